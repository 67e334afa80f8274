// Entity calls: creation, handles, typed records and their type checks, headers, deletion.
#include <cstring>

#include "tests/workbench/host_fixture.h"

using EntityCalls = HostTest;

TEST_F(EntityCalls, AddedLineReadsBackWithLineTypeInItsHeader) {
  const host::LineRecord line = MakeLine(1, 2, 3, 4, 5, 6);
  EntityHandle entity = 0;
  ASSERT_EQ(qel_add_line(db.handle, &entity, &line), 1);
  EXPECT_EQ(entity, 1);

  host::EntityHeader header{};
  ASSERT_EQ(qel_read_entity_header(db.handle, entity, &header), 1);
  EXPECT_EQ(header.bytes[host::kHeaderType], host::kTypeLine);
  host::LineRecord back{};
  ASSERT_EQ(qel_read_line(db.handle, entity, &back), 1);
  EXPECT_EQ(std::memcmp(&back, &line, sizeof line), 0);

  host::LineRecord moved = MakeLine(9, 9, 9, 8, 8, 8);
  ASSERT_EQ(qel_update_line(db.handle, entity, &moved), 1);
  ASSERT_EQ(qel_read_line(db.handle, entity, &back), 1);
  EXPECT_EQ(back.start.x, 9.0F);
  EXPECT_EQ(back.end.z, 8.0F);
}

TEST_F(EntityCalls, HandlesCountFromOneAndAreNeverReused) {
  EXPECT_EQ(AddLine(), 1);
  EXPECT_EQ(AddGroup(), 2);
  EXPECT_EQ(AddLine(), 3);
  ASSERT_EQ(qel_delete_entity(db.handle, 3), 1);
  ASSERT_EQ(qel_delete_entity(db.handle, 2), 1);
  EXPECT_EQ(AddLine(), 4);

  host::EntityHeader header{};
  EXPECT_EQ(qel_read_entity_header(db.handle, 3, &header), 0);
  EXPECT_EQ(qel_delete_entity(db.handle, 3), 0) << "a deleted entity cannot be deleted twice";
  EXPECT_EQ(qel_read_entity_header(db.handle, 0, &header), 0);
  EXPECT_EQ(qel_read_entity_header(db.handle, -1, &header), 0);
  EXPECT_EQ(Current().LiveCount(), 2U);
}

TEST_F(EntityCalls, TypedReadsAndUpdatesRefuseEntitiesOfAnotherType) {
  const EntityHandle line = AddLine();
  const EntityHandle group = AddGroup();
  host::LineRecord lineRecord{};
  host::BlockRecord block{};
  host::GroupRecord groupRecord{};
  host::PlacedBlockRecord placed{};
  host::ElementRecord element{};
  char* name = nullptr;

  EXPECT_EQ(qel_read_line(db.handle, group, &lineRecord), 0);
  EXPECT_EQ(qel_update_line(db.handle, group, &lineRecord), 0);
  EXPECT_EQ(qel_read_block(db.handle, group, &block, &name), 0);
  EXPECT_EQ(qel_read_group(db.handle, line, &groupRecord, &name), 0);
  EXPECT_EQ(qel_update_group(db.handle, line, &groupRecord), 0);
  EXPECT_EQ(qel_read_placed_block(db.handle, line, &placed, &name), 0);
  EXPECT_EQ(qel_read_element(db.handle, group, &element), 0);
  EXPECT_EQ(qel_update_element(db.handle, line, &element), 0);
  EXPECT_EQ(name, nullptr);
  EXPECT_EQ(Session().Memory().TotalHandedOut(), 0);
  EXPECT_EQ(Log().Names(wb::JournalEntry::Kind::HostCall),
            (std::vector<std::string>{"qel_add_line", "qel_create_group"}))
      << "refused updates change nothing";
}

TEST_F(EntityCalls, HeaderUpdateChangesFlagsButNeverTheType) {
  const EntityHandle line = AddLine();
  host::EntityHeader header{};
  ASSERT_EQ(qel_read_entity_header(db.handle, line, &header), 1);
  header.bytes[host::kHeaderByte9] = 1;
  header.bytes[host::kHeaderFlags] = 0x85;
  header.bytes[host::kHeaderType] = host::kTypeBlock;
  ASSERT_EQ(qel_update_entity_header(db.handle, line, &header), 1);

  host::EntityHeader back{};
  ASSERT_EQ(qel_read_entity_header(db.handle, line, &back), 1);
  EXPECT_EQ(back.bytes[host::kHeaderByte9], 1);
  EXPECT_EQ(back.bytes[host::kHeaderFlags], 0x85);
  EXPECT_EQ(back.bytes[host::kHeaderType], host::kTypeLine);
  host::LineRecord record{};
  EXPECT_EQ(qel_read_line(db.handle, line, &record), 1) << "still readable as the line it is";
}

TEST_F(EntityCalls, TextIsALineEntityCarryingItsText) {
  const host::LineRecord position = MakeLine(1, 1, 0, 1, 1, 0);
  EntityHandle text = 0;
  ASSERT_EQ(qel_add_text(db.handle, &text, &position, "", "Section A", 1), 1);

  host::EntityHeader header{};
  ASSERT_EQ(qel_read_entity_header(db.handle, text, &header), 1);
  EXPECT_EQ(header.bytes[host::kHeaderType], host::kTypeLine);
  EXPECT_EQ(ReadString(text, "t="), "Section A");
  EXPECT_EQ(is_attribute_exist(db.handle, text, "t="), 1);
  EXPECT_EQ(is_attribute_exist(db.handle, text, "tb="), 0) << "the text block is the caller's to write";
  EXPECT_EQ(qel_add_text(db.handle, &text, &position, "", nullptr, 1), 0);
}

TEST_F(EntityCalls, UnusableArgumentsAreRefusedWithoutCreatingAnything) {
  const host::LineRecord line = MakeLine(0, 0, 0, 1, 1, 1);
  EntityHandle entity = 0;
  EXPECT_EQ(qel_add_line(db.handle + 7, &entity, &line), 0);
  EXPECT_EQ(qel_add_line(db.handle, nullptr, &line), 0);
  EXPECT_EQ(qel_add_line(db.handle, &entity, nullptr), 0);
  EXPECT_EQ(qel_read_entity_header(db.handle, AddLine(), nullptr), 0);
  EXPECT_EQ(Current().NextHandle(), 2);
}

TEST_F(EntityCalls, DeletedEntityLeavesEveryBlockThatListedIt) {
  const EntityHandle a = AddLine();
  const EntityHandle b = AddLine();
  const EntityHandle members[] = {a, b, a};
  const host::BlockRecord record{};
  EntityHandle block = 0;
  ASSERT_EQ(qel_create_block(db.handle, &block, 3, members, "blk", &record), 1);

  ASSERT_EQ(qel_delete_entity(db.handle, a), 1);
  EXPECT_EQ(Current().Find(block)->members, (std::vector<EntityHandle>{b}));
}

TEST_F(EntityCalls, StateChangingCallsAreJournaledByName) {
  const EntityHandle line = AddLine();
  host::LineRecord record = MakeLine(0, 0, 0, 2, 2, 2);
  ASSERT_EQ(qel_update_line(db.handle, line, &record), 1);
  host::LineRecord read{};
  ASSERT_EQ(qel_read_line(db.handle, line, &read), 1);
  ASSERT_EQ(qel_delete_entity(db.handle, line), 1);

  const std::vector<wb::JournalEntry> expected = {
      {wb::JournalEntry::Kind::HostCall, "qel_add_line", line, 0},
      {wb::JournalEntry::Kind::HostCall, "qel_update_line", line, 0},
      {wb::JournalEntry::Kind::HostCall, "qel_delete_entity", line, 0},
  };
  EXPECT_EQ(Log().Entries(), expected) << "reads are not journaled";
}
