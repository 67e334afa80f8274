// Block insertions: the placement matrix and the placed block travel whole through the host.
#include "model/hr_placed_block.h"

#include "math/vector.h"
#include "model/hr_block.h"
#include "tests/model/model_fixture.h"

namespace {

class PlacedBlockTest : public ModelTest {
 protected:
  static host::PlacedBlockRecord HostRecord(host::EntityHandle entity) {
    return wb::ReadRecord<host::PlacedBlockRecord>(*Find(entity));
  }
  static HRMath::Matrix SamplePlacement() {
    HRMath::Matrix mirror;
    mirror.SetMirror(1, 0, 0);
    HRMath::Matrix shift;
    shift.SetTranslation(0.1, 20, -3);
    return mirror.Multiply(shift);
  }
};

TEST_F(PlacedBlockTest, ResetStateIsAnUnstoredInsertionOfNothing) {
  HRPlacedBlock placed;
  EXPECT_EQ(placed.GetClassName(), "HRPlacedBlock");
  EXPECT_EQ(placed.GetName(), "blk");
  EXPECT_EQ(placed.GetBlock(), 0);
  EXPECT_EQ(placed.GetEntity(), 0);
  EXPECT_EQ(placed.GetHeaderByte9(), 1);
  EXPECT_EQ(placed.GetEntityType(), 11);
  const HRMath::Matrix placement = placed.GetPlacement();
  for (int i = 0; i < 16; ++i) EXPECT_EQ(placement.Get(i / 4, i % 4), i % 5 == 0 ? 1.0 : 0.0) << i;
}

TEST_F(PlacedBlockTest, CreateStoresBlockAndPlacementAndMarksTheEntity) {
  HRBlock block;
  ASSERT_EQ(block.Create(), 0);
  HRPlacedBlock placed;
  placed.SetClassName("HRSection");
  EXPECT_EQ(placed.SetBlock(block), 0);
  placed.SetPlacement(SamplePlacement());
  EXPECT_EQ(placed.Create(), 0);
  const host::EntityHandle entity = placed.GetEntity();
  ASSERT_GT(entity, 0);
  const host::PlacedBlockRecord stored = HostRecord(entity);
  EXPECT_EQ(stored.block, block.GetEntity());
  EXPECT_EQ(stored.placement[0], -1.0);
  EXPECT_EQ(stored.placement[12], 0.1);
  EXPECT_EQ(stored.placement[13], 20.0);
  EXPECT_EQ(Find(entity)->name, "blk");
  EXPECT_EQ(StringAttribute(entity, "@Class="), "HRSection");
  EXPECT_EQ(placed.GetEntityType(), host::kTypePlacedBlock);
  EXPECT_EQ(placed.GetKind(), 8);
}

TEST_F(PlacedBlockTest, ReadTakesPlacementBlockAndName) {
  HRPlacedBlock created;
  created.SetPlacement(SamplePlacement());
  HRBlock block;
  ASSERT_EQ(block.Create(), 0);
  created.SetBlock(block);
  ASSERT_EQ(created.Create(), 0);
  Find(created.GetEntity())->name = "instance";

  HRPlacedBlock placed;
  EXPECT_EQ(placed.Read(created.GetEntity()), 0);
  EXPECT_EQ(placed.GetEntity(), created.GetEntity());
  EXPECT_EQ(placed.GetBlock(), block.GetEntity());
  EXPECT_EQ(placed.GetName(), "instance");
  const HRMath::Vector moved = HRMath::Vector(2, 0, 0).Transform(placed.GetPlacement());
  EXPECT_EQ(moved.x, -2 + 0.1);
  EXPECT_EQ(moved.y, 20.0);
}

TEST_F(PlacedBlockTest, UpdateWritesTheRecordAndEmptiesTheName) {
  HRPlacedBlock placed;
  ASSERT_EQ(placed.Create(), 0);
  placed.SetPlacement(SamplePlacement());
  EXPECT_EQ(placed.Update(), 0);
  EXPECT_EQ(HostRecord(placed.GetEntity()).placement[14], -3.0);
  EXPECT_EQ(placed.GetName(), "");
  EXPECT_EQ(HostCalls().back(), "qel_update_placed_block");
}

TEST_F(PlacedBlockTest, DeleteRecordsTheRemovalAndResetsEvenWhenTheHostRefuses) {
  HRPlacedBlock placed;
  placed.SetPlacement(SamplePlacement());
  ASSERT_EQ(placed.Create(), 0);
  const host::EntityHandle entity = placed.GetEntity();
  EXPECT_EQ(placed.Delete(), 0);
  EXPECT_EQ(Find(entity), nullptr);
  EXPECT_FALSE(placed.IsStored());
  EXPECT_EQ(placed.GetName(), "blk");
  EXPECT_EQ(placed.GetPlacement().Get(0, 0), 1.0);
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{entity, 2}}));

  ASSERT_EQ(placed.Create(), 0);
  FailNext("qel_delete_entity");
  EXPECT_EQ(placed.Delete(), 0);
  EXPECT_FALSE(placed.IsStored());
}

TEST_F(PlacedBlockTest, FailuresGiveTheirCodes) {
  HRPlacedBlock placed;
  FailNext("qel_add_placed_block");
  EXPECT_EQ(placed.Create(), -25);
  EXPECT_EQ(Drawing().LiveCount(), 0U);
  EXPECT_EQ(placed.Read(9), -2);

  ASSERT_EQ(placed.Create(), 0);
  FailNext("qel_read_placed_block");
  EXPECT_EQ(placed.Read(placed.GetEntity()), -24);
  FailNext("qel_update_placed_block");
  EXPECT_EQ(placed.Update(), -26);
  EXPECT_EQ(placed.GetName(), "blk");

  // There is no type check of its own: the host refuses to read a line as an insertion.
  EXPECT_EQ(placed.Read(AddEntity(host::kTypeLine)), -24);
}

TEST_F(PlacedBlockTest, AHostNameOfNullReadsAsEmpty) {
  HRPlacedBlock created;
  ASSERT_EQ(created.Create(), 0);
  FailNext("qel_read_placed_block", 1);
  HRPlacedBlock placed;
  EXPECT_EQ(placed.Read(created.GetEntity()), 0);
  EXPECT_EQ(placed.GetName(), "");
}

}  // namespace
