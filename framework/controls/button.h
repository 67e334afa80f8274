// Buttons: push buttons (with a text or one icon), check boxes, radio buttons and group boxes.
#pragma once

#include "framework/cwnd.h"

class CButton : public CWnd {
 public:
  BOOL Create(std::string_view text, DWORD style, const RECT& rect, CWnd* parent, UINT id);

  int GetCheck() const;
  void SetCheck(int check);
  UINT GetState() const;
  void SetState(BOOL pushed);
  UINT GetButtonStyle() const;
  void SetButtonStyle(UINT style, BOOL redraw = TRUE);
  // The icon a button with BS_ICON shows; answers the previous one.
  HICON SetIcon(HICON icon);
  HICON GetIcon() const;

  // Owner-drawn buttons (BS_OWNERDRAW) draw themselves here.
  virtual void DrawItem(LPDRAWITEMSTRUCT drawItem);

 protected:
  BOOL OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) override;
};

namespace framework {
void RegisterButtonClass();
}
