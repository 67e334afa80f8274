// A clean window layer for each test: the library's resources, an empty queue and message-box
// log, a scripted user, and a host frame window the way the host gives one.
#pragma once

#include <gtest/gtest.h>

#include <string>

#include "framework/cwnd.h"
#include "framework/scripted_user.h"

class FrameworkTest : public ::testing::Test {
 protected:
  FrameworkTest();
  ~FrameworkTest() override;

  // A visible top-level frame, made the host's main window.
  CWnd& HostFrame();
  // Writes a render where a person can look at it (the folder of the test's renders).
  static std::string SaveRender(const std::string& name, const std::string& svg);

  framework::ScriptedUser user;

 private:
  CWnd frame_;
};
