// Writes a sheet as an ASCII DXF file of release 12 (AC1009), the dialect nearly every CAD
// program reads, and the naming and text conventions the reader relies on to read it back.
#pragma once

#include <array>
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

#include "workbench/draft/sheet_writer.h"

namespace wb::draft {

// Release 12 files carry no lineweight, so a stroke's kind and the sheet's own layer index
// travel as extended data of this application: 1070 layer index, then 1070 kind on lines.
inline constexpr std::string_view kDxfApplication = "PANDEX";

// Longest line the reader accepts; the writer refuses texts that would not fit.
constexpr std::size_t kMaxDxfLineLength = 65536;
// Longest layer name, in characters.
constexpr std::size_t kMaxDxfLayerNameLength = 255;

class DxfWriter final : public SheetWriter {
 public:
  // Throws std::invalid_argument when a value cannot be carried (CheckSheetValues) or a text is
  // longer than kMaxDxfLineLength once encoded.
  void Write(const Sheet& sheet, std::ostream& out) const override;
};

// Texts are stored in code page 1252, the one written in $DWGCODEPAGE.
std::optional<unsigned char> ToCp1252(char32_t codePoint);
char32_t FromCp1252(unsigned char byte);

// A name DXF programs accept as a layer name (UTF-8, every character representable in code
// page 1252): characters they reserve and control characters become '_', blanks around it go,
// and it is cut to kMaxDxfLayerNameLength characters. Empty when nothing is left.
std::string SanitizeDxfLayerName(std::string_view name);

// Layer names compare without regard to case in DXF programs; this is the key to compare by.
std::string DxfNameKey(std::string_view name);

// A layer's name as the file shows it, before names that clash are told apart: the sanitized
// name, or "Layer n" when nothing of it is left.
std::string BaseDxfLayerName(const Sheet& sheet, int index);

// The layer name written for each used layer (empty for unused ones): sanitized, and made
// unique where two layers would otherwise share one by appending "_2", "_3" and so on.
std::array<std::string, kSheetLayerCount> DxfLayerNames(const Sheet& sheet);

// A label's text as it is written in a TEXT entity: code page 1252, line breaks and other
// control characters as blanks, characters outside the code page as \U+XXXX, and "%%" (which
// DXF programs read as a control code) as "%%%%%%".
std::string EncodeDxfText(std::string_view text);

}  // namespace wb::draft
