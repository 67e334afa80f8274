// What the writers put in a file, group by group; the audit checks that files are well formed.
#include <gtest/gtest.h>

#include <cmath>
#include <locale>
#include <sstream>

#include "tests/draft_output/draft_samples.h"
#include "workbench/draft/dxf_writer.h"
#include "workbench/draft/svg_writer.h"

namespace {

using namespace wb::draft;

// The DXF file as "code value|" groups; a line without CR LF or a lone code shows as a mismatch.
std::string Groups(const Sheet& sheet) {
  const std::string text = draft_output_samples::WrittenBy(DxfWriter(), sheet);
  std::string groups;
  std::size_t lines = 0;
  for (std::size_t at = 0, end; at < text.size(); at = end + 2, ++lines) {
    end = text.find("\r\n", at);
    if (end == std::string::npos) return groups + "<a line without CR LF>";
    const std::string line = text.substr(at, end - at);
    groups += lines % 2 == 0 ? line.substr(line.find_first_not_of(' ')) + ' ' : line + '|';
  }
  return lines % 2 == 0 ? groups : groups + "<a code without its value>";
}

TEST(DxfWriter, AnEmptySheetIsAWholeReleaseTwelveFile) {
  EXPECT_EQ(Groups(Sheet{}),
            "0 SECTION|2 HEADER|9 $ACADVER|1 AC1009|9 $DWGCODEPAGE|3 ANSI_1252|9 $EXTMIN|10 0|20 0|30 0|9 $EXTMAX|10 0|"
            "20 0|30 0|0 ENDSEC|0 SECTION|2 TABLES|0 TABLE|2 LTYPE|70 1|0 LTYPE|2 CONTINUOUS|70 0|3 Solid line|72 65|"
            "73 0|40 0|0 ENDTAB|0 TABLE|2 LAYER|70 1|0 LAYER|2 0|70 0|62 7|6 CONTINUOUS|0 ENDTAB|0 TABLE|2 STYLE|70 1|"
            "0 STYLE|2 STANDARD|70 0|40 0|41 1|50 0|71 0|42 2.5|3 txt|4 |0 ENDTAB|0 TABLE|2 APPID|70 1|0 APPID|"
            "2 PANDEX|70 0|0 ENDTAB|0 ENDSEC|0 SECTION|2 ENTITIES|0 ENDSEC|0 EOF|");
}

// The used layers only and entities with their layer index and kind; numbers are the shortest
// exact decimals, with a point even where streams are told to write a comma.
TEST(DxfWriter, LayersLinesAndTextsCarryWhatTheReaderNeeds) {
  struct DecimalComma : std::numpunct<char> {
    char do_decimal_point() const override { return ','; }
  };
  Sheet sheet;
  sheet.layerNames[3] = "Walls";
  sheet.layerNames[9] = "Unused but named";
  sheet.strokes.push_back({{1.5, -2.25}, {1234.0625, 0.1}, 3, 5, StrokeKind::Cut});
  sheet.strokes.push_back({{-10, 0}, {1, 50}, 0, 0, StrokeKind::Preserved});
  sheet.strokes.push_back({{1e-7, -0.0}, {123456789.123456789, 2.0 / 3.0}, 0, 7, StrokeKind::Edge});
  sheet.labels.push_back({{10.0, 20.5}, 3.5, 45.0, "Section A-A", 200, 3});
  const std::locale previous = std::locale::global(std::locale(std::locale::classic(), new DecimalComma));
  const std::string groups = Groups(sheet);
  std::locale::global(previous);
  for (const char* part :
       {"9 $EXTMIN|10 -10|20 -2.25|30 0|9 $EXTMAX|10 123456789.12345679|20 50|30 0|0 ENDSEC|",
        "2 LAYER|70 4|0 LAYER|2 0|70 0|62 7|6 CONTINUOUS|0 LAYER|2 Layer 1|70 0|62 7|6 CONTINUOUS|0 LAYER|2 Walls|"
        "70 0|62 7|6 CONTINUOUS|0 LAYER|2 Layer 201|70 0|62 7|6 CONTINUOUS|0 ENDTAB|",
        "0 LINE|8 Walls|62 5|10 1.5|20 -2.25|30 0|11 1234.0625|21 0.1|31 0|1001 PANDEX|1070 3|1070 1|",
        "0 LINE|8 Layer 1|62 0|10 -10|20 0|30 0|11 1|21 50|31 0|1001 PANDEX|1070 0|1070 2|",
        "0 LINE|8 Layer 1|62 7|10 0.0000001|20 0|30 0|11 123456789.12345679|21 0.6666666666666666|31 0|",
        "0 TEXT|8 Layer 201|62 3|10 10|20 20.5|30 0|40 3.5|1 Section A-A|50 45|1001 PANDEX|1070 200|0 ENDSEC|"}) {
    EXPECT_NE(groups.find(part), std::string::npos) << part << "\nin " << groups;
  }
}

TEST(DxfWriter, NamesAndTextsAreCleanedAndEncodedForTheCodePage) {
  const Sheet odd = draft_output_samples::MakeOddNamesSheet();
  const auto names = DxfLayerNames(odd);
  EXPECT_EQ(std::vector<std::string>(names.begin(), names.begin() + 13),
            (std::vector<std::string>{"a_b_c_d_e_f_g_h_i_j_k_l_m_n_o", "A_B_C_D_E_F_G_H_I_J_K_L_M_N_O_2", "Layer 3",
                                      "Walls", "WALLS_2", "Doors", "Wände", "__", "tab_here_newline",
                                      std::string(255, 'x'), "Layer 2", "Layer 12", ""}));
  EXPECT_NE(Groups(odd).find("|0 LAYER|2 W\xE4nde|"), std::string::npos);
  const std::vector<std::pair<std::string, std::string>> texts = {
      {"line one\nline two\r\n", "line one line two  "}, {"bell\a tab\t", "bell  tab "},
      {"Wände €", "W\xE4nde \x80"}, {"日本", "\\U+65E5\\U+672C"}, {"smile \xF0\x9F\x98\x80", "smile ?"},
      {"bad \xC3 byte", "bad \\U+FFFD byte"}, {"100% or %%c or %%%", "100% or %%%%%%c or %%%%%%%%%"},
      {"C:\\Users\\me \\u+0041", "C:\\U+005CUsers\\me \\U+005Cu+0041"}};
  for (const auto& [text, encoded] : texts) EXPECT_EQ(EncodeDxfText(text), encoded);
}

TEST(SheetWriters, ValuesNoFileCanCarryAreRefusedBeforeAnythingIsWritten) {
  const double nan = std::nan("");
  const auto stroke = [](Point2 a, Point2 b) { return Sheet{{{a, b, 0, 7, StrokeKind::Edge}}, {}, {}}; };
  const auto label = [](double height, double angle, std::string text) {
    return Sheet{{}, {{{0, 0}, height, angle, std::move(text), 0, 7}}, {}};
  };
  // Each of these characters takes seven bytes as an escape: too long for a DXF line only.
  std::string longText;
  for (std::size_t i = 0; i < kMaxDxfLineLength / 7 + 1; ++i) longText += "日";
  const std::vector<Sheet> refused = {stroke({nan, 0}, {1, 1}), stroke({0, 0}, {1, -HUGE_VAL}), stroke({0, 0}, {1.5e15, 1}),
                                      label(0, 0, "flat"), label(-1, 0, "upside down"), label(1, nan, "spinning"),
                                      label(1, 0, longText)};
  const DxfWriter dxf;
  const SvgWriter svg;
  for (std::size_t i = 0; i < refused.size(); ++i) {
    for (const SheetWriter* writer : {static_cast<const SheetWriter*>(&dxf), static_cast<const SheetWriter*>(&svg)}) {
      if (writer == &svg && i + 1 == refused.size()) continue;  // a picture has no line length limit
      std::ostringstream out;
      EXPECT_THROW(writer->Write(refused[i], out), std::invalid_argument) << i;
      EXPECT_TRUE(out.str().empty()) << i;
    }
  }
}

}  // namespace
