// Compound entity calls: blocks and their members, groups, placed blocks and placed elements.
#include <cstring>
#include <vector>

#include "tests/workbench/host_fixture.h"

namespace {

std::vector<EntityHandle> ListMembers(EntityHandle block) {
  EntityHandle* list = nullptr;
  std::int32_t count = -1;
  EXPECT_EQ(get_whole_vector_of_block_members(db.handle, block, &list, &count), 1);
  std::vector<EntityHandle> members(list, list + count);
  log_free(list);
  return members;
}

EntityHandle CreateBlock(std::vector<EntityHandle> members, const char* name = "blk") {
  host::BlockRecord record{};
  record.base = {1.0F, 2.0F, 3.0F};
  record.flags = 42;
  EntityHandle block = 0;
  EXPECT_EQ(
      qel_create_block(db.handle, &block, static_cast<std::int32_t>(members.size()), members.data(), name, &record), 1);
  return block;
}

}  // namespace

using BlockCalls = HostTest;

TEST_F(BlockCalls, CreatedBlockReadsBackWithNameRecordAndMembersInOrder) {
  const EntityHandle a = AddLine();
  const EntityHandle b = AddLine();
  const EntityHandle block = CreateBlock({b, a}, "symbol");

  host::BlockRecord record{};
  char* name = nullptr;
  ASSERT_EQ(qel_read_block(db.handle, block, &record, &name), 1);
  EXPECT_STREQ(name, "symbol");
  EXPECT_EQ(Session().Memory().Outstanding(), 1) << "the name is host memory until log_free";
  log_free(name);
  EXPECT_EQ(record.flags, 42);
  EXPECT_EQ(record.base.z, 3.0F);
  EXPECT_EQ(ListMembers(block), (std::vector<EntityHandle>{b, a}));
  EXPECT_EQ(Session().Memory().Outstanding(), 0);
}

TEST_F(BlockCalls, EmptyBlockListsNoMembersWithoutHandingOutMemory) {
  const EntityHandle block = CreateBlock({});
  EntityHandle sentinel = 0;
  EntityHandle* list = &sentinel;
  std::int32_t count = -1;
  ASSERT_EQ(get_whole_vector_of_block_members(db.handle, block, &list, &count), 1);
  EXPECT_EQ(count, 0);
  EXPECT_EQ(list, nullptr);
  EXPECT_EQ(Session().Memory().TotalHandedOut(), 0);
}

TEST_F(BlockCalls, MemberListsNamingNoLiveEntityAreRefusedWhole) {
  const EntityHandle a = AddLine();
  const EntityHandle gone = AddLine();
  ASSERT_EQ(qel_delete_entity(db.handle, gone), 1);
  const host::BlockRecord record{};
  EntityHandle block = 0;
  const EntityHandle withDead[] = {a, gone};
  EXPECT_EQ(qel_create_block(db.handle, &block, 2, withDead, "blk", &record), 0);
  EXPECT_EQ(qel_create_block(db.handle, &block, -1, withDead, "blk", &record), 0);
  EXPECT_EQ(qel_create_block(db.handle, &block, 1, nullptr, "blk", &record), 0);
  EXPECT_EQ(Current().NextHandle(), 3) << "nothing was created";

  block = CreateBlock({a});
  EXPECT_EQ(qel_add_members_to_block(db.handle, block, 2, withDead), 0);
  EXPECT_EQ(qel_add_members_to_block(db.handle, block, 1, &block), 0) << "a block cannot hold itself";
  EXPECT_EQ(ListMembers(block), (std::vector<EntityHandle>{a}));
}

TEST_F(BlockCalls, UnlinkRemovesFirstOccurrencesAndRefusesNonMembers) {
  const EntityHandle a = AddLine();
  const EntityHandle b = AddLine();
  const EntityHandle c = AddLine();
  const EntityHandle block = CreateBlock({a});
  const EntityHandle more[] = {b, a};
  ASSERT_EQ(qel_add_members_to_block(db.handle, block, 2, more), 1);
  EXPECT_EQ(ListMembers(block), (std::vector<EntityHandle>{a, b, a}));

  ASSERT_EQ(qel_unlink_members_from_block(db.handle, block, 1, &a), 1);
  EXPECT_EQ(ListMembers(block), (std::vector<EntityHandle>{b, a}));
  const EntityHandle partlyForeign[] = {b, c};
  EXPECT_EQ(qel_unlink_members_from_block(db.handle, block, 2, partlyForeign), 0);
  EXPECT_EQ(ListMembers(block), (std::vector<EntityHandle>{b, a})) << "a refused unlink changes nothing";
  EXPECT_NE(Current().Find(a), nullptr) << "unlinked members stay in the drawing";
}

TEST_F(BlockCalls, DeletingABlockUnlinksButKeepsItsMembers) {
  const EntityHandle a = AddLine();
  const EntityHandle group = AddGroup();
  const EntityHandle block = CreateBlock({a});
  EXPECT_EQ(qel_delete_block(db.handle, group), 0) << "a group is no block";
  ASSERT_EQ(qel_delete_block(db.handle, block), 1);
  EXPECT_EQ(Current().Find(block), nullptr);
  EXPECT_NE(Current().Find(a), nullptr);
  EntityHandle* list = nullptr;
  std::int32_t count = 0;
  EXPECT_EQ(get_whole_vector_of_block_members(db.handle, block, &list, &count), 0);
}

using GroupCalls = HostTest;

TEST_F(GroupCalls, GroupRecordAndNameRoundTripAndDeleteChecksType) {
  host::GroupRecord record{};
  record.kind = 5;
  record.reserved[27] = 9;
  EntityHandle group = 0;
  ASSERT_EQ(qel_create_group(db.handle, &group, 0, nullptr, "grp", &record), 1);
  record.kind = 6;
  ASSERT_EQ(qel_update_group(db.handle, group, &record), 1);

  host::GroupRecord back{};
  char* name = nullptr;
  ASSERT_EQ(qel_read_group(db.handle, group, &back, &name), 1);
  EXPECT_STREQ(name, "grp");
  log_free(name);
  EXPECT_EQ(std::memcmp(&back, &record, sizeof record), 0);

  EXPECT_EQ(qel_delete_group(db.handle, AddLine()), 0);
  ASSERT_EQ(qel_delete_group(db.handle, group), 1);
  EXPECT_EQ(qel_read_group(db.handle, group, &back, nullptr), 0);
}

using PlacedCalls = HostTest;

TEST_F(PlacedCalls, PlacedBlockKeepsPlacementBlockAndName) {
  const EntityHandle block = CreateBlock({});
  host::PlacedBlockRecord placed{};
  for (int i = 0; i < 16; ++i) placed.placement[i] = i * 0.5;
  placed.block = block;
  placed.values[2] = 7;
  EntityHandle instance = 0;
  ASSERT_EQ(qel_add_placed_block(db.handle, &instance, "blk", &placed), 1);

  placed.placement[12] = 100.0;
  ASSERT_EQ(qel_update_placed_block(db.handle, instance, &placed, 0), 1);
  host::PlacedBlockRecord back{};
  char* name = nullptr;
  ASSERT_EQ(qel_read_placed_block(db.handle, instance, &back, &name), 1);
  EXPECT_STREQ(name, "blk");
  log_free(name);
  EXPECT_EQ(back.placement[12], 100.0);
  EXPECT_EQ(back.placement[15], 7.5);
  EXPECT_EQ(back.block, block);
  EXPECT_EQ(back.values[2], 7);
  host::EntityHeader header{};
  ASSERT_EQ(qel_read_entity_header(db.handle, instance, &header), 1);
  EXPECT_EQ(header.bytes[host::kHeaderType], host::kTypePlacedBlock);
}

TEST_F(PlacedCalls, ElementTellsItsLibraryFolderAndName) {
  host::ElementRecord record{};
  std::memcpy(record.shortName, "sec01   ", 8);
  record.placement[0] = 1.0F;
  EntityHandle element = 0;
  ASSERT_EQ(qel_add_element(db.handle, &element, &record, 0), 1);
  host::ElementRecord back{};
  ASSERT_EQ(qel_read_element(db.handle, element, &back), 1);
  EXPECT_EQ(std::memcmp(&back, &record, sizeof record), 0);

  auto text = [](char* host) {
    std::string copy = host == nullptr ? "<null>" : host;
    log_free(host);
    return copy;
  };
  // Before anything tells the host its library, the element is known by its short name.
  EXPECT_EQ(text(qel_get_config_path(db.handle, element)), "");
  EXPECT_EQ(text(qel_get_element_name(db.handle, element, "sec01")), "sec01");
  // The plug-in tells the library file and folder through the element's record.
  SetString(element, "URL=", "lib\\sec_sym\\");
  SetString(element, "@lfname=", "sec01.sym");
  EXPECT_EQ(text(qel_get_config_path(db.handle, element)), "lib\\sec_sym\\");
  EXPECT_EQ(text(qel_get_element_name(db.handle, element, "sec01")), "sec01.sym");
  // A name the loader recorded wins.
  Current().Find(element)->configPath = "C:\\library\\";
  Current().Find(element)->elementName = "Door 90";
  EXPECT_EQ(text(qel_get_config_path(db.handle, element)), "C:\\library\\");
  EXPECT_EQ(text(qel_get_element_name(db.handle, element, "sec01")), "Door 90");

  const EntityHandle line = AddLine();
  EXPECT_EQ(text(qel_get_config_path(db.handle, line)), "<null>");
  EXPECT_EQ(text(qel_get_element_name(db.handle, line, "sec01")), "<null>");
  EXPECT_EQ(Session().Memory().Outstanding(), 0);
}

TEST_F(PlacedCalls, ShortNameIsAtMostEightCharactersOfTheBareFileName) {
  char buffer[9];
  auto shortName = [&](const char* file) {
    std::memset(buffer, 'x', sizeof buffer);
    const char* answer = qel_get_short_name(file, buffer);
    EXPECT_EQ(answer, buffer);
    return std::string(buffer);
  };
  EXPECT_EQ(shortName("C:\\lib\\sec_sym\\section01.sym"), "section0");
  EXPECT_EQ(shortName("lib/sec01.sym"), "sec01");
  EXPECT_EQ(shortName("sec.v2.sym"), "sec.v2");
  EXPECT_EQ(shortName("plain"), "plain");
  EXPECT_EQ(shortName(".hidden"), ".hidden");
  EXPECT_EQ(shortName(nullptr), "");
  EXPECT_EQ(shortName("a\xC3\xA9\xC3\xA9\xC3\xA9\xC3\xA9.sym"), "a\xC3\xA9\xC3\xA9\xC3\xA9")
      << "a two-byte character is never cut in half";
  EXPECT_EQ(qel_get_short_name("file", nullptr), nullptr);
}
