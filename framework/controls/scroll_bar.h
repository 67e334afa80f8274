// Scroll bars: a vertical bar with an arrow at each end and a thumb that shows which part of a
// longer list is in view. Lists place one beside their rows; a click on an arrow or on the
// track asks the bar's parent to scroll (WM_VSCROLL).
#pragma once

#include "framework/cwnd.h"

constexpr UINT SIF_RANGE = 0x0001;
constexpr UINT SIF_PAGE = 0x0002;
constexpr UINT SIF_POS = 0x0004;
constexpr UINT SIF_ALL = SIF_RANGE | SIF_PAGE | SIF_POS;

struct SCROLLINFO {
  UINT cbSize = sizeof(SCROLLINFO);
  UINT fMask = 0;
  int nMin = 0;
  int nMax = 0;
  UINT nPage = 0;
  int nPos = 0;
  int nTrackPos = 0;
};

class CScrollBar : public CWnd {
 public:
  BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);
  int GetScrollPos() const;
  int SetScrollPos(int position);
  BOOL SetScrollInfo(const SCROLLINFO& info);
  BOOL GetScrollInfo(SCROLLINFO* info, UINT mask = SIF_ALL) const;
};

namespace framework {

inline constexpr int kScrollBarWidth = 16;

void RegisterScrollBarClass();

// Places (or hides) the vertical bar of a list at the right edge of `area`, for `total` rows of
// which `visible` show from row `top`; answers whether the bar is shown.
bool ShowListScrollBar(HWND bar, const RECT& area, int total, int visible, int top);

}  // namespace framework
