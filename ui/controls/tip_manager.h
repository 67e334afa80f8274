// Tips for parts of a window (its buttons by control id, its tabs by index), shown in one
// popup tip window when the owner relays the mouse to them.
#pragma once

#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "framework/toolkit/tip_window.h"

class CTipManager {
 public:
  // Whether `point` lies on the part `id` of the owner; when it does, `area` receives the
  // part's area in the owner's client coordinates.
  using HitTest = std::function<bool(CWnd* owner, int id, CPoint point, CRect& area)>;

  CTipManager() = default;
  CTipManager(const CTipManager&) = delete;
  CTipManager& operator=(const CTipManager&) = delete;
  virtual ~CTipManager() = default;

  // Creates the hidden tip window for the owner and resets the display parameters.
  void Setup(CWnd* owner, HitTest hitTest, int spacingX, int spacingY);
  void SetDisplayParameters(int first, int second, int third, int fourth, int fifth);
  // The text of a string id for a part; a part added again gets the new text.
  void AddTip(int id, UINT stringId);
  // Shows the tip of part `id` when the point is on it; answers whether it did.
  bool Relay(int id, CPoint point);
  // Tries the parts in the order they were added and shows the first the point is on.
  bool RelayAll(CPoint point);

  CTipWindow& TipWindow() { return tip_; }
  const std::vector<std::pair<int, std::string>>& Entries() const { return entries_; }

 private:
  CWnd* owner_ = nullptr;
  std::vector<std::pair<int, std::string>> entries_;
  CTipWindow tip_;
  int spacingX_ = 0;
  int spacingY_ = 0;
  CTipWindow::DisplayParameters display_ = {6, 0, 5000, 0, 0};
  HitTest hitTest_;
};
