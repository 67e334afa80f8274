// Block calls: blocks, their records and members, and what deleting either does to the other.
#include <vector>

#include "tests/workbench/host_fixture.h"

namespace {

class BlockCalls : public HostTest {
 protected:
  void TearDown() override { EXPECT_EQ(Session().Memory().Outstanding(), 0); }

  static EntityHandle CreateBlock(std::vector<EntityHandle> members) {
    host::BlockRecord record{};
    record.flags = 42;
    EntityHandle block = 0;
    const auto count = static_cast<std::int32_t>(members.size());
    EXPECT_EQ(qel_create_block(db.handle, &block, count, members.data(), "symbol", &record), 1);
    return block;
  }
  static std::vector<EntityHandle> Members(EntityHandle block) {
    EntityHandle sentinel = 0;
    EntityHandle* list = &sentinel;
    std::int32_t count = -1;
    EXPECT_EQ(get_whole_vector_of_block_members(db.handle, block, &list, &count), 1);
    EXPECT_TRUE(count > 0 || list == nullptr) << "an empty list is no host memory";
    std::vector<EntityHandle> members(list, list + count);
    log_free(list);
    return members;
  }
};

}  // namespace

TEST_F(BlockCalls, BlockReadsBackWithNameRecordAndMembersInOrder) {
  const EntityHandle a = AddLine();
  const EntityHandle b = AddLine();
  const EntityHandle block = CreateBlock({b, a});
  host::BlockRecord record{};
  char* name = nullptr;
  ASSERT_EQ(qel_read_block(db.handle, block, &record, &name), 1);
  EXPECT_STREQ(name, "symbol");
  log_free(name);
  EXPECT_EQ(record.flags, 42);
  EXPECT_EQ(Members(block), (std::vector<EntityHandle>{b, a}));
  EXPECT_TRUE(Members(CreateBlock({})).empty());
}

TEST_F(BlockCalls, UnlinkTakesFirstOccurrencesAndChangesNamingNoLiveMemberAreRefusedWhole) {
  const EntityHandle a = AddLine();
  const EntityHandle b = AddLine();
  const EntityHandle gone = AddLine();
  ASSERT_EQ(qel_delete_entity(db.handle, gone), 1);
  const EntityHandle block = CreateBlock({a, b, a});
  const EntityHandle withDead[] = {a, gone};
  EXPECT_EQ(qel_add_members_to_block(db.handle, block, 2, withDead), 0);
  EXPECT_EQ(qel_add_members_to_block(db.handle, block, 1, &block), 0) << "a block cannot hold itself";
  EXPECT_EQ(qel_unlink_members_from_block(db.handle, block, 2, withDead), 0);
  ASSERT_EQ(qel_unlink_members_from_block(db.handle, block, 1, &a), 1);
  EXPECT_EQ(Members(block), (std::vector<EntityHandle>{b, a}));
  EntityHandle refused = 0;
  const host::BlockRecord record{};
  EXPECT_EQ(qel_create_block(db.handle, &refused, 2, withDead, "blk", &record), 0);
  EXPECT_EQ(qel_create_block(db.handle, &refused, -1, withDead, "blk", &record), 0);
  EXPECT_EQ(Current().NextHandle(), block + 1) << "nothing was created";
}

TEST_F(BlockCalls, DeletingABlockKeepsItsMembersAndADeletedMemberLeavesItsBlocks) {
  const EntityHandle a = AddLine();
  const EntityHandle b = AddLine();
  const EntityHandle block = CreateBlock({a, b, a});
  const EntityHandle outer = CreateBlock({b});
  ASSERT_EQ(qel_delete_entity(db.handle, a), 1);
  EXPECT_EQ(Members(block), (std::vector<EntityHandle>{b}));
  EXPECT_EQ(qel_delete_block(db.handle, AddGroup()), 0) << "a group is no block";
  ASSERT_EQ(qel_delete_block(db.handle, outer), 1);
  EXPECT_EQ(Current().Find(outer), nullptr);
  EXPECT_NE(Current().Find(b), nullptr);
}
