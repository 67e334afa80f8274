// A fresh workbench host per test, and small helpers to call it as the plug-in would.
#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll.h"
#include "shell/host/qeldll_view.h"
#include "workbench/workbench.h"

class HostTest : public ::testing::Test {
 protected:
  using Kind = wb::JournalEntry::Kind;

  void SetUp() override { wb::Workbench::Get().Reset(); }

  static wb::Workbench& Session() { return wb::Workbench::Get(); }
  static wb::Drawing& Current() { return Session().CurrentDrawing(); }
  static const wb::Journal& Log() { return Session().GetJournal(); }
  static wb::ViewState& View() { return Session().View(); }
  static wb::DisplayState& Display() { return Session().Display(); }
  static Status Run(const char* command) { return execute_internal_command(command); }

  static host::LineRecord MakeLine(host::Point3f start, host::Point3f end) {
    host::LineRecord line{};
    line.color = 7;
    line.start = start;
    line.end = end;
    return line;
  }

  static EntityHandle AddLine(float x = 0.0F) {
    const host::LineRecord line = MakeLine({x, 0, 0}, {x + 1, 0, 0});
    EntityHandle entity = 0;
    EXPECT_EQ(qel_add_line(db.handle, &entity, &line), 1);
    return entity;
  }

  static EntityHandle AddGroup() {
    const host::GroupRecord group{};
    EntityHandle entity = 0;
    EXPECT_EQ(qel_create_group(db.handle, &entity, 0, nullptr, "grp", &group), 1);
    return entity;
  }

  static RecordHandle OpenRecord(EntityHandle entity) {
    std::int16_t status = 0;
    const RecordHandle record = qel_open_attribute_record(db.handle, entity, &status);
    EXPECT_EQ(status, 1);
    return record;
  }
};
