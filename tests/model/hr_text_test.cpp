// Text wrappers: the line record plus "t=", "tb=", "$p=", "$ts=", "$tw=" in the host record,
// and the defaults taken from the host's text settings.
#include "model/hr_text.h"

#include <tuple>

#include "shell/host/argument_blocks.h"
#include "tests/model/model_fixture.h"

namespace {

class TextTest : public ModelTest {
 protected:
  static std::vector<float> TextBlockOf(host::EntityHandle entity) { return AttributeOf(entity, "tb=")->floats; }
  static host::LineRecord HostLine(host::EntityHandle entity) {
    return wb::ReadRecord<host::LineRecord>(*Find(entity));
  }

  // A stored text with every layout value taken from the host's settings.
  static HRText CreatedText(const std::string& content) {
    for (const auto& [index, value] :
         {std::pair{22, 3.5F}, {23, 0.25F}, {24, 1.0F}, {25, 0.8F}, {50, 0.1F}, {57, 2.0F}, {93, 0.05F}}) {
      globr[index] = value;
    }
    HRText text;
    text.SetText(content);
    text.LoadTextDefaults();
    text.SetPoints(1, 2, 0, 2, 2, 0);
    EXPECT_EQ(text.Create(), 0);
    return text;
  }
};

TEST_F(TextTest, CreateWritesTheTextItsLayoutValuesAndItsMarkerByte) {
  globr[26] = 12.0F;
  const host::EntityHandle entity = CreatedText("A-A").GetEntity();
  EXPECT_EQ(static_cast<std::int8_t>(HostLine(entity).lineType), -2);
  EXPECT_EQ(StringAttribute(entity, "t="), "A-A");
  EXPECT_EQ(TextBlockOf(entity), (std::vector<float>{3.5F, 0, 0.25F, 0, 0, 12, 1, 1, 1, 2, 0.1F}));
  EXPECT_EQ(AttributeOf(entity, "tb=")->format, 4);
  for (const auto& [name, value, format] : {std::tuple{"$p=", 2.0F, 0}, {"$ts=", 0.05F, 0}, {"$tw=", 0.8F, 3}}) {
    EXPECT_EQ(AttributeOf(entity, name)->floatValue, value) << name;
    EXPECT_EQ(AttributeOf(entity, name)->format, format) << name;
  }
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"tb=", "$p=", "$ts=", "$tw=", "@Class="}));
}

TEST_F(TextTest, ReadAndAssignFromTakeBackEverythingCreateWrote) {
  const HRText original = CreatedText("A-A");
  HRText loaded;
  EXPECT_EQ(loaded.Read(original.GetEntity()), 0);
  HRText assigned;
  assigned.AssignFrom(loaded);
  for (HRText* copy : {&loaded, &assigned}) {
    copy->SetEntity(0);
    ASSERT_EQ(copy->Create(), 0);
    EXPECT_EQ(Find(copy->GetEntity())->record, Find(original.GetEntity())->record);
    EXPECT_TRUE(Find(copy->GetEntity())->attributes == Find(original.GetEntity())->attributes);
  }
}

TEST_F(TextTest, UpdateRewritesTextAndValuesThenMarks) {
  HRText text = CreatedText("A-A");
  text.SetText("B-B");
  const double position[3] = {5, 6, 7};
  text.SetPosition(position);
  ClearJournal();
  EXPECT_EQ(text.Update(), 0);
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"t=", "tb=", "$p=", "$ts=", "$tw=", "@Class="}));
  EXPECT_EQ(HostCalls(), (std::vector<std::string>{"qel_update_entity_header", "qel_update_line"}));
  EXPECT_EQ(StringAttribute(text.GetEntity(), "t="), "B-B");
  EXPECT_EQ(HostLine(text.GetEntity()).end.z, 7.0F);
}

TEST_F(TextTest, DefaultsTakeElementFiveAndTheHeightSignFromTheSettings) {
  const std::string doubleByte = "\xE6\x96\xAD\xE9\x9D\xA2";
  // Element 5 keeps a setting from 60 to 63; otherwise a double-byte text gets 88.
  for (const auto& [setting, content, expected] : std::vector<std::tuple<float, std::string, float>>{
           {61, doubleByte, 61}, {12, doubleByte, 88}, {12, "A", 12}, {63, doubleByte, 63}, {63.5F, doubleByte, 88}}) {
    globr[26] = setting;
    EXPECT_EQ(TextBlockOf(CreatedText(content).GetEntity())[5], expected) << setting << " " << content;
  }
  globr[20] = 0.75F;
  EXPECT_EQ(TextBlockOf(CreatedText("A").GetEntity())[7], 1.0F);
  globc[89] = 'f';  // a negative height takes the width factor
  EXPECT_EQ(TextBlockOf(CreatedText("A").GetEntity())[0], -3.5F);
  EXPECT_EQ(TextBlockOf(CreatedText("A").GetEntity())[7], 0.75F);
}

}  // namespace
