// A fresh workbench host per test, with helpers that run host commands as the plug-in does.
#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll.h"
#include "shell/host/qeldll_view.h"
#include "workbench/workbench.h"

class ViewHostTest : public ::testing::Test {
 protected:
  void SetUp() override { wb::Workbench::Get().Reset(); }

  static wb::Workbench& Session() { return wb::Workbench::Get(); }
  static wb::ViewState& View() { return Session().View(); }
  static wb::DisplayState& Display() { return Session().Display(); }

  static host::Status Run(const char* command) { return execute_internal_command(command); }
  static host::Status Overlay(const char* overlay) { return execute_quorvel_overlay(overlay); }

  // The host calls journaled by function name, in order.
  static std::vector<std::string> HostCalls() { return Session().GetJournal().Names(wb::JournalEntry::Kind::HostCall); }
  static std::vector<std::string> Commands() { return Session().GetJournal().Names(wb::JournalEntry::Kind::Command); }
};

// Compares points exactly: the host hands back what it was given, float for float.
inline void ExpectPoint(const host::Point3f& actual, float x, float y, float z) {
  EXPECT_EQ(actual.x, x);
  EXPECT_EQ(actual.y, y);
  EXPECT_EQ(actual.z, z);
}
