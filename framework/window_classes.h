// Names of the window classes the framework registers; dialog templates name their controls by them.
#pragma once

#include <string_view>

namespace framework {

inline constexpr std::string_view kDialogClass = "#32770";
inline constexpr std::string_view kButtonClass = "Button";
inline constexpr std::string_view kStaticClass = "Static";
inline constexpr std::string_view kEditClass = "Edit";
inline constexpr std::string_view kTreeViewClass = "SysTreeView32";
inline constexpr std::string_view kTabControlClass = "SysTabControl32";
inline constexpr std::string_view kToolTipClass = "tooltips_class32";
inline constexpr std::string_view kListViewClass = "SysListView32";
inline constexpr std::string_view kComboBoxClass = "ComboBox";
inline constexpr std::string_view kComboBoxExClass = "ComboBoxEx32";
inline constexpr std::string_view kProgressClass = "msctls_progress32";

}  // namespace framework
