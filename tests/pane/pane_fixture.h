// The workbench's main window with the plug-in loaded and its pane shown, driven by the same
// script runner as the pane command; readers of what the drawing and the windows hold after.
#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "app/pane_script/pane_script_runner.h"
#include "workbench/drawing.h"
#include "workbench/host_ui/main_frame.h"
#include "workbench/workbench.h"

class PaneTest : public ::testing::Test {
 protected:
  // The drawing the test starts from: the sample house, or an empty drawing.
  enum class Start { kSampleHouse, kEmptyDrawing };

  void SetUp() override { Open(Start::kSampleHouse); }
  void TearDown() override;

  // Opens a drawing in a fresh workbench, loads the plug-in, makes the main window (answering
  // for the pane manager or not) and shows the pane.
  void Open(Start start, bool docking = true);
  void Open(wb::Drawing drawing, bool docking = true);
  // Destroys the main window and unloads the plug-in; the drawing stays open.
  void Close();

  // Runs script lines through the pane command's runner; answers what they printed.
  std::string Run(std::string_view lines);
  // The message of the first line that cannot be done (empty when all could).
  std::string RunFailing(std::string_view lines);
  // The tree the pane shows, as "print" writes it.
  std::string Tree() { return Run("print"); }

  static wb::Workbench& Bench() { return wb::Workbench::Get(); }
  static wb::Drawing& Drawing() { return Bench().CurrentDrawing(); }
  // Live entities whose "@Class=" is exactly `className`, in handle order.
  static std::vector<const wb::Entity*> OfClass(const std::string& className);
  // The one camera, section camera or plan camera entity with this name.
  static const wb::Entity& CameraNamed(const std::string& name, const std::string& className = "HRCamera");
  static std::vector<float> Floats(const wb::Entity& entity, const char* name);
  static std::int16_t Short(const wb::Entity& entity, const char* name);
  static std::string Text(const wb::Entity& entity, const char* name);
  static std::vector<std::int32_t> Longs(const wb::Entity& entity, const char* name);
  // The pane manager's calls (with the pane id) and the camera manager's switches, in order.
  static std::vector<std::string> PaneCalls();

  wb::ui::MainFrame& Frame() { return *frame_; }
  HWND PaneWindow() const;
  // Where a pane control sits in the pane's client area.
  CRect Placed(int id) const;

 private:
  std::unique_ptr<wb::ui::MainFrame> frame_;
  std::size_t windowsBefore_ = 0;
};
