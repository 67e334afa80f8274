// Plans: the record on the group entity, the plan view and the plan's own cameras.
#include "views/hr_plane.h"

#include <cstring>

#include "display/display_mode.h"
#include "model/class_marker.h"
#include "model/current_database.h"
#include "model/host_point.h"
#include "model/status_codes.h"
#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll.h"
#include "shell/host/qeldll_view.h"
#include "views/cut_display.h"
#include "views/section_symbols.h"

namespace {

constexpr const char* kPlaneClass = "HRPlane";
constexpr float kAxisLength = 100.0F;  // drawing units

void Run(const char* command) { execute_internal_command(command); }

// Reads a 3-float vector attribute into doubles; false when it is absent or not 3 long.
bool ReadPoint(const HRGroup& group, const char* name, double out[3]) {
  std::int32_t count = 0;
  float* values = nullptr;
  const bool read = group.ReadFloatVectorAttribute(name, &count, &values) == 0 && values != nullptr && count == 3;
  if (read) {
    for (int i = 0; i < 3; ++i) out[i] = values[i];
  }
  if (values != nullptr) log_free(values);
  return read;
}

}  // namespace

HRPlane::HRPlane() : HRObject(kPlaneClass) {}

HRPlane::~HRPlane() = default;

void HRPlane::DefineFromPoints(const std::string& name, const float base[3], const float dir[3]) {
  const double wideBase[3] = {base[0], base[1], base[2]};
  const double wideDir[3] = {dir[0], dir[1], dir[2]};
  Define(name, wideBase, wideDir);
}

void HRPlane::Define(const std::string& name, const double base[3], const double dir[3]) {
  name_ = name;
  std::memcpy(base_, base, sizeof base_);
  std::memcpy(dir_, dir, sizeof dir_);
}

host::EntityHandle HRPlane::GetHandle() const { return group_.GetEntity(); }
void HRPlane::SetFor2D(std::int16_t for2D) { for2D_ = static_cast<std::uint16_t>(for2D); }
std::uint16_t HRPlane::IsFor2D() const { return for2D_; }
void HRPlane::SetCutType(char cutType) { cutType_ = cutType; }
std::string HRPlane::GetName() const { return name_; }
void HRPlane::SetName(const std::string& name) { name_ = name; }
std::int16_t HRPlane::Unused(std::int32_t /*argument*/) { return 0; }
std::int16_t HRPlane::Create() { return CreateIn(GetCurrentDatabase()); }
std::int16_t HRPlane::Load(host::EntityHandle entity) { return LoadFrom(GetCurrentDatabase(), entity); }
std::int16_t HRPlane::Save() { return SaveTo(GetCurrentDatabase()); }

void HRPlane::WriteRecord(bool removeEmptyCameraList) {
  const host::Point3f base = ToHostPoint(base_);
  const host::Point3f dir = ToHostPoint(dir_);
  group_.SetFloatVectorAttribute("@base=", &base.x, 3);
  group_.SetFloatVectorAttribute("@dir=", &dir.x, 3);
  group_.SetStringAttribute("@name=", name_);
  group_.SetShortAttribute("@S2D=", static_cast<std::int16_t>(for2D_));
  cameras_.WriteList(group_, removeEmptyCameraList);
}

std::int16_t HRPlane::CreateIn(host::DatabaseHandle database) {
  group_.SetClassName(kPlaneClass);
  group_.Create(database);
  WriteRecord(false);
  return 0;
}

std::int16_t HRPlane::SaveTo(host::DatabaseHandle database) {
  group_.SetClassName(kPlaneClass);
  group_.Update(database);
  WriteRecord(true);
  return 0;
}

std::int16_t HRPlane::LoadFrom(host::DatabaseHandle database, host::EntityHandle entity) {
  if (const std::int16_t result = group_.Read(database, entity); result != 0) return result;
  // Records written here always hold base, dir and name; one without them is no plane.
  if (!ReadPoint(group_, "@base=", base_) || !ReadPoint(group_, "@dir=", dir_)) return model_status::kAttributeFailed;
  std::int16_t for2D = 0;
  group_.GetShortAttribute("@S2D=", for2D);
  for2D_ = static_cast<std::uint16_t>(for2D);
  cameras_.ReadList(group_);
  if (group_.GetStringAttribute("@name=", name_) != 0) return model_status::kAttributeFailed;
  return 0;
}

std::int16_t HRPlane::Delete() {
  group_.Delete();
  cameras_.DeleteAll(GetCurrentDatabase());
  return 0;
}

std::int16_t HRPlane::ShowView(std::int32_t cameraIndex, const void* /*context*/) {
  HRCamera camera;
  const bool withCamera = cameraIndex != -1;
  if (withCamera) {
    // Applying a camera that did not load would switch every layer off and put the eye on the
    // target; the view is left as it is instead.
    if (const std::int16_t loaded = cameras_.Load(cameraIndex, camera); loaded != 0) return loaded;
    camera.ApplyView(0);
  }
  const host::Point3f base = ToHostPoint(base_);
  globp[0] = base;
  globp[1] = {base.x + kAxisLength, base.y, base.z};
  globp[2] = {base.x, base.y + kAxisLength, base.z};
  globp[3] = ToHostPoint(dir_);

  if (cut_display::RenderingActive()) {
    // The camera's first phase turned the wait cursor on; do not leave it on when refusing.
    if (withCamera) remove_wait_cur();
    return cut_display::kRenderStillOn;
  }
  cut_display::Begin(cutType_);
  // Texts of the plan show while the section symbols do.
  globr[0] = SectionsShown != 0 ? 1.0F : globr[103];
  Run("draw_text_on_off");
  cut_display::Finish('h');
  if (withCamera) {
    camera.ApplyView(1);
  } else {
    Run("planv");
    HRUtility::SetDisplayMode(HRUtility::kHiddenline);
  }
  return 0;
}

std::int32_t HRPlane::AddCamera(const std::string& name) { return cameras_.Add(group_, name); }
std::int16_t HRPlane::LoadCamera(std::int32_t index, HRCamera& camera) { return cameras_.Load(index, camera); }
std::int16_t HRPlane::RemoveCamera(std::int32_t index) { return cameras_.Remove(group_, index); }
std::int16_t HRPlane::GetCameraCount() const { return cameras_.Count(); }
std::string HRPlane::GetCameraName(std::int32_t index) { return cameras_.NameAt(index); }
void HRPlane::RenameCamera(const std::string& name, std::int32_t index) { cameras_.Rename(index, name); }
void HRPlane::SetCameraFor2D(std::int32_t index, std::int16_t for2D) { cameras_.SetFor2D(index, for2D); }
std::uint16_t HRPlane::IsCameraFor2D(std::int32_t index) { return cameras_.IsFor2D(index); }
std::int16_t HRPlane::SaveCamera(std::int32_t index, HRCamera& camera) { return cameras_.Save(index, camera); }

bool IsPlaneEntity(host::DatabaseHandle database, host::EntityHandle entity) {
  return HasClassMarker(database, entity, kPlaneClass);
}
