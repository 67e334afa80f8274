// Entity calls: creation, handles, typed records and their type checks, headers, deletion, and
// the database walks: which entities each delivers, in what order, and the cursor rules.
#include <cstring>
#include <vector>

#include "tests/workbench/host_fixture.h"

using EntityCalls = HostTest;

TEST_F(EntityCalls, HandlesCountFromOneAndOnlyStateChangesAreJournaled) {
  const host::LineRecord line = MakeLine({1, 2, 3}, {4, 5, 6});
  EntityHandle entity = 0;
  ASSERT_EQ(qel_add_line(db.handle, &entity, &line), 1);
  host::LineRecord back{};
  ASSERT_EQ(qel_read_line(db.handle, entity, &back), 1);
  EXPECT_EQ(std::memcmp(&back, &line, sizeof line), 0);
  EXPECT_EQ(std::pair(entity, AddGroup()), std::pair(1, 2));
  ASSERT_EQ(qel_update_line(db.handle, entity, &back), 1);
  ASSERT_EQ(qel_delete_entity(db.handle, entity), 1);
  EXPECT_EQ(qel_delete_entity(db.handle, entity), 0) << "a deleted entity cannot be deleted twice";
  EXPECT_EQ(AddLine(), 3) << "handles are never reused";
  host::EntityHeader header{};
  for (const EntityHandle absent : {1, 0, -1}) EXPECT_EQ(qel_read_entity_header(db.handle, absent, &header), 0);

  const std::vector<std::string> expected = {"qel_add_line", "qel_create_group", "qel_update_line",
                                             "qel_delete_entity", "qel_add_line"};
  EXPECT_EQ(Log().Names(Kind::HostCall), expected);
}

TEST_F(EntityCalls, CallsOnTheWrongTypeOrWithUnusableArgumentsChangeNothing) {
  const EntityHandle line = AddLine();
  const EntityHandle group = AddGroup();
  host::LineRecord lineRecord{};
  host::GroupRecord groupRecord{};
  char* name = nullptr;
  EXPECT_EQ(qel_update_line(db.handle, group, &lineRecord), 0);
  EXPECT_EQ(qel_read_group(db.handle, line, &groupRecord, &name), 0);
  EXPECT_EQ(name, nullptr);
  EntityHandle entity = 0;
  EXPECT_EQ(qel_add_line(db.handle + 7, &entity, &lineRecord), 0);
  EXPECT_EQ(qel_add_text(db.handle, &entity, &lineRecord, "", nullptr, 1), 0);
  EXPECT_EQ(Current().NextHandle(), 3);
  EXPECT_EQ(Log().Entries().size(), 2U);
}

TEST_F(EntityCalls, HeaderUpdateChangesFlagsButNeverTheType) {
  const EntityHandle line = AddLine();
  host::EntityHeader header{};
  ASSERT_EQ(qel_read_entity_header(db.handle, line, &header), 1);
  EXPECT_EQ(header.bytes[host::kHeaderType], host::kTypeLine);
  header.bytes[host::kHeaderFlags] = 0x85;
  header.bytes[host::kHeaderType] = host::kTypeBlock;
  ASSERT_EQ(qel_update_entity_header(db.handle, line, &header), 1);
  ASSERT_EQ(qel_read_entity_header(db.handle, line, &header), 1);
  EXPECT_EQ(header.bytes[host::kHeaderFlags], 0x85);
  EXPECT_EQ(header.bytes[host::kHeaderType], host::kTypeLine);
}

class DatabaseWalks : public HostTest {
 protected:
  // Handles 1 to 5: 2 is hidden, 4 deleted.
  void SetUp() override {
    HostTest::SetUp();
    for (int i = 0; i < 5; ++i) AddLine(static_cast<float>(i));
    Current().Find(2)->header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
    ASSERT_EQ(qel_delete_entity(db.handle, 4), 1);
  }

  using Walk = Status (*)(DatabaseHandle, EntityHandle*, std::int32_t*);
  static std::vector<EntityHandle> WalkAll(Walk walk, bool addOnTheWay = false) {
    std::vector<EntityHandle> seen;
    EntityHandle entity = 0;
    std::int32_t cursor = 0;
    while (walk(db.handle, &entity, &cursor) == 1) {
      seen.push_back(entity);
      if (addOnTheWay && entity == 1) AddLine();
    }
    return seen;
  }
};

TEST_F(DatabaseWalks, VisibleWalkSkipsHiddenEntitiesAndBlankWalksIncludeThem) {
  EXPECT_EQ(WalkAll(loop_on_database_blank), (std::vector<EntityHandle>{1, 2, 3, 5}));
  EXPECT_EQ(WalkAll(loop_on_database, true), (std::vector<EntityHandle>{1, 3, 5, 6})) << "additions come at the end";
  host::EntityHeader header{};
  EntityHandle entity = 0;
  std::int32_t cursor = 1;
  ASSERT_EQ(loop_on_database_blank_h(db.handle, &entity, &cursor, &header), 1);
  EXPECT_EQ(entity, 2);
  EXPECT_EQ(header.bytes[host::kHeaderFlags], host::kFlagHidden) << "the header comes with the entity";
  EXPECT_EQ(loop_on_database_blank_h(db.handle, &entity, &cursor, nullptr), 0);
}

TEST_F(DatabaseWalks, CursorIsTheNextSlotAndTheEndKeepsAnswering0) {
  EntityHandle entity = 0;
  std::int32_t cursor = 0;
  ASSERT_EQ(loop_on_database(db.handle, &entity, &cursor), 1);
  ASSERT_EQ(loop_on_database(db.handle, &entity, &cursor), 1);
  EXPECT_EQ(std::pair(entity, cursor), std::pair(3, 3));
  // Kinds share the cursor: a blank walk goes on where the visible one stopped.
  ASSERT_EQ(loop_on_database_blank(db.handle, &entity, &cursor), 1);
  EXPECT_EQ(entity, 5);
  for (int i = 0; i < 2; ++i) EXPECT_EQ(loop_on_database_blank(db.handle, &entity, &cursor), 0);
  EXPECT_EQ(entity, 0);
  for (const std::int32_t unusable : {-1, 1000}) {
    cursor = unusable;
    EXPECT_EQ(loop_on_database_blank(db.handle, &entity, &cursor), 0) << unusable;
  }
  cursor = 0;
  EXPECT_EQ(loop_on_database_blank(db.handle + 1, &entity, &cursor), 0);
  EXPECT_EQ(loop_on_database_blank(db.handle, nullptr, &cursor), 0);
  Session().SetCurrent(Session().Open(wb::Drawing{}));
  EXPECT_TRUE(WalkAll(loop_on_database_blank).empty()) << "an empty drawing ends at once";
}
