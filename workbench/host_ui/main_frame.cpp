// The main frame: its layout, its picture, the docked panes' captions, the mouse messages it
// hands to docked panes, and the command lines it runs.
#include "workbench/host_ui/main_frame.h"

#include <algorithm>

#include "framework/canvas.h"
#include "framework/cwinapp.h"
#include "framework/message_queue.h"
#include "framework/text_metrics.h"
#include "framework/window_class.h"
#include "shell/host/argument_blocks.h"
#include "shell/host/pane_manager.h"
#include "workbench/workbench.h"

namespace wb::ui {
namespace {

constexpr const char* kFrameClass = "WorkbenchFrame";
constexpr UINT kRunCommandLines = WM_APP + 1;  // posted to itself: run the queued command lines
constexpr const char* kIdlePrompt = "Command:";
constexpr int kPromptWidth = 300;
constexpr int kCommandLineWidth = 240;

constexpr COLORREF kCaptionColor = RGB(205, 214, 232);
constexpr COLORREF kCaptionInk = RGB(30, 40, 60);

bool IsMouseMessage(UINT message) { return message >= WM_MOUSEMOVE && message <= WM_MBUTTONDBLCLK; }

}  // namespace

MainFrame::~MainFrame() {
  // The panes' windows are told of the end while the pane manager still exists.
  if (m_hWnd) DestroyWindow();
}

bool MainFrame::Create(const std::string& title, bool answerPaneManager) {
  answerPaneManager_ = answerPaneManager;
  getPaneManagerMessage_ = ::RegisterWindowMessage(host::kGetPaneManagerMessageName);
  preTranslateMessage_ = ::RegisterWindowMessage(host::kPreTranslateMessageName);
  framework::RegisterWindowClass(kFrameClass, 0, [] { return std::make_unique<framework::WindowBehaviour>(); });
  const CRect screen(0, 0, ::GetSystemMetrics(SM_CXSCREEN), ::GetSystemMetrics(SM_CYSCREEN));
  if (!CreateEx(0, kFrameClass, title, WS_OVERLAPPED | WS_CAPTION | WS_SYSMENU | WS_VISIBLE, screen, nullptr, 0)) {
    return false;
  }
  viewport_.Create(this, kViewportId);
  prompt_.Create(kIdlePrompt, WS_CHILD | WS_VISIBLE | SS_LEFT | SS_NOPREFIX, CRect(), this, kPromptId);
  commandLine_.Create(WS_CHILD | WS_VISIBLE | WS_BORDER | WS_TABSTOP | ES_AUTOHSCROLL, CRect(), this, kCommandLineId);
  framework::SetHostMainWindow(m_hWnd);
  Workbench::Get().SetCommandLineRunner([this](const std::string& line) { QueueCommandLine(line); });
  LayOut();
  return true;
}

void MainFrame::RunSubCommand(int subCommand) {
  globi[0] = subCommand;
  Workbench::Get().RunPluginEntry();
  framework::PumpPendingMessages();
}

// --- Layout and picture ---------------------------------------------------------------------

std::optional<CRect> MainFrame::DockedPlace(int paneId) const {
  const DockingPane* pane = panes_.Find(paneId);
  if (pane == nullptr || !pane->attached || !::IsWindow(pane->window)) return std::nullopt;
  CRect place;
  ::GetWindowRect(pane->window, &place);
  ScreenToClient(&place);
  return place;
}

std::optional<CRect> MainFrame::CaptionOf(const DockingPane& pane) const {
  const std::optional<CRect> place = DockedPlace(pane.id);
  if (!place) return std::nullopt;
  return CRect(place->left, place->top - kCaptionHeight, place->right, place->top);
}

CRect MainFrame::CloseBoxOf(const CRect& caption) {
  return CRect(caption.right - kCaptionHeight, caption.top, caption.right, caption.bottom);
}

// Each attached pane takes its room from one side of what is left, in the order the panes
// were added; the viewport gets the rest, the status line the bottom.
void MainFrame::LayOut() {
  if (!m_hWnd || !viewport_.m_hWnd || !commandLine_.m_hWnd) return;
  CRect client;
  GetClientRect(&client);
  const CRect status(client.left, client.bottom - kStatusHeight, client.right, client.bottom);
  CRect area(client.left, client.top, client.right, status.top);
  for (const DockingPane& pane : panes_.Panes()) {
    if (!pane.attached || !::IsWindow(pane.window)) continue;
    const LONG width = std::clamp(pane.rect.Width(), LONG{0}, area.Width());
    const LONG height = std::clamp(pane.rect.Height(), LONG{kCaptionHeight}, std::max(area.Height(), LONG{kCaptionHeight}));
    CRect box = area;
    switch (pane.direction) {
      case xtpPaneDockLeft:
        box.right = area.left += width;
        break;
      case xtpPaneDockRight:
        box.left = area.right -= width;
        break;
      case xtpPaneDockTop:
        box.bottom = area.top += std::min(height, area.Height());
        break;
      case xtpPaneDockBottom:
        box.top = area.bottom -= std::min(height, area.Height());
        break;
    }
    ::MoveWindow(pane.window, box.left, box.top + kCaptionHeight, box.Width(),
                 std::max(box.Height() - kCaptionHeight, LONG{0}), TRUE);
  }
  viewport_.MoveWindow(area);
  const int fieldTop = status.top + 3;
  const int fieldHeight = kStatusHeight - 6;
  prompt_.MoveWindow(status.left + 6, fieldTop + 4, kPromptWidth, fieldHeight - 4);
  commandLine_.MoveWindow(status.left + 6 + kPromptWidth, fieldTop, kCommandLineWidth, fieldHeight);
  Invalidate();
}

void MainFrame::OnSize(UINT type, int cx, int cy) {
  CWnd::OnSize(type, cx, cy);
  LayOut();
}

void MainFrame::Paint(Canvas& canvas) {
  CRect client;
  GetClientRect(&client);
  canvas.FillRect(client, ::GetSysColor(COLOR_BTNFACE));
  for (const DockingPane& pane : panes_.Panes()) {
    const std::optional<CRect> caption = CaptionOf(pane);
    if (!caption) continue;
    static constexpr const char* kSides[] = {"left", "right", "top", "bottom"};
    canvas.BeginGroup({{"data-part", "dock-caption"},
                       {"data-pane", std::to_string(pane.id)},
                       {"data-side", kSides[pane.direction]},
                       {"data-text", pane.title}});
    canvas.FillRect(*caption, kCaptionColor);
    canvas.Text(caption->left + 6, caption->top + (kCaptionHeight - framework::kLineHeight) / 2 + framework::kFontAscent,
                pane.title, {kCaptionInk, true, Canvas::Anchor::kStart});
    const CPoint c = CloseBoxOf(*caption).CenterPoint();
    canvas.Line({c.x - 4, c.y - 4}, {c.x + 4, c.y + 4}, kCaptionInk, 2);
    canvas.Line({c.x + 4, c.y - 4}, {c.x - 4, c.y + 4}, kCaptionInk, 2);
    canvas.EndGroup();
  }
  const bool on = Workbench::Get().CameraManagerOn();
  canvas.BeginGroup({{"data-part", "status"}, {"data-camera-manager", on ? "on" : "off"}});
  canvas.Text(client.right - 10, client.bottom - kStatusHeight + 6 + framework::kFontAscent,
              on ? "Camera manager on" : "Camera manager off", {RGB(60, 60, 60), false, Canvas::Anchor::kEnd});
  canvas.EndGroup();
}

LRESULT MainFrame::WindowProc(UINT message, WPARAM wParam, LPARAM lParam) {
  if (message == WM_PAINT) {
    Paint(*reinterpret_cast<Canvas*>(wParam));
    return 0;
  }
  if (message != 0 && message == getPaneManagerMessage_) {
    return answerPaneManager_ ? reinterpret_cast<LRESULT>(static_cast<CPaneManager*>(&panes_)) : 0;
  }
  if (message == kRunCommandLines) {
    RunCommandLines();
    return 0;
  }
  return CWnd::WindowProc(message, wParam, lParam);
}

// --- Input ----------------------------------------------------------------------------------

// The host shows docked panes the mouse before they get it (they bring up their tips), and
// reads the command line while it asks for points.
BOOL MainFrame::PreTranslateMessage(MSG* msg) {
  if (IsMouseMessage(msg->message)) {
    if (const DockingPane* pane = panes_.Holding(msg->hwnd)) {
      ::SendMessage(pane->window, preTranslateMessage_, reinterpret_cast<WPARAM>(msg), 0);
    }
    return FALSE;
  }
  if (pick_ && msg->hwnd == commandLine_.m_hWnd && msg->message == WM_KEYDOWN) {
    if (msg->wParam == VK_RETURN) {
      pick_->TakeTyped(commandLine_.GetWindowText());
      commandLine_.SetWindowText("");
      ShowPrompt(pick_->Prompt());
      viewport_.SetPickedPoints(pick_->Points());
      return TRUE;
    }
    if (msg->wParam == VK_ESCAPE) {
      pick_->Cancel();
      return TRUE;
    }
  }
  return FALSE;
}

// A click on a docked pane's close box closes the pane as its own window would be closed.
void MainFrame::OnLButtonDown(UINT flags, CPoint point) {
  for (const DockingPane& pane : panes_.Panes()) {
    const std::optional<CRect> caption = CaptionOf(pane);
    if (caption && CloseBoxOf(*caption).PtInRect(point)) {
      ::SendMessage(pane.window, WM_CLOSE, 0, 0);
      return;
    }
  }
  CWnd::OnLButtonDown(flags, point);
}

void MainFrame::OnClose() { DestroyWindow(); }

void MainFrame::OnDestroy() {
  if (::AfxGetMainWnd() == this) framework::SetHostMainWindow(HWND());
  Workbench::Get().SetCommandLineRunner(nullptr);
  commandLines_.clear();
  if (pick_) pick_->Cancel();
  CWnd::OnDestroy();
}

// --- Command lines and picks ----------------------------------------------------------------

void MainFrame::QueueCommandLine(const std::string& line) {
  commandLines_.push_back(line);
  PostMessage(kRunCommandLines);
}

void MainFrame::RunCommandLines() {
  if (pick_) return;  // the pick under way finishes first; its caller runs the rest
  while (!commandLines_.empty() && m_hWnd) {
    const std::string line = commandLines_.front();
    commandLines_.pop_front();
    if (line == "/3secadd") {
      AddViewFromPicks(2, {"Section: start point (x,y or x,y,z)", "Section: end point (x,y or x,y,z)"});
    } else if (line == "/3planead") {
      AddViewFromPicks(4, {"Plan: base point (x,y or x,y,z)", "Plan: second point (x,y or x,y,z)"});
    }
  }
}

// The host calls the plug-in back with the two points only when the user picked both.
void MainFrame::AddViewFromPicks(int subCommand, std::vector<std::string> prompts) {
  const std::optional<std::vector<host::Point3f>> points = PickPoints(std::move(prompts));
  if (!points || points->size() != 2 || !m_hWnd) return;
  globp[0] = (*points)[0];
  globp[1] = (*points)[1];
  RunSubCommand(subCommand);
}

std::optional<std::vector<host::Point3f>> MainFrame::PickPoints(std::vector<std::string> prompts) {
  pick_.emplace(std::move(prompts));
  const HWND focusBefore = ::GetFocus();
  EnablePanes(false);
  ShowPrompt(pick_->Prompt());
  commandLine_.SetWindowText("");
  commandLine_.SetFocus();
  const HWND self = m_hWnd;
  // The user answers through the input entry points; with no one left to answer, the pick is
  // cancelled.
  framework::RunModalLoop(self, [this, self] { return !::IsWindow(self) || pick_->Finished(); });
  std::optional<std::vector<host::Point3f>> points;
  if (pick_->Finished() && !pick_->Cancelled()) points = pick_->Points();
  pick_.reset();
  if (::IsWindow(self)) {
    viewport_.SetPickedPoints({});
    ShowPrompt(kIdlePrompt);
    EnablePanes(true);
    if (::IsWindow(focusBefore)) ::SetFocus(focusBefore);
  }
  return points;
}

void MainFrame::ShowPrompt(const std::string& text) { prompt_.SetWindowText(text); }

// While the host asks for points only the command line and the view take input, so that the
// panes (docked or not) start no second command.
void MainFrame::EnablePanes(bool enable) {
  for (const HWND child : framework::GetChildren(m_hWnd)) {
    if (child != commandLine_.m_hWnd && child != viewport_.m_hWnd && child != prompt_.m_hWnd) {
      ::EnableWindow(child, enable ? TRUE : FALSE);
    }
  }
}

}  // namespace wb::ui
