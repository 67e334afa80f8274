// Damaged and hostile DXF text never crashes or hangs the reader: each variant is refused with
// a DxfReadError on one line, or reads as a sheet the writers accept again.
#include <gtest/gtest.h>

#include <random>
#include <sstream>

#include "tests/draft_output/draft_samples.h"
#include "workbench/draft/dxf_reader.h"
#include "workbench/draft/dxf_writer.h"

namespace {

using wb::draft::DxfReadError;
using wb::draft::Sheet;

class DxfHostileInput : public ::testing::Test {
 protected:
  void SetUp() override {
    original_ = draft_output_samples::WrittenBy(wb::draft::DxfWriter(), draft_output_samples::MakeSheet(5, 40, 12, 6));
    for (std::size_t at = 0; at < original_.size(); at = original_.find('\n', at) + 1) lineStarts_.push_back(at);
  }

  void Try(const std::string& text, const std::string& variant) {
    std::istringstream in(text);
    try {
      const Sheet sheet = wb::draft::ParseDxfSheet(in, "variant.dxf");
      draft_output_samples::WrittenBy(wb::draft::DxfWriter(), sheet);
      ++read_;
    } catch (const DxfReadError& error) {
      const std::string message = error.what();
      EXPECT_EQ(message.rfind("variant.dxf", 0), 0u) << variant << ": " << message;
      EXPECT_EQ(message.find('\n'), std::string::npos) << variant;
      ++refused_;
    } catch (const std::exception& error) {
      ADD_FAILURE() << variant << " threw " << error.what();
    }
  }

  std::size_t Below(std::size_t limit) { return std::uniform_int_distribution<std::size_t>(0, limit - 1)(random_); }

  // The text with the line at `line` (a value line when odd) replaced.
  std::string WithLine(std::size_t line, const std::string& replacement) const {
    const std::size_t start = lineStarts_[line];
    const std::size_t end = original_.find("\r\n", start);
    return original_.substr(0, start) + replacement + original_.substr(end);
  }

  std::string original_;
  std::vector<std::size_t> lineStarts_;
  std::mt19937 random_{2024};
  int read_ = 0;
  int refused_ = 0;
};

TEST_F(DxfHostileInput, DamagedCopiesAreRefusedOrReadWhole) {
  for (int i = 0; i < 100; ++i) Try(original_.substr(0, Below(original_.size())), "truncated " + std::to_string(i));
  for (int i = 0; i < 100; ++i) {
    std::string text = original_;
    for (int k = 0; k < 3; ++k) text[Below(text.size())] = static_cast<char>(Below(256));
    Try(text, "bytes changed " + std::to_string(i));
  }
  const std::vector<std::string> values = {"1e400",    "-1e400", "nan",  "inf", "1e16",          "99999999999999999999",
                                           "",         "  ",     "0x10", "+-1", "-32769",        std::string(5000, '9'),
                                           "4294967296", "-0",   "1e-400", "256", "2147483648", "\x01\x02"};
  for (int i = 0; i < 150; ++i) {
    const std::size_t line = Below(lineStarts_.size() / 2) * 2 + 1;
    const std::string& value = values[Below(values.size())];
    Try(WithLine(line, value), "line " + std::to_string(line + 1) + " as " + value.substr(0, 20));
  }
  for (int i = 0; i < 50; ++i) {
    std::string text = original_;
    const std::size_t from = lineStarts_[Below(lineStarts_.size())];
    const std::size_t length = Below(400);
    if (i % 2 == 0) {
      text.erase(from, length);
    } else {
      text.insert(lineStarts_[Below(lineStarts_.size())], original_.substr(from, length));
    }
    Try(text, "lines moved " + std::to_string(i));
  }
  for (int i = 0; i < 30; ++i) {
    std::string noise(Below(3000), '\0');
    for (char& c : noise) c = static_cast<char>(Below(256));
    Try(noise, "noise " + std::to_string(i));
  }
  EXPECT_EQ(read_ + refused_, 430);
  // Most damage must be noticed; a reader that accepts everything is no reader.
  EXPECT_GT(refused_, 300);
}

TEST_F(DxfHostileInput, EndlessLinesAndDeepRepetitionEnd) {
  Try(std::string(wb::draft::kMaxDxfLineLength * 4, '7'), "one endless line");
  Try("0\nSECTION\n2\nENTITIES\n" + std::string(wb::draft::kMaxDxfLineLength * 2, ' ') + "\n", "endless blanks");
  std::string repeated = "0\nSECTION\n2\nHEADER\n";
  for (int i = 0; i < 50000; ++i) repeated += "9\n$X\n";
  Try(repeated, "a header that never ends");
  std::string sections;
  for (int i = 0; i < 20000; ++i) sections += "0\nSECTION\n2\nX\n0\nENDSEC\n";
  Try(sections + "0\nEOF\n", "many empty sections");
  EXPECT_EQ(refused_, 3);
  EXPECT_EQ(read_, 1);
}

}  // namespace
