// Checks and encodings every 2D file format needs, kept in one place so that the DXF file and
// its SVG preview always agree on what a sheet contains.
#include "workbench/draft/sheet_writer.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <stdexcept>

namespace wb::draft {
namespace {

bool IsCarried(double value) { return std::isfinite(value) && std::fabs(value) <= kMaxSheetCoordinate; }
bool IsCarried(const Point2& point) { return IsCarried(point.x) && IsCarried(point.y); }

[[noreturn]] void Refuse(const char* what, std::size_t index, const char* fault) {
  throw std::invalid_argument(std::string(what) + ' ' + std::to_string(index + 1) + ' ' + fault);
}

// Wide enough for a typical drafting font; the extent only has to keep texts in the picture.
constexpr double kCharacterWidth = 0.6;

void Include(Box2& box, Point2 point) {
  box.min.x = std::min(box.min.x, point.x);
  box.min.y = std::min(box.min.y, point.y);
  box.max.x = std::max(box.max.x, point.x);
  box.max.y = std::max(box.max.y, point.y);
}

void IncludeLabel(Box2& box, const Label& label) {
  const double width = kCharacterWidth * label.height * static_cast<double>(DecodeUtf8(label.text).size());
  const double radians = label.angle * std::acos(-1.0) / 180.0;
  const double c = std::cos(radians);
  const double s = std::sin(radians);
  for (const Point2 corner : {Point2{0, 0}, Point2{width, 0}, Point2{width, label.height}, Point2{0, label.height}}) {
    Include(box, {label.at.x + corner.x * c - corner.y * s, label.at.y + corner.x * s + corner.y * c});
  }
}

bool IsContinuation(unsigned char byte) { return (byte & 0xC0) == 0x80; }

}  // namespace

void CheckSheetValues(const Sheet& sheet) {
  for (std::size_t i = 0; i < sheet.strokes.size(); ++i) {
    if (!IsCarried(sheet.strokes[i].a) || !IsCarried(sheet.strokes[i].b)) {
      Refuse("stroke", i, "has a coordinate that is not a finite number within 1e15");
    }
  }
  for (std::size_t i = 0; i < sheet.labels.size(); ++i) {
    const Label& label = sheet.labels[i];
    if (!IsCarried(label.at) || !IsCarried(label.angle)) {
      Refuse("label", i, "has a position or angle that is not a finite number within 1e15");
    }
    if (!IsCarried(label.height) || !(label.height > 0.0)) Refuse("label", i, "has a height that is not positive");
  }
}

std::array<bool, kSheetLayerCount> UsedLayers(const Sheet& sheet) {
  std::array<bool, kSheetLayerCount> used{};
  for (const Stroke& stroke : sheet.strokes) used[stroke.layer] = true;
  for (const Label& label : sheet.labels) used[label.layer] = true;
  return used;
}

std::string DefaultLayerName(int index) { return "Layer " + std::to_string(index + 1); }

std::string EffectiveLayerName(const Sheet& sheet, int index) {
  const std::string& name = sheet.layerNames[static_cast<std::size_t>(index)];
  return name.empty() ? DefaultLayerName(index) : name;
}

std::optional<Box2> SheetExtent(const Sheet& sheet) {
  std::optional<Box2> box;
  const auto start = [&box](Point2 point) {
    if (!box) box = Box2{point, point};
  };
  for (const Stroke& stroke : sheet.strokes) {
    start(stroke.a);
    Include(*box, stroke.a);
    Include(*box, stroke.b);
  }
  for (const Label& label : sheet.labels) {
    start(label.at);
    IncludeLabel(*box, label);
  }
  return box;
}

std::string FormatNumber(double value) {
  // Fixed notation of a double near 1e-300 runs to a few hundred digits.
  char buffer[400];
  const auto result = std::to_chars(buffer, buffer + sizeof buffer, value + 0.0, std::chars_format::fixed);
  if (result.ec != std::errc()) throw std::invalid_argument("a number cannot be written");
  return std::string(buffer, result.ptr);
}

std::u32string DecodeUtf8(std::string_view text) {
  std::u32string decoded;
  decoded.reserve(text.size());
  for (std::size_t i = 0; i < text.size();) {
    const auto lead = static_cast<unsigned char>(text[i]);
    int length = 0;
    char32_t point = 0;
    char32_t least = 0;
    if (lead < 0x80) {
      length = 1, point = lead;
    } else if ((lead & 0xE0) == 0xC0) {
      length = 2, point = lead & 0x1Fu, least = 0x80;
    } else if ((lead & 0xF0) == 0xE0) {
      length = 3, point = lead & 0x0Fu, least = 0x800;
    } else if ((lead & 0xF8) == 0xF0) {
      length = 4, point = lead & 0x07u, least = 0x10000;
    }
    bool valid = length > 0 && i + static_cast<std::size_t>(length) <= text.size();
    for (int k = 1; valid && k < length; ++k) {
      const auto byte = static_cast<unsigned char>(text[i + static_cast<std::size_t>(k)]);
      valid = IsContinuation(byte);
      point = (point << 6) | (byte & 0x3Fu);
    }
    // Overlong forms, surrogates and values past U+10FFFF are not characters.
    valid = valid && point >= least && point <= 0x10FFFF && !(point >= 0xD800 && point <= 0xDFFF);
    decoded.push_back(valid ? point : U'\uFFFD');
    i += valid ? static_cast<std::size_t>(length) : 1;
  }
  return decoded;
}

void AppendUtf8(std::string& out, char32_t codePoint) {
  if (codePoint > 0x10FFFF || (codePoint >= 0xD800 && codePoint <= 0xDFFF)) codePoint = U'\uFFFD';
  const auto put = [&out](char32_t bits) { out.push_back(static_cast<char>(bits)); };
  if (codePoint < 0x80) {
    put(codePoint);
  } else if (codePoint < 0x800) {
    put(0xC0 | (codePoint >> 6));
    put(0x80 | (codePoint & 0x3F));
  } else if (codePoint < 0x10000) {
    put(0xE0 | (codePoint >> 12));
    put(0x80 | ((codePoint >> 6) & 0x3F));
    put(0x80 | (codePoint & 0x3F));
  } else {
    put(0xF0 | (codePoint >> 18));
    put(0x80 | ((codePoint >> 12) & 0x3F));
    put(0x80 | ((codePoint >> 6) & 0x3F));
    put(0x80 | (codePoint & 0x3F));
  }
}

}  // namespace wb::draft
