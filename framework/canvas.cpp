// SVG output of the canvas: one element a line, indented by nesting, the same bytes for the
// same drawing.
#include "framework/canvas.h"

#include <array>
#include <cstdio>

#include "framework/cdc.h"
#include "framework/text_metrics.h"

namespace framework {
namespace {

// Code points of the bytes 0x80 to 0x9F of the 8-bit code page (0 where it has no character).
constexpr std::array<char32_t, 32> kHighControls = {
    0x20AC, 0,      0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0,      0x017D, 0,      0,      0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0,      0x017E, 0x0178,
};

void AppendUtf8(std::string& out, char32_t cp) {
  if (cp < 0x80) {
    out += static_cast<char>(cp);
  } else if (cp < 0x800) {
    out += static_cast<char>(0xC0 | (cp >> 6));
    out += static_cast<char>(0x80 | (cp & 0x3F));
  } else {
    out += static_cast<char>(0xE0 | (cp >> 12));
    out += static_cast<char>(0x80 | ((cp >> 6) & 0x3F));
    out += static_cast<char>(0x80 | (cp & 0x3F));
  }
}

std::string Number(int value) { return std::to_string(value); }

std::string Decimal(double value) {
  char text[32];
  std::snprintf(text, sizeof text, "%g", value);
  return text;
}

}  // namespace

std::string EscapeXmlText(std::string_view text) {
  std::string out;
  out.reserve(text.size());
  for (unsigned char c : text) {
    switch (c) {
      case '&':
        out += "&amp;";
        break;
      case '<':
        out += "&lt;";
        break;
      case '>':
        out += "&gt;";
        break;
      case '"':
        out += "&quot;";
        break;
      case '\'':
        out += "&apos;";
        break;
      default:
        if (c < 0x20 && c != '\t') break;  // XML cannot hold these
        if (c >= 0x80 && c < 0xA0) {
          if (kHighControls[c - 0x80] != 0) AppendUtf8(out, kHighControls[c - 0x80]);
        } else {
          AppendUtf8(out, c);
        }
    }
  }
  return out;
}

std::string ColorText(COLORREF color) {
  char text[8];
  std::snprintf(text, sizeof text, "#%02x%02x%02x", GetRValue(color), GetGValue(color), GetBValue(color));
  return text;
}

}  // namespace framework

using framework::ColorText;
using framework::Decimal;
using framework::Number;
using framework::EscapeXmlText;

Canvas::Canvas(int width, int height) : width_(width), height_(height) {}

Canvas::~Canvas() = default;

CDC& Canvas::Dc() {
  if (!dc_) dc_ = std::make_unique<CDC>(this);
  return *dc_;
}

void Canvas::Indent() { body_.append(static_cast<std::size_t>(depth_) * 2, ' '); }

void Canvas::Open(std::string_view element, const Attributes& attributes, bool selfClosing) {
  Indent();
  body_ += '<';
  body_ += element;
  for (const auto& [name, value] : attributes) {
    body_ += ' ';
    body_ += name;
    body_ += "=\"";
    body_ += EscapeXmlText(value);
    body_ += '"';
  }
  body_ += selfClosing ? "/>\n" : ">\n";
}

void Canvas::BeginArea(const RECT& rect, const Attributes& attributes) {
  Attributes all = {{"x", Number(rect.left)},
                    {"y", Number(rect.top)},
                    {"width", Number(rect.right - rect.left)},
                    {"height", Number(rect.bottom - rect.top)}};
  all.insert(all.end(), attributes.begin(), attributes.end());
  Open("svg", all, false);
  ++depth_;
}

void Canvas::EndArea() {
  --depth_;
  Indent();
  body_ += "</svg>\n";
}

void Canvas::BeginGroup(const Attributes& attributes) {
  Open("g", attributes, false);
  ++depth_;
}

void Canvas::EndGroup() {
  --depth_;
  Indent();
  body_ += "</g>\n";
}

void Canvas::Marker(const Attributes& attributes) { Open("g", attributes, true); }

void Canvas::FillRect(const RECT& r, COLORREF color) {
  if (r.right <= r.left || r.bottom <= r.top) return;
  Open("rect",
       {{"x", Number(r.left)},
        {"y", Number(r.top)},
        {"width", Number(r.right - r.left)},
        {"height", Number(r.bottom - r.top)},
        {"fill", ColorText(color)}},
       true);
}

void Canvas::FrameRect(const RECT& r, COLORREF color, int width) {
  if (r.right - r.left < width || r.bottom - r.top < width) return;
  // The stroke runs inside the rectangle, as a frame drawn pixel by pixel would.
  const double half = width / 2.0;
  Open("rect",
       {{"x", Decimal(r.left + half)},
        {"y", Decimal(r.top + half)},
        {"width", Number(r.right - r.left - width)},
        {"height", Number(r.bottom - r.top - width)},
        {"fill", "none"},
        {"stroke", ColorText(color)},
        {"stroke-width", Number(width)}},
       true);
}

void Canvas::FocusRect(const RECT& r) {
  if (r.right - r.left < 2 || r.bottom - r.top < 2) return;
  Open("rect",
       {{"x", Decimal(r.left + 0.5)},
        {"y", Decimal(r.top + 0.5)},
        {"width", Number(r.right - r.left - 1)},
        {"height", Number(r.bottom - r.top - 1)},
        {"fill", "none"},
        {"stroke", "#000000"},
        {"stroke-width", "1"},
        {"stroke-dasharray", "1 1"},
        {"data-focus", "true"}},
       true);
}

void Canvas::Line(POINT from, POINT to, COLORREF color, int width, bool dotted) {
  Attributes a = {{"x1", Number(from.x)}, {"y1", Number(from.y)}, {"x2", Number(to.x)},
                  {"y2", Number(to.y)},   {"stroke", ColorText(color)}, {"stroke-width", Number(width)}};
  if (dotted) a.emplace_back("stroke-dasharray", "1 1");
  Open("line", a, true);
}

void Canvas::Polyline(const std::vector<POINT>& points, COLORREF color, int width) {
  std::string list;
  for (const POINT& p : points) list += (list.empty() ? "" : " ") + Number(p.x) + "," + Number(p.y);
  Open("polyline",
       {{"points", list},
        {"fill", "none"},
        {"stroke", ColorText(color)},
        {"stroke-width", Number(width)},
        {"stroke-linecap", "round"},
        {"stroke-linejoin", "round"}},
       true);
}

void Canvas::Polygon(const std::vector<POINT>& points, COLORREF fill) {
  std::string list;
  for (const POINT& p : points) list += (list.empty() ? "" : " ") + Number(p.x) + "," + Number(p.y);
  Open("polygon", {{"points", list}, {"fill", ColorText(fill)}}, true);
}

void Canvas::Circle(POINT centre, int radius, COLORREF fill, COLORREF stroke) {
  Open("circle",
       {{"cx", Number(centre.x)},
        {"cy", Number(centre.y)},
        {"r", Number(radius)},
        {"fill", ColorText(fill)},
        {"stroke", ColorText(stroke)}},
       true);
}

void Canvas::Text(int x, int baseline, std::string_view text, const TextStyle& style) {
  if (text.empty()) return;
  Attributes a = {{"x", Number(x)},
                  {"y", Number(baseline)},
                  {"font-family", std::string(framework::kFontFamily)},
                  {"font-size", Number(framework::kFontSize)},
                  {"fill", ColorText(style.color)}};
  if (style.bold) a.emplace_back("font-weight", "bold");
  if (style.anchor == Anchor::kMiddle) a.emplace_back("text-anchor", "middle");
  if (style.anchor == Anchor::kEnd) a.emplace_back("text-anchor", "end");
  a.emplace_back("xml:space", "preserve");
  Indent();
  body_ += "<text";
  for (const auto& [name, value] : a) body_ += ' ' + name + "=\"" + EscapeXmlText(value) + '"';
  body_ += '>' + EscapeXmlText(text) + "</text>\n";
}

void Canvas::Picture(const RECT& r, std::string_view svg, bool dimmed, const Attributes& attributes) {
  // The picture's own drawing goes in unchanged; only its outer element is replaced, so that
  // it lands in `rect` whatever size it was drawn at.
  const auto open = svg.find("<svg");
  const auto openEnd = open == std::string_view::npos ? open : svg.find('>', open);
  const auto close = svg.rfind("</svg>");
  if (openEnd == std::string_view::npos || close == std::string_view::npos || close < openEnd) return;
  const std::string_view head = svg.substr(open, openEnd - open);
  std::string viewBox = "0 0 16 16";
  if (const auto at = head.find("viewBox=\""); at != std::string_view::npos) {
    const auto start = at + 9;
    viewBox = std::string(head.substr(start, head.find('"', start) - start));
  }
  Attributes a = attributes;
  if (dimmed) a.emplace_back("opacity", "0.35");
  BeginGroup(a);
  Open("svg",
       {{"x", Number(r.left)},
        {"y", Number(r.top)},
        {"width", Number(r.right - r.left)},
        {"height", Number(r.bottom - r.top)},
        {"viewBox", viewBox}},
       false);
  Indent();
  body_ += svg.substr(openEnd + 1, close - openEnd - 1);
  body_ += '\n';
  Indent();
  body_ += "</svg>\n";
  EndGroup();
}

std::string Canvas::Svg() const {
  return "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"" + Number(width_) + "\" height=\"" + Number(height_) +
         "\" viewBox=\"0 0 " + Number(width_) + " " + Number(height_) + "\">\n" + body_ + "</svg>\n";
}
