// Finding views by name and changing their 2D ticks; making a camera from eye and target.
#include "app/view_edit.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <stdexcept>

#include "model/current_database.h"
#include "shell/host/argument_blocks.h"
#include "views/hr_camera_mgr.h"
#include "views/hr_plane.h"
#include "views/hr_section.h"
#include "views/view_collection.h"

namespace app {
namespace {

// The edit that sets one view's tick, or nothing when no view has that name.
using Edit = std::function<void(bool)>;

template <typename Owner>
Edit FindOwnedCamera(const std::vector<host::EntityHandle>& owners, const std::string& ownerName,
                     const std::string& cameraName) {
  for (const host::EntityHandle handle : owners) {
    Owner owner;
    if (owner.Load(handle) != 0 || owner.GetName() != ownerName) continue;
    for (std::int32_t k = 0; k < owner.GetCameraCount(); ++k) {
      if (owner.GetCameraName(k) != cameraName) continue;
      return [handle, k](bool tick) {
        Owner found;
        if (found.Load(handle) == 0) found.SetCameraFor2D(k, tick ? 1 : 0);
      };
    }
  }
  return nullptr;
}

Edit FindGeneralCamera(const std::string& name) {
  for (std::int32_t i = 0; i < GetGeneralCameraCount(); ++i) {
    HRCamera camera;
    if (LoadGeneralCamera(camera, i) != 0 || camera.GetName() != name) continue;
    return [i](bool tick) {
      HRCamera found;
      if (LoadGeneralCamera(found, i) != 0) return;
      found.SetFor2D(tick ? 1 : 0);
      UpdateGeneralCamera(found, i);
    };
  }
  return nullptr;
}

// Names may hold '/' themselves: a general camera of the whole name comes first, then every
// place the name could split into owner and camera.
Edit FindView(const std::string& view) {
  if (Edit edit = FindGeneralCamera(view)) return edit;
  const host::DatabaseHandle database = GetCurrentDatabase();
  const std::vector<host::EntityHandle> sections = CollectSectionHandles(database);
  const std::vector<host::EntityHandle> plans = CollectPlanHandles(database);
  for (std::size_t slash = view.find('/'); slash != std::string::npos; slash = view.find('/', slash + 1)) {
    const std::string owner = view.substr(0, slash);
    const std::string camera = view.substr(slash + 1);
    if (Edit edit = FindOwnedCamera<HRSection>(sections, owner, camera)) return edit;
    if (Edit edit = FindOwnedCamera<HRPlane>(plans, owner, camera)) return edit;
  }
  return nullptr;
}

bool Finite(const std::array<float, 3>& point) {
  return std::all_of(point.begin(), point.end(), [](float value) { return std::isfinite(value); });
}

}  // namespace

void SetTicks(const std::vector<std::string>& views, bool tick) {
  SetDatabase(db.handle);
  std::vector<Edit> edits;
  for (const std::string& view : views) {
    Edit edit = FindView(view);
    if (!edit) throw std::runtime_error("no view named \"" + view + "\" in the drawing");
    edits.push_back(std::move(edit));
  }
  for (const Edit& edit : edits) edit(tick);
}

std::int32_t AddCamera(const NewCamera& camera) {
  if (camera.name.empty()) throw std::runtime_error("a camera needs a name");
  if (!Finite(camera.eye) || !Finite(camera.target)) throw std::runtime_error("the eye and the target must be numbers");
  // Without a direction there is no view to look along.
  if (camera.eye == camera.target) throw std::runtime_error("the eye and the target must differ");
  SetDatabase(db.handle);
  CameraSettings settings;
  for (std::size_t i = 0; i < 3; ++i) {
    settings.eye[i] = camera.eye[i];
    settings.target[i] = camera.target[i];
  }
  settings.cone = 45.0F;
  for (std::size_t i = 0; i < 4; ++i) settings.viewWindow[i] = camera.window[i];
  settings.displayMode = camera.displayMode;
  settings.viewMode = static_cast<std::int16_t>((camera.flat ? 0 : 2) + (camera.perspective ? 1 : 0));
  settings.layers.fill(1);
  settings.showSections = settings.autoClip = settings.overwrite2D = 1;
  settings.removeCoincident = settings.lineMerge = 1;
  settings.scaleMode = 'a';
  HRCamera newCamera;
  newCamera.SetSettings(settings);
  newCamera.SetName(camera.name);
  newCamera.SetFor2D(camera.tick ? 1 : 0);
  const std::int32_t index = AddGeneralCamera(newCamera);
  if (index < 0) throw std::runtime_error("the camera could not be stored (host code " + std::to_string(index) + ")");
  return index;
}

}  // namespace app
