// Block definitions: reading, creating and deleting them, and keeping their member lists in
// step with the host.
#include "model/hr_block.h"

#include "model/hr_group.h"
#include "model/hr_line.h"
#include "model/hr_text.h"
#include "model/hr_unknown.h"
#include "tests/model/model_fixture.h"

namespace {

class BlockTest : public ModelTest {
 protected:
  static std::vector<host::EntityHandle> HostMembers(host::EntityHandle block) { return Find(block)->members; }
  static std::vector<host::EntityHandle> MembersOf(const HRBlock& block) {
    std::vector<host::EntityHandle> members;
    for (std::int32_t i = 0; i < block.GetMemberCount(); ++i) members.push_back(block.GetMember(i));
    return members;
  }
  static HRBlock CreatedBlock() {
    HRBlock block;
    EXPECT_EQ(block.Create(), 0);
    return block;
  }
};

TEST_F(BlockTest, CreateMakesANamedBlockAndMarksIt) {
  HRBlock block;
  EXPECT_EQ(block.GetClassName(), "HRBlock");
  EXPECT_EQ(block.Create(), 0);
  const host::EntityHandle entity = block.GetEntity();
  ASSERT_GT(entity, 0);
  EXPECT_EQ(Find(entity)->Type(), host::kTypeBlock);
  EXPECT_EQ(Find(entity)->name, "blk");
  EXPECT_EQ(StringAttribute(entity, "@Class="), "HRBlock");
  EXPECT_EQ(block.GetEntityType(), host::kTypeBlock);
  EXPECT_EQ(block.GetKind(), 10);
}

TEST_F(BlockTest, AddMemberCreatesAnUnstoredMemberFirst) {
  HRBlock block = CreatedBlock();
  HRLine line;
  EXPECT_EQ(block.AddMember(line), 0);
  ASSERT_TRUE(line.IsStored());
  EXPECT_EQ(MembersOf(block), (std::vector<host::EntityHandle>{line.GetEntity()}));
  EXPECT_EQ(HostMembers(block.GetEntity()), (std::vector<host::EntityHandle>{line.GetEntity()}));
  EXPECT_EQ(StringAttribute(line.GetEntity(), "@Class="), "HRLine");

  // A stored member is linked as it is.
  EXPECT_EQ(block.AddMember(Database(), line), 0);
  EXPECT_EQ(Drawing().LiveCount(), 2U);
  EXPECT_EQ(block.GetMemberCount(), 2);
}

TEST_F(BlockTest, ReadTakesNameAndMembersInHostOrder) {
  HRBlock created = CreatedBlock();
  HRLine first;
  HRText second;
  HRLine third;
  created.AddMember(first);
  created.AddMember(second);
  created.AddMember(third);
  Find(created.GetEntity())->name = "symbol";

  HRBlock block;
  EXPECT_EQ(block.Read(created.GetEntity()), 0);
  EXPECT_EQ(block.GetEntity(), created.GetEntity());
  EXPECT_EQ(block.GetName(), "symbol");
  EXPECT_EQ(MembersOf(block),
            (std::vector<host::EntityHandle>{first.GetEntity(), second.GetEntity(), third.GetEntity()}));

  // A second read starts from an empty member list.
  EXPECT_EQ(block.Read(created.GetEntity()), 0);
  EXPECT_EQ(block.GetMemberCount(), 3);
}

TEST_F(BlockTest, ReadingAGroupAsABlockGivesMinus4) {
  HRGroup group;
  ASSERT_EQ(group.Create(), 0);
  HRBlock block;
  EXPECT_EQ(block.Read(group.GetEntity()), -4);
  EXPECT_FALSE(block.IsStored());
}

TEST_F(BlockTest, ReadFailuresGiveTheirCodesAndReleaseWhatTheHostHandedOut) {
  HRBlock created = CreatedBlock();
  HRLine member;
  created.AddMember(member);
  HRBlock block;
  EXPECT_EQ(block.Read(123), -2);
  FailNext("qel_read_block");
  EXPECT_EQ(block.Read(created.GetEntity()), -4);
  FailNext("get_whole_vector_of_block_members");
  EXPECT_EQ(block.Read(created.GetEntity()), -5);
  EXPECT_FALSE(block.IsStored());
  EXPECT_EQ(block.GetMemberCount(), 0);
  EXPECT_GT(Bench().Memory().TotalHandedOut(), 0);
}

TEST_F(BlockTest, AHostNameOfNullReadsAsEmpty) {
  HRBlock created = CreatedBlock();
  FailNext("qel_read_block", 1);
  HRBlock block;
  EXPECT_EQ(block.Read(created.GetEntity()), 0);
  EXPECT_EQ(block.GetName(), "");
}

TEST_F(BlockTest, UpdateWritesHeaderAndRecord) {
  HRBlock block = CreatedBlock();
  block.Hide();
  Find(block.GetEntity())->header.bytes[10] = 0;
  EXPECT_EQ(block.Update(), 0);
  EXPECT_EQ(Find(block.GetEntity())->header.bytes[10], host::kFlagHidden);
  ClearJournal();
  EXPECT_EQ(block.Update(), 0);
  EXPECT_EQ(HostCalls(), (std::vector<std::string>{"qel_update_entity_header", "qel_update_block"}));

  FailNext("qel_update_entity_header", 2);
  EXPECT_EQ(block.Update(), -3);
  FailNext("qel_update_block");
  EXPECT_EQ(block.Update(), -6);
}

TEST_F(BlockTest, CreateFailuresGiveTheirCodes) {
  HRBlock block;
  FailNext("qel_create_block");
  EXPECT_EQ(block.Create(), -5);
  EXPECT_EQ(Drawing().LiveCount(), 0U);
  FailNext("qel_read_entity_header");
  EXPECT_EQ(block.Create(), -2);
  EXPECT_FALSE(block.IsStored());
  EXPECT_TRUE(AttributeWrites().empty());
}

TEST_F(BlockTest, DeleteRecordsTheRemovalAndForgetsTheHandle) {
  HRBlock block = CreatedBlock();
  const host::EntityHandle entity = block.GetEntity();
  FailNext("qel_delete_block");
  EXPECT_EQ(block.Delete(), -7);
  EXPECT_TRUE(block.IsStored());
  EXPECT_EQ(block.Delete(), 0);
  EXPECT_FALSE(block.IsStored());
  EXPECT_EQ(Find(entity), nullptr);
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{entity, 2}, {entity, 2}}));
}

TEST_F(BlockTest, RemoveMemberTakesOnlyTheFirstOfTwoEqualHandles) {
  HRBlock block = CreatedBlock();
  HRLine repeated;
  HRLine other;
  block.AddMember(repeated);
  block.AddMember(other);
  block.AddMember(repeated);
  EXPECT_EQ(block.RemoveMember(repeated), 0);
  const std::vector<host::EntityHandle> expected = {other.GetEntity(), repeated.GetEntity()};
  EXPECT_EQ(MembersOf(block), expected);
  EXPECT_EQ(HostMembers(block.GetEntity()), expected);
  EXPECT_NE(Find(repeated.GetEntity()), nullptr);
}

TEST_F(BlockTest, MemberChangesTheHostRefusesLeaveTheListAlone) {
  HRBlock block = CreatedBlock();
  HRLine member;
  FailNext("qel_add_members_to_block");
  EXPECT_EQ(block.AddMember(member), -8);
  EXPECT_TRUE(member.IsStored());
  EXPECT_EQ(block.GetMemberCount(), 0);

  ASSERT_EQ(block.AddMember(member), 0);
  FailNext("qel_unlink_members_from_block");
  EXPECT_EQ(block.RemoveMember(member), -21);
  EXPECT_EQ(block.GetMemberCount(), 1);
  FailNext("qel_unlink_members_from_block");
  EXPECT_EQ(block.RemoveAndDeleteMember(member), -21);
  EXPECT_NE(Find(member.GetEntity()), nullptr);
  EXPECT_TRUE(member.IsStored());
}

TEST_F(BlockTest, RemoveAndDeleteMemberAnswersTheMembersDelete) {
  HRBlock block = CreatedBlock();
  HRLine kept;
  HRLine deleted;
  block.AddMember(kept);
  block.AddMember(deleted);
  const host::EntityHandle deletedHandle = deleted.GetEntity();
  EXPECT_EQ(block.RemoveAndDeleteMember(deleted), 0);
  EXPECT_EQ(Find(deletedHandle), nullptr);
  EXPECT_FALSE(deleted.IsStored());
  EXPECT_EQ(MembersOf(block), (std::vector<host::EntityHandle>{kept.GetEntity()}));

  block.AddMember(deleted);
  FailNext("qel_delete_entity");
  EXPECT_EQ(block.RemoveAndDeleteMember(Database(), deleted), -20);
  EXPECT_EQ(MembersOf(block), (std::vector<host::EntityHandle>{kept.GetEntity()}));
}

TEST_F(BlockTest, DeleteAllMembersDeletesEachMemberAndRecordsEveryRemoval) {
  HRBlock block = CreatedBlock();
  HRLine line;
  HRText text;
  HRGroup group;
  block.AddMember(line);
  block.AddMember(text);
  block.AddMember(group);
  const host::EntityHandle l = line.GetEntity();
  const host::EntityHandle t = text.GetEntity();
  const host::EntityHandle g = group.GetEntity();
  ClearJournal();

  EXPECT_EQ(block.DeleteAllMembers(), 0);
  EXPECT_EQ(block.GetMemberCount(), 0);
  EXPECT_TRUE(HostMembers(block.GetEntity()).empty());
  for (const host::EntityHandle member : {l, t, g}) EXPECT_EQ(Find(member), nullptr) << member;
  // Lines and texts record their own removal before the block records it again.
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{l, 2}, {l, 2}, {-1, -1}, {t, 2}, {t, 2}, {-1, -1}, {g, 2}, {-1, -1}}));
  EXPECT_NE(Find(block.GetEntity()), nullptr);
}

TEST_F(BlockTest, DeleteAllMembersGoesOnWhenAMemberCannotBeDeleted) {
  HRBlock block = CreatedBlock();
  HRLine first;
  HRLine second;
  block.AddMember(first);
  block.AddMember(second);
  wb::FaultRule rule;
  rule.call = "qel_delete_entity";
  rule.entity = first.GetEntity();
  Bench().GetFaults().Add(rule);
  EXPECT_EQ(block.DeleteAllMembers(), 0);
  EXPECT_NE(Find(first.GetEntity()), nullptr);
  EXPECT_EQ(Find(second.GetEntity()), nullptr);
  EXPECT_EQ(block.GetMemberCount(), 0);
}

TEST_F(BlockTest, UnlinkAllMembersKeepsTheEntities) {
  HRBlock block = CreatedBlock();
  HRLine line;
  HRLine other;
  block.AddMember(line);
  block.AddMember(other);
  ClearJournal();
  EXPECT_EQ(block.UnlinkAllMembers(), 0);
  EXPECT_EQ(block.GetMemberCount(), 0);
  EXPECT_TRUE(HostMembers(block.GetEntity()).empty());
  EXPECT_NE(Find(line.GetEntity()), nullptr);
  EXPECT_NE(Find(other.GetEntity()), nullptr);
  EXPECT_TRUE(ChangeRecords().empty());
}

TEST_F(BlockTest, MemberListFailuresLeaveMembersInPlace) {
  HRBlock block = CreatedBlock();
  HRLine line;
  block.AddMember(line);
  for (auto run : {&HRBlock::DeleteAllMembers, &HRBlock::UnlinkAllMembers}) {
    FailNext("get_whole_vector_of_block_members");
    EXPECT_EQ((block.*run)(), -29);
    FailNext("qel_unlink_members_from_block");
    EXPECT_EQ((block.*run)(), -21);
    EXPECT_EQ(block.GetMemberCount(), 1);
    EXPECT_EQ(HostMembers(block.GetEntity()).size(), 1U);
    EXPECT_NE(Find(line.GetEntity()), nullptr);
  }
  EXPECT_TRUE(ChangeRecords().empty());
}

TEST_F(BlockTest, MembersOutsideTheListAreZeroAndWrapAsUnknown) {
  HRBlock block = CreatedBlock();
  HRText text;
  block.AddMember(text);
  for (const std::int32_t index : {-1, 1, 2147483647}) EXPECT_EQ(block.GetMember(index), 0) << index;

  std::unique_ptr<HRPrimitive> member;
  EXPECT_EQ(block.WrapMember(0, member), 0);
  EXPECT_NE(dynamic_cast<HRText*>(member.get()), nullptr);
  EXPECT_EQ(member->GetEntity(), text.GetEntity());

  EXPECT_EQ(block.WrapMember(5, member), -4);
  EXPECT_NE(dynamic_cast<HRUnknown*>(member.get()), nullptr);
}

TEST_F(BlockTest, CopyOfTakesHeaderRecordAndHandleButNoMembers) {
  HRBlock source = CreatedBlock();
  HRLine line;
  source.AddMember(line);
  source.Hide();
  Find(source.GetEntity())->name = "symbol";
  ASSERT_EQ(source.Read(source.GetEntity()), 0);

  HRBlock other;
  const HRBlock copy = other.CopyOf(source);
  EXPECT_EQ(copy.GetEntity(), source.GetEntity());
  EXPECT_EQ(copy.GetFlags(), host::kFlagHidden);
  EXPECT_EQ(copy.GetName(), "");
  EXPECT_EQ(copy.GetMemberCount(), 0);
  EXPECT_FALSE(other.IsStored());
}

TEST_F(BlockTest, AssignFromTakesMembersAndNameFromABlock) {
  HRBlock source = CreatedBlock();
  HRLine line;
  source.AddMember(line);
  ASSERT_EQ(source.Read(source.GetEntity()), 0);
  HRBlock target;
  const HRBlock returned = target.AssignFrom(source);
  EXPECT_EQ(target.GetEntity(), source.GetEntity());
  EXPECT_EQ(MembersOf(target), (std::vector<host::EntityHandle>{line.GetEntity()}));
  EXPECT_EQ(returned.GetMemberCount(), 1);
  EXPECT_EQ(target.GetName(), "blk");

  target.AssignFrom(line);
  EXPECT_EQ(target.GetEntity(), line.GetEntity());
  EXPECT_EQ(target.GetMemberCount(), 1);
}

}  // namespace
