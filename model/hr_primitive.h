// A wrapper around one host entity: its 18-byte header, its handle, the operations every
// wrapper shares and the family that reads and writes the entity's attribute record.
#pragma once

#include <cstdint>
#include <string>

#include "model/hr_object.h"
#include "shell/host/host_types.h"

class HRPrimitive : public HRObject {
 public:
  HRPrimitive(const HRPrimitive&) = default;
  HRPrimitive& operator=(const HRPrimitive&) = default;
  ~HRPrimitive() override;

  // The virtual operations keep this order; derived classes add theirs after Reserved.
  virtual host::EntityHandle GetEntity() const;
  virtual bool IsStored() const;
  virtual std::int16_t GetKind() const;
  virtual std::uint8_t GetHeaderByte8() const;
  virtual std::uint8_t GetHeaderByte9() const;
  virtual std::uint8_t GetFlags() const;
  virtual std::uint8_t GetEntityType() const;
  virtual std::int16_t Read(host::EntityHandle entity);
  virtual std::int16_t Read(host::DatabaseHandle database, host::EntityHandle entity);
  virtual std::int16_t Update();
  virtual std::int16_t Update(host::DatabaseHandle database);
  virtual std::int16_t Create();
  virtual std::int16_t Create(host::DatabaseHandle database);
  virtual std::int16_t Delete();
  virtual std::int16_t Delete(host::DatabaseHandle database);
  virtual std::int16_t Hide();
  virtual std::int16_t Show();
  // Has no behaviour in any class; it holds its place so that the operations after it keep
  // theirs.
  virtual void Reserved() = 0;

  // Points the wrapper at an entity without reading it.
  void SetEntity(host::EntityHandle entity) { entity_ = entity; }

  // The attribute family. Each call opens this entity's record in the current database, makes
  // one host call and closes the record again. The string and short readers and the string
  // writer end the name in exactly one "="; the others pass the name as given.
  std::int16_t SetStringAttribute(const std::string& name, const std::string& text) const;
  std::int16_t GetStringAttribute(const std::string& name, std::string& text) const;
  std::int16_t GetShortAttribute(const std::string& name, std::int16_t& value) const;
  std::int16_t SetShortAttribute(const std::string& name, std::int16_t value) const;
  std::int16_t SetLongVectorAttribute(const std::string& name, std::int32_t count, const std::int32_t* values) const;
  std::int16_t SetFloatVectorAttribute(const std::string& name, const float* values, std::int32_t count) const;
  // The readers hand back a host list the caller releases with log_free.
  std::int16_t ReadLongVectorAttribute(const std::string& name, std::int32_t* count, std::int32_t** hostValues) const;
  std::int16_t ReadFloatVectorAttribute(const std::string& name, std::int32_t* count, float** hostValues) const;
  std::int16_t RemoveAttribute(const std::string& name) const;

 protected:
  explicit HRPrimitive(std::string className = std::string());

  host::EntityHeader& Header() { return header_; }
  const host::EntityHeader& Header() const { return header_; }
  void SetHeaderByte(std::size_t index, std::uint8_t value) { header_.bytes[index] = value; }
  // Bytes 8 = 0, 9 = 1 and type 11, with which new lines, groups and placed objects start.
  void PresetNewHeader();
  // Reads the header into this object without taking the handle; true on success.
  bool ReadHeader(host::DatabaseHandle database, host::EntityHandle entity);
  // Takes header bytes 8, 9, 11 and the handle from another wrapper through its getters.
  void TakeIdentityOf(const HRPrimitive& other);
  // The class marker, written after a create.
  std::int16_t WriteClassMarker() const;

 private:
  std::int16_t ChangeVisibility(bool hidden);

  host::EntityHeader header_{};
  host::EntityHandle entity_ = 0;
};
