// Writes a sheet as an SVG picture beside the DXF file, for a person to look at the result
// without a CAD program.
#pragma once

#include <cstdint>
#include <string_view>

#include "workbench/draft/sheet_writer.h"

namespace wb::draft {

class SvgWriter final : public SheetWriter {
 public:
  // Drawing y points up; the picture is flipped so that it looks as it does in the host.
  // Throws std::invalid_argument when a value cannot be carried (CheckSheetValues).
  void Write(const Sheet& sheet, std::ostream& out) const override;
};

// The host colour index as an SVG colour on a white page: 1 red, 2 yellow, 3 green, 4 cyan,
// 5 blue, 6 magenta, 7 black, any other grey.
std::string_view SvgColor(std::uint8_t hostColor);

}  // namespace wb::draft
