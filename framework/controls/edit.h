// Edit controls: one line of text typed by the user, with a caret and a selection, scrolled
// sideways as the caret moves (ES_AUTOHSCROLL), optionally read-only.
#pragma once

#include "framework/cwnd.h"

class CEdit : public CWnd {
 public:
  BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);

  void SetSel(int start, int end, BOOL noScroll = FALSE);
  void GetSel(int& start, int& end) const;
  void ReplaceSel(std::string_view text, BOOL canUndo = FALSE);
  BOOL SetReadOnly(BOOL readOnly = TRUE);
  void SetLimitText(UINT maximum);
};

namespace framework {
void RegisterEditClass();
}
