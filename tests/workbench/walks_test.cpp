// Database walks: which entities each walk delivers, in what order, and the cursor rules.
#include <vector>

#include "tests/workbench/host_fixture.h"

namespace {

using WalkCall = Status (*)(DatabaseHandle, EntityHandle*, std::int32_t*);

std::vector<EntityHandle> WalkAll(WalkCall walk) {
  std::vector<EntityHandle> seen;
  EntityHandle entity = 0;
  std::int32_t cursor = 0;
  while (walk(db.handle, &entity, &cursor) == 1) seen.push_back(entity);
  return seen;
}

}  // namespace

class DatabaseWalks : public HostTest {
 protected:
  // Handles 1 to 5: 2 is hidden, 4 deleted.
  void SetUp() override {
    HostTest::SetUp();
    for (int i = 0; i < 5; ++i) AddLine(static_cast<float>(i));
    Hide(2);
    ASSERT_EQ(qel_delete_entity(db.handle, 4), 1);
  }
};

TEST_F(DatabaseWalks, VisibleWalkSkipsHiddenAndDeletedEntitiesInHandleOrder) {
  EXPECT_EQ(WalkAll(loop_on_database), (std::vector<EntityHandle>{1, 3, 5}));
}

TEST_F(DatabaseWalks, BlankWalksIncludeHiddenEntities) {
  EXPECT_EQ(WalkAll(loop_on_database_blank), (std::vector<EntityHandle>{1, 2, 3, 5}));
  std::vector<EntityHandle> seen;
  std::vector<std::uint8_t> flags;
  EntityHandle entity = 0;
  std::int32_t cursor = 0;
  host::EntityHeader header{};
  while (loop_on_database_blank_h(db.handle, &entity, &cursor, &header) == 1) {
    seen.push_back(entity);
    flags.push_back(header.bytes[host::kHeaderFlags]);
    EXPECT_EQ(header.bytes[host::kHeaderType], host::kTypeLine);
  }
  EXPECT_EQ(seen, (std::vector<EntityHandle>{1, 2, 3, 5}));
  EXPECT_EQ(flags, (std::vector<std::uint8_t>{0, host::kFlagHidden, 0, 0}));
  EXPECT_EQ(loop_on_database_blank_h(db.handle, &entity, &cursor, nullptr), 0);
}

TEST_F(DatabaseWalks, CursorIsTheNextSlotAndTheEndKeepsAnswering0) {
  EntityHandle entity = 0;
  std::int32_t cursor = 0;
  ASSERT_EQ(loop_on_database(db.handle, &entity, &cursor), 1);
  EXPECT_EQ(cursor, 1);
  ASSERT_EQ(loop_on_database(db.handle, &entity, &cursor), 1);
  EXPECT_EQ(entity, 3);
  EXPECT_EQ(cursor, 3);
  // Kinds share the cursor: a blank walk goes on where the visible one stopped.
  ASSERT_EQ(loop_on_database_blank(db.handle, &entity, &cursor), 1);
  EXPECT_EQ(entity, 5);
  EXPECT_EQ(cursor, 5);
  EXPECT_EQ(loop_on_database_blank(db.handle, &entity, &cursor), 0);
  EXPECT_EQ(entity, 0);
  EXPECT_EQ(loop_on_database_blank(db.handle, &entity, &cursor), 0);

  cursor = 1;
  ASSERT_EQ(loop_on_database_blank(db.handle, &entity, &cursor), 1);
  EXPECT_EQ(entity, 2) << "a walk can resume from any cursor";
}

TEST_F(DatabaseWalks, UnusableStartsAnswer0) {
  EntityHandle entity = 0;
  std::int32_t cursor = -1;
  EXPECT_EQ(loop_on_database_blank(db.handle, &entity, &cursor), 0);
  cursor = 1000;
  EXPECT_EQ(loop_on_database_blank(db.handle, &entity, &cursor), 0);
  cursor = 0;
  EXPECT_EQ(loop_on_database_blank(db.handle + 1, &entity, &cursor), 0);
  EXPECT_EQ(loop_on_database_blank(db.handle, nullptr, &cursor), 0);
  EXPECT_EQ(loop_on_database_blank(db.handle, &entity, nullptr), 0);
}

TEST_F(DatabaseWalks, EntitiesAddedDuringAWalkAreReachedAtTheEnd) {
  std::vector<EntityHandle> seen;
  EntityHandle entity = 0;
  std::int32_t cursor = 0;
  while (loop_on_database(db.handle, &entity, &cursor) == 1) {
    seen.push_back(entity);
    if (entity == 1) AddLine();
  }
  EXPECT_EQ(seen, (std::vector<EntityHandle>{1, 3, 5, 6}));
}

TEST_F(DatabaseWalks, AnEmptyDrawingEndsAtOnce) {
  Session().SetCurrent(Session().Open(wb::Drawing{}));
  EXPECT_TRUE(WalkAll(loop_on_database_blank).empty());
}
