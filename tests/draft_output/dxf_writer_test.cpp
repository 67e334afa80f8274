// What the DXF writer puts in a file, checked group by group: header, layer table, lines,
// texts, the encoding of names and texts, and the values it refuses.
#include "workbench/draft/dxf_writer.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <charconv>
#include <clocale>
#include <cmath>
#include <limits>
#include <locale>
#include <sstream>

#include "tests/draft_output/draft_samples.h"
#include "tests/draft_output/dxf_groups.h"

namespace {

using draft_output_samples::DxfEntries;
using draft_output_samples::DxfGroup;
using draft_output_samples::DxfValue;
using draft_output_samples::SplitDxfGroups;
using wb::draft::Label;
using wb::draft::Sheet;
using wb::draft::Stroke;
using wb::draft::StrokeKind;

std::string Written(const Sheet& sheet) { return draft_output_samples::WrittenBy(wb::draft::DxfWriter(), sheet); }

std::vector<DxfGroup> Groups(const Sheet& sheet) { return SplitDxfGroups(Written(sheet)); }

// The value after a header variable, for a variable with one value group.
std::vector<DxfGroup> HeaderVariable(const std::vector<DxfGroup>& groups, const std::string& name) {
  for (std::size_t i = 0; i < groups.size(); ++i) {
    if (groups[i].code != 9 || groups[i].value != name) continue;
    std::vector<DxfGroup> values;
    for (std::size_t k = i + 1; k < groups.size() && groups[k].code != 9 && groups[k].code != 0; ++k) {
      values.push_back(groups[k]);
    }
    return values;
  }
  return {};
}

std::vector<std::string> LayerTableNames(const std::vector<DxfGroup>& groups) {
  std::vector<std::string> names;
  for (const auto& entry : DxfEntries(groups, "LAYER")) names.push_back(DxfValue(entry, 2));
  return names;
}

TEST(DxfWriter, HeaderNamesReleaseTwelveTheCodePageAndTheExtent) {
  Sheet sheet;
  sheet.strokes.push_back({{-10.0, 5.0}, {100.0, 50.0}, 0, 7, StrokeKind::Edge});
  sheet.strokes.push_back({{20.0, -30.0}, {40.0, 0.0}, 0, 7, StrokeKind::Cut});
  const auto groups = Groups(sheet);
  EXPECT_EQ(HeaderVariable(groups, "$ACADVER"), (std::vector<DxfGroup>{{1, "AC1009"}}));
  EXPECT_EQ(HeaderVariable(groups, "$DWGCODEPAGE"), (std::vector<DxfGroup>{{3, "ANSI_1252"}}));
  EXPECT_EQ(HeaderVariable(groups, "$EXTMIN"), (std::vector<DxfGroup>{{10, "-10"}, {20, "-30"}, {30, "0"}}));
  EXPECT_EQ(HeaderVariable(groups, "$EXTMAX"), (std::vector<DxfGroup>{{10, "100"}, {20, "50"}, {30, "0"}}));
  EXPECT_EQ(groups.front(), (DxfGroup{0, "SECTION"}));
  EXPECT_EQ(groups.back(), (DxfGroup{0, "EOF"}));
}

TEST(DxfWriter, LayerTableHoldsLayerZeroAndEveryUsedLayerOnce) {
  Sheet sheet;
  sheet.layerNames[3] = "Walls";
  sheet.layerNames[9] = "Unused but named";
  sheet.strokes.push_back({{0, 0}, {1, 1}, 3, 1, StrokeKind::Edge});
  sheet.strokes.push_back({{0, 0}, {1, 2}, 0, 2, StrokeKind::Edge});
  sheet.labels.push_back({{0, 0}, 2.5, 0.0, "x", 200, 3});
  sheet.strokes.push_back({{0, 0}, {1, 3}, 3, 4, StrokeKind::Edge});
  const auto groups = Groups(sheet);
  EXPECT_EQ(LayerTableNames(groups), (std::vector<std::string>{"0", "Layer 1", "Walls", "Layer 201"}));
  for (const auto& entry : DxfEntries(groups, "LAYER")) {
    EXPECT_EQ(DxfValue(entry, 62), "7");
    EXPECT_EQ(DxfValue(entry, 70), "0");
    EXPECT_EQ(DxfValue(entry, 6), "CONTINUOUS");
  }
  const auto tables = DxfEntries(groups, "TABLE");
  ASSERT_EQ(tables.size(), 4u);
  EXPECT_EQ(tables[1], (std::vector<DxfGroup>{{2, "LAYER"}, {70, "4"}}));
  EXPECT_EQ(DxfEntries(groups, "LTYPE").size(), 1u);
  EXPECT_EQ(DxfValue(DxfEntries(groups, "LTYPE")[0], 2), "CONTINUOUS");
  EXPECT_EQ(DxfValue(DxfEntries(groups, "APPID")[0], 2), "PANDEX");
}

TEST(DxfWriter, ALayerNamedZeroIsTheDrawingsLayerZero) {
  Sheet sheet;
  sheet.layerNames[4] = "0";
  sheet.strokes.push_back({{0, 0}, {1, 1}, 4, 1, StrokeKind::Edge});
  EXPECT_EQ(LayerTableNames(Groups(sheet)), std::vector<std::string>{"0"});
}

TEST(DxfWriter, LinesCarryLayerColourEndsIndexAndKind) {
  Sheet sheet;
  sheet.layerNames[3] = "Walls";
  sheet.strokes.push_back({{1.5, -2.25}, {1234.0625, 0.1}, 3, 5, StrokeKind::Cut});
  sheet.strokes.push_back({{0, 0}, {1, 0}, 0, 0, StrokeKind::Preserved});
  const auto lines = DxfEntries(Groups(sheet), "LINE");
  ASSERT_EQ(lines.size(), 2u);
  EXPECT_EQ(lines[0], (std::vector<DxfGroup>{{8, "Walls"},
                                             {62, "5"},
                                             {10, "1.5"},
                                             {20, "-2.25"},
                                             {30, "0"},
                                             {11, "1234.0625"},
                                             {21, "0.1"},
                                             {31, "0"},
                                             {1001, "PANDEX"},
                                             {1070, "3"},
                                             {1070, "1"}}));
  EXPECT_EQ(DxfValue(lines[1], 8), "Layer 1");
  EXPECT_EQ(DxfValue(lines[1], 62), "0");
  EXPECT_EQ(lines[1].back(), (DxfGroup{1070, "2"}));
}

TEST(DxfWriter, TextsCarryPositionHeightTextAngleAndLayer) {
  Sheet sheet;
  sheet.labels.push_back({{10.0, 20.5}, 3.5, 45.0, "Section A-A", 6, 3});
  const auto texts = DxfEntries(Groups(sheet), "TEXT");
  ASSERT_EQ(texts.size(), 1u);
  EXPECT_EQ(texts[0], (std::vector<DxfGroup>{{8, "Layer 7"},
                                             {62, "3"},
                                             {10, "10"},
                                             {20, "20.5"},
                                             {30, "0"},
                                             {40, "3.5"},
                                             {1, "Section A-A"},
                                             {50, "45"},
                                             {1001, "PANDEX"},
                                             {1070, "6"}}));
}

TEST(DxfWriter, NumbersAreShortestExactDecimalsWithAPointInAnyLocale) {
  // A locale with a decimal comma, where the machine has one; the output must not notice.
  const std::string previous = std::setlocale(LC_ALL, nullptr);
  const std::locale previousGlobal;
  for (const char* name : {"de_DE.UTF-8", "fr_FR.UTF-8", "de_DE"}) {
    if (std::setlocale(LC_ALL, name) == nullptr) continue;
    std::locale::global(std::locale(name));
    break;
  }
  const std::vector<double> values = {0.1, -0.0, 1e-7, 123456789.123456789, -98765.4321, 1e15, 2.0 / 3.0};
  Sheet sheet;
  for (std::size_t i = 0; i + 1 < values.size(); i += 2) {
    sheet.strokes.push_back({{values[i], values[i + 1]}, {values[i + 1], values[i]}, 0, 7, StrokeKind::Edge});
  }
  sheet.strokes.push_back({{values.back(), 0.0}, {0.0, 0.0}, 0, 7, StrokeKind::Edge});
  const auto lines = DxfEntries(Groups(sheet), "LINE");
  std::setlocale(LC_ALL, previous.c_str());
  std::locale::global(previousGlobal);

  EXPECT_EQ(DxfValue(lines[0], 10), "0.1");
  EXPECT_EQ(DxfValue(lines[0], 20), "0");
  EXPECT_EQ(DxfValue(lines[1], 10), "0.0000001");
  EXPECT_EQ(DxfValue(lines[2], 20), "1000000000000000");
  for (std::size_t i = 0; i < values.size(); ++i) {
    const std::string text = DxfValue(lines[i / 2], i % 2 == 0 ? 10 : 20);
    EXPECT_EQ(text.find_first_of(",eE"), std::string::npos) << text;
    double back = 1.0;
    std::from_chars(text.data(), text.data() + text.size(), back);
    EXPECT_EQ(back, values[i]) << text;
  }
}

TEST(DxfWriter, LayerNamesAreCleanedAndKeptApart) {
  const Sheet sheet = draft_output_samples::MakeOddNamesSheet();
  const auto names = wb::draft::DxfLayerNames(sheet);
  EXPECT_EQ(names[0], "a_b_c_d_e_f_g_h_i_j_k_l_m_n_o");
  EXPECT_EQ(names[1], "A_B_C_D_E_F_G_H_I_J_K_L_M_N_O_2");
  EXPECT_EQ(names[2], "Layer 3");
  EXPECT_EQ(names[3], "Walls");
  EXPECT_EQ(names[4], "WALLS_2");
  EXPECT_EQ(names[5], "Doors");
  EXPECT_EQ(names[6], "Wände");
  EXPECT_EQ(names[7], "__");
  EXPECT_EQ(names[8], "tab_here_newline");
  EXPECT_EQ(names[9], std::string(255, 'x'));
  EXPECT_EQ(names[10], "Layer 2");
  EXPECT_EQ(names[11], "Layer 12");
  EXPECT_TRUE(names[12].empty());
  // The file has them in code page 1252, as $DWGCODEPAGE says.
  const auto table = LayerTableNames(Groups(sheet));
  EXPECT_NE(std::find(table.begin(), table.end(), "W\xE4nde"), table.end());
  EXPECT_EQ(table.size(), 13u);
}

TEST(DxfWriter, ClashingNamesStayUniqueAtTheLengthLimit) {
  Sheet sheet;
  sheet.layerNames[0] = std::string(300, 'y');
  sheet.layerNames[1] = std::string(260, 'Y');
  sheet.strokes.push_back({{0, 0}, {1, 1}, 0, 7, StrokeKind::Edge});
  sheet.strokes.push_back({{0, 0}, {1, 1}, 1, 7, StrokeKind::Edge});
  const auto names = wb::draft::DxfLayerNames(sheet);
  EXPECT_EQ(names[0], std::string(255, 'y'));
  EXPECT_EQ(names[1], std::string(253, 'Y') + "_2");
}

TEST(DxfWriter, TextsAreEncodedForTheCodePageOnOneLine) {
  using wb::draft::EncodeDxfText;
  EXPECT_EQ(EncodeDxfText("line one\nline two\r\n"), "line one line two  ");
  EXPECT_EQ(EncodeDxfText("bell\a tab\t"), "bell  tab ");
  EXPECT_EQ(EncodeDxfText("Wände €"), "W\xE4nde \x80");
  EXPECT_EQ(EncodeDxfText("日本"), "\\U+65E5\\U+672C");
  EXPECT_EQ(EncodeDxfText("smile \xF0\x9F\x98\x80"), "smile ?");
  EXPECT_EQ(EncodeDxfText("bad \xC3 byte"), "bad \\U+FFFD byte");
  EXPECT_EQ(EncodeDxfText("100% or %%c or %%%"), "100% or %%%%%%c or %%%%%%%%%");
  EXPECT_EQ(EncodeDxfText("C:\\Users\\me \\u+0041"), "C:\\U+005CUsers\\me \\U+005Cu+0041");
  EXPECT_EQ(EncodeDxfText(""), "");
}

TEST(DxfWriter, AnEmptySheetIsAWholeFile) {
  const auto groups = Groups(Sheet{});
  EXPECT_EQ(LayerTableNames(groups), std::vector<std::string>{"0"});
  EXPECT_TRUE(DxfEntries(groups, "LINE").empty());
  EXPECT_TRUE(DxfEntries(groups, "TEXT").empty());
  EXPECT_EQ(HeaderVariable(groups, "$EXTMAX"), (std::vector<DxfGroup>{{10, "0"}, {20, "0"}, {30, "0"}}));
  std::vector<std::string> sections;
  for (const auto& entry : DxfEntries(groups, "SECTION")) sections.push_back(DxfValue(entry, 2));
  EXPECT_EQ(sections, (std::vector<std::string>{"HEADER", "TABLES", "ENTITIES"}));
  EXPECT_EQ(DxfEntries(groups, "ENDSEC").size(), 3u);
  EXPECT_EQ(groups.back(), (DxfGroup{0, "EOF"}));
}

TEST(DxfWriter, ValuesNoFileCanCarryAreRefusedBeforeAnythingIsWritten) {
  const double nan = std::numeric_limits<double>::quiet_NaN();
  const double infinity = std::numeric_limits<double>::infinity();
  std::vector<Sheet> refused(7);
  refused[0].strokes.push_back({{nan, 0}, {1, 1}, 0, 7, StrokeKind::Edge});
  refused[1].strokes.push_back({{0, 0}, {1, -infinity}, 0, 7, StrokeKind::Edge});
  refused[2].strokes.push_back({{0, 0}, {1.5e15, 1}, 0, 7, StrokeKind::Edge});
  refused[3].labels.push_back({{0, 0}, 0.0, 0.0, "flat", 0, 7});
  refused[4].labels.push_back({{0, 0}, -1.0, 0.0, "upside down", 0, 7});
  refused[5].labels.push_back({{0, 0}, 1.0, nan, "spinning", 0, 7});
  // Each of these characters takes seven bytes as an escape.
  std::string longText;
  for (std::size_t i = 0; i < wb::draft::kMaxDxfLineLength / 7 + 1; ++i) longText += "日";
  refused[6].labels.push_back({{0, 0}, 1.0, 0.0, longText, 0, 7});
  for (std::size_t i = 0; i < refused.size(); ++i) {
    std::ostringstream out;
    EXPECT_THROW(wb::draft::DxfWriter().Write(refused[i], out), std::invalid_argument) << i;
    EXPECT_TRUE(out.str().empty()) << i;
  }
}

}  // namespace
