// Reading, writing and laying out text entities.
#include "model/hr_text.h"

#include "model/attribute_record.h"
#include "model/host_allocation.h"
#include "model/host_point.h"
#include "model/status_codes.h"
#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll.h"

namespace {

// Element 5 keeps a host value from 60 to 63 whatever the text; any other value gives way to
// 88 for a text with double-byte characters.
bool KeepsElement5(float value) { return value >= 60.0F && value <= 63.0F; }

constexpr float kDoubleByteElement5 = 88.0F;

}  // namespace

HRText::HRText() : HRPrimitive("HRText") { line_.lineType = static_cast<std::uint8_t>(-2); }

std::int16_t HRText::Read(host::DatabaseHandle database, host::EntityHandle entity) {
  if (HRPrimitive::Read(database, entity) != model_status::kSuccess) return model_status::kHeaderNotRead;
  if (GetEntityType() != host::kTypeLine) return model_status::kWrongEntity;
  if (qel_read_line(database, entity, &line_) != host::kOk) return model_status::kLineNotRead;
  AttributeRecord record(database, entity);
  if (!record.IsOpen()) return model_status::kLineNotRead;

  char* hostText = nullptr;
  const host::Status textResult = qel_read_string_attribute(record.Get(), "t=", &hostText);
  const HostAllocation<char> ownedText(hostText);
  if (textResult == host::kOk) text_ = CopyHostText(ownedText.get());
  qel_read_fixed_float_vector(record.Get(), "tb=", textBlock_.data(), kTextBlockSize);
  qel_read_float_attribute(record.Get(), "$p=", &pValue_);
  qel_read_float_attribute(record.Get(), "$ts=", &tsValue_);
  qel_read_float_attribute(record.Get(), "$tw=", &twValue_);
  return model_status::kSuccess;
}

std::int16_t HRText::Update(host::DatabaseHandle database) {
  HRPrimitive::Update(database);
  if (qel_update_line(database, GetEntity(), &line_) != host::kOk) return model_status::kTextNotWritten;
  {
    AttributeRecord record(database, GetEntity());
    if (!record.IsOpen()) return model_status::kRecordNotOpened;
    qel_set_string_attribute(record.Get(), "t=", text_.c_str());
    WriteLayoutValues(record.Get());
  }
  WriteClassMarker();
  return HRPrimitive::Read(database, GetEntity());
}

std::int16_t HRText::Create(host::DatabaseHandle database) {
  host::EntityHandle newEntity = 0;
  if (qel_add_text(database, &newEntity, &line_, "", text_.c_str(), 1) != host::kOk) {
    return model_status::kTextNotWritten;
  }
  SetEntity(newEntity);
  {
    AttributeRecord record(database, newEntity);
    if (!record.IsOpen()) return model_status::kRecordNotOpened;
    WriteLayoutValues(record.Get());
  }
  WriteClassMarker();
  return HRPrimitive::Read(database, newEntity);
}

std::int16_t HRText::Delete(host::DatabaseHandle database) {
  if (qel_delete_entity(database, GetEntity()) != host::kOk) return model_status::kEntityNotDeleted;
  write_to_record(GetEntity(), 2);
  return model_status::kSuccess;
}

void HRText::Reserved() {}

void HRText::WriteLayoutValues(host::RecordHandle record) const {
  qel_set_float_vector_attribute(record, "tb=", textBlock_.data(), kTextBlockSize, 4);
  qel_set_float_attribute(record, "$p=", pValue_, 0);
  qel_set_float_attribute(record, "$ts=", tsValue_, 0);
  qel_set_float_attribute(record, "$tw=", twValue_, 3);
}

void HRText::SetText(const std::string& text) { text_ = text; }

std::string HRText::GetText() const { return text_; }

void HRText::SetPosition(const float position[3]) {
  line_.start = {position[0], position[1], position[2]};
  line_.end = line_.start;
}

void HRText::SetPosition(const double position[3]) {
  line_.start = ToHostPoint(position[0], position[1], position[2]);
  line_.end = line_.start;
}

void HRText::SetPoints(double x1, double y1, double z1, double x2, double y2, double z2) {
  line_.start = ToHostPoint(x1, y1, z1);
  line_.end = ToHostPoint(x2, y2, z2);
}

void HRText::SetBlockValue6(std::int16_t value) { textBlock_[6] = static_cast<float>(value); }

HRText HRText::AssignFrom(const HRPrimitive& primitive) {
  if (const auto* text = dynamic_cast<const HRText*>(&primitive)) {
    line_ = text->line_;
    textBlock_ = text->textBlock_;
    pValue_ = text->pValue_;
    twValue_ = text->twValue_;
    tsValue_ = text->tsValue_;
    text_ = text->text_;
  }
  TakeIdentityOf(primitive);
  return *this;
}

void HRText::LoadTextDefaults() {
  textBlock_[0] = globc[89] == 'f' ? -globr[22] : globr[22];
  textBlock_[1] = 0.0F;
  textBlock_[2] = globr[23];
  textBlock_[3] = 0.0F;
  textBlock_[4] = 0.0F;
  if (KeepsElement5(globr[26])) {
    textBlock_[5] = globr[26];
  } else {
    textBlock_[5] = iskanji_string(text_.c_str()) != 0 ? kDoubleByteElement5 : globr[26];
  }
  textBlock_[6] = globr[24];
  textBlock_[7] = textBlock_[0] < 0.0F ? globr[20] : 1.0F;
  textBlock_[8] = 1.0F;
  textBlock_[9] = 2.0F;
  textBlock_[10] = globr[50];
  pValue_ = globr[57];
  twValue_ = globr[25];
  tsValue_ = globr[93];
}
