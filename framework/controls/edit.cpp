// The edit class: typing, deleting, caret movement and selection, and sideways scrolling that
// keeps the caret in view.
#include "framework/controls/edit.h"

#include <algorithm>

#include "framework/cdc.h"
#include "framework/controls/control_behaviour.h"
#include "framework/message_queue.h"
#include "framework/text_metrics.h"
#include "framework/window_classes.h"

namespace framework {
namespace {

constexpr int kMargin = 2;  // pixels between the client edge and the text

class EditBehaviour : public ControlBehaviour {
 public:
  std::string StateWords(HWND hwnd) const override {
    std::string words = (::GetWindowStyle(hwnd) & ES_READONLY) != 0 ? "readonly" : "";
    if (anchor_ != caret_) words += std::string(words.empty() ? "" : " ") + "selection";
    return words;
  }

 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case WM_GETDLGCODE: {
        LRESULT code = DLGC_WANTCHARS | DLGC_HASSETSEL | DLGC_WANTARROWS;
        if ((::GetWindowStyle(hwnd) & ES_MULTILINE) != 0) code |= DLGC_WANTALLKEYS;
        return code;
      }
      case WM_SETTEXT: {
        const LRESULT result = ::DefWindowProc(hwnd, message, wParam, lParam);
        anchor_ = caret_ = 0;
        first_ = 0;
        Command(hwnd, EN_UPDATE);
        Command(hwnd, EN_CHANGE);
        return result;
      }
      case WM_CHAR:
        OnChar(hwnd, static_cast<unsigned char>(wParam));
        return 0;
      case WM_KEYDOWN:
        OnKey(hwnd, static_cast<UINT>(wParam));
        return 0;
      case WM_LBUTTONDOWN:
        ::SetFocus(hwnd);
        caret_ = anchor_ = IndexAt(hwnd, GET_X_LPARAM(lParam));
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return 0;
      case WM_LBUTTONDBLCLK:
        anchor_ = 0;
        caret_ = Length(hwnd);
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return 0;
      case WM_SETFOCUS:
        ::InvalidateRect(hwnd, nullptr, FALSE);
        Command(hwnd, EN_SETFOCUS);
        return 0;
      case WM_KILLFOCUS:
        ::InvalidateRect(hwnd, nullptr, FALSE);
        Command(hwnd, EN_KILLFOCUS);
        return 0;
      case EM_SETSEL: {
        const int length = Length(hwnd);
        const auto start = static_cast<int>(static_cast<std::intptr_t>(wParam));
        const auto end = static_cast<int>(lParam);
        if (start < 0) {
          anchor_ = caret_;
        } else {
          anchor_ = std::min(start, length);
          caret_ = end < 0 ? length : std::min(end, length);
        }
        ScrollToCaret(hwnd);
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return 0;
      }
      case EM_GETSEL: {
        const auto [start, end] = Selection();
        if (wParam != 0) *reinterpret_cast<DWORD*>(wParam) = static_cast<DWORD>(start);
        if (lParam != 0) *reinterpret_cast<DWORD*>(lParam) = static_cast<DWORD>(end);
        return static_cast<LRESULT>(MAKELONG(static_cast<unsigned>(start), static_cast<unsigned>(end)));
      }
      case EM_REPLACESEL:
        Insert(hwnd, lParam != 0 ? reinterpret_cast<const char*>(lParam) : "");
        return 0;
      case EM_SETREADONLY:
        ::SetWindowStyle(hwnd, wParam != 0 ? ::GetWindowStyle(hwnd) | ES_READONLY : ::GetWindowStyle(hwnd) & ~ES_READONLY);
        ::InvalidateRect(hwnd, nullptr, TRUE);
        return TRUE;
      case EM_LIMITTEXT:
        limit_ = wParam == 0 ? kDefaultLimit : static_cast<std::size_t>(wParam);
        return 0;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override {
    const CRect r = ClientRect(hwnd);
    const bool readOnly = (::GetWindowStyle(hwnd) & ES_READONLY) != 0;
    canvas.FillRect(r, readOnly || !::IsWindowEnabled(hwnd) ? ::GetSysColor(COLOR_BTNFACE) : ::GetSysColor(COLOR_WINDOW));
    const std::string text = Shown(hwnd);
    const int baseline = r.top + (r.Height() - kLineHeight) / 2 + kFontAscent;
    const auto [start, end] = Selection();
    const bool focused = HasFocus(hwnd);
    const int from = static_cast<int>(first_);
    // Three runs: before, inside and after the selection (the selection shows only with focus).
    const int selStart = focused ? std::max(start, from) : from;
    const int selEnd = focused ? std::max(end, from) : from;
    int x = r.left + kMargin;
    const auto run = [&](int a, int b, COLORREF ink, bool highlighted) {
      if (b <= a) return;
      const std::string piece = text.substr(static_cast<std::size_t>(a), static_cast<std::size_t>(b - a));
      const int width = TextWidth(piece);
      if (highlighted) canvas.FillRect(CRect(x, r.top + 1, x + width, r.bottom - 1), ::GetSysColor(COLOR_HIGHLIGHT));
      canvas.Text(x, baseline, piece, {ink, false, Canvas::Anchor::kStart});
      x += width;
    };
    const int length = static_cast<int>(text.size());
    run(from, std::min(selStart, length), TextColor(hwnd), false);
    run(std::min(selStart, length), std::min(selEnd, length), ::GetSysColor(COLOR_HIGHLIGHTTEXT), true);
    run(std::min(selEnd, length), length, TextColor(hwnd), false);
    if (focused && start == end && caret_ >= first_) {
      const int caretX = r.left + kMargin + TextWidth(text.substr(first_, caret_ - first_));
      canvas.Line({caretX, baseline - kFontAscent}, {caretX, baseline + 2}, RGB(0, 0, 0));
    }
  }

 private:
  static constexpr std::size_t kDefaultLimit = 30000;

  static int Length(HWND hwnd) { return ::GetWindowTextLength(hwnd); }

  std::pair<int, int> Selection() const {
    return {static_cast<int>(std::min(anchor_, caret_)), static_cast<int>(std::max(anchor_, caret_))};
  }

  static std::string Shown(HWND hwnd) {
    std::string text = ::GetWindowText(hwnd);
    if ((::GetWindowStyle(hwnd) & ES_PASSWORD) != 0) std::fill(text.begin(), text.end(), '*');
    return text;
  }

  static int VisibleWidth(HWND hwnd) { return std::max(0, ClientRect(hwnd).Width() - 2 * kMargin); }

  // The character boundary nearest to a client x coordinate.
  std::size_t IndexAt(HWND hwnd, int x) const {
    const std::string text = Shown(hwnd);
    std::size_t index = first_;
    int left = kMargin;
    while (index < text.size()) {
      const int width = TextWidth(text.substr(index, 1));
      if (x < left + width / 2) break;
      left += width;
      ++index;
    }
    return index;
  }

  void ScrollToCaret(HWND hwnd) {
    const std::string text = Shown(hwnd);
    first_ = std::min(first_, text.size());
    if (caret_ < first_) first_ = caret_;
    while (first_ < caret_ && TextWidth(text.substr(first_, caret_ - first_)) > VisibleWidth(hwnd)) ++first_;
  }

  void Insert(HWND hwnd, std::string_view piece) {
    const std::string text = ::GetWindowText(hwnd);
    const auto [start, end] = Selection();
    const DWORD style = ::GetWindowStyle(hwnd);
    std::string accepted;
    for (char c : piece) {
      if ((style & ES_NUMBER) != 0 && (c < '0' || c > '9')) continue;
      accepted += c;
    }
    const std::size_t room = limit_ - std::min(limit_, text.size() - static_cast<std::size_t>(end - start));
    accepted.resize(std::min(accepted.size(), room));
    std::string next = text.substr(0, static_cast<std::size_t>(start)) + accepted + text.substr(static_cast<std::size_t>(end));
    // Without sideways scrolling the line takes only what fits in the box.
    if ((style & (ES_AUTOHSCROLL | ES_MULTILINE)) == 0 && TextWidth(next) > VisibleWidth(hwnd)) return;
    if (next == text) return;
    const std::string copy = next;
    ::DefWindowProc(hwnd, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(copy.c_str()));
    caret_ = anchor_ = static_cast<std::size_t>(start) + accepted.size();
    ScrollToCaret(hwnd);
    Command(hwnd, EN_UPDATE);
    Command(hwnd, EN_CHANGE);
  }

  void OnChar(HWND hwnd, unsigned char c) {
    if ((::GetWindowStyle(hwnd) & ES_READONLY) != 0) return;
    if (c == 0x08) {
      if (anchor_ == caret_ && caret_ > 0) anchor_ = caret_ - 1;
      Insert(hwnd, "");
    } else if (c >= 0x20 && c != 0x7F) {
      const char ch = static_cast<char>(c);
      Insert(hwnd, std::string_view(&ch, 1));
    }
  }

  void OnKey(HWND hwnd, UINT key) {
    const std::size_t length = static_cast<std::size_t>(Length(hwnd));
    const bool extend = (::GetKeyState(static_cast<int>(VK_SHIFT)) & 0x8000) != 0;
    switch (key) {
      case VK_LEFT:
        if (caret_ > 0) --caret_;
        break;
      case VK_RIGHT:
        if (caret_ < length) ++caret_;
        break;
      case VK_HOME:
        caret_ = 0;
        break;
      case VK_END:
        caret_ = length;
        break;
      case VK_DELETE:
        if ((::GetWindowStyle(hwnd) & ES_READONLY) != 0) return;
        if (anchor_ == caret_ && caret_ < length) anchor_ = caret_ + 1;
        Insert(hwnd, "");
        return;
      default:
        return;
    }
    if (!extend) anchor_ = caret_;
    ScrollToCaret(hwnd);
    ::InvalidateRect(hwnd, nullptr, FALSE);
  }

  std::size_t anchor_ = 0;
  std::size_t caret_ = 0;
  std::size_t first_ = 0;  // the first character shown
  std::size_t limit_ = kDefaultLimit;
};

}  // namespace

void RegisterEditClass() {
  RegisterWindowClass(kEditClass, CS_DBLCLKS, [] { return std::make_unique<EditBehaviour>(); });
}

}  // namespace framework

BOOL CEdit::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
  return CWnd::Create(framework::kEditClass, "", style, rect, parent, id);
}

void CEdit::SetSel(int start, int end, BOOL) { SendMessage(EM_SETSEL, static_cast<WPARAM>(start), end); }

void CEdit::GetSel(int& start, int& end) const {
  DWORD s = 0;
  DWORD e = 0;
  SendMessage(EM_GETSEL, reinterpret_cast<WPARAM>(&s), reinterpret_cast<LPARAM>(&e));
  start = static_cast<int>(s);
  end = static_cast<int>(e);
}

void CEdit::ReplaceSel(std::string_view text, BOOL canUndo) {
  const std::string copy(text);
  SendMessage(EM_REPLACESEL, static_cast<WPARAM>(canUndo), reinterpret_cast<LPARAM>(copy.c_str()));
}

BOOL CEdit::SetReadOnly(BOOL readOnly) { return static_cast<BOOL>(SendMessage(EM_SETREADONLY, static_cast<WPARAM>(readOnly))); }
void CEdit::SetLimitText(UINT maximum) { SendMessage(EM_LIMITTEXT, maximum); }
