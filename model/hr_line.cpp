// Reading, writing and editing line entities.
#include "model/hr_line.h"

#include "model/host_point.h"
#include "model/hr_point.h"
#include "model/status_codes.h"
#include "shell/host/qeldll.h"

namespace {

std::uint8_t LowByte(std::uint16_t value) { return static_cast<std::uint8_t>(value & 0xFFU); }

}  // namespace

HRLine::HRLine() : HRPrimitive("HRLine") {
  PresetNewHeader();
  line_.lineType = 1;
  line_.color = 1;
  line_.width = 1;
}

HRLine::HRLine(const HRLine& other) = default;

HRLine::~HRLine() = default;

std::int16_t HRLine::Read(host::DatabaseHandle database, host::EntityHandle entity) {
  const std::int16_t result = HRPrimitive::Read(database, entity);
  if (result != model_status::kSuccess) return result;
  return qel_read_line(database, entity, &line_) == host::kOk ? model_status::kSuccess : model_status::kLineNotRead;
}

std::int16_t HRLine::Update(host::DatabaseHandle database) {
  const std::int16_t result = HRPrimitive::Update(database);
  if (result != model_status::kSuccess) return result;
  return qel_update_line(database, GetEntity(), &line_) == host::kOk ? model_status::kSuccess
                                                                     : model_status::kLineNotUpdated;
}

std::int16_t HRLine::Create(host::DatabaseHandle database) {
  host::EntityHandle newEntity = 0;
  if (qel_add_line(database, &newEntity, &line_) != host::kOk) return model_status::kLineNotAdded;
  SetEntity(newEntity);
  WriteClassMarker();
  // The header comes back from the host, so the type and kind are those of the new entity.
  return HRPrimitive::Read(database, newEntity);
}

std::int16_t HRLine::Delete(host::DatabaseHandle database) {
  const host::EntityHandle entity = GetEntity();
  if (qel_delete_entity(database, entity) != host::kOk) return model_status::kEntityNotDeleted;
  write_to_record(entity, 2);
  return HRPrimitive::Delete(database);
}

void HRLine::Reserved() {}

void HRLine::SetPoints(const HRPoint& start, const HRPoint& end) {
  line_.start = ToHostPoint(start.GetPosition());
  line_.end = ToHostPoint(end.GetPosition());
}

void HRLine::SetPoints(double x1, double y1, double z1, double x2, double y2, double z2) {
  line_.start = ToHostPoint(x1, y1, z1);
  line_.end = ToHostPoint(x2, y2, z2);
}

HRMath::Vector HRLine::GetStart() const { return ToVector(line_.start); }

HRMath::Vector HRLine::GetEnd() const { return ToVector(line_.end); }

HRLine HRLine::AssignFrom(const HRPrimitive& primitive) {
  if (const auto* line = dynamic_cast<const HRLine*>(&primitive)) line_ = line->line_;
  TakeIdentityOf(primitive);
  return *this;
}

HRLine HRLine::operator=(const HRLine& other) {
  TakeIdentityOf(other);
  line_ = other.line_;
  return *this;
}

std::uint8_t HRLine::GetLineType() const { return line_.lineType; }

std::uint8_t HRLine::GetWidth() const { return line_.width; }

std::uint8_t HRLine::GetColor() const { return line_.color; }

void HRLine::SetLineType(std::uint16_t value) { line_.lineType = LowByte(value); }

void HRLine::SetWidth(std::uint16_t value) { line_.width = LowByte(value); }

void HRLine::SetColor(std::uint16_t value) { line_.color = LowByte(value); }
