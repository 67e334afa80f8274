// Static controls: labels (left, centred or right, wrapped) and icons.
#pragma once

#include "framework/cwnd.h"

class CStatic : public CWnd {
 public:
  BOOL Create(std::string_view text, DWORD style, const RECT& rect, CWnd* parent, UINT id = IDC_STATIC);
  HICON SetIcon(HICON icon);
  HICON GetIcon() const;
};

namespace framework {
void RegisterStaticClass();
}
