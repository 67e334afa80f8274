// Two programs on one drawing: readers share it, an editor has it alone from reading to saving,
// and a lock won on a file that a save has just replaced moves to the new file.
#include "workbench/drawing_file_lock.h"

#include <fcntl.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <chrono>
#include <optional>
#include <string>
#include <thread>

#include "tests/drawing_file/scratch_folder.h"
#include "workbench/drawing_file.h"

namespace {

using namespace std::chrono_literals;
using Mode = wb::DrawingFileLock::Mode;

// Another program: takes the lock, holds it for a while, optionally saves the drawing with a
// new title meanwhile, and ends.
class OtherProgram {
 public:
  OtherProgram(const std::filesystem::path& path, Mode mode, std::chrono::milliseconds hold,
               std::optional<std::string> newTitle = std::nullopt) {
    int report[2];
    if (pipe2(report, O_CLOEXEC) != 0) throw std::runtime_error("no pipe");
    pid_ = fork();
    if (pid_ < 0) throw std::runtime_error("cannot fork");
    if (pid_ == 0) {
      try {
        const wb::DrawingFileLock lock(path, mode, 0ms);
        if (write(report[1], "y", 1) != 1) _exit(1);
        std::this_thread::sleep_for(hold);
        if (newTitle) {
          wb::Drawing drawing = wb::OpenDrawingFile(path);
          drawing.title = *newTitle;
          wb::SaveDrawingFile(drawing, path);
        }
      } catch (...) {
        _exit(1);
      }
      _exit(0);
    }
    close(report[1]);
    char ready = 'n';
    const bool holds = read(report[0], &ready, 1) == 1;
    close(report[0]);
    if (!holds) {
      Wait();
      throw std::runtime_error("the other program could not lock " + path.string());
    }
  }
  ~OtherProgram() {
    // Only ever the child: a pid of -1 would signal every process there is.
    if (pid_ > 0) kill(pid_, SIGKILL);
    Wait();
  }
  OtherProgram(const OtherProgram&) = delete;
  OtherProgram& operator=(const OtherProgram&) = delete;

  // The program's exit status once it has ended.
  int Wait() {
    if (pid_ > 0) waitpid(pid_, &status_, 0);
    pid_ = -1;
    return WIFEXITED(status_) ? WEXITSTATUS(status_) : -1;
  }

 private:
  pid_t pid_ = -1;
  int status_ = 0;
};

class DrawingLockTest : public ::testing::Test {
 protected:
  void SetUp() override {
    wb::Drawing drawing;
    drawing.title = "first";
    wb::SaveDrawingFile(drawing, path_);
  }
  drawing_file_samples::ScratchFolder scratch_;
  std::filesystem::path path_ = scratch_ / "house.pdx";
};

TEST_F(DrawingLockTest, ReadersShareAnEditorIsAloneAndTheRefusalNamesTheFile) {
  {
    OtherProgram reader(path_, Mode::Shared, 10s);
    EXPECT_NO_THROW(wb::DrawingFileLock(path_, Mode::Shared, 0ms));
    try {
      wb::DrawingFileLock editing(path_, Mode::Exclusive, 100ms);
      ADD_FAILURE() << "an editor got in beside a reader";
    } catch (const wb::DrawingFileError& error) {
      EXPECT_EQ(error.GetReason(), wb::DrawingFileError::Reason::InUse);
      EXPECT_NE(std::string(error.what()).find(path_.string() + " is in use by another program (waited 0.1 s)"),
                std::string::npos)
          << error.what();
    }
  }
  OtherProgram editor(path_, Mode::Exclusive, 10s);
  EXPECT_THROW(wb::DrawingFileLock(path_, Mode::Shared, 50ms), wb::DrawingFileError);
  EXPECT_THROW(wb::DrawingFileLock(path_, Mode::Exclusive, 50ms), wb::DrawingFileError);
}

TEST_F(DrawingLockTest, AWaitingEditorGetsTheDrawingTheOtherSavedAndHoldsThatFile) {
  OtherProgram first(path_, Mode::Exclusive, 300ms, "second");
  {
    const wb::DrawingFileLock lock(path_, Mode::Exclusive, 10s);
    EXPECT_EQ(first.Wait(), 0);
    EXPECT_EQ(wb::OpenDrawingFile(path_).title, "second") << "read after the other program's save";
    // The lock is on the file the path names now, not on the one the save replaced.
    EXPECT_THROW(OtherProgram(path_, Mode::Shared, 0ms), std::runtime_error);
  }
  EXPECT_NO_THROW(OtherProgram(path_, Mode::Exclusive, 0ms));
}

TEST_F(DrawingLockTest, AMissingDrawingIsNotLockedAndOpeningItSaysWhy) {
  const std::filesystem::path missing = scratch_ / "none.pdx";
  EXPECT_NO_THROW(wb::DrawingFileLock(missing, Mode::Exclusive, 0ms));
  EXPECT_THROW(wb::OpenDrawingFile(missing), wb::DrawingFileError);
}

}  // namespace
