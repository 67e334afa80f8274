// A fresh workbench host per test, and small helpers to call it as the plug-in would.
#pragma once

#include <gtest/gtest.h>

#include <string>

#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll.h"
#include "workbench/workbench.h"

class HostTest : public ::testing::Test {
 protected:
  void SetUp() override { wb::Workbench::Get().Reset(); }

  static wb::Workbench& Session() { return wb::Workbench::Get(); }
  static wb::Drawing& Current() { return Session().CurrentDrawing(); }
  static const wb::Journal& Log() { return Session().GetJournal(); }

  static host::LineRecord MakeLine(float x1, float y1, float z1, float x2, float y2, float z2) {
    host::LineRecord line{};
    line.lineType = 3;
    line.color = 7;
    line.width = 2;
    line.start = {x1, y1, z1};
    line.end = {x2, y2, z2};
    return line;
  }

  static EntityHandle AddLine(float x = 0.0F) {
    const host::LineRecord line = MakeLine(x, 0, 0, x + 1, 0, 0);
    EntityHandle entity = 0;
    EXPECT_EQ(qel_add_line(db.handle, &entity, &line), 1);
    return entity;
  }

  static EntityHandle AddGroup(const char* name = "grp") {
    const host::GroupRecord group{};
    EntityHandle entity = 0;
    EXPECT_EQ(qel_create_group(db.handle, &entity, 0, nullptr, name, &group), 1);
    return entity;
  }

  static RecordHandle OpenRecord(EntityHandle entity) {
    std::int16_t status = 0;
    const RecordHandle record = qel_open_attribute_record(db.handle, entity, &status);
    EXPECT_EQ(status, 1);
    return record;
  }

  static void SetString(EntityHandle entity, const char* name, const char* text) {
    const RecordHandle record = OpenRecord(entity);
    EXPECT_EQ(qel_set_string_attribute(record, name, text), 1);
    EXPECT_EQ(qel_close_attribute_record(db.handle, record), 1);
  }

  // Reads a string attribute the way the plug-in does: copy, then log_free.
  static std::string ReadString(EntityHandle entity, const char* name, Status* result = nullptr) {
    const RecordHandle record = OpenRecord(entity);
    char* text = nullptr;
    const Status status = qel_read_string_attribute(record, name, &text);
    std::string copy = text == nullptr ? std::string{} : std::string{text};
    log_free(text);
    EXPECT_EQ(qel_close_attribute_record(db.handle, record), 1);
    if (result != nullptr) *result = status;
    return copy;
  }

  static void Hide(EntityHandle entity) {
    host::EntityHeader header{};
    ASSERT_EQ(qel_read_entity_header(db.handle, entity, &header), 1);
    header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
    ASSERT_EQ(qel_update_entity_header(db.handle, entity, &header), 1);
  }
};
