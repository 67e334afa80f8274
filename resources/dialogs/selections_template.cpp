// Dialog 5055, "Selections": three icon buttons above the list of stored selections, and Exit.
#include "framework/window_classes.h"
#include "resources/dialog_templates.h"

namespace resources {

const DialogTemplate& SelectionsTemplate() {
  using namespace framework;
  constexpr DWORD kIconButton = WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON;
  static const DialogTemplate selections{
      kIddSelections, WS_POPUP | WS_CAPTION | WS_SYSMENU | DS_MODALFRAME | DS_SETFONT, 0, 0, 0, 136, 180,
      "Selections", "MS Shell Dlg", 8, true,
      {
          {5075, kButtonClass, "", kIconButton, 0, 75, 3, 16, 14},
          {5072, kListViewClass, "", WS_VISIBLE | WS_BORDER | WS_TABSTOP | LVS_REPORT | LVS_SINGLESEL, 0, 2, 21, 131, 138},
          {5073, kButtonClass, "", kIconButton, 0, 118, 3, 15, 14},
          {5074, kButtonClass, "", kIconButton, 0, 97, 3, 15, 14},
          {1, kButtonClass, "Exit", WS_VISIBLE | WS_TABSTOP | BS_DEFPUSHBUTTON, 0, 83, 163, 50, 14},
      }};
  return selections;
}

}  // namespace resources
