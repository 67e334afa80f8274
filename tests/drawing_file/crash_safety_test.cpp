// A save killed at any moment leaves exactly the old drawing or exactly the new one.
#include <gtest/gtest.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <random>
#include <thread>

#include "tests/drawing_file/sample_drawings.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/drawing_file.h"

namespace {

using drawing_file_samples::MakeBulkDrawing;
using drawing_file_samples::ScratchFolder;
using Clock = std::chrono::steady_clock;

// Saves in a child process, so the save can be killed like a crashing or powered-off program.
pid_t StartSave(const wb::Drawing& drawing, const std::filesystem::path& file) {
  const pid_t child = fork();
  if (child == 0) {
    try {
      wb::SaveDrawingFile(drawing, file);
    } catch (...) {
      _exit(2);
    }
    _exit(0);
  }
  return child;
}

int WaitFor(pid_t child) {
  int status = 0;
  waitpid(child, &status, 0);
  return status;
}

TEST(DrawingFileCrashSafety, AKilledSaveLeavesTheOldOrTheNewDrawing) {
  ScratchFolder folder;
  const std::filesystem::path file = folder / "drawing.pdx";
  const std::array<wb::Drawing, 2> drawings = {MakeBulkDrawing(4000, 21), MakeBulkDrawing(5000, 22)};
  ASSERT_NE(drawings[0], drawings[1]);
  wb::SaveDrawingFile(drawings[0], file);

  // How long a whole save takes from the fork on, so that the kills spread over all of it:
  // before the temporary exists, while it is written and synced, around the rename.
  Clock::duration saveTime{};
  for (int i = 0; i < 4; ++i) {
    const Clock::time_point start = Clock::now();
    const int status = WaitFor(StartSave(drawings[static_cast<std::size_t>(i + 1) % 2], file));
    ASSERT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    saveTime = std::max(saveTime, Clock::now() - start);
  }
  ASSERT_EQ(wb::OpenDrawingFile(file), drawings[0]);

  std::mt19937 random(20240611);
  const auto longest = std::chrono::duration_cast<std::chrono::microseconds>(saveTime * 5 / 4).count();
  std::uniform_int_distribution<long> delay(0, longest);
  std::size_t current = 0;
  int oldKept = 0;
  int newWritten = 0;
  for (int trial = 0; trial < 220; ++trial) {
    const std::size_t next = 1 - current;
    const pid_t child = StartSave(drawings[next], file);
    ASSERT_GT(child, 0);
    std::this_thread::sleep_for(std::chrono::microseconds(delay(random)));
    kill(child, SIGKILL);
    const int status = WaitFor(child);
    if (WIFEXITED(status)) {
      ASSERT_EQ(WEXITSTATUS(status), 0) << "the save failed in trial " << trial;
    }

    wb::Drawing opened;
    ASSERT_NO_THROW(opened = wb::OpenDrawingFile(file)) << "trial " << trial;
    if (opened == drawings[next]) {
      ++newWritten;
      current = next;
    } else {
      ASSERT_EQ(opened, drawings[current]) << "trial " << trial;
      ++oldKept;
    }
  }
  EXPECT_GT(oldKept, 0);
  EXPECT_GT(newWritten, 0);
  RecordProperty("OldKept", oldKept);
  RecordProperty("NewWritten", newWritten);

  // The next save clears what the killed ones left and leaves the drawing and its backup.
  wb::SaveDrawingFile(drawings[0], file);
  EXPECT_EQ(wb::OpenDrawingFile(file), drawings[0]);
  EXPECT_EQ(folder.Names(), (std::vector<std::string>{"drawing.pdx", "drawing.pdx.bak"}));
}

}  // namespace
