// Selection sets: writing and reading the record, and ticking exactly the views it lists.
#include "views/hr_selection.h"

#include <cstdio>

#include "model/current_database.h"
#include "model/status_codes.h"
#include "shell/host/qeldll.h"
#include "views/hr_camera_mgr.h"
#include "views/hr_plane.h"
#include "views/hr_section.h"

namespace {

constexpr const char* kSelectionClass = "HRSelection";

std::string EntryKey(const char* prefix, std::size_t index) {
  char key[32];
  std::snprintf(key, sizeof key, "%s%d=", prefix, static_cast<int>(index));
  return key;
}

// Walks a view's cameras in step with an ascending list of ticked indices. Cameras that do not
// load are left as they are rather than overwritten with an unloaded camera.
template <typename View>
void TickCameras(View& view, const std::vector<std::int32_t>& ticked) {
  std::size_t k = 0;
  for (std::int32_t j = 0; j < view.GetCameraCount(); ++j) {
    HRCamera camera;
    const bool loaded = view.LoadCamera(j, camera) == 0;
    const bool tick = k < ticked.size() && ticked[k] == j;
    if (tick) ++k;
    if (!loaded) continue;
    camera.SetFor2D(tick ? 1 : 0);
    view.SaveCamera(j, camera);
  }
}

const SECPLN_NODE* EntryAt(const std::vector<SECPLN_NODE>& entries, std::int32_t i) {
  return i >= 0 && static_cast<std::size_t>(i) < entries.size() ? &entries[static_cast<std::size_t>(i)] : nullptr;
}

}  // namespace

HRSelection::HRSelection() : HRObject(kSelectionClass) {}

HRSelection::~HRSelection() = default;

void HRSelection::AddSection(host::EntityHandle section, const std::vector<std::int32_t>& cameras) {
  sections_.push_back({section, cameras});
}

void HRSelection::AddPlan(host::EntityHandle plan, const std::vector<std::int32_t>& cameras) {
  plans_.push_back({plan, cameras});
}

std::int32_t HRSelection::GetCamera(std::int32_t i) const {
  return i >= 0 && i < GetCameraCount() ? cameras_[static_cast<std::size_t>(i)] : -1;
}

host::EntityHandle HRSelection::GetSectionHandle(std::int32_t i) const {
  const SECPLN_NODE* entry = EntryAt(sections_, i);
  return entry != nullptr ? entry->handle : 0;
}

host::EntityHandle HRSelection::GetPlanHandle(std::int32_t i) const {
  const SECPLN_NODE* entry = EntryAt(plans_, i);
  return entry != nullptr ? entry->handle : 0;
}

void HRSelection::GetSectionCameras(std::int32_t i, std::vector<std::int32_t>& cameras) const {
  const SECPLN_NODE* entry = EntryAt(sections_, i);
  cameras = entry != nullptr ? entry->cameras : std::vector<std::int32_t>();
}

void HRSelection::GetPlanCameras(std::int32_t i, std::vector<std::int32_t>& cameras) const {
  const SECPLN_NODE* entry = EntryAt(plans_, i);
  cameras = entry != nullptr ? entry->cameras : std::vector<std::int32_t>();
}

std::int16_t HRSelection::WriteEntries(const char* countKey, const char* keyPrefix,
                                       const std::vector<SECPLN_NODE>& entries) {
  if (const std::int16_t result = group_.SetShortAttribute(countKey, static_cast<std::int16_t>(entries.size()));
      result != 0) {
    return result;
  }
  for (std::size_t i = 0; i < entries.size(); ++i) {
    std::vector<std::int32_t> values;
    values.reserve(entries[i].cameras.size() + 1);
    values.push_back(entries[i].handle);
    values.insert(values.end(), entries[i].cameras.begin(), entries[i].cameras.end());
    const std::int16_t result = group_.SetLongVectorAttribute(EntryKey(keyPrefix, i),
                                                              static_cast<std::int32_t>(values.size()), values.data());
    if (result != 0) return result;
  }
  return 0;
}

std::int16_t HRSelection::Create() {
  if (const std::int16_t result = group_.Create(GetCurrentDatabase()); result != 0) return result;
  if (const std::int16_t result = group_.SetStringAttribute("@SNAME=", name_); result != 0) return result;
  if (!cameras_.empty()) {
    const std::int16_t result =
        group_.SetLongVectorAttribute("@SCL=", static_cast<std::int32_t>(cameras_.size()), cameras_.data());
    if (result != 0) return result;
  }
  if (const std::int16_t result = WriteEntries("@SSC=", "@SSL", sections_); result != 0) return result;
  if (const std::int16_t result = WriteEntries("@SPC=", "@SPL", plans_); result != 0) return result;
  return group_.SetStringAttribute("@Class=", kSelectionClass);
}

std::int16_t HRSelection::ReadEntries(const char* countKey, const char* keyPrefix, std::vector<SECPLN_NODE>& entries) {
  std::int16_t count = 0;
  if (const std::int16_t result = group_.GetShortAttribute(countKey, count); result != 0) return result;
  for (std::int16_t i = 0; i < count; ++i) {
    std::int32_t length = 0;
    std::int32_t* values = nullptr;
    std::int16_t result =
        group_.ReadLongVectorAttribute(EntryKey(keyPrefix, static_cast<std::size_t>(i)), &length, &values);
    // An entry holds at least the view's handle; an empty one is damaged.
    if (result == 0 && (values == nullptr || length < 1)) result = model_status::kAttributeFailed;
    if (result == 0) entries.push_back({values[0], std::vector<std::int32_t>(values + 1, values + length)});
    if (values != nullptr) log_free(values);
    if (result != 0) return result;
  }
  return 0;
}

std::int16_t HRSelection::Load(host::EntityHandle entity) {
  if (const std::int16_t result = group_.Read(GetCurrentDatabase(), entity); result != 0) return result;
  std::string className;
  if (const std::int16_t result = group_.GetStringAttribute("@Class=", className); result != 0) return result;
  if (className != kSelectionClass) return model_status::kWrongEntity;
  if (const std::int16_t result = group_.GetStringAttribute("@SNAME=", name_); result != 0) return result;
  std::int32_t count = 0;
  std::int32_t* values = nullptr;
  if (group_.ReadLongVectorAttribute("@SCL=", &count, &values) == 0 && values != nullptr && count > 0) {
    cameras_.insert(cameras_.end(), values, values + count);
  }
  if (values != nullptr) log_free(values);
  if (const std::int16_t result = ReadEntries("@SSC=", "@SSL", sections_); result != 0) return result;
  return ReadEntries("@SPC=", "@SPL", plans_);
}

void HRSelection::Apply() const {
  std::size_t k = 0;
  for (std::int32_t i = 0; i < GetGeneralCameraCount(); ++i) {
    HRCamera camera;
    const bool loaded = LoadGeneralCamera(camera, i) == 0;
    const bool tick = k < cameras_.size() && cameras_[k] == i;
    if (tick) ++k;
    if (!loaded) continue;
    camera.SetFor2D(tick ? 1 : 0);
    UpdateGeneralCamera(camera, i);
  }
  for (const SECPLN_NODE& entry : sections_) {
    HRSection section;
    if (section.Load(entry.handle) == 0) TickCameras(section, entry.cameras);
  }
  for (const SECPLN_NODE& entry : plans_) {
    HRPlane plan;
    if (plan.Load(entry.handle) == 0) TickCameras(plan, entry.cameras);
  }
}

std::int16_t IsSelection(host::EntityHandle entity) {
  HRGroup group;
  if (group.Read(GetCurrentDatabase(), entity) != 0) return 0;
  std::string className;
  return group.GetStringAttribute("@Class=", className) == 0 && className == kSelectionClass ? 1 : 0;
}

std::int16_t DeleteSelection(host::EntityHandle entity) {
  return qel_delete_group(GetCurrentDatabase(), entity) == host::kOk ? 0 : model_status::kNotDeleted;
}
