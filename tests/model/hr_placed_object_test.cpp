// Library elements: file and folder handling, the element record and the library attributes.
#include "model/hr_placed_object.h"

#include <cstring>

#include "model/hr_line.h"
#include "tests/model/model_fixture.h"

namespace {

class PlacedObjectTest : public ModelTest {
 protected:
  static host::ElementRecord HostRecord(host::EntityHandle entity) {
    return wb::ReadRecord<host::ElementRecord>(*Find(entity));
  }
  static std::string ShortNameOf(const host::ElementRecord& record) {
    return std::string(record.shortName, strnlen(record.shortName, sizeof record.shortName));
  }
  static HRPlacedObject SampleObject() {
    HRPlacedObject object;
    object.SetFile("C:\\Lib\\sec_sym\\sec01.sym");
    HRMath::Matrix shift;
    shift.SetTranslation(10, 0, 0);
    object.SetPlacement(shift);
    return object;
  }
};

TEST_F(PlacedObjectTest, SetFileSplitsAtTheLastBackslash) {
  HRPlacedObject object;
  object.SetFile("C:\\sym\\sec01.sym");
  EXPECT_EQ(object.GetFolder(), "C:\\sym\\");
  EXPECT_EQ(object.GetFileName(), "sec01.sym");
  EXPECT_EQ(object.GetFullPath(), "C:\\sym\\sec01.sym");

  object.SetFile("C:\\sym\\\\\\sec01");
  EXPECT_EQ(object.GetFolder(), "C:\\sym\\");
  EXPECT_EQ(object.GetFileName(), "sec01");

  object.SetFile("C:\\sym\\");
  EXPECT_EQ(object.GetFolder(), "C:\\sym\\");
  EXPECT_EQ(object.GetFileName(), "");
}

TEST_F(PlacedObjectTest, SetFileWithoutAFolderKeepsTheNameAsItIs) {
  HRPlacedObject object;
  object.SetFile("C:\\old\\x");
  object.SetFile("sec01.sym");
  EXPECT_EQ(object.GetFolder(), "");
  EXPECT_EQ(object.GetFileName(), "sec01.sym");
  EXPECT_EQ(object.GetFullPath(), "sec01.sym");
}

TEST_F(PlacedObjectTest, ResetStateIsAnUnstoredElementWithoutFile) {
  const HRPlacedObject object;
  EXPECT_EQ(object.GetClassName(), "HRPlacedObject");
  EXPECT_EQ(object.GetFullPath(), "");
  EXPECT_EQ(object.GetHeaderByte9(), 1);
  EXPECT_EQ(object.GetEntityType(), 11);
  EXPECT_FALSE(object.IsStored());
}

TEST_F(PlacedObjectTest, CreateWritesRecordAndLibraryAttributesThenMarks) {
  HRPlacedObject object = SampleObject();
  EXPECT_EQ(object.Create(), 0);
  const host::EntityHandle entity = object.GetEntity();
  ASSERT_GT(entity, 0);
  EXPECT_EQ(Find(entity)->Type(), host::kTypeElement);
  const host::ElementRecord stored = HostRecord(entity);
  EXPECT_EQ(ShortNameOf(stored), "sec01");
  EXPECT_EQ(stored.placement[12], 10.0F);
  EXPECT_EQ(stored.placement[0], 1.0F);
  EXPECT_EQ(StringAttribute(entity, "@lfname="), "sec01.sym");
  EXPECT_EQ(StringAttribute(entity, "URL="), "C:\\Lib\\sec_sym\\");
  EXPECT_EQ(StringAttribute(entity, "@lib="), "C:\\Lib\\sec_sym\\");
  EXPECT_EQ(StringAttribute(entity, "@Class="), "HRPlacedObject");
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"@lfname=", "URL=", "@lib=", "@Class="}));
}

TEST_F(PlacedObjectTest, ALongShortNameNeverOverrunsItsEightBytes) {
  HRPlacedObject object;
  object.SetFile("C:\\Lib\\averylongsymbolname.sym");
  // Every byte of the element right after the field is non-zero, so a stray terminator shows.
  double placement[16] = {};
  for (double& element : placement) element = 1.1;
  object.SetPlacement(HRMath::Matrix(placement));
  ASSERT_EQ(object.Create(), 0);
  const host::ElementRecord stored = HostRecord(object.GetEntity());
  EXPECT_EQ(std::string(stored.shortName, 8), "averylon");
  EXPECT_EQ(stored.placement[0], 1.1F);

  // A host that gives no short name leaves the field empty.
  FailNext("qel_get_short_name");
  ASSERT_EQ(object.Update(), 0);
  EXPECT_EQ(ShortNameOf(HostRecord(object.GetEntity())), "");
}

TEST_F(PlacedObjectTest, ReadTakesFileAndFolderBack) {
  HRPlacedObject created = SampleObject();
  ASSERT_EQ(created.Create(), 0);
  HRPlacedObject object;
  EXPECT_EQ(object.Read(created.GetEntity()), 0);
  EXPECT_EQ(object.GetEntity(), created.GetEntity());
  EXPECT_EQ(object.GetFullPath(), "C:\\Lib\\sec_sym\\sec01.sym");
  EXPECT_EQ(object.GetFolder(), "C:\\Lib\\sec_sym\\");
}

TEST_F(PlacedObjectTest, ReadSurvivesAHostWithoutFolderOrName) {
  HRPlacedObject created = SampleObject();
  ASSERT_EQ(created.Create(), 0);
  FailNext("qel_get_config_path");
  FailNext("qel_get_element_name");
  HRPlacedObject object;
  object.SetFile("C:\\before\\x.sym");
  EXPECT_EQ(object.Read(created.GetEntity()), 0);
  EXPECT_EQ(object.GetFullPath(), "");
}

TEST_F(PlacedObjectTest, AForeignElementIsNamedAfterItsFullEightCharacterShortName) {
  // An element placed by someone else has no library attributes; the host then names it after
  // the short name it is handed, which here fills all eight bytes without a terminator.
  const host::EntityHandle entity = AddEntity(host::kTypeElement);
  host::ElementRecord record{};
  std::memcpy(record.shortName, "ABCDEFGH", 8);
  record.placement[0] = 99.0F;
  wb::WriteRecord(*Find(entity), record);
  HRPlacedObject object;
  EXPECT_EQ(object.Read(entity), 0);
  EXPECT_EQ(object.GetFileName(), "ABCDEFGH");
}

TEST_F(PlacedObjectTest, UpdateRewritesRecordAndAttributes) {
  HRPlacedObject object = SampleObject();
  ASSERT_EQ(object.Create(), 0);
  object.SetFile("D:\\other\\sec02.sym");
  ClearJournal();
  EXPECT_EQ(object.Update(), 0);
  EXPECT_EQ(ShortNameOf(HostRecord(object.GetEntity())), "sec02");
  EXPECT_EQ(StringAttribute(object.GetEntity(), "@lfname="), "sec02.sym");
  EXPECT_EQ(StringAttribute(object.GetEntity(), "@lib="), "D:\\other\\");
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"@lfname=", "URL=", "@lib="}));
}

TEST_F(PlacedObjectTest, FileNameWritesFailOnlyOnZeroFolderWritesOnAnythingButOne) {
  HRPlacedObject object = SampleObject();
  ASSERT_EQ(object.Create(), 0);
  FailAttribute("qel_set_string_attribute", "@lfname=", 2);
  EXPECT_EQ(object.Update(), 0);
  FailAttribute("qel_set_string_attribute", "@lfname=", 0);
  EXPECT_EQ(object.Update(), -10);
  FailAttribute("qel_set_string_attribute", "URL=", 2);
  EXPECT_EQ(object.Update(), -10);
  FailAttribute("qel_set_string_attribute", "@lib=", -205);
  EXPECT_EQ(object.Update(), -10);
}

TEST_F(PlacedObjectTest, ReadFailuresGiveTheirCodes) {
  HRPlacedObject object;
  EXPECT_EQ(object.Read(404), -2);
  HRLine line;
  ASSERT_EQ(line.Create(), 0);
  EXPECT_EQ(object.Read(line.GetEntity()), -4);
  HRPlacedObject created = SampleObject();
  ASSERT_EQ(created.Create(), 0);
  FailNext("qel_read_element");
  EXPECT_EQ(object.Read(created.GetEntity()), -4);
  EXPECT_FALSE(object.IsStored());
}

TEST_F(PlacedObjectTest, WriteFailuresGiveTheirCodes) {
  HRPlacedObject object = SampleObject();
  FailNext("qel_add_element");
  EXPECT_EQ(object.Create(), -14);
  EXPECT_EQ(Drawing().LiveCount(), 0U);
  FailNext("qel_open_attribute_record");
  EXPECT_EQ(object.Create(), -14);
  EXPECT_FALSE(object.IsStored());
  FailAttribute("qel_set_string_attribute", "URL=");
  EXPECT_EQ(object.Create(), -10);
  EXPECT_FALSE(object.IsStored());
  EXPECT_EQ(Bench().Records().OpenCount(), 0U);

  ASSERT_EQ(object.Create(), 0);
  FailNext("qel_update_element");
  EXPECT_EQ(object.Update(), -14);
  FailNext("qel_open_attribute_record");
  EXPECT_EQ(object.Update(), -14);
}

TEST_F(PlacedObjectTest, DeleteRemovesTheElementAndResets) {
  HRPlacedObject object = SampleObject();
  ASSERT_EQ(object.Create(), 0);
  const host::EntityHandle entity = object.GetEntity();
  FailNext("qel_delete_entity");
  EXPECT_EQ(object.Delete(), -16);
  EXPECT_EQ(object.GetEntity(), entity);
  EXPECT_EQ(object.GetFileName(), "sec01.sym");
  EXPECT_TRUE(ChangeRecords().empty());

  EXPECT_EQ(object.Delete(), 0);
  EXPECT_FALSE(object.IsStored());
  EXPECT_EQ(object.GetFullPath(), "");
  EXPECT_EQ(Find(entity), nullptr);
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{entity, 2}}));
}

TEST_F(PlacedObjectTest, AssignFromTakesFileFolderValuesAndPlacementButNotTheShortName) {
  HRPlacedObject created = SampleObject();
  ASSERT_EQ(created.Create(), 0);
  HRPlacedObject source;
  ASSERT_EQ(source.Read(created.GetEntity()), 0);
  HRPlacedObject target;
  target.SetFile("x\\old.sym");
  const HRPlacedObject returned = target.AssignFrom(source);
  EXPECT_EQ(returned.GetFullPath(), "C:\\Lib\\sec_sym\\sec01.sym");
  EXPECT_EQ(target.GetEntity(), source.GetEntity());
  EXPECT_EQ(target.GetEntityType(), host::kTypeElement);

  // Written as a new element, the taken placement lands in the record.
  target.SetEntity(0);
  ASSERT_EQ(target.Create(), 0);
  EXPECT_EQ(HostRecord(target.GetEntity()).placement[12], 10.0F);

  HRLine line;
  target.AssignFrom(line);
  EXPECT_EQ(target.GetEntity(), 0);
  EXPECT_EQ(target.GetFileName(), "sec01.sym");
}

TEST_F(PlacedObjectTest, CopyOfTakesHeaderRecordAndHandleButNoStrings) {
  HRPlacedObject created = SampleObject();
  ASSERT_EQ(created.Create(), 0);
  HRPlacedObject source;
  ASSERT_EQ(source.Read(created.GetEntity()), 0);
  HRPlacedObject other;
  HRPlacedObject copy = other.CopyOf(source);
  EXPECT_EQ(copy.GetEntity(), source.GetEntity());
  EXPECT_EQ(copy.GetEntityType(), host::kTypeElement);
  EXPECT_EQ(copy.GetFullPath(), "");
  EXPECT_FALSE(other.IsStored());
  // The copy's record still carries the placement: an update writes it unchanged.
  ASSERT_EQ(copy.Update(), 0);
  EXPECT_EQ(HostRecord(source.GetEntity()).placement[12], 10.0F);
}

}  // namespace
