// The wrapper classes side by side: what each creates and deletes, and which class the entity
// factory picks for an entity.
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

// Owners rename a wrapper before creating it, so that the marker names the owner.
std::unique_ptr<HRPrimitive> Renamed(std::unique_ptr<HRPrimitive> wrapper, const char* className) {
  wrapper->SetClassName(className);
  return wrapper;
}

TEST_F(WrapEntityTest, EveryCreatedEntityIsMarkedWrapsBackIntoItsClassAndDeletes) {
  struct Case {
    std::unique_ptr<HRPrimitive> wrapper;
    const char* className;
    const char* name;  // the host's entity name
    std::uint8_t type;
    bool recordsRemoval;
    bool keepsHandle;
  };
  Case cases[] = {{std::make_unique<HRLine>(), "HRLine", "", host::kTypeLine, true, false},
                  {std::make_unique<HRText>(), "HRText", "", host::kTypeLine, true, true},
                  {std::make_unique<HRBlock>(), "HRBlock", "blk", host::kTypeBlock, true, false},
                  {std::make_unique<HRGroup>(), "HRGroup", "grp", host::kTypeGroup, false, false},
                  {Renamed(std::make_unique<HRGroup>(), "hrSecCam"), "hrSecCam", "grp", host::kTypeGroup, false, false},
                  {std::make_unique<HRPlacedBlock>(), "HRPlacedBlock", "blk", host::kTypePlacedBlock, true, false},
                  {std::make_unique<HRPlacedObject>(), "HRPlacedObject", "", host::kTypeElement, true, false}};
  for (Case& c : cases) {
    SCOPED_TRACE(c.className);
    ASSERT_EQ(c.wrapper->Create(), 0);
    const host::EntityHandle entity = c.wrapper->GetEntity();
    EXPECT_EQ(StringAttribute(entity, "@Class="), c.className);
    EXPECT_EQ(Find(entity)->name, c.name);
    std::unique_ptr<HRPrimitive> wrapped;
    EXPECT_EQ(WrapEntity(Database(), entity, wrapped), 0);
    EXPECT_EQ(ClassOf(wrapped), ClassOf(c.wrapper));
    EXPECT_EQ(wrapped->GetEntityType(), c.type);

    ClearJournal();
    EXPECT_EQ(c.wrapper->Delete(), 0);
    EXPECT_EQ(Find(entity), nullptr);
    EXPECT_EQ(c.wrapper->IsStored(), c.keepsHandle);
    EXPECT_EQ(ChangeRecords(), std::vector<ChangeRecord>(c.recordsRemoval ? 1U : 0U, ChangeRecord(entity, 2)));
  }
}

TEST_F(WrapEntityTest, PointsAreWrappedUnreadAndOtherTypesAsAnUnreadUnknownWithMinus4) {
  const host::EntityHandle point = AddEntity(host::kTypePoint);
  std::unique_ptr<HRPrimitive> object;
  EXPECT_EQ(WrapEntity(Database(), point, object), 0);
  EXPECT_EQ(ClassOf(object), typeid(HRPoint));
  EXPECT_FALSE(object->IsStored());
  object->SetEntity(point);  // a point creates nothing, it only marks the entity it holds
  EXPECT_EQ(object->Create(), 0);
  EXPECT_EQ(Drawing().LiveCount(), 1U);
  EXPECT_EQ(StringAttribute(point, "@Class="), "HRPoint");
  for (const std::uint8_t type : std::initializer_list<std::uint8_t>{2, 3, 5, 6, 7, 9, 0, 13}) {
    object = std::make_unique<HRLine>();
    EXPECT_EQ(WrapEntity(Database(), AddEntity(type), object), -4) << int{type};
    EXPECT_EQ(ClassOf(object), typeid(HRUnknown)) << int{type};
  }
}

TEST_F(WrapEntityTest, AnUnreadableEntityGivesMinus4OrTheWrappersOwnReadResult) {
  std::unique_ptr<HRPrimitive> object;
  EXPECT_EQ(WrapEntity(Database(), 1234, object), -4);
  EXPECT_EQ(ClassOf(object), typeid(HRUnknown));
  const host::EntityHandle group = AddEntity(host::kTypeGroup);
  FailNext("qel_read_entity_header");
  EXPECT_EQ(WrapEntity(Database(), group, object), -4);
  EXPECT_EQ(ClassOf(object), typeid(HRUnknown));
  FailNext("qel_read_line");
  EXPECT_EQ(WrapEntity(Database(), AddEntity(host::kTypeLine), object), -17);
  EXPECT_EQ(ClassOf(object), typeid(HRLine));
  wb::Drawing other;  // the given database, not the current one, is read: its entity 2 is a group
  other.Add(host::kTypeArc);
  other.Add(host::kTypeGroup);
  EXPECT_EQ(WrapEntity(Bench().Open(std::move(other)), 2, object), 0);
}

}  // namespace
