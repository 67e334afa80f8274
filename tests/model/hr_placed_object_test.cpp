// Library elements: file and folder handling, the element record and the library attributes.
#include "model/hr_placed_object.h"

#include <algorithm>
#include <cstring>

#include "tests/model/model_fixture.h"

namespace {

class PlacedObjectTest : public ModelTest {
 protected:
  static host::ElementRecord HostRecord(host::EntityHandle entity) {
    return wb::ReadRecord<host::ElementRecord>(*Find(entity));
  }
  static std::string ShortNameOf(host::EntityHandle entity) {
    const host::ElementRecord record = HostRecord(entity);
    return std::string(record.shortName, strnlen(record.shortName, sizeof record.shortName));
  }
};

TEST_F(PlacedObjectTest, SetFileSplitsAtTheLastBackslash) {
  HRPlacedObject object;  // one object throughout, so no folder may outlive its path
  const auto split = [&object](const char* path) {
    object.SetFile(path);
    return object.GetFolder() + "|" + object.GetFileName();
  };
  EXPECT_EQ(split("C:\\sym\\sec01.sym"), "C:\\sym\\|sec01.sym");
  EXPECT_EQ(split("C:\\sym\\\\\\sec01"), "C:\\sym\\|sec01");
  EXPECT_EQ(split("C:\\sym\\"), "C:\\sym\\|");
  EXPECT_EQ(split("sec01.sym"), "|sec01.sym");
}

TEST_F(PlacedObjectTest, CreateAndUpdateWriteRecordAndLibraryAttributesWhichReadTakesBack) {
  HRPlacedObject object;
  object.SetFile("C:\\Lib\\sec_sym\\sec01.sym");
  ASSERT_EQ(object.Create(), 0);
  const host::EntityHandle entity = object.GetEntity();
  EXPECT_EQ(ShortNameOf(entity), "sec01");
  EXPECT_EQ(StringAttribute(entity, "@lfname="), "sec01.sym");
  EXPECT_EQ(StringAttribute(entity, "URL="), "C:\\Lib\\sec_sym\\");
  EXPECT_EQ(StringAttribute(entity, "@lib="), "C:\\Lib\\sec_sym\\");
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"@lfname=", "URL=", "@lib=", "@Class="}));

  object.SetFile("D:\\other\\sec02.sym");
  ClearJournal();
  EXPECT_EQ(object.Update(), 0);
  EXPECT_EQ(ShortNameOf(entity), "sec02");
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"@lfname=", "URL=", "@lib="}));
  FailNext("qel_get_config_path");  // a host without folder or name leaves the path empty
  FailNext("qel_get_element_name");
  EXPECT_EQ(object.Read(entity), 0);
  EXPECT_EQ(object.GetFullPath(), "");
}

TEST_F(PlacedObjectTest, ShortNamesNeverOverrunTheirEightBytes) {
  HRPlacedObject object;
  object.SetFile("C:\\Lib\\averylongsymbolname.sym");
  // Every byte of the element right after the field is non-zero, so a stray terminator shows.
  double placement[16] = {};
  std::fill_n(placement, 16, 1.1);
  object.SetPlacement(HRMath::Matrix(placement));
  ASSERT_EQ(object.Create(), 0);
  EXPECT_EQ(std::string(HostRecord(object.GetEntity()).shortName, 8), "averylon");
  EXPECT_EQ(HostRecord(object.GetEntity()).placement[0], 1.1F);
  HRPlacedObject copy;  // a copy takes file and placement
  copy.AssignFrom(object);
  copy.SetEntity(0);
  ASSERT_EQ(copy.Create(), 0);
  EXPECT_EQ(Find(copy.GetEntity())->record, Find(object.GetEntity())->record);

  // A foreign element has no library attributes and is named after its short name, which here
  // fills all eight bytes without a terminator.
  const host::EntityHandle foreign = AddEntity(host::kTypeElement);
  host::ElementRecord record{};
  std::memcpy(record.shortName, "ABCDEFGH", 8);
  record.placement[0] = 99.0F;
  wb::WriteRecord(*Find(foreign), record);
  EXPECT_EQ(object.Read(foreign), 0);
  EXPECT_EQ(object.GetFileName(), "ABCDEFGH");
}

}  // namespace
