// Attribute records: open and close, typed values, absent and mistyped reads, removal.
#include <tuple>
#include <vector>

#include "tests/workbench/host_fixture.h"

class AttributeRecords : public HostTest {
 protected:
  void SetUp() override {
    HostTest::SetUp();
    entity = AddGroup();
    record = OpenRecord(entity);
  }
  // Every text and list a test reads is host memory it gives back.
  void TearDown() override {
    EXPECT_EQ(Session().Memory().Outstanding(), 0);
    EXPECT_EQ(Session().Memory().BadReleases(), 0);
  }

  template <typename Value, typename Read>
  std::vector<Value> List(Read read, const char* name) {
    std::int32_t count = -1;
    Value sentinel{};
    Value* list = &sentinel;
    EXPECT_EQ(read(record, name, &count, &list), 1);
    EXPECT_TRUE(count > 0 || list == nullptr) << "an empty list is no host memory";
    std::vector<Value> values(list, list + count);
    log_free(list);
    return values;
  }

  EntityHandle entity = 0;
  RecordHandle record = 0;
};

TEST_F(AttributeRecords, EveryTypeReadsBackWhatWasWritten) {
  const std::vector<float> floats = {1.5F, -2.0F, 3.25F};
  const std::vector<std::int16_t> shorts = {4, -5};
  const std::vector<std::int32_t> longs = {70000, 8, -9};
  ASSERT_EQ(qel_set_string_attribute(record, "@Class=", "HRCamera"), 1);
  ASSERT_EQ(qel_set_short_attribute(record, "@S2D=", -3), 1);
  ASSERT_EQ(qel_set_float_attribute(record, "$tw=", 0.75F, 3), 1);
  ASSERT_EQ(qel_set_float_vector_attribute(record, "tb=", floats.data(), 3, 4), 1);
  ASSERT_EQ(qel_set_short_vector_attribute(record, "@lay=", shorts.data(), 2), 1);
  ASSERT_EQ(qel_set_long_vector_attribute(record, "@CamLst=", 3, longs.data()), 1);
  ASSERT_EQ(qel_set_long_vector_attribute(record, "@none=", 0, nullptr), 1);

  char* text = nullptr;
  std::int16_t shortValue = 0;
  float floatValue = 0;
  std::vector<float> front(2);
  ASSERT_EQ(qel_read_string_attribute(record, "@Class=", &text), 1);
  EXPECT_STREQ(text, "HRCamera");
  log_free(text);
  EXPECT_EQ(qel_read_short_attribute(record, "@S2D=", &shortValue), 1);
  EXPECT_EQ(qel_read_float_attribute(record, "$tw=", &floatValue), 1);
  EXPECT_EQ(qel_read_fixed_float_vector(record, "tb=", front.data(), 2), 1) << "a shorter read takes the front";
  EXPECT_EQ(std::tuple(shortValue, floatValue, front), std::tuple(-3, 0.75F, std::vector{1.5F, -2.0F}));
  EXPECT_EQ(Current().Find(entity)->FindAttribute("tb=")->format, 4);
  EXPECT_EQ(List<std::int32_t>(qel_read_unknown_long_vector, "@CamLst="), longs);
  EXPECT_EQ(List<float>(qel_read_unknown_float_vector, "tb="), floats);
  EXPECT_EQ(List<std::int16_t>(qel_read_unknown_short_vector, "@lay="), shorts);
  EXPECT_TRUE(List<std::int32_t>(qel_read_unknown_long_vector, "@none=").empty());
  float eleven[11] = {};
  EXPECT_EQ(qel_read_fixed_float_vector(record, "tb=", eleven, 11), 0) << "never more than was stored";
  EXPECT_EQ(eleven[0], 0.0F) << "a refused read writes nothing";
}

TEST_F(AttributeRecords, RewritesTakeTheNewTypeAndMistypedReadsAnswer0) {
  ASSERT_EQ(qel_set_string_attribute(record, "a=", "text"), 1);
  ASSERT_EQ(qel_set_string_attribute(record, "b=", "next"), 1);
  ASSERT_EQ(qel_set_short_attribute(record, "a=", 12), 1);
  char* text = nullptr;
  EXPECT_EQ(qel_read_string_attribute(record, "c=", &text), host::kAttributeAbsent);
  EXPECT_EQ(qel_read_string_attribute(record, "a=", &text), 0);
  EXPECT_EQ(text, nullptr);
  const auto& attributes = Current().Find(entity)->attributes;
  ASSERT_EQ(attributes.size(), 2U);
  EXPECT_EQ(std::tie(attributes[0].name, attributes[0].type), std::tuple("a=", wb::AttributeType::Short));
  EXPECT_EQ(attributes[0].text, "") << "no stale value of the old type is kept";
}

TEST_F(AttributeRecords, RecordsNeedALiveEntityInTheirOwnOpenDrawingAndRemovalsAreJournaled) {
  std::int16_t status = 7;
  EXPECT_EQ(qel_open_attribute_record(db.handle, 99, &status), 0);
  EXPECT_EQ(status, 0);
  EXPECT_EQ(qel_open_attribute_record(db.handle + 1, entity, &status), 0);
  EXPECT_EQ(qel_close_attribute_record(db.handle + 1, record), 0);
  ASSERT_EQ(qel_set_string_attribute(record, "@sec=", "0"), 1);
  ASSERT_EQ(qel_remove_attribute_from_record(record, "@sec="), 1);
  EXPECT_EQ(qel_remove_attribute_from_record(record, "@sec="), host::kAttributeAbsent);
  ASSERT_EQ(qel_close_attribute_record(db.handle, record), 1);
  EXPECT_EQ(qel_close_attribute_record(db.handle, record), 0);
  EXPECT_EQ(qel_set_short_attribute(record, "x=", 1), 0);
  EXPECT_EQ(Log().Entries().back(), (wb::JournalEntry{Kind::AttributeRemove, "@sec=", entity, 0}));
  EXPECT_EQ(Log().Names(Kind::AttributeRemove).size(), 1U) << "only the removal that happened is journaled";

  const RecordHandle again = OpenRecord(entity);
  EXPECT_NE(again, record) << "a closed handle is not handed out again";
  ASSERT_EQ(qel_delete_group(db.handle, entity), 1);
  EXPECT_EQ(qel_set_short_attribute(again, "x=", 1), 0);
  EXPECT_EQ(qel_close_attribute_record(db.handle, again), 1);
  EXPECT_EQ(Session().Records().OpenCount(), 0U);
}
