// Dialog 5038, "Section Settings": the symbol file with its browse button, the cut line's look
// (type, width, colour, cut type) two by two, the start and end points as a small table of
// X, Y and Z, and the comment; OK and Cancel at the bottom right.
#include "framework/window_classes.h"
#include "resources/dialog_templates.h"

namespace resources {

const DialogTemplate& SectionSettingsTemplate() {
  using namespace framework;
  constexpr DWORD kLabel = WS_VISIBLE | SS_LEFT;
  constexpr DWORD kColumnTitle = WS_VISIBLE | SS_CENTER;
  constexpr DWORD kEdit = WS_VISIBLE | WS_TABSTOP | WS_BORDER | ES_AUTOHSCROLL;
  constexpr DWORD kDropList = WS_VISIBLE | WS_TABSTOP | WS_VSCROLL | CBS_DROPDOWNLIST;
  constexpr DWORD kGroup = WS_VISIBLE | BS_GROUPBOX;
  static const DialogTemplate section{
      kIddSectionSettings, WS_POPUP | WS_CAPTION | WS_SYSMENU | DS_MODALFRAME | DS_SETFONT | DS_CENTER, 0, 0, 0, 250,
      200, "Section Settings", "MS Shell Dlg", 8, false,
      {
          {IDC_STATIC, kButtonClass, " Symbol ", kGroup, 0, 7, 4, 236, 30},
          {IDC_STATIC, kStaticClass, "Symbol file", kLabel, 0, 14, 17, 42, 8},
          {5041, kEditClass, "", kEdit | ES_READONLY, 0, 58, 15, 160, 13},
          {5055, kButtonClass, "...", WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON, 0, 222, 15, 16, 13},

          {IDC_STATIC, kButtonClass, " Cut line ", kGroup, 0, 7, 38, 236, 56},
          {IDC_STATIC, kStaticClass, "Line type", kLabel, 0, 14, 53, 40, 8},
          {5052, kComboBoxExClass, "", kDropList, 0, 58, 51, 66, 100},
          {IDC_STATIC, kStaticClass, "Width", kLabel, 0, 134, 53, 30, 8},
          {5053, kComboBoxExClass, "", kDropList, 0, 168, 51, 66, 60},
          {IDC_STATIC, kStaticClass, "Color", kLabel, 0, 14, 73, 40, 8},
          {5054, kComboBoxClass, "", kDropList | CBS_OWNERDRAWFIXED | CBS_HASSTRINGS, 0, 58, 71, 66, 120},
          {IDC_STATIC, kStaticClass, "Cut type", kLabel, 0, 134, 73, 32, 8},
          {5056, kComboBoxClass, "", kDropList, 0, 168, 71, 66, 60},

          {IDC_STATIC, kButtonClass, " Points ", kGroup, 0, 7, 98, 236, 56},
          {IDC_STATIC, kStaticClass, "X", kColumnTitle, 0, 58, 109, 56, 8},
          {IDC_STATIC, kStaticClass, "Y", kColumnTitle, 0, 118, 109, 56, 8},
          {IDC_STATIC, kStaticClass, "Z", kColumnTitle, 0, 178, 109, 56, 8},
          {IDC_STATIC, kStaticClass, "Start", kLabel, 0, 14, 122, 40, 8},
          {5045, kEditClass, "", kEdit, 0, 58, 120, 56, 13},
          {5046, kEditClass, "", kEdit, 0, 118, 120, 56, 13},
          {5047, kEditClass, "", kEdit, 0, 178, 120, 56, 13},
          {IDC_STATIC, kStaticClass, "End", kLabel, 0, 14, 138, 40, 8},
          {5048, kEditClass, "", kEdit, 0, 58, 136, 56, 13},
          {5049, kEditClass, "", kEdit, 0, 118, 136, 56, 13},
          {5050, kEditClass, "", kEdit, 0, 178, 136, 56, 13},

          {IDC_STATIC, kStaticClass, "Comment", kLabel, 0, 14, 163, 40, 8},
          {5051, kEditClass, "", kEdit, 0, 58, 161, 180, 13},
          {IDOK, kButtonClass, "OK", WS_VISIBLE | WS_TABSTOP | BS_DEFPUSHBUTTON, 0, 137, 180, 50, 14},
          {IDCANCEL, kButtonClass, "Cancel", WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON, 0, 193, 180, 50, 14},
      }};
  return section;
}

}  // namespace resources
