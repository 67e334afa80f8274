// The files of a 2D target: merged or replaced as asked; a failure leaves the old ones as they were.
#include "workbench/draft/sheet_files.h"

#include <gtest/gtest.h>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <fstream>
#include <limits>

#include "tests/draft_output/draft_samples.h"
#include "tests/draft_output/locking_child.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/draft/dxf_reader.h"
#include "workbench/draft/file_lock.h"

namespace {

using namespace wb::draft;
using draft_output_samples::LockingChild;
using drawing_file_samples::ReadBytes;

Sheet OneStroke(std::uint8_t layer, const std::string& name, double y) {
  Sheet sheet;
  sheet.layerNames[layer] = name;
  sheet.strokes.push_back({{0.0, y}, {10.0, y}, layer, 1, StrokeKind::Edge});
  return sheet;
}

// A target that already holds the files of a first generation.
class SheetFiles : public ::testing::Test {
 protected:
  void SetUp() override {
    WriteSheetFiles(first_, target_, false);
    oldDxf_ = ReadBytes(dxf_);
    oldSvg_ = ReadBytes(svg_);
  }

  // Refused with a message holding `message`, the old files as they were and nothing beside them.
  void ExpectRefused(const Sheet& sheet, const std::filesystem::path& target, bool overwrite,
                     const std::string& message) {
    try {
      WriteSheetFiles(sheet, target, overwrite);
      ADD_FAILURE() << "writing " << target << " did not fail";
    } catch (const SheetFileError& error) {
      EXPECT_NE(std::string(error.what()).find(message), std::string::npos) << error.what();
    }
    EXPECT_EQ(ReadBytes(dxf_), oldDxf_);
    EXPECT_TRUE(!std::filesystem::is_regular_file(svg_) || ReadBytes(svg_) == oldSvg_);
    EXPECT_EQ(folder_.Names(), (std::vector<std::string>{"plan.dxf", "plan.svg"}));
  }

  drawing_file_samples::ScratchFolder folder_;
  const std::filesystem::path target_ = folder_ / "plan";
  const std::filesystem::path dxf_ = DxfPathOf(target_);
  const std::filesystem::path svg_ = SvgPathOf(target_);
  const Sheet first_ = draft_output_samples::MakeSheet(1, 100, 10, 8);
  const Sheet second_ = draft_output_samples::MakeSheet(2, 60, 5, 12);
  std::vector<std::uint8_t> oldDxf_;
  std::vector<std::uint8_t> oldSvg_;
};

TEST_F(SheetFiles, OverwriteReplacesTheDrawingAndOtherwiseItIsAddedTo) {
  ASSERT_EQ(chmod(dxf_.c_str(), 0640), 0);
  WriteSheetFiles(second_, target_, false);
  EXPECT_EQ(ReadDxfSheet(dxf_), MergeSheets(first_, second_));
  struct stat status {};
  ASSERT_EQ(stat(dxf_.c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0640u) << "the new file keeps the permissions of the old";
  WriteSheetFiles(second_, target_, true);
  EXPECT_EQ(ReadDxfSheet(dxf_), second_);
  EXPECT_NE(ReadBytes(svg_), oldSvg_);
  EXPECT_EQ(folder_.Names(), (std::vector<std::string>{"plan.dxf", "plan.svg"}));
}

TEST_F(SheetFiles, AFailedWriteLeavesTheOldFiles) {
  Sheet broken = second_;
  broken.strokes[7].b.y = std::numeric_limits<double>::quiet_NaN();
  for (const bool overwrite : {true, false}) {
    ExpectRefused(broken, target_, overwrite, "has a coordinate that is not a finite number");
  }
  ExpectRefused(second_, dxf_ / "plan", true, "cannot write " + (dxf_ / "plan.dxf").string());  // a file, not a folder
  ExpectRefused(second_, folder_ / "missing" / "plan", false, "No such file or directory");
  // Other programs lock with record locks; what counts is that the lock is another process's.
  for (const auto lock : {LockingChild::Lock::SharedGuard, LockingChild::Lock::RecordLock}) {
    LockingChild child(dxf_, lock);
    ExpectRefused(second_, target_, true, dxf_.string() + " is in use by another user");
    child.Release();
    EXPECT_FALSE(IsLockedByAnotherProcess(dxf_));
  }
  // An old drawing that cannot be read is not merged into, but can be replaced.
  drawing_file_samples::WriteBytes(dxf_, {oldDxf_.begin(), oldDxf_.end() - 20});
  oldDxf_ = ReadBytes(dxf_);
  ExpectRefused(second_, target_, false, "cannot merge into " + dxf_.string() + ", line ");
  WriteSheetFiles(first_, target_, true);
  oldDxf_ = ReadBytes(dxf_);
  std::filesystem::remove(svg_);
  std::filesystem::create_directory(svg_);
  std::ofstream(svg_ / "inside") << "keeps the folder from being empty";
  ExpectRefused(second_, target_, true, "cannot replace " + svg_.string());
}

TEST_F(SheetFiles, LeftoversOfKilledWritesAreSweptButNotThoseOfRunningOnes) {
  const std::vector<std::string> leftovers = {".plan.dxf.0123456789abcdef.tmp", ".other.svg.fedcba9876543210.tmp",
                                              ".other.dxf.00000000000000aa.tmp", ".notes.0123.tmp", "keep.tmp"};
  for (const std::string& name : leftovers) drawing_file_samples::WriteBytes(folder_ / name, {'x'});
  // A write still running in another process holds the lock on its temporary.
  const int running = open((folder_ / leftovers[2]).c_str(), O_RDONLY);
  ASSERT_GE(running, 0);
  ASSERT_EQ(flock(running, LOCK_EX), 0);
  // Writing a target clears its own leftovers; a new run clears the whole folder's.
  WriteSheetFiles(second_, target_, true);
  EXPECT_EQ(folder_.Names(), (std::vector<std::string>{leftovers[3], leftovers[2], leftovers[1], "keep.tmp",
                                                       "plan.dxf", "plan.svg"}));
  RemoveStaleSheetTemporaries(folder_.Path());
  EXPECT_EQ(folder_.Names(),
            (std::vector<std::string>{leftovers[3], leftovers[2], "keep.tmp", "plan.dxf", "plan.svg"}));
  close(running);
}

TEST(SheetFileNames, TargetsAsLongAsAFileNameCanBeAreWrittenAndMergedInto) {
  drawing_file_samples::ScratchFolder folder;
  const std::filesystem::path target = folder / std::string(251, 'n');
  WriteSheetFiles(OneStroke(0, "Walls", 0.0), target, true);
  WriteSheetFiles(OneStroke(0, "Walls", 1.0), target, false);
  EXPECT_EQ(ReadDxfSheet(DxfPathOf(target)).strokes.size(), 2U);
  EXPECT_EQ(folder.Names(), (std::vector<std::string>{std::string(251, 'n') + ".dxf", std::string(251, 'n') + ".svg"}));
}

// Layers meet by the name the file shows; a moved layer keeps its name, even a default one.
TEST(MergeSheets, LayersMeetByTheNameTheFileShows) {
  Sheet existing = OneStroke(2, "Walls", 0.0);
  existing.strokes.push_back({{0, 1}, {1, 1}, 0, 3, StrokeKind::Cut});
  Sheet added = OneStroke(5, "WALLS", 1.0);
  added.layerNames[2] = "Doors";
  added.layerNames[7] = "Roof";
  added.strokes.push_back({{0, 2}, {1, 2}, 2, 4, StrokeKind::Edge});
  added.strokes.push_back({{0, 4}, {1, 4}, 0, 6, StrokeKind::Edge});  // unnamed: "Layer 1", as the existing one
  added.labels.push_back({{0, 3}, 1.0, 0.0, "roof", 7, 5});
  const Sheet merged = MergeSheets(existing, added);
  ASSERT_EQ(merged.strokes.size(), 5u);
  EXPECT_EQ((std::vector<int>{merged.strokes[2].layer, merged.strokes[3].layer, merged.strokes[4].layer}),
            (std::vector<int>{2, 1, 0}));
  EXPECT_EQ(merged.labels, added.labels);
  EXPECT_EQ(std::vector<std::string>(merged.layerNames.begin(), merged.layerNames.begin() + 8),
            (std::vector<std::string>{"", "Doors", "Walls", "", "", "", "", "Roof"}));
  EXPECT_EQ(MergeSheets(OneStroke(2, "Walls", 0.0), OneStroke(2, "", 1.0)).layerNames[0], "Layer 3");
  const Sheet all = draft_output_samples::MakeAllLayersSheet();
  EXPECT_EQ(MergeSheets(all, OneStroke(9, "", 0.0)).strokes.back().layer, 9);
  EXPECT_THROW(MergeSheets(all, OneStroke(9, "One too many", 0.0)), SheetFileError);
}

}  // namespace
