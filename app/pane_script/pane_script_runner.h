// Running a pane script: a scripted user does each action through the input entry points, in
// the workbench's main frame with the plug-in's pane in it. The runner is also the user's
// answer to anything that waits for input (a message box, the host asking for points): the
// next lines of the script run while it waits, as a person would go on working in the window
// that opened. A picture of the screen can be written after every action.
#pragma once

#include <cstddef>
#include <optional>
#include <ostream>
#include <string>

#include "app/pane_script/pane_script.h"
#include "framework/scripted_user.h"
#include "workbench/host_ui/main_frame.h"

namespace app::script {

struct RunOptions {
  std::string drawingPath;   // where "save" without a file writes; empty: the drawing has none
  std::string renderFolder;  // where the pictures go; empty: none are made
};

class Runner final : public framework::InputSource {
 public:
  Runner(wb::ui::MainFrame& frame, RunOptions options, std::ostream& out);
  Runner(const Runner&) = delete;
  Runner& operator=(const Runner&) = delete;
  ~Runner();

  // Runs the actions in order; throws ScriptError for the first one that cannot be done, and
  // for a window still waiting for an answer when the script ends.
  void Run(const Script& script);
  // Pictures written so far.
  int Renders() const { return renders_; }
  framework::ScriptedUser& User() { return user_; }

 private:
  bool AwaitInput(HWND modalWindow) override;
  void Step();
  void RenderPending();
  std::string DescribeWaiting(HWND modalWindow) const;

  void Do(const SelectTab& action);
  void Do(const Click& action);
  void Do(const Hover& action);
  void Do(const SelectItem& action);
  void Do(const SetCheck& action);
  void Do(const Rename& action);
  void Do(const PickPoints& action);
  void Do(const Answer& action);
  void Do(const RunSubCommand& action);
  void Do(const Wait& action);
  void Do(const ResizePane& action);
  void Do(const SetView& action);
  void Do(const Save& action);
  void Do(const Print& action);

  // The pane's controls, found below the main frame as a person finds them on screen; the
  // pane must be shown.
  HWND PaneControl(int id) const;
  HWND Tree() const { return PaneControl(kTreeId); }
  HWND ControlOf(const Control& control) const;

  static constexpr int kTreeId = 5016;
  static constexpr int kTabsId = 5011;
  static constexpr int kMaxDepth = 32;  // windows waiting within windows
  static constexpr DWORD kPauseMs = 200;

  framework::ScriptedUser user_;
  InputSource* previous_ = nullptr;
  wb::ui::MainFrame& frame_;
  RunOptions options_;
  std::ostream& out_;
  const Script* script_ = nullptr;
  std::size_t next_ = 0;
  int depth_ = 0;
  std::optional<ScriptError> failure_;
  const Action* lastStarted_ = nullptr;
  bool rendered_ = true;
  int renders_ = 0;
};

}  // namespace app::script
