// A text entity: to the host a line entity that carries the text and its layout values in its
// attribute record ("t=", "tb=", "$p=", "$ts=", "$tw=").
#pragma once

#include <array>
#include <cstdint>
#include <string>

#include "model/hr_primitive.h"

class HRText : public HRPrimitive {
 public:
  static constexpr int kTextBlockSize = 11;

  HRText();

  using HRPrimitive::Create;
  using HRPrimitive::Delete;
  using HRPrimitive::Read;
  using HRPrimitive::Update;
  std::int16_t Read(host::DatabaseHandle database, host::EntityHandle entity) override;
  std::int16_t Update(host::DatabaseHandle database) override;
  std::int16_t Create(host::DatabaseHandle database) override;
  // Keeps the handle, unlike a line's delete.
  std::int16_t Delete(host::DatabaseHandle database) override;
  void Reserved() override;

  virtual void SetText(const std::string& text);
  virtual std::string GetText() const;
  // Both points of the record take the same position.
  virtual void SetPosition(const float position[3]);
  virtual void SetPosition(const double position[3]);
  virtual void SetPoints(double x1, double y1, double z1, double x2, double y2, double z2);
  // Element 6 of the text block, the justification.
  virtual void SetBlockValue6(std::int16_t value);
  virtual HRText AssignFrom(const HRPrimitive& primitive);
  // Takes the host's current text settings from the argument blocks.
  virtual void LoadTextDefaults();

 private:
  // Writes "tb=", "$p=", "$ts=" and "$tw=" on an open record; each result is ignored.
  void WriteLayoutValues(host::RecordHandle record) const;

  host::LineRecord line_{};
  std::string text_;
  std::array<float, kTextBlockSize> textBlock_{};
  float pValue_ = 0.0F;
  float twValue_ = 0.0F;
  float tsValue_ = 0.0F;
};
