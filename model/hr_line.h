// A straight segment of the drawing with line type, colour and width.
#pragma once

#include <cstdint>

#include "math/vector.h"
#include "model/hr_primitive.h"

class HRPoint;

class HRLine : public HRPrimitive {
 public:
  HRLine();
  HRLine(const HRLine& other);
  ~HRLine() override;

  using HRPrimitive::Create;
  using HRPrimitive::Delete;
  using HRPrimitive::Read;
  using HRPrimitive::Update;
  std::int16_t Read(host::DatabaseHandle database, host::EntityHandle entity) override;
  std::int16_t Update(host::DatabaseHandle database) override;
  std::int16_t Create(host::DatabaseHandle database) override;
  std::int16_t Delete(host::DatabaseHandle database) override;
  void Reserved() override;

  virtual void SetPoints(const HRPoint& start, const HRPoint& end);
  virtual void SetPoints(double x1, double y1, double z1, double x2, double y2, double z2);
  virtual HRMath::Vector GetStart() const;
  virtual HRMath::Vector GetEnd() const;
  // Takes the line record only from another line; header bytes 8, 9, 11 and the handle from
  // any wrapper.
  virtual HRLine AssignFrom(const HRPrimitive& primitive);
  virtual HRLine operator=(const HRLine& other);
  virtual std::uint8_t GetLineType() const;
  virtual std::uint8_t GetWidth() const;
  virtual std::uint8_t GetColor() const;
  // Each setter keeps the low 8 bits: the record holds one byte per value.
  virtual void SetLineType(std::uint16_t value);
  virtual void SetWidth(std::uint16_t value);
  virtual void SetColor(std::uint16_t value);

 private:
  host::LineRecord line_{};
};
