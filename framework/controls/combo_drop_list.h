// The list a combo box drops: a popup window below the combo that shows its items, follows the
// mouse and the arrow keys, and hands the chosen item (or none) back to the combo.
#pragma once

#include "framework/canvas.h"
#include "framework/geometry.h"

namespace framework::detail {

// What the drop-down list needs of its combo box.
class DropListOwner {
 public:
  virtual int ItemCount() const = 0;
  virtual int ItemHeight(HWND combo) = 0;
  virtual void PaintItem(HWND combo, Canvas& canvas, int index, const RECT& rect, bool highlighted) = 0;
  // The list closes with an item chosen, or with -1 when the user dismissed it.
  virtual void CloseList(HWND combo, int chosen) = 0;

 protected:
  ~DropListOwner() = default;
};

// Opens the list below the combo with `visibleRows` rows and `highlighted` marked; the list
// takes the mouse until it closes.
HWND OpenDropList(HWND combo, DropListOwner& owner, int visibleRows, int highlighted);
// The arrow keys of the combo while its list is open: moves the highlight by `delta` rows
// (clamped), or to the first or last row for `toEnd` -1 or 1.
void MoveDropListHighlight(HWND list, int delta);
int DropListHighlight(HWND list);

void RegisterDropListClass();

}  // namespace framework::detail
