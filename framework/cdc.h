// A device context over a canvas: the drawing calls window code is written against (colours,
// background mode, text layout, icons), with the state such code expects a context to keep.
#pragma once

#include <string_view>

#include "framework/geometry.h"
#include "framework/win_constants.h"
#include "framework/win_types.h"

class Canvas;

// A font as the window layer knows it: only bold or not; size and face are the window font's.
class CFont {
 public:
  BOOL CreatePointFont(int, std::string_view, void* = nullptr) { return created_ = TRUE; }
  void SetBold(bool bold) {
    bold_ = bold;
    created_ = TRUE;
  }
  bool IsBold() const { return bold_; }
  bool Exists() const { return created_ != FALSE; }

 private:
  BOOL created_ = FALSE;
  bool bold_ = false;
};

class CDC {
 public:
  explicit CDC(Canvas* canvas) : canvas_(canvas) {}

  // The context of a device-context handle (the canvas a window paints into).
  static CDC* FromHandle(HDC hdc);
  HDC GetSafeHdc() const { return canvas_; }
  Canvas& GetCanvas() const { return *canvas_; }

  COLORREF SetTextColor(COLORREF color);
  COLORREF GetTextColor() const { return textColor_; }
  COLORREF SetBkColor(COLORREF color);
  int SetBkMode(int mode);
  // Selects a font and answers the previous one; a null font or one never created changes nothing.
  CFont* SelectObject(CFont* font);

  void FillSolidRect(const RECT& rect, COLORREF color);
  void FillSolidRect(int x, int y, int cx, int cy, COLORREF color);
  void Draw3dRect(const RECT& rect, COLORREF topLeft, COLORREF bottomRight);
  void DrawFocusRect(const RECT& rect);
  // Lays out and draws text in a rectangle (DT_ flags); answers the height of the text. With
  // DT_CALCRECT it only measures, widening or heightening `rect` to fit.
  int DrawText(std::string_view text, RECT* rect, UINT format);
  CSize GetTextExtent(std::string_view text) const;
  // Draws an icon at its point and size (DST_ICON; DSS_DISABLED draws it faint).
  BOOL DrawState(CPoint point, CSize size, HICON icon, UINT flags);
  BOOL DrawIcon(int x, int y, HICON icon);  // at the system's large icon size

 private:
  Canvas* canvas_;
  COLORREF textColor_ = RGB(0, 0, 0);
  COLORREF bkColor_ = RGB(255, 255, 255);
  int bkMode_ = OPAQUE;
  CFont* font_ = nullptr;
};
