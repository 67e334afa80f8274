// The one interface the 2D file formats implement, and what they share: value checks, the
// sheet's extent, layer names, number and text encoding.
#pragma once

#include <array>
#include <optional>
#include <ostream>
#include <string>
#include <string_view>

#include "workbench/draft/sheet.h"

namespace wb::draft {

// A writer only serializes: projection, hidden lines and cuts are done before a sheet exists.
class SheetWriter {
 public:
  virtual ~SheetWriter() = default;
  // Throws std::invalid_argument (see CheckSheetValues) before writing anything.
  virtual void Write(const Sheet& sheet, std::ostream& out) const = 0;
};

// Beyond this a drawing unit is no longer a building part, and sums of such values (extents,
// margins) would lose all precision or overflow; readers refuse the same values.
constexpr double kMaxSheetCoordinate = 1.0e15;

// Throws std::invalid_argument naming the first stroke or label with a value no file format can
// carry: a coordinate, height or angle that is not finite or beyond kMaxSheetCoordinate, or a
// text height that is not positive.
void CheckSheetValues(const Sheet& sheet);

// Which of the 256 layers carry a stroke or a label.
std::array<bool, kSheetLayerCount> UsedLayers(const Sheet& sheet);

// "Layer n" with n = index + 1, the name of a layer the sheet leaves unnamed.
std::string DefaultLayerName(int index);
std::string EffectiveLayerName(const Sheet& sheet, int index);

// The box around all strokes and labels (a label's box is estimated from its height and the
// length of its text), or nothing for an empty sheet.
std::optional<Box2> SheetExtent(const Sheet& sheet);

// The shortest decimal text that reads back as the same double, never in exponent notation and
// always with '.', whatever the locale; -0 is written as 0.
std::string FormatNumber(double value);

// The code points of UTF-8 text; each byte that does not belong to a valid sequence becomes
// U+FFFD, so that texts from anywhere can be written.
std::u32string DecodeUtf8(std::string_view text);
void AppendUtf8(std::string& out, char32_t codePoint);

}  // namespace wb::draft
