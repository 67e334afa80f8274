// The list control's calls, each one message to the list-view class.
#include "framework/controls/list_ctrl.h"

#include <cstring>

#include "framework/image_list.h"
#include "framework/window_classes.h"

BOOL CListCtrl::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
  return CWnd::Create(framework::kListViewClass, "", style, rect, parent, id);
}

int CListCtrl::InsertColumn(int column, std::string_view heading, int format, int width, int subItem) {
  std::string text(heading);
  LVCOLUMN info;
  info.mask = LVCF_TEXT | LVCF_FMT | (width >= 0 ? LVCF_WIDTH : 0U) | (subItem >= 0 ? LVCF_SUBITEM : 0U);
  info.fmt = format;
  info.cx = width;
  info.pszText = text.data();
  info.iSubItem = subItem;
  return static_cast<int>(SendMessage(LVM_INSERTCOLUMN, static_cast<WPARAM>(column), reinterpret_cast<LPARAM>(&info)));
}

BOOL CListCtrl::DeleteColumn(int column) { return static_cast<BOOL>(SendMessage(LVM_DELETECOLUMN, static_cast<WPARAM>(column))); }

BOOL CListCtrl::GetColumn(int column, LVCOLUMN* info) const {
  return static_cast<BOOL>(SendMessage(LVM_GETCOLUMN, static_cast<WPARAM>(column), reinterpret_cast<LPARAM>(info)));
}

int CListCtrl::GetColumnWidth(int column) const {
  return static_cast<int>(SendMessage(LVM_GETCOLUMNWIDTH, static_cast<WPARAM>(column)));
}

BOOL CListCtrl::SetColumnWidth(int column, int width) {
  return static_cast<BOOL>(SendMessage(LVM_SETCOLUMNWIDTH, static_cast<WPARAM>(column), width));
}

CHeaderCtrl* CListCtrl::GetHeaderCtrl() {
  header_.m_hWnd = HWND::FromParam(SendMessage(LVM_GETHEADER));
  return header_.m_hWnd ? &header_ : nullptr;
}

int CListCtrl::InsertItem(const LVITEM* item) {
  return static_cast<int>(SendMessage(LVM_INSERTITEM, 0, reinterpret_cast<LPARAM>(item)));
}

int CListCtrl::InsertItem(int index, std::string_view text) {
  std::string copy(text);
  LVITEM item;
  item.mask = LVIF_TEXT;
  item.iItem = index;
  item.pszText = copy.data();
  return InsertItem(&item);
}

int CListCtrl::InsertItem(int index, std::string_view text, int image) {
  std::string copy(text);
  LVITEM item;
  item.mask = LVIF_TEXT | LVIF_IMAGE;
  item.iItem = index;
  item.pszText = copy.data();
  item.iImage = image;
  return InsertItem(&item);
}

BOOL CListCtrl::DeleteItem(int index) { return static_cast<BOOL>(SendMessage(LVM_DELETEITEM, static_cast<WPARAM>(index))); }
BOOL CListCtrl::DeleteAllItems() { return static_cast<BOOL>(SendMessage(LVM_DELETEALLITEMS)); }
int CListCtrl::GetItemCount() const { return static_cast<int>(SendMessage(LVM_GETITEMCOUNT)); }

BOOL CListCtrl::GetItem(LVITEM* item) const { return static_cast<BOOL>(SendMessage(LVM_GETITEM, 0, reinterpret_cast<LPARAM>(item))); }

BOOL CListCtrl::SetItem(const LVITEM* item) {
  return static_cast<BOOL>(SendMessage(LVM_SETITEM, 0, reinterpret_cast<LPARAM>(item)));
}

std::string CListCtrl::GetItemText(int index, int subItem) const {
  // Asks with a larger buffer until the whole text fits.
  for (int size = 256;; size *= 4) {
    std::string buffer(static_cast<std::size_t>(size), '\0');
    LVITEM item;
    item.iSubItem = subItem;
    item.pszText = buffer.data();
    item.cchTextMax = size;
    const auto length = static_cast<int>(SendMessage(LVM_GETITEMTEXT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(&item)));
    if (length < size - 1) return buffer.substr(0, static_cast<std::size_t>(length));
  }
}

BOOL CListCtrl::SetItemText(int index, int subItem, std::string_view text) {
  std::string copy(text);
  LVITEM item;
  item.iSubItem = subItem;
  item.pszText = copy.data();
  return static_cast<BOOL>(SendMessage(LVM_SETITEMTEXT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(&item)));
}

DWORD_PTR CListCtrl::GetItemData(int index) const {
  LVITEM item;
  item.mask = LVIF_PARAM;
  item.iItem = index;
  return GetItem(&item) ? static_cast<DWORD_PTR>(item.lParam) : 0;
}

BOOL CListCtrl::SetItemData(int index, DWORD_PTR data) {
  LVITEM item;
  item.mask = LVIF_PARAM;
  item.iItem = index;
  item.lParam = static_cast<LPARAM>(data);
  return SetItem(&item);
}

UINT CListCtrl::GetItemState(int index, UINT mask) const {
  return static_cast<UINT>(SendMessage(LVM_GETITEMSTATE, static_cast<WPARAM>(index), static_cast<LPARAM>(mask)));
}

BOOL CListCtrl::SetItemState(int index, UINT state, UINT mask) {
  LVITEM item;
  item.state = state;
  item.stateMask = mask;
  return static_cast<BOOL>(SendMessage(LVM_SETITEMSTATE, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(&item)));
}

BOOL CListCtrl::GetCheck(int index) const { return (GetItemState(index, LVIS_STATEIMAGEMASK) >> 12) == 2 ? TRUE : FALSE; }

BOOL CListCtrl::SetCheck(int index, BOOL check) {
  return SetItemState(index, INDEXTOSTATEIMAGEMASK(check ? 2U : 1U), LVIS_STATEIMAGEMASK);
}

int CListCtrl::GetNextItem(int start, UINT flags) const {
  return static_cast<int>(SendMessage(LVM_GETNEXTITEM, static_cast<WPARAM>(start), static_cast<LPARAM>(flags)));
}

UINT CListCtrl::GetSelectedCount() const { return static_cast<UINT>(SendMessage(LVM_GETSELECTEDCOUNT)); }

BOOL CListCtrl::GetItemRect(int index, RECT* rect, UINT code) const {
  if (rect == nullptr) return FALSE;
  rect->left = static_cast<LONG>(code);  // the part goes in the rectangle, as the system passes it
  return static_cast<BOOL>(SendMessage(LVM_GETITEMRECT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(rect)));
}

BOOL CListCtrl::GetSubItemRect(int index, int subItem, int code, RECT* rect) const {
  if (rect == nullptr) return FALSE;
  rect->top = subItem;
  rect->left = code;
  return static_cast<BOOL>(SendMessage(LVM_GETSUBITEMRECT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(rect)));
}

int CListCtrl::HitTest(LVHITTESTINFO* info) const {
  return static_cast<int>(SendMessage(LVM_HITTEST, 0, reinterpret_cast<LPARAM>(info)));
}

int CListCtrl::HitTest(CPoint point, UINT* flags) const {
  LVHITTESTINFO info;
  info.pt = point;
  const int item = HitTest(&info);
  if (flags != nullptr) *flags = info.flags;
  return item;
}

int CListCtrl::SubItemHitTest(LVHITTESTINFO* info) const {
  return static_cast<int>(SendMessage(LVM_SUBITEMHITTEST, 0, reinterpret_cast<LPARAM>(info)));
}

BOOL CListCtrl::EnsureVisible(int index, BOOL partialOk) {
  return static_cast<BOOL>(SendMessage(LVM_ENSUREVISIBLE, static_cast<WPARAM>(index), partialOk));
}

int CListCtrl::GetTopIndex() const { return static_cast<int>(SendMessage(LVM_GETTOPINDEX)); }
int CListCtrl::GetCountPerPage() const { return static_cast<int>(SendMessage(LVM_GETCOUNTPERPAGE)); }

HIMAGELIST CListCtrl::SetImageList(CImageList* list, int which) {
  const HIMAGELIST handle = list != nullptr ? list->GetSafeHandle() : HIMAGELIST();
  return HIMAGELIST::FromParam(SendMessage(LVM_SETIMAGELIST, static_cast<WPARAM>(which), handle.ToLParam()));
}

HIMAGELIST CListCtrl::GetImageList(int which) const {
  return HIMAGELIST::FromParam(SendMessage(LVM_GETIMAGELIST, static_cast<WPARAM>(which)));
}

DWORD CListCtrl::SetExtendedStyle(DWORD exStyle) {
  return static_cast<DWORD>(SendMessage(LVM_SETEXTENDEDLISTVIEWSTYLE, 0, static_cast<LPARAM>(exStyle)));
}

DWORD CListCtrl::GetExtendedStyle() const { return static_cast<DWORD>(SendMessage(LVM_GETEXTENDEDLISTVIEWSTYLE)); }
