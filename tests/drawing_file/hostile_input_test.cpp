// Damaged copies of a real drawing file never crash or hang the opener: each one is refused with
// a DrawingFileError or opens as a drawing that saves and opens again unchanged.
#include <gtest/gtest.h>

#include <functional>
#include <random>

#include "tests/drawing_file/sample_drawings.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/drawing_file.h"

namespace {

using drawing_file_samples::ReadBytes;
using drawing_file_samples::ScratchFolder;
using drawing_file_samples::WriteBytes;
using Bytes = std::vector<std::uint8_t>;

class DrawingFileHostileInput : public ::testing::Test {
 protected:
  void SetUp() override {
    wb::SaveDrawingFile(drawing_file_samples::MakeBulkDrawing(700, 3), folder_ / "original.pdx");
    original_ = ReadBytes(folder_ / "original.pdx");
  }

  // Opens one variant and counts the outcome.
  void Try(const Bytes& bytes, const std::string& variant) {
    const std::filesystem::path file = folder_ / "variant.pdx";
    WriteBytes(file, bytes);
    try {
      const wb::Drawing opened = wb::OpenDrawingFile(file);
      wb::SaveDrawingFile(opened, folder_ / "resaved.pdx");
      EXPECT_EQ(wb::OpenDrawingFile(folder_ / "resaved.pdx"), opened) << variant;
      ++opened_;
    } catch (const wb::DrawingFileError& error) {
      EXPECT_EQ(std::string(error.what()).find('\n'), std::string::npos) << variant;
      ++refused_;
    } catch (const std::exception& error) {
      ADD_FAILURE() << variant << " threw " << error.what();
    }
  }

  std::size_t Offset(std::size_t below) { return std::uniform_int_distribution<std::size_t>(0, below - 1)(random_); }
  std::uint8_t NonZeroByte() { return static_cast<std::uint8_t>(std::uniform_int_distribution<int>(1, 255)(random_)); }

  ScratchFolder folder_;
  Bytes original_;
  std::mt19937 random_{7};
  int opened_ = 0;
  int refused_ = 0;
};

TEST_F(DrawingFileHostileInput, DamagedCopiesAreRefusedOrOpenWhole) {
  ASSERT_GT(original_.size(), 8U * 4096U);
  int variants = 0;
  for (int i = 0; i < 400; ++i, ++variants) {
    Bytes bytes = original_;
    const std::size_t at = Offset(bytes.size());
    bytes[at] ^= NonZeroByte();
    Try(bytes, "byte " + std::to_string(at) + " flipped");
  }
  for (int i = 0; i < 250; ++i, ++variants) {
    Bytes bytes = original_;
    const int flips = std::uniform_int_distribution<int>(2, 24)(random_);
    for (int flip = 0; flip < flips; ++flip) bytes[Offset(bytes.size())] ^= NonZeroByte();
    Try(bytes, "multiple flips, round " + std::to_string(i));
  }
  for (int i = 0; i < 200; ++i, ++variants) {
    // Every length class: inside the header, at and around page boundaries, anywhere.
    const std::size_t length = i < 40 ? static_cast<std::size_t>(i) * 3
                               : i < 80 ? (static_cast<std::size_t>(i - 40) % 10 + 1) * 4096 + (i % 3) - 1
                                        : Offset(original_.size());
    Try(Bytes(original_.begin(), original_.begin() + static_cast<std::ptrdiff_t>(length)),
        "cut to " + std::to_string(length) + " bytes");
  }
  for (int i = 0; i < 250; ++i, ++variants) {
    // The first page: the SQLite header, then the schema every read starts from.
    Bytes bytes = original_;
    const std::size_t span = i < 100 ? 100 : 4096;
    const int flips = 1 + i % 4;
    for (int flip = 0; flip < flips; ++flip) bytes[Offset(span)] ^= NonZeroByte();
    Try(bytes, "first page damaged, round " + std::to_string(i));
  }
  EXPECT_GE(variants, 1000);
  EXPECT_EQ(opened_ + refused_, variants);
  // Both outcomes occur, or the variants would not be testing what they claim to.
  EXPECT_GT(opened_, 50);
  EXPECT_GT(refused_, 50);
  RecordProperty("Opened", opened_);
  RecordProperty("Refused", refused_);
}

}  // namespace
