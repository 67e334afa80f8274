// The window-layer test fixture.
#include "tests/framework/framework_fixture.h"

#include <filesystem>
#include <fstream>

#include "framework/cwinapp.h"
#include "framework/message_box.h"
#include "framework/window_classes.h"
#include "resources/resource_module.h"

FrameworkTest::FrameworkTest() {
  framework::SetResourceModule(&resources::Module());
  framework::ResetMessageQueue();
  framework::ClearMessageBoxLog();
}

FrameworkTest::~FrameworkTest() {
  if (frame_.m_hWnd) frame_.DestroyWindow();
  framework::SetHostMainWindow(HWND());
  framework::ResetMessageQueue();
  framework::SetResourceModule(nullptr);
}

CWnd& FrameworkTest::HostFrame() {
  if (!frame_.m_hWnd) {
    frame_.CreateEx(0, framework::kDialogClass, "Host", WS_OVERLAPPED | WS_CAPTION | WS_SYSMENU | WS_VISIBLE,
                    CRect(20, 20, 420, 520), nullptr, 0);
    framework::SetHostMainWindow(frame_.m_hWnd);
  }
  return frame_;
}

std::string FrameworkTest::SaveRender(const std::string& name, const std::string& svg) {
  const std::filesystem::path folder = std::filesystem::path(PANDEX_RENDER_DIR);
  std::filesystem::create_directories(folder);
  const std::filesystem::path file = folder / (name + ".svg");
  std::ofstream(file, std::ios::binary) << svg;
  return file.string();
}
