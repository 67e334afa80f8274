// The entity factory: which class wraps which entity, and what the caller receives.
#include "model/wrap_entity.h"

#include <typeinfo>

#include "model/hr_block.h"
#include "model/hr_group.h"
#include "model/hr_line.h"
#include "model/hr_placed_block.h"
#include "model/hr_placed_object.h"
#include "model/hr_point.h"
#include "model/hr_text.h"
#include "model/hr_unknown.h"
#include "tests/model/model_fixture.h"

namespace {

using WrapEntityTest = ModelTest;

const std::type_info& ClassOf(const std::unique_ptr<HRPrimitive>& object) {
  const HRPrimitive& wrapper = *object;
  return typeid(wrapper);
}

TEST_F(WrapEntityTest, EachWrappedTypeGetsItsClassAndIsRead) {
  struct Case {
    std::uint8_t type;
    const std::type_info& wrapper;
  };
  const Case cases[] = {
      {host::kTypeLine, typeid(HRLine)},          {host::kTypeElement, typeid(HRPlacedObject)},
      {host::kTypeGroup, typeid(HRGroup)},        {host::kTypeBlock, typeid(HRBlock)},
      {host::kTypePlacedBlock, typeid(HRPlacedBlock)},
  };
  for (const Case& c : cases) {
    const host::EntityHandle entity = AddEntity(c.type);
    std::unique_ptr<HRPrimitive> object;
    EXPECT_EQ(WrapEntity(Database(), entity, object), 0) << int{c.type};
    ASSERT_NE(object, nullptr);
    EXPECT_EQ(ClassOf(object), c.wrapper) << int{c.type};
    EXPECT_EQ(object->GetEntity(), entity) << int{c.type};
    EXPECT_EQ(object->GetEntityType(), c.type);
  }
}

TEST_F(WrapEntityTest, LinesWithATextBlockBecomeTexts) {
  HRText created;
  created.SetText("label");
  ASSERT_EQ(created.Create(), 0);
  std::unique_ptr<HRPrimitive> object;
  EXPECT_EQ(WrapEntity(Database(), created.GetEntity(), object), 0);
  const auto* text = dynamic_cast<const HRText*>(object.get());
  ASSERT_NE(text, nullptr);
  EXPECT_EQ(text->GetText(), "label");
}

TEST_F(WrapEntityTest, PointsAreWrappedButReadNothing) {
  const host::EntityHandle entity = AddEntity(host::kTypePoint);
  std::unique_ptr<HRPrimitive> object;
  EXPECT_EQ(WrapEntity(Database(), entity, object), 0);
  EXPECT_EQ(ClassOf(object), typeid(HRPoint));
  EXPECT_FALSE(object->IsStored());
}

TEST_F(WrapEntityTest, UnwrappedTypesGiveAnUnreadUnknownAndMinus4) {
  const std::uint8_t unwrapped[] = {2, 3, 5, 6, 7, 9, 0, 13};
  for (const std::uint8_t type : unwrapped) {
    const host::EntityHandle entity = AddEntity(type);
    std::unique_ptr<HRPrimitive> object = std::make_unique<HRLine>();
    EXPECT_EQ(WrapEntity(Database(), entity, object), -4) << int{type};
    ASSERT_NE(object, nullptr);
    EXPECT_EQ(ClassOf(object), typeid(HRUnknown)) << int{type};
    EXPECT_FALSE(object->IsStored());
    EXPECT_EQ(object->GetEntityType(), 0);
  }
}

TEST_F(WrapEntityTest, AnUnreadableHeaderGivesAnUnknownAndMinus4) {
  std::unique_ptr<HRPrimitive> object;
  EXPECT_EQ(WrapEntity(Database(), 1234, object), -4);
  EXPECT_EQ(ClassOf(object), typeid(HRUnknown));

  const host::EntityHandle entity = AddEntity(host::kTypeGroup);
  FailNext("qel_read_entity_header");
  EXPECT_EQ(WrapEntity(Database(), entity, object), -4);
  EXPECT_EQ(ClassOf(object), typeid(HRUnknown));
}

TEST_F(WrapEntityTest, TheWrappersReadResultIsTheFactorysResult) {
  const host::EntityHandle line = AddEntity(host::kTypeLine);
  std::unique_ptr<HRPrimitive> object;
  FailNext("qel_read_line");
  EXPECT_EQ(WrapEntity(Database(), line, object), -17);
  EXPECT_EQ(ClassOf(object), typeid(HRLine));

  const host::EntityHandle group = AddEntity(host::kTypeGroup);
  FailNext("qel_read_group");
  EXPECT_EQ(WrapEntity(Database(), group, object), -4);
  EXPECT_EQ(ClassOf(object), typeid(HRGroup));
}

TEST_F(WrapEntityTest, ReadsFromTheGivenDatabase) {
  wb::Drawing other;
  other.Add(host::kTypeArc);
  other.Add(host::kTypeGroup);
  const host::DatabaseHandle otherDatabase = Bench().Open(std::move(other));
  AddEntity(host::kTypeLine);
  AddEntity(host::kTypeLine);
  std::unique_ptr<HRPrimitive> object;
  EXPECT_EQ(WrapEntity(otherDatabase, 2, object), 0);
  EXPECT_EQ(ClassOf(object), typeid(HRGroup));
}

}  // namespace
