// The window classes the framework brings, registered once on first need. A new control class
// adds its Register function here.
#include "framework/controls/button.h"
#include "framework/controls/edit.h"
#include "framework/controls/static_control.h"
#include "framework/controls/tab_control.h"
#include "framework/controls/tool_tip.h"
#include "framework/controls/tree_control.h"
#include "framework/window_table.h"

namespace framework {

void RegisterDialogClass();

namespace detail {

void EnsureBuiltInClasses() {
  static bool registered = false;
  if (registered) return;
  registered = true;
  RegisterDialogClass();
  RegisterButtonClass();
  RegisterStaticClass();
  RegisterEditClass();
  RegisterTabControlClass();
  RegisterTreeViewClass();
  RegisterToolTipClass();
}

}  // namespace detail
}  // namespace framework
