// Progress bars: a range, a position in it and a step; the bar fills in proportion.
#pragma once

#include "framework/cwnd.h"

struct PBRANGE {
  int iLow = 0;
  int iHigh = 0;
};

class CProgressCtrl : public CWnd {
 public:
  BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);

  // The 16-bit range of PBM_SETRANGE; SetRange32 takes any.
  void SetRange(short lower, short upper);
  void SetRange32(int lower, int upper);
  void GetRange(int& lower, int& upper) const;
  int GetPos() const;
  int SetPos(int position);      // answers the previous position
  int OffsetPos(int offset);     // answers the previous position
  int SetStep(int step);         // answers the previous step
  int StepIt();                  // answers the previous position
  COLORREF SetBarColor(COLORREF color);
};

namespace framework {
void RegisterProgressClass();
}
