// The scripted user: locating what is on screen and acting on it through the input entry points.
#include "framework/scripted_user.h"

#include <vector>

#include "framework/controls/tab_control.h"
#include "framework/controls/tree_control.h"
#include "framework/geometry.h"
#include "framework/input.h"
#include "framework/window_system.h"

namespace framework {
namespace {

constexpr DWORD kLabelEditWait = 600;  // longer than the tree waits before it opens its editor

std::string VisibleText(std::string_view text) {
  std::string out;
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] == '&' && i + 1 < text.size()) ++i;
    out += text[i];
  }
  return out;
}

HWND Search(HWND within, const std::function<bool(HWND)>& match) {
  for (HWND child : GetChildren(within)) {
    if (match(child)) return child;
    if (const HWND deeper = Search(child, match)) return deeper;
  }
  return HWND();
}

// A point of a window's client area in its top-level window's own pixels.
POINT InTopLevel(HWND window, POINT clientPoint, HWND& topLevel) {
  topLevel = GetTopLevelWindow(window);
  POINT screen = clientPoint;
  ::ClientToScreen(window, &screen);
  RECT outer;
  ::GetWindowRect(topLevel, &outer);
  return {screen.x - outer.left, screen.y - outer.top};
}

POINT Centre(HWND window) {
  RECT client;
  ::GetClientRect(window, &client);
  return CRect(client).CenterPoint();
}

std::vector<std::string> SplitPath(std::string_view path) {
  std::vector<std::string> parts;
  std::size_t start = 0;
  while (start <= path.size()) {
    const std::size_t slash = path.find('/', start);
    parts.emplace_back(path.substr(start, slash == std::string_view::npos ? std::string_view::npos : slash - start));
    if (slash == std::string_view::npos) break;
    start = slash + 1;
  }
  return parts;
}

HTREEITEM NextItem(HWND tree, HTREEITEM item, UINT code) {
  return HTREEITEM::FromParam(::SendMessage(tree, TVM_GETNEXTITEM, code, item.ToLParam()));
}

std::string ItemText(HWND tree, HTREEITEM item) {
  char buffer[1024];
  TVITEM t;
  t.mask = TVIF_TEXT | TVIF_HANDLE;
  t.hItem = item;
  t.pszText = buffer;
  t.cchTextMax = sizeof buffer;
  buffer[0] = '\0';
  ::SendMessage(tree, TVM_GETITEM, 0, reinterpret_cast<LPARAM>(&t));
  return buffer;
}

}  // namespace

ScriptedUser::ScriptedUser() : previous_(GetInputSource()) { SetInputSource(this); }

ScriptedUser::~ScriptedUser() { SetInputSource(previous_); }

void ScriptedUser::AnswerNext(Answer answer) { answers_.push_back(std::move(answer)); }

void ScriptedUser::AnswerNextWithButton(int buttonId) {
  AnswerNext([buttonId](ScriptedUser& user, HWND modal) { user.Click(user.Find(buttonId, modal)); });
}

bool ScriptedUser::AwaitInput(HWND) {
  if (answers_.empty()) {
    ++unanswered_;
    return false;
  }
  Answer answer = std::move(answers_.front());
  answers_.pop_front();
  answer(*this, ActiveWindow());
  return true;
}

HWND ScriptedUser::ActiveWindow() const {
  const HWND active = ::GetActiveWindow();
  if (::IsWindowVisible(active)) return active;
  const std::vector<HWND> windows = TopLevelWindows();
  for (auto it = windows.rbegin(); it != windows.rend(); ++it) {
    if (::IsWindowVisible(*it) && (::GetWindowExStyle(*it) & WS_EX_TOOLWINDOW) == 0) return *it;
  }
  return HWND();
}

HWND ScriptedUser::Find(int id, HWND within) const {
  const HWND root = within ? within : ActiveWindow();
  const HWND found = Search(root, [id](HWND h) { return ::GetDlgCtrlID(h) == id; });
  if (!found) throw ScriptError("no control with id " + std::to_string(id) + " in the window");
  return found;
}

HWND ScriptedUser::FindByText(std::string_view text, HWND within) const {
  const HWND root = within ? within : ActiveWindow();
  const HWND found = Search(root, [text](HWND h) {
    return ::IsWindowVisible(h) && VisibleText(::GetWindowText(h)) == VisibleText(text);
  });
  if (!found) throw ScriptError("no control showing \"" + std::string(text) + "\" in the window");
  return found;
}

void ScriptedUser::MoveTo(HWND window, POINT clientPoint) {
  HWND top;
  const POINT p = InTopLevel(window, clientPoint, top);
  input::MouseMove(top, p);
}

void ScriptedUser::Click(HWND window) { Click(window, Centre(window)); }

void ScriptedUser::Click(HWND window, POINT clientPoint) {
  HWND top;
  const POINT p = InTopLevel(window, clientPoint, top);
  input::MouseMove(top, p);
  input::MouseDown(top, p);
  input::MouseUp(top, p);
}

void ScriptedUser::Click(int id) { Click(Find(id)); }
void ScriptedUser::Click(std::string_view text) { Click(FindByText(text)); }

void ScriptedUser::DoubleClick(HWND window, POINT clientPoint) {
  HWND top;
  const POINT p = InTopLevel(window, clientPoint, top);
  input::MouseMove(top, p);
  input::MouseDown(top, p);
  input::MouseUp(top, p);
  input::MouseDown(top, p, input::MouseButton::kLeft, true);
  input::MouseUp(top, p);
}

void ScriptedUser::RightClick(HWND window, POINT clientPoint) {
  HWND top;
  const POINT p = InTopLevel(window, clientPoint, top);
  input::MouseMove(top, p);
  input::MouseDown(top, p, input::MouseButton::kRight);
  input::MouseUp(top, p, input::MouseButton::kRight);
}

void ScriptedUser::Press(UINT virtualKey) {
  input::KeyDown(virtualKey);
  input::KeyUp(virtualKey);
}

void ScriptedUser::PressWith(UINT modifier, UINT virtualKey) {
  input::KeyDown(modifier);
  Press(virtualKey);
  input::KeyUp(modifier);
}

void ScriptedUser::Type(std::string_view text) {
  for (char c : text) input::Character(c);
}

void ScriptedUser::Wait(DWORD milliseconds) { input::Wait(milliseconds); }

HTREEITEM ScriptedUser::FindItem(HWND tree, std::string_view path) const {
  HTREEITEM parent = TVI_ROOT;
  HTREEITEM found;
  for (const std::string& part : SplitPath(path)) {
    found = HTREEITEM();
    for (HTREEITEM item = NextItem(tree, parent, TVGN_CHILD); item; item = NextItem(tree, item, TVGN_NEXT)) {
      if (ItemText(tree, item) == part) {
        found = item;
        break;
      }
    }
    if (!found) throw ScriptError("no tree item \"" + std::string(path) + "\"");
    parent = found;
  }
  return found;
}

void ScriptedUser::ShowItem(HWND tree, HTREEITEM item) {
  std::vector<HTREEITEM> ancestors;
  for (HTREEITEM up = NextItem(tree, item, TVGN_PARENT); up; up = NextItem(tree, up, TVGN_PARENT)) ancestors.push_back(up);
  for (auto it = ancestors.rbegin(); it != ancestors.rend(); ++it) {
    if ((::SendMessage(tree, TVM_GETITEMSTATE, it->ToWParam(), TVIS_EXPANDED) & TVIS_EXPANDED) == 0) {
      Click(tree, ItemPart(tree, *it, TVHT_ONITEMBUTTON));
    }
  }
}

// Where on screen a part of an item lies, found as a person finds it: by looking along the
// item's row (hit tests) from its label leftwards.
POINT ScriptedUser::ItemPart(HWND tree, HTREEITEM item, UINT part) {
  RECT label;
  label.left = static_cast<LONG>(item.Value());
  if (!::SendMessage(tree, TVM_GETITEMRECT, TRUE, reinterpret_cast<LPARAM>(&label))) {
    throw ScriptError("tree item \"" + ItemText(tree, item) + "\" is not in view");
  }
  const int y = (label.top + label.bottom) / 2;
  if (part == TVHT_ONITEMLABEL) return {(label.left + label.right) / 2, y};
  int first = -1;
  int last = -1;
  for (int x = label.left - 1; x >= 0; --x) {
    TVHITTESTINFO info;
    info.pt = {x, y};
    ::SendMessage(tree, TVM_HITTEST, 0, reinterpret_cast<LPARAM>(&info));
    if (info.hItem == item && (info.flags & part) != 0) {
      if (last < 0) last = x;
      first = x;
    } else if (last >= 0) {
      break;
    }
  }
  if (last < 0) throw ScriptError("tree item \"" + ItemText(tree, item) + "\" shows no such part");
  return {(first + last) / 2, y};
}

void ScriptedUser::SelectItem(HWND tree, std::string_view path) {
  const HTREEITEM item = FindItem(tree, path);
  ShowItem(tree, item);
  if (HTREEITEM::FromParam(::SendMessage(tree, TVM_GETNEXTITEM, TVGN_CARET, 0)) == item) return;
  Click(tree, ItemPart(tree, item, TVHT_ONITEMLABEL));
}

void ScriptedUser::ToggleCheck(HWND tree, std::string_view path) {
  const HTREEITEM item = FindItem(tree, path);
  ShowItem(tree, item);
  Click(tree, ItemPart(tree, item, TVHT_ONITEMSTATEICON));
}

void ScriptedUser::DoubleClickItem(HWND tree, std::string_view path) {
  const HTREEITEM item = FindItem(tree, path);
  ShowItem(tree, item);
  DoubleClick(tree, ItemPart(tree, item, TVHT_ONITEMLABEL));
}

void ScriptedUser::ToggleExpand(HWND tree, std::string_view path) {
  const HTREEITEM item = FindItem(tree, path);
  ShowItem(tree, item);
  Click(tree, ItemPart(tree, item, TVHT_ONITEMBUTTON));
}

void ScriptedUser::RenameItem(HWND tree, std::string_view path, std::string_view text, bool confirm) {
  SelectItem(tree, path);
  const HTREEITEM item = FindItem(tree, path);
  Click(tree, ItemPart(tree, item, TVHT_ONITEMLABEL));
  Wait(kLabelEditWait);
  if (!::SendMessage(tree, TVM_GETEDITCONTROL, 0, 0)) throw ScriptError("the tree opened no editor for \"" + std::string(path) + "\"");
  Type(text);
  Press(confirm ? VK_RETURN : VK_ESCAPE);
}

void ScriptedUser::SelectTab(HWND tabs, int index) {
  RECT r;
  if (!::SendMessage(tabs, TCM_GETITEMRECT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(&r))) {
    throw ScriptError("no tab " + std::to_string(index));
  }
  Click(tabs, CRect(r).CenterPoint());
}

}  // namespace framework
