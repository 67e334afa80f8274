// A freshly reset host with the library loaded, for tests of the plug-in's shell.
#pragma once

#include <gtest/gtest.h>

#include "shell/plugin_exports.h"
#include "workbench/workbench.h"

class LoadedPluginTest : public ::testing::Test {
 protected:
  void SetUp() override {
    wb::Workbench::Get().Reset();
    wb::Workbench::Get().LoadPlugin({pandex::kExports.attach, pandex::kExports.detach, pandex::kExports.entry});
  }
  void TearDown() override {
    wb::Workbench::Get().UnloadPlugin();
    EXPECT_EQ(wb::Workbench::Get().Memory().Outstanding(), 0);
  }
};
