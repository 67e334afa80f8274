// Sections: laying out the symbol in the section's own frame, and writing, reading and
// deleting its entities and record.
#include "views/hr_section.h"

#include "model/current_database.h"
#include "model/host_point.h"
#include "model/status_codes.h"
#include "shell/host/qeldll.h"

namespace {

constexpr const char* kSectionClass = "HRSection";
constexpr std::int16_t kRightJustified = 2;

// The point to the left of the cut line, seen from above walking from start to end, at the
// line's plan length from start: start + Z x (end - start).
void SidePoint(const double start[3], const double end[3], double side[3]) {
  side[0] = start[0] - (end[1] - start[1]);
  side[1] = start[1] + (end[0] - start[0]);
  side[2] = start[2];
}

// Writes a string attribute under the name exactly as given (the end marks' role key has no
// trailing "=").
void WriteExactString(const HRPrimitive& entity, const char* name, const char* text) {
  const host::DatabaseHandle database = GetCurrentDatabase();
  std::int16_t status = 0;
  const host::RecordHandle record = qel_open_attribute_record(database, entity.GetEntity(), &status);
  if (status != host::kOk) return;
  qel_set_string_attribute(record, name, text);
  qel_close_attribute_record(database, record);
}

}  // namespace

HRSection::HRSection() : HRObject(kSectionClass) { instance_.SetClassName(kSectionClass); }

HRSection::~HRSection() = default;

void HRSection::BuildFromFloats(const std::string& name, const std::string& symbolFile, const float start[3],
                                const float end[3]) {
  const double wideStart[3] = {start[0], start[1], start[2]};
  const double wideEnd[3] = {end[0], end[1], end[2]};
  Build(name, symbolFile, wideStart, wideEnd);
}

void HRSection::BuildFromPoints(const std::string& name, const std::string& symbolFile, const HRPoint& start,
                                const HRPoint& end) {
  double wideStart[3];
  double wideEnd[3];
  start.GetPosition().CopyTo(wideStart);
  end.GetPosition().CopyTo(wideEnd);
  Build(name, symbolFile, wideStart, wideEnd);
}

void HRSection::LayOut(const double start[3], const double end[3]) {
  const host::Point3f from = ToHostPoint(start);
  const host::Point3f to = ToHostPoint(end);
  const double length = distance_3d(&from, &to);
  double side[3];
  SidePoint(start, end, side);

  line_.SetPoints(0.0, 0.0, 0.0, length, 0.0, 0.0);
  startMark_.SetPlacement(HRMath::Matrix());
  HRMath::Matrix mirror;
  mirror.SetMirror(1, 0, 0);
  HRMath::Matrix shift;
  shift.SetTranslation(length, 0.0, 0.0);
  endMark_.SetPlacement(mirror.Multiply(shift));

  const double frame[9] = {start[0], start[1], start[2], end[0], end[1], end[2], side[0], side[1], side[2]};
  HRMath::Matrix placement;
  placement.SetView(frame);
  instance_.SetPlacement(placement);

  const double offset = labelOffset_;
  startLabel_.SetPoints(offset, 0.0, 0.0, offset + 1.0, 0.0, 0.0);
  endLabel_.SetPoints(length - offset, 0.0, 0.0, length - offset + 1.0, 0.0, 0.0);
}

void HRSection::Build(const std::string& name, const std::string& symbolFile, const double start[3],
                      const double end[3]) {
  startMark_.SetFile(symbolFile);
  endMark_.SetFile(symbolFile);
  instance_.SetClassName(kSectionClass);
  startLabel_.SetText(name);
  endLabel_.SetText(name);
  LayOut(start, end);
}

void HRSection::Move(const double start[3], const double end[3]) {
  LayOut(start, end);
  line_.Update();
  startMark_.Update();
  endMark_.Update();
  instance_.Update();
  startLabel_.Update();
  endLabel_.Update();
}

host::EntityHandle HRSection::GetHandle() const { return instance_.GetEntity(); }

std::int16_t HRSection::Create() { return CreateIn(GetCurrentDatabase()); }

std::int16_t HRSection::Unused(std::int32_t /*argument*/) { return 0; }

void HRSection::WriteMarkRoles() const {
  WriteExactString(startMark_, "@dim_typ", "start");
  WriteExactString(endMark_, "@dim_typ", "end");
}

std::int16_t HRSection::CreateIn(host::DatabaseHandle database) {
  startLabel_.LoadTextDefaults();
  endLabel_.LoadTextDefaults();
  endLabel_.SetBlockValue6(kRightJustified);

  block_.Create(database);
  block_.AddMember(database, line_);
  block_.AddMember(database, startMark_);
  block_.AddMember(database, endMark_);
  block_.AddMember(database, startLabel_);
  block_.AddMember(database, endLabel_);
  write_to_record(block_.GetEntity(), 1);
  WriteMarkRoles();

  instance_.SetBlock(block_);
  instance_.Create(database);
  instance_.SetStringAttribute("@sec=", "0");
  instance_.SetShortAttribute("@S2D=", static_cast<std::int16_t>(for2D_));
  instance_.SetStringAttribute("@type=", std::string(1, cutType_));
  cameras_.WriteList(instance_, false);
  write_to_record(instance_.GetEntity(), 1);
  write_to_record(-1, -1);
  return 0;
}

std::int16_t HRSection::SaveTo(host::DatabaseHandle database) {
  endLabel_.SetBlockValue6(kRightJustified);
  block_.Update(database);
  line_.Update(database);
  startMark_.Update(database);
  endMark_.Update(database);
  startLabel_.Update();
  endLabel_.Update();
  WriteMarkRoles();
  instance_.SetBlock(block_);
  cameras_.WriteList(instance_, true);
  // Any "selected" value is stored as 1; only creation keeps the value as given.
  instance_.SetShortAttribute("@S2D=", for2D_ != 0 ? 1 : 0);
  instance_.SetStringAttribute("@type=", std::string(1, cutType_));
  instance_.Update(database);
  for (const HRPrimitive* entity : std::initializer_list<const HRPrimitive*>{
           &block_, &line_, &startMark_, &endMark_, &startLabel_, &endLabel_, &instance_}) {
    write_to_record(entity->GetEntity(), 5);
  }
  write_to_record(-1, -1);
  return 0;
}

std::int16_t HRSection::LoadFrom(host::DatabaseHandle database, host::EntityHandle entity) {
  if (const std::int16_t result = instance_.Read(database, entity); result != 0) return result;
  if (const std::int16_t result = block_.Read(database, instance_.GetBlock()); result != 0) return result;
  // A damaged member loads as an empty one; a block with fewer members leaves the rest unread.
  line_.Read(database, block_.GetMember(0));
  startMark_.Read(database, block_.GetMember(1));
  endMark_.Read(database, block_.GetMember(2));
  startLabel_.Read(database, block_.GetMember(3));
  endLabel_.Read(database, block_.GetMember(4));

  cameras_.ReadList(instance_);
  std::int16_t for2D = 0;
  instance_.GetShortAttribute("@S2D=", for2D);
  for2D_ = static_cast<std::uint16_t>(for2D);

  std::string type;
  instance_.GetStringAttribute("@type=", type);
  cutType_ = type.empty() ? '\0' : type.front();
  return 0;
}

std::int16_t HRSection::Load(host::EntityHandle entity) { return LoadFrom(GetCurrentDatabase(), entity); }

std::int16_t HRSection::Save() { return SaveTo(GetCurrentDatabase()); }

std::int16_t HRSection::Delete() {
  instance_.Delete();
  block_.DeleteAllMembers();
  block_.Delete();
  cameras_.DeleteAll(GetCurrentDatabase());
  return 0;
}

void HRSection::SetCutType(char cutType) { cutType_ = cutType; }
std::string HRSection::GetName() const { return startLabel_.GetText(); }
void HRSection::SetFor2D(std::int16_t for2D) { for2D_ = static_cast<std::uint16_t>(for2D); }
std::uint16_t HRSection::IsFor2D() const { return for2D_; }

void HRSection::SetName(const std::string& name) {
  startLabel_.SetText(name);
  endLabel_.SetText(name);
}

std::int16_t HRSection::HideSymbol() { return instance_.Hide(); }
std::int16_t HRSection::ShowSymbol() { return instance_.Show(); }

void HRSection::CutLine(HRMath::Vector& start, HRMath::Vector& end) const {
  const HRMath::Matrix placement = instance_.GetPlacement();
  start = line_.GetStart().Transform(placement);
  end = line_.GetEnd().Transform(placement);
}

void HRSection::GetSettings(SectionSettings& settings) const {
  HRMath::Vector start;
  HRMath::Vector end;
  CutLine(start, end);
  start.CopyTo(settings.start);
  end.CopyTo(settings.end);
  settings.symbolFile = startMark_.GetFullPath();
  settings.comment.clear();
  settings.lineType = line_.GetLineType();
  settings.lineWidth = line_.GetWidth();
  settings.lineColor = line_.GetColor();
  settings.cutType = cutType_;
}

void HRSection::SetSettings(const SectionSettings& settings) {
  const double start[3] = {settings.start[0], settings.start[1], settings.start[2]};
  const double end[3] = {settings.end[0], settings.end[1], settings.end[2]};
  Build(startLabel_.GetText(), settings.symbolFile, start, end);
  line_.SetLineType(settings.lineType);
  line_.SetColor(settings.lineColor);
  line_.SetWidth(settings.lineWidth);
  startMark_.SetFile(settings.symbolFile);
  endMark_.SetFile(settings.symbolFile);
  cutType_ = settings.cutType;
}
