// The class marker test that tells the plug-in's own entities apart.
#include "model/class_marker.h"

#include "tests/model/model_fixture.h"

namespace {

using ClassMarkerTest = ModelTest;

TEST_F(ClassMarkerTest, MatchesOnlyTheExactClassName) {
  const host::EntityHandle entity = AddEntity(host::kTypePlacedBlock);
  AddStringAttribute(entity, "@Class=", "HRSection");
  EXPECT_TRUE(HasClassMarker(Database(), entity, "HRSection"));
  for (const char* other : {"hrsection", "HRSection ", "HRCamera", "hrSecCam", "HRSectio", ""}) {
    EXPECT_FALSE(HasClassMarker(Database(), entity, other)) << other;
  }
  EXPECT_EQ(Bench().Memory().TotalHandedOut(), 7);
}

TEST_F(ClassMarkerTest, EntitiesWithoutAReadableMarkerBelongToNoClass) {
  const host::EntityHandle unmarked = AddEntity(host::kTypeGroup);
  AddStringAttribute(unmarked, "@Class", "HRCamera");
  EXPECT_FALSE(HasClassMarker(Database(), unmarked, "HRCamera"));

  const host::EntityHandle shortMarker = AddEntity(host::kTypeGroup);
  wb::Attribute& attribute = Find(shortMarker)->attributes.emplace_back();
  attribute.name = "@Class=";
  attribute.type = wb::AttributeType::Short;
  EXPECT_FALSE(HasClassMarker(Database(), shortMarker, ""));

  const host::EntityHandle marked = AddEntity(host::kTypeGroup);
  AddStringAttribute(marked, "@Class=", "HRCamera");
  FailNext("qel_open_attribute_record");
  EXPECT_FALSE(HasClassMarker(Database(), marked, "HRCamera"));
  FailNext("qel_read_string_attribute");
  EXPECT_FALSE(HasClassMarker(Database(), marked, "HRCamera"));
  FailNext("qel_read_string_attribute", 1);
  EXPECT_FALSE(HasClassMarker(Database(), marked, ""));
  EXPECT_FALSE(HasClassMarker(Database(), 999, "HRCamera"));
  EXPECT_TRUE(HasClassMarker(Database(), marked, "HRCamera"));
}

}  // namespace
