// The files of a 2D target: both written whole, merged or replaced as asked, and a failed
// generation that leaves the old files exactly as they were with nothing beside them.
#include "workbench/draft/sheet_files.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <fstream>
#include <limits>

#include "tests/draft_output/draft_samples.h"
#include "tests/draft_output/locking_child.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/draft/dxf_reader.h"
#include "workbench/draft/dxf_writer.h"

namespace {

using drawing_file_samples::ReadBytes;
using drawing_file_samples::ScratchFolder;
using wb::draft::MergeSheets;
using wb::draft::ReadDxfSheet;
using wb::draft::Sheet;
using wb::draft::SheetFileError;
using wb::draft::StrokeKind;
using wb::draft::WriteSheetFiles;

Sheet OneStroke(std::uint8_t layer, const std::string& name, double y) {
  Sheet sheet;
  sheet.layerNames[layer] = name;
  sheet.strokes.push_back({{0.0, y}, {10.0, y}, layer, 1, StrokeKind::Edge});
  return sheet;
}

class SheetFiles : public ::testing::Test {
 protected:
  // The message of the refusal; a failure when the write goes through.
  std::string Refusal(const Sheet& sheet, const std::filesystem::path& target, bool overwrite) {
    try {
      WriteSheetFiles(sheet, target, overwrite);
    } catch (const SheetFileError& error) {
      return error.what();
    }
    ADD_FAILURE() << "writing " << target << " did not fail";
    return {};
  }

  void ExpectOldFilesUntouched() {
    EXPECT_EQ(ReadBytes(folder_ / "plan.dxf"), oldDxf_);
    EXPECT_EQ(ReadBytes(folder_ / "plan.svg"), oldSvg_);
  }

  void WriteOldFiles() {
    WriteSheetFiles(first_, target_, true);
    oldDxf_ = ReadBytes(folder_ / "plan.dxf");
    oldSvg_ = ReadBytes(folder_ / "plan.svg");
  }

  ScratchFolder folder_;
  const std::filesystem::path target_ = folder_ / "plan";
  const Sheet first_ = draft_output_samples::MakeSheet(1, 100, 10, 8);
  const Sheet second_ = draft_output_samples::MakeSheet(2, 60, 5, 12);
  std::vector<std::uint8_t> oldDxf_;
  std::vector<std::uint8_t> oldSvg_;
};

TEST_F(SheetFiles, TheDrawingAndItsPreviewAreWrittenBesideEachOther) {
  WriteSheetFiles(first_, target_, false);
  EXPECT_EQ(folder_.Names(), (std::vector<std::string>{"plan.dxf", "plan.svg"}));
  EXPECT_EQ(ReadDxfSheet(folder_ / "plan.dxf"), first_);
  const auto svg = ReadBytes(folder_ / "plan.svg");
  EXPECT_EQ(std::string(svg.begin(), svg.begin() + 5), "<?xml");
  EXPECT_EQ(wb::draft::DxfPathOf(folder_ / "a.b"), folder_ / "a.b.dxf");
  EXPECT_EQ(wb::draft::SvgPathOf(folder_ / "a.b"), folder_ / "a.b.svg");
}

TEST_F(SheetFiles, OverwriteReplacesTheOldDrawing) {
  WriteOldFiles();
  WriteSheetFiles(second_, target_, true);
  EXPECT_EQ(ReadDxfSheet(folder_ / "plan.dxf"), second_);
  EXPECT_NE(ReadBytes(folder_ / "plan.svg"), oldSvg_);
  EXPECT_EQ(folder_.Names(), (std::vector<std::string>{"plan.dxf", "plan.svg"}));
}

TEST_F(SheetFiles, WithoutOverwriteTheNewDrawingIsAddedToTheOld) {
  WriteOldFiles();
  WriteSheetFiles(second_, target_, false);
  const Sheet merged = ReadDxfSheet(folder_ / "plan.dxf");
  EXPECT_EQ(merged, MergeSheets(first_, second_));
  ASSERT_EQ(merged.strokes.size(), first_.strokes.size() + second_.strokes.size());
  EXPECT_TRUE(std::equal(first_.strokes.begin(), first_.strokes.end(), merged.strokes.begin()));
  EXPECT_EQ(merged.labels.size(), first_.labels.size() + second_.labels.size());
  // A third generation appends again, to what the second left.
  WriteSheetFiles(OneStroke(0, "Level 0 Ä", 1.0), target_, false);
  EXPECT_EQ(ReadDxfSheet(folder_ / "plan.dxf").strokes.size(), merged.strokes.size() + 1);
  EXPECT_EQ(folder_.Names(), (std::vector<std::string>{"plan.dxf", "plan.svg"}));
}

TEST(MergeSheets, LayersMeetByTheNameTheFileShows) {
  Sheet existing = OneStroke(2, "Walls", 0.0);
  existing.strokes.push_back({{0, 1}, {1, 1}, 0, 3, StrokeKind::Cut});
  Sheet added = OneStroke(5, "WALLS", 1.0);
  added.layerNames[2] = "Doors";
  added.strokes.push_back({{0, 2}, {1, 2}, 2, 4, StrokeKind::Edge});
  added.layerNames[7] = "Roof";
  added.labels.push_back({{0, 3}, 1.0, 0.0, "roof", 7, 5});
  added.strokes.push_back({{0, 4}, {1, 4}, 0, 6, StrokeKind::Edge});  // unnamed: "Layer 1"

  const Sheet merged = MergeSheets(existing, added);
  ASSERT_EQ(merged.strokes.size(), 5u);
  EXPECT_EQ(merged.strokes[2].layer, 2);  // "WALLS" is "Walls"
  EXPECT_EQ(merged.strokes[3].layer, 1);  // "Doors" finds index 2 taken, takes the first free
  EXPECT_EQ(merged.strokes[4].layer, 0);  // "Layer 1" is the existing unnamed layer 0
  EXPECT_EQ(merged.labels.at(0).layer, 7);
  EXPECT_EQ(merged.layerNames[2], "Walls");
  EXPECT_EQ(merged.layerNames[1], "Doors");
  EXPECT_EQ(merged.layerNames[7], "Roof");
  EXPECT_EQ(merged.layerNames[0], "");
  EXPECT_EQ(merged.layerNames[5], "");
  EXPECT_EQ(merged.strokes[3].color, 4);
  EXPECT_EQ(merged.labels[0].text, "roof");
}

TEST(MergeSheets, AnUnnamedLayerThatMovesKeepsItsName) {
  const Sheet merged = MergeSheets(OneStroke(2, "Walls", 0.0), OneStroke(2, "", 1.0));
  EXPECT_EQ(merged.strokes[1].layer, 0);
  EXPECT_EQ(merged.layerNames[0], "Layer 3");
  EXPECT_EQ(wb::draft::DxfLayerNames(merged)[0], "Layer 3");
}

TEST(MergeSheets, MoreThan256LayersAreRefused) {
  const Sheet all = draft_output_samples::MakeAllLayersSheet();
  EXPECT_EQ(MergeSheets(all, OneStroke(9, "", 0.0)).strokes.back().layer, 9);
  EXPECT_THROW(MergeSheets(all, OneStroke(9, "One too many", 0.0)), SheetFileError);
}

TEST_F(SheetFiles, AValueNoFileCanCarryLeavesTheOldFiles) {
  WriteOldFiles();
  Sheet broken = second_;
  broken.strokes[7].b.y = std::numeric_limits<double>::quiet_NaN();
  for (const bool overwrite : {true, false}) {
    EXPECT_NE(Refusal(broken, target_, overwrite).find("has a coordinate that is not a finite number"), std::string::npos);
  }
  ExpectOldFilesUntouched();
  EXPECT_EQ(folder_.Names(), (std::vector<std::string>{"plan.dxf", "plan.svg"}));
}

TEST_F(SheetFiles, AFailingRenameLeavesBothOldFilesAndNoTemporary) {
  WriteOldFiles();
  std::filesystem::remove(folder_ / "plan.svg");
  std::filesystem::create_directory(folder_ / "plan.svg");
  std::ofstream(folder_ / "plan.svg" / "inside") << "keeps the folder from being empty";
  EXPECT_NE(Refusal(second_, target_, true).find("cannot replace " + (folder_ / "plan.svg").string()),
            std::string::npos);
  EXPECT_EQ(ReadBytes(folder_ / "plan.dxf"), oldDxf_);
  EXPECT_EQ(folder_.Names(), (std::vector<std::string>{"plan.dxf", "plan.svg"}));
}

TEST_F(SheetFiles, AFolderThatIsMissingOrAFileIsReported) {
  std::ofstream(folder_ / "notes") << "a file, not a folder";
  EXPECT_NE(Refusal(first_, folder_ / "notes" / "plan", true).find("cannot write " + (folder_ / "notes" / "plan.dxf").string()),
            std::string::npos);
  EXPECT_NE(Refusal(first_, folder_ / "missing" / "plan", false).find("No such file or directory"), std::string::npos);
  EXPECT_EQ(folder_.Names(), std::vector<std::string>{"notes"});
}

TEST_F(SheetFiles, AnOldDrawingThatCannotBeReadIsNotMergedInto) {
  WriteOldFiles();
  const std::string damaged = std::string(oldDxf_.begin(), oldDxf_.end() - 20);
  drawing_file_samples::WriteBytes(folder_ / "plan.dxf", {damaged.begin(), damaged.end()});
  oldDxf_ = ReadBytes(folder_ / "plan.dxf");
  const std::string refusal = Refusal(second_, target_, false);
  EXPECT_EQ(refusal.rfind("cannot merge into " + (folder_ / "plan.dxf").string() + ", line ", 0), 0u) << refusal;
  ExpectOldFilesUntouched();
  // Overwriting does not need the old drawing.
  WriteSheetFiles(second_, target_, true);
  EXPECT_EQ(ReadDxfSheet(folder_ / "plan.dxf"), second_);
}

TEST_F(SheetFiles, ATargetInUseByAnotherUserIsNotWritten) {
  WriteOldFiles();
  {
    draft_output_samples::LockingChild child(folder_ / "plan.dxf", draft_output_samples::LockingChild::Lock::SharedGuard);
    EXPECT_EQ(Refusal(second_, target_, true), (folder_ / "plan.dxf").string() + " is in use by another user");
    ExpectOldFilesUntouched();
  }
  WriteSheetFiles(second_, target_, true);
  EXPECT_EQ(ReadDxfSheet(folder_ / "plan.dxf"), second_);
}

TEST_F(SheetFiles, TheNewFilesKeepThePermissionsOfTheOld) {
  WriteOldFiles();
  ASSERT_EQ(chmod((folder_ / "plan.dxf").c_str(), 0640), 0);
  WriteSheetFiles(second_, target_, false);
  struct stat status {};
  ASSERT_EQ(stat((folder_ / "plan.dxf").c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0640u);
}

}  // namespace
