// Camera values, defaults, copies and the settings exchange.
#include "views/hr_camera.h"

#include <algorithm>
#include <cstring>

#include "model/current_database.h"
#include "model/status_codes.h"
#include "shell/host/qeldll.h"

namespace {
constexpr const char* kCameraClass = "HRCamera";
}

HRCamera::HRCamera() : HRObject(kCameraClass) { Reset(); }

HRCamera::~HRCamera() = default;

std::string HRCamera::GetName() const { return name_; }
void HRCamera::SetName(const std::string& name) { name_ = name; }
void HRCamera::GetLayerConfig(LayerTable& layers) const { layers = layers_; }
void HRCamera::SetLayerConfig(const LayerTable& layers) { layers_ = layers; }
void HRCamera::SetFor2D(std::int16_t for2D) { for2D_ = static_cast<std::uint16_t>(for2D); }
std::uint16_t HRCamera::IsFor2D() const { return for2D_; }
void HRCamera::Set2DFile(const std::string& file) { file2D_ = file; }
std::string HRCamera::Get2DFile() const { return file2D_; }
void HRCamera::SetComment(const std::string& comment) { comment_ = comment; }
std::string HRCamera::GetComment() const { return comment_; }
void HRCamera::SetHandle(host::EntityHandle entity) { group_.SetEntity(entity); }
void HRCamera::SetClassName(const std::string& className) { HRObject::SetClassName(className); }
bool HRCamera::IsCamera() const { return GetClassName() == kCameraClass; }
bool HRCamera::HasPatterns() const { return patterns_ != 0; }

void HRCamera::Reset() {
  group_ = HRGroup();
  for2D_ = 0;
  patterns_ = 0;
  layers_.fill(0);
  viewMode_ = k2DParallel;
  displayMode_ = 0;
  name_ = "Camera";
  scaleMode_ = 'a';
  showSections_ = autoClip_ = overwrite2D_ = removeCoincident_ = lineMerge_ = 1;
  preserveDimensions_ = preserveText_ = preserveWalls_ = preserveLayer_ = 0;
  preserveLayerIndex_ = 1;
}

HRCamera HRCamera::Copy(const HRCamera& camera) const {
  HRCamera copy;
  copy.group_ = copy.group_.CopyOf(camera.group_);
  copy.viewMode_ = camera.viewMode_;
  std::copy(std::begin(camera.viewWindow_), std::end(camera.viewWindow_), copy.viewWindow_);
  copy.displayMode_ = camera.displayMode_;
  copy.layers_ = camera.layers_;
  copy.cone_ = camera.cone_;
  std::copy(std::begin(camera.eye_), std::end(camera.eye_), copy.eye_);
  std::copy(std::begin(camera.target_), std::end(camera.target_), copy.target_);
  copy.name_.clear();
  copy.file2D_.clear();
  copy.comment_.clear();
  return copy;
}

void HRCamera::GetSettings(CameraSettings& settings) const {
  std::copy(std::begin(eye_), std::end(eye_), settings.eye);
  std::copy(std::begin(target_), std::end(target_), settings.target);
  settings.cone = cone_;
  std::copy(std::begin(viewWindow_), std::end(viewWindow_), settings.viewWindow);
  settings.displayMode = displayMode_;
  settings.viewMode = viewMode_;
  settings.layers = layers_;
  settings.file2D = file2D_;
  settings.comment = comment_;
  settings.patterns = patterns_;
  settings.showSections = showSections_;
  settings.autoClip = autoClip_;
  settings.overwrite2D = overwrite2D_;
  settings.removeCoincident = removeCoincident_;
  settings.lineMerge = lineMerge_;
  settings.scaleMode = scaleMode_;
  settings.preserveDimensions = preserveDimensions_;
  settings.preserveText = preserveText_;
  settings.preserveWalls = preserveWalls_;
  settings.preserveLayer = preserveLayer_;
  settings.preserveLayerIndex = preserveLayerIndex_;
}

void HRCamera::SetSettings(const CameraSettings& settings) {
  std::copy(std::begin(settings.eye), std::end(settings.eye), eye_);
  std::copy(std::begin(settings.target), std::end(settings.target), target_);
  cone_ = settings.cone;
  std::copy(std::begin(settings.viewWindow), std::end(settings.viewWindow), viewWindow_);
  displayMode_ = settings.displayMode;
  viewMode_ = settings.viewMode;
  layers_ = settings.layers;
  file2D_ = settings.file2D;
  comment_ = settings.comment;
  patterns_ = settings.patterns;
  showSections_ = settings.showSections;
  autoClip_ = settings.autoClip;
  overwrite2D_ = settings.overwrite2D;
  removeCoincident_ = settings.removeCoincident;
  lineMerge_ = settings.lineMerge;
  scaleMode_ = settings.scaleMode;
  preserveDimensions_ = settings.preserveDimensions;
  preserveText_ = settings.preserveText;
  preserveWalls_ = settings.preserveWalls;
  preserveLayer_ = settings.preserveLayer;
  preserveLayerIndex_ = settings.preserveLayerIndex;
}

std::int16_t HRCamera::Create() { return CreateIn(GetCurrentDatabase()); }

std::int16_t HRCamera::CreateIn(host::DatabaseHandle database) {
  // The marker the group writes on creation already names the camera's kind.
  group_.SetClassName(GetClassName());
  group_.Create(database);
  return SaveTo(database);
}

std::int16_t HRCamera::Delete() { return DeleteIn(GetCurrentDatabase()); }

std::int16_t HRCamera::DeleteIn(host::DatabaseHandle database) {
  return qel_delete_group(database, group_.GetEntity()) == host::kOk ? model_status::kSuccess
                                                                       : model_status::kNotDeleted;
}

std::int16_t HRCamera::Load(host::EntityHandle entity) { return LoadFrom(GetCurrentDatabase(), entity); }

std::int16_t HRCamera::Save() { return SaveTo(GetCurrentDatabase()); }
