// The tip window: its size from its texts, its place by the mouse, its timers on the virtual clock.
#include "framework/toolkit/tip_window.h"

#include <algorithm>

#include "framework/canvas.h"
#include "framework/text_metrics.h"
#include "framework/window_class.h"

namespace {

constexpr std::string_view kTipWindowClass = "ToolkitTipWindow";
constexpr UINT_PTR kShowTimer = 1;
constexpr UINT_PTR kHideTimer = 2;
constexpr UINT_PTR kTrackTimer = 3;
constexpr UINT kTrackMs = 100;

}  // namespace

BOOL CTipWindow::Create(CWnd* owner, int spacingX, int spacingY) {
  if (!framework::IsWindowClassRegistered(kTipWindowClass)) framework::RegisterWindowClass(kTipWindowClass, 0, nullptr);
  owner_ = owner;
  spacingX_ = std::max(0, spacingX);
  spacingY_ = std::max(0, spacingY);
  return CreateEx(WS_EX_TOPMOST | WS_EX_TOOLWINDOW, kTipWindowClass, "", WS_POPUP, CRect(), owner, 0);
}

void CTipWindow::SetTitle(std::string_view title) { title_ = title; }

void CTipWindow::SetText(std::string_view text) {
  text_ = text;
  SetWindowText(text);  // the window text is what the tip says, for readers of its picture
}

void CTipWindow::Show(const RECT& area, POINT point, const DisplayParameters& parameters) {
  area_ = area;
  point_ = point;
  parameters_ = parameters;
  KillTimer(kHideTimer);
  KillTimer(kTrackTimer);
  if (parameters_[1] > 0) {
    SetTimer(kShowTimer, static_cast<UINT>(parameters_[1]));
  } else {
    ShowNow();
  }
}

void CTipWindow::Hide() {
  KillTimer(kShowTimer);
  KillTimer(kHideTimer);
  KillTimer(kTrackTimer);
  ShowWindow(SW_HIDE);
}

bool CTipWindow::MouseInArea() const {
  if (owner_ == nullptr || !::IsWindowVisible(owner_->m_hWnd)) return false;
  POINT p;
  ::GetCursorPos(&p);
  owner_->ScreenToClient(&p);
  return area_.PtInRect(p);
}

void CTipWindow::ShowNow() {
  if (text_.empty() && title_.empty()) return;
  const int lines = title_.empty() ? 1 : 2;
  const int width = std::max(framework::TextWidth(title_, true), framework::TextWidth(text_)) + 2 * spacingX_ + 2;
  const int height = lines * framework::kLineHeight + 2 * spacingY_ + 2;
  POINT mouse;
  ::GetCursorPos(&mouse);
  SetWindowPos(mouse.x + parameters_[3], mouse.y + parameters_[0], width, height, SWP_NOACTIVATE);
  ShowWindow(SW_SHOWNA);
  if (parameters_[2] > 0) SetTimer(kHideTimer, static_cast<UINT>(parameters_[2]));
  if (parameters_[4] != 0) SetTimer(kTrackTimer, kTrackMs);
}

void CTipWindow::Paint(Canvas& canvas) {
  RECT client;
  GetClientRect(&client);
  canvas.FillRect(client, ::GetSysColor(COLOR_INFOBK));
  canvas.FrameRect(client, RGB(118, 118, 118));
  int top = 1 + spacingY_;
  const int left = 1 + spacingX_;
  const COLORREF ink = ::GetSysColor(COLOR_INFOTEXT);
  if (!title_.empty()) {
    canvas.Text(left, top + framework::kFontAscent, title_, {ink, true, Canvas::Anchor::kStart});
    top += framework::kLineHeight;
  }
  canvas.Text(left, top + framework::kFontAscent, text_, {ink, false, Canvas::Anchor::kStart});
}

LRESULT CTipWindow::WindowProc(UINT message, WPARAM wParam, LPARAM lParam) {
  switch (message) {
    case WM_PAINT:
      if (wParam != 0) Paint(*reinterpret_cast<Canvas*>(wParam));
      return 0;
    case WM_NCHITTEST:
      return HTTRANSPARENT;  // a tip never takes the mouse from what lies under it
    case WM_TIMER:
      if (wParam == kShowTimer) {
        KillTimer(kShowTimer);
        ShowNow();
      } else if (wParam == kHideTimer || (wParam == kTrackTimer && !MouseInArea())) {
        Hide();
      }
      return 0;
    default:
      return CWnd::WindowProc(message, wParam, lParam);
  }
}
