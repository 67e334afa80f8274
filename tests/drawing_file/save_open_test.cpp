// Saving and opening drawings: everything comes back byte for byte, opening changes nothing, and
// a save keeps the old drawing as a backup, leaves it untouched when it fails, and clears only
// what killed saves left behind.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cmath>
#include <functional>
#include <tuple>

#include "tests/drawing_file/sample_drawings.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/drawing_file.h"

namespace {

using drawing_file_samples::MakeBulkDrawing;
using drawing_file_samples::MakeDrawingWithEverything;
using drawing_file_samples::ReadBytes;
using drawing_file_samples::WriteBytes;
using Bytes = std::vector<std::uint8_t>;
using Names = std::vector<std::string>;

TEST(DrawingFileSaveOpen, EveryDrawingComesBackAndSavesAgainToTheSameBytes) {
  drawing_file_samples::ScratchFolder folder;
  for (const wb::Drawing& original : {wb::Drawing(), MakeDrawingWithEverything(), MakeBulkDrawing(20000, 11)}) {
    SCOPED_TRACE(original.title);
    wb::SaveDrawingFile(original, folder / "first.pdx");
    const Bytes first = ReadBytes(folder / "first.pdx");
    const wb::Drawing opened = wb::OpenDrawingFile(folder / "first.pdx");
    EXPECT_EQ(opened, original);
    wb::SaveDrawingFile(opened, folder / "second.pdx");
    EXPECT_EQ(ReadBytes(folder / "second.pdx"), first);
    // Over itself too: nothing in the file depends on when or where it was written.
    wb::SaveDrawingFile(opened, folder / "first.pdx");
    EXPECT_EQ(ReadBytes(folder / "first.pdx"), first);
  }
}

TEST(DrawingFileSaveOpen, OpeningChangesNothing) {
  drawing_file_samples::ScratchFolder folder;
  const std::filesystem::path file = folder / "house.pdx";
  wb::SaveDrawingFile(MakeDrawingWithEverything(), file);
  struct stat before {};
  ASSERT_EQ(stat(file.c_str(), &before), 0);
  const Bytes bytes = ReadBytes(file);
  wb::OpenDrawingFile(file);
  // Equality takes -0 for 0, so the sign is checked on its own.
  EXPECT_TRUE(std::signbit(wb::OpenDrawingFile(file).Find(12)->attributes.at(3).floatValue));
  struct stat after {};
  ASSERT_EQ(stat(file.c_str(), &after), 0);
  EXPECT_EQ(std::tie(after.st_ino, after.st_mtim.tv_sec, after.st_mtim.tv_nsec),
            std::tie(before.st_ino, before.st_mtim.tv_sec, before.st_mtim.tv_nsec));
  EXPECT_EQ(ReadBytes(file), bytes);
  EXPECT_EQ(folder.Names(), Names{"house.pdx"}) << "no journal or lock beside it";
}

TEST(DrawingFileSaveOpen, ThePreviousVersionStaysAsBackupAndAFailedSaveChangesNothing) {
  drawing_file_samples::ScratchFolder folder;
  const std::filesystem::path file = folder / "plan.pdx";
  const std::array<wb::Drawing, 3> versions = {MakeBulkDrawing(50, 1), MakeBulkDrawing(60, 2),
                                               MakeDrawingWithEverything()};
  wb::SaveDrawingFile(versions[0], file);
  ASSERT_EQ(chmod(file.c_str(), 0640), 0);
  for (std::size_t i = 1; i < versions.size(); ++i) {
    wb::SaveDrawingFile(versions[i], file);
    EXPECT_EQ(wb::OpenDrawingFile(file), versions[i]);
    EXPECT_EQ(wb::OpenDrawingFile(folder / "plan.pdx.bak"), versions[i - 1]);
  }
  struct stat status {};
  ASSERT_EQ(stat(file.c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0640U) << "the new version keeps the permissions";

  const Bytes bytes = ReadBytes(file);
  const std::pair<std::function<void(wb::Drawing&)>, const char*> failures[] = {
      {[](wb::Drawing& d) { d.Find(13)->members.push_back(99); }, "entity 13 lists the member 99"},
      {[](wb::Drawing& d) { d.Find(14)->members.push_back(15); }, "contains itself"},
      {[](wb::Drawing& d) { d.Find(1)->record.resize(27); }, "entity 1 has a record of 27 bytes where its type"},
      {[](wb::Drawing& d) { d.slots[4].handle = 9; }, "slot 5 holds handle 9"},
      {[](wb::Drawing& d) { d.Find(12)->attributes[4].type = static_cast<wb::AttributeType>(77); },
       "attribute 5 has the unknown type 77"},
  };
  for (const auto& [breakIt, expected] : failures) {
    wb::Drawing broken = versions[2];
    breakIt(broken);
    try {
      wb::SaveDrawingFile(broken, file);
      ADD_FAILURE() << "saved despite " << expected;
    } catch (const wb::DrawingFileError& error) {
      EXPECT_EQ(error.GetReason(), wb::DrawingFileError::Reason::CannotWrite);
      EXPECT_EQ(std::string(error.what()).find("cannot write " + file.string() + ": "), 0U) << error.what();
      EXPECT_NE(std::string(error.what()).find(expected), std::string::npos) << error.what();
    }
    EXPECT_EQ(ReadBytes(file), bytes);
    EXPECT_EQ(folder.Names(), (Names{"plan.pdx", "plan.pdx.bak"}));
  }
}

TEST(DrawingFileSaveOpen, LeftoversOfKilledSavesAreClearedButNotThoseOfRunningOnes) {
  drawing_file_samples::ScratchFolder folder;
  const Names leftovers = {".other.pdx.0123456789abcdef.saving", ".plan.pdx.0123456789abcdef.saving",
                           ".plan.pdx.fedcba9876543210.saving", ".plan.pdx.notahexnumber.saving"};
  for (const std::string& name : leftovers) WriteBytes(folder / name, Bytes(5000, 0xAB));
  // A save still running in another process holds the lock on its temporary.
  const int running = open((folder / leftovers[2]).c_str(), O_RDONLY);
  ASSERT_GE(running, 0);
  ASSERT_EQ(flock(running, LOCK_EX), 0);
  wb::SaveDrawingFile(MakeBulkDrawing(10, 1), folder / "plan.pdx");
  EXPECT_EQ(folder.Names(), (Names{leftovers[0], leftovers[2], leftovers[3], "plan.pdx"}));
  close(running);
  wb::SaveDrawingFile(MakeBulkDrawing(10, 1), folder / "plan.pdx");
  EXPECT_EQ(folder.Names(), (Names{leftovers[0], leftovers[3], "plan.pdx", "plan.pdx.bak"}));
}

TEST(DrawingFileSaveOpen, NamesUpToTheLongestTheFileSystemTakesSaveWithTheirBackups) {
  drawing_file_samples::ScratchFolder folder;
  const std::string twoBytes = "\xC3\xA9";  // e acute
  for (const std::size_t length : {231U, 243U, 255U}) {
    SCOPED_TRACE(length);
    std::string name;
    while (name.size() + twoBytes.size() + 4 <= length) name += twoBytes;
    name = std::string(length - 4 - name.size(), 'p') + name + ".pdx";
    ASSERT_EQ(name.size(), length);
    wb::SaveDrawingFile(MakeBulkDrawing(10, 1), folder / name);
    wb::SaveDrawingFile(MakeBulkDrawing(20, 2), folder / name);
    EXPECT_EQ(wb::OpenDrawingFile(folder / name), MakeBulkDrawing(20, 2));
    // The backup keeps as much of the name as fits, in whole characters.
    std::string backup = name.substr(0, std::min<std::size_t>(name.size(), 251));
    if ((static_cast<unsigned char>(backup.back()) & 0xC0) == 0xC0) backup.pop_back();
    EXPECT_EQ(wb::OpenDrawingFile(folder / (backup + ".bak")), MakeBulkDrawing(10, 1));
    EXPECT_EQ(folder.Names().size(), 2U);
    for (const std::string& left : folder.Names()) std::filesystem::remove(folder / left);
  }
}

TEST(DrawingFileSaveOpen, SavingThroughLinksChangesTheDrawingTheyLeadToAndKeepsTheLinks) {
  drawing_file_samples::ScratchFolder folder;
  std::filesystem::create_directory(folder / "real");
  wb::SaveDrawingFile(MakeBulkDrawing(10, 1), folder / "real" / "plan.pdx");
  // A relative link in another folder, and a link to that link.
  std::filesystem::create_directory(folder / "links");
  std::filesystem::create_symlink("../real/plan.pdx", folder / "links" / "plan.pdx");
  std::filesystem::create_symlink(folder / "links" / "plan.pdx", folder / "shortcut.pdx");
  const wb::Drawing changed = MakeBulkDrawing(30, 2);
  wb::SaveDrawingFile(changed, folder / "shortcut.pdx");
  EXPECT_TRUE(std::filesystem::is_symlink(folder / "shortcut.pdx"));
  EXPECT_TRUE(std::filesystem::is_symlink(folder / "links" / "plan.pdx"));
  EXPECT_EQ(wb::OpenDrawingFile(folder / "real" / "plan.pdx"), changed);
  EXPECT_EQ(wb::OpenDrawingFile(folder / "real" / "plan.pdx.bak"), MakeBulkDrawing(10, 1));
  EXPECT_EQ(folder.Names(), (Names{"links", "real", "shortcut.pdx"}));
  // A link to a drawing not saved yet makes it; a loop of links is refused.
  std::filesystem::create_symlink("real/new.pdx", folder / "ahead.pdx");
  wb::SaveDrawingFile(changed, folder / "ahead.pdx");
  EXPECT_EQ(wb::OpenDrawingFile(folder / "real" / "new.pdx"), changed);
  std::filesystem::create_symlink("loop.pdx", folder / "loop.pdx");
  EXPECT_THROW(wb::SaveDrawingFile(changed, folder / "loop.pdx"), wb::DrawingFileError);
  EXPECT_TRUE(std::filesystem::is_symlink(folder / "loop.pdx"));
}

TEST(DrawingFileSaveOpen, PlacesThatCannotTakeAFileAreLeftAsTheyWere) {
  drawing_file_samples::ScratchFolder folder;
  std::filesystem::create_directory(folder / "taken.pdx");
  for (const std::filesystem::path& path : {folder / "no" / "plan.pdx", folder / "taken.pdx", folder.Path() / ""}) {
    EXPECT_THROW(wb::SaveDrawingFile(MakeBulkDrawing(10, 1), path), wb::DrawingFileError) << path;
  }
  EXPECT_TRUE(std::filesystem::is_directory(folder / "taken.pdx"));
  EXPECT_EQ(folder.Names(), Names{"taken.pdx"});
}

}  // namespace
