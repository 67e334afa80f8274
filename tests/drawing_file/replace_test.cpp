// Saving over a drawing: the old file is replaced whole, kept as a backup, and a failed save
// leaves it and its folder exactly as they were.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <functional>

#include "tests/drawing_file/sample_drawings.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/drawing_file.h"

namespace {

using drawing_file_samples::MakeBulkDrawing;
using drawing_file_samples::MakeDrawingWithEverything;
using drawing_file_samples::ReadBytes;
using drawing_file_samples::ScratchFolder;
using drawing_file_samples::WriteBytes;
using Reason = wb::DrawingFileError::Reason;

class DrawingFileReplace : public ::testing::Test {
 protected:
  // Saves and answers the error, failing the test when the save does not throw.
  wb::DrawingFileError FailedSave(const wb::Drawing& drawing, const std::filesystem::path& path) {
    try {
      wb::SaveDrawingFile(drawing, path);
    } catch (const wb::DrawingFileError& error) {
      return error;
    }
    ADD_FAILURE() << "saving " << path << " did not fail";
    return wb::DrawingFileError(Reason::CannotWrite, "");
  }

  ScratchFolder folder_;
  const std::filesystem::path file_ = folder_ / "plan.pdx";
};

TEST_F(DrawingFileReplace, ThePreviousVersionStaysAsBackup) {
  const wb::Drawing first = MakeBulkDrawing(50, 1);
  const wb::Drawing second = MakeBulkDrawing(60, 2);
  const wb::Drawing third = MakeDrawingWithEverything();
  wb::SaveDrawingFile(first, file_);
  EXPECT_EQ(folder_.Names(), std::vector<std::string>{"plan.pdx"});
  wb::SaveDrawingFile(second, file_);
  EXPECT_EQ(wb::OpenDrawingFile(file_), second);
  EXPECT_EQ(wb::OpenDrawingFile(folder_ / "plan.pdx.bak"), first);
  wb::SaveDrawingFile(third, file_);
  EXPECT_EQ(wb::OpenDrawingFile(file_), third);
  EXPECT_EQ(wb::OpenDrawingFile(folder_ / "plan.pdx.bak"), second);
  EXPECT_EQ(folder_.Names(), (std::vector<std::string>{"plan.pdx", "plan.pdx.bak"}));
}

TEST_F(DrawingFileReplace, TheNewVersionKeepsThePermissions) {
  wb::SaveDrawingFile(MakeBulkDrawing(10, 1), file_);
  ASSERT_EQ(chmod(file_.c_str(), 0640), 0);
  wb::SaveDrawingFile(MakeBulkDrawing(10, 2), file_);
  struct stat status {};
  ASSERT_EQ(stat(file_.c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0640U);
}

TEST_F(DrawingFileReplace, LeftoversOfKilledSavesAreClearedButNotThoseOfRunningOnes) {
  wb::SaveDrawingFile(MakeBulkDrawing(10, 1), file_);
  const std::vector<std::uint8_t> junk(5000, 0xAB);
  WriteBytes(folder_ / ".plan.pdx.0123456789abcdef.saving", junk);
  WriteBytes(folder_ / ".plan.pdx.fedcba9876543210.saving", junk);
  WriteBytes(folder_ / ".other.pdx.0123456789abcdef.saving", junk);  // another drawing's
  WriteBytes(folder_ / ".plan.pdx.notahexnumber.saving", junk);        // not a name saves make
  // A save still running in another process holds the lock on its temporary.
  const int running = open((folder_ / ".plan.pdx.fedcba9876543210.saving").c_str(), O_RDONLY);
  ASSERT_GE(running, 0);
  ASSERT_EQ(flock(running, LOCK_EX), 0);

  const wb::Drawing drawing = MakeDrawingWithEverything();
  wb::SaveDrawingFile(drawing, file_);
  EXPECT_EQ(wb::OpenDrawingFile(file_), drawing);
  EXPECT_EQ(folder_.Names(), (std::vector<std::string>{".other.pdx.0123456789abcdef.saving",
                                                       ".plan.pdx.fedcba9876543210.saving",
                                                       ".plan.pdx.notahexnumber.saving", "plan.pdx", "plan.pdx.bak"}));
  close(running);
  wb::SaveDrawingFile(drawing, file_);
  EXPECT_FALSE(std::filesystem::exists(folder_ / ".plan.pdx.fedcba9876543210.saving"));
}

TEST_F(DrawingFileReplace, AFailedSaveChangesNothing) {
  const wb::Drawing good = MakeDrawingWithEverything();
  wb::SaveDrawingFile(good, file_);
  std::filesystem::remove(folder_ / "plan.pdx.bak");
  const std::vector<std::uint8_t> bytes = ReadBytes(file_);

  struct Case {
    const char* what;
    std::function<void(wb::Drawing&)> breakIt;
    const char* expected;
  };
  const std::vector<Case> cases = {
      {"member out of range", [](wb::Drawing& d) { d.Find(13)->members.push_back(99); },
       "entity 13 lists the member 99 that the drawing never had"},
      {"member zero", [](wb::Drawing& d) { d.Find(14)->members = {0}; }, "lists the member 0"},
      {"group in itself", [](wb::Drawing& d) { d.Find(13)->members.push_back(13); }, "entity 13 contains itself"},
      {"block placing itself", [](wb::Drawing& d) { d.Find(14)->members.push_back(15); }, "contains itself"},
      {"placed block out of range",
       [](wb::Drawing& d) {
         auto placed = wb::ReadRecord<host::PlacedBlockRecord>(*d.Find(15));
         placed.block = -4;
         wb::WriteRecord(*d.Find(15), placed);
       },
       "entity 15 places the block -4"},
      {"record of another size", [](wb::Drawing& d) { d.Find(1)->record.resize(27); },
       "entity 1 has a record of 27 bytes where its type takes 28"},
      {"handle in the wrong slot", [](wb::Drawing& d) { d.slots[4].handle = 9; }, "slot 5 holds handle 9"},
      {"unknown attribute type",
       [](wb::Drawing& d) { d.Find(12)->attributes[4].type = static_cast<wb::AttributeType>(77); },
       "attribute 5 has the unknown type 77"},
  };
  for (const Case& test : cases) {
    SCOPED_TRACE(test.what);
    wb::Drawing broken = good;
    test.breakIt(broken);
    const wb::DrawingFileError error = FailedSave(broken, file_);
    EXPECT_EQ(error.GetReason(), Reason::CannotWrite);
    EXPECT_NE(std::string(error.what()).find("cannot write " + file_.string() + ": "), std::string::npos)
        << error.what();
    EXPECT_NE(std::string(error.what()).find(test.expected), std::string::npos) << error.what();
    EXPECT_EQ(ReadBytes(file_), bytes);
    EXPECT_EQ(folder_.Names(), std::vector<std::string>{"plan.pdx"});
  }
}

TEST_F(DrawingFileReplace, PlacesThatCannotTakeAFileAreRefused) {
  const wb::Drawing drawing = MakeBulkDrawing(10, 1);
  const wb::DrawingFileError missingFolder = FailedSave(drawing, folder_ / "no" / "such" / "plan.pdx");
  EXPECT_EQ(missingFolder.GetReason(), Reason::CannotWrite);
  EXPECT_EQ(std::string(missingFolder.what()), "cannot write " + (folder_ / "no" / "such" / "plan.pdx").string() +
                                                   ": creating a temporary file: No such file or directory");

  std::filesystem::create_directory(folder_ / "taken.pdx");
  const wb::DrawingFileError folderInTheWay = FailedSave(drawing, folder_ / "taken.pdx");
  EXPECT_EQ(folderInTheWay.GetReason(), Reason::CannotWrite);
  EXPECT_NE(std::string(folderInTheWay.what()).find("replacing the file"), std::string::npos) << folderInTheWay.what();
  EXPECT_TRUE(std::filesystem::is_directory(folder_ / "taken.pdx"));

  EXPECT_EQ(FailedSave(drawing, folder_.Path() / "").GetReason(), Reason::CannotWrite);
  EXPECT_EQ(folder_.Names(), std::vector<std::string>{"taken.pdx"});
}

}  // namespace
