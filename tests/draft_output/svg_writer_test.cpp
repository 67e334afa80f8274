// The SVG preview: page and flip, colours by host colour, heavier cut edges, texts escaped.
#include "workbench/draft/svg_writer.h"

#include <gtest/gtest.h>

#include <sstream>

#include "tests/draft_output/draft_samples.h"

namespace {

using wb::draft::Label;
using wb::draft::Sheet;
using wb::draft::StrokeKind;

std::string Written(const Sheet& sheet) { return draft_output_samples::WrittenBy(wb::draft::SvgWriter(), sheet); }

// The opening tags (or whole empty elements) of one element name, in document order.
std::vector<std::string> Elements(const std::string& svg, const std::string& name) {
  std::vector<std::string> found;
  for (std::size_t at = svg.find('<' + name + ' '); at != std::string::npos; at = svg.find('<' + name + ' ', at + 1)) {
    found.push_back(svg.substr(at, svg.find('>', at) - at + 1));
  }
  return found;
}

std::string Attribute(const std::string& element, const std::string& name) {
  const std::size_t start = element.find(' ' + name + "=\"");
  if (start == std::string::npos) return "<missing>";
  const std::size_t value = start + name.size() + 3;
  return element.substr(value, element.find('"', value) - value);
}

// The characters between <text ...> and </text>.
std::vector<std::string> TextContents(const std::string& svg) {
  std::vector<std::string> contents;
  for (std::size_t at = svg.find("<text "); at != std::string::npos; at = svg.find("<text ", at + 1)) {
    const std::size_t begin = svg.find('>', at) + 1;
    contents.push_back(svg.substr(begin, svg.find("</text>", begin) - begin));
  }
  return contents;
}

TEST(SvgWriter, ThePageIsTheExtentWithAMarginAndYPointsUp) {
  Sheet sheet;
  sheet.strokes.push_back({{0.0, 0.0}, {200.0, 100.0}, 0, 7, StrokeKind::Edge});
  const std::string svg = Written(sheet);
  EXPECT_EQ(svg.rfind("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n", 0), 0u);
  const std::string root = Elements(svg, "svg").at(0);
  EXPECT_EQ(Attribute(root, "viewBox"), "-10 -110 220 120");
  EXPECT_EQ(Attribute(root, "width"), "1000");
  EXPECT_EQ(Attribute(root, "height"), "546");
  const std::string page = Elements(svg, "rect").at(0);
  EXPECT_EQ(Attribute(page, "x"), "-10");
  EXPECT_EQ(Attribute(page, "y"), "-110");
  EXPECT_EQ(Attribute(page, "fill"), "#ffffff");
  const std::string line = Elements(svg, "line").at(0);
  EXPECT_EQ(Attribute(line, "x1"), "0");
  EXPECT_EQ(Attribute(line, "y1"), "0");
  EXPECT_EQ(Attribute(line, "x2"), "200");
  EXPECT_EQ(Attribute(line, "y2"), "-100");
  EXPECT_LT(svg.find("<rect "), svg.find("<line "));
  EXPECT_EQ(svg.substr(svg.size() - 7), "</svg>\n");
}

TEST(SvgWriter, AnEmptyOrSinglePointSheetStillHasAPage) {
  const std::string empty = Written(Sheet{});
  EXPECT_EQ(Attribute(Elements(empty, "svg").at(0), "viewBox"), "-0.5 -0.5 1 1");
  EXPECT_TRUE(Elements(empty, "line").empty());
  Sheet point;
  point.strokes.push_back({{3.0, 4.0}, {3.0, 4.0}, 0, 7, StrokeKind::Edge});
  EXPECT_EQ(Attribute(Elements(Written(point), "svg").at(0), "viewBox"), "2.5 -4.5 1 1");
}

TEST(SvgWriter, StrokesTakeTheHostColourAndCutsAreHeavierAndOnTop) {
  Sheet sheet;
  for (int color : {1, 2, 3, 4, 5, 6, 7, 8, 0, 255}) {
    sheet.strokes.push_back({{0.0, 0.0}, {1000.0, static_cast<double>(color)}, 0, static_cast<std::uint8_t>(color),
                             color == 3 ? StrokeKind::Cut : StrokeKind::Edge});
  }
  const auto lines = Elements(Written(sheet), "line");
  ASSERT_EQ(lines.size(), 10u);
  std::vector<std::string> colors;
  for (const auto& line : lines) colors.push_back(Attribute(line, "stroke"));
  EXPECT_EQ(colors, (std::vector<std::string>{"#ff0000", "#d4b000", "#00a8c0", "#0000ff", "#c000c0", "#000000",
                                              "#808080", "#808080", "#808080", "#00a000"}));
  const double edge = std::stod(Attribute(lines.front(), "stroke-width"));
  const double cut = std::stod(Attribute(lines.back(), "stroke-width"));
  EXPECT_DOUBLE_EQ(edge, 1100.0 / 1000.0);
  EXPECT_DOUBLE_EQ(cut, 2.5 * edge);
}

TEST(SvgWriter, LabelsAreTextsTurnedTheWayTheyTurnInTheDrawing) {
  Sheet sheet;
  sheet.labels.push_back({{10.0, 20.0}, 2.5, 30.0, "Section", 0, 1});
  sheet.labels.push_back({{0.0, 0.0}, 1.0, 0.0, "flat", 0, 7});
  const std::string svg = Written(sheet);
  const auto texts = Elements(svg, "text");
  ASSERT_EQ(texts.size(), 2u);
  EXPECT_EQ(Attribute(texts[0], "x"), "10");
  EXPECT_EQ(Attribute(texts[0], "y"), "-20");
  EXPECT_EQ(Attribute(texts[0], "font-size"), "2.5");
  EXPECT_EQ(Attribute(texts[0], "fill"), "#ff0000");
  EXPECT_EQ(Attribute(texts[0], "transform"), "rotate(-30 10 -20)");
  EXPECT_EQ(Attribute(texts[1], "transform"), "<missing>");
  EXPECT_EQ(TextContents(svg), (std::vector<std::string>{"Section", "flat"}));
}

TEST(SvgWriter, TextsAreEscapedIntoWellFormedCharacters) {
  Sheet sheet;
  for (const std::string& text : draft_output_samples::OddTexts()) sheet.labels.push_back({{0, 0}, 1.0, 0.0, text, 0, 7});
  const auto contents = TextContents(Written(sheet));
  ASSERT_EQ(contents.size(), draft_output_samples::OddTexts().size());
  EXPECT_EQ(contents[0], "line one line two  ");
  EXPECT_EQ(contents[1], "bell  tab  del ");
  EXPECT_EQ(contents[2], "quotes &quot; &apos; and &lt;tags&gt; &amp; amps");
  EXPECT_EQ(contents[3], "mixed Wände 日本 €");
  EXPECT_EQ(contents[4], "emoji \xF0\x9F\x98\x80 here");
  EXPECT_EQ(contents[5], "broken \xEF\xBF\xBD utf-8 \xEF\xBF\xBD");
  EXPECT_EQ(contents[6], "%%c%%d 100%");
  EXPECT_EQ(contents[8], "");
}

TEST(SvgWriter, ValuesNoFileCanCarryAreRefused) {
  Sheet sheet;
  sheet.labels.push_back({{0, 0}, 0.0, 0.0, "flat", 0, 7});
  std::ostringstream out;
  EXPECT_THROW(wb::draft::SvgWriter().Write(sheet, out), std::invalid_argument);
  EXPECT_TRUE(out.str().empty());
}

}  // namespace
