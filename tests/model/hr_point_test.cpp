// Point values: they read and write no entity of their own, only the class marker.
#include "model/hr_point.h"

#include "tests/model/model_fixture.h"

namespace {

using PointTest = ModelTest;

TEST_F(PointTest, HoldsItsPosition) {
  HRPoint point;
  EXPECT_EQ(point.GetClassName(), "HRPoint");
  EXPECT_EQ(point.GetPosition().Length(), 0.0);
  point.SetPosition(1.5F, -2.0F, 3.0F);
  const HRMath::Vector position = point.GetPosition();
  EXPECT_EQ(position.x, 1.5);
  EXPECT_EQ(position.y, -2.0);
  EXPECT_EQ(position.z, 3.0);
}

TEST_F(PointTest, ReadAndUpdateTouchNothing) {
  const host::EntityHandle entity = AddEntity(host::kTypePoint);
  Find(entity)->header.bytes[8] = 5;
  HRPoint point;
  EXPECT_EQ(point.Read(entity), 0);
  EXPECT_EQ(point.GetEntity(), 0);
  EXPECT_EQ(point.GetHeaderByte8(), 0);
  point.SetEntity(entity);
  EXPECT_EQ(point.Update(), 0);
  EXPECT_TRUE(HostCalls().empty());
}

TEST_F(PointTest, CreateOnlyMarksTheEntityItHolds) {
  const host::EntityHandle entity = AddEntity(host::kTypeLine);
  HRPoint point;
  point.SetEntity(entity);
  EXPECT_EQ(point.Create(), 0);
  EXPECT_EQ(Drawing().LiveCount(), 1U);
  EXPECT_EQ(StringAttribute(entity, "@Class="), "HRPoint");

  HRPoint unstored;
  EXPECT_EQ(unstored.Create(), 0);
  EXPECT_EQ(Drawing().LiveCount(), 1U);
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"@Class="}));
}

TEST_F(PointTest, DeleteOnlyForgetsTheHandle) {
  const host::EntityHandle entity = AddEntity(host::kTypePoint);
  HRPoint point;
  point.SetEntity(entity);
  EXPECT_EQ(point.Delete(), 0);
  EXPECT_FALSE(point.IsStored());
  EXPECT_NE(Find(entity), nullptr);
}

}  // namespace
