// The list-view class: rows of cells under a header, their states and check boxes, hit tests
// by part of a row, selection by mouse and keys, scrolling, and painting with custom colours
// the parent may give each item and cell (NM_CUSTOMDRAW).
#include <algorithm>
#include <cstring>
#include <optional>
#include <vector>

#include "framework/cdc.h"
#include "framework/controls/control_behaviour.h"
#include "framework/controls/list_ctrl.h"
#include "framework/controls/scroll_bar.h"
#include "framework/image_list.h"
#include "framework/text_metrics.h"
#include "framework/window_classes.h"

namespace framework {
namespace {

constexpr int kStateIconWidth = 16;
constexpr int kFirstLabelPadding = 2;
constexpr int kLabelPadding = 6;
constexpr UINT kUnchecked = 1;
constexpr UINT kChecked = 2;

struct Cell {
  std::string text;
  int image = -1;
};

struct Row {
  std::vector<Cell> cells;
  UINT state = 0;
  LPARAM param = 0;
};

struct Column {
  std::string text;
  int format = LVCFMT_LEFT;
  int width = 0;
};

// Where the parts of one cell lie, in client pixels.
struct CellLayout {
  CRect cell;
  CRect stateIcon;  // empty when the cell has none
  CRect icon;
  CRect label;
};

// What the press of a mouse button started; the release finishes it.
struct Press {
  int item = -1;
  int subItem = -1;
  POINT point;
  bool doubleClick = false;
};

class ListViewBehaviour : public ControlBehaviour {
 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case WM_CREATE:
        header_ = ::CreateWindowEx(0, kHeaderClass, "", WS_CHILD | HDS_HORZ, 0, 0, 0, kHeaderHeight, hwnd, 0);
        bar_ = ::CreateWindowEx(0, kScrollBarClass, "", WS_CHILD | SBS_VERT, 0, 0, 0, 0, hwnd, 1);
        Relayout(hwnd);
        return 0;
      case WM_SIZE:
        Relayout(hwnd);
        return 0;
      case WM_DESTROY:
        DeleteAll(hwnd);  // the owners of the rows' data hear of every row
        return 0;
      case LVM_INSERTCOLUMN:
        return InsertColumn(hwnd, static_cast<int>(wParam), reinterpret_cast<const LVCOLUMN*>(lParam));
      case LVM_DELETECOLUMN:
        return DeleteColumn(hwnd, static_cast<int>(wParam));
      case LVM_GETCOLUMN:
        return GetColumn(static_cast<int>(wParam), reinterpret_cast<LVCOLUMN*>(lParam));
      case LVM_SETCOLUMN:
        return SetColumn(hwnd, static_cast<int>(wParam), reinterpret_cast<const LVCOLUMN*>(lParam));
      case LVM_GETCOLUMNWIDTH:
        return ValidColumn(static_cast<int>(wParam)) ? columns_[wParam].width : 0;
      case LVM_SETCOLUMNWIDTH: {
        LVCOLUMN column;
        column.mask = LVCF_WIDTH;
        column.cx = static_cast<int>(lParam);
        return SetColumn(hwnd, static_cast<int>(wParam), &column);
      }
      case LVM_GETHEADER:
        return header_.ToLParam();
      case LVM_INSERTITEM:
        return InsertItem(hwnd, reinterpret_cast<const LVITEM*>(lParam));
      case LVM_DELETEITEM:
        return DeleteItem(hwnd, static_cast<int>(wParam));
      case LVM_DELETEALLITEMS:
        DeleteAll(hwnd);
        return TRUE;
      case LVM_GETITEMCOUNT:
        return Count();
      case LVM_GETITEM:
        return GetItem(reinterpret_cast<LVITEM*>(lParam));
      case LVM_SETITEM:
        return SetItem(hwnd, reinterpret_cast<const LVITEM*>(lParam));
      case LVM_GETITEMTEXT: {
        auto* item = reinterpret_cast<LVITEM*>(lParam);
        if (item == nullptr || item->pszText == nullptr || item->cchTextMax <= 0) return 0;
        item->iItem = static_cast<int>(wParam);
        item->mask = LVIF_TEXT;
        return GetItem(item) != FALSE ? static_cast<LRESULT>(std::strlen(item->pszText)) : 0;
      }
      case LVM_SETITEMTEXT: {
        const auto* source = reinterpret_cast<const LVITEM*>(lParam);
        if (source == nullptr) return FALSE;
        LVITEM item = *source;
        item.iItem = static_cast<int>(wParam);
        item.mask = LVIF_TEXT;
        return SetItem(hwnd, &item);
      }
      case LVM_GETITEMSTATE:
        return ValidRow(static_cast<int>(wParam)) ? static_cast<LRESULT>(rows_[wParam].state & static_cast<UINT>(lParam)) : 0;
      case LVM_SETITEMSTATE: {
        const auto* item = reinterpret_cast<const LVITEM*>(lParam);
        if (item == nullptr) return FALSE;
        const auto index = static_cast<int>(static_cast<std::intptr_t>(wParam));
        if (index < 0) {
          for (int i = 0; i < Count(); ++i) ChangeState(hwnd, i, item->state, item->stateMask);
          return TRUE;
        }
        return ValidRow(index) && ChangeState(hwnd, index, item->state, item->stateMask);
      }
      case LVM_GETNEXTITEM:
        return NextItem(static_cast<int>(static_cast<std::intptr_t>(wParam)), static_cast<UINT>(lParam));
      case LVM_GETSELECTEDCOUNT:
        return std::count_if(rows_.begin(), rows_.end(), [](const Row& r) { return (r.state & LVIS_SELECTED) != 0; });
      case LVM_GETITEMRECT: {
        auto* rect = reinterpret_cast<RECT*>(lParam);
        return rect != nullptr && ItemRect(hwnd, static_cast<int>(wParam), rect->left, *rect);
      }
      case LVM_GETSUBITEMRECT: {
        auto* rect = reinterpret_cast<RECT*>(lParam);
        return rect != nullptr && SubItemRect(hwnd, static_cast<int>(wParam), rect->top, rect->left, *rect);
      }
      case LVM_HITTEST:
      case LVM_SUBITEMHITTEST: {
        auto* info = reinterpret_cast<LVHITTESTINFO*>(lParam);
        if (info == nullptr) return -1;
        HitTest(hwnd, *info);
        return info->iItem;
      }
      case LVM_ENSUREVISIBLE:
        EnsureVisible(hwnd, static_cast<int>(wParam));
        return TRUE;
      case LVM_GETTOPINDEX:
        return top_;
      case LVM_GETCOUNTPERPAGE:
        return PerPage(hwnd);
      case LVM_SETIMAGELIST: {
        const int which = std::clamp(static_cast<int>(wParam), 0, 2);
        const HIMAGELIST old = std::exchange(images_[which], HIMAGELIST::FromParam(lParam));
        Relayout(hwnd);
        return old.ToLParam();
      }
      case LVM_GETIMAGELIST:
        return images_[std::clamp(static_cast<int>(wParam), 0, 2)].ToLParam();
      case LVM_SETEXTENDEDLISTVIEWSTYLE: {
        const DWORD mask = wParam != 0 ? static_cast<DWORD>(wParam) : 0xFFFFFFFF;
        const DWORD old = exStyle_;
        exStyle_ = (exStyle_ & ~mask) | (static_cast<DWORD>(lParam) & mask);
        if (((old ^ exStyle_) & LVS_EX_CHECKBOXES) != 0) {
          // Rows gain an unchecked box, or lose their box.
          for (Row& row : rows_) {
            row.state &= ~LVIS_STATEIMAGEMASK;
            if ((exStyle_ & LVS_EX_CHECKBOXES) != 0) row.state |= INDEXTOSTATEIMAGEMASK(kUnchecked);
          }
        }
        Relayout(hwnd);
        return old;
      }
      case LVM_GETEXTENDEDLISTVIEWSTYLE:
        return exStyle_;
      case LVM_SETTEXTCOLOR:
        textColor_ = static_cast<COLORREF>(lParam);
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return TRUE;
      case LVM_GETTEXTCOLOR:
        return textColor_;
      case LVM_SETBKCOLOR:
        backColor_ = static_cast<COLORREF>(lParam);
        ::InvalidateRect(hwnd, nullptr, TRUE);
        return TRUE;
      case LVM_GETBKCOLOR:
        return backColor_;
      case WM_NOTIFY: {
        const auto* header = reinterpret_cast<const NMHDR*>(lParam);
        if (header != nullptr && header->hwndFrom == header_ && header->code == HDN_ITEMCLICK) {
          NMLISTVIEW nm;
          nm.iSubItem = reinterpret_cast<const NMHEADER*>(lParam)->iItem;
          Notify(hwnd, LVN_COLUMNCLICK, &nm.hdr);
        }
        return 0;
      }
      case WM_VSCROLL:
        Scroll(hwnd, LOWORD(wParam));
        return 0;
      case WM_GETDLGCODE:
        return DLGC_WANTARROWS | DLGC_WANTCHARS;
      case WM_LBUTTONDOWN:
      case WM_LBUTTONDBLCLK:
        OnLeftPress(hwnd, {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)}, message == WM_LBUTTONDBLCLK);
        return 0;
      case WM_LBUTTONUP:
        OnLeftRelease(hwnd);
        return 0;
      case WM_RBUTTONDOWN:
      case WM_RBUTTONDBLCLK:
        OnRightPress(hwnd, {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)});
        return 0;
      case WM_CAPTURECHANGED:
        if (HWND::FromParam(lParam) != hwnd) press_.reset();
        return 0;
      case WM_KEYDOWN:
        OnKey(hwnd, static_cast<UINT>(wParam));
        return 0;
      case WM_SETFOCUS:
        Notify(hwnd, NM_SETFOCUS);
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return 0;
      case WM_KILLFOCUS:
        Notify(hwnd, NM_KILLFOCUS);
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override;

 private:
  int Count() const { return static_cast<int>(rows_.size()); }
  bool ValidRow(int index) const { return index >= 0 && index < Count(); }
  bool ValidColumn(int index) const { return index >= 0 && index < static_cast<int>(columns_.size()); }
  bool CheckBoxes() const { return (exStyle_ & LVS_EX_CHECKBOXES) != 0; }
  static UINT StateImage(const Row& row) { return (row.state & LVIS_STATEIMAGEMASK) >> 12; }

  static bool ShowsHeader(HWND hwnd) {
    const DWORD style = ::GetWindowStyle(hwnd);
    return (style & LVS_TYPEMASK) == LVS_REPORT && (style & LVS_NOCOLUMNHEADER) == 0;
  }

  static int HeaderHeight(HWND hwnd) { return ShowsHeader(hwnd) ? kHeaderHeight : 0; }

  int RowHeight() const {
    int cx = 0;
    int cy = 0;
    ImageList_GetIconSize(images_[LVSIL_SMALL], &cx, &cy);
    return std::max(kLineHeight + 4, cy + 2);
  }

  int PerPage(HWND hwnd) const { return std::max(1, (ClientRect(hwnd).Height() - HeaderHeight(hwnd)) / RowHeight()); }

  int ItemsWidth(HWND hwnd) const { return ClientRect(hwnd).Width() - (::IsWindowVisible(bar_) ? kScrollBarWidth : 0); }

  // Puts the header and the scroll bar where the rows and columns want them.
  void Relayout(HWND hwnd) {
    top_ = std::clamp(top_, 0, std::max(0, Count() - PerPage(hwnd)));
    const CRect client = ClientRect(hwnd);
    ShowListScrollBar(bar_, client, Count(), PerPage(hwnd), top_);
    DWORD headerStyle = ::GetWindowStyle(header_) & ~HDS_BUTTONS;
    if ((::GetWindowStyle(hwnd) & LVS_NOSORTHEADER) == 0) headerStyle |= HDS_BUTTONS;
    ::SetWindowStyle(header_, headerStyle);
    ::SetWindowPos(header_, 0, 0, ItemsWidth(hwnd), kHeaderHeight, SWP_NOZORDER);
    if ((::IsWindowVisible(header_) != FALSE) != ShowsHeader(hwnd)) ::ShowWindow(header_, ShowsHeader(hwnd) ? SW_SHOWNA : SW_HIDE);
    ::InvalidateRect(hwnd, nullptr, FALSE);
  }

  void Scroll(HWND hwnd, WORD request) {
    const int page = PerPage(hwnd);
    if (request == SB_LINEUP) top_ -= 1;
    if (request == SB_LINEDOWN) top_ += 1;
    if (request == SB_PAGEUP) top_ -= page;
    if (request == SB_PAGEDOWN) top_ += page;
    if (request == SB_TOP) top_ = 0;
    if (request == SB_BOTTOM) top_ = Count();
    Relayout(hwnd);
  }

  void EnsureVisible(HWND hwnd, int index) {
    if (!ValidRow(index)) return;
    const int page = PerPage(hwnd);
    if (index < top_) top_ = index;
    if (index >= top_ + page) top_ = index - page + 1;
    Relayout(hwnd);
  }

  int ColumnLeft(int column) const {
    int left = 0;
    for (int i = 0; i < column; ++i) left += columns_[static_cast<std::size_t>(i)].width;
    return left;
  }

  int ColumnCount() const { return std::max(1, static_cast<int>(columns_.size())); }

  CellLayout LayoutCell(HWND hwnd, int row, int column) const {
    CellLayout l;
    const int top = HeaderHeight(hwnd) + (row - top_) * RowHeight();
    const int width = ValidColumn(column) ? columns_[static_cast<std::size_t>(column)].width : ItemsWidth(hwnd);
    l.cell = CRect(ColumnLeft(column), top, ColumnLeft(column) + width, top + RowHeight());
    int x = l.cell.left;
    if (column == 0 && CheckBoxes()) {
      l.stateIcon = CRect(x, top, x + kStateIconWidth, l.cell.bottom);
      x += kStateIconWidth;
    }
    int cx = 0;
    int cy = 0;
    const bool hasImages = ImageList_GetIconSize(images_[LVSIL_SMALL], &cx, &cy) != FALSE;
    const Cell* cell = CellAt(row, column);
    const bool showsImage =
        hasImages && (column == 0 || ((exStyle_ & LVS_EX_SUBITEMIMAGES) != 0 && cell != nullptr && cell->image >= 0));
    if (showsImage) {
      l.icon = CRect(x + (column == 0 ? 0 : 2), top, x + (column == 0 ? 0 : 2) + cx, l.cell.bottom);
      x = l.icon.right;
    } else {
      l.icon = CRect(x, top, x, l.cell.bottom);
    }
    l.label = CRect(x, top, std::max(x, l.cell.right), l.cell.bottom);
    return l;
  }

  const Cell* CellAt(int row, int column) const {
    if (!ValidRow(row) || column < 0) return nullptr;
    const std::vector<Cell>& cells = rows_[static_cast<std::size_t>(row)].cells;
    return column < static_cast<int>(cells.size()) ? &cells[static_cast<std::size_t>(column)] : nullptr;
  }

  void HitTest(HWND hwnd, LVHITTESTINFO& info) const {
    const CRect client = ClientRect(hwnd);
    const POINT p = info.pt;
    info.iItem = info.iSubItem = -1;
    info.flags = 0;
    if (p.x < 0) info.flags |= LVHT_TOLEFT;
    if (p.x >= client.right) info.flags |= LVHT_TORIGHT;
    if (p.y < HeaderHeight(hwnd)) info.flags |= LVHT_ABOVE;
    if (p.y >= client.bottom) info.flags |= LVHT_BELOW;
    if (info.flags != 0) return;
    const int row = top_ + (p.y - HeaderHeight(hwnd)) / RowHeight();
    if (!ValidRow(row) || p.x >= ItemsWidth(hwnd)) {
      info.flags = LVHT_NOWHERE;
      return;
    }
    for (int column = 0; column < ColumnCount(); ++column) {
      const CellLayout l = LayoutCell(hwnd, row, column);
      if (!l.cell.PtInRect(p)) continue;
      info.iItem = row;
      info.iSubItem = column;
      if (l.stateIcon.PtInRect(p)) {
        info.flags = LVHT_ONITEMSTATEICON;
      } else if (l.icon.PtInRect(p)) {
        info.flags = LVHT_ONITEMICON;
      } else {
        info.flags = LVHT_ONITEMLABEL;
      }
      return;
    }
    // Right of the last column only a full-row selection still counts as the row.
    if ((exStyle_ & LVS_EX_FULLROWSELECT) != 0) {
      info.iItem = row;
      info.flags = LVHT_ONITEMLABEL;
    } else {
      info.flags = LVHT_NOWHERE;
    }
  }

  bool ItemRect(HWND hwnd, int row, int code, RECT& rect) const {
    if (!ValidRow(row)) return false;
    const CellLayout first = LayoutCell(hwnd, row, 0);
    switch (code) {
      case LVIR_ICON:
        rect = first.icon;
        return true;
      case LVIR_LABEL:
        rect = first.label;
        return true;
      case LVIR_BOUNDS:
        rect = CRect(0, first.cell.top, std::max(ColumnLeft(ColumnCount()), ItemsWidth(hwnd)), first.cell.bottom);
        return true;
      default:
        rect = CRect(first.icon.left, first.cell.top, first.label.right, first.cell.bottom);
        return true;
    }
  }

  // As the system answers it: the bounds of column 0 are the whole row's, and the label of any
  // other column is the whole cell, its image included.
  bool SubItemRect(HWND hwnd, int row, int column, int code, RECT& rect) const {
    if (!ValidRow(row) || column < 0 || column >= ColumnCount()) return false;
    if (column == 0) return ItemRect(hwnd, row, code, rect);
    const CellLayout l = LayoutCell(hwnd, row, column);
    rect = code == LVIR_ICON ? l.icon : l.cell;
    return true;
  }

  LRESULT InsertColumn(HWND hwnd, int index, const LVCOLUMN* info) {
    if (info == nullptr) return -1;
    index = std::clamp(index, 0, static_cast<int>(columns_.size()));
    Column column;
    if ((info->mask & LVCF_TEXT) != 0 && info->pszText != nullptr) column.text = info->pszText;
    if ((info->mask & LVCF_FMT) != 0) column.format = info->fmt;
    if ((info->mask & LVCF_WIDTH) != 0) column.width = std::max(0, info->cx);
    // A first column is new only when the rows' cells already hold it.
    const bool shiftsCells = !columns_.empty() || index > 0;
    columns_.insert(columns_.begin() + index, column);
    if (shiftsCells) {
      for (Row& row : rows_) {
        if (static_cast<int>(row.cells.size()) >= index) row.cells.insert(row.cells.begin() + index, Cell{});
      }
    }
    HDITEM title;
    title.mask = HDI_TEXT | HDI_WIDTH | HDI_FORMAT;
    title.pszText = columns_[static_cast<std::size_t>(index)].text.data();
    title.cxy = column.width;
    title.fmt = column.format & LVCFMT_JUSTIFYMASK;
    ::SendMessage(header_, HDM_INSERTITEM, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(&title));
    Relayout(hwnd);
    return index;
  }

  LRESULT DeleteColumn(HWND hwnd, int index) {
    if (!ValidColumn(index)) return FALSE;
    columns_.erase(columns_.begin() + index);
    for (Row& row : rows_) {
      if (index < static_cast<int>(row.cells.size()) && row.cells.size() > 1) row.cells.erase(row.cells.begin() + index);
    }
    ::SendMessage(header_, HDM_DELETEITEM, static_cast<WPARAM>(index), 0);
    Relayout(hwnd);
    return TRUE;
  }

  LRESULT GetColumn(int index, LVCOLUMN* info) const {
    if (!ValidColumn(index) || info == nullptr) return FALSE;
    const Column& column = columns_[static_cast<std::size_t>(index)];
    if ((info->mask & LVCF_FMT) != 0) info->fmt = column.format;
    if ((info->mask & LVCF_WIDTH) != 0) info->cx = column.width;
    if ((info->mask & LVCF_SUBITEM) != 0) info->iSubItem = index;
    if ((info->mask & LVCF_TEXT) != 0 && info->pszText != nullptr && info->cchTextMax > 0) {
      const std::size_t n = std::min(column.text.size(), static_cast<std::size_t>(info->cchTextMax - 1));
      std::memcpy(info->pszText, column.text.data(), n);
      info->pszText[n] = '\0';
    }
    return TRUE;
  }

  LRESULT SetColumn(HWND hwnd, int index, const LVCOLUMN* info) {
    if (!ValidColumn(index) || info == nullptr) return FALSE;
    Column& column = columns_[static_cast<std::size_t>(index)];
    if ((info->mask & LVCF_FMT) != 0) column.format = info->fmt;
    if ((info->mask & LVCF_WIDTH) != 0) column.width = std::max(0, info->cx);
    if ((info->mask & LVCF_TEXT) != 0) column.text = info->pszText != nullptr ? info->pszText : "";
    HDITEM title;
    title.mask = HDI_TEXT | HDI_WIDTH | HDI_FORMAT;
    title.pszText = column.text.data();
    title.cxy = column.width;
    title.fmt = column.format & LVCFMT_JUSTIFYMASK;
    ::SendMessage(header_, HDM_SETITEM, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(&title));
    Relayout(hwnd);
    return TRUE;
  }

  NMLISTVIEW Describe(int index) const {
    NMLISTVIEW nm;
    nm.iItem = index;
    if (ValidRow(index)) nm.lParam = rows_[static_cast<std::size_t>(index)].param;
    return nm;
  }

  LRESULT InsertItem(HWND hwnd, const LVITEM* item) {
    if (item == nullptr || item->iSubItem != 0) return -1;
    const int index = std::clamp(item->iItem, 0, Count());
    Row row;
    row.cells.resize(static_cast<std::size_t>(ColumnCount()));
    if ((item->mask & LVIF_TEXT) != 0 && item->pszText != nullptr) row.cells[0].text = item->pszText;
    if ((item->mask & LVIF_IMAGE) != 0) row.cells[0].image = item->iImage;
    if ((item->mask & LVIF_PARAM) != 0) row.param = item->lParam;
    if ((item->mask & LVIF_STATE) != 0) row.state = item->state & item->stateMask;
    if (CheckBoxes() && StateImage(row) == 0) row.state |= INDEXTOSTATEIMAGEMASK(kUnchecked);
    rows_.insert(rows_.begin() + index, std::move(row));
    NMLISTVIEW nm = Describe(index);
    Notify(hwnd, LVN_INSERTITEM, &nm.hdr);
    Relayout(hwnd);
    return index;
  }

  LRESULT DeleteItem(HWND hwnd, int index) {
    if (!ValidRow(index)) return FALSE;
    NMLISTVIEW nm = Describe(index);
    Notify(hwnd, LVN_DELETEITEM, &nm.hdr);
    if (!ValidRow(index)) return FALSE;  // the parent changed the rows meanwhile
    rows_.erase(rows_.begin() + index);
    if (press_ && press_->item >= index) press_.reset();
    Relayout(hwnd);
    return TRUE;
  }

  void DeleteAll(HWND hwnd) {
    if (rows_.empty()) return;
    NMLISTVIEW all = Describe(-1);
    if (Notify(hwnd, LVN_DELETEALLITEMS, &all.hdr) == 0) {
      for (int i = 0; i < Count(); ++i) {
        NMLISTVIEW nm = Describe(i);
        Notify(hwnd, LVN_DELETEITEM, &nm.hdr);
      }
    }
    rows_.clear();
    press_.reset();
    top_ = 0;
    if (::IsWindow(bar_)) Relayout(hwnd);
  }

  LRESULT GetItem(LVITEM* item) const {
    if (item == nullptr) return FALSE;
    const Cell* cell = CellAt(item->iItem, item->iSubItem);
    if (!ValidRow(item->iItem) || item->iSubItem < 0 || item->iSubItem >= ColumnCount()) return FALSE;
    const Row& row = rows_[static_cast<std::size_t>(item->iItem)];
    if ((item->mask & LVIF_TEXT) != 0 && item->pszText != nullptr && item->cchTextMax > 0) {
      const std::string text = cell != nullptr ? cell->text : std::string();
      const std::size_t n = std::min(text.size(), static_cast<std::size_t>(item->cchTextMax - 1));
      std::memcpy(item->pszText, text.data(), n);
      item->pszText[n] = '\0';
    }
    if ((item->mask & LVIF_IMAGE) != 0) item->iImage = cell != nullptr ? cell->image : -1;
    if ((item->mask & LVIF_PARAM) != 0) item->lParam = row.param;
    if ((item->mask & LVIF_STATE) != 0) item->state = row.state & item->stateMask;
    return TRUE;
  }

  LRESULT SetItem(HWND hwnd, const LVITEM* item) {
    if (item == nullptr || !ValidRow(item->iItem) || item->iSubItem < 0 || item->iSubItem >= ColumnCount()) return FALSE;
    Row& row = rows_[static_cast<std::size_t>(item->iItem)];
    if (static_cast<int>(row.cells.size()) <= item->iSubItem) row.cells.resize(static_cast<std::size_t>(item->iSubItem) + 1);
    Cell& cell = row.cells[static_cast<std::size_t>(item->iSubItem)];
    if ((item->mask & LVIF_TEXT) != 0) cell.text = item->pszText != nullptr ? item->pszText : "";
    if ((item->mask & LVIF_IMAGE) != 0) cell.image = item->iImage;
    if (item->iSubItem == 0 && (item->mask & LVIF_PARAM) != 0) row.param = item->lParam;
    ::InvalidateRect(hwnd, nullptr, FALSE);
    if (item->iSubItem == 0 && (item->mask & LVIF_STATE) != 0) ChangeState(hwnd, item->iItem, item->state, item->stateMask);
    return TRUE;
  }

  // Changes state bits of a row, asking the parent first (LVN_ITEMCHANGING) and telling it
  // after (LVN_ITEMCHANGED); a single-selection list keeps one row selected.
  bool ChangeState(HWND hwnd, int index, UINT state, UINT mask) {
    if (!ValidRow(index)) return false;
    const UINT old = rows_[static_cast<std::size_t>(index)].state;
    const UINT next = (old & ~mask) | (state & mask);
    if (next == old) return true;
    NMLISTVIEW nm = Describe(index);
    nm.uChanged = LVIF_STATE;
    nm.uOldState = old;
    nm.uNewState = next;
    if (Notify(hwnd, LVN_ITEMCHANGING, &nm.hdr) != 0 || !ValidRow(index)) return false;
    const bool single = (::GetWindowStyle(hwnd) & LVS_SINGLESEL) != 0;
    const bool gainsSelection = (next & ~old & LVIS_SELECTED) != 0;
    const bool gainsFocus = (next & ~old & LVIS_FOCUSED) != 0;
    for (int i = 0; i < Count(); ++i) {
      if (i == index) continue;
      if (gainsFocus) ChangeState(hwnd, i, 0, LVIS_FOCUSED);
      if (gainsSelection && single) ChangeState(hwnd, i, 0, LVIS_SELECTED);
    }
    if (!ValidRow(index)) return false;
    rows_[static_cast<std::size_t>(index)].state = next;
    ::InvalidateRect(hwnd, nullptr, FALSE);
    nm = Describe(index);
    nm.uChanged = LVIF_STATE;
    nm.uOldState = old;
    nm.uNewState = next;
    Notify(hwnd, LVN_ITEMCHANGED, &nm.hdr);
    return true;
  }

  void SelectOnly(HWND hwnd, int index) {
    for (int i = 0; i < Count(); ++i) {
      if (i != index) ChangeState(hwnd, i, 0, LVIS_SELECTED);
    }
    if (ValidRow(index)) ChangeState(hwnd, index, LVIS_SELECTED | LVIS_FOCUSED, LVIS_SELECTED | LVIS_FOCUSED);
  }

  void ToggleCheck(HWND hwnd, int index) {
    const UINT next = StateImage(rows_[static_cast<std::size_t>(index)]) == kChecked ? kUnchecked : kChecked;
    ChangeState(hwnd, index, INDEXTOSTATEIMAGEMASK(next), LVIS_STATEIMAGEMASK);
  }

  LRESULT NextItem(int start, UINT flags) const {
    const UINT wanted = flags & (LVNI_SELECTED | LVNI_FOCUSED);
    const int step = (flags & LVNI_ABOVE) != 0 ? -1 : 1;
    for (int i = start + step; i >= 0 && i < Count(); i += step) {
      const UINT state = rows_[static_cast<std::size_t>(i)].state;
      if (((wanted & LVNI_SELECTED) == 0 || (state & LVIS_SELECTED) != 0) &&
          ((wanted & LVNI_FOCUSED) == 0 || (state & LVIS_FOCUSED) != 0)) {
        return i;
      }
    }
    return -1;
  }

  NMITEMACTIVATE Activation(const Press& press) const {
    NMITEMACTIVATE nm;
    nm.iItem = press.item;
    nm.iSubItem = press.subItem;
    nm.ptAction = press.point;
    if (ValidRow(press.item)) nm.lParam = rows_[static_cast<std::size_t>(press.item)].param;
    return nm;
  }

  void OnLeftPress(HWND hwnd, POINT p, bool doubleClick) {
    ::SetFocus(hwnd);
    LVHITTESTINFO info;
    info.pt = p;
    HitTest(hwnd, info);
    if (ValidRow(info.iItem)) {
      if ((info.flags & LVHT_ONITEMSTATEICON) != 0 && CheckBoxes()) ToggleCheck(hwnd, info.iItem);
      SelectOnly(hwnd, info.iItem);
    } else {
      SelectOnly(hwnd, -1);
    }
    press_ = Press{info.iItem, info.iSubItem, p, doubleClick};
    ::SetCapture(hwnd);
    if (doubleClick) {
      NMITEMACTIVATE nm = Activation(*press_);
      Notify(hwnd, NM_DBLCLK, &nm.hdr);
    }
  }

  void OnLeftRelease(HWND hwnd) {
    if (!press_) return;
    const Press press = *press_;
    press_.reset();
    ::ReleaseCapture();
    if (press.doubleClick) return;  // the double click was reported with its press
    NMITEMACTIVATE nm = Activation(press);
    Notify(hwnd, NM_CLICK, &nm.hdr);
  }

  void OnRightPress(HWND hwnd, POINT p) {
    ::SetFocus(hwnd);
    LVHITTESTINFO info;
    info.pt = p;
    HitTest(hwnd, info);
    if (ValidRow(info.iItem)) SelectOnly(hwnd, info.iItem);
    NMITEMACTIVATE nm = Activation(Press{info.iItem, info.iSubItem, p, false});
    Notify(hwnd, NM_RCLICK, &nm.hdr);
  }

  void OnKey(HWND hwnd, UINT key) {
    NMLVKEYDOWN nm;
    nm.wVKey = static_cast<WORD>(key);
    Notify(hwnd, LVN_KEYDOWN, &nm.hdr);
    if (!::IsWindow(hwnd) || rows_.empty()) return;
    const int focused = static_cast<int>(NextItem(-1, LVNI_FOCUSED));
    const int page = PerPage(hwnd);
    const int last = Count() - 1;
    int target = -1;
    switch (key) {
      case VK_UP:
        target = focused < 0 ? 0 : std::max(0, focused - 1);
        break;
      case VK_DOWN:
        target = focused < 0 ? 0 : std::min(last, focused + 1);
        break;
      case VK_PRIOR:
        target = std::max(0, focused - page);
        break;
      case VK_NEXT:
        target = std::min(last, std::max(0, focused) + page);
        break;
      case VK_HOME:
        target = 0;
        break;
      case VK_END:
        target = last;
        break;
      case VK_SPACE:
        if (CheckBoxes() && focused >= 0) ToggleCheck(hwnd, focused);
        return;
      default:
        return;
    }
    SelectOnly(hwnd, target);
    EnsureVisible(hwnd, target);
  }

  void PaintRow(HWND hwnd, Canvas& canvas, int index, LRESULT prepaint);

  std::vector<Row> rows_;
  std::vector<Column> columns_;
  HIMAGELIST images_[3];
  DWORD exStyle_ = 0;
  int top_ = 0;
  HWND header_;
  HWND bar_;
  std::optional<Press> press_;
  COLORREF textColor_ = RGB(0, 0, 0);
  COLORREF backColor_ = RGB(255, 255, 255);
};

void ListViewBehaviour::Paint(HWND hwnd, Canvas& canvas) {
  const CRect client = ClientRect(hwnd);
  canvas.FillRect(client, backColor_);
  NMLVCUSTOMDRAW cd;
  cd.nmcd.dwDrawStage = CDDS_PREPAINT;
  cd.nmcd.hdc = &canvas;
  cd.nmcd.rc = client;
  const LRESULT prepaint = Notify(hwnd, NM_CUSTOMDRAW, &cd.nmcd.hdr);
  const int last = std::min(Count(), top_ + PerPage(hwnd) + 1);
  for (int row = top_; row < last; ++row) PaintRow(hwnd, canvas, row, prepaint);
}

void ListViewBehaviour::PaintRow(HWND hwnd, Canvas& canvas, int index, LRESULT prepaint) {
  const Row& row = rows_[static_cast<std::size_t>(index)];
  const bool focusedList = HasFocus(hwnd);
  const bool selected = (row.state & LVIS_SELECTED) != 0;
  const bool highlighted = selected && (focusedList || (::GetWindowStyle(hwnd) & LVS_SHOWSELALWAYS) != 0);
  const bool fullRow = (exStyle_ & LVS_EX_FULLROWSELECT) != 0;
  const bool enabled = ::IsWindowEnabled(hwnd) != FALSE;

  std::string state;
  const auto add = [&state](std::string_view word) { state += (state.empty() ? "" : " ") + std::string(word); };
  if (StateImage(row) == kChecked) add("checked");
  if (StateImage(row) == kUnchecked && CheckBoxes()) add("unchecked");
  if (selected) add("selected");
  if ((row.state & LVIS_FOCUSED) != 0) add("focused");
  Canvas::Attributes attributes = {{"data-row", std::to_string(index)}, {"data-item", row.cells.front().text}};
  if (!state.empty()) attributes.emplace_back("data-state", state);
  canvas.BeginGroup(attributes);

  NMLVCUSTOMDRAW cd;
  cd.nmcd.hdc = &canvas;
  cd.nmcd.dwItemSpec = static_cast<DWORD_PTR>(index);
  cd.nmcd.uItemState = (selected ? CDIS_SELECTED : 0) | ((row.state & LVIS_FOCUSED) != 0 ? CDIS_FOCUS : 0);
  cd.nmcd.lItemlParam = row.param;
  LRESULT itemAnswer = CDRF_DODEFAULT;
  COLORREF itemText = CLR_DEFAULT;
  COLORREF itemBack = CLR_DEFAULT;
  if ((prepaint & CDRF_NOTIFYITEMDRAW) != 0) {
    cd.nmcd.dwDrawStage = CDDS_ITEMPREPAINT;
    itemAnswer = Notify(hwnd, NM_CUSTOMDRAW, &cd.nmcd.hdr);
    itemText = cd.clrText;
    itemBack = cd.clrTextBk;
  }
  CDC& dc = canvas.Dc();
  dc.SetBkMode(TRANSPARENT);
  for (int column = 0; column < ColumnCount(); ++column) {
    const CellLayout l = LayoutCell(hwnd, index, column);
    if (l.cell.left >= ItemsWidth(hwnd)) break;
    COLORREF text = itemText;
    COLORREF back = itemBack;
    if ((itemAnswer & CDRF_NOTIFYSUBITEMDRAW) != 0) {
      cd.nmcd.dwDrawStage = CDDS_ITEMPREPAINT | CDDS_SUBITEM;
      cd.iSubItem = column;
      cd.clrText = itemText;
      cd.clrTextBk = itemBack;
      if (Notify(hwnd, NM_CUSTOMDRAW, &cd.nmcd.hdr) == CDRF_SKIPDEFAULT) continue;
      text = cd.clrText;
      back = cd.clrTextBk;
    }
    canvas.BeginGroup({{"data-column", std::to_string(column)}});
    if (back != CLR_DEFAULT) canvas.FillRect(l.cell, back);
    const bool lit = highlighted && (fullRow || column == 0);
    if (lit) {
      const CRect area = fullRow || column != 0 ? l.cell : l.label;
      canvas.FillRect(area, focusedList ? ::GetSysColor(COLOR_HIGHLIGHT) : RGB(217, 217, 217));
    }
    if (!l.stateIcon.IsRectEmpty()) {
      PaintCheckBox(canvas, {l.stateIcon.left + 2, l.stateIcon.top + (l.stateIcon.Height() - 13) / 2},
                    StateImage(row) == kChecked ? BST_CHECKED : BST_UNCHECKED, enabled);
    }
    const Cell* cell = CellAt(index, column);
    if (cell != nullptr && l.icon.Width() > 0 && cell->image >= 0) {
      int cx = 0;
      int cy = 0;
      ImageList_GetIconSize(images_[LVSIL_SMALL], &cx, &cy);
      const int y = l.icon.top + (l.icon.Height() - cy) / 2;
      if (enabled) {
        ImageList_Draw(images_[LVSIL_SMALL], cell->image, &canvas, l.icon.left, y, ILD_TRANSPARENT);
      } else {
        DrawImageDimmed(images_[LVSIL_SMALL], cell->image, &canvas, l.icon.left, y);
      }
    }
    if (cell != nullptr && !cell->text.empty()) {
      COLORREF ink = text != CLR_DEFAULT ? text : textColor_;
      if (!enabled) ink = ::GetSysColor(COLOR_GRAYTEXT);
      if (lit && focusedList) ink = ::GetSysColor(COLOR_HIGHLIGHTTEXT);
      const int padding = column == 0 ? kFirstLabelPadding : kLabelPadding;
      CRect label(l.label.left + padding, l.label.top, l.label.right - padding, l.label.bottom);
      const int justify = ValidColumn(column) ? columns_[static_cast<std::size_t>(column)].format & LVCFMT_JUSTIFYMASK : 0;
      dc.SetTextColor(ink);
      dc.DrawText(cell->text, &label,
                  DT_SINGLELINE | DT_VCENTER | DT_NOPREFIX | DT_END_ELLIPSIS |
                      (justify == LVCFMT_CENTER ? DT_CENTER : justify == LVCFMT_RIGHT ? DT_RIGHT : DT_LEFT));
    }
    if ((exStyle_ & LVS_EX_GRIDLINES) != 0) {
      canvas.FillRect(CRect(l.cell.right - 1, l.cell.top, l.cell.right, l.cell.bottom), RGB(240, 240, 240));
      canvas.FillRect(CRect(l.cell.left, l.cell.bottom - 1, l.cell.right, l.cell.bottom), RGB(240, 240, 240));
    }
    canvas.EndGroup();
  }
  if (focusedList && (row.state & LVIS_FOCUSED) != 0) {
    RECT bounds;
    ItemRect(hwnd, index, fullRow ? LVIR_BOUNDS : LVIR_LABEL, bounds);
    canvas.FocusRect(bounds);
  }
  canvas.EndGroup();
}

}  // namespace

void RegisterListViewClass() {
  RegisterWindowClass(kListViewClass, CS_DBLCLKS, [] { return std::make_unique<ListViewBehaviour>(); });
}

}  // namespace framework
