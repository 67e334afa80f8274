// The progress-bar class: range, position and step as the system keeps them (a position is held
// inside the range; a step past the upper end starts again from the lower end).
#include "framework/controls/progress_ctrl.h"

#include <algorithm>

#include "framework/controls/control_behaviour.h"
#include "framework/window_classes.h"

namespace framework {
namespace {

class ProgressBehaviour : public ControlBehaviour {
 protected:
  LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) override {
    switch (message) {
      case PBM_SETRANGE: {
        const LRESULT old = MAKELONG(static_cast<unsigned>(low_), static_cast<unsigned>(high_));
        SetRange(hwnd, LOWORD(static_cast<std::uintptr_t>(lParam)), HIWORD(static_cast<std::uintptr_t>(lParam)));
        return old;
      }
      case PBM_SETRANGE32: {
        const LRESULT old = MAKELONG(static_cast<unsigned>(low_), static_cast<unsigned>(high_));
        SetRange(hwnd, static_cast<int>(wParam), static_cast<int>(lParam));
        return old;
      }
      case PBM_GETRANGE: {
        if (lParam != 0) *reinterpret_cast<PBRANGE*>(lParam) = PBRANGE{low_, high_};
        return wParam != 0 ? low_ : high_;
      }
      case PBM_SETPOS:
        return Move(hwnd, static_cast<int>(wParam));
      case PBM_DELTAPOS:
        return Move(hwnd, pos_ + static_cast<int>(wParam));
      case PBM_GETPOS:
        return pos_;
      case PBM_SETSTEP:
        return std::exchange(step_, static_cast<int>(wParam));
      case PBM_STEPIT: {
        int next = pos_ + step_;
        if (next > high_) next = low_ + (next - high_);  // wraps round, as the system's bar does
        if (next > high_ || next < low_) next = low_;
        return Move(hwnd, next);
      }
      case PBM_SETBARCOLOR:
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return std::exchange(bar_, static_cast<COLORREF>(lParam));
      case PBM_SETBKCOLOR:
        ::InvalidateRect(hwnd, nullptr, FALSE);
        return std::exchange(back_, static_cast<COLORREF>(lParam));
      case WM_NCHITTEST:
        return HTTRANSPARENT;
      default:
        return ::DefWindowProc(hwnd, message, wParam, lParam);
    }
  }

  void Paint(HWND hwnd, Canvas& canvas) override {
    const CRect r = ClientRect(hwnd);
    canvas.FillRect(r, back_);
    canvas.BeginGroup({{"data-position", std::to_string(pos_)},
                       {"data-range", std::to_string(low_) + " " + std::to_string(high_)}});
    const int span = high_ - low_;
    const int filled = span > 0 ? static_cast<int>(static_cast<long long>(r.Width()) * (pos_ - low_) / span) : 0;
    if ((::GetWindowStyle(hwnd) & PBS_SMOOTH) != 0) {
      canvas.FillRect(CRect(r.left, r.top, r.left + filled, r.bottom), bar_);
    } else {
      // Blocks with a gap between them, as far as the position reaches.
      const int block = std::max(4, r.Height() * 2 / 3);
      for (int x = r.left + 1; x + block <= r.left + filled; x += block + 2) {
        canvas.FillRect(CRect(x, r.top + 1, x + block, r.bottom - 1), bar_);
      }
    }
    canvas.EndGroup();
  }

 private:
  void SetRange(HWND hwnd, int low, int high) {
    low_ = low;
    high_ = std::max(low, high);
    pos_ = std::clamp(pos_, low_, high_);
    ::InvalidateRect(hwnd, nullptr, FALSE);
  }

  LRESULT Move(HWND hwnd, int position) {
    const int old = std::exchange(pos_, std::clamp(position, low_, high_));
    if (old != pos_) ::InvalidateRect(hwnd, nullptr, FALSE);
    return old;
  }

  int low_ = 0;
  int high_ = 100;
  int pos_ = 0;
  int step_ = 10;
  COLORREF bar_ = RGB(6, 176, 37);
  COLORREF back_ = RGB(230, 230, 230);
};

}  // namespace

void RegisterProgressClass() {
  RegisterWindowClass(kProgressClass, 0, [] { return std::make_unique<ProgressBehaviour>(); });
}

}  // namespace framework

BOOL CProgressCtrl::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
  return CWnd::Create(framework::kProgressClass, "", style, rect, parent, id);
}

void CProgressCtrl::SetRange(short lower, short upper) {
  SendMessage(PBM_SETRANGE, 0, MAKELPARAM(lower, upper));
}

void CProgressCtrl::SetRange32(int lower, int upper) {
  SendMessage(PBM_SETRANGE32, static_cast<WPARAM>(lower), static_cast<LPARAM>(upper));
}

void CProgressCtrl::GetRange(int& lower, int& upper) const {
  PBRANGE range;
  SendMessage(PBM_GETRANGE, TRUE, reinterpret_cast<LPARAM>(&range));
  lower = range.iLow;
  upper = range.iHigh;
}

int CProgressCtrl::GetPos() const { return static_cast<int>(SendMessage(PBM_GETPOS)); }
int CProgressCtrl::SetPos(int position) { return static_cast<int>(SendMessage(PBM_SETPOS, static_cast<WPARAM>(position))); }
int CProgressCtrl::OffsetPos(int offset) { return static_cast<int>(SendMessage(PBM_DELTAPOS, static_cast<WPARAM>(offset))); }
int CProgressCtrl::SetStep(int step) { return static_cast<int>(SendMessage(PBM_SETSTEP, static_cast<WPARAM>(step))); }
int CProgressCtrl::StepIt() { return static_cast<int>(SendMessage(PBM_STEPIT)); }

COLORREF CProgressCtrl::SetBarColor(COLORREF color) {
  return static_cast<COLORREF>(SendMessage(PBM_SETBARCOLOR, 0, static_cast<LPARAM>(color)));
}
