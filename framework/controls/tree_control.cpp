// The tree-view class: the item model, its layout in rows and columns, hit tests, selection,
// expansion, check boxes, keyboard and mouse, in-place label editing and painting.
#include "framework/controls/tree_control.h"

#include <algorithm>
#include <cctype>
#include <cstring>
#include <map>
#include <optional>
#include <vector>

#include "framework/cdc.h"
#include "framework/controls/control_behaviour.h"
#include "framework/image_list.h"
#include "framework/message_queue.h"
#include "framework/text_metrics.h"
#include "framework/window_classes.h"

namespace framework {
namespace {

constexpr int kRowHeight = 18;
constexpr int kIndent = 19;
constexpr int kStateImageWidth = 16;
constexpr int kLabelPadding = 2;
constexpr UINT_PTR kEditTimer = 0x2A;
constexpr UINT kEditDelayMs = 500;  // a second click on the selected label starts editing after this
constexpr UINT kUnchecked = 1;
constexpr UINT kChecked = 2;

struct Item {
  HTREEITEM parent;
  std::vector<HTREEITEM> children;
  std::string text;
  int image = 0;
  int selectedImage = 0;
  LPARAM data = 0;
  UINT state = 0;
};

// Where the parts of one row lie, in client pixels.
struct RowLayout {
  int top = 0;
  int buttonLeft = 0;  // the indent column that holds the +/- button
  int stateLeft = 0;
  int stateWidth = 0;
  int imageLeft = 0;
  int imageWidth = 0;
  int labelLeft = 0;
  int labelRight = 0;
};

class TreeBehaviour : public ControlBehaviour {
 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case TVM_INSERTITEM:
        return Insert(hwnd, reinterpret_cast<const TVINSERTSTRUCT*>(lParam)).ToLParam();
      case TVM_DELETEITEM:
        return Delete(hwnd, HTREEITEM::FromParam(lParam));
      case TVM_EXPAND:
        return Expand(hwnd, HTREEITEM::FromParam(lParam), static_cast<UINT>(wParam), false);
      case TVM_GETITEMRECT:
        return ItemRect(hwnd, wParam != 0, reinterpret_cast<RECT*>(lParam));
      case TVM_GETCOUNT:
        return static_cast<LRESULT>(items_.size());
      case TVM_GETINDENT:
        return kIndent;
      case TVM_GETVISIBLECOUNT:
        return VisibleCapacity(hwnd);
      case TVM_SETIMAGELIST: {
        HIMAGELIST& slot = wParam == static_cast<WPARAM>(TVSIL_STATE) ? stateImages_ : images_;
        ::InvalidateRect(hwnd, nullptr, TRUE);
        return std::exchange(slot, HIMAGELIST::FromParam(lParam)).ToLParam();
      }
      case TVM_GETIMAGELIST:
        return (wParam == static_cast<WPARAM>(TVSIL_STATE) ? stateImages_ : images_).ToLParam();
      case TVM_GETNEXTITEM:
        return Next(hwnd, HTREEITEM::FromParam(lParam), static_cast<UINT>(wParam)).ToLParam();
      case TVM_SELECTITEM:
        return SelectBy(hwnd, static_cast<UINT>(wParam), HTREEITEM::FromParam(lParam));
      case TVM_GETITEM:
        return GetItem(reinterpret_cast<TVITEM*>(lParam));
      case TVM_SETITEM:
        return SetItem(hwnd, reinterpret_cast<const TVITEM*>(lParam));
      case TVM_GETITEMSTATE: {
        const Item* item = Find(HTREEITEM::FromParam(wParam));
        return item != nullptr ? static_cast<LRESULT>(item->state & static_cast<UINT>(lParam)) : 0;
      }
      case TVM_EDITLABEL:
        return StartEdit(hwnd, HTREEITEM::FromParam(lParam)).ToLParam();
      case TVM_GETEDITCONTROL:
        return edit_.ToLParam();
      case TVM_ENDEDITLABELNOW:
        EndEdit(hwnd, wParam != 0);
        return TRUE;
      case TVM_HITTEST: {
        auto* info = reinterpret_cast<TVHITTESTINFO*>(lParam);
        if (info == nullptr) return 0;
        info->hItem = HitTest(hwnd, info->pt, info->flags);
        return info->hItem.ToLParam();
      }
      case TVM_ENSUREVISIBLE:
        return EnsureVisible(hwnd, HTREEITEM::FromParam(lParam));
      case WM_GETDLGCODE:
        return DLGC_WANTARROWS | DLGC_WANTCHARS;
      case WM_LBUTTONDOWN:
        OnButtonDown(hwnd, {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)});
        return 0;
      case WM_LBUTTONUP:
        OnButtonUp(hwnd);
        return 0;
      case WM_LBUTTONDBLCLK:
        OnDoubleClick(hwnd, {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)});
        return 0;
      case WM_RBUTTONDOWN:
        Notify(hwnd, NM_RCLICK);
        return 0;
      case WM_CAPTURECHANGED:
        press_.reset();
        return 0;
      case WM_TIMER:
        if (wParam != kEditTimer) return 0;
        ::KillTimer(hwnd, kEditTimer);
        if (pendingEdit_ && pendingEdit_ == selected_) StartEdit(hwnd, pendingEdit_);
        pendingEdit_ = HTREEITEM();
        return 0;
      case WM_KEYDOWN:
        OnKey(hwnd, static_cast<UINT>(wParam));
        return 0;
      case WM_SETFOCUS:
        // A tree that gets the focus without a selection selects its first visible item.
        if (!selected_ && !roots_.empty()) Select(hwnd, VisibleRows()[static_cast<std::size_t>(top_)], TVC_UNKNOWN);
        Notify(hwnd, NM_SETFOCUS);
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return 0;
      case WM_KILLFOCUS:
        Notify(hwnd, NM_KILLFOCUS);
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return 0;
      case WM_SIZE:
        ClampTop(hwnd);
        return 0;
      case WM_DESTROY:
        ::KillTimer(hwnd, kEditTimer);
        if (edit_) ::DestroyWindow(std::exchange(edit_, HWND()));
        return 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override;

 private:
  struct Press {
    HTREEITEM item;
    UINT flags = 0;
  };

  Item* Find(HTREEITEM h) {
    const auto it = items_.find(h.Value());
    return it == items_.end() ? nullptr : &it->second;
  }
  const Item* Find(HTREEITEM h) const {
    const auto it = items_.find(h.Value());
    return it == items_.end() ? nullptr : &it->second;
  }

  std::vector<HTREEITEM>& SiblingsOf(HTREEITEM h) {
    const Item* item = Find(h);
    Item* parent = item != nullptr ? Find(item->parent) : nullptr;
    return parent != nullptr ? parent->children : roots_;
  }
  const std::vector<HTREEITEM>& SiblingsOf(HTREEITEM h) const {
    const Item* item = Find(h);
    const Item* parent = item != nullptr ? Find(item->parent) : nullptr;
    return parent != nullptr ? parent->children : roots_;
  }

  static bool Expanded(const Item& item) { return (item.state & TVIS_EXPANDED) != 0; }
  static UINT StateImage(const Item& item) { return (item.state & TVIS_STATEIMAGEMASK) >> 12; }

  int Level(HTREEITEM h) const {
    int level = 0;
    for (const Item* item = Find(h); item != nullptr && item->parent; item = Find(item->parent)) ++level;
    return level;
  }

  // Items whose ancestors are all expanded, in display order.
  std::vector<HTREEITEM> VisibleRows() const {
    std::vector<HTREEITEM> rows;
    const auto walk = [&](const auto& self, const std::vector<HTREEITEM>& level) -> void {
      for (HTREEITEM h : level) {
        rows.push_back(h);
        const Item& item = *Find(h);
        if (Expanded(item)) self(self, item.children);
      }
    };
    walk(walk, roots_);
    return rows;
  }

  int RowOf(HTREEITEM h) const {
    const std::vector<HTREEITEM> rows = VisibleRows();
    const auto it = std::find(rows.begin(), rows.end(), h);
    return it == rows.end() ? -1 : static_cast<int>(it - rows.begin());
  }

  static int VisibleCapacity(HWND hwnd) { return std::max(1, ClientRect(hwnd).Height() / kRowHeight); }

  void ClampTop(HWND hwnd) {
    const int rows = static_cast<int>(VisibleRows().size());
    top_ = std::clamp(top_, 0, std::max(0, rows - VisibleCapacity(hwnd)));
  }

  RowLayout Layout(HWND hwnd, HTREEITEM h, int row) const {
    const Item& item = *Find(h);
    const DWORD style = ::GetWindowStyle(hwnd);
    const int columns = Level(h) + ((style & TVS_LINESATROOT) != 0 ? 1 : 0);
    RowLayout layout;
    layout.top = (row - top_) * kRowHeight;
    layout.stateLeft = columns * kIndent;
    layout.buttonLeft = layout.stateLeft - kIndent;
    const bool hasStateImage = StateImage(item) != 0 && ((style & TVS_CHECKBOXES) != 0 || stateImages_);
    layout.stateWidth = hasStateImage ? kStateImageWidth : 0;
    layout.imageLeft = layout.stateLeft + layout.stateWidth;
    int cx = 0;
    int cy = 0;
    layout.imageWidth = ImageList_GetIconSize(images_, &cx, &cy) ? cx : 0;
    layout.labelLeft = layout.imageLeft + layout.imageWidth + (layout.imageWidth > 0 ? 1 : 0);
    layout.labelRight = layout.labelLeft + TextWidth(item.text) + 2 * kLabelPadding;
    return layout;
  }

  HTREEITEM HitTest(HWND hwnd, POINT p, UINT& flags) const {
    const CRect client = ClientRect(hwnd);
    flags = 0;
    if (p.x < client.left) flags |= TVHT_TOLEFT;
    if (p.x >= client.right) flags |= TVHT_TORIGHT;
    if (p.y < client.top) flags |= TVHT_ABOVE;
    if (p.y >= client.bottom) flags |= TVHT_BELOW;
    if (flags != 0) return HTREEITEM();
    const std::vector<HTREEITEM> rows = VisibleRows();
    const int row = top_ + p.y / kRowHeight;
    if (row >= static_cast<int>(rows.size())) {
      flags = TVHT_NOWHERE;
      return HTREEITEM();
    }
    const HTREEITEM h = rows[static_cast<std::size_t>(row)];
    const RowLayout l = Layout(hwnd, h, row);
    const bool button = (::GetWindowStyle(hwnd) & TVS_HASBUTTONS) != 0 && !Find(h)->children.empty();
    if (p.x < l.buttonLeft) {
      flags = TVHT_ONITEMINDENT;
    } else if (p.x < l.stateLeft) {
      flags = button ? TVHT_ONITEMBUTTON : TVHT_ONITEMINDENT;
    } else if (p.x < l.stateLeft + l.stateWidth) {
      flags = TVHT_ONITEMSTATEICON;
    } else if (p.x < l.imageLeft + l.imageWidth) {
      flags = TVHT_ONITEMICON;
    } else if (p.x < l.labelRight) {
      flags = TVHT_ONITEMLABEL;
    } else {
      flags = TVHT_ONITEMRIGHT;
    }
    return h;
  }

  LRESULT ItemRect(HWND hwnd, bool textOnly, RECT* rect) {
    if (rect == nullptr) return FALSE;
    // The item comes in the rectangle's first member, as the system passes it.
    const HTREEITEM h(static_cast<std::uint32_t>(rect->left));
    const int row = RowOf(h);
    if (row < 0) return FALSE;
    const RowLayout l = Layout(hwnd, h, row);
    *rect = textOnly ? RECT{l.labelLeft, l.top, l.labelRight, l.top + kRowHeight}
                     : RECT{0, l.top, ClientRect(hwnd).right, l.top + kRowHeight};
    return TRUE;
  }

  TVITEM Describe(HTREEITEM h) const {
    TVITEM t;
    t.mask = TVIF_HANDLE | TVIF_STATE | TVIF_PARAM;
    t.hItem = h;
    if (const Item* item = Find(h)) {
      t.state = item->state;
      t.lParam = item->data;
    }
    return t;
  }

  HTREEITEM Insert(HWND hwnd, const TVINSERTSTRUCT* insert) {
    if (insert == nullptr) return HTREEITEM();
    const bool atRoot = !insert->hParent || insert->hParent == TVI_ROOT;
    Item* parent = atRoot ? nullptr : Find(insert->hParent);
    if (!atRoot && parent == nullptr) return HTREEITEM();
    std::vector<HTREEITEM>& level = parent != nullptr ? parent->children : roots_;
    const TVITEM& t = insert->item;
    Item item;
    item.parent = parent != nullptr ? insert->hParent : HTREEITEM();
    if ((t.mask & TVIF_TEXT) != 0 && t.pszText != nullptr) item.text = t.pszText;
    if ((t.mask & TVIF_IMAGE) != 0) item.image = t.iImage;
    if ((t.mask & TVIF_SELECTEDIMAGE) != 0) item.selectedImage = t.iSelectedImage;
    if ((t.mask & TVIF_PARAM) != 0) item.data = t.lParam;
    if ((t.mask & TVIF_STATE) != 0) item.state = t.state & t.stateMask & ~TVIS_SELECTED;
    // Items of a tree with check boxes start unchecked.
    if ((::GetWindowStyle(hwnd) & TVS_CHECKBOXES) != 0 && StateImage(item) == 0) item.state |= INDEXTOSTATEIMAGEMASK(kUnchecked);

    auto position = level.end();
    if (insert->hInsertAfter == TVI_FIRST) {
      position = level.begin();
    } else if (insert->hInsertAfter == TVI_SORT) {
      position = std::find_if(level.begin(), level.end(), [&](HTREEITEM other) {
        return std::lexicographical_compare(item.text.begin(), item.text.end(), Find(other)->text.begin(),
                                            Find(other)->text.end(), [](char a, char b) {
                                              return std::tolower(static_cast<unsigned char>(a)) <
                                                     std::tolower(static_cast<unsigned char>(b));
                                            });
      });
    } else if (insert->hInsertAfter != TVI_LAST) {
      const auto after = std::find(level.begin(), level.end(), insert->hInsertAfter);
      if (after != level.end()) position = after + 1;
    }
    const HTREEITEM handle(next_++);
    level.insert(position, handle);
    items_.emplace(handle.Value(), std::move(item));
    ::InvalidateRect(hwnd, nullptr, FALSE);
    return handle;
  }

  void Forget(HWND hwnd, HTREEITEM h) {
    Item* item = Find(h);
    if (item == nullptr) return;
    for (HTREEITEM child : std::vector<HTREEITEM>(item->children)) Forget(hwnd, child);
    NMTREEVIEW nm;
    nm.itemOld = Describe(h);
    Notify(hwnd, TVN_DELETEITEM, &nm.hdr);
    if (editing_ == h) EndEdit(hwnd, true);
    if (pendingEdit_ == h) pendingEdit_ = HTREEITEM();
    items_.erase(h.Value());
  }

  LRESULT Delete(HWND hwnd, HTREEITEM h) {
    if (!h || h == TVI_ROOT) {
      for (HTREEITEM root : std::vector<HTREEITEM>(roots_)) Forget(hwnd, root);
      roots_.clear();
      selected_ = dropHighlight_ = HTREEITEM();
      top_ = 0;
      ::InvalidateRect(hwnd, nullptr, TRUE);
      return TRUE;
    }
    if (Find(h) == nullptr) return FALSE;
    // The selection moves to the previous sibling, the parent or the next sibling.
    HTREEITEM moveTo;
    const bool selectionGoes = selected_ && IsSelfOrAncestor(h, selected_);
    if (selectionGoes) {
      const std::vector<HTREEITEM>& siblings = SiblingsOf(h);
      const auto at = std::find(siblings.begin(), siblings.end(), h);
      if (at != siblings.begin()) {
        moveTo = *(at - 1);
      } else if (Find(h)->parent) {
        moveTo = Find(h)->parent;
      } else if (at + 1 != siblings.end()) {
        moveTo = *(at + 1);
      }
    }
    std::erase(SiblingsOf(h), h);
    const bool wasSelected = selectionGoes;
    Forget(hwnd, h);
    if (wasSelected) {
      selected_ = HTREEITEM();
      if (moveTo) Select(hwnd, moveTo, TVC_UNKNOWN);
    }
    if (dropHighlight_ && Find(dropHighlight_) == nullptr) dropHighlight_ = HTREEITEM();
    ClampTop(hwnd);
    ::InvalidateRect(hwnd, nullptr, TRUE);
    return TRUE;
  }

  bool IsSelfOrAncestor(HTREEITEM ancestor, HTREEITEM h) const {
    for (const Item* item = Find(h); item != nullptr; item = Find(item->parent)) {
      if (h == ancestor) return true;
      h = item->parent;
    }
    return false;
  }

  LRESULT Expand(HWND hwnd, HTREEITEM h, UINT code, bool notify) {
    Item* item = Find(h);
    if (item == nullptr || item->children.empty()) return FALSE;
    const bool expand = code == TVE_TOGGLE ? !Expanded(*item) : code == TVE_EXPAND;
    if (expand == Expanded(*item)) return TRUE;
    NMTREEVIEW nm;
    nm.action = expand ? TVE_EXPAND : TVE_COLLAPSE;
    nm.itemNew = Describe(h);
    if (notify && Notify(hwnd, TVN_ITEMEXPANDING, &nm.hdr) != 0) return FALSE;
    if ((item = Find(h)) == nullptr) return FALSE;
    if (expand) {
      item->state |= TVIS_EXPANDED | TVIS_EXPANDEDONCE;
    } else {
      item->state &= ~TVIS_EXPANDED;
      // A selection hidden by the collapse moves up to the collapsed item.
      if (selected_ && selected_ != h && IsSelfOrAncestor(h, selected_)) Select(hwnd, h, TVC_UNKNOWN);
    }
    ClampTop(hwnd);
    ::InvalidateRect(hwnd, nullptr, TRUE);
    if (notify) {
      nm.itemNew = Describe(h);
      Notify(hwnd, TVN_ITEMEXPANDED, &nm.hdr);
    }
    return TRUE;
  }

  LRESULT EnsureVisible(HWND hwnd, HTREEITEM h) {
    const Item* item = Find(h);
    if (item == nullptr) return FALSE;
    for (HTREEITEM up = item->parent; up; up = Find(up)->parent) Find(up)->state |= TVIS_EXPANDED | TVIS_EXPANDEDONCE;
    const int row = RowOf(h);
    const int capacity = VisibleCapacity(hwnd);
    if (row < top_) top_ = row;
    if (row >= top_ + capacity) top_ = row - capacity + 1;
    ::InvalidateRect(hwnd, nullptr, FALSE);
    return TRUE;
  }

  void Select(HWND hwnd, HTREEITEM h, UINT action) {
    if (h == selected_) return;
    NMTREEVIEW nm;
    nm.action = action;
    nm.itemOld = Describe(selected_);
    nm.itemNew = Describe(h);
    if (Notify(hwnd, TVN_SELCHANGING, &nm.hdr) != 0) return;  // the parent refused
    if (Item* old = Find(selected_)) old->state &= ~TVIS_SELECTED;
    selected_ = Find(h) != nullptr ? h : HTREEITEM();
    if (Item* now = Find(selected_)) {
      now->state |= TVIS_SELECTED;
      EnsureVisible(hwnd, selected_);
    }
    ::InvalidateRect(hwnd, nullptr, FALSE);
    nm.itemOld = Describe(nm.itemOld.hItem);
    nm.itemNew = Describe(selected_);
    Notify(hwnd, TVN_SELCHANGED, &nm.hdr);
  }

  LRESULT SelectBy(HWND hwnd, UINT code, HTREEITEM h) {
    if (h && Find(h) == nullptr) return FALSE;
    switch (code) {
      case TVGN_CARET:
        Select(hwnd, h, TVC_UNKNOWN);
        return TRUE;
      case TVGN_DROPHILITE:
        dropHighlight_ = h;
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return TRUE;
      case TVGN_FIRSTVISIBLE:
        if (h) {
          EnsureVisible(hwnd, h);
          top_ = RowOf(h);
          ClampTop(hwnd);
        }
        return TRUE;
      default:
        return FALSE;
    }
  }

  HTREEITEM Next(HWND hwnd, HTREEITEM h, UINT code) const {
    const Item* item = Find(h);
    switch (code) {
      case TVGN_ROOT:
        return roots_.empty() ? HTREEITEM() : roots_.front();
      case TVGN_CARET:
        return selected_;
      case TVGN_DROPHILITE:
        return dropHighlight_;
      case TVGN_CHILD:
        if (!h || h == TVI_ROOT) return roots_.empty() ? HTREEITEM() : roots_.front();
        return item != nullptr && !item->children.empty() ? item->children.front() : HTREEITEM();
      case TVGN_PARENT:
        return item != nullptr ? item->parent : HTREEITEM();
      case TVGN_NEXT:
      case TVGN_PREVIOUS: {
        if (item == nullptr) return HTREEITEM();
        const std::vector<HTREEITEM>& siblings = SiblingsOf(h);
        const auto at = std::find(siblings.begin(), siblings.end(), h);
        if (code == TVGN_NEXT) return at + 1 != siblings.end() ? *(at + 1) : HTREEITEM();
        return at != siblings.begin() ? *(at - 1) : HTREEITEM();
      }
      case TVGN_FIRSTVISIBLE: {
        const std::vector<HTREEITEM> rows = VisibleRows();
        return top_ < static_cast<int>(rows.size()) ? rows[static_cast<std::size_t>(top_)] : HTREEITEM();
      }
      case TVGN_LASTVISIBLE: {
        const std::vector<HTREEITEM> rows = VisibleRows();
        return rows.empty() ? HTREEITEM() : rows.back();
      }
      case TVGN_NEXTVISIBLE:
      case TVGN_PREVIOUSVISIBLE: {
        const std::vector<HTREEITEM> rows = VisibleRows();
        const int row = RowOf(h);
        const int other = row + (code == TVGN_NEXTVISIBLE ? 1 : -1);
        return row >= 0 && other >= 0 && other < static_cast<int>(rows.size()) ? rows[static_cast<std::size_t>(other)]
                                                                                 : HTREEITEM();
      }
      default:
        static_cast<void>(hwnd);
        return HTREEITEM();
    }
  }

  LRESULT GetItem(TVITEM* t) const {
    if (t == nullptr) return FALSE;
    const Item* item = Find(t->hItem);
    if (item == nullptr) return FALSE;
    if ((t->mask & TVIF_TEXT) != 0 && t->pszText != nullptr && t->cchTextMax > 0) {
      const std::size_t n = std::min(item->text.size(), static_cast<std::size_t>(t->cchTextMax - 1));
      std::memcpy(t->pszText, item->text.data(), n);
      t->pszText[n] = '\0';
    }
    if ((t->mask & TVIF_IMAGE) != 0) t->iImage = item->image;
    if ((t->mask & TVIF_SELECTEDIMAGE) != 0) t->iSelectedImage = item->selectedImage;
    if ((t->mask & TVIF_PARAM) != 0) t->lParam = item->data;
    if ((t->mask & TVIF_STATE) != 0) t->state = item->state & t->stateMask;
    if ((t->mask & TVIF_CHILDREN) != 0) t->cChildren = item->children.empty() ? 0 : 1;
    return TRUE;
  }

  LRESULT SetItem(HWND hwnd, const TVITEM* t) {
    if (t == nullptr) return FALSE;
    Item* item = Find(t->hItem);
    if (item == nullptr) return FALSE;
    if ((t->mask & TVIF_TEXT) != 0) item->text = t->pszText != nullptr ? t->pszText : "";
    if ((t->mask & TVIF_IMAGE) != 0) item->image = t->iImage;
    if ((t->mask & TVIF_SELECTEDIMAGE) != 0) item->selectedImage = t->iSelectedImage;
    if ((t->mask & TVIF_PARAM) != 0) item->data = t->lParam;
    if ((t->mask & TVIF_STATE) != 0) {
      const UINT mask = t->stateMask & ~TVIS_SELECTED;  // the selection changes only by selecting
      item->state = (item->state & ~mask) | (t->state & mask);
      ClampTop(hwnd);
    }
    ::InvalidateRect(hwnd, nullptr, FALSE);
    return TRUE;
  }

  void ToggleCheck(HWND hwnd, HTREEITEM h) {
    Item* item = Find(h);
    if (item == nullptr) return;
    const UINT next = StateImage(*item) == kChecked ? kUnchecked : kChecked;
    item->state = (item->state & ~TVIS_STATEIMAGEMASK) | INDEXTOSTATEIMAGEMASK(next);
    ::InvalidateRect(hwnd, nullptr, FALSE);
  }

  void OnButtonDown(HWND hwnd, POINT p) {
    ::KillTimer(hwnd, kEditTimer);
    pendingEdit_ = HTREEITEM();
    if (edit_) EndEdit(hwnd, false);
    UINT flags = 0;
    const HTREEITEM h = HitTest(hwnd, p, flags);
    if (h && (flags & TVHT_ONITEMBUTTON) != 0) {
      Expand(hwnd, h, TVE_TOGGLE, true);
      ::SetFocus(hwnd);
      return;
    }
    // The rest waits for the button to come up, as a press may yet become a drag.
    press_ = Press{h, flags};
    ::SetCapture(hwnd);
  }

  void OnButtonUp(HWND hwnd) {
    if (!press_) return;
    const Press press = *press_;
    press_.reset();
    ::ReleaseCapture();
    if (Notify(hwnd, NM_CLICK) != 0) {
      ::SetFocus(hwnd);
      return;
    }
    if (!press.item || Find(press.item) == nullptr) {
      ::SetFocus(hwnd);
      return;
    }
    const bool editable = (::GetWindowStyle(hwnd) & TVS_EDITLABELS) != 0;
    if (editable && (press.flags & TVHT_ONITEMLABEL) != 0 && press.item == selected_) {
      pendingEdit_ = press.item;
      ::SetTimer(hwnd, kEditTimer, kEditDelayMs);
    } else if ((press.flags & (TVHT_ONITEMLABEL | TVHT_ONITEMICON)) != 0) {
      Select(hwnd, press.item, TVC_BYMOUSE);
    } else if ((press.flags & TVHT_ONITEMSTATEICON) != 0 && (::GetWindowStyle(hwnd) & TVS_CHECKBOXES) != 0) {
      ToggleCheck(hwnd, press.item);
    }
    ::SetFocus(hwnd);
  }

  void OnDoubleClick(HWND hwnd, POINT p) {
    ::KillTimer(hwnd, kEditTimer);
    pendingEdit_ = HTREEITEM();
    UINT flags = 0;
    const HTREEITEM h = HitTest(hwnd, p, flags);
    if (Notify(hwnd, NM_DBLCLK) != 0) return;
    if (h && Find(h) != nullptr && (flags & (TVHT_ONITEMLABEL | TVHT_ONITEMICON)) != 0) Expand(hwnd, h, TVE_TOGGLE, true);
  }

  void OnKey(HWND hwnd, UINT key) {
    NMTVKEYDOWN nm;
    nm.wVKey = static_cast<WORD>(key);
    Notify(hwnd, TVN_KEYDOWN, &nm.hdr);
    if (!::IsWindow(hwnd)) return;
    const std::vector<HTREEITEM> rows = VisibleRows();
    if (rows.empty()) return;
    const Item* item = Find(selected_);
    HTREEITEM target;
    switch (key) {
      case VK_UP:
        target = selected_ ? Next(hwnd, selected_, TVGN_PREVIOUSVISIBLE) : rows.front();
        break;
      case VK_DOWN:
        target = selected_ ? Next(hwnd, selected_, TVGN_NEXTVISIBLE) : rows.front();
        break;
      case VK_HOME:
        target = rows.front();
        break;
      case VK_END:
        target = rows.back();
        break;
      case VK_LEFT:
        if (item != nullptr && Expanded(*item) && !item->children.empty()) {
          Expand(hwnd, selected_, TVE_COLLAPSE, true);
        } else if (item != nullptr) {
          target = item->parent;
        }
        break;
      case VK_RIGHT:
        if (item != nullptr && !item->children.empty()) {
          if (!Expanded(*item)) {
            Expand(hwnd, selected_, TVE_EXPAND, true);
          } else {
            target = item->children.front();
          }
        }
        break;
      case VK_SPACE:
        if (selected_ && (::GetWindowStyle(hwnd) & TVS_CHECKBOXES) != 0) ToggleCheck(hwnd, selected_);
        break;
      default:
        break;
    }
    if (target) Select(hwnd, target, TVC_BYKEYBOARD);
  }

  HWND StartEdit(HWND hwnd, HTREEITEM h) {
    Item* item = Find(h);
    if (item == nullptr) return HWND();
    if (edit_) EndEdit(hwnd, false);
    std::string text = item->text;
    NMTVDISPINFO begin;
    begin.item = Describe(h);
    begin.item.mask |= TVIF_TEXT;
    begin.item.pszText = text.data();
    if (Notify(hwnd, TVN_BEGINLABELEDIT, &begin.hdr) != 0 || Find(h) == nullptr) return HWND();
    EnsureVisible(hwnd, h);
    const RowLayout l = Layout(hwnd, h, RowOf(h));
    const int width = std::max(l.labelRight - l.labelLeft + 24, 60);
    editing_ = h;
    edit_ = ::CreateWindowEx(0, kEditClass, Find(h)->text, WS_CHILD | WS_VISIBLE | WS_BORDER | ES_AUTOHSCROLL,
                             l.labelLeft - 1, l.top, std::min(width, ClientRect(hwnd).right - l.labelLeft + 1),
                             kRowHeight, hwnd, 1);
    if (!edit_) {
      editing_ = HTREEITEM();
      return HWND();
    }
    // The editor takes Enter and Escape itself, and loses its edit when it loses the focus.
    InterceptMessages(edit_, [this, hwnd](HWND, UINT message, WPARAM wParam, LPARAM) -> std::optional<LRESULT> {
      if (message == WM_GETDLGCODE) return DLGC_WANTALLKEYS | DLGC_WANTCHARS | DLGC_HASSETSEL | DLGC_WANTARROWS;
      if (message == WM_KEYDOWN && (wParam == VK_RETURN || wParam == VK_ESCAPE)) {
        EndEdit(hwnd, wParam == VK_ESCAPE);
        return 0;
      }
      if (message == WM_CHAR && (wParam == '\r' || wParam == 0x1B)) return 0;
      if (message == WM_KILLFOCUS) EndEdit(hwnd, false);
      return std::nullopt;
    });
    ::SetFocus(edit_);
    ::SendMessage(edit_, EM_SETSEL, 0, -1);
    ::InvalidateRect(hwnd, nullptr, FALSE);
    return edit_;
  }

  void EndEdit(HWND hwnd, bool cancel) {
    if (!edit_ || ending_) return;
    ending_ = true;
    const HTREEITEM h = editing_;
    std::string text = ::GetWindowText(edit_);
    NMTVDISPINFO end;
    end.item = Describe(h);
    end.item.mask |= TVIF_TEXT;
    end.item.pszText = cancel ? nullptr : text.data();
    end.item.cchTextMax = static_cast<int>(text.size()) + 1;
    const LRESULT keep = Notify(hwnd, TVN_ENDLABELEDIT, &end.hdr);
    if (Item* item = Find(h); item != nullptr && !cancel && keep != 0) item->text = text;
    const bool hadFocus = ::GetFocus() == edit_;
    const HWND editor = std::exchange(edit_, HWND());
    editing_ = HTREEITEM();
    ::DestroyWindow(editor);
    ending_ = false;
    if (hadFocus && ::IsWindow(hwnd)) ::SetFocus(hwnd);
    ::InvalidateRect(hwnd, nullptr, FALSE);
  }

  void PaintRow(HWND hwnd, Canvas& canvas, HTREEITEM h, int row) const;

  std::map<std::uint32_t, Item> items_;
  std::vector<HTREEITEM> roots_;
  HTREEITEM selected_;
  HTREEITEM dropHighlight_;
  HIMAGELIST images_;
  HIMAGELIST stateImages_;
  int top_ = 0;  // the first row shown
  HWND edit_;
  HTREEITEM editing_;
  HTREEITEM pendingEdit_;
  bool ending_ = false;
  std::optional<Press> press_;
  std::uint32_t next_ = 1;
};

void TreeBehaviour::Paint(HWND hwnd, Canvas& canvas) {
  const CRect client = ClientRect(hwnd);
  canvas.FillRect(client, ::GetSysColor(COLOR_WINDOW));
  const std::vector<HTREEITEM> rows = VisibleRows();
  const int last = std::min(static_cast<int>(rows.size()), top_ + (client.Height() + kRowHeight - 1) / kRowHeight);
  for (int row = top_; row < last; ++row) PaintRow(hwnd, canvas, rows[static_cast<std::size_t>(row)], row);
  if (static_cast<int>(rows.size()) > VisibleCapacity(hwnd)) {
    // A thin bar on the right says how much of the tree is in view.
    const int total = static_cast<int>(rows.size());
    const int height = client.Height();
    canvas.FillRect(CRect(client.right - 4, top_ * height / total, client.right - 1,
                          std::min(height, (top_ + VisibleCapacity(hwnd)) * height / total)),
                    ::GetSysColor(COLOR_BTNSHADOW));
  }
}

void TreeBehaviour::PaintRow(HWND hwnd, Canvas& canvas, HTREEITEM h, int row) const {
  const Item& item = *Find(h);
  const DWORD style = ::GetWindowStyle(hwnd);
  const RowLayout l = Layout(hwnd, h, row);
  const int mid = l.top + kRowHeight / 2;
  const bool enabled = ::IsWindowEnabled(hwnd) != FALSE;

  std::string state;
  const auto add = [&state](std::string_view word) { state += (state.empty() ? "" : " ") + std::string(word); };
  if (StateImage(item) == kChecked) add("checked");
  if (StateImage(item) == kUnchecked) add("unchecked");
  if (h == selected_) add("selected");
  if (!item.children.empty()) add(Expanded(item) ? "expanded" : "collapsed");
  if (h == editing_) add("editing");
  Canvas::Attributes attributes = {{"data-item", item.text}, {"data-level", std::to_string(Level(h))}};
  if (!state.empty()) attributes.emplace_back("data-state", state);
  canvas.BeginGroup(attributes);

  const COLORREF lineColor = RGB(160, 160, 160);
  if ((style & TVS_HASLINES) != 0) {
    // Connectors: this item's own column, then the columns of ancestors with later siblings.
    const int own = l.buttonLeft + kIndent / 2;
    if (l.buttonLeft >= 0) {
      const std::vector<HTREEITEM>& siblings = SiblingsOf(h);
      const bool lastSibling = siblings.back() == h;
      const bool firstRoot = !item.parent && roots_.front() == h;
      canvas.Line({own, firstRoot ? mid : l.top}, {own, lastSibling ? mid : l.top + kRowHeight}, lineColor, 1, true);
      canvas.Line({own, mid}, {l.stateLeft, mid}, lineColor, 1, true);
    }
    int column = l.buttonLeft - kIndent;
    for (HTREEITEM up = item.parent; up && column >= 0; up = Find(up)->parent, column -= kIndent) {
      const std::vector<HTREEITEM>& siblings = SiblingsOf(up);
      if (siblings.back() != up) {
        canvas.Line({column + kIndent / 2, l.top}, {column + kIndent / 2, l.top + kRowHeight}, lineColor, 1, true);
      }
    }
  }
  if ((style & TVS_HASBUTTONS) != 0 && !item.children.empty() && l.buttonLeft >= 0) {
    const CPoint c(l.buttonLeft + kIndent / 2, mid);
    const CRect box(c.x - 4, c.y - 4, c.x + 5, c.y + 5);
    canvas.FillRect(box, RGB(255, 255, 255));
    canvas.FrameRect(box, RGB(145, 145, 145));
    canvas.Line({c.x - 2, c.y}, {c.x + 3, c.y}, RGB(0, 0, 0));
    if (!Expanded(item)) canvas.Line({c.x, c.y - 2}, {c.x, c.y + 3}, RGB(0, 0, 0));
  }
  if (l.stateWidth > 0) {
    const UINT index = StateImage(item);
    if (stateImages_) {
      ImageList_Draw(stateImages_, static_cast<int>(index), &canvas, l.stateLeft, l.top + 1, ILD_NORMAL);
    } else {
      PaintCheckBox(canvas, {l.stateLeft + 1, l.top + (kRowHeight - 13) / 2}, index == kChecked ? BST_CHECKED : BST_UNCHECKED,
                    enabled);
    }
  }
  if (l.imageWidth > 0) {
    int cx = 0;
    int cy = 0;
    ImageList_GetIconSize(images_, &cx, &cy);
    const int image = h == selected_ ? item.selectedImage : item.image;
    if (enabled) {
      ImageList_Draw(images_, image, &canvas, l.imageLeft, l.top + (kRowHeight - cy) / 2, ILD_TRANSPARENT);
    } else {
      DrawImageDimmed(images_, image, &canvas, l.imageLeft, l.top + (kRowHeight - cy) / 2);
    }
  }
  const CRect label(l.labelLeft, l.top + 1, l.labelRight, l.top + kRowHeight - 1);
  COLORREF ink = TextColor(hwnd);
  const bool focused = HasFocus(hwnd);
  const bool highlighted = h == dropHighlight_ || (h == selected_ && (focused || (style & TVS_SHOWSELALWAYS) != 0));
  if (highlighted && h != editing_) {
    if (focused || h == dropHighlight_) {
      canvas.FillRect(label, ::GetSysColor(COLOR_HIGHLIGHT));
      ink = ::GetSysColor(COLOR_HIGHLIGHTTEXT);
    } else {
      canvas.FillRect(label, RGB(217, 217, 217));
    }
  }
  if (h != editing_) {
    canvas.Text(l.labelLeft + kLabelPadding, l.top + (kRowHeight - kLineHeight) / 2 + kFontAscent, item.text,
                {ink, (item.state & TVIS_BOLD) != 0, Canvas::Anchor::kStart});
  }
  if (h == selected_ && focused && h != editing_) canvas.FocusRect(label);
  canvas.EndGroup();
}

}  // namespace

void RegisterTreeViewClass() {
  RegisterWindowClass(kTreeViewClass, CS_DBLCLKS, [] { return std::make_unique<TreeBehaviour>(); });
}

}  // namespace framework

BOOL CTreeCtrl::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
  return CWnd::Create(framework::kTreeViewClass, "", style, rect, parent, id);
}

HTREEITEM CTreeCtrl::InsertItem(const TVINSERTSTRUCT* insert) {
  return HTREEITEM::FromParam(SendMessage(TVM_INSERTITEM, 0, reinterpret_cast<LPARAM>(insert)));
}

HTREEITEM CTreeCtrl::InsertItem(std::string_view text, HTREEITEM parent, HTREEITEM after) {
  std::string copy(text);
  TVINSERTSTRUCT insert{parent, after, {}};
  insert.item.mask = TVIF_TEXT;
  insert.item.pszText = copy.data();
  return InsertItem(&insert);
}

HTREEITEM CTreeCtrl::InsertItem(std::string_view text, int image, int selectedImage, HTREEITEM parent,
                                HTREEITEM after) {
  std::string copy(text);
  TVINSERTSTRUCT insert{parent, after, {}};
  insert.item.mask = TVIF_TEXT | TVIF_IMAGE | TVIF_SELECTEDIMAGE;
  insert.item.pszText = copy.data();
  insert.item.iImage = image;
  insert.item.iSelectedImage = selectedImage;
  return InsertItem(&insert);
}

BOOL CTreeCtrl::DeleteItem(HTREEITEM item) { return static_cast<BOOL>(SendMessage(TVM_DELETEITEM, 0, item.ToLParam())); }
BOOL CTreeCtrl::DeleteAllItems() { return DeleteItem(TVI_ROOT); }
BOOL CTreeCtrl::Expand(HTREEITEM item, UINT code) { return static_cast<BOOL>(SendMessage(TVM_EXPAND, code, item.ToLParam())); }
BOOL CTreeCtrl::EnsureVisible(HTREEITEM item) { return static_cast<BOOL>(SendMessage(TVM_ENSUREVISIBLE, 0, item.ToLParam())); }
BOOL CTreeCtrl::SelectItem(HTREEITEM item) { return static_cast<BOOL>(SendMessage(TVM_SELECTITEM, TVGN_CARET, item.ToLParam())); }
UINT CTreeCtrl::GetCount() const { return static_cast<UINT>(SendMessage(TVM_GETCOUNT)); }
UINT CTreeCtrl::GetVisibleCount() const { return static_cast<UINT>(SendMessage(TVM_GETVISIBLECOUNT)); }

HTREEITEM CTreeCtrl::GetNextItem(HTREEITEM item, UINT code) const {
  return HTREEITEM::FromParam(SendMessage(TVM_GETNEXTITEM, code, item.ToLParam()));
}

HTREEITEM CTreeCtrl::GetRootItem() const { return GetNextItem(HTREEITEM(), TVGN_ROOT); }
HTREEITEM CTreeCtrl::GetChildItem(HTREEITEM item) const { return GetNextItem(item, TVGN_CHILD); }
HTREEITEM CTreeCtrl::GetNextSiblingItem(HTREEITEM item) const { return GetNextItem(item, TVGN_NEXT); }
HTREEITEM CTreeCtrl::GetPrevSiblingItem(HTREEITEM item) const { return GetNextItem(item, TVGN_PREVIOUS); }
HTREEITEM CTreeCtrl::GetParentItem(HTREEITEM item) const { return GetNextItem(item, TVGN_PARENT); }
HTREEITEM CTreeCtrl::GetSelectedItem() const { return GetNextItem(HTREEITEM(), TVGN_CARET); }
HTREEITEM CTreeCtrl::GetFirstVisibleItem() const { return GetNextItem(HTREEITEM(), TVGN_FIRSTVISIBLE); }
HTREEITEM CTreeCtrl::GetNextVisibleItem(HTREEITEM item) const { return GetNextItem(item, TVGN_NEXTVISIBLE); }
BOOL CTreeCtrl::ItemHasChildren(HTREEITEM item) const { return GetChildItem(item) ? TRUE : FALSE; }

BOOL CTreeCtrl::GetItem(TVITEM* item) const {
  return static_cast<BOOL>(SendMessage(TVM_GETITEM, 0, reinterpret_cast<LPARAM>(item)));
}

BOOL CTreeCtrl::SetItem(TVITEM* item) { return static_cast<BOOL>(SendMessage(TVM_SETITEM, 0, reinterpret_cast<LPARAM>(item))); }

std::string CTreeCtrl::GetItemText(HTREEITEM item) const {
  // Asks with a larger buffer until the whole text fits.
  for (int size = 256;; size *= 4) {
    std::string buffer(static_cast<std::size_t>(size), '\0');
    TVITEM t;
    t.mask = TVIF_TEXT | TVIF_HANDLE;
    t.hItem = item;
    t.pszText = buffer.data();
    t.cchTextMax = size;
    if (!GetItem(&t)) return {};
    buffer.resize(std::strlen(buffer.c_str()));
    if (static_cast<int>(buffer.size()) < size - 1) return buffer;
  }
}

BOOL CTreeCtrl::SetItemText(HTREEITEM item, std::string_view text) {
  std::string copy(text);
  TVITEM t;
  t.mask = TVIF_TEXT | TVIF_HANDLE;
  t.hItem = item;
  t.pszText = copy.data();
  return SetItem(&t);
}

BOOL CTreeCtrl::GetItemImage(HTREEITEM item, int& image, int& selectedImage) const {
  TVITEM t;
  t.mask = TVIF_IMAGE | TVIF_SELECTEDIMAGE | TVIF_HANDLE;
  t.hItem = item;
  if (!GetItem(&t)) return FALSE;
  image = t.iImage;
  selectedImage = t.iSelectedImage;
  return TRUE;
}

BOOL CTreeCtrl::SetItemImage(HTREEITEM item, int image, int selectedImage) {
  TVITEM t;
  t.mask = TVIF_IMAGE | TVIF_SELECTEDIMAGE | TVIF_HANDLE;
  t.hItem = item;
  t.iImage = image;
  t.iSelectedImage = selectedImage;
  return SetItem(&t);
}

DWORD_PTR CTreeCtrl::GetItemData(HTREEITEM item) const {
  TVITEM t;
  t.mask = TVIF_PARAM | TVIF_HANDLE;
  t.hItem = item;
  return GetItem(&t) ? static_cast<DWORD_PTR>(t.lParam) : 0;
}

BOOL CTreeCtrl::SetItemData(HTREEITEM item, DWORD_PTR data) {
  TVITEM t;
  t.mask = TVIF_PARAM | TVIF_HANDLE;
  t.hItem = item;
  t.lParam = static_cast<LPARAM>(data);
  return SetItem(&t);
}

UINT CTreeCtrl::GetItemState(HTREEITEM item, UINT mask) const {
  return static_cast<UINT>(SendMessage(TVM_GETITEMSTATE, item.ToWParam(), static_cast<LPARAM>(mask)));
}

BOOL CTreeCtrl::SetItemState(HTREEITEM item, UINT state, UINT mask) {
  TVITEM t;
  t.mask = TVIF_STATE | TVIF_HANDLE;
  t.hItem = item;
  t.state = state;
  t.stateMask = mask;
  return SetItem(&t);
}

BOOL CTreeCtrl::GetCheck(HTREEITEM item) const {
  return ((GetItemState(item, TVIS_STATEIMAGEMASK) >> 12) == 2) ? TRUE : FALSE;
}

BOOL CTreeCtrl::SetCheck(HTREEITEM item, BOOL check) {
  return SetItemState(item, INDEXTOSTATEIMAGEMASK(check ? 2U : 1U), TVIS_STATEIMAGEMASK);
}

BOOL CTreeCtrl::GetItemRect(HTREEITEM item, RECT* rect, BOOL textOnly) const {
  if (rect == nullptr) return FALSE;
  rect->left = static_cast<LONG>(item.Value());  // the item goes in the rectangle's first member
  return static_cast<BOOL>(SendMessage(TVM_GETITEMRECT, static_cast<WPARAM>(textOnly), reinterpret_cast<LPARAM>(rect)));
}

HTREEITEM CTreeCtrl::HitTest(CPoint point, UINT* flags) const {
  TVHITTESTINFO info;
  info.pt = point;
  const HTREEITEM item = HitTest(&info);
  if (flags != nullptr) *flags = info.flags;
  return item;
}

HTREEITEM CTreeCtrl::HitTest(TVHITTESTINFO* info) const {
  return HTREEITEM::FromParam(SendMessage(TVM_HITTEST, 0, reinterpret_cast<LPARAM>(info)));
}

CWnd* CTreeCtrl::EditLabel(HTREEITEM item) {
  return CWnd::FromHandle(HWND::FromParam(SendMessage(TVM_EDITLABEL, 0, item.ToLParam())));
}

CWnd* CTreeCtrl::GetEditControl() const { return CWnd::FromHandle(HWND::FromParam(SendMessage(TVM_GETEDITCONTROL))); }

HIMAGELIST CTreeCtrl::SetImageList(HIMAGELIST list, int which) {
  return HIMAGELIST::FromParam(SendMessage(TVM_SETIMAGELIST, static_cast<WPARAM>(which), list.ToLParam()));
}

HIMAGELIST CTreeCtrl::SetImageList(CImageList* list, int which) {
  return SetImageList(list != nullptr ? list->GetSafeHandle() : HIMAGELIST(), which);
}

HIMAGELIST CTreeCtrl::GetImageList(int which) const {
  return HIMAGELIST::FromParam(SendMessage(TVM_GETIMAGELIST, static_cast<WPARAM>(which)));
}
