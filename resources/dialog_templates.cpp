// Finding a dialog template by its id.
#include "resources/dialog_templates.h"

namespace resources {

const DialogTemplate* FindDialogTemplate(UINT id) {
  for (const DialogTemplate* t : {&ManagerPaneTemplate(), &ProgressTemplate(), &SelectionsTemplate(), &SelectionNameTemplate()}) {
    if (static_cast<UINT>(t->id) == id) return t;
  }
  return nullptr;
}

}  // namespace resources
