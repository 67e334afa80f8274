// The cameras a section or plan owns: camera entities of the owner's own camera class, listed
// by handle under one key of the owner's record. The list on the record follows every addition
// and removal at once, without a save of the owner.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "model/hr_primitive.h"
#include "shell/host/host_types.h"
#include "views/hr_camera.h"

class OwnedCameras {
 public:
  OwnedCameras(const char* cameraClass, const char* listKey) : cameraClass_(cameraClass), listKey_(listKey) {}

  const std::vector<host::EntityHandle>& Handles() const { return handles_; }
  std::int16_t Count() const { return static_cast<std::int16_t>(handles_.size()); }
  // The handle at the index; 0, which no camera has, outside the list.
  host::EntityHandle HandleAt(std::int32_t index) const;

  // Replaces the list with the one stored on the owner's record; absent or unreadable gives none.
  void ReadList(const HRPrimitive& owner);
  // Stores the list on the owner's record; an empty list removes the key when asked to.
  void WriteList(const HRPrimitive& owner, bool removeWhenEmpty) const;

  // Captures the current view as a new camera; its index, or 0 when it could not be made.
  std::int32_t Add(const HRPrimitive& owner, const std::string& name);
  // Drops the entry whatever happens; deletes the camera entity only when it loads. Answers the
  // load or delete result.
  std::int16_t Remove(const HRPrimitive& owner, std::int32_t index);
  // Deletes every camera entity (results ignored) and empties the list.
  void DeleteAll(host::DatabaseHandle database);

  std::int16_t Load(std::int32_t index, HRCamera& camera) const { return camera.Load(HandleAt(index)); }
  // Saves the camera onto the entity at the index, whatever handle it held.
  std::int16_t Save(std::int32_t index, HRCamera& camera) const;
  // The camera's name, or empty when it does not load.
  std::string NameAt(std::int32_t index) const;
  // The camera's 2D flag, or 0 when it does not load.
  std::uint16_t IsFor2D(std::int32_t index) const;
  // These load, change one value and save; a camera that does not load is left alone.
  void Rename(std::int32_t index, const std::string& name) const;
  void SetFor2D(std::int32_t index, std::int16_t for2D) const;

 private:
  const char* cameraClass_;
  const char* listKey_;
  std::vector<host::EntityHandle> handles_;
};
