// The combo-box classes: the items and the selection, the selection field and its button, the
// drop-down list, mouse and keys, owner-drawn measuring and drawing, and the items with images
// of the extended combo box.
#include "framework/controls/combo_box.h"

#include <algorithm>
#include <cctype>
#include <cstring>
#include <vector>

#include "framework/cdc.h"
#include "framework/controls/combo_box_ex.h"
#include "framework/controls/combo_drop_list.h"
#include "framework/controls/control_behaviour.h"
#include "framework/image_list.h"
#include "framework/message_queue.h"
#include "framework/text_metrics.h"
#include "framework/window_classes.h"

namespace framework {
namespace {

constexpr int kFieldItemHeight = 15;  // the selection field's item; the window is 6 pixels taller
constexpr int kListItemHeight = 16;
constexpr int kButtonWidth = 17;
constexpr int kTextIndent = 3;

struct Item {
  std::string text;
  DWORD_PTR data = 0;
  int image = -1;
  int selectedImage = -1;
};

bool EqualNoCase(std::string_view a, std::string_view b) {
  return a.size() == b.size() && std::equal(a.begin(), a.end(), b.begin(), [](char x, char y) {
           return std::tolower(static_cast<unsigned char>(x)) == std::tolower(static_cast<unsigned char>(y));
         });
}

class ComboBehaviour : public ControlBehaviour, public detail::DropListOwner {
 public:
  explicit ComboBehaviour(bool extended) : extended_(extended) {}

  std::string StateWords(HWND) const override { return list_ ? "dropped" : ""; }

  int ItemCount() const override { return static_cast<int>(items_.size()); }

  int ItemHeight(HWND hwnd) override {
    Measure(hwnd);
    return itemHeight_;
  }

  void PaintItem(HWND hwnd, Canvas& canvas, int index, const RECT& rect, bool highlighted) override {
    const Item& item = items_[static_cast<std::size_t>(index)];
    Canvas::Attributes attributes = {{"data-item", item.text}, {"data-index", std::to_string(index)}};
    if (highlighted) attributes.emplace_back("data-state", "highlighted");
    canvas.BeginGroup(attributes);
    if (OwnerDrawn(hwnd)) {
      AskOwnerToDraw(hwnd, canvas, ODT_COMBOBOX, static_cast<UINT>(index), highlighted ? ODS_SELECTED | ODS_FOCUS : 0,
                     rect, item.data);
    } else {
      PaintPlain(hwnd, canvas, item, rect, highlighted, highlighted);
    }
    canvas.EndGroup();
  }

  void CloseList(HWND hwnd, int chosen) override {
    if (!list_) return;
    ::DestroyWindow(std::exchange(list_, HWND()));
    ::InvalidateRect(hwnd, nullptr, FALSE);
    Command(hwnd, CBN_CLOSEUP);
    Command(hwnd, chosen >= 0 ? CBN_SELENDOK : CBN_SELENDCANCEL);
    if (chosen >= 0 && chosen != selected_ && chosen < ItemCount()) {
      selected_ = chosen;
      Command(hwnd, CBN_SELCHANGE);
    }
  }

 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case WM_CREATE:
        // The template's height is the height with the list dropped; the window keeps the field's.
        droppedHeight_ = reinterpret_cast<const CREATESTRUCT*>(lParam)->cy;
        FitField(hwnd);
        return 0;
      case CB_ADDSTRING:
        return Insert(hwnd, SortedPosition(hwnd, Text(lParam)), Item{std::string(Text(lParam))});
      case CB_INSERTSTRING:
        return Insert(hwnd, static_cast<int>(static_cast<std::intptr_t>(wParam)), Item{std::string(Text(lParam))});
      case CB_DELETESTRING:
        return Delete(hwnd, static_cast<int>(wParam));
      case CB_RESETCONTENT:
        CloseList(hwnd, -1);
        items_.clear();
        selected_ = -1;
        ::InvalidateRect(hwnd, nullptr, TRUE);
        return 0;
      case CB_GETCOUNT:
        return ItemCount();
      case CB_GETCURSEL:
        return selected_;
      case CB_SETCURSEL: {
        const auto index = static_cast<int>(static_cast<std::intptr_t>(wParam));
        selected_ = Valid(index) ? index : -1;
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return Valid(index) ? index : CB_ERR;
      }
      case CB_GETLBTEXTLEN:
        return Valid(static_cast<int>(wParam)) ? static_cast<LRESULT>(At(wParam).text.size()) : CB_ERR;
      case CB_GETLBTEXT: {
        if (!Valid(static_cast<int>(wParam)) || lParam == 0) return CB_ERR;
        const std::string& text = At(wParam).text;
        std::memcpy(reinterpret_cast<char*>(lParam), text.c_str(), text.size() + 1);  // room for it is the caller's
        return static_cast<LRESULT>(text.size());
      }
      case CB_FINDSTRING:
      case CB_FINDSTRINGEXACT:
      case CB_SELECTSTRING: {
        const int found = Find(static_cast<int>(static_cast<std::intptr_t>(wParam)), Text(lParam), message == CB_FINDSTRINGEXACT);
        if (message == CB_SELECTSTRING && found >= 0) {
          selected_ = found;
          ::InvalidateRect(hwnd, nullptr, FALSE);
        }
        return found;
      }
      case CB_GETITEMDATA:
        return Valid(static_cast<int>(wParam)) ? static_cast<LRESULT>(At(wParam).data) : CB_ERR;
      case CB_SETITEMDATA:
        if (!Valid(static_cast<int>(wParam))) return CB_ERR;
        items_[wParam].data = static_cast<DWORD_PTR>(lParam);
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return 0;
      case CB_SETITEMHEIGHT: {
        Measure(hwnd);
        const int height = std::max(1, static_cast<int>(lParam));
        if (static_cast<int>(static_cast<std::intptr_t>(wParam)) < 0) {
          fieldHeight_ = height;
          FitField(hwnd);
        } else {
          itemHeight_ = height;
        }
        return 0;
      }
      case CB_GETITEMHEIGHT:
        Measure(hwnd);
        return static_cast<int>(static_cast<std::intptr_t>(wParam)) < 0 ? fieldHeight_ : itemHeight_;
      case CB_SHOWDROPDOWN:
        if (wParam != 0) {
          Open(hwnd);
        } else {
          CloseList(hwnd, -1);
        }
        return TRUE;
      case CB_GETDROPPEDSTATE:
        return list_ ? TRUE : FALSE;
      case CB_GETDROPPEDCONTROLRECT: {
        if (lParam == 0) return FALSE;
        RECT r;
        ::GetWindowRect(hwnd, &r);
        r.bottom = r.top + std::max(droppedHeight_, CRect(r).Height());
        *reinterpret_cast<RECT*>(lParam) = r;
        return TRUE;
      }
      case CB_GETCOMBOBOXINFO: {
        auto* info = reinterpret_cast<COMBOBOXINFO*>(lParam);
        if (info == nullptr) return FALSE;
        info->rcItem = FieldRect(hwnd);
        info->rcButton = ButtonRect(hwnd);
        info->hwndCombo = hwnd;
        info->hwndItem = HWND();
        info->hwndList = list_;
        return TRUE;
      }
      case CBEM_INSERTITEM:
        return InsertEx(hwnd, reinterpret_cast<const COMBOBOXEXITEM*>(lParam));
      case CBEM_GETITEM:
        return GetEx(reinterpret_cast<COMBOBOXEXITEM*>(lParam));
      case CBEM_SETITEM:
        return SetEx(hwnd, reinterpret_cast<const COMBOBOXEXITEM*>(lParam));
      case CBEM_SETIMAGELIST: {
        const HIMAGELIST old = std::exchange(images_, HIMAGELIST::FromParam(lParam));
        measured_ = false;
        ::InvalidateRect(hwnd, nullptr, TRUE);
        return old.ToLParam();
      }
      case CBEM_GETIMAGELIST:
        return images_.ToLParam();
      case WM_GETTEXTLENGTH:
        return Valid(selected_) ? static_cast<LRESULT>(At(selected_).text.size()) : 0;
      case WM_GETTEXT: {
        // The window text of a drop-down list is the chosen item's text.
        if (wParam == 0 || lParam == 0) return 0;
        const std::string text = Valid(selected_) ? At(selected_).text : std::string();
        const std::size_t n = std::min<std::size_t>(wParam - 1, text.size());
        std::memcpy(reinterpret_cast<char*>(lParam), text.data(), n);
        reinterpret_cast<char*>(lParam)[n] = '\0';
        return static_cast<LRESULT>(n);
      }
      case WM_SETTEXT:
        return FALSE;  // the field shows the selection only
      case WM_GETDLGCODE:
        return DLGC_WANTARROWS | DLGC_WANTCHARS | (list_ ? DLGC_WANTALLKEYS : 0);
      case WM_LBUTTONDOWN:
      case WM_LBUTTONDBLCLK:
        ::SetFocus(hwnd);
        if (list_) {
          CloseList(hwnd, -1);
        } else {
          Open(hwnd);
        }
        return 0;
      case WM_KEYDOWN:
        OnKey(hwnd, static_cast<UINT>(wParam));
        return 0;
      case WM_CHAR:
        OnCharacter(hwnd, static_cast<char>(wParam));
        return 0;
      case WM_SETFOCUS:
        ::InvalidateRect(hwnd, nullptr, FALSE);
        Command(hwnd, CBN_SETFOCUS);
        return 0;
      case WM_KILLFOCUS:
        CloseList(hwnd, -1);
        ::InvalidateRect(hwnd, nullptr, FALSE);
        Command(hwnd, CBN_KILLFOCUS);
        return 0;
      case WM_ENABLE:
        if (wParam == 0) CloseList(hwnd, -1);
        return 0;
      case WM_DESTROY:
        if (list_) ::DestroyWindow(std::exchange(list_, HWND()));
        return 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override {
    Measure(hwnd);
    const CRect r = ClientRect(hwnd);
    const bool enabled = ::IsWindowEnabled(hwnd) != FALSE;
    canvas.FillRect(r, enabled ? ::GetSysColor(COLOR_WINDOW) : ::GetSysColor(COLOR_BTNFACE));
    canvas.FrameRect(r, enabled ? RGB(122, 122, 122) : RGB(191, 191, 191));
    const CRect button = ButtonRect(hwnd);
    canvas.FillRect(button, list_ ? RGB(204, 228, 247) : RGB(225, 225, 225));
    const CPoint c = button.CenterPoint();
    canvas.Polygon({{c.x - 4, c.y - 2}, {c.x + 4, c.y - 2}, {c.x, c.y + 2}}, enabled ? RGB(0, 0, 0) : RGB(160, 160, 160));
    const CRect field = FieldRect(hwnd);
    const bool focused = HasFocus(hwnd) && !list_;
    if (OwnerDrawn(hwnd)) {
      const UINT state = ODS_COMBOBOXEDIT | (focused ? ODS_SELECTED | ODS_FOCUS : 0);
      const DWORD_PTR data = Valid(selected_) ? At(selected_).data : 0;
      AskOwnerToDraw(hwnd, canvas, ODT_COMBOBOX, static_cast<UINT>(selected_), state, field, data);
    } else if (Valid(selected_)) {
      PaintPlain(hwnd, canvas, At(selected_), field, focused, false);
    } else if (focused) {
      canvas.FillRect(field, ::GetSysColor(COLOR_HIGHLIGHT));
    }
    if (focused) canvas.FocusRect(field);
  }

 private:
  static std::string_view Text(LPARAM lParam) {
    return lParam != 0 ? std::string_view(reinterpret_cast<const char*>(lParam)) : std::string_view();
  }

  bool Valid(int index) const { return index >= 0 && index < ItemCount(); }
  const Item& At(std::uintptr_t index) const { return items_[index]; }
  const Item& At(int index) const { return items_[static_cast<std::size_t>(index)]; }

  static bool OwnerDrawn(HWND hwnd) {
    return (::GetWindowStyle(hwnd) & (CBS_OWNERDRAWFIXED | CBS_OWNERDRAWVARIABLE)) != 0;
  }

  CRect FieldRect(HWND hwnd) const {
    const CRect r = ClientRect(hwnd);
    return {r.left + 3, r.top + 3, r.right - kButtonWidth - 1, r.bottom - 3};
  }

  static CRect ButtonRect(HWND hwnd) {
    const CRect r = ClientRect(hwnd);
    return {r.right - kButtonWidth - 1, r.top + 1, r.right - 1, r.bottom - 1};
  }

  // Asks the owner of an owner-drawn combo how tall its field and items are, once, the first
  // time it matters (so that a control object that took the window over is asked as well).
  void Measure(HWND hwnd) {
    if (measured_) return;
    measured_ = true;
    int imageWidth = 0;
    int imageHeight = 0;
    if (extended_ && ImageList_GetIconSize(images_, &imageWidth, &imageHeight)) {
      itemHeight_ = std::max(itemHeight_, imageHeight + 2);
      fieldHeight_ = std::max(fieldHeight_, imageHeight + 2);
    }
    if (OwnerDrawn(hwnd)) {
      for (const int item : {-1, 0}) {
        MEASUREITEMSTRUCT measure;
        measure.CtlType = ODT_COMBOBOX;
        measure.CtlID = static_cast<UINT>(::GetDlgCtrlID(hwnd));
        measure.itemID = static_cast<UINT>(item);
        measure.itemWidth = static_cast<UINT>(ClientRect(hwnd).Width());
        measure.itemHeight = static_cast<UINT>(item < 0 ? fieldHeight_ : itemHeight_);
        ::SendMessage(::GetParent(hwnd), WM_MEASUREITEM, measure.CtlID, reinterpret_cast<LPARAM>(&measure));
        (item < 0 ? fieldHeight_ : itemHeight_) = std::max(1, static_cast<int>(measure.itemHeight));
      }
    }
    FitField(hwnd);
  }

  void FitField(HWND hwnd) const {
    RECT r;
    ::GetWindowRect(hwnd, &r);
    if (CRect(r).Height() != fieldHeight_ + 6) {
      ::SetWindowPos(hwnd, 0, 0, CRect(r).Width(), fieldHeight_ + 6, SWP_NOMOVE | SWP_NOZORDER);
    }
  }

  int SortedPosition(HWND hwnd, std::string_view text) const {
    if ((::GetWindowStyle(hwnd) & CBS_SORT) == 0) return -1;
    const auto lower = [](std::string_view s) {
      std::string out(s);
      for (char& c : out) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
      return out;
    };
    const std::string key = lower(text);
    const auto at = std::find_if(items_.begin(), items_.end(), [&](const Item& item) { return key < lower(item.text); });
    return static_cast<int>(at - items_.begin());
  }

  LRESULT Insert(HWND hwnd, int index, Item item) {
    if (index > ItemCount()) return CB_ERR;
    if (index < 0) index = ItemCount();
    items_.insert(items_.begin() + index, std::move(item));
    if (selected_ >= index) ++selected_;
    Measure(hwnd);
    ::InvalidateRect(hwnd, nullptr, FALSE);
    return index;
  }

  LRESULT Delete(HWND hwnd, int index) {
    if (!Valid(index)) return CB_ERR;
    CloseList(hwnd, -1);
    items_.erase(items_.begin() + index);
    if (selected_ == index) {
      selected_ = -1;
    } else if (selected_ > index) {
      --selected_;
    }
    ::InvalidateRect(hwnd, nullptr, FALSE);
    return ItemCount();
  }

  int Find(int startAfter, std::string_view text, bool exact) const {
    const int count = ItemCount();
    for (int step = 1; step <= count; ++step) {
      const int i = ((startAfter < 0 ? -1 : startAfter) + step) % count;
      const std::string& candidate = At(i).text;
      if (exact ? EqualNoCase(candidate, text) : EqualNoCase(std::string_view(candidate).substr(0, text.size()), text)) return i;
    }
    return static_cast<int>(CB_ERR);
  }

  LRESULT InsertEx(HWND hwnd, const COMBOBOXEXITEM* ex) {
    if (ex == nullptr) return CB_ERR;
    Item item;
    Assign(item, *ex);
    return Insert(hwnd, static_cast<int>(ex->iItem), std::move(item));
  }

  LRESULT GetEx(COMBOBOXEXITEM* ex) const {
    if (ex == nullptr || !Valid(static_cast<int>(ex->iItem))) return FALSE;
    const Item& item = At(static_cast<int>(ex->iItem));
    if ((ex->mask & CBEIF_TEXT) != 0 && ex->pszText != nullptr && ex->cchTextMax > 0) {
      const std::size_t n = std::min(item.text.size(), static_cast<std::size_t>(ex->cchTextMax - 1));
      std::memcpy(ex->pszText, item.text.data(), n);
      ex->pszText[n] = '\0';
    }
    if ((ex->mask & CBEIF_IMAGE) != 0) ex->iImage = item.image;
    if ((ex->mask & CBEIF_SELECTEDIMAGE) != 0) ex->iSelectedImage = item.selectedImage;
    if ((ex->mask & CBEIF_LPARAM) != 0) ex->lParam = static_cast<LPARAM>(item.data);
    return TRUE;
  }

  LRESULT SetEx(HWND hwnd, const COMBOBOXEXITEM* ex) {
    if (ex == nullptr || !Valid(static_cast<int>(ex->iItem))) return FALSE;
    Assign(items_[static_cast<std::size_t>(ex->iItem)], *ex);
    ::InvalidateRect(hwnd, nullptr, FALSE);
    return TRUE;
  }

  static void Assign(Item& item, const COMBOBOXEXITEM& ex) {
    if ((ex.mask & CBEIF_TEXT) != 0) item.text = ex.pszText != nullptr ? ex.pszText : "";
    if ((ex.mask & CBEIF_IMAGE) != 0) item.image = ex.iImage;
    if ((ex.mask & CBEIF_SELECTEDIMAGE) != 0) item.selectedImage = ex.iSelectedImage;
    if ((ex.mask & CBEIF_LPARAM) != 0) item.data = static_cast<DWORD_PTR>(ex.lParam);
  }

  void PaintPlain(HWND hwnd, Canvas& canvas, const Item& item, const CRect& rect, bool highlighted, bool inList) const {
    if (highlighted) canvas.FillRect(rect, ::GetSysColor(COLOR_HIGHLIGHT));
    int x = rect.left + kTextIndent;
    int cx = 0;
    int cy = 0;
    if (extended_ && ImageList_GetIconSize(images_, &cx, &cy)) {
      const int image = inList && item.selectedImage >= 0 ? item.selectedImage : item.image;
      const int y = rect.top + (rect.Height() - cy) / 2;
      if (::IsWindowEnabled(hwnd)) {
        ImageList_Draw(images_, image, &canvas, x, y, ILD_TRANSPARENT);
      } else {
        DrawImageDimmed(images_, image, &canvas, x, y);
      }
      x += cx + 4;
    }
    const COLORREF ink = highlighted ? ::GetSysColor(COLOR_HIGHLIGHTTEXT) : TextColor(hwnd);
    canvas.Text(x, rect.top + (rect.Height() - kLineHeight) / 2 + kFontAscent, item.text, {ink, false, Canvas::Anchor::kStart});
  }

  void Open(HWND hwnd) {
    if (list_) return;
    Command(hwnd, CBN_DROPDOWN);  // the parent may still fill the list
    if (!::IsWindow(hwnd) || list_) return;
    const int rows = std::max(1, (droppedHeight_ - fieldHeight_ - 6 - 2) / std::max(1, ItemHeight(hwnd)));
    list_ = detail::OpenDropList(hwnd, *this, rows, selected_);
    ::InvalidateRect(hwnd, nullptr, FALSE);
  }

  void ChooseByKey(HWND hwnd, int index) {
    if (!Valid(index) || index == selected_) return;
    selected_ = index;
    ::InvalidateRect(hwnd, nullptr, FALSE);
    Command(hwnd, CBN_SELCHANGE);
  }

  void OnKey(HWND hwnd, UINT key) {
    const int page = std::max(1, (droppedHeight_ - fieldHeight_) / std::max(1, itemHeight_));
    if (list_) {
      switch (key) {
        case VK_UP:
          detail::MoveDropListHighlight(list_, -1);
          break;
        case VK_DOWN:
          detail::MoveDropListHighlight(list_, 1);
          break;
        case VK_PRIOR:
          detail::MoveDropListHighlight(list_, -page);
          break;
        case VK_NEXT:
          detail::MoveDropListHighlight(list_, page);
          break;
        case VK_HOME:
          detail::MoveDropListHighlight(list_, -ItemCount());
          break;
        case VK_END:
          detail::MoveDropListHighlight(list_, ItemCount());
          break;
        case VK_RETURN:
        case VK_F4:
          CloseList(hwnd, detail::DropListHighlight(list_));
          break;
        case VK_ESCAPE:
          CloseList(hwnd, -1);
          break;
        default:
          break;
      }
      return;
    }
    const bool alt = (::GetKeyState(static_cast<int>(VK_MENU)) & 0x8000) != 0;
    if (key == VK_F4 || (alt && (key == VK_DOWN || key == VK_UP))) {
      Open(hwnd);
      return;
    }
    const int last = ItemCount() - 1;
    if (last < 0) return;
    switch (key) {
      case VK_UP:
        ChooseByKey(hwnd, std::max(0, selected_ - 1));
        break;
      case VK_DOWN:
        ChooseByKey(hwnd, std::min(last, selected_ + 1));
        break;
      case VK_PRIOR:
        ChooseByKey(hwnd, std::max(0, selected_ - page));
        break;
      case VK_NEXT:
        ChooseByKey(hwnd, std::min(last, std::max(0, selected_) + page));
        break;
      case VK_HOME:
        ChooseByKey(hwnd, 0);
        break;
      case VK_END:
        ChooseByKey(hwnd, last);
        break;
      default:
        break;
    }
  }

  // A typed character picks the next item that starts with it.
  void OnCharacter(HWND hwnd, char c) {
    if (static_cast<unsigned char>(c) < 0x20) return;
    const int found = Find(list_ ? detail::DropListHighlight(list_) : selected_, std::string_view(&c, 1), false);
    if (found < 0) return;
    if (list_) {
      detail::MoveDropListHighlight(list_, found - detail::DropListHighlight(list_));
    } else {
      ChooseByKey(hwnd, found);
    }
  }

  bool extended_;
  std::vector<Item> items_;
  int selected_ = -1;
  HWND list_;
  HIMAGELIST images_;
  bool measured_ = false;
  int fieldHeight_ = kFieldItemHeight;
  int itemHeight_ = kListItemHeight;
  int droppedHeight_ = 0;
};

}  // namespace

void RegisterComboBoxClasses() {
  RegisterWindowClass(kComboBoxClass, CS_DBLCLKS, [] { return std::make_unique<ComboBehaviour>(false); });
  RegisterWindowClass(kComboBoxExClass, CS_DBLCLKS, [] { return std::make_unique<ComboBehaviour>(true); });
  detail::RegisterDropListClass();
}

}  // namespace framework

BOOL CComboBox::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
  return CWnd::Create(framework::kComboBoxClass, "", style, rect, parent, id);
}

namespace {
LPARAM TextParam(const std::string& text) { return reinterpret_cast<LPARAM>(text.c_str()); }
}  // namespace

int CComboBox::AddString(std::string_view text) {
  const std::string copy(text);
  return static_cast<int>(SendMessage(CB_ADDSTRING, 0, TextParam(copy)));
}

int CComboBox::InsertString(int index, std::string_view text) {
  const std::string copy(text);
  return static_cast<int>(SendMessage(CB_INSERTSTRING, static_cast<WPARAM>(index), TextParam(copy)));
}

int CComboBox::DeleteString(UINT index) { return static_cast<int>(SendMessage(CB_DELETESTRING, index)); }
void CComboBox::ResetContent() { SendMessage(CB_RESETCONTENT); }
int CComboBox::GetCount() const { return static_cast<int>(SendMessage(CB_GETCOUNT)); }
int CComboBox::GetCurSel() const { return static_cast<int>(SendMessage(CB_GETCURSEL)); }
int CComboBox::SetCurSel(int index) { return static_cast<int>(SendMessage(CB_SETCURSEL, static_cast<WPARAM>(index))); }

std::string CComboBox::GetLBText(int index) const {
  const int length = GetLBTextLen(index);
  if (length < 0) return {};
  std::string text(static_cast<std::size_t>(length) + 1, '\0');
  SendMessage(CB_GETLBTEXT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(text.data()));
  text.resize(static_cast<std::size_t>(length));
  return text;
}

int CComboBox::GetLBTextLen(int index) const {
  return static_cast<int>(SendMessage(CB_GETLBTEXTLEN, static_cast<WPARAM>(index)));
}

int CComboBox::FindString(int startAfter, std::string_view prefix) const {
  const std::string copy(prefix);
  return static_cast<int>(SendMessage(CB_FINDSTRING, static_cast<WPARAM>(startAfter), TextParam(copy)));
}

int CComboBox::FindStringExact(int startAfter, std::string_view text) const {
  const std::string copy(text);
  return static_cast<int>(SendMessage(CB_FINDSTRINGEXACT, static_cast<WPARAM>(startAfter), TextParam(copy)));
}

int CComboBox::SelectString(int startAfter, std::string_view prefix) {
  const std::string copy(prefix);
  return static_cast<int>(SendMessage(CB_SELECTSTRING, static_cast<WPARAM>(startAfter), TextParam(copy)));
}

DWORD_PTR CComboBox::GetItemData(int index) const {
  return static_cast<DWORD_PTR>(SendMessage(CB_GETITEMDATA, static_cast<WPARAM>(index)));
}

int CComboBox::SetItemData(int index, DWORD_PTR data) {
  return static_cast<int>(SendMessage(CB_SETITEMDATA, static_cast<WPARAM>(index), static_cast<LPARAM>(data)));
}

int CComboBox::SetItemHeight(int index, UINT height) {
  return static_cast<int>(SendMessage(CB_SETITEMHEIGHT, static_cast<WPARAM>(index), static_cast<LPARAM>(height)));
}

int CComboBox::GetItemHeight(int index) const {
  return static_cast<int>(SendMessage(CB_GETITEMHEIGHT, static_cast<WPARAM>(index)));
}

void CComboBox::ShowDropDown(BOOL show) { SendMessage(CB_SHOWDROPDOWN, static_cast<WPARAM>(show)); }
BOOL CComboBox::GetDroppedState() const { return static_cast<BOOL>(SendMessage(CB_GETDROPPEDSTATE)); }

void CComboBox::DrawItem(LPDRAWITEMSTRUCT) {}
void CComboBox::MeasureItem(LPMEASUREITEMSTRUCT) {}

BOOL CComboBox::OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
  if (message == WM_DRAWITEM) {
    DrawItem(reinterpret_cast<LPDRAWITEMSTRUCT>(lParam));
    return TRUE;
  }
  if (message == WM_MEASUREITEM) {
    MeasureItem(reinterpret_cast<LPMEASUREITEMSTRUCT>(lParam));
    return TRUE;
  }
  return CWnd::OnChildNotify(message, wParam, lParam, result);
}

BOOL CComboBoxEx::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
  return CWnd::Create(framework::kComboBoxExClass, "", style, rect, parent, id);
}
