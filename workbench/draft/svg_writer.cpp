// SVG preview: white page around the sheet's extent, strokes coloured by host colour with cut
// edges heavier, labels as text. Lengths in the picture are drawing units; stroke widths and the
// margin follow the picture's size, so a plan of 40 m and a detail of 40 mm look alike.
#include "workbench/draft/svg_writer.h"

#include <algorithm>
#include <cmath>

namespace wb::draft {
namespace {

constexpr double kMarginShare = 0.05;
constexpr double kPictureSide = 1000.0;  // pixels, the longer side
constexpr double kEdgeWidth = 1.0;       // in thousandths of the longer side
constexpr double kCutWidth = 2.5;

std::string EscapeXml(std::string_view text) {
  std::string out;
  for (const char32_t c : DecodeUtf8(text)) {
    switch (c) {
      case U'&': out += "&amp;"; break;
      case U'<': out += "&lt;"; break;
      case U'>': out += "&gt;"; break;
      case U'"': out += "&quot;"; break;
      case U'\'': out += "&apos;"; break;
      default:
        if (c < 0x20 || (c >= 0x7F && c <= 0x9F)) {
          // Not allowed in XML (or not meant to be shown); a label is one line anyway.
          out.push_back(' ');
        } else {
          AppendUtf8(out, c == 0xFFFE || c == 0xFFFF ? U'\uFFFD' : c);
        }
    }
  }
  return out;
}

// Drawing y points up, SVG y points down.
std::string X(const Point2& point) { return FormatNumber(point.x); }
std::string Y(const Point2& point) { return FormatNumber(-point.y); }

void WriteStrokes(std::ostream& out, const Sheet& sheet, bool cuts, double width) {
  const std::string strokeWidth = FormatNumber(width);
  for (const Stroke& stroke : sheet.strokes) {
    if ((stroke.kind == StrokeKind::Cut) != cuts) continue;
    out << "<line x1=\"" << X(stroke.a) << "\" y1=\"" << Y(stroke.a) << "\" x2=\"" << X(stroke.b) << "\" y2=\""
        << Y(stroke.b) << "\" stroke=\"" << SvgColor(stroke.color) << "\" stroke-width=\"" << strokeWidth << "\"/>\n";
  }
}

void WriteLabels(std::ostream& out, const Sheet& sheet) {
  for (const Label& label : sheet.labels) {
    out << "<text x=\"" << X(label.at) << "\" y=\"" << Y(label.at) << "\" font-size=\"" << FormatNumber(label.height)
        << "\" fill=\"" << SvgColor(label.color) << '"';
    // Counter-clockwise in the drawing is clockwise once y is flipped.
    if (label.angle != 0.0) {
      out << " transform=\"rotate(" << FormatNumber(-label.angle) << ' ' << X(label.at) << ' ' << Y(label.at) << ")\"";
    }
    out << '>' << EscapeXml(label.text) << "</text>\n";
  }
}

}  // namespace

std::string_view SvgColor(std::uint8_t hostColor) {
  // Pure yellow and cyan are hard to see on white; these are darkened as far as they stay
  // recognisable. Colour 7 is the foreground, black on a white page.
  switch (hostColor) {
    case 1: return "#ff0000";
    case 2: return "#d4b000";
    case 3: return "#00a000";
    case 4: return "#00a8c0";
    case 5: return "#0000ff";
    case 6: return "#c000c0";
    case 7: return "#000000";
    default: return "#808080";
  }
}

void SvgWriter::Write(const Sheet& sheet, std::ostream& out) const {
  CheckSheetValues(sheet);
  const Box2 extent = SheetExtent(sheet).value_or(Box2{});
  const double longer = std::max(extent.max.x - extent.min.x, extent.max.y - extent.min.y);
  // A sheet that is one point (or empty) still gets a page of one unit around it.
  const double margin = longer > 0.0 ? longer * kMarginShare : 0.5;
  const double viewWidth = extent.max.x - extent.min.x + 2.0 * margin;
  const double viewHeight = extent.max.y - extent.min.y + 2.0 * margin;
  const double unit = std::max(viewWidth, viewHeight) / kPictureSide;
  const std::string left = FormatNumber(extent.min.x - margin);
  const std::string top = FormatNumber(-extent.max.y - margin);
  const std::string width = FormatNumber(viewWidth);
  const std::string height = FormatNumber(viewHeight);

  out << "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
      << "<svg xmlns=\"http://www.w3.org/2000/svg\" version=\"1.1\" width=\""
      << FormatNumber(std::ceil(viewWidth / unit)) << "\" height=\"" << FormatNumber(std::ceil(viewHeight / unit))
      << "\" viewBox=\"" << left << ' ' << top << ' ' << width << ' ' << height << "\">\n"
      << "<rect x=\"" << left << "\" y=\"" << top << "\" width=\"" << width << "\" height=\"" << height
      << "\" fill=\"#ffffff\"/>\n"
      << "<g fill=\"none\" stroke-linecap=\"round\">\n";
  // Cut edges last, so that they lie on top of what they cut through.
  WriteStrokes(out, sheet, false, kEdgeWidth * unit);
  WriteStrokes(out, sheet, true, kCutWidth * unit);
  out << "</g>\n<g font-family=\"sans-serif\">\n";
  WriteLabels(out, sheet);
  out << "</g>\n</svg>\n";
}

}  // namespace wb::draft
