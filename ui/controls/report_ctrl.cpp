// The report list: row records with colours, custom drawing from them, sorting by column in
// separator groups, the check-box modes and the in-place cell editor.
#include "ui/controls/report_ctrl.h"

#include <algorithm>
#include <utility>

#include "framework/image_list.h"
#include "framework/window_classes.h"
#include "ui/controls/report_sort.h"

BEGIN_MESSAGE_MAP(CReportCtrl, CListCtrl)
ON_NOTIFY_REFLECT(NM_CUSTOMDRAW, OnCustomDraw)
ON_NOTIFY_REFLECT(LVN_COLUMNCLICK, OnColumnClick)
ON_NOTIFY_REFLECT_EX(LVN_DELETEITEM, OnDeleteItem)
END_MESSAGE_MAP()

namespace {

bool IsButtonPress(UINT message) {
  switch (message) {
    case WM_LBUTTONDOWN:
    case WM_LBUTTONDBLCLK:
    case WM_MBUTTONDOWN:
    case WM_MBUTTONDBLCLK:
    case WM_RBUTTONDOWN:
    case WM_RBUTTONDBLCLK:
      return true;
    default:
      return false;
  }
}

}  // namespace

CReportCtrl::CReportCtrl() = default;

CReportCtrl::~CReportCtrl() {
  // The list's window (and with it the editor) goes first, while the records still exist.
  if (m_hWnd) DestroyWindow();
}

void CReportCtrl::PreSubclassWindow() {
  ModifyStyle(LVS_EDITLABELS | LVS_SMALLICON | LVS_NOSCROLL, WS_CHILD | WS_VISIBLE | WS_HSCROLL | WS_VSCROLL | LVS_REPORT);
  SetExtendedStyle(GetExtendedStyle() | LVS_EX_FULLROWSELECT | LVS_EX_SUBITEMIMAGES);
}

CReportCtrl::RowRecord* CReportCtrl::RecordOf(int row) const {
  if (row < 0 || row >= GetItemCount()) return nullptr;
  auto* record = reinterpret_cast<RowRecord*>(CListCtrl::GetItemData(row));
  return records_.contains(record) ? record : nullptr;
}

void CReportCtrl::NotifyParent(UINT message, WPARAM wParam, LPARAM lParam) {
  if (CWnd* parent = GetParent()) parent->SendMessage(message, wParam, lParam);
}

int CReportCtrl::GetColumnCount() {
  const CHeaderCtrl* header = GetHeaderCtrl();
  return header != nullptr ? header->GetItemCount() : 0;
}

int CReportCtrl::InsertColumn(int column, std::string_view heading, int format, int width, int subItem) {
  EndEdit(true);
  const int index = CListCtrl::InsertColumn(column, heading, format, width, subItem);
  if (index < 0) return index;
  for (auto& [key, record] : records_) {
    const auto at = static_cast<std::size_t>(std::min<int>(index, static_cast<int>(record->text.size())));
    record->text.insert(record->text.begin() + static_cast<std::ptrdiff_t>(at), ::GetSysColor(COLOR_WINDOWTEXT));
    record->background.insert(record->background.begin() + static_cast<std::ptrdiff_t>(at), ::GetSysColor(COLOR_WINDOW));
  }
  return index;
}

BOOL CReportCtrl::DeleteColumn(int column) {
  EndEdit(true);
  if (!CListCtrl::DeleteColumn(column)) return FALSE;
  for (auto& [key, record] : records_) {
    if (column < static_cast<int>(record->text.size())) {
      record->text.erase(record->text.begin() + column);
      record->background.erase(record->background.begin() + column);
    }
  }
  if (sortColumn_ == column) sortColumn_ = -1;
  return TRUE;
}

int CReportCtrl::InsertItem(int index, std::string_view text, int image) {
  EndEdit(true);
  sortColumn_ = -1;
  auto record = std::make_unique<RowRecord>();
  const auto columns = static_cast<std::size_t>(std::max(1, GetColumnCount()));
  record->text.assign(columns, ::GetSysColor(COLOR_WINDOWTEXT));
  record->background.assign(columns, ::GetSysColor(COLOR_WINDOW));
  std::string copy(text);
  LVITEM item;
  item.mask = LVIF_TEXT | LVIF_PARAM | (image >= 0 ? LVIF_IMAGE : 0U);
  item.iItem = index;
  item.pszText = copy.data();
  item.iImage = image;
  item.lParam = reinterpret_cast<LPARAM>(record.get());
  const RowRecord* key = record.get();
  records_.emplace(key, std::move(record));
  const int row = CListCtrl::InsertItem(&item);
  if (row < 0) records_.erase(key);
  return row;
}

BOOL CReportCtrl::DeleteItem(int index) {
  EndEdit(true);
  return CListCtrl::DeleteItem(index);  // the record goes with the row's deletion notice
}

BOOL CReportCtrl::DeleteAllItems() {
  EndEdit(true);
  const BOOL done = CListCtrl::DeleteAllItems();
  records_.clear();
  return done;
}

int CReportCtrl::DeleteAllItems(DWORD states) {
  EndEdit(true);
  int deleted = 0;
  for (int row = GetItemCount() - 1; row >= 0; --row) {
    if (ItemHasStates(row, states) && CListCtrl::DeleteItem(row)) ++deleted;
  }
  return deleted;
}

BOOL CReportCtrl::OnDeleteItem(NMHDR* header, LRESULT*) {
  records_.erase(reinterpret_cast<const RowRecord*>(reinterpret_cast<NMLISTVIEW*>(header)->lParam));
  return FALSE;  // the parent hears of it as well
}

BOOL CReportCtrl::SetItemText(int row, int column, std::string_view text) {
  EndEdit(true);
  sortColumn_ = -1;
  return CListCtrl::SetItemText(row, column, text);
}

BOOL CReportCtrl::SetItemImage(int row, int column, int image) {
  LVITEM item;
  item.mask = LVIF_IMAGE;
  item.iItem = row;
  item.iSubItem = column;
  item.iImage = image;
  return SetItem(&item);
}

int CReportCtrl::GetItemImage(int row, int column) const {
  LVITEM item;
  item.mask = LVIF_IMAGE;
  item.iItem = row;
  item.iSubItem = column;
  return GetItem(&item) ? item.iImage : -1;
}

BOOL CReportCtrl::SetItemData(int row, DWORD_PTR data) {
  RowRecord* record = RecordOf(row);
  if (record == nullptr) return FALSE;
  record->data = data;
  return TRUE;
}

DWORD_PTR CReportCtrl::GetItemData(int row) const {
  const RowRecord* record = RecordOf(row);
  return record != nullptr ? record->data : 0;
}

HIMAGELIST CReportCtrl::SetImageList(CImageList* images) { return CListCtrl::SetImageList(images, LVSIL_SMALL); }

BOOL CReportCtrl::SetItemTextColor(int row, int column, COLORREF color) {
  RowRecord* record = RecordOf(row);
  if (record == nullptr || column >= static_cast<int>(record->text.size())) return FALSE;
  if (column < 0) {
    std::fill(record->text.begin(), record->text.end(), color);
  } else {
    record->text[static_cast<std::size_t>(column)] = color;
  }
  Invalidate(FALSE);
  return TRUE;
}

BOOL CReportCtrl::SetItemBkColor(int row, int column, COLORREF color) {
  RowRecord* record = RecordOf(row);
  if (record == nullptr || column >= static_cast<int>(record->background.size())) return FALSE;
  if (column < 0) {
    std::fill(record->background.begin(), record->background.end(), color);
  } else {
    record->background[static_cast<std::size_t>(column)] = color;
  }
  Invalidate(FALSE);
  return TRUE;
}

COLORREF CReportCtrl::GetItemTextColor(int row, int column) const {
  const RowRecord* record = RecordOf(row);
  if (record == nullptr || column < 0 || column >= static_cast<int>(record->text.size())) return ::GetSysColor(COLOR_WINDOWTEXT);
  return record->text[static_cast<std::size_t>(column)];
}

COLORREF CReportCtrl::GetItemBkColor(int row, int column) const {
  const RowRecord* record = RecordOf(row);
  if (record == nullptr || column < 0 || column >= static_cast<int>(record->background.size())) return ::GetSysColor(COLOR_WINDOW);
  return record->background[static_cast<std::size_t>(column)];
}

void CReportCtrl::OnCustomDraw(NMHDR* header, LRESULT* result) {
  auto* draw = reinterpret_cast<NMLVCUSTOMDRAW*>(header);
  switch (draw->nmcd.dwDrawStage) {
    case CDDS_PREPAINT:
      *result = CDRF_NOTIFYITEMDRAW;
      return;
    case CDDS_ITEMPREPAINT:
      *result = CDRF_NOTIFYSUBITEMDRAW;
      return;
    case CDDS_ITEMPREPAINT | CDDS_SUBITEM: {
      const int row = static_cast<int>(draw->nmcd.dwItemSpec);
      draw->clrText = GetItemTextColor(row, draw->iSubItem);
      draw->clrTextBk = GetItemBkColor(row, draw->iSubItem);
      *result = CDRF_DODEFAULT;
      return;
    }
    default:
      *result = CDRF_DODEFAULT;
  }
}

bool CReportCtrl::ItemHasStates(int row, DWORD states) const {
  if (row < 0 || row >= GetItemCount()) return false;
  if ((states & RC_ITEM_ALL) != 0) return true;
  const bool selected = GetItemState(row, LVIS_SELECTED) != 0;
  const bool focused = GetItemState(row, LVIS_FOCUSED) != 0;
  const bool checked = GetCheck(row) != FALSE;
  return ((states & RC_ITEM_SELECTED) == 0 || selected) && ((states & RC_ITEM_UNSELECTED) == 0 || !selected) &&
         ((states & RC_ITEM_CHECKED) == 0 || checked) && ((states & RC_ITEM_UNCHECKED) == 0 || !checked) &&
         ((states & RC_ITEM_FOCUSED) == 0 || focused) && ((states & RC_ITEM_UNFOCUSED) == 0 || !focused);
}

int CReportCtrl::GetFirstItem(DWORD states, int startAfter) const {
  for (int row = std::max(0, startAfter + 1); row < GetItemCount(); ++row) {
    if (ItemHasStates(row, states)) return row;
  }
  return -1;
}

int CReportCtrl::CountItems(DWORD states) const {
  int count = 0;
  for (int row = 0; row < GetItemCount(); ++row) count += ItemHasStates(row, states) ? 1 : 0;
  return count;
}

BOOL CReportCtrl::SetItemStates(int row, DWORD states) {
  if (row < 0) {
    for (int i = 0; i < GetItemCount(); ++i) SetItemStates(i, states);
    return TRUE;
  }
  if (row >= GetItemCount()) return FALSE;
  if ((states & RC_ITEM_SELECTED) != 0) SetItemState(row, LVIS_SELECTED, LVIS_SELECTED);
  if ((states & RC_ITEM_UNSELECTED) != 0) SetItemState(row, 0, LVIS_SELECTED);
  if ((states & RC_ITEM_CHECKED) != 0) SetCheck(row, TRUE);
  if ((states & RC_ITEM_UNCHECKED) != 0) SetCheck(row, FALSE);
  if ((states & RC_ITEM_FOCUSED) != 0) SetItemState(row, LVIS_FOCUSED, LVIS_FOCUSED);
  if ((states & RC_ITEM_UNFOCUSED) != 0) SetItemState(row, 0, LVIS_FOCUSED);
  return TRUE;
}

void CReportCtrl::SetCheckboxMode(int mode) { checkboxMode_ = std::clamp(mode, RC_CHKBOX_NONE, RC_CHKBOX_FIXED); }

void CReportCtrl::SetSortSeparator(std::optional<std::string> separator) { separator_ = std::move(separator); }

void CReportCtrl::OnColumnClick(NMHDR* header, LRESULT*) {
  const int column = reinterpret_cast<NMLISTVIEW*>(header)->iSubItem;
  SortItems(column, column == sortColumn_ ? !sortAscending_ : true);
}

BOOL CReportCtrl::SortItems(int column, bool ascending) {
  CHeaderCtrl* header = GetHeaderCtrl();
  if (column < 0 || column >= GetColumnCount() || header == nullptr || (header->GetStyle() & HDS_BUTTONS) == 0) return FALSE;
  EndEdit(true);

  // Everything a row shows and keeps, read out before the rows are written back in order.
  struct Snapshot {
    std::vector<std::string> texts;
    std::vector<int> images;
    UINT state = 0;
    LPARAM record = 0;
  };
  const int rows = GetItemCount();
  const int columns = GetColumnCount();
  std::vector<Snapshot> snapshots(static_cast<std::size_t>(rows));
  for (int row = 0; row < rows; ++row) {
    Snapshot& s = snapshots[static_cast<std::size_t>(row)];
    for (int c = 0; c < columns; ++c) {
      s.texts.push_back(GetItemText(row, c));
      s.images.push_back(GetItemImage(row, c));
    }
    s.state = GetItemState(row, LVIS_SELECTED | LVIS_FOCUSED | LVIS_STATEIMAGEMASK);
    s.record = static_cast<LPARAM>(CListCtrl::GetItemData(row));
  }
  const auto key = [&](int row) -> const std::string& {
    return snapshots[static_cast<std::size_t>(row)].texts[static_cast<std::size_t>(column)];
  };
  const auto before = [&](int a, int b) { return ascending ? report_sort::Less(key(a), key(b)) : report_sort::Less(key(b), key(a)); };

  // Separator rows stay where they are; the rows between them are sorted group by group.
  std::vector<int> order;
  std::vector<int> group;
  const auto flush = [&] {
    report_sort::StableSort(group, before);
    order.insert(order.end(), group.begin(), group.end());
    group.clear();
  };
  for (int row = 0; row < rows; ++row) {
    if (separator_ && key(row) == *separator_) {
      flush();
      order.push_back(row);
    } else {
      group.push_back(row);
    }
  }
  flush();

  for (int row = 0; row < rows; ++row) {
    const Snapshot& s = snapshots[static_cast<std::size_t>(order[static_cast<std::size_t>(row)])];
    for (int c = 0; c < columns; ++c) {
      LVITEM item;
      item.mask = LVIF_TEXT | LVIF_IMAGE | (c == 0 ? LVIF_PARAM | LVIF_STATE : 0U);
      item.iItem = row;
      item.iSubItem = c;
      std::string text = s.texts[static_cast<std::size_t>(c)];
      item.pszText = text.data();
      item.iImage = s.images[static_cast<std::size_t>(c)];
      item.lParam = s.record;
      item.state = s.state;
      item.stateMask = LVIS_SELECTED | LVIS_FOCUSED | LVIS_STATEIMAGEMASK;
      SetItem(&item);
    }
  }
  sortColumn_ = column;
  sortAscending_ = ascending;
  NotifyParent(WM_REPORT_SORTED, static_cast<WPARAM>(column), ascending ? 1 : 0);
  return TRUE;
}

LRESULT CReportCtrl::WindowProc(UINT message, WPARAM wParam, LPARAM lParam) {
  if (!IsButtonPress(message)) return CListCtrl::WindowProc(message, wParam, lParam);
  LVHITTESTINFO hit;
  hit.pt = CPoint(GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam));
  SubItemHitTest(&hit);
  const int row = hit.iItem;
  const bool wasChecked = row >= 0 && GetCheck(row) != FALSE;
  const bool wasCurrent = row >= 0 && ItemHasStates(row, RC_ITEM_SELECTED | RC_ITEM_FOCUSED);
  const bool wasEditing = IsEditing();
  const HWND self = m_hWnd;
  const LRESULT result = CListCtrl::WindowProc(message, wParam, lParam);
  if (!::IsWindow(self) || row < 0 || row >= GetItemCount()) return result;
  const bool checked = GetCheck(row) != FALSE;
  if (checked != wasChecked) {
    OnCheckChanged(row, checked, message);
  } else if ((message == WM_LBUTTONDOWN || message == WM_LBUTTONDBLCLK) && editable_ && wasCurrent && !wasEditing &&
             hit.iSubItem >= 0) {
    StartEdit(row, hit.iSubItem);
  }
  return result;
}

void CReportCtrl::OnCheckChanged(int row, bool checked, UINT mouseMessage) {
  switch (checkboxMode_) {
    case RC_CHKBOX_NONE:
      return;
    case RC_CHKBOX_FIXED:
      SetCheck(row, checked ? FALSE : TRUE);
      return;
    case RC_CHKBOX_SINGLE:
      if (checked) {
        for (int other = 0; other < GetItemCount(); ++other) {
          if (other != row && GetCheck(other)) SetCheck(other, FALSE);
        }
      }
      break;
    default:
      break;
  }
  SetItemStates(-1, RC_ITEM_UNSELECTED);
  SetItemState(row, LVIS_SELECTED | LVIS_FOCUSED, LVIS_SELECTED | LVIS_FOCUSED);
  NotifyParent(WM_REPORT_CHECKBOX_CHANGED, static_cast<WPARAM>(row), static_cast<LPARAM>(mouseMessage));
}

void CReportCtrl::SetEditable(bool editable) {
  if (!editable) EndEdit(true);
  editable_ = editable;
}

BOOL CReportCtrl::StartEdit(int row, int column) {
  if (!editable_ || row < 0 || row >= GetItemCount() || column < 0 || column >= GetColumnCount()) return FALSE;
  EndEdit(true);
  LVCOLUMN info;
  info.mask = LVCF_FMT;
  GetColumn(column, &info);
  const int alignment = info.fmt & LVCFMT_JUSTIFYMASK;
  if (!editor_.m_hWnd || alignment != editorAlignment_) {
    if (editor_.m_hWnd) editor_.DestroyWindow();
    const DWORD align = alignment == LVCFMT_CENTER ? ES_CENTER : alignment == LVCFMT_RIGHT ? ES_RIGHT : ES_LEFT;
    if (!editor_.Create(WS_CHILD | WS_BORDER | ES_AUTOHSCROLL | align, CRect(), this, 0)) return FALSE;
    editorAlignment_ = alignment;
    // An edit left by clicking elsewhere keeps its text: losing the focus commits it.
    framework::InterceptMessages(editor_.m_hWnd, [this](HWND, UINT message, WPARAM, LPARAM) -> std::optional<LRESULT> {
      if (message == WM_KILLFOCUS && IsEditing()) EndEdit(true);
      return std::nullopt;
    });
  }
  CRect cell;
  GetSubItemRect(row, column, LVIR_LABEL, &cell);
  if (column != 0 && GetItemImage(row, column) >= 0 && GetImageList(LVSIL_SMALL)) cell.left += 16;
  editRow_ = row;
  editColumn_ = column;
  editor_.MoveWindow(cell);
  editor_.SendMessage(WM_SETFONT, SendMessage(WM_GETFONT), FALSE);
  editor_.SetWindowText(GetItemText(row, column));
  editor_.ShowWindow(SW_SHOW);
  editor_.SetSel(0, -1);
  editor_.SetFocus();
  return TRUE;
}

BOOL CReportCtrl::EndEdit(bool commit) {
  if (!IsEditing()) return FALSE;
  const int row = std::exchange(editRow_, -1);
  const int column = std::exchange(editColumn_, -1);
  const bool hadFocus = ::GetFocus() == editor_.m_hWnd;
  const std::string text = editor_.GetWindowText();
  editor_.ShowWindow(SW_HIDE);
  if (hadFocus) SetFocus();
  if (commit && row < GetItemCount() && text != GetItemText(row, column)) {
    CListCtrl::SetItemText(row, column, text);
    sortColumn_ = -1;
    NotifyParent(WM_REPORT_CELL_EDITED, static_cast<WPARAM>(row), static_cast<LPARAM>(column));
  }
  return TRUE;
}

void CReportCtrl::MoveEdit(int row, int column) {
  if (row < 0 || row >= GetItemCount()) return;  // the edit stays where it is at the first and last row
  EndEdit(true);
  EnsureVisible(row, FALSE);
  StartEdit(row, column);
}

BOOL CReportCtrl::PreTranslateMessage(MSG* msg) {
  if (msg->message == WM_KEYDOWN && IsEditing() && msg->hwnd == editor_.m_hWnd) {
    switch (msg->wParam) {
      case VK_TAB:
        MoveEdit(editRow_, (editColumn_ + 1) % std::max(1, GetColumnCount()));
        return TRUE;
      case VK_RETURN:
        EndEdit(true);
        return TRUE;
      case VK_ESCAPE:
        EndEdit(false);
        return TRUE;
      case VK_UP:
        MoveEdit(editRow_ - 1, editColumn_);
        return TRUE;
      case VK_DOWN:
        MoveEdit(editRow_ + 1, editColumn_);
        return TRUE;
      default:
        break;
    }
  }
  // Without an edit the space bar does nothing here (it would tick the focused row's box past
  // the check-box mode).
  if (msg->message == WM_KEYDOWN && msg->wParam == VK_SPACE && !IsEditing() && msg->hwnd == m_hWnd) return TRUE;
  return CListCtrl::PreTranslateMessage(msg);
}
