// Finding a dialog template by its id.
#include "resources/dialog_templates.h"

namespace resources {

std::vector<const DialogTemplate*> AllDialogTemplates() {
  return {&ManagerPaneTemplate(),    &CameraSettingsTemplate(), &SectionSettingsTemplate(), &LayerSettingsTemplate(),
          &ProgressTemplate(),       &SelectionsTemplate(),     &SelectionNameTemplate()};
}

const DialogTemplate* FindDialogTemplate(UINT id) {
  for (const DialogTemplate* t : AllDialogTemplates()) {
    if (static_cast<UINT>(t->id) == id) return t;
  }
  return nullptr;
}

}  // namespace resources
