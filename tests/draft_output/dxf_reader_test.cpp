// Reading DXF back: the writer's files whole, other programs' layers, and damaged or hostile
// files refused with a one-line message that says where, never with a crash or a hang.
#include "workbench/draft/dxf_reader.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <sstream>

#include "tests/draft_output/draft_samples.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/draft/dxf_writer.h"

namespace {

using namespace wb::draft;

std::string Written(const Sheet& sheet) { return draft_output_samples::WrittenBy(DxfWriter(), sheet); }

Sheet Parsed(const std::string& text) {
  std::istringstream in(text);
  return ParseDxfSheet(in, "sample.dxf");
}

// As another program might write it: LF line ends, comments, a block, a layer table.
std::string Handwritten(const std::string& entities, const std::string& tables = "") {
  return "999\nwritten by hand\n0\nSECTION\n2\nHEADER\n9\n$ACADVER\n1\nAC1009\n0\nENDSEC\n0\nSECTION\n2\nTABLES\n0\n"
         "TABLE\n2\nLAYER\n70\n2\n" + tables + "0\nENDTAB\n0\nENDSEC\n0\nSECTION\n2\nBLOCKS\n0\nBLOCK\n2\nB\n0\nENDBLK\n"
         "0\nENDSEC\n0\nSECTION\n2\nENTITIES\n" + entities + "0\nENDSEC\n0\nEOF\n";
}

std::string Line(const std::string& layer, const std::string& more = "") {
  return "0\nLINE\n8\n" + layer + "\n10\n1\n20\n2\n30\n0\n11\n3\n21\n4\n31\n0\n" + more;
}

TEST(DxfReader, WhatTheWriterWroteComesBackTheSame) {
  std::vector<Sheet> sheets = {Sheet{}, draft_output_samples::MakeAllLayersSheet()};
  for (unsigned seed = 1; seed <= 5; ++seed) sheets.push_back(draft_output_samples::MakeSheet(seed, 300, 60, 40));
  for (const Sheet& sheet : sheets) EXPECT_EQ(Parsed(Written(sheet)), sheet);
}

// Layers take the index our data names, else the one their name claims, else the first free.
TEST(DxfReader, LayersOfOtherProgramsFindTheirIndexAndColour) {
  const std::string tables = "0\nLAYER\n2\nWALLS\n70\n0\n62\n-3\n6\nCONTINUOUS\n0\nLAYER\n2\nLayer 5\n62\n6\n";
  const std::string ours = "1001\nOTHERAPP\n1070\n999\n1000\nnote\n1001\nPANDEX\n1070\n9\n1070\n1\n";
  const Sheet sheet = Parsed(Handwritten(Line("Layer 5") + Line("Walls", "62\n256\n") + Line("walls", "62\n0\n") +
                                             Line("Roof", "62\n2\n") + Line("Layer 1") + Line("First", ours) +
                                             Line("Second", "1001\nPANDEX\n1070\n9\n") + Line("First"),
                                         tables));
  ASSERT_EQ(sheet.strokes.size(), 8u);
  const std::vector<std::pair<int, int>> layerAndColor = {{4, 6}, {1, 3}, {1, 0}, {2, 2}, {0, 7}, {9, 7}, {3, 7}, {9, 7}};
  for (std::size_t i = 0; i < layerAndColor.size(); ++i) {
    EXPECT_EQ((std::pair<int, int>{sheet.strokes[i].layer, sheet.strokes[i].color}), layerAndColor[i]) << i;
  }
  EXPECT_EQ(std::vector<std::string>(sheet.layerNames.begin(), sheet.layerNames.begin() + 10),
            (std::vector<std::string>{"", "Walls", "Roof", "Second", "", "", "", "", "", "First"}));
  EXPECT_EQ(sheet.strokes[5].kind, StrokeKind::Cut);
}

// The message of the refusal, checked to name the source and to be one line.
std::string Refusal(const std::string& text, const std::string& source = "sample.dxf") {
  std::istringstream in(text);
  try {
    ParseDxfSheet(in, source);
  } catch (const DxfReadError& error) {
    const std::string message = error.what();
    EXPECT_EQ(message.rfind(source, 0), 0u) << message;
    EXPECT_EQ(message.find('\n'), std::string::npos) << message;
    return message;
  }
  return "read";
}

std::string LineOf(const std::string& text, const std::string& part) {
  const auto at = static_cast<std::ptrdiff_t>(text.find(part));
  return "line " + std::to_string(std::count(text.begin(), text.begin() + at, '\n') + 1);
}

TEST(DxfReader, WhatCannotBeTakenOverWholeIsRefusedWithItsPlace) {
  const std::string huge = Handwritten(Line("A") + "0\nLINE\n8\nA\n10\n1e400\n");
  const std::string circle = Handwritten(Line("A") + "0\nCIRCLE\n8\n0\n10\n0\n20\n0\n40\n5\n");
  std::string manyLayers;
  for (int i = 0; i < 257; ++i) manyLayers += Line("L" + std::to_string(i));
  const std::vector<std::pair<std::string, std::string>> cases = {
      {huge, "sample.dxf, " + LineOf(huge, "1e400") + ": group 10: \"1e400\" is not a number"},
      {circle, LineOf(circle, "CIRCLE") + ": a \"CIRCLE\" entity cannot be read back"},
      {"", "truncated"},
      {Handwritten(Line("A")).substr(0, Handwritten(Line("A")).find("0\nENDSEC\n0\nEOF")), "truncated"},
      {"0\nSECTION\n2\nENTITIES\n0\nLINE\n10\n", "between a group code and its value"},
      {Handwritten("0\nLINE\n8\nA\n21\n-2e15\n"), "is not a number within 1e15"},
      {Handwritten(Line("A", "62\n300\n")), "is not a whole number from 0 to 256"},
      {Handwritten(Line("A", "1001\nPANDEX\n1070\n1\n1070\n5\n")), "the stroke kind 5 is unknown"},
      {Handwritten("0\nTEXT\n8\nA\n10\n0\n20\n0\n1\nno height\n"), "a TEXT without a positive height"},
      {Handwritten(manyLayers), "more than 256 layers"},
      {"0\nSECTION\n2\nHEADER\n9\n$DWGCODEPAGE\n3\nANSI_1251\n0\nENDSEC\n0\nEOF\n", "code page \"ANSI_1251\""},
      {"0\nSECTION\n2\nTABLES\n0\nTABLE\n2\nLAYER\n0\nLAYER\n2\nA\n0\nENDSEC\n0\nEOF\n", "table \"LAYER\" is not closed"},
      {"0\n" + std::string(kMaxDxfLineLength + 2, 'A') + "\n", "a line is longer than 65536 bytes"},
  };
  for (const auto& [text, message] : cases) EXPECT_NE(Refusal(text).find(message), std::string::npos) << message;
  drawing_file_samples::ScratchFolder folder;
  for (const auto& path : {folder / "missing.dxf", folder.Path()}) EXPECT_THROW(ReadDxfSheet(path), DxfReadError);
}

// Each damaged copy is refused or reads as a sheet the writer accepts; most must be refused.
TEST(DxfReader, DamagedCopiesAreRefusedOrReadWhole) {
  const std::string original = Written(draft_output_samples::MakeSheet(5, 40, 12, 6));
  std::vector<std::size_t> lineStarts;
  for (std::size_t at = 0; at < original.size(); at = original.find('\n', at) + 1) lineStarts.push_back(at);
  const std::vector<std::string> values = {"1e400", "-1e400", "nan", "inf", "1e16", "99999999999999999999", "", "  ",
                                           "0x10", "+-1", "-32769", std::string(5000, '9'), "4294967296", "-0",
                                           "1e-400", "256", "2147483648", "\x01\x02"};
  std::mt19937 random(2024);
  const auto below = [&](std::size_t limit) { return std::uniform_int_distribution<std::size_t>(0, limit - 1)(random); };
  int refused = 0;
  for (int i = 0; i < 430; ++i) {
    std::string text = original;
    const std::size_t from = lineStarts[below(lineStarts.size())];
    const std::size_t valueLine = lineStarts[below(lineStarts.size() / 2) * 2 + 1];
    switch (i % 6) {
      case 0: text.resize(below(original.size())); break;
      case 1: text[below(text.size())] = static_cast<char>(below(256)); break;
      case 2: text.replace(valueLine, text.find("\r\n", valueLine) - valueLine, values[below(values.size())]); break;
      case 3: text.erase(from, below(400)); break;
      case 4: text.insert(lineStarts[below(lineStarts.size())], original.substr(from, below(400))); break;
      default:
        text.resize(below(3000));
        for (char& c : text) c = static_cast<char>(below(256));
    }
    if (Refusal(text, "variant " + std::to_string(i)) == "read") {
      Written(Parsed(text));  // what is read, the writer takes again
    } else {
      ++refused;
    }
  }
  EXPECT_GT(refused, 300);
  // Endless lines and deep repetition end too.
  std::string header = "0\nSECTION\n2\nHEADER\n";
  for (int i = 0; i < 50000; ++i) header += "9\n$X\n";
  std::string sections;
  for (int i = 0; i < 20000; ++i) sections += "0\nSECTION\n2\nX\n0\nENDSEC\n";
  EXPECT_NE(Refusal(std::string(kMaxDxfLineLength * 4, '7')), "read");
  EXPECT_NE(Refusal("0\nSECTION\n2\nENTITIES\n" + std::string(kMaxDxfLineLength * 2, ' ') + "\n"), "read");
  EXPECT_NE(Refusal(header), "read");
  EXPECT_EQ(Refusal(sections + "0\nEOF\n"), "read");
}

}  // namespace
