// Blocks, their insertions and groups: reading and writing them, and keeping a block's member
// list in step with the host.
#include "model/hr_block.h"

#include "math/vector.h"
#include "model/hr_group.h"
#include "model/hr_line.h"
#include "model/hr_placed_block.h"
#include "model/hr_text.h"
#include "tests/model/model_fixture.h"

namespace {

class BlockTest : public ModelTest {
 protected:
  using Handles = std::vector<host::EntityHandle>;
  // The block's member list, which must equal the host's.
  static Handles MembersOf(const HRBlock& block) {
    Handles members;
    for (std::int32_t i = 0; i < block.GetMemberCount(); ++i) members.push_back(block.GetMember(i));
    EXPECT_EQ(Find(block.GetEntity())->members, members) << "the host's list differs";
    EXPECT_EQ(block.GetMember(block.GetMemberCount()), 0);
    return members;
  }
  void SetUp() override {
    ModelTest::SetUp();
    ASSERT_EQ(block_.Create(), 0);
  }
  HRBlock block_;
};

TEST_F(BlockTest, AddMemberCreatesAnUnstoredMemberAndReadTakesNameAndMembersInHostOrder) {
  HRLine first;
  HRText second;
  EXPECT_EQ(block_.AddMember(first), 0);
  EXPECT_EQ(block_.AddMember(second), 0);
  EXPECT_EQ(block_.AddMember(Database(), first), 0);  // a stored member is linked as it is
  const Handles expected = {first.GetEntity(), second.GetEntity(), first.GetEntity()};
  EXPECT_EQ(MembersOf(block_), expected);

  Find(block_.GetEntity())->name = "symbol";
  HRBlock read;
  EXPECT_EQ(read.Read(block_.GetEntity()), 0);
  EXPECT_EQ(MembersOf(read), expected);
  EXPECT_EQ(read.GetName(), "symbol");
  ClearJournal();
  EXPECT_EQ(read.Update(), 0);
  EXPECT_EQ(HostCalls(), (std::vector<std::string>{"qel_update_entity_header", "qel_update_block"}));
}

TEST_F(BlockTest, RemoveMemberTakesOnlyTheFirstOfTwoEqualHandles) {
  HRLine repeated;
  HRLine other;
  for (HRLine* member : {&repeated, &other, &repeated}) block_.AddMember(*member);
  EXPECT_EQ(block_.RemoveMember(repeated), 0);
  EXPECT_EQ(MembersOf(block_), (Handles{other.GetEntity(), repeated.GetEntity()}));
  const host::EntityHandle deleted = other.GetEntity();
  EXPECT_EQ(block_.RemoveAndDeleteMember(other), 0);
  EXPECT_EQ(Find(deleted), nullptr);
  EXPECT_EQ(MembersOf(block_), (Handles{repeated.GetEntity()}));
  EXPECT_EQ(block_.UnlinkAllMembers(), 0);
  EXPECT_TRUE(MembersOf(block_).empty());
  EXPECT_NE(Find(repeated.GetEntity()), nullptr);
}

TEST_F(BlockTest, DeleteAllMembersDeletesEachRecordsEveryRemovalAndGoesOnPastARefusal) {
  HRLine line;
  HRText text;
  HRGroup group;
  for (HRPrimitive* member : std::initializer_list<HRPrimitive*>{&line, &text, &group}) block_.AddMember(*member);
  const host::EntityHandle l = line.GetEntity();
  const host::EntityHandle t = text.GetEntity();
  const host::EntityHandle g = group.GetEntity();
  FailNext("qel_delete_entity");  // the line's, the first such call
  ClearJournal();
  EXPECT_EQ(block_.DeleteAllMembers(), 0);
  EXPECT_TRUE(MembersOf(block_).empty());
  EXPECT_NE(Find(l), nullptr);
  EXPECT_EQ(Find(t), nullptr);
  EXPECT_EQ(Find(g), nullptr);
  // A text records its own removal before the block records it again; the refused line does not.
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{l, 2}, {-1, -1}, {t, 2}, {t, 2}, {-1, -1}, {g, 2}, {-1, -1}}));
}

TEST_F(BlockTest, InsertionsCarryBlockPlacementAndNameThroughTheHostAndDeleteResetsThemAlways) {
  HRMath::Matrix mirror;
  mirror.SetMirror(1, 0, 0);
  HRMath::Matrix shift;
  shift.SetTranslation(0.1, 20, -3);
  HRPlacedBlock placed;
  EXPECT_EQ(placed.SetBlock(block_), 0);
  ASSERT_EQ(placed.Create(), 0);
  const host::EntityHandle entity = placed.GetEntity();
  placed.SetPlacement(mirror.Multiply(shift));
  EXPECT_EQ(placed.Update(), 0);
  EXPECT_EQ(placed.GetName(), "");

  Find(entity)->name = "instance";
  HRPlacedBlock read;
  EXPECT_EQ(read.Read(entity), 0);
  EXPECT_EQ(read.GetBlock(), block_.GetEntity());
  EXPECT_EQ(read.GetName(), "instance");
  const HRMath::Vector moved = HRMath::Vector(2, 1, 1).Transform(read.GetPlacement());
  EXPECT_EQ(moved.x, -2 + 0.1);
  EXPECT_EQ(moved.y, 21.0);

  FailNext("qel_delete_entity");
  EXPECT_EQ(read.Delete(), 0);
  EXPECT_EQ(read.GetName(), "blk");
  EXPECT_EQ(HRMath::Vector(2, 1, 1).Transform(read.GetPlacement()).x, 2.0);
}

using GroupTest = ModelTest;

TEST_F(GroupTest, CopyOfTakesHeaderAndHandleButNoName) {
  HRGroup group;
  ASSERT_EQ(group.Create(), 0);
  ASSERT_EQ(group.Read(group.GetEntity()), 0);
  group.Hide();
  const HRGroup copy = HRGroup().CopyOf(group);
  EXPECT_EQ(copy.GetEntity(), group.GetEntity());
  EXPECT_EQ(copy.GetFlags(), host::kFlagHidden);
  EXPECT_EQ(copy.GetName(), "");
}

}  // namespace
