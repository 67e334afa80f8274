// Dialog 5062, "Selection Name": one line for the name of a new selection, OK and Cancel.
#include "framework/window_classes.h"
#include "resources/dialog_templates.h"

namespace resources {

const DialogTemplate& SelectionNameTemplate() {
  using namespace framework;
  static const DialogTemplate name{
      kIddSelectionName, WS_POPUP | WS_CAPTION | WS_SYSMENU | DS_MODALFRAME | DS_SETFONT | DS_CENTER, 0, 0, 0, 238,
      41, "Selection Name", "MS Shell Dlg", 8, false,
      {
          {IDC_STATIC, kStaticClass, "Name", WS_VISIBLE | SS_LEFT, 0, 2, 5, 38, 8},
          {5074, kEditClass, "", WS_VISIBLE | WS_BORDER | WS_TABSTOP | ES_AUTOHSCROLL, 0, 44, 5, 189, 14},
          {IDOK, kButtonClass, "OK", WS_VISIBLE | WS_TABSTOP | BS_DEFPUSHBUTTON, 0, 125, 24, 50, 14},
          {IDCANCEL, kButtonClass, "Cancel", WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON, 0, 183, 24, 50, 14},
      }};
  return name;
}

}  // namespace resources
