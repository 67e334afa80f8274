// The menu table: menus by handle with their items, found by position or by command id.
#include "framework/menu.h"

#include <map>
#include <utility>

#include "framework/menu_table.h"
#include "framework/resource_module.h"

namespace {

using framework::detail::MenuItem;

struct MenuTable {
  std::map<std::uint32_t, std::vector<MenuItem>> menus;
  std::uint32_t next = 1;
};

MenuTable& Table() {
  static MenuTable table;
  return table;
}

std::vector<MenuItem>* Items(HMENU menu) {
  const auto it = Table().menus.find(menu.Value());
  return it == Table().menus.end() ? nullptr : &it->second;
}

// The item an (item, MF_BYPOSITION or MF_BYCOMMAND) pair names, or null.
MenuItem* Locate(HMENU menu, UINT item, UINT flags) {
  std::vector<MenuItem>* items = Items(menu);
  if (items == nullptr) return nullptr;
  if ((flags & MF_BYPOSITION) != 0) return item < items->size() ? &(*items)[item] : nullptr;
  for (MenuItem& candidate : *items) {
    if ((candidate.flags & MF_SEPARATOR) == 0 && candidate.id == item) return &candidate;
  }
  return nullptr;
}

}  // namespace

namespace framework {

std::size_t LiveMenuCount() { return Table().menus.size(); }

namespace detail {
const std::vector<MenuItem>* MenuItems(HMENU menu) { return Items(menu); }
}  // namespace detail

}  // namespace framework

HMENU CreatePopupMenu() {
  MenuTable& t = Table();
  t.menus.emplace(t.next, std::vector<MenuItem>{});
  return HMENU(t.next++);
}

BOOL DestroyMenu(HMENU menu) { return Table().menus.erase(menu.Value()) > 0 ? TRUE : FALSE; }
BOOL IsMenu(HMENU menu) { return Items(menu) != nullptr ? TRUE : FALSE; }

BOOL InsertMenu(HMENU menu, UINT position, UINT flags, UINT_PTR id, std::string_view text) {
  std::vector<MenuItem>* items = Items(menu);
  if (items == nullptr || (flags & (MF_POPUP | MF_OWNERDRAW)) != 0) return FALSE;
  MenuItem item;
  item.id = static_cast<UINT>(id);
  item.flags = flags & (MF_SEPARATOR | MF_GRAYED | MF_DISABLED | MF_CHECKED);
  if ((flags & MF_SEPARATOR) == 0) item.text = std::string(text);
  auto at = items->end();
  if (position != 0xFFFFFFFF) {
    if ((flags & MF_BYPOSITION) != 0) {
      at = items->begin() + std::min<std::size_t>(position, items->size());
    } else if (MenuItem* before = Locate(menu, position, MF_BYCOMMAND)) {
      at = items->begin() + (before - items->data());
    }
  }
  items->insert(at, std::move(item));
  return TRUE;
}

BOOL AppendMenu(HMENU menu, UINT flags, UINT_PTR id, std::string_view text) {
  return InsertMenu(menu, 0xFFFFFFFF, flags | MF_BYPOSITION, id, text);
}

BOOL DeleteMenu(HMENU menu, UINT item, UINT flags) {
  const MenuItem* found = Locate(menu, item, flags);
  if (found == nullptr) return FALSE;
  std::vector<MenuItem>& items = *Items(menu);
  items.erase(items.begin() + (found - items.data()));
  return TRUE;
}

int GetMenuItemCount(HMENU menu) {
  const std::vector<MenuItem>* items = Items(menu);
  return items != nullptr ? static_cast<int>(items->size()) : -1;
}

UINT GetMenuItemID(HMENU menu, int position) {
  const MenuItem* item = position >= 0 ? Locate(menu, static_cast<UINT>(position), MF_BYPOSITION) : nullptr;
  if (item == nullptr) return 0xFFFFFFFF;
  return (item->flags & MF_SEPARATOR) != 0 ? 0 : item->id;
}

UINT GetMenuState(HMENU menu, UINT item, UINT flags) {
  const MenuItem* found = Locate(menu, item, flags);
  return found != nullptr ? found->flags : 0xFFFFFFFF;
}

std::string GetMenuString(HMENU menu, UINT item, UINT flags) {
  const MenuItem* found = Locate(menu, item, flags);
  return found != nullptr ? found->text : std::string();
}

DWORD CheckMenuItem(HMENU menu, UINT item, UINT flags) {
  MenuItem* found = Locate(menu, item, flags);
  if (found == nullptr) return 0xFFFFFFFF;
  const DWORD old = found->flags & MF_CHECKED;
  found->flags = (found->flags & ~MF_CHECKED) | (flags & MF_CHECKED);
  return old;
}

BOOL EnableMenuItem(HMENU menu, UINT item, UINT flags) {
  MenuItem* found = Locate(menu, item, flags);
  if (found == nullptr) return -1;
  const BOOL old = static_cast<BOOL>(found->flags & (MF_GRAYED | MF_DISABLED));
  found->flags = (found->flags & ~(MF_GRAYED | MF_DISABLED)) | (flags & (MF_GRAYED | MF_DISABLED));
  return old;
}

BOOL SetMenuItemBitmaps(HMENU menu, UINT item, UINT flags, HBITMAP unchecked, HBITMAP checked) {
  MenuItem* found = Locate(menu, item, flags);
  if (found == nullptr) return FALSE;
  found->unchecked = unchecked;
  found->checked = checked;
  return TRUE;
}

BOOL SetMenuItemImage(HMENU menu, UINT item, UINT flags, HIMAGELIST images, int image) {
  MenuItem* found = Locate(menu, item, flags);
  if (found == nullptr) return FALSE;
  found->images = images;
  found->image = image;
  return TRUE;
}

BOOL CBitmap::LoadBitmap(UINT id) {
  m_hObject = AfxLoadBitmap(id);
  return m_hObject ? TRUE : FALSE;
}

BOOL CBitmap::DeleteObject() {
  const bool had = static_cast<bool>(m_hObject);
  m_hObject = HBITMAP();
  return had ? TRUE : FALSE;
}

CMenu::~CMenu() { DestroyMenu(); }

BOOL CMenu::CreatePopupMenu() {
  DestroyMenu();
  m_hMenu = ::CreatePopupMenu();
  return m_hMenu ? TRUE : FALSE;
}

BOOL CMenu::DestroyMenu() {
  if (!m_hMenu) return FALSE;
  ::DestroyMenu(std::exchange(m_hMenu, HMENU()));
  return TRUE;
}

BOOL CMenu::AppendMenu(UINT flags, UINT_PTR id, std::string_view text) { return ::AppendMenu(m_hMenu, flags, id, text); }

BOOL CMenu::InsertMenu(UINT position, UINT flags, UINT_PTR id, std::string_view text) {
  return ::InsertMenu(m_hMenu, position, flags, id, text);
}

BOOL CMenu::DeleteMenu(UINT item, UINT flags) { return ::DeleteMenu(m_hMenu, item, flags); }
int CMenu::GetMenuItemCount() const { return ::GetMenuItemCount(m_hMenu); }
UINT CMenu::GetMenuItemID(int position) const { return ::GetMenuItemID(m_hMenu, position); }
UINT CMenu::GetMenuState(UINT item, UINT flags) const { return ::GetMenuState(m_hMenu, item, flags); }
std::string CMenu::GetMenuString(UINT item, UINT flags) const { return ::GetMenuString(m_hMenu, item, flags); }
UINT CMenu::CheckMenuItem(UINT item, UINT flags) { return ::CheckMenuItem(m_hMenu, item, flags); }
UINT CMenu::EnableMenuItem(UINT item, UINT flags) { return static_cast<UINT>(::EnableMenuItem(m_hMenu, item, flags)); }

BOOL CMenu::SetMenuItemBitmaps(UINT item, UINT flags, const CBitmap* unchecked, const CBitmap* checked) {
  return ::SetMenuItemBitmaps(m_hMenu, item, flags, unchecked != nullptr ? unchecked->m_hObject : HBITMAP(),
                              checked != nullptr ? checked->m_hObject : HBITMAP());
}

BOOL CMenu::TrackPopupMenu(UINT flags, int x, int y, CWnd* owner, const RECT* rect) {
  return ::TrackPopupMenu(m_hMenu, flags, x, y, 0, owner != nullptr ? owner->m_hWnd : HWND(), rect);
}
