// Dialog 5046, "Layers": two icon buttons above the list of layers (force all on, all/used
// layers), OK and Cancel below it on the right.
#include "framework/window_classes.h"
#include "resources/dialog_templates.h"

namespace resources {

const DialogTemplate& LayerSettingsTemplate() {
  using namespace framework;
  constexpr DWORD kIconButton = WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON;
  static const DialogTemplate layers{
      kIddLayerSettings, WS_POPUP | WS_CAPTION | WS_SYSMENU | DS_MODALFRAME | DS_SETFONT | DS_CENTER, 0, 0, 0, 176, 188,
      "Layers", "MS Shell Dlg", 8, false,
      {
          {5065, kButtonClass, "", kIconButton, 0, 4, 3, 16, 14},
          {5066, kButtonClass, "", kIconButton, 0, 22, 3, 16, 14},
          {5064, kListViewClass, "",
           WS_VISIBLE | WS_BORDER | WS_TABSTOP | LVS_REPORT | LVS_SINGLESEL | LVS_SHOWSELALWAYS, 0, 4, 20, 168, 146},
          {IDOK, kButtonClass, "OK", WS_VISIBLE | WS_TABSTOP | BS_DEFPUSHBUTTON, 0, 66, 170, 50, 14},
          {IDCANCEL, kButtonClass, "Cancel", WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON, 0, 122, 170, 50, 14},
      }};
  return layers;
}

}  // namespace resources
