// Dialog 5000, the manager pane: a child window without caption or border holding the icon
// tabs, the row of seven icon buttons, the tree and a hidden default OK button.
#include "framework/window_classes.h"
#include "resources/dialog_templates.h"

namespace resources {

const DialogTemplate& ManagerPaneTemplate() {
  using namespace framework;
  constexpr DWORD kIconButton = WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON;
  static const DialogTemplate manager{
      kIddManagerPane, WS_CHILD | DS_SETFONT | DS_CENTER, 0, 0, 0, 169, 246, "", "MS Shell Dlg", 8, false,
      {
          // The tabs come first, so that they lie under all the other controls.
          {5011, kTabControlClass, "", WS_VISIBLE | TCS_OWNERDRAWFIXED, 0, 0, 1, 169, 244},
          {5007, kButtonClass, "", kIconButton, 0, 3, 20, 16, 14},
          {5008, kButtonClass, "", kIconButton, 0, 23, 20, 16, 14},
          {5009, kButtonClass, "", kIconButton, 0, 43, 20, 16, 14},
          {5010, kButtonClass, "", kIconButton, 0, 63, 20, 16, 14},
          {5018, kButtonClass, "", kIconButton, 0, 83, 20, 16, 14},
          {5021, kButtonClass, "", kIconButton, 0, 103, 20, 15, 14},
          {5019, kButtonClass, "", kIconButton, 0, 123, 20, 15, 14},
          {5016, kTreeViewClass, "",
           WS_VISIBLE | WS_BORDER | WS_TABSTOP | TVS_HASBUTTONS | TVS_HASLINES | TVS_LINESATROOT | TVS_EDITLABELS |
               TVS_SHOWSELALWAYS | TVS_CHECKBOXES | TVS_FULLROWSELECT,
           0, 2, 39, 165, 204},
          {1, kButtonClass, "OK", WS_TABSTOP | BS_DEFPUSHBUTTON, 0, 119, 231, 50, 14},
      }};
  return manager;
}

}  // namespace resources
