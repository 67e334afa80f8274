// Sample sheets: random ones from a seed, and the awkward cases named in the header.
#include "tests/draft_output/draft_samples.h"

#include <random>
#include <sstream>

namespace draft_output_samples {
namespace {

using wb::draft::Label;
using wb::draft::Sheet;
using wb::draft::Stroke;
using wb::draft::StrokeKind;

// Pieces that read back exactly: cp1252 letters, characters written as \U+ escapes, percent
// runs and backslashes that the encoding escapes.
const std::vector<std::string> kTextPieces = {"Wall", " ", "Schnitt A-A", "Wände", "€ 12", "日本", "50%",
                                             "%%c", "%%%", "C:\\Users", "\\U+0041", "<&\"'>", "ø 12", "Ω"};

}  // namespace

Sheet MakeSheet(unsigned seed, int strokes, int labels, int layers) {
  std::mt19937 random(seed);
  std::uniform_real_distribution<double> coordinate(-20000.0, 20000.0);
  std::uniform_int_distribution<int> layer(0, layers - 1);
  std::uniform_int_distribution<int> color(0, 255);
  std::uniform_int_distribution<int> kind(0, 2);
  std::uniform_int_distribution<std::size_t> piece(0, kTextPieces.size() - 1);
  Sheet sheet;
  for (int i = 0; i < layers; i += 2) sheet.layerNames[static_cast<std::size_t>(i)] = "Level " + std::to_string(i) + " Ä";
  for (int i = 0; i < strokes; ++i) {
    Stroke stroke;
    stroke.a = {coordinate(random), coordinate(random)};
    stroke.b = {coordinate(random), coordinate(random)};
    stroke.layer = static_cast<std::uint8_t>(layer(random));
    stroke.color = static_cast<std::uint8_t>(color(random));
    stroke.kind = static_cast<StrokeKind>(kind(random));
    sheet.strokes.push_back(stroke);
  }
  for (int i = 0; i < labels; ++i) {
    Label label;
    label.at = {coordinate(random), coordinate(random)};
    label.height = 0.5 + std::uniform_real_distribution<double>(0.0, 10.0)(random);
    label.angle = std::uniform_real_distribution<double>(-360.0, 360.0)(random);
    for (int k = 0; k < 4; ++k) label.text += kTextPieces[piece(random)];
    label.layer = static_cast<std::uint8_t>(layer(random));
    label.color = static_cast<std::uint8_t>(color(random));
    sheet.labels.push_back(label);
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
    sheet.strokes.push_back({{0.0, static_cast<double>(i)}, {10.0, static_cast<double>(i)},
                             static_cast<std::uint8_t>(i), 7, StrokeKind::Edge});
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
