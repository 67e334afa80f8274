// Sample sheets: random ones from a seed, and the awkward cases named in the header.
#include "tests/draft_output/draft_samples.h"

#include <random>
#include <sstream>

namespace draft_output_samples {

using wb::draft::Sheet;
using wb::draft::StrokeKind;

Sheet MakeSheet(unsigned seed, int strokes, int labels, int layers) {
  // Code page letters, characters written as \U+ escapes, and what the encoding escapes.
  static const std::vector<std::string> pieces = {"Wall", " ",    "Schnitt A-A", "Wände", "€ 12",  "日本", "50%",
                                                  "%%c",  "%%%", "C:\\Users",    "\\U+0041", "<&\"'>", "ø 12", "Ω"};
  std::mt19937 random(seed);
  std::uniform_real_distribution<double> coordinate(-20000.0, 20000.0);
  const auto below = [&](int limit) { return std::uniform_int_distribution<int>(0, limit - 1)(random); };
  const auto byte = [&](int limit) { return static_cast<std::uint8_t>(below(limit)); };
  Sheet sheet;
  for (int i = 0; i < layers; i += 2) sheet.layerNames[static_cast<std::size_t>(i)] = "Level " + std::to_string(i) + " Ä";
  // Braced lists evaluate left to right, so the same seed draws the same values.
  for (int i = 0; i < strokes; ++i) {
    sheet.strokes.push_back({{coordinate(random), coordinate(random)}, {coordinate(random), coordinate(random)},
                             byte(layers), byte(256), static_cast<StrokeKind>(below(3))});
  }
  for (int i = 0; i < labels; ++i) {
    std::string text;
    for (int k = 0; k < 4; ++k) text += pieces[static_cast<std::size_t>(below(static_cast<int>(pieces.size())))];
    sheet.labels.push_back({{coordinate(random), coordinate(random)}, 5.5 + coordinate(random) / 4000,
                            coordinate(random) / 50, text, byte(layers), byte(256)});
  }
  return sheet;
}

Sheet MakeOddNamesSheet() {
  const std::vector<std::string> names = {"a<b>c/d\\e\"f:g;h?i*j|k=l`m'n,o", "A_B_C_D_E_F_G_H_I_J_K_L_M_N_O", "   ",
                                          "Walls", "WALLS", "  Doors  ", "Wände", "日本", "tab\there\nnewline",
                                          std::string(300, 'x'), "Layer 2", ""};
  Sheet sheet;
  for (std::size_t i = 0; i < names.size(); ++i) {
    sheet.layerNames[i] = names[i];
    const double y = static_cast<double>(i);
    sheet.strokes.push_back({{0.0, y}, {10.0, y}, static_cast<std::uint8_t>(i), 7, StrokeKind::Edge});
  }
  sheet.labels.push_back({{0.0, -5.0}, 2.5, 0.0, "odd layers", 4, 2});
  return sheet;
}

Sheet MakeAllLayersSheet() {
  Sheet sheet;
  for (int i = 0; i < wb::draft::kSheetLayerCount; ++i) {
    const double y = static_cast<double>(i);
    sheet.strokes.push_back({{0.0, y}, {100.0, y}, static_cast<std::uint8_t>(i),
                             static_cast<std::uint8_t>(i % 255 + 1), static_cast<StrokeKind>(i % 3)});
  }
  return sheet;
}

std::vector<std::string> OddTexts() {
  return {"line one\nline two\r\n", "bell\a tab\t del\x7f", "quotes \" ' and <tags> & amps",
          "mixed Wände 日本 €", "emoji \xF0\x9F\x98\x80 here", "broken \xC3 utf-8 \xFF", "%%c%%d 100%",
          "back\\slash \\U+0041 \\u+0042", "", "   leading and trailing   "};
}

std::string WrittenBy(const wb::draft::SheetWriter& writer, const Sheet& sheet) {
  std::ostringstream out;
  writer.Write(sheet, out);
  return out.str();
}

}  // namespace draft_output_samples
