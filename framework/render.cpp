// Drawing a window tree: the system's frames and captions, each class's client area, children
// from the bottom of the stacking order up.
#include "framework/render.h"

#include "framework/canvas.h"
#include "framework/cdc.h"
#include "framework/geometry.h"
#include "framework/message_queue.h"
#include "framework/text_metrics.h"
#include "framework/window_class.h"
#include "framework/window_system.h"

namespace framework {
namespace {

Canvas::Attributes Describe(HWND hwnd, bool hidden) {
  Canvas::Attributes attributes = {{"data-class", ::GetClassName(hwnd)}};
  if ((::GetWindowStyle(hwnd) & WS_CHILD) != 0) attributes.emplace_back("data-id", std::to_string(::GetDlgCtrlID(hwnd)));
  const std::string text = ::GetWindowText(hwnd);
  if (!text.empty()) attributes.emplace_back("data-text", text);
  std::string state;
  const auto add = [&state](std::string_view word) {
    if (word.empty()) return;
    if (!state.empty()) state += ' ';
    state += word;
  };
  if (hidden) add("hidden");
  if (!::IsWindowEnabled(hwnd)) add("disabled");
  if (::GetFocus() == hwnd) add("focused");
  if ((::GetWindowStyle(hwnd) & WS_CHILD) == 0 && ::GetActiveWindow() == hwnd) add("active");
  if (const WindowBehaviour* behaviour = GetWindowBehaviour(hwnd)) add(behaviour->StateWords(hwnd));
  if (!state.empty()) attributes.emplace_back("data-state", state);
  return attributes;
}

void PaintFrame(HWND hwnd, Canvas& canvas, const CRect& outer) {
  const DWORD style = ::GetWindowStyle(hwnd);
  const DWORD exStyle = ::GetWindowExStyle(hwnd);
  const RECT insets = NonClientInsets(style, exStyle);
  const CRect all(0, 0, outer.Width(), outer.Height());
  const bool caption = (style & WS_CAPTION) == WS_CAPTION;
  const int edge = ((exStyle & WS_EX_CLIENTEDGE) != 0 ? ::GetSystemMetrics(SM_CXEDGE) : 0) +
                   ((exStyle & WS_EX_STATICEDGE) != 0 ? 1 : 0);
  const int frame = insets.left - edge;
  if (frame > 0) {
    canvas.FillRect(all, ::GetSysColor(COLOR_BTNFACE));
    canvas.FrameRect(all, frame > 1 ? ::GetSysColor(COLOR_BTNSHADOW) : RGB(122, 122, 122));
  }
  if (caption) {
    const bool active = ::GetActiveWindow() == hwnd;
    const CRect bar(frame, frame, all.right - frame, insets.top - edge);
    canvas.FillRect(bar, active ? ::GetSysColor(COLOR_ACTIVECAPTION) : RGB(191, 205, 219));
    const COLORREF ink = active ? ::GetSysColor(COLOR_CAPTIONTEXT) : RGB(67, 78, 84);
    canvas.Text(bar.left + 6, bar.top + (bar.Height() - kLineHeight) / 2 + kFontAscent, ::GetWindowText(hwnd),
                {ink, true, Canvas::Anchor::kStart});
    if ((style & WS_SYSMENU) != 0) {
      // The close box: a cross in the caption's right end.
      const CPoint c(bar.right - 11, bar.top + bar.Height() / 2);
      canvas.BeginGroup({{"data-part", "close"}});
      canvas.Line({c.x - 4, c.y - 4}, {c.x + 4, c.y + 4}, ink, 2);
      canvas.Line({c.x + 4, c.y - 4}, {c.x - 4, c.y + 4}, ink, 2);
      canvas.EndGroup();
    }
  }
  if (edge > 0) {
    CRect r(frame, insets.top - edge, all.right - frame, all.bottom - frame);
    canvas.Dc().Draw3dRect(r, RGB(160, 160, 160), RGB(255, 255, 255));
    if (edge > 1) {
      r.DeflateRect(1, 1);
      canvas.Dc().Draw3dRect(r, RGB(105, 105, 105), RGB(227, 227, 227));
    }
  }
}

}  // namespace

void PaintWindow(HWND hwnd, Canvas& canvas, const RECT& place) {
  const CRect outer(place);
  canvas.BeginArea(outer, Describe(hwnd, false));
  PaintFrame(hwnd, canvas, outer);
  const RECT insets = NonClientInsets(::GetWindowStyle(hwnd), ::GetWindowExStyle(hwnd));
  RECT client;
  ::GetClientRect(hwnd, &client);
  canvas.BeginArea(CRect(CPoint(insets.left, insets.top), CSize(client.right, client.bottom)), {{"data-part", "client"}});
  ::SendMessage(hwnd, WM_PAINT, reinterpret_cast<WPARAM>(&canvas), 0);
  for (HWND child : GetChildren(hwnd)) {
    if ((::GetWindowStyle(child) & WS_VISIBLE) == 0) {
      canvas.Marker(Describe(child, true));
      continue;
    }
    RECT r;
    ::GetWindowRect(child, &r);
    POINT topLeft{r.left, r.top};
    ::ScreenToClient(hwnd, &topLeft);
    PaintWindow(child, canvas, CRect(topLeft, CRect(r).Size()));
  }
  canvas.EndArea();
  canvas.EndArea();
}

std::string RenderWindow(HWND hwnd) {
  RECT r;
  if (!::GetWindowRect(hwnd, &r)) return {};
  const CRect outer(r);
  Canvas canvas(outer.Width(), outer.Height());
  PaintWindow(hwnd, canvas, CRect(0, 0, outer.Width(), outer.Height()));
  return canvas.Svg();
}

}  // namespace framework
