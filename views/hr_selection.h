// A named selection set: which general cameras, and which cameras of which sections and plans,
// are ticked for 2D. Kept on a group entity's record.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "model/hr_group.h"
#include "model/hr_object.h"

// One section or plan entry: the view's handle and its ticked camera indices, ascending.
struct SECPLN_NODE {
  host::EntityHandle handle = 0;
  std::vector<std::int32_t> cameras;
};

class HRSelection : public HRObject {
 public:
  HRSelection();
  ~HRSelection() override;

  void SetName(const std::string& name) { name_ = name; }
  std::string GetName() const { return name_; }
  void AddCamera(std::int32_t index) { cameras_.push_back(index); }
  void AddSection(host::EntityHandle section, const std::vector<std::int32_t>& cameras);
  void AddPlan(host::EntityHandle plan, const std::vector<std::int32_t>& cameras);
  std::int32_t GetCameraCount() const { return static_cast<std::int32_t>(cameras_.size()); }
  std::int32_t GetSectionCount() const { return static_cast<std::int32_t>(sections_.size()); }
  std::int32_t GetPlanCount() const { return static_cast<std::int32_t>(plans_.size()); }
  std::int32_t GetCamera(std::int32_t i) const;
  host::EntityHandle GetSectionHandle(std::int32_t i) const;
  host::EntityHandle GetPlanHandle(std::int32_t i) const;
  void GetSectionCameras(std::int32_t i, std::vector<std::int32_t>& cameras) const;
  void GetPlanCameras(std::int32_t i, std::vector<std::int32_t>& cameras) const;
  host::EntityHandle GetHandle() const { return group_.GetEntity(); }

  std::int16_t Create();
  std::int16_t Load(host::EntityHandle entity);
  void Apply() const;

 private:
  std::int16_t WriteEntries(const char* countKey, const char* keyPrefix, const std::vector<SECPLN_NODE>& entries);
  std::int16_t ReadEntries(const char* countKey, const char* keyPrefix, std::vector<SECPLN_NODE>& entries);

  HRGroup group_;
  std::vector<std::int32_t> cameras_;
  std::vector<SECPLN_NODE> sections_;
  std::vector<SECPLN_NODE> plans_;
  std::string name_;
};

// 1 when the entity is a selection set, else 0.
std::int16_t IsSelection(host::EntityHandle entity);
// 0, or -7 when the host does not delete the group.
std::int16_t DeleteSelection(host::EntityHandle entity);
