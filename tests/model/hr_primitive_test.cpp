// The base wrapper: header reads and updates, visibility, classification and the attribute
// family, run through HRUnknown, which keeps every base operation; and the class marker test.
#include "model/hr_primitive.h"

#include "model/class_marker.h"
#include "model/hr_unknown.h"
#include "shell/host/qeldll.h"
#include "tests/model/model_fixture.h"

namespace {

using PrimitiveTest = ModelTest;

TEST_F(PrimitiveTest, ReadAndUpdateTheHeaderWhileCreateAndDeleteLeaveTheHostAlone) {
  const host::EntityHandle inFirst = AddEntity(host::kTypeArc);
  wb::Drawing second;
  second.Add(host::kTypeCircle);
  second.Add(host::kTypeSolid);
  SetCurrentDatabase(Bench().Open(std::move(second)));
  HRUnknown wrapper;
  EXPECT_EQ(wrapper.Read(2), 0);  // the current database
  EXPECT_EQ(wrapper.GetEntityType(), host::kTypeSolid);
  SetCurrentDatabase(Database());
  Find(inFirst)->header.bytes[10] = 0x21;
  EXPECT_EQ(wrapper.Read(inFirst), 0);
  EXPECT_EQ(wrapper.GetFlags(), 0x21);
  Find(inFirst)->header.bytes[10] = 0;
  EXPECT_EQ(wrapper.Create() | wrapper.Update() | wrapper.Delete(), 0);
  EXPECT_EQ(Find(inFirst)->header.bytes[10], 0x21);
  EXPECT_EQ(HostCalls(), (std::vector<std::string>{"qel_update_entity_header"}));
  wrapper.SetEntity(-1);
  EXPECT_FALSE(wrapper.IsStored());
}

TEST_F(PrimitiveTest, HideAndShowTouchOnlyBitSevenAndRecordTheChangeEvenWhenRefused) {
  const host::EntityHandle entity = AddEntity(host::kTypeArc);
  Find(entity)->header.bytes[10] = 0x7F;
  HRUnknown wrapper;
  ASSERT_EQ(wrapper.Read(entity), 0);
  EXPECT_EQ(wrapper.Hide(), 0);
  EXPECT_EQ(Find(entity)->header.bytes[10], 0xFF);
  EXPECT_EQ(wrapper.Show(), 0);
  EXPECT_EQ(Find(entity)->header.bytes[10], 0x7F);
  FailNext("qel_update_entity_header");
  EXPECT_EQ(wrapper.Hide(), 0);
  EXPECT_EQ(Find(entity)->header.bytes[10], 0x7F);
  EXPECT_EQ(ChangeRecords(),
            (std::vector<ChangeRecord>{{entity, 5}, {-1, -1}, {entity, 5}, {-1, -1}, {entity, 5}, {-1, -1}}));
}

TEST_F(PrimitiveTest, KindFollowsTheEntityTypeAndALineWithATextBlockIsEleven) {
  const std::int16_t kinds[] = {12, 2, 4, 5, 7, 3, 12, 12, 1, 6, 9, 10, 8, 12};  // of types 0 to 13
  HRUnknown wrapper;
  for (std::uint8_t type = 0; type < 14; ++type) {
    ASSERT_EQ(wrapper.Read(AddEntity(type)), 0);
    EXPECT_EQ(wrapper.GetKind(), kinds[type]) << "type " << int{type};
  }
  const host::EntityHandle text = AddEntity(host::kTypeLine);
  AddStringAttribute(text, "tb=", "");
  ASSERT_EQ(wrapper.Read(text), 0);
  EXPECT_EQ(wrapper.GetKind(), 11);
}

TEST_F(PrimitiveTest, StringAttributeNamesReachTheHostWithExactlyOneEqualsSign) {
  HRUnknown wrapper;
  wrapper.SetEntity(AddEntity(host::kTypeGroup));
  const char* const names[] = {"@Class", "@Class=", "@Class=="};
  for (const char* name : names) EXPECT_EQ(wrapper.SetStringAttribute(name, name), 0);
  const float floats[1] = {1.5F};
  EXPECT_EQ(wrapper.SetShortAttribute("@S2D", 7), 0);  // only strings and short reads are made canonical
  EXPECT_EQ(wrapper.SetFloatVectorAttribute("@dir", floats, 1), 0);
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"@Class=", "@Class=", "@Class=", "@S2D", "@dir"}));
  EXPECT_EQ(AttributeOf(wrapper.GetEntity(), "@dir")->format, 6);
  EXPECT_EQ(Find(wrapper.GetEntity())->attributes.size(), 3U);
  std::string text;
  for (const char* name : names) {
    EXPECT_EQ(wrapper.GetStringAttribute(name, text), 0);
    EXPECT_EQ(text, "@Class==") << name;
  }
  FailNext("qel_read_string_attribute", 1);  // success without a text reads as empty
  EXPECT_EQ(wrapper.GetStringAttribute("@Class", text), 0);
  EXPECT_EQ(text, "");
}

using ClassMarkerTest = ModelTest;

TEST_F(ClassMarkerTest, MatchesOnlyTheExactClassNameAndReleasesEveryText) {
  const host::EntityHandle entity = AddEntity(host::kTypePlacedBlock);
  AddStringAttribute(entity, "@Class=", "HRSection");
  EXPECT_TRUE(HasClassMarker(Database(), entity, "HRSection"));
  for (const char* name : {"hrsection", "HRSection ", "HRSectio", ""})
    EXPECT_FALSE(HasClassMarker(Database(), entity, name));
  EXPECT_EQ(Bench().Memory().TotalHandedOut(), 5);
}

TEST_F(ClassMarkerTest, EntitiesWithoutAReadableMarkerBelongToNoClass) {
  const host::EntityHandle entity = AddEntity(host::kTypeGroup);
  AddStringAttribute(entity, "@Class", "HRCamera");
  EXPECT_FALSE(HasClassMarker(Database(), entity, "HRCamera"));
  AddStringAttribute(entity, "@Class=", "HRCamera");
  Find(entity)->attributes.back().type = wb::AttributeType::Short;
  EXPECT_FALSE(HasClassMarker(Database(), entity, ""));
  Find(entity)->attributes.back().type = wb::AttributeType::String;
  FailNext("qel_open_attribute_record");
  EXPECT_FALSE(HasClassMarker(Database(), entity, "HRCamera"));
  FailNext("qel_read_string_attribute");
  EXPECT_FALSE(HasClassMarker(Database(), entity, "HRCamera"));
  FailNext("qel_read_string_attribute", 1);  // success without a text matches not even ""
  EXPECT_FALSE(HasClassMarker(Database(), entity, ""));
  EXPECT_TRUE(HasClassMarker(Database(), entity, "HRCamera"));
}

}  // namespace
