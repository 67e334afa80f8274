// The library's dialog templates by id.
#pragma once

#include "framework/dialog_template.h"

namespace resources {

enum DialogId : int {
  kIddManagerPane = 5000,
  kIddProgress = 5054,
  kIddSelections = 5055,
  kIddSelectionName = 5062,
};

// The template of a dialog id, or null.
const DialogTemplate* FindDialogTemplate(UINT id);

// One function a template, each in its own file under dialogs/.
const DialogTemplate& ManagerPaneTemplate();
const DialogTemplate& ProgressTemplate();
const DialogTemplate& SelectionsTemplate();
const DialogTemplate& SelectionNameTemplate();

}  // namespace resources
