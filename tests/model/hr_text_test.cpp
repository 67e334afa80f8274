// Text wrappers: the line record plus "t=", "tb=", "$p=", "$ts=", "$tw=" in the host record,
// and the defaults taken from the host's text settings.
#include "model/hr_text.h"

#include "model/hr_line.h"
#include "shell/host/argument_blocks.h"
#include "tests/model/model_fixture.h"

namespace {

class TextTest : public ModelTest {
 protected:
  static std::vector<float> TextBlockOf(host::EntityHandle entity) {
    const wb::Attribute* block = AttributeOf(entity, "tb=");
    return block == nullptr ? std::vector<float>{} : block->floats;
  }
  static float FloatOf(host::EntityHandle entity, const char* name) { return AttributeOf(entity, name)->floatValue; }
  static host::LineRecord HostLine(host::EntityHandle entity) { return wb::ReadRecord<host::LineRecord>(*Find(entity)); }

  // The text block a new text gets from the current settings, as the host stores it.
  static std::vector<float> DefaultBlockFor(const std::string& content) {
    HRText text;
    text.SetText(content);
    text.LoadTextDefaults();
    EXPECT_EQ(text.Create(), 0);
    return TextBlockOf(text.GetEntity());
  }

  static HRText SampleText() {
    globr[22] = 3.5F;
    globr[23] = 0.25F;
    globr[24] = 1.0F;
    globr[25] = 0.8F;
    globr[26] = 12.0F;
    globr[50] = 0.1F;
    globr[57] = 2.0F;
    globr[93] = 0.05F;
    HRText text;
    text.SetText("A-A");
    text.LoadTextDefaults();
    text.SetPoints(1, 2, 0, 2, 2, 0);
    return text;
  }
};

TEST_F(TextTest, NewTextKeepsItsMarkerByteInTheLineRecord) {
  HRText text;
  EXPECT_EQ(text.GetClassName(), "HRText");
  ASSERT_EQ(text.Create(), 0);
  const host::LineRecord stored = HostLine(text.GetEntity());
  EXPECT_EQ(static_cast<std::int8_t>(stored.lineType), -2);
  EXPECT_EQ(stored.color, 0);
  EXPECT_EQ(stored.width, 0);
  EXPECT_EQ(stored.unused, 0);
}

TEST_F(TextTest, CreateWritesTheTextAndItsLayoutValues) {
  HRText text = SampleText();
  EXPECT_EQ(text.Create(), 0);
  const host::EntityHandle entity = text.GetEntity();
  ASSERT_GT(entity, 0);
  EXPECT_EQ(StringAttribute(entity, "t="), "A-A");
  EXPECT_EQ(TextBlockOf(entity), (std::vector<float>{3.5F, 0, 0.25F, 0, 0, 12, 1, 1, 1, 2, 0.1F}));
  EXPECT_EQ(AttributeOf(entity, "tb=")->format, 4);
  EXPECT_EQ(FloatOf(entity, "$p="), 2.0F);
  EXPECT_EQ(AttributeOf(entity, "$p=")->format, 0);
  EXPECT_EQ(FloatOf(entity, "$ts="), 0.05F);
  EXPECT_EQ(AttributeOf(entity, "$ts=")->format, 0);
  EXPECT_EQ(FloatOf(entity, "$tw="), 0.8F);
  EXPECT_EQ(AttributeOf(entity, "$tw=")->format, 3);
  EXPECT_EQ(StringAttribute(entity, "@Class="), "HRText");
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"tb=", "$p=", "$ts=", "$tw=", "@Class="}));
  EXPECT_EQ(HostLine(entity).start.x, 1.0F);
  EXPECT_EQ(HostLine(entity).end.x, 2.0F);
  EXPECT_EQ(text.GetEntityType(), host::kTypeLine);
  EXPECT_EQ(text.GetKind(), 11);
}

TEST_F(TextTest, ReadTakesBackEverythingCreateWrote) {
  HRText original = SampleText();
  ASSERT_EQ(original.Create(), 0);
  HRText loaded;
  EXPECT_EQ(loaded.Read(original.GetEntity()), 0);
  EXPECT_EQ(loaded.GetEntity(), original.GetEntity());
  EXPECT_EQ(loaded.GetText(), "A-A");

  // A copy made from what was read stores the same values.
  ASSERT_EQ(loaded.Create(), 0);
  const host::EntityHandle copy = loaded.GetEntity();
  ASSERT_NE(copy, original.GetEntity());
  EXPECT_EQ(TextBlockOf(copy), TextBlockOf(original.GetEntity()));
  EXPECT_EQ(FloatOf(copy, "$p="), 2.0F);
  EXPECT_EQ(FloatOf(copy, "$ts="), 0.05F);
  EXPECT_EQ(FloatOf(copy, "$tw="), 0.8F);
  EXPECT_EQ(StringAttribute(copy, "t="), "A-A");
  EXPECT_EQ(HostLine(copy).start.y, 2.0F);
}

TEST_F(TextTest, UpdateRewritesTextAndValuesThenMarks) {
  HRText text = SampleText();
  ASSERT_EQ(text.Create(), 0);
  text.SetText("B-B");
  text.SetBlockValue6(2);
  const double position[3] = {5, 6, 7};
  text.SetPosition(position);
  ClearJournal();
  EXPECT_EQ(text.Update(), 0);
  const host::EntityHandle entity = text.GetEntity();
  EXPECT_EQ(AttributeWrites(), (std::vector<std::string>{"t=", "tb=", "$p=", "$ts=", "$tw=", "@Class="}));
  EXPECT_EQ(HostCalls(), (std::vector<std::string>{"qel_update_entity_header", "qel_update_line"}));
  EXPECT_EQ(StringAttribute(entity, "t="), "B-B");
  EXPECT_EQ(TextBlockOf(entity)[6], 2.0F);
  EXPECT_EQ(HostLine(entity).start.z, 7.0F);
  EXPECT_EQ(HostLine(entity).end.x, 5.0F);
}

TEST_F(TextTest, PositionFromFloatsSetsBothPoints) {
  HRText text;
  const float position[3] = {1.25F, 2.5F, 3.75F};
  text.SetPosition(position);
  ASSERT_EQ(text.Create(), 0);
  const host::LineRecord stored = HostLine(text.GetEntity());
  EXPECT_EQ(stored.start.y, 2.5F);
  EXPECT_EQ(stored.end.x, 1.25F);
  EXPECT_EQ(stored.end.z, 3.75F);
}

TEST_F(TextTest, DeleteKeepsTheHandle) {
  HRText text;
  ASSERT_EQ(text.Create(), 0);
  const host::EntityHandle entity = text.GetEntity();
  FailNext("qel_delete_entity");
  EXPECT_EQ(text.Delete(), -20);
  EXPECT_NE(Find(entity), nullptr);
  EXPECT_EQ(text.Delete(), 0);
  EXPECT_EQ(text.GetEntity(), entity);
  EXPECT_EQ(Find(entity), nullptr);
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{entity, 2}}));
}

TEST_F(TextTest, DefaultsKeepElementFiveFrom60To63AndUse88ForDoubleByteTextOtherwise) {
  const std::string doubleByte = "\xE6\x96\xAD\xE9\x9D\xA2";
  globr[26] = 61.0F;
  EXPECT_EQ(DefaultBlockFor(doubleByte)[5], 61.0F);
  globr[26] = 12.0F;
  EXPECT_EQ(DefaultBlockFor(doubleByte)[5], 88.0F);
  EXPECT_EQ(DefaultBlockFor("A")[5], 12.0F);
  globr[26] = 63.0F;
  EXPECT_EQ(DefaultBlockFor(doubleByte)[5], 63.0F);
  globr[26] = 63.5F;
  EXPECT_EQ(DefaultBlockFor(doubleByte)[5], 88.0F);
}

TEST_F(TextTest, NegativeHeightFlagNegatesTheHeightAndTakesTheWidthFactor) {
  globr[22] = 2.5F;
  globr[20] = 0.75F;
  EXPECT_EQ(DefaultBlockFor("A")[0], 2.5F);
  EXPECT_EQ(DefaultBlockFor("A")[7], 1.0F);
  globc[89] = 'f';
  const std::vector<float> block = DefaultBlockFor("A");
  EXPECT_EQ(block[0], -2.5F);
  EXPECT_EQ(block[7], 0.75F);
  EXPECT_EQ(block[8], 1.0F);
  EXPECT_EQ(block[9], 2.0F);
}

TEST_F(TextTest, ReadFailuresGiveTheirCodes) {
  HRText text;
  EXPECT_EQ(text.Read(77), -2);
  EXPECT_EQ(text.Read(AddEntity(host::kTypePoint)), -4);

  HRText stored = SampleText();
  ASSERT_EQ(stored.Create(), 0);
  FailNext("qel_read_line");
  EXPECT_EQ(text.Read(stored.GetEntity()), -17);
  FailNext("qel_open_attribute_record");
  EXPECT_EQ(text.Read(stored.GetEntity()), -17);
}

TEST_F(TextTest, FailedAttributeReadsAreIgnored) {
  HRText stored = SampleText();
  ASSERT_EQ(stored.Create(), 0);
  FailNext("qel_read_string_attribute");
  FailNext("qel_read_fixed_float_vector");
  FailNext("qel_read_float_attribute");
  HRText text;
  EXPECT_EQ(text.Read(stored.GetEntity()), 0);
  EXPECT_EQ(text.GetText(), "");
  EXPECT_EQ(text.GetEntity(), stored.GetEntity());
}

TEST_F(TextTest, WriteFailuresGiveTheirCodes) {
  HRText text = SampleText();
  FailNext("qel_add_text");
  EXPECT_EQ(text.Create(), -27);
  EXPECT_FALSE(text.IsStored());
  EXPECT_EQ(Drawing().LiveCount(), 0U);

  FailNext("qel_open_attribute_record");
  EXPECT_EQ(text.Create(), -9);
  EXPECT_TRUE(text.IsStored());
  EXPECT_EQ(AttributeOf(text.GetEntity(), "tb="), nullptr);

  FailNext("qel_update_line");
  EXPECT_EQ(text.Update(), -27);
  FailNext("qel_open_attribute_record");
  EXPECT_EQ(text.Update(), -9);
  EXPECT_EQ(AttributeOf(text.GetEntity(), "tb="), nullptr);

  // A refused header update is not reported; the rest of the update goes on.
  FailNext("qel_update_entity_header");
  EXPECT_EQ(text.Update(), 0);
  EXPECT_EQ(TextBlockOf(text.GetEntity()).size(), 11U);
}

TEST_F(TextTest, AssignFromTakesEverythingOnlyFromTexts) {
  HRText source = SampleText();
  ASSERT_EQ(source.Create(), 0);
  HRText target;
  const HRText returned = target.AssignFrom(source);
  EXPECT_EQ(returned.GetText(), "A-A");
  EXPECT_EQ(target.GetEntity(), source.GetEntity());
  EXPECT_EQ(target.GetText(), "A-A");
  target.SetEntity(0);
  ASSERT_EQ(target.Create(), 0);
  EXPECT_EQ(TextBlockOf(target.GetEntity()), TextBlockOf(source.GetEntity()));
  EXPECT_EQ(FloatOf(target.GetEntity(), "$tw="), 0.8F);
  EXPECT_EQ(HostLine(target.GetEntity()).start.x, 1.0F);

  HRLine line;
  ASSERT_EQ(line.Create(), 0);
  target.AssignFrom(line);
  EXPECT_EQ(target.GetEntity(), line.GetEntity());
  EXPECT_EQ(target.GetText(), "A-A");
}

}  // namespace
