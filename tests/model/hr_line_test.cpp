// Line wrappers: presets, create, read, update and delete against the host, and copying.
#include "model/hr_line.h"

#include "model/hr_group.h"
#include "model/hr_point.h"
#include "tests/model/model_fixture.h"

namespace {

class LineTest : public ModelTest {
 protected:
  static host::LineRecord HostLine(host::EntityHandle entity) { return wb::ReadRecord<host::LineRecord>(*Find(entity)); }

  // A line entity put straight into the drawing.
  static host::EntityHandle AddLineEntity(const host::LineRecord& record) {
    const host::EntityHandle entity = AddEntity(host::kTypeLine);
    wb::WriteRecord(*Find(entity), record);
    return entity;
  }

  static HRLine SampleLine() {
    HRLine line;
    line.SetPoints(1, 2, 3, 4, 5, 6);
    line.SetLineType(3);
    line.SetColor(5);
    line.SetWidth(2);
    return line;
  }
};

void ExpectPoint(const host::Point3f& point, float x, float y, float z) {
  EXPECT_EQ(point.x, x);
  EXPECT_EQ(point.y, y);
  EXPECT_EQ(point.z, z);
}

TEST_F(LineTest, NewLineHasItsPresets) {
  const HRLine line;
  EXPECT_EQ(line.GetClassName(), "HRLine");
  EXPECT_EQ(line.GetEntity(), 0);
  EXPECT_EQ(line.GetHeaderByte8(), 0);
  EXPECT_EQ(line.GetHeaderByte9(), 1);
  EXPECT_EQ(line.GetEntityType(), 11);
  EXPECT_EQ(line.GetLineType(), 1);
  EXPECT_EQ(line.GetColor(), 1);
  EXPECT_EQ(line.GetWidth(), 1);
  EXPECT_EQ(line.GetStart().Length(), 0.0);
  EXPECT_EQ(line.GetEnd().Length(), 0.0);
}

TEST_F(LineTest, SettersKeepTheLowEightBits) {
  HRLine line;
  line.SetColor(300);
  line.SetLineType(0x1FF);
  line.SetWidth(258);
  EXPECT_EQ(line.GetColor(), 44);
  EXPECT_EQ(line.GetLineType(), 255);
  EXPECT_EQ(line.GetWidth(), 2);
}

TEST_F(LineTest, PointsAreNarrowedToFloats) {
  HRLine line;
  line.SetPoints(0.1, 2, 3, 4, 5, 6.000000001);
  EXPECT_EQ(line.GetStart().x, static_cast<double>(0.1F));
  EXPECT_EQ(line.GetEnd().z, 6.0);

  line.SetPoints(HRPoint(7, 8, 9), HRPoint(-1, -2, -3));
  EXPECT_EQ(line.GetStart().y, 8.0);
  EXPECT_EQ(line.GetEnd().x, -1.0);
}

TEST_F(LineTest, CreateAddsTheLineMarksItAndReadsTheHeaderBack) {
  HRLine line = SampleLine();
  EXPECT_EQ(line.Create(), 0);
  const host::EntityHandle entity = line.GetEntity();
  ASSERT_TRUE(line.IsStored());
  const host::LineRecord stored = HostLine(entity);
  EXPECT_EQ(stored.lineType, 3);
  EXPECT_EQ(stored.color, 5);
  EXPECT_EQ(stored.width, 2);
  ExpectPoint(stored.start, 1, 2, 3);
  ExpectPoint(stored.end, 4, 5, 6);
  EXPECT_EQ(StringAttribute(entity, "@Class="), "HRLine");
  EXPECT_EQ(line.GetEntityType(), host::kTypeLine);
  EXPECT_EQ(line.GetKind(), 2);
  EXPECT_EQ(HostCalls(), (std::vector<std::string>{"qel_add_line"}));
}

TEST_F(LineTest, CreateMarksTheEntityWithTheClassNameHeldAtThatMoment) {
  HRLine line;
  line.SetClassName("hrCutLine");
  ASSERT_EQ(line.Create(), 0);
  EXPECT_EQ(StringAttribute(line.GetEntity(), "@Class="), "hrCutLine");
}

TEST_F(LineTest, ReadTakesHeaderAndRecord) {
  const host::EntityHandle entity = AddLineEntity({7, 8, 9, 0, {1, 1, 1}, {2, 2, 2}});
  Find(entity)->header.bytes[8] = 4;
  HRLine line;
  EXPECT_EQ(line.Read(entity), 0);
  EXPECT_EQ(line.GetEntity(), entity);
  EXPECT_EQ(line.GetHeaderByte8(), 4);
  EXPECT_EQ(line.GetEntityType(), host::kTypeLine);
  EXPECT_EQ(line.GetLineType(), 7);
  EXPECT_EQ(line.GetColor(), 8);
  EXPECT_EQ(line.GetWidth(), 9);
  EXPECT_EQ(line.GetEnd().y, 2.0);
}

TEST_F(LineTest, UpdateWritesHeaderAndRecord) {
  HRLine line = SampleLine();
  ASSERT_EQ(line.Create(), 0);
  line.SetColor(77);
  line.SetPoints(0, 0, 0, 10, 0, 0);
  line.Hide();
  Find(line.GetEntity())->header.bytes[10] = 0;
  EXPECT_EQ(line.Update(), 0);
  EXPECT_EQ(HostLine(line.GetEntity()).color, 77);
  ExpectPoint(HostLine(line.GetEntity()).end, 10, 0, 0);
  EXPECT_EQ(Find(line.GetEntity())->header.bytes[10], host::kFlagHidden);
}

TEST_F(LineTest, DeleteRemovesTheEntityRecordsItAndClearsTheHandle) {
  HRLine line = SampleLine();
  ASSERT_EQ(line.Create(), 0);
  const host::EntityHandle entity = line.GetEntity();
  EXPECT_EQ(line.Delete(), 0);
  EXPECT_FALSE(line.IsStored());
  EXPECT_EQ(Find(entity), nullptr);
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{entity, 2}}));
}

TEST_F(LineTest, FailuresGiveTheirCodes) {
  HRLine line;
  EXPECT_EQ(line.Read(99), -2);

  FailNext("qel_add_line");
  EXPECT_EQ(line.Create(), -18);
  EXPECT_FALSE(line.IsStored());
  EXPECT_EQ(Drawing().LiveCount(), 0U);

  ASSERT_EQ(line.Create(), 0);
  const host::EntityHandle entity = line.GetEntity();
  FailNext("qel_read_line");
  EXPECT_EQ(line.Read(entity), -17);

  line.SetColor(9);
  FailNext("qel_update_entity_header");
  EXPECT_EQ(line.Update(), -3);
  EXPECT_EQ(HostLine(entity).color, 1);
  FailNext("qel_update_line");
  EXPECT_EQ(line.Update(), -19);
  EXPECT_EQ(HostLine(entity).color, 1);

  FailNext("qel_delete_entity");
  EXPECT_EQ(line.Delete(), -20);
  EXPECT_EQ(line.GetEntity(), entity);
  EXPECT_NE(Find(entity), nullptr);
  EXPECT_TRUE(ChangeRecords().empty());
}

TEST_F(LineTest, ReadingAnEntityWithoutALineRecordGivesMinus17) {
  HRLine line;
  EXPECT_EQ(line.Read(AddEntity(host::kTypePoint)), -17);
}

TEST_F(LineTest, CreateReportsAHeaderThatCannotBeReadBack) {
  HRLine line;
  FailNext("qel_read_entity_header");
  EXPECT_EQ(line.Create(), -2);
  EXPECT_EQ(StringAttribute(1, "@Class="), "HRLine");
}

TEST_F(LineTest, AssignFromTakesTheRecordOnlyFromLines) {
  HRLine source = SampleLine();
  ASSERT_EQ(source.Create(), 0);
  HRLine target;
  const HRLine returned = target.AssignFrom(source);
  for (const HRLine* line : {static_cast<const HRLine*>(&target), &returned}) {
    EXPECT_EQ(line->GetEntity(), source.GetEntity());
    EXPECT_EQ(line->GetEntityType(), host::kTypeLine);
    EXPECT_EQ(line->GetColor(), 5);
    EXPECT_EQ(line->GetStart().z, 3.0);
  }

  HRGroup group;
  ASSERT_EQ(group.Create(), 0);
  target.AssignFrom(group);
  EXPECT_EQ(target.GetEntity(), group.GetEntity());
  EXPECT_EQ(target.GetEntityType(), host::kTypeGroup);
  EXPECT_EQ(target.GetColor(), 5);
}

TEST_F(LineTest, AssignmentTakesIdentityAndRecord) {
  HRLine source = SampleLine();
  ASSERT_EQ(source.Create(), 0);
  HRLine target;
  target.SetClassName("kept");
  HRLine returned = (target = source);
  EXPECT_EQ(target.GetEntity(), source.GetEntity());
  EXPECT_EQ(target.GetEntityType(), host::kTypeLine);
  EXPECT_EQ(target.GetWidth(), 2);
  EXPECT_EQ(target.GetClassName(), "kept");
  returned.SetColor(99);
  EXPECT_EQ(target.GetColor(), 5);
}

}  // namespace
