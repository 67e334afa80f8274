// Popup menus: items with a command id, a text, check and enabled states, a bitmap or an
// image of an image list; TrackPopupMenu shows one and waits for the user's choice.
#pragma once

#include <string>
#include <string_view>

#include "framework/cwnd.h"

constexpr UINT MF_STRING = 0x0000;
constexpr UINT MF_BYCOMMAND = 0x0000;
constexpr UINT MF_BYPOSITION = 0x0400;
constexpr UINT MF_SEPARATOR = 0x0800;
constexpr UINT MF_ENABLED = 0x0000;
constexpr UINT MF_GRAYED = 0x0001;
constexpr UINT MF_DISABLED = 0x0002;
constexpr UINT MF_UNCHECKED = 0x0000;
constexpr UINT MF_CHECKED = 0x0008;
constexpr UINT MF_POPUP = 0x0010;
constexpr UINT MF_OWNERDRAW = 0x0100;

constexpr UINT TPM_LEFTBUTTON = 0x0000;
constexpr UINT TPM_RIGHTBUTTON = 0x0002;
constexpr UINT TPM_LEFTALIGN = 0x0000;
constexpr UINT TPM_CENTERALIGN = 0x0004;
constexpr UINT TPM_RIGHTALIGN = 0x0008;
constexpr UINT TPM_TOPALIGN = 0x0000;
constexpr UINT TPM_VCENTERALIGN = 0x0010;
constexpr UINT TPM_BOTTOMALIGN = 0x0020;
constexpr UINT TPM_NONOTIFY = 0x0080;
constexpr UINT TPM_RETURNCMD = 0x0100;

HMENU CreatePopupMenu();
BOOL DestroyMenu(HMENU menu);
BOOL IsMenu(HMENU menu);
// Items are strings or separators (MF_POPUP submenus and owner-drawn items are refused).
BOOL AppendMenu(HMENU menu, UINT flags, UINT_PTR id, std::string_view text = {});
BOOL InsertMenu(HMENU menu, UINT position, UINT flags, UINT_PTR id, std::string_view text = {});
BOOL DeleteMenu(HMENU menu, UINT item, UINT flags);
int GetMenuItemCount(HMENU menu);
UINT GetMenuItemID(HMENU menu, int position);  // 0xFFFFFFFF for none
UINT GetMenuState(HMENU menu, UINT item, UINT flags);  // 0xFFFFFFFF for none
std::string GetMenuString(HMENU menu, UINT item, UINT flags);
DWORD CheckMenuItem(HMENU menu, UINT item, UINT flags);  // answers the previous check state
BOOL EnableMenuItem(HMENU menu, UINT item, UINT flags);  // answers the previous state, -1 for none
// The bitmap shown beside the item when it is not checked and when it is.
BOOL SetMenuItemBitmaps(HMENU menu, UINT item, UINT flags, HBITMAP unchecked, HBITMAP checked);
// An image of an image list shown beside the item (the widget toolkit's image menus).
BOOL SetMenuItemImage(HMENU menu, UINT item, UINT flags, HIMAGELIST images, int image);
// Shows the menu at a screen point (aligned by the TPM_ flags) and waits for the user. With
// TPM_RETURNCMD it answers the chosen id, 0 when dismissed; without it, it posts WM_COMMAND
// with the chosen id to the owner (unless TPM_NONOTIFY) and answers whether one was chosen.
int TrackPopupMenu(HMENU menu, UINT flags, int x, int y, int reserved, HWND owner, const RECT* ignored = nullptr);
// Where an item of a menu that is showing lies, in screen pixels.
BOOL GetMenuItemRect(HWND menuWindow, HMENU menu, UINT position, RECT* rect);

namespace framework {
std::size_t LiveMenuCount();
void RegisterPopupMenuClass();
}  // namespace framework

// A bitmap resource; pictures are shared and live as long as the process.
class CBitmap {
 public:
  BOOL LoadBitmap(UINT id);
  HBITMAP GetSafeHandle() const { return m_hObject; }
  BOOL DeleteObject();

  HBITMAP m_hObject;
};

// A menu owned by an object: destroyed with it.
class CMenu {
 public:
  CMenu() = default;
  CMenu(const CMenu&) = delete;
  CMenu& operator=(const CMenu&) = delete;
  virtual ~CMenu();

  HMENU m_hMenu;

  BOOL CreatePopupMenu();
  BOOL DestroyMenu();
  HMENU GetSafeHmenu() const { return m_hMenu; }
  BOOL AppendMenu(UINT flags, UINT_PTR id = 0, std::string_view text = {});
  BOOL InsertMenu(UINT position, UINT flags, UINT_PTR id = 0, std::string_view text = {});
  BOOL DeleteMenu(UINT item, UINT flags);
  int GetMenuItemCount() const;
  UINT GetMenuItemID(int position) const;
  UINT GetMenuState(UINT item, UINT flags) const;
  std::string GetMenuString(UINT item, UINT flags) const;
  UINT CheckMenuItem(UINT item, UINT flags);
  UINT EnableMenuItem(UINT item, UINT flags);
  BOOL SetMenuItemBitmaps(UINT item, UINT flags, const CBitmap* unchecked, const CBitmap* checked);
  BOOL TrackPopupMenu(UINT flags, int x, int y, CWnd* owner, const RECT* rect = nullptr);
};
