// An element placed from a library file; a section's two end symbols are two of them.
#pragma once

#include <cstdint>
#include <string>

#include "math/matrix.h"
#include "model/hr_primitive.h"

class HRPlacedObject : public HRPrimitive {
 public:
  HRPlacedObject();

  using HRPrimitive::Create;
  using HRPrimitive::Delete;
  using HRPrimitive::Read;
  using HRPrimitive::Update;
  std::int16_t Read(host::DatabaseHandle database, host::EntityHandle entity) override;
  std::int16_t Update(host::DatabaseHandle database) override;
  std::int16_t Create(host::DatabaseHandle database) override;
  std::int16_t Delete(host::DatabaseHandle database) override;
  void Reserved() override;

  virtual HRPlacedObject AssignFrom(const HRPrimitive& primitive);
  // A copy of `object` with its header, element record and handle, but no file or folder.
  virtual HRPlacedObject CopyOf(const HRPlacedObject& object) const;
  // Splits at the last backslash; the folder keeps exactly one backslash at its end.
  virtual void SetFile(const std::string& path);
  virtual void SetPlacement(const HRMath::Matrix& placement);

  std::string GetFullPath() const { return folder_ + fileName_; }
  const std::string& GetFileName() const { return fileName_; }
  const std::string& GetFolder() const { return folder_; }

  // Back to an unstored element without file, with the identity placement.
  void Reset();

 private:
  // The record's short name from the file name, never more than its 8 bytes.
  void TakeShortName();
  // "@lfname=", "URL=" and "@lib=" on an open record; false at the first failed write.
  bool WriteLibraryAttributes(host::RecordHandle record) const;
  // Writes the element's library attributes after the element itself has been written.
  std::int16_t WriteAttributesOf(host::DatabaseHandle database, host::EntityHandle entity) const;

  host::ElementRecord record_{};
  std::string fileName_;
  std::string folder_;
};
