// What `pandex info` counts: entities by type, texts told from lines, attribute records,
// class markers and layers in use.
#include <gtest/gtest.h>

#include <sstream>

#include "app/drawing_summary.h"

namespace {

wb::Attribute Text(const char* name, const char* value) {
  wb::Attribute attribute;
  attribute.name = name;
  attribute.type = wb::AttributeType::String;
  attribute.text = value;
  return attribute;
}

wb::Drawing SmallDrawing() {
  wb::Drawing drawing;
  drawing.title = "small";
  drawing.Add(host::kTypeLine).header.bytes[host::kHeaderLayer] = 2;
  wb::Entity& text = drawing.Add(host::kTypeLine);
  text.attributes.push_back({"tb=", wb::AttributeType::FloatVector, 4, {}, 0, 0.0F, std::vector<float>(11, 1.0F), {}, {}});
  text.header.bytes[host::kHeaderLayer] = 2;
  wb::Entity& camera = drawing.Add(host::kTypeGroup);
  camera.attributes.push_back(Text("@Class=", "HRCamera"));
  camera.attributes.push_back(Text("@CAMNAME=", "North"));
  camera.header.bytes[host::kHeaderFlags] = host::kFlagHidden;
  drawing.Add(host::kTypeGroup).attributes.push_back(Text("@Class=", "HRCamera"));
  drawing.Add(host::kTypePoint);
  drawing.Remove(5);
  drawing.layers[7].on = false;
  return drawing;
}

TEST(DrawingSummaryTest, CountsLiveEntitiesByTypeAndTellsTextsFromLines) {
  const app::DrawingSummary summary = app::Summarize(SmallDrawing());
  EXPECT_EQ(summary.title, "small");
  EXPECT_EQ(summary.entities, 4U);
  EXPECT_EQ(summary.hiddenEntities, 1U);
  EXPECT_EQ(summary.nextHandle, 6);
  EXPECT_EQ(summary.entitiesByType, (std::map<std::string, std::size_t>{{"group", 2}, {"line", 1}, {"text", 1}}));
}

TEST(DrawingSummaryTest, CountsAttributeRecordsAndClassMarkers) {
  const app::DrawingSummary summary = app::Summarize(SmallDrawing());
  EXPECT_EQ(summary.attributeRecords, 3U);
  EXPECT_EQ(summary.attributes, 4U);
  EXPECT_EQ(summary.classMarkers, (std::map<std::string, std::size_t>{{"HRCamera", 2}}));
}

TEST(DrawingSummaryTest, ListsLayersInUseAndLayersSwitchedOff) {
  const app::DrawingSummary summary = app::Summarize(SmallDrawing());
  ASSERT_EQ(summary.layers.size(), 3U);
  EXPECT_EQ(summary.layers[0].index, 0);
  EXPECT_EQ(summary.layers[0].entities, 2U);  // both groups
  EXPECT_EQ(summary.layers[1].index, 2);
  EXPECT_EQ(summary.layers[1].entities, 2U);
  EXPECT_EQ(summary.layers[2].index, 7);
  EXPECT_FALSE(summary.layers[2].on);
  EXPECT_EQ(summary.layers[2].entities, 0U);
}

TEST(DrawingSummaryTest, PrintsOneLinePerCount) {
  std::ostringstream out;
  app::PrintSummary(app::Summarize(SmallDrawing()), out);
  const std::string text = out.str();
  EXPECT_NE(text.find("Drawing: small\n"), std::string::npos);
  EXPECT_NE(text.find("Entities: 4 (1 hidden)\n"), std::string::npos);
  EXPECT_NE(text.find("  text: 1\n"), std::string::npos);
  EXPECT_NE(text.find("Attribute records: 3 holding 4 attributes\n"), std::string::npos);
  EXPECT_NE(text.find("  @Class=HRCamera: 2\n"), std::string::npos);
  EXPECT_NE(text.find("  8 Layer 8: 0 entities, off\n"), std::string::npos);
}

}  // namespace
