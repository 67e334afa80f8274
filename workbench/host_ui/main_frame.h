// The workbench's main window: the host's frame that the plug-in's pane docks into. It answers
// the plug-in's question for the pane manager, lays out the docked panes beside the viewport,
// hands the host's mouse messages to the docked panes, runs the command lines handed to the
// host (asking the user for the points of a new section or plan), and shows on its status line
// whether the camera manager is on.
#pragma once

#include <deque>
#include <optional>
#include <string>
#include <vector>

#include "framework/controls/edit.h"
#include "framework/controls/static_control.h"
#include "framework/cwnd.h"
#include "workbench/host_ui/docking_panes.h"
#include "workbench/host_ui/point_pick.h"
#include "workbench/host_ui/viewport.h"

namespace wb::ui {

class MainFrame : public CWnd {
 public:
  static constexpr int kViewportId = 100;
  static constexpr int kPromptId = 101;       // the text of the command line
  static constexpr int kCommandLineId = 102;  // where the user types
  static constexpr int kCaptionHeight = 20;   // a docked pane's caption
  static constexpr int kStatusHeight = 26;

  MainFrame() = default;
  ~MainFrame() override;

  // Makes the frame (filling the screen) and names it the host's main window. With
  // `answerPaneManager` false the frame does not answer "Quorvel_GetPaneManager": panes are
  // then not docked.
  bool Create(const std::string& title, bool answerPaneManager = true);

  DockingPanes& Panes() { return panes_; }
  Viewport& View() { return viewport_; }
  HWND CommandLine() const { return commandLine_.m_hWnd; }
  // A pick under way: the host waits for the user's points.
  const PointPick* Pick() const { return pick_ ? &*pick_ : nullptr; }

  // Where the docked pane with this id sits now (frame client coordinates), or nothing.
  std::optional<CRect> DockedPlace(int paneId) const;

  // As the host's own menus do: runs the plug-in's entry with a sub-command (the caller has
  // filled the argument blocks), then delivers what it posted.
  void RunSubCommand(int subCommand);

 protected:
  LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override;
  BOOL PreTranslateMessage(MSG* msg) override;
  void OnSize(UINT type, int cx, int cy) override;
  void OnClose() override;
  void OnDestroy() override;
  void OnLButtonDown(UINT flags, CPoint point) override;

 private:
  void LayOut();
  void Paint(Canvas& canvas);
  // The command lines handed to the host, run after the handler that handed them returns.
  void QueueCommandLine(const std::string& line);
  void RunCommandLines();
  // Asks the user for points through the command line; nothing when the user cancels.
  std::optional<std::vector<host::Point3f>> PickPoints(std::vector<std::string> prompts);
  void AddViewFromPicks(int subCommand, std::vector<std::string> prompts);
  void ShowPrompt(const std::string& text);
  void EnablePanes(bool enable);
  // A docked pane's caption, and its close box, in client coordinates.
  std::optional<CRect> CaptionOf(const DockingPane& pane) const;
  static CRect CloseBoxOf(const CRect& caption);

  DockingPanes panes_{[this] { LayOut(); }};
  Viewport viewport_;
  CStatic prompt_;
  CEdit commandLine_;
  std::deque<std::string> commandLines_;
  std::optional<PointPick> pick_;
  bool answerPaneManager_ = true;
  UINT getPaneManagerMessage_ = 0;
  UINT preTranslateMessage_ = 0;
};

}  // namespace wb::ui
