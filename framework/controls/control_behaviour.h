// The base of the framework's control classes: their state lives in a behaviour object per
// window, their picture comes from one Paint hook, their news goes to the parent window.
#pragma once

#include "framework/canvas.h"
#include "framework/geometry.h"
#include "framework/win_constants.h"
#include "framework/win_messages.h"
#include "framework/win_structs.h"
#include "framework/win_styles.h"
#include "framework/window_class.h"

namespace framework {

class ControlBehaviour : public WindowBehaviour {
 public:
  // WM_PAINT goes to Paint; every other message to OnMessage.
  LRESULT Handle(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) final;

 protected:
  virtual LRESULT OnMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam);
  // The rendering hook: draws the client area, whose top-left corner is (0, 0).
  virtual void Paint(HWND hwnd, Canvas& canvas) = 0;

  // Sends WM_NOTIFY to the parent with the header filled in (the record may be larger than
  // NMHDR); answers the parent's result.
  static LRESULT Notify(HWND control, UINT code, NMHDR* header = nullptr);
  // Sends WM_COMMAND with a notification code to the parent.
  static void Command(HWND control, UINT code);
  // Has the parent draw one item of an owner-drawn control (WM_DRAWITEM); the parent hands the
  // request to the control's own object when it has one.
  static void AskOwnerToDraw(HWND control, Canvas& canvas, UINT type, UINT item, UINT state, const RECT& rect,
                             UINT_PTR data = 0);
  static CRect ClientRect(HWND hwnd);
  // The text colour of the control: grey when it is disabled.
  static COLORREF TextColor(HWND hwnd);
  static bool HasFocus(HWND hwnd);
};

// A check mark in a 13 x 13 box with its top-left corner at `origin` (check boxes and the
// tree's state images share it).
void PaintCheckBox(Canvas& canvas, POINT origin, int checkState, bool enabled);

}  // namespace framework
