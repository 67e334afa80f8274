// The tool-tip class: follows the mouse over its tools (by watching their messages or by
// relayed ones), shows after a rest, hides when the mouse leaves, a button is pressed or the
// time is up.
#include "framework/controls/tool_tip.h"

#include <algorithm>
#include <cstring>
#include <vector>

#include "framework/controls/control_behaviour.h"
#include "framework/message_queue.h"
#include "framework/resource_module.h"
#include "framework/text_metrics.h"
#include "framework/window_classes.h"

namespace framework {
namespace {

constexpr UINT_PTR kShowTimer = 1;
constexpr UINT_PTR kHideTimer = 2;
constexpr UINT_PTR kTrackTimer = 3;
constexpr UINT kTrackMs = 100;  // how often a shown tip checks that the mouse is still on its tool

struct Tool {
  UINT flags = 0;
  HWND hwnd;
  UINT_PTR id = 0;
  RECT rect;
  std::string text;
  UINT textId = 0;
  int interceptKey = 0;
};

bool IsMouseMessage(UINT message) { return message >= WM_MOUSEMOVE && message <= WM_MBUTTONDBLCLK; }

class ToolTipBehaviour : public ControlBehaviour {
 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case TTM_ADDTOOL:
        return Add(hwnd, reinterpret_cast<const TOOLINFO*>(lParam));
      case TTM_DELTOOL:
        Remove(reinterpret_cast<const TOOLINFO*>(lParam));
        return 0;
      case TTM_UPDATETIPTEXT:
        if (Tool* tool = Match(reinterpret_cast<const TOOLINFO*>(lParam))) SetText(*tool, reinterpret_cast<const TOOLINFO*>(lParam)->lpszText);
        return 0;
      case TTM_GETTEXT: {
        auto* info = reinterpret_cast<TOOLINFO*>(lParam);
        const Tool* tool = Match(info);
        if (tool == nullptr || info->lpszText == nullptr || wParam == 0) return 0;
        const std::string text = TextOf(*tool);
        const std::size_t n = std::min(text.size(), wParam - 1);
        std::memcpy(info->lpszText, text.data(), n);
        info->lpszText[n] = '\0';
        return static_cast<LRESULT>(n);
      }
      case TTM_GETTOOLCOUNT:
        return static_cast<LRESULT>(tools_.size());
      case TTM_ACTIVATE:
        active_ = wParam != 0;
        if (!active_) Hide(hwnd);
        return 0;
      case TTM_SETDELAYTIME: {
        const UINT ms = LOWORD(static_cast<std::uintptr_t>(lParam));
        if (wParam == TTDT_INITIAL || wParam == TTDT_AUTOMATIC) initialMs_ = ms;
        if (wParam == TTDT_AUTOPOP || wParam == TTDT_AUTOMATIC) autopopMs_ = ms;
        return 0;
      }
      case TTM_RELAYEVENT:
        if (lParam != 0) Relay(hwnd, *reinterpret_cast<const MSG*>(lParam));
        return 0;
      case TTM_POP:
        Hide(hwnd);
        return 0;
      case WM_TIMER:
        OnTimer(hwnd, wParam);
        return 0;
      case WM_NCHITTEST:
        return HTTRANSPARENT;
      case WM_DESTROY:
        for (const Tool& tool : tools_) StopIntercepting(tool.hwnd, tool.interceptKey);
        return 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override {
    const CRect r = ClientRect(hwnd);
    canvas.FillRect(r, ::GetSysColor(COLOR_INFOBK));
    canvas.FrameRect(r, RGB(118, 118, 118));
    canvas.Text(kPadX, kPadY + kFontAscent, ::GetWindowText(hwnd), {::GetSysColor(COLOR_INFOTEXT), false, Canvas::Anchor::kStart});
  }

 private:
  static constexpr int kPadX = 4;
  static constexpr int kPadY = 3;

  static CRect ToolRect(const Tool& tool) {
    if ((tool.flags & TTF_IDISHWND) != 0) return ClientRect(HWND::FromParam(tool.id));
    return tool.rect;
  }

  // The window whose client coordinates the tool's area is given in.
  static HWND ToolWindow(const Tool& tool) { return (tool.flags & TTF_IDISHWND) != 0 ? HWND::FromParam(tool.id) : tool.hwnd; }

  Tool* Match(const TOOLINFO* info) {
    if (info == nullptr) return nullptr;
    const auto it = std::find_if(tools_.begin(), tools_.end(),
                                 [info](const Tool& t) { return t.hwnd == info->hwnd && t.id == info->uId; });
    return it == tools_.end() ? nullptr : &*it;
  }

  static void SetText(Tool& tool, const char* text) {
    tool.textId = text != nullptr && IS_INTRESOURCE(text) ? static_cast<UINT>(reinterpret_cast<std::uintptr_t>(text)) : 0;
    tool.text = text != nullptr && tool.textId == 0 ? text : "";
  }

  static std::string TextOf(const Tool& tool) { return tool.textId != 0 ? AfxLoadString(tool.textId) : tool.text; }

  LRESULT Add(HWND hwnd, const TOOLINFO* info) {
    if (info == nullptr || !::IsWindow(info->hwnd)) return FALSE;
    Tool tool;
    tool.flags = info->uFlags;
    tool.hwnd = info->hwnd;
    tool.id = info->uId;
    tool.rect = info->rect;
    SetText(tool, info->lpszText);
    if ((tool.flags & TTF_SUBCLASS) != 0) {
      tool.interceptKey = InterceptMessages(ToolWindow(tool), [this, hwnd](HWND target, UINT message, WPARAM wParam,
                                                                           LPARAM lParam) -> std::optional<LRESULT> {
        if (IsMouseMessage(message)) Relay(hwnd, MSG{target, message, wParam, lParam, 0, {}});
        return std::nullopt;
      });
    }
    tools_.push_back(tool);
    return TRUE;
  }

  void Remove(const TOOLINFO* info) {
    if (const Tool* tool = Match(info)) {
      StopIntercepting(ToolWindow(*tool), tool->interceptKey);
      tools_.erase(tools_.begin() + (tool - tools_.data()));
      hover_ = -1;
    }
  }

  // The tool under a point of a window's client area, or -1.
  int ToolAt(HWND window, POINT p) const {
    for (int i = 0; i < static_cast<int>(tools_.size()); ++i) {
      const Tool& tool = tools_[static_cast<std::size_t>(i)];
      if (ToolWindow(tool) == window && ToolRect(tool).PtInRect(p)) return i;
    }
    return -1;
  }

  bool CursorOnTool(int index) const {
    if (index < 0 || index >= static_cast<int>(tools_.size())) return false;
    const Tool& tool = tools_[static_cast<std::size_t>(index)];
    POINT p;
    ::GetCursorPos(&p);
    ::ScreenToClient(ToolWindow(tool), &p);
    return ::IsWindowVisible(ToolWindow(tool)) && ToolRect(tool).PtInRect(p);
  }

  void Relay(HWND hwnd, const MSG& msg) {
    if (!active_) return;
    if (msg.message != WM_MOUSEMOVE) {
      Hide(hwnd);  // any button hides the tip until the mouse rests again
      return;
    }
    const int tool = ToolAt(msg.hwnd, {GET_X_LPARAM(msg.lParam), GET_Y_LPARAM(msg.lParam)});
    if (tool == hover_) return;
    hover_ = tool;
    if (tool < 0) {
      Hide(hwnd);
    } else if (::IsWindowVisible(hwnd)) {
      Show(hwnd);  // moving from one tool to the next changes the tip at once
    } else {
      ::SetTimer(hwnd, kShowTimer, initialMs_);
    }
  }

  void OnTimer(HWND hwnd, UINT_PTR id) {
    if (id == kShowTimer) {
      ::KillTimer(hwnd, kShowTimer);
      if (CursorOnTool(hover_)) Show(hwnd);
    } else if (id == kHideTimer) {
      Hide(hwnd);
    } else if (id == kTrackTimer && !CursorOnTool(hover_)) {
      hover_ = -1;
      Hide(hwnd);
    }
  }

  void Show(HWND hwnd) {
    const std::string text = TextOf(tools_[static_cast<std::size_t>(hover_)]);
    if (text.empty()) return;
    ::SetWindowText(hwnd, text);
    POINT at;
    ::GetCursorPos(&at);
    ::SetWindowPos(hwnd, at.x, at.y + 20, TextWidth(text) + 2 * kPadX, kLineHeight + 2 * kPadY, SWP_NOACTIVATE);
    ::ShowWindow(hwnd, SW_SHOWNA);
    ::SetTimer(hwnd, kHideTimer, autopopMs_);
    ::SetTimer(hwnd, kTrackTimer, kTrackMs);
  }

  static void Hide(HWND hwnd) {
    ::KillTimer(hwnd, kShowTimer);
    ::KillTimer(hwnd, kHideTimer);
    ::KillTimer(hwnd, kTrackTimer);
    ::ShowWindow(hwnd, SW_HIDE);
  }

  std::vector<Tool> tools_;
  int hover_ = -1;
  bool active_ = true;
  UINT initialMs_ = 500;
  UINT autopopMs_ = 5000;
};

}  // namespace

void RegisterToolTipClass() {
  RegisterWindowClass(kToolTipClass, 0, [] { return std::make_unique<ToolTipBehaviour>(); });
}

}  // namespace framework

BOOL CToolTipCtrl::Create(CWnd* parent, DWORD style) {
  return CreateEx(WS_EX_TOPMOST | WS_EX_TOOLWINDOW, framework::kToolTipClass, "", WS_POPUP | style, CRect(), parent, 0);
}

BOOL CToolTipCtrl::AddToolInfo(CWnd* wnd, char* text, const RECT* toolRect, UINT_PTR toolId) {
  if (wnd == nullptr) return FALSE;
  TOOLINFO info;
  info.uFlags = TTF_SUBCLASS;
  info.hwnd = wnd->m_hWnd;
  info.uId = toolId;
  if (toolRect != nullptr) {
    info.rect = *toolRect;
  } else {
    wnd->GetClientRect(&info.rect);
  }
  info.lpszText = text;
  return static_cast<BOOL>(SendMessage(TTM_ADDTOOL, 0, reinterpret_cast<LPARAM>(&info)));
}

BOOL CToolTipCtrl::AddTool(CWnd* wnd, std::string_view text, const RECT* toolRect, UINT_PTR toolId) {
  std::string copy(text);
  return AddToolInfo(wnd, copy.data(), toolRect, toolId);
}

BOOL CToolTipCtrl::AddTool(CWnd* wnd, UINT textId, const RECT* toolRect, UINT_PTR toolId) {
  return AddToolInfo(wnd, MAKEINTRESOURCE(textId), toolRect, toolId);
}

void CToolTipCtrl::DelTool(CWnd* wnd, UINT_PTR toolId) {
  TOOLINFO info;
  info.hwnd = wnd != nullptr ? wnd->m_hWnd : HWND();
  info.uId = toolId;
  SendMessage(TTM_DELTOOL, 0, reinterpret_cast<LPARAM>(&info));
}

void CToolTipCtrl::UpdateTipText(std::string_view text, CWnd* wnd, UINT_PTR toolId) {
  std::string copy(text);
  TOOLINFO info;
  info.hwnd = wnd != nullptr ? wnd->m_hWnd : HWND();
  info.uId = toolId;
  info.lpszText = copy.data();
  SendMessage(TTM_UPDATETIPTEXT, 0, reinterpret_cast<LPARAM>(&info));
}

std::string CToolTipCtrl::GetText(CWnd* wnd, UINT_PTR toolId) const {
  std::string buffer(1024, '\0');
  TOOLINFO info;
  info.hwnd = wnd != nullptr ? wnd->m_hWnd : HWND();
  info.uId = toolId;
  info.lpszText = buffer.data();
  buffer.resize(static_cast<std::size_t>(SendMessage(TTM_GETTEXT, buffer.size(), reinterpret_cast<LPARAM>(&info))));
  return buffer;
}

int CToolTipCtrl::GetToolCount() const { return static_cast<int>(SendMessage(TTM_GETTOOLCOUNT)); }
void CToolTipCtrl::Activate(BOOL activate) { SendMessage(TTM_ACTIVATE, static_cast<WPARAM>(activate)); }

void CToolTipCtrl::SetDelayTime(WPARAM which, int milliseconds) {
  SendMessage(TTM_SETDELAYTIME, which, MAKELPARAM(milliseconds, 0));
}

void CToolTipCtrl::RelayEvent(MSG* msg) { SendMessage(TTM_RELAYEVENT, 0, reinterpret_cast<LPARAM>(msg)); }
void CToolTipCtrl::Pop() { SendMessage(TTM_POP); }
