// Points, sizes and rectangles with the small arithmetic that window code does on them.
#pragma once

#include <algorithm>

#include "framework/win_types.h"

class CPoint : public POINT {
 public:
  constexpr CPoint() = default;
  constexpr CPoint(LONG px, LONG py) : POINT{px, py} {}
  constexpr CPoint(const POINT& p) : POINT(p) {}  // NOLINT: widening a plain point is lossless
  constexpr void Offset(LONG dx, LONG dy) {
    x += dx;
    y += dy;
  }
};

class CSize : public SIZE {
 public:
  constexpr CSize() = default;
  constexpr CSize(LONG w, LONG h) : SIZE{w, h} {}
  constexpr CSize(const SIZE& s) : SIZE(s) {}  // NOLINT
};

class CRect : public RECT {
 public:
  constexpr CRect() = default;
  constexpr CRect(LONG l, LONG t, LONG r, LONG b) : RECT{l, t, r, b} {}
  constexpr CRect(const RECT& r) : RECT(r) {}  // NOLINT
  constexpr CRect(POINT topLeft, SIZE size)
      : RECT{topLeft.x, topLeft.y, topLeft.x + size.cx, topLeft.y + size.cy} {}

  constexpr LONG Width() const { return right - left; }
  constexpr LONG Height() const { return bottom - top; }
  constexpr CSize Size() const { return {Width(), Height()}; }
  constexpr CPoint TopLeft() const { return {left, top}; }
  constexpr CPoint BottomRight() const { return {right, bottom}; }
  constexpr CPoint CenterPoint() const { return {(left + right) / 2, (top + bottom) / 2}; }
  constexpr bool IsRectEmpty() const { return right <= left || bottom <= top; }
  // Right and bottom edges lie outside the rectangle, as the window system counts them.
  constexpr bool PtInRect(POINT p) const { return p.x >= left && p.x < right && p.y >= top && p.y < bottom; }
  constexpr void OffsetRect(LONG dx, LONG dy) {
    left += dx;
    right += dx;
    top += dy;
    bottom += dy;
  }
  constexpr void InflateRect(LONG dx, LONG dy) {
    left -= dx;
    right += dx;
    top -= dy;
    bottom += dy;
  }
  constexpr void DeflateRect(LONG dx, LONG dy) { InflateRect(-dx, -dy); }
  constexpr void DeflateRect(LONG l, LONG t, LONG r, LONG b) {
    left += l;
    top += t;
    right -= r;
    bottom -= b;
  }
  constexpr bool IntersectRect(const RECT& a, const RECT& b) {
    *this = CRect(std::max(a.left, b.left), std::max(a.top, b.top), std::min(a.right, b.right),
                  std::min(a.bottom, b.bottom));
    if (IsRectEmpty()) *this = CRect();
    return !IsRectEmpty();
  }
};
