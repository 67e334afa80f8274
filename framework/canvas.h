// A drawing surface that writes SVG: windows nest as clipped sub-pictures with their own
// coordinates, and every window and item carries data- attributes that say what it is and in
// which state, so that readers of the picture (tests, the browser page) need not guess.
#pragma once

#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "framework/win_types.h"

class CDC;

class Canvas {
 public:
  using Attributes = std::vector<std::pair<std::string, std::string>>;
  enum class Anchor { kStart, kMiddle, kEnd };
  struct TextStyle {
    COLORREF color = 0;
    bool bold = false;
    Anchor anchor = Anchor::kStart;
  };

  Canvas(int width, int height);
  Canvas(const Canvas&) = delete;
  Canvas& operator=(const Canvas&) = delete;
  ~Canvas();

  // A window or area at `rect` of the current coordinates; what is drawn until the matching
  // End is clipped to it and placed relative to its top-left corner.
  void BeginArea(const RECT& rect, const Attributes& attributes);
  void EndArea();
  // A labelled part of a window (a tree item, a tab) with no clipping of its own.
  void BeginGroup(const Attributes& attributes);
  void EndGroup();
  // A marker for something that exists but is not shown (a hidden window).
  void Marker(const Attributes& attributes);

  void FillRect(const RECT& rect, COLORREF color);
  void FrameRect(const RECT& rect, COLORREF color, int width = 1);
  void FocusRect(const RECT& rect);  // the dotted frame of the focused item
  void Line(POINT from, POINT to, COLORREF color, int width = 1, bool dotted = false);
  void Polyline(const std::vector<POINT>& points, COLORREF color, int width);
  void Polygon(const std::vector<POINT>& points, COLORREF fill);
  void Circle(POINT centre, int radius, COLORREF fill, COLORREF stroke);
  // Text in the window font from its baseline; the text is in the 8-bit code page.
  void Text(int x, int baseline, std::string_view text, const TextStyle& style);
  // An SVG picture (an icon) scaled into `rect`; a dimmed one is drawn faint (disabled).
  void Picture(const RECT& rect, std::string_view svg, bool dimmed, const Attributes& attributes = {});

  // The complete SVG document.
  std::string Svg() const;

  // The device context of this canvas, for code written against device contexts.
  CDC& Dc();

 private:
  void Open(std::string_view element, const Attributes& attributes, bool selfClosing);
  void Indent();

  int width_;
  int height_;
  int depth_ = 1;
  std::string body_;
  std::unique_ptr<CDC> dc_;
};

namespace framework {

// Text of the 8-bit code page as UTF-8, with the characters XML reserves escaped; control
// characters that XML cannot hold are left out.
std::string EscapeXmlText(std::string_view text);
std::string ColorText(COLORREF color);

}  // namespace framework
