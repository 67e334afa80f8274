// Attribute records: open and close, typed values, exact names, absent and mistyped reads.
#include <vector>

#include "tests/workbench/host_fixture.h"

class AttributeRecords : public HostTest {
 protected:
  void SetUp() override {
    HostTest::SetUp();
    entity = AddGroup();
    record = OpenRecord(entity);
  }
  void TearDown() override {
    EXPECT_EQ(Session().Memory().Outstanding(), 0);
    EXPECT_EQ(Session().Memory().BadReleases(), 0);
  }
  const wb::Attribute* Stored(const char* name) { return Current().Find(entity)->FindAttribute(name); }

  EntityHandle entity = 0;
  RecordHandle record = 0;
};

TEST_F(AttributeRecords, OpeningNeedsALiveEntityInAnOpenDrawing) {
  std::int16_t status = 7;
  EXPECT_EQ(qel_open_attribute_record(db.handle, 99, &status), 0);
  EXPECT_EQ(status, 0);
  status = 7;
  EXPECT_EQ(qel_open_attribute_record(db.handle + 1, entity, &status), 0);
  EXPECT_EQ(status, 0);
  status = 0;
  const RecordHandle second = qel_open_attribute_record(db.handle, entity, &status);
  EXPECT_EQ(status, 1);
  EXPECT_NE(second, record) << "two open records are two handles";
  EXPECT_EQ(Session().Records().OpenCount(), 2U);
}

TEST_F(AttributeRecords, EveryTypeReadsBackWhatWasWritten) {
  const float floats[] = {1.5F, -2.0F, 3.25F};
  const std::int16_t shorts[] = {4, -5};
  const std::int32_t longs[] = {70000, 8, -9};
  ASSERT_EQ(qel_set_string_attribute(record, "@Class=", "HRCamera"), 1);
  ASSERT_EQ(qel_set_short_attribute(record, "@S2D=", -3), 1);
  ASSERT_EQ(qel_set_float_attribute(record, "$tw=", 0.75F, 3), 1);
  ASSERT_EQ(qel_set_float_vector_attribute(record, "tb=", floats, 3, 4), 1);
  ASSERT_EQ(qel_set_short_vector_attribute(record, "@lay=", shorts, 2), 1);
  ASSERT_EQ(qel_set_long_vector_attribute(record, "@CamLst=", 3, longs), 1);

  char* text = nullptr;
  ASSERT_EQ(qel_read_string_attribute(record, "@Class=", &text), 1);
  EXPECT_STREQ(text, "HRCamera");
  log_free(text);
  std::int16_t shortValue = 0;
  ASSERT_EQ(qel_read_short_attribute(record, "@S2D=", &shortValue), 1);
  EXPECT_EQ(shortValue, -3);
  float floatValue = 0;
  ASSERT_EQ(qel_read_float_attribute(record, "$tw=", &floatValue), 1);
  EXPECT_EQ(floatValue, 0.75F);
  EXPECT_EQ(Stored("$tw=")->format, 3);
  EXPECT_EQ(Stored("tb=")->format, 4);

  float fixedFloats[3] = {};
  ASSERT_EQ(qel_read_fixed_float_vector(record, "tb=", fixedFloats, 3), 1);
  EXPECT_EQ(std::vector<float>(fixedFloats, fixedFloats + 3), std::vector<float>(floats, floats + 3));
  std::int16_t fixedShorts[2] = {};
  ASSERT_EQ(qel_read_fixed_short_vector(record, "@lay=", fixedShorts, 2), 1);
  EXPECT_EQ(fixedShorts[1], -5);

  std::int32_t count = 0;
  std::int32_t* longList = nullptr;
  ASSERT_EQ(qel_read_unknown_long_vector(record, "@CamLst=", &count, &longList), 1);
  EXPECT_EQ(std::vector<std::int32_t>(longList, longList + count), std::vector<std::int32_t>(longs, longs + 3));
  float* floatList = nullptr;
  ASSERT_EQ(qel_read_unknown_float_vector(record, "tb=", &count, &floatList), 1);
  EXPECT_EQ(count, 3);
  EXPECT_EQ(floatList[2], 3.25F);
  std::int16_t* shortList = nullptr;
  ASSERT_EQ(qel_read_unknown_short_vector(record, "@lay=", &count, &shortList), 1);
  EXPECT_EQ(count, 2);
  EXPECT_EQ(shortList[0], 4);
  EXPECT_EQ(Session().Memory().Outstanding(), 3) << "each list is host memory until log_free";
  log_free(longList);
  log_free(floatList);
  log_free(shortList);
}

TEST_F(AttributeRecords, NamesAreTakenExactlyAsGiven) {
  ASSERT_EQ(qel_set_string_attribute(record, "@Class=", "HRSection"), 1);
  char* text = nullptr;
  EXPECT_EQ(qel_read_string_attribute(record, "@Class", &text), host::kAttributeAbsent);
  EXPECT_EQ(qel_read_string_attribute(record, "@Class==", &text), host::kAttributeAbsent);
  EXPECT_EQ(qel_read_string_attribute(record, "@class=", &text), host::kAttributeAbsent);
  EXPECT_EQ(text, nullptr);
  EXPECT_EQ(is_attribute_exist(db.handle, entity, "@Class="), 1);
  EXPECT_EQ(is_attribute_exist(db.handle, entity, "@Class"), 0);

  ASSERT_EQ(qel_set_string_attribute(record, "@Class", "other"), 1);
  EXPECT_EQ(Current().Find(entity)->attributes.size(), 2U) << "\"@Class\" is a second key";
  EXPECT_EQ(Stored("@Class=")->text, "HRSection");
}

TEST_F(AttributeRecords, AbsentNamesAnswer205AndMistypedReadsAnswer0) {
  ASSERT_EQ(qel_set_short_attribute(record, "@S2D=", 1), 1);
  char* text = nullptr;
  std::int16_t shortValue = 0;
  float floatValue = 0;
  float floats[1];
  std::int32_t count = 0;
  std::int32_t* longs = nullptr;
  EXPECT_EQ(qel_read_short_attribute(record, "@type=", &shortValue), host::kAttributeAbsent);
  EXPECT_EQ(qel_read_float_attribute(record, "$p=", &floatValue), host::kAttributeAbsent);
  EXPECT_EQ(qel_read_fixed_float_vector(record, "tb=", floats, 1), host::kAttributeAbsent);
  EXPECT_EQ(qel_read_unknown_long_vector(record, "@CamLst=", &count, &longs), host::kAttributeAbsent);

  EXPECT_EQ(qel_read_string_attribute(record, "@S2D=", &text), 0);
  EXPECT_EQ(qel_read_float_attribute(record, "@S2D=", &floatValue), 0);
  EXPECT_EQ(qel_read_unknown_long_vector(record, "@S2D=", &count, &longs), 0);
  EXPECT_EQ(text, nullptr);
  EXPECT_EQ(longs, nullptr);
  EXPECT_EQ(Session().Memory().TotalHandedOut(), 0);
  EXPECT_EQ(qel_read_short_attribute(record, "@S2D=", nullptr), 0);
  EXPECT_EQ(qel_read_short_attribute(record, nullptr, &shortValue), 0);
  EXPECT_EQ(qel_read_short_attribute(record, "", &shortValue), 0);
}

TEST_F(AttributeRecords, RewritingKeepsThePositionAndTakesTheNewType) {
  ASSERT_EQ(qel_set_string_attribute(record, "a=", "text"), 1);
  ASSERT_EQ(qel_set_string_attribute(record, "b=", "next"), 1);
  ASSERT_EQ(qel_set_short_attribute(record, "a=", 12), 1);
  const auto& attributes = Current().Find(entity)->attributes;
  ASSERT_EQ(attributes.size(), 2U);
  EXPECT_EQ(attributes[0].name, "a=");
  EXPECT_EQ(attributes[0].type, wb::AttributeType::Short);
  EXPECT_EQ(attributes[0].text, "") << "no stale value of the old type is kept";
  EXPECT_EQ(attributes[1].name, "b=");
}

TEST_F(AttributeRecords, FixedVectorReadsRefuseShorterStoredVectors) {
  const float three[] = {1, 2, 3};
  ASSERT_EQ(qel_set_float_vector_attribute(record, "tb=", three, 3, 4), 1);
  float eleven[11] = {};
  EXPECT_EQ(qel_read_fixed_float_vector(record, "tb=", eleven, 11), 0);
  EXPECT_EQ(eleven[0], 0.0F) << "a refused read writes nothing";
  float two[2] = {};
  ASSERT_EQ(qel_read_fixed_float_vector(record, "tb=", two, 2), 1);
  EXPECT_EQ(two[1], 2.0F);
  EXPECT_EQ(qel_read_fixed_float_vector(record, "tb=", two, -1), 0);
  EXPECT_EQ(qel_set_float_vector_attribute(record, "v=", nullptr, 2, 6), 0);
  EXPECT_EQ(qel_set_long_vector_attribute(record, "v=", -1, nullptr), 0);
  EXPECT_EQ(Stored("v="), nullptr);
}

TEST_F(AttributeRecords, EmptyVectorsReadAsCountZeroAndNoList) {
  ASSERT_EQ(qel_set_long_vector_attribute(record, "@CamLst=", 0, nullptr), 1);
  std::int32_t count = -1;
  std::int32_t sentinel = 0;
  std::int32_t* list = &sentinel;
  ASSERT_EQ(qel_read_unknown_long_vector(record, "@CamLst=", &count, &list), 1);
  EXPECT_EQ(count, 0);
  EXPECT_EQ(list, nullptr);
}

TEST_F(AttributeRecords, RemovingTakesTheNameOutAndAnswers205WhenAbsent) {
  ASSERT_EQ(qel_set_string_attribute(record, "@sec=", "0"), 1);
  ASSERT_EQ(qel_remove_attribute_from_record(record, "@sec"), host::kAttributeAbsent);
  ASSERT_EQ(qel_remove_attribute_from_record(record, "@sec="), 1);
  EXPECT_EQ(Stored("@sec="), nullptr);
  EXPECT_EQ(qel_remove_attribute_from_record(record, "@sec="), host::kAttributeAbsent);

  const std::vector<wb::JournalEntry> tail(Log().Entries().end() - 2, Log().Entries().end());
  const std::vector<wb::JournalEntry> expected = {
      {wb::JournalEntry::Kind::AttributeWrite, "@sec=", entity, 0},
      {wb::JournalEntry::Kind::AttributeRemove, "@sec=", entity, 0},
  };
  EXPECT_EQ(tail, expected) << "only the removal that happened is journaled";
}

TEST_F(AttributeRecords, ClosedRecordsAndRecordsOfDeletedEntitiesAreRefused) {
  EXPECT_EQ(qel_close_attribute_record(db.handle + 1, record), 0) << "closed in its own drawing only";
  ASSERT_EQ(qel_close_attribute_record(db.handle, record), 1);
  EXPECT_EQ(qel_close_attribute_record(db.handle, record), 0);
  EXPECT_EQ(qel_set_short_attribute(record, "x=", 1), 0);

  const RecordHandle again = OpenRecord(entity);
  EXPECT_NE(again, record) << "a closed handle is not handed out again";
  ASSERT_EQ(qel_delete_group(db.handle, entity), 1);
  EXPECT_EQ(qel_set_short_attribute(again, "x=", 1), 0);
  std::int16_t value = 0;
  EXPECT_EQ(qel_read_short_attribute(again, "x=", &value), 0);
  EXPECT_EQ(qel_close_attribute_record(db.handle, again), 1);
  EXPECT_EQ(Session().Records().OpenCount(), 0U);
}

TEST_F(AttributeRecords, WritesAreJournaledWithNameAndOwner) {
  const EntityHandle other = AddLine();
  const RecordHandle otherRecord = OpenRecord(other);
  ASSERT_EQ(qel_set_string_attribute(record, "@Class=", "HRGroup"), 1);
  ASSERT_EQ(qel_set_short_attribute(otherRecord, "@S2D=", 1), 1);
  std::int16_t value = 0;
  ASSERT_EQ(qel_read_short_attribute(otherRecord, "@S2D=", &value), 1);
  ASSERT_EQ(qel_close_attribute_record(db.handle, otherRecord), 1);

  std::vector<wb::JournalEntry> writes;
  for (const wb::JournalEntry& entry : Log().Entries()) {
    if (entry.kind == wb::JournalEntry::Kind::AttributeWrite) writes.push_back(entry);
  }
  const std::vector<wb::JournalEntry> expected = {
      {wb::JournalEntry::Kind::AttributeWrite, "@Class=", entity, 0},
      {wb::JournalEntry::Kind::AttributeWrite, "@S2D=", other, 0},
  };
  EXPECT_EQ(writes, expected);
}
