// The library's dialog templates by id.
#pragma once

#include "framework/dialog_template.h"

namespace resources {

enum DialogId : int {
  kIddManagerPane = 5000,
  kIddCameraSettings = 5012,
  kIddSectionSettings = 5038,
  kIddLayerSettings = 5046,
  kIddProgress = 5054,
  kIddSelections = 5055,
  kIddSelectionName = 5062,
};

// The template of a dialog id, or null.
const DialogTemplate* FindDialogTemplate(UINT id);
// Every template, in id order (the gallery shows them all).
std::vector<const DialogTemplate*> AllDialogTemplates();

// One function a template, each in its own file under dialogs/.
const DialogTemplate& ManagerPaneTemplate();
const DialogTemplate& CameraSettingsTemplate();
const DialogTemplate& SectionSettingsTemplate();
const DialogTemplate& LayerSettingsTemplate();
const DialogTemplate& ProgressTemplate();
const DialogTemplate& SelectionsTemplate();
const DialogTemplate& SelectionNameTemplate();

}  // namespace resources
