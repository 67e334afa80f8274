// Reading DXF back: what the writer wrote comes back as the same sheet, files written by hand
// or by other programs get sensible layers and colours, and what cannot be taken over whole is
// refused with a message that says where.
#include "workbench/draft/dxf_reader.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <sstream>

#include "tests/draft_output/draft_samples.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/draft/dxf_writer.h"

namespace {

using wb::draft::DxfReadError;
using wb::draft::Sheet;
using wb::draft::StrokeKind;

std::string Written(const Sheet& sheet) { return draft_output_samples::WrittenBy(wb::draft::DxfWriter(), sheet); }

Sheet Parsed(const std::string& text) {
  std::istringstream in(text);
  return wb::draft::ParseDxfSheet(in, "sample.dxf");
}

// The message of the refusal, or a failure when the text is read.
std::string Refusal(const std::string& text) {
  try {
    Parsed(text);
  } catch (const DxfReadError& error) {
    return error.what();
  }
  ADD_FAILURE() << "read without complaint:\n" << text.substr(0, 400);
  return {};
}

// A file as another program might write it: LF line ends, no extended data, only what the
// entities need, with a layer table giving colours.
std::string Handwritten(const std::string& entities, const std::string& tables = "") {
  return "0\nSECTION\n2\nHEADER\n9\n$ACADVER\n1\nAC1009\n0\nENDSEC\n"
         "0\nSECTION\n2\nTABLES\n0\nTABLE\n2\nLAYER\n70\n2\n" +
         tables + "0\nENDTAB\n0\nENDSEC\n0\nSECTION\n2\nENTITIES\n" + entities + "0\nENDSEC\n0\nEOF\n";
}

std::string Line(const std::string& layer, const std::string& more = "") {
  return "0\nLINE\n8\n" + layer + "\n10\n1\n20\n2\n30\n0\n11\n3\n21\n4\n31\n0\n" + more;
}

TEST(DxfReader, WhatTheWriterWroteComesBackTheSame) {
  for (unsigned seed = 1; seed <= 5; ++seed) {
    const Sheet sheet = draft_output_samples::MakeSheet(seed, 300, 60, 40);
    EXPECT_EQ(Parsed(Written(sheet)), sheet) << "seed " << seed;
  }
  EXPECT_EQ(Parsed(Written(Sheet{})), Sheet{});
  const Sheet all = draft_output_samples::MakeAllLayersSheet();
  EXPECT_EQ(Parsed(Written(all)), all);
}

TEST(DxfReader, OddNamesComeBackAsTheFileShowsThem) {
  const Sheet sheet = draft_output_samples::MakeOddNamesSheet();
  const Sheet back = Parsed(Written(sheet));
  const auto written = wb::draft::DxfLayerNames(sheet);
  for (int i = 0; i < 12; ++i) {
    const auto slot = static_cast<std::size_t>(i);
    const std::string expected = written[slot] == wb::draft::DefaultLayerName(i) ? "" : written[slot];
    EXPECT_EQ(back.layerNames[slot], expected) << i;
  }
  EXPECT_EQ(back.strokes, sheet.strokes);
  EXPECT_EQ(back.layerNames[10], "Layer 2");  // not the default name of index 10
  EXPECT_EQ(back.layerNames[6], "Wände");
}

TEST(DxfReader, OddTextsComeBackWithBlanksForControlCharacters) {
  Sheet sheet;
  for (const std::string& text : draft_output_samples::OddTexts()) sheet.labels.push_back({{0, 0}, 1.0, 0.0, text, 0, 7});
  const Sheet back = Parsed(Written(sheet));
  std::vector<std::string> texts;
  for (const auto& label : back.labels) texts.push_back(label.text);
  EXPECT_EQ(texts, (std::vector<std::string>{"line one line two  ", "bell  tab  del ", "quotes \" ' and <tags> & amps",
                                             "mixed Wände 日本 €", "emoji ? here", "broken \xEF\xBF\xBD utf-8 \xEF\xBF\xBD",
                                             "%%c%%d 100%", "back\\slash \\U+0041 \\u+0042", "",
                                             "   leading and trailing   "}));
}

TEST(DxfReader, LayersWithoutIndicesTakeTheirNumberOrTheFirstFreeOne) {
  const std::string tables = "0\nLAYER\n2\nWALLS\n70\n0\n62\n-3\n6\nCONTINUOUS\n0\nLAYER\n2\nLayer 5\n62\n6\n";
  const Sheet sheet = Parsed(Handwritten(Line("Layer 5") + Line("Walls", "62\n256\n") + Line("walls", "62\n0\n") +
                                             Line("Roof", "62\n2\n") + Line("Layer 1"),
                                         tables));
  ASSERT_EQ(sheet.strokes.size(), 5u);
  EXPECT_EQ(sheet.strokes[0].layer, 4);
  EXPECT_EQ(sheet.strokes[1].layer, 1);  // "Layer 1" claims index 0 by its name
  EXPECT_EQ(sheet.strokes[2].layer, 1);  // the same layer: names compare without case
  EXPECT_EQ(sheet.strokes[3].layer, 2);
  EXPECT_EQ(sheet.strokes[4].layer, 0);
  EXPECT_EQ(sheet.layerNames[1], "Walls");
  EXPECT_EQ(sheet.layerNames[2], "Roof");
  EXPECT_EQ(sheet.layerNames[4], "");
  EXPECT_EQ(sheet.layerNames[0], "");
  // By layer: the layer's colour, whether the colour is missing or 256; off layers count too.
  EXPECT_EQ(sheet.strokes[0].color, 6);
  EXPECT_EQ(sheet.strokes[1].color, 3);
  EXPECT_EQ(sheet.strokes[2].color, 0);
  EXPECT_EQ(sheet.strokes[3].color, 2);
  EXPECT_EQ(sheet.strokes[4].color, 7);
  EXPECT_EQ(sheet.strokes[0].a, (wb::draft::Point2{1, 2}));
  EXPECT_EQ(sheet.strokes[0].b, (wb::draft::Point2{3, 4}));
  EXPECT_EQ(sheet.strokes[0].kind, StrokeKind::Edge);
}

TEST(DxfReader, AnIndexTwoLayersClaimGoesToTheFirst) {
  const std::string ours = "1001\nPANDEX\n1070\n2\n1070\n1\n";
  const Sheet sheet = Parsed(Handwritten(Line("First", ours) + Line("Second", ours) + Line("First")));
  EXPECT_EQ(sheet.strokes[0].layer, 2);
  EXPECT_EQ(sheet.strokes[1].layer, 0);
  EXPECT_EQ(sheet.strokes[2].layer, 2);
  EXPECT_EQ(sheet.strokes[1].kind, StrokeKind::Cut);
  EXPECT_EQ(sheet.layerNames[2], "First");
  EXPECT_EQ(sheet.layerNames[0], "Second");
}

TEST(DxfReader, OtherApplicationsDataCommentsAndOtherSectionsArePassedOver) {
  const std::string entities = Line("A", "1001\nOTHERAPP\n1070\n999\n1000\nnote\n1001\nPANDEX\n1070\n7\n");
  std::string text = Handwritten(entities);
  text.insert(0, "999\nwritten by hand\n");
  text.insert(text.find("0\nSECTION\n2\nENTITIES"), "0\nSECTION\n2\nBLOCKS\n0\nBLOCK\n2\nB\n0\nENDBLK\n0\nENDSEC\n");
  const Sheet sheet = Parsed(text);
  ASSERT_EQ(sheet.strokes.size(), 1u);
  EXPECT_EQ(sheet.strokes[0].layer, 7);
}

// The line a text first appears on, as the reader counts lines.
std::string LineOf(const std::string& text, const std::string& part) {
  const std::size_t at = text.find(part);
  return "line " + std::to_string(std::count(text.begin(), text.begin() + static_cast<std::ptrdiff_t>(at), '\n') + 1);
}

TEST(DxfReader, WhatCannotBeTakenOverWholeIsRefusedWithItsPlace) {
  const std::string huge = Handwritten(Line("A") + "0\nLINE\n8\nA\n10\n1e400\n");
  EXPECT_NE(Refusal(huge).find("sample.dxf, " + LineOf(huge, "1e400") + ": group 10: \"1e400\" is not a number"),
            std::string::npos)
      << Refusal(huge);
  const std::string circle = Handwritten(Line("A") + "0\nCIRCLE\n8\n0\n10\n0\n20\n0\n40\n5\n");
  EXPECT_NE(Refusal(circle).find(LineOf(circle, "CIRCLE") + ": a \"CIRCLE\" entity cannot be read back"),
            std::string::npos)
      << Refusal(circle);

  std::string manyLayers;
  for (int i = 0; i < 257; ++i) manyLayers += Line("L" + std::to_string(i));
  const std::string codePage =
      "0\nSECTION\n2\nHEADER\n9\n$DWGCODEPAGE\n3\nANSI_1251\n0\nENDSEC\n0\nSECTION\n2\nENTITIES\n0\nENDSEC\n0\nEOF\n";
  const std::vector<std::pair<std::string, std::string>> cases = {
      {"", "truncated"},
      {Handwritten(Line("A")).substr(0, Handwritten(Line("A")).find("0\nENDSEC\n0\nEOF")), "truncated"},
      {"0\nSECTION\n2\nENTITIES\n0\nLINE\n10\n", "between a group code and its value"},
      {"abc\nSECTION\n", "expected a group code, found \"abc\""},
      {"2000\nSECTION\n", "expected a group code"},
      {"\x7f\x45LF\x02\x01\x01\n\n", "expected a group code"},
      {"0\nLINE\n0\nEOF\n", "expected a section"},
      {Handwritten("0\nLINE\n8\nA\n10\nnan\n"), "is not a number within 1e15"},
      {Handwritten("0\nLINE\n8\nA\n21\n-2e15\n"), "is not a number within 1e15"},
      {Handwritten("0\nLINE\n8\nA\n11\n12abc\n"), "is not a number within 1e15"},
      {Handwritten("0\nLINE\n8\nA\n11\n\n"), "is not a number within 1e15"},
      {Handwritten(Line("A", "62\n300\n")), "is not a whole number from 0 to 256"},
      {Handwritten(Line("A", "62\n-1\n")), "is not a whole number from 0 to 256"},
      {Handwritten(Line("A", "1001\nPANDEX\n1070\n300\n")), "the layer index 300 is out of range"},
      {Handwritten(Line("A", "1001\nPANDEX\n1070\n1\n1070\n5\n")), "the stroke kind 5 is unknown"},
      {Handwritten(Line("A", "67\n1\n")), "paper space"},
      {Handwritten("0\nTEXT\n8\nA\n10\n0\n20\n0\n1\nno height\n"), "a TEXT without a positive height"},
      {Handwritten("0\nTEXT\n8\nA\n40\n0\n1\nflat\n"), "a TEXT without a positive height"},
      {Handwritten(manyLayers), "more than 256 layers"},
      {codePage, "code page \"ANSI_1251\""},
      {"0\nSECTION\n2\nTABLES\n0\nTABLE\n2\nLAYER\n0\nLAYER\n2\nA\n0\nENDSEC\n0\nEOF\n", "table \"LAYER\" is not closed"},
      {"0\nSECTION\n2\nTABLES\n0\nTABLE\n2\nLAYER\n0\nLAYER\n70\n0\n0\nENDTAB\n0\nENDSEC\n0\nEOF\n", "a layer without a name"},
      {"0\nSECTION\n2\nBLOCKS\n0\nBLOCK\n0\nEOF\n", "section \"BLOCKS\" is not closed"},
      {"0\nSECTION\n2\nENTITIES\n0\nSECTION\n2\nX\n0\nENDSEC\n0\nEOF\n", "the ENTITIES section is not closed"},
      {"0\nSECTION\n2\nHEADER\n9\n$ACADVER\n0\nEOF\n", "the HEADER section is not closed"},
      {"0\n" + std::string(wb::draft::kMaxDxfLineLength + 2, 'A') + "\n", "a line is longer than 65536 bytes"},
  };
  for (const auto& [text, message] : cases) {
    const std::string refusal = Refusal(text);
    EXPECT_EQ(refusal.rfind("sample.dxf, line ", 0) == 0 || refusal.rfind("sample.dxf: ", 0) == 0, true) << refusal;
    EXPECT_NE(refusal.find(message), std::string::npos) << refusal << "\nexpected: " << message;
  }
}

TEST(DxfReader, FilesThatAreNotThereOrNotFilesAreRefused) {
  drawing_file_samples::ScratchFolder folder;
  for (const auto& path : {folder / "missing.dxf", folder.Path()}) {
    try {
      wb::draft::ReadDxfSheet(path);
      ADD_FAILURE() << path << " was read";
    } catch (const DxfReadError& error) {
      EXPECT_NE(std::string(error.what()).find(path.string() + ": cannot be read"), std::string::npos) << error.what();
    }
  }
}

}  // namespace
