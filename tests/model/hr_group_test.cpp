// Group entities: the carriers of camera, plan and selection records.
#include "model/hr_group.h"

#include "model/hr_block.h"
#include "tests/model/model_fixture.h"

namespace {

using GroupTest = ModelTest;

TEST_F(GroupTest, NewGroupHasItsPresets) {
  const HRGroup group;
  EXPECT_EQ(group.GetClassName(), "HRGroup");
  EXPECT_EQ(group.GetHeaderByte8(), 0);
  EXPECT_EQ(group.GetHeaderByte9(), 1);
  EXPECT_EQ(group.GetEntityType(), 11);
  EXPECT_FALSE(group.IsStored());
}

TEST_F(GroupTest, CreateMakesANamedGroupAndMarksItWithTheClassName) {
  HRGroup group;
  group.SetClassName("hrSecCam");
  EXPECT_EQ(group.Create(), 0);
  const host::EntityHandle entity = group.GetEntity();
  ASSERT_GT(entity, 0);
  EXPECT_EQ(Find(entity)->Type(), host::kTypeGroup);
  EXPECT_EQ(Find(entity)->name, "grp");
  EXPECT_EQ(StringAttribute(entity, "@Class="), "hrSecCam");
  EXPECT_EQ(group.GetEntityType(), host::kTypeGroup);
  EXPECT_EQ(group.GetKind(), 9);
}

TEST_F(GroupTest, ReadTakesHeaderNameAndHandle) {
  HRGroup created;
  ASSERT_EQ(created.Create(), 0);
  Find(created.GetEntity())->header.bytes[10] = 3;
  HRGroup group;
  EXPECT_EQ(group.Read(created.GetEntity()), 0);
  EXPECT_EQ(group.GetEntity(), created.GetEntity());
  EXPECT_EQ(group.GetName(), "grp");
  EXPECT_EQ(group.GetFlags(), 3);
}

TEST_F(GroupTest, ReadFailuresGiveTheirCodes) {
  HRBlock block;
  ASSERT_EQ(block.Create(), 0);
  HRGroup group;
  EXPECT_EQ(group.Read(block.GetEntity()), -4);
  EXPECT_EQ(group.Read(500), -2);

  HRGroup created;
  ASSERT_EQ(created.Create(), 0);
  FailNext("qel_read_group");
  EXPECT_EQ(group.Read(created.GetEntity()), -4);
  EXPECT_FALSE(group.IsStored());

  FailNext("qel_read_group", 1);
  EXPECT_EQ(group.Read(created.GetEntity()), 0);
  EXPECT_EQ(group.GetName(), "");
}

TEST_F(GroupTest, UpdateWritesHeaderAndRecord) {
  HRGroup group;
  ASSERT_EQ(group.Create(), 0);
  ClearJournal();
  EXPECT_EQ(group.Update(), 0);
  EXPECT_EQ(HostCalls(), (std::vector<std::string>{"qel_update_entity_header", "qel_update_group"}));
  FailNext("qel_update_entity_header", 3);
  EXPECT_EQ(group.Update(), -3);
  FailNext("qel_update_group");
  EXPECT_EQ(group.Update(), -6);
}

TEST_F(GroupTest, CreateFailuresGiveTheirCodes) {
  HRGroup group;
  FailNext("qel_create_group");
  EXPECT_EQ(group.Create(), -13);
  EXPECT_EQ(Drawing().LiveCount(), 0U);
  FailNext("qel_read_entity_header");
  EXPECT_EQ(group.Create(), -2);
  EXPECT_FALSE(group.IsStored());
}

TEST_F(GroupTest, DeleteRemovesTheGroup) {
  HRGroup group;
  ASSERT_EQ(group.Create(), 0);
  const host::EntityHandle entity = group.GetEntity();
  FailNext("qel_delete_group");
  EXPECT_EQ(group.Delete(), -7);
  EXPECT_TRUE(group.IsStored());
  EXPECT_EQ(group.Delete(), 0);
  EXPECT_FALSE(group.IsStored());
  EXPECT_EQ(Find(entity), nullptr);
}

TEST_F(GroupTest, CopyOfTakesHeaderRecordAndHandleButNoName) {
  HRGroup source;
  ASSERT_EQ(source.Create(), 0);
  ASSERT_EQ(source.Read(source.GetEntity()), 0);
  source.Hide();
  HRGroup other;
  const HRGroup copy = other.CopyOf(source);
  EXPECT_EQ(copy.GetEntity(), source.GetEntity());
  EXPECT_EQ(copy.GetEntityType(), host::kTypeGroup);
  EXPECT_EQ(copy.GetFlags(), host::kFlagHidden);
  EXPECT_EQ(copy.GetName(), "");
  EXPECT_FALSE(other.IsStored());
}

}  // namespace
