// Dialog 5054, the progress of a 2D run: a popup without caption with the "File n of m" line,
// the bar, the Start/Done button and Cancel.
#include "framework/window_classes.h"
#include "resources/dialog_templates.h"

namespace resources {

const DialogTemplate& ProgressTemplate() {
  using namespace framework;
  static const DialogTemplate progress{
      kIddProgress, WS_POPUP | DS_MODALFRAME | DS_SETFONT | DS_CENTER, 0, 0, 0, 186, 59, "", "MS Shell Dlg", 8, false,
      {
          {5069, kStaticClass, "", WS_VISIBLE | SS_CENTER, 0, 7, 7, 172, 8},
          {5068, kProgressClass, "", WS_VISIBLE | WS_BORDER | PBS_SMOOTH, 0, 7, 18, 172, 14},
          {5070, kButtonClass, "", WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON, 0, 35, 38, 50, 14},
          {2, kButtonClass, "Cancel", WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON, 0, 101, 38, 50, 14},
      }};
  return progress;
}

}  // namespace resources
