// The popup tip window: a title and a text on the info-tip colours, shown beside the mouse for
// an area of its owner and hidden again when the mouse leaves the area or its time is up.
#pragma once

#include <array>
#include <string>

#include "framework/cwnd.h"

class CTipWindow : public CWnd {
 public:
  // The five display parameters, as a caller hands them over on each show:
  //   [0] pixels between the mouse and the tip's top edge,
  //   [1] milliseconds before the tip appears (0: at once),
  //   [2] milliseconds the tip stays (0: until hidden),
  //   [3] pixels the tip is moved right from the mouse,
  //   [4] 1: the tip hides as soon as the mouse leaves the area; 0: it stays its time.
  using DisplayParameters = std::array<int, 5>;

  // Creates the hidden tip window for an owner; the spacing is the room between the tip's
  // border and its text (negative values count as 0).
  BOOL Create(CWnd* owner, int spacingX, int spacingY);
  void SetTitle(std::string_view title);
  void SetText(std::string_view text);
  // Shows the tip for `area` of the owner's client area; `point` is the mouse point the caller
  // saw (kept as given, the tip is placed by the mouse itself).
  void Show(const RECT& area, POINT point, const DisplayParameters& parameters);
  void Hide();

  const std::string& Title() const { return title_; }
  const DisplayParameters& Parameters() const { return parameters_; }
  const CRect& HitArea() const { return area_; }
  const CPoint& ShownPoint() const { return point_; }

 protected:
  LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override;

 private:
  void ShowNow();
  void Paint(Canvas& canvas);
  bool MouseInArea() const;

  CWnd* owner_ = nullptr;
  std::string title_;
  std::string text_;
  int spacingX_ = 0;
  int spacingY_ = 0;
  CRect area_;
  CPoint point_;
  DisplayParameters parameters_ = {};
};
