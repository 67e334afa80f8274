// Dialog templates as data: the dialog's style, size and caption and one record a control, all
// positions in dialog units.
#pragma once

#include <string_view>
#include <vector>

#include "framework/geometry.h"
#include "framework/win_constants.h"
#include "framework/win_styles.h"
#include "framework/win_types.h"

struct DialogItemTemplate {
  int id = 0;
  std::string_view className;  // one of framework/window_classes.h
  std::string_view text;
  DWORD style = 0;  // WS_CHILD is implied
  DWORD exStyle = 0;
  short x = 0;
  short y = 0;
  short cx = 0;
  short cy = 0;
  std::vector<std::string_view> initialStrings = {};  // the entries a template gives a list or combo box
};

struct DialogTemplate {
  int id = 0;
  DWORD style = 0;
  DWORD exStyle = 0;
  short x = 0;
  short y = 0;
  short cx = 0;  // the client area, as the dialog units count it
  short cy = 0;
  std::string_view caption;
  std::string_view fontName = "MS Shell Dlg";
  short pointSize = 8;
  bool extended = false;  // written as an extended template (which allows extended styles on the dialog)
  std::vector<DialogItemTemplate> items;
};

namespace framework {

// Dialog units to pixels by one fixed font metric: the dialog font (8 points at 96 dots per
// inch) has an average character of 6 x 13 pixels; a horizontal unit is a quarter of its width,
// a vertical unit an eighth of its height, rounded to the nearest pixel.
inline constexpr int kDialogBaseUnitX = 6;
inline constexpr int kDialogBaseUnitY = 13;

constexpr int MulDiv(int value, int numerator, int denominator) {
  const long long product = static_cast<long long>(value) * numerator;
  const long long half = denominator / 2;
  return static_cast<int>(product >= 0 ? (product + half) / denominator : -((-product + half) / denominator));
}

constexpr CRect DialogUnitsToPixels(short x, short y, short cx, short cy) {
  const int left = MulDiv(x, kDialogBaseUnitX, 4);
  const int top = MulDiv(y, kDialogBaseUnitY, 8);
  return {left, top, left + MulDiv(cx, kDialogBaseUnitX, 4), top + MulDiv(cy, kDialogBaseUnitY, 8)};
}

}  // namespace framework

// Converts a rectangle given in dialog units to pixels, in place.
inline void MapDialogRect(RECT* rect) {
  *rect = framework::DialogUnitsToPixels(static_cast<short>(rect->left), static_cast<short>(rect->top),
                                         static_cast<short>(rect->right - rect->left),
                                         static_cast<short>(rect->bottom - rect->top));
}
