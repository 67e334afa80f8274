// A save killed at any moment leaves exactly the old drawing or exactly the new one, and damaged
// copies of a drawing file never crash or hang the opener: each is refused with a DrawingFileError
// or opens as a drawing that saves and opens again unchanged.
#include <gtest/gtest.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <random>
#include <thread>

#include "tests/drawing_file/sample_drawings.h"
#include "tests/drawing_file/scratch_folder.h"
#include "workbench/drawing_file.h"

namespace {

using drawing_file_samples::MakeBulkDrawing;
using drawing_file_samples::ScratchFolder;
using Bytes = std::vector<std::uint8_t>;
using Clock = std::chrono::steady_clock;

// Saves in a child process, which can be killed like a crashing or powered-off program, and
// answers its wait status once it has ended; `killAfter` below zero lets the save finish.
int SaveInChild(const wb::Drawing& drawing, const std::filesystem::path& file, std::chrono::microseconds killAfter) {
  const pid_t child = fork();
  if (child == 0) {
    try {
      wb::SaveDrawingFile(drawing, file);
    } catch (...) {
      _exit(2);
    }
    _exit(0);
  }
  if (child > 0 && killAfter.count() >= 0) {
    std::this_thread::sleep_for(killAfter);
    kill(child, SIGKILL);
  }
  int status = 0;
  waitpid(child, &status, 0);
  return status;
}

TEST(DrawingFileCrashSafety, AKilledSaveLeavesTheOldOrTheNewDrawing) {
  ScratchFolder folder;
  const std::filesystem::path file = folder / "drawing.pdx";
  const std::array<wb::Drawing, 2> drawings = {MakeBulkDrawing(4000, 21), MakeBulkDrawing(5000, 22)};
  wb::SaveDrawingFile(drawings[0], file);

  // How long a whole save takes from the fork on, so that the kills spread over all of it:
  // before the temporary exists, while it is written and synced, around the rename.
  Clock::duration saveTime{};
  for (std::size_t i = 1; i <= 4; ++i) {
    const Clock::time_point start = Clock::now();
    const int status = SaveInChild(drawings[i % 2], file, std::chrono::microseconds(-1));
    ASSERT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    saveTime = std::max(saveTime, Clock::now() - start);
  }
  ASSERT_EQ(wb::OpenDrawingFile(file), drawings[0]);

  std::mt19937 random(20240611);
  using Microseconds = std::chrono::microseconds;
  const Microseconds::rep longest = std::chrono::duration_cast<Microseconds>(saveTime * 5 / 4).count();
  std::uniform_int_distribution<Microseconds::rep> delay(0, longest);
  std::size_t current = 0;
  std::array<int, 2> outcomes{};  // old drawing kept, new one written
  for (int trial = 0; trial < 220; ++trial) {
    SCOPED_TRACE(testing::Message() << "trial " << trial);
    const std::size_t next = 1 - current;
    const int status = SaveInChild(drawings[next], file, Microseconds(delay(random)));
    ASSERT_TRUE(!WIFEXITED(status) || WEXITSTATUS(status) == 0) << "the save failed";
    wb::Drawing opened;
    ASSERT_NO_THROW(opened = wb::OpenDrawingFile(file));
    ASSERT_TRUE(opened == drawings[current] || opened == drawings[next]);
    ++outcomes[opened == drawings[next] ? 1 : 0];
    if (opened == drawings[next]) current = next;
  }
  EXPECT_GT(outcomes[0], 0);
  EXPECT_GT(outcomes[1], 0);
  // The next save clears what the killed ones left and leaves the drawing and its backup.
  wb::SaveDrawingFile(drawings[0], file);
  EXPECT_EQ(wb::OpenDrawingFile(file), drawings[0]);
  EXPECT_EQ(folder.Names(), (std::vector<std::string>{"drawing.pdx", "drawing.pdx.bak"}));
}

TEST(DrawingFileHostileInput, DamagedCopiesAreRefusedOrOpenWhole) {
  ScratchFolder folder;
  wb::SaveDrawingFile(MakeBulkDrawing(700, 3), folder / "original.pdx");
  const Bytes original = drawing_file_samples::ReadBytes(folder / "original.pdx");
  ASSERT_GT(original.size(), 8U * 4096U);
  std::mt19937 random(7);
  const auto offset = [&](std::size_t below) {
    return std::uniform_int_distribution<std::size_t>(0, below - 1)(random);
  };
  const auto flip = [&](Bytes& bytes, std::size_t span) {
    bytes[offset(span)] ^= static_cast<std::uint8_t>(std::uniform_int_distribution<int>(1, 255)(random));
  };
  std::array<int, 2> outcomes{};  // opened, refused
  for (int i = 0; i < 1100; ++i) {
    Bytes bytes = original;
    if (i < 400) {
      flip(bytes, bytes.size());
    } else if (i < 650) {
      for (int flips = std::uniform_int_distribution<int>(2, 24)(random); flips > 0; --flips) flip(bytes, bytes.size());
    } else if (i < 850) {
      // Every length class: inside the header, at and around page boundaries, anywhere.
      const int n = i - 650;
      bytes.resize(n < 40 ? static_cast<std::size_t>(n) * 3
                   : n < 80 ? (static_cast<std::size_t>(n - 40) % 10 + 1) * 4096 + (n % 3) - 1
                            : offset(original.size()));
    } else {
      // The first page: the SQLite header, then the schema every read starts from.
      for (int flips = 1 + i % 4; flips > 0; --flips) flip(bytes, i < 950 ? 100 : 4096);
    }
    SCOPED_TRACE(testing::Message() << "variant " << i);
    drawing_file_samples::WriteBytes(folder / "variant.pdx", bytes);
    try {
      const wb::Drawing opened = wb::OpenDrawingFile(folder / "variant.pdx");
      wb::SaveDrawingFile(opened, folder / "resaved.pdx");
      EXPECT_EQ(wb::OpenDrawingFile(folder / "resaved.pdx"), opened);
      ++outcomes[0];
    } catch (const wb::DrawingFileError& error) {
      EXPECT_EQ(std::string(error.what()).find('\n'), std::string::npos);
      ++outcomes[1];
    } catch (const std::exception& error) {
      ADD_FAILURE() << "threw " << error.what();
    }
  }
  // Both outcomes occur, or the variants would not be testing what they claim to.
  EXPECT_GT(outcomes[0], 50);
  EXPECT_GT(outcomes[1], 50);
}

}  // namespace
