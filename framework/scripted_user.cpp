// The scripted user: locating what is on screen and acting on it through the input entry points.
#include "framework/scripted_user.h"

#include <vector>

#include "framework/controls/combo_box.h"
#include "framework/controls/list_ctrl.h"
#include "framework/controls/tab_control.h"
#include "framework/controls/tree_control.h"
#include "framework/geometry.h"
#include "framework/input.h"
#include "framework/menu.h"
#include "framework/text_metrics.h"
#include "framework/window_classes.h"
#include "framework/window_system.h"

namespace framework {
namespace {

constexpr DWORD kLabelEditWait = 600;  // longer than the tree waits before it opens its editor

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

HWND ChildOfClass(HWND parent, std::string_view className) {
  for (HWND child : GetChildren(parent)) {
    if (::GetClassName(child) == className && ::IsWindowVisible(child)) return child;
  }
  return HWND();
}

CRect ClientOf(HWND window) {
  RECT r;
  ::GetClientRect(window, &r);
  return r;
}

HMENU MenuOf(HWND menuWindow) { return HMENU::FromParam(::SendMessage(menuWindow, MN_GETHMENU, 0, 0)); }

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
    return ::IsWindowVisible(h) && WithoutMnemonics(::GetWindowText(h)) == WithoutMnemonics(text);
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

void ScriptedUser::ScrollIntoView(HWND scrollable, const std::function<CRect()>& place, const CRect& view) {
  // Each click moves the list by one row, so the clicks are bounded by the rows there are.
  for (int clicks = 0; clicks < 100000; ++clicks) {
    const CRect r = place();
    const bool above = r.top < view.top;
    const bool below = r.bottom > view.bottom;
    if (!above && !below) return;
    const HWND bar = ChildOfClass(scrollable, kScrollBarClass);
    if (!bar) throw ScriptError("the item is out of view and the list shows no scroll bar");
    const CRect track = ClientOf(bar);
    const int before = static_cast<int>(::SendMessage(bar, SBM_GETPOS, 0, 0));
    Click(bar, CPoint(track.CenterPoint().x, above ? track.top + 4 : track.bottom - 5));
    if (static_cast<int>(::SendMessage(bar, SBM_GETPOS, 0, 0)) == before) throw ScriptError("the list does not scroll to the item");
  }
}

void ScriptedUser::ChooseComboItem(HWND combo, int index) {
  if (index < 0 || index >= static_cast<int>(::SendMessage(combo, CB_GETCOUNT, 0, 0))) {
    throw ScriptError("the combo box has no item " + std::to_string(index));
  }
  if (!::SendMessage(combo, CB_GETDROPPEDSTATE, 0, 0)) Click(combo);
  COMBOBOXINFO info;
  ::SendMessage(combo, CB_GETCOMBOBOXINFO, 0, reinterpret_cast<LPARAM>(&info));
  const HWND list = info.hwndList;
  if (!list) throw ScriptError("the combo box dropped no list");
  const auto itemRect = [list, index] {
    RECT r;
    ::SendMessage(list, LB_GETITEMRECT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(&r));
    return CRect(r);
  };
  ScrollIntoView(list, itemRect, ClientOf(list));
  Click(list, itemRect().CenterPoint());
  if (static_cast<int>(::SendMessage(combo, CB_GETCURSEL, 0, 0)) != index) {
    throw ScriptError("the combo box did not take item " + std::to_string(index));
  }
}

void ScriptedUser::ChooseComboItem(HWND combo, std::string_view text) {
  const int count = static_cast<int>(::SendMessage(combo, CB_GETCOUNT, 0, 0));
  for (int i = 0; i < count; ++i) {
    const auto length = ::SendMessage(combo, CB_GETLBTEXTLEN, static_cast<WPARAM>(i), 0);
    std::string item(static_cast<std::size_t>(std::max<LRESULT>(0, length)) + 1, '\0');
    ::SendMessage(combo, CB_GETLBTEXT, static_cast<WPARAM>(i), reinterpret_cast<LPARAM>(item.data()));
    item.resize(static_cast<std::size_t>(std::max<LRESULT>(0, length)));
    if (item == text) {
      ChooseComboItem(combo, i);
      return;
    }
  }
  throw ScriptError("the combo box has no item \"" + std::string(text) + "\"");
}

HWND ScriptedUser::OpenMenu() const {
  const std::vector<HWND> windows = TopLevelWindows();
  for (auto it = windows.rbegin(); it != windows.rend(); ++it) {
    if (::GetClassName(*it) == kPopupMenuClass && ::IsWindowVisible(*it)) return *it;
  }
  throw ScriptError("no menu is open");
}

std::vector<std::string> ScriptedUser::MenuItemTexts() const {
  const HMENU menu = MenuOf(OpenMenu());
  std::vector<std::string> texts;
  for (int i = 0; i < ::GetMenuItemCount(menu); ++i) {
    if ((::GetMenuState(menu, static_cast<UINT>(i), MF_BYPOSITION) & MF_SEPARATOR) != 0) continue;
    texts.push_back(WithoutMnemonics(::GetMenuString(menu, static_cast<UINT>(i), MF_BYPOSITION)));
  }
  return texts;
}

void ScriptedUser::ChooseMenuItem(int commandId) {
  const HWND window = OpenMenu();
  const HMENU menu = MenuOf(window);
  for (int i = 0; i < ::GetMenuItemCount(menu); ++i) {
    if (::GetMenuItemID(menu, i) != static_cast<UINT>(commandId)) continue;
    RECT r;
    ::GetMenuItemRect(window, menu, static_cast<UINT>(i), &r);
    POINT centre = CRect(r).CenterPoint();
    ::ScreenToClient(window, &centre);
    Click(window, centre);
    return;
  }
  throw ScriptError("the menu has no item " + std::to_string(commandId));
}

void ScriptedUser::ChooseMenuItem(std::string_view text) {
  const HMENU menu = MenuOf(OpenMenu());
  for (int i = 0; i < ::GetMenuItemCount(menu); ++i) {
    if (WithoutMnemonics(::GetMenuString(menu, static_cast<UINT>(i), MF_BYPOSITION)) == WithoutMnemonics(text)) {
      ChooseMenuItem(static_cast<int>(::GetMenuItemID(menu, i)));
      return;
    }
  }
  throw ScriptError("the menu has no item \"" + std::string(text) + "\"");
}

void ScriptedUser::DismissMenu() {
  OpenMenu();
  Press(VK_ESCAPE);
}

void ScriptedUser::AnswerNextWithMenuItem(int commandId) {
  AnswerNext([commandId](ScriptedUser& u, HWND) { u.ChooseMenuItem(commandId); });
}

void ScriptedUser::AnswerNextWithMenuItem(std::string_view text) {
  AnswerNext([item = std::string(text)](ScriptedUser& u, HWND) { u.ChooseMenuItem(item); });
}

void ScriptedUser::AnswerNextByDismissingMenu() {
  AnswerNext([](ScriptedUser& u, HWND) { u.DismissMenu(); });
}

CRect ScriptedUser::ListCell(HWND list, int row, int column) {
  if (row < 0 || row >= static_cast<int>(::SendMessage(list, LVM_GETITEMCOUNT, 0, 0))) {
    throw ScriptError("the list has no row " + std::to_string(row));
  }
  const auto cell = [list, row, column] {
    RECT r;
    r.top = column;
    r.left = column == 0 ? LVIR_LABEL : LVIR_BOUNDS;
    if (!::SendMessage(list, LVM_GETSUBITEMRECT, static_cast<WPARAM>(row), reinterpret_cast<LPARAM>(&r))) {
      throw ScriptError("the list has no column " + std::to_string(column));
    }
    return CRect(r);
  };
  CRect rows = ClientOf(list);
  const HWND header = HWND::FromParam(::SendMessage(list, LVM_GETHEADER, 0, 0));
  if (::IsWindowVisible(header)) rows.top += ClientOf(header).Height();
  ScrollIntoView(list, cell, rows);
  return cell();
}

void ScriptedUser::ClickListHeader(HWND list, int column) {
  const HWND header = HWND::FromParam(::SendMessage(list, LVM_GETHEADER, 0, 0));
  RECT r;
  if (!::IsWindowVisible(header) || !::SendMessage(header, HDM_GETITEMRECT, static_cast<WPARAM>(column), reinterpret_cast<LPARAM>(&r))) {
    throw ScriptError("the list shows no column header " + std::to_string(column));
  }
  Click(header, CRect(r).CenterPoint());
}

void ScriptedUser::ClickListCell(HWND list, int row, int column) { Click(list, ListCell(list, row, column).CenterPoint()); }

void ScriptedUser::DoubleClickListCell(HWND list, int row, int column) {
  DoubleClick(list, ListCell(list, row, column).CenterPoint());
}

void ScriptedUser::ToggleListCheck(HWND list, int row) {
  const CRect cell = ListCell(list, row, 0);
  const int y = cell.CenterPoint().y;
  for (int x = 0; x < cell.right; ++x) {
    LVHITTESTINFO info;
    info.pt = {x, y};
    ::SendMessage(list, LVM_HITTEST, 0, reinterpret_cast<LPARAM>(&info));
    if (info.iItem == row && (info.flags & LVHT_ONITEMSTATEICON) != 0) {
      Click(list, CPoint(x + 6, y));
      return;
    }
  }
  throw ScriptError("row " + std::to_string(row) + " shows no check box");
}

void ScriptedUser::EditListCell(HWND list, int row, int column, std::string_view text, UINT endKey) {
  const UINT wanted = LVIS_SELECTED | LVIS_FOCUSED;
  if (static_cast<UINT>(::SendMessage(list, LVM_GETITEMSTATE, static_cast<WPARAM>(row), wanted)) != wanted) {
    ClickListCell(list, row, column);
  }
  ClickListCell(list, row, column);
  const HWND editor = ::GetFocus();
  if (!editor || ::GetParent(editor) != list || ::GetClassName(editor) != kEditClass) {
    throw ScriptError("the list opened no editor on row " + std::to_string(row) + ", column " + std::to_string(column));
  }
  Type(text);
  Press(endKey);
}

}  // namespace framework
