// Libraries loaded by name through the system's loader, and the shell's "open" that is recorded
// but never starts a viewer unless the program allows it.
#include <gtest/gtest.h>

#include <cstdio>
#include <filesystem>
#include <fstream>

#include "framework/dynamic_library.h"
#include "framework/shell_execute.h"
#include "framework/win_constants.h"

namespace {

class LoaderTest : public ::testing::Test {
 protected:
  LoaderTest() { framework::AddLibraryFolder(PANDEX_PROBE_DIR); }
  ~LoaderTest() override { framework::ClearLibraryFolders(); }
};

TEST_F(LoaderTest, ALibraryLoadedByItsWindowsNameAnswersItsFunctionsUntilFreed) {
  const std::size_t loaded = framework::LoadedLibraryCount();
  const HMODULE probe = LoadLibrary("PandexLoaderProbe.dll");
  ASSERT_TRUE(probe);
  const auto answer = reinterpret_cast<int (*)()>(GetProcAddress(probe, "ProbeAnswer"));
  ASSERT_NE(answer, nullptr);
  EXPECT_EQ(answer(), 42);
  EXPECT_EQ(GetProcAddress(probe, "NoSuchFunction"), nullptr);

  // A second load is the same library, state and all, until it is freed as often.
  const HMODULE again = LoadLibrary("PandexLoaderProbe");
  EXPECT_EQ(again, probe);
  const auto count = reinterpret_cast<int (*)()>(GetProcAddress(again, "ProbeCount"));
  ASSERT_NE(count, nullptr);
  const int first = count();
  EXPECT_EQ(reinterpret_cast<int (*)()>(GetProcAddress(probe, "ProbeCount"))(), first + 1);
  EXPECT_EQ(framework::LoadedLibraryCount(), loaded + 1);
  EXPECT_TRUE(FreeLibrary(again));
  EXPECT_NE(GetProcAddress(probe, "ProbeAnswer"), nullptr);
  EXPECT_TRUE(FreeLibrary(probe));
  EXPECT_EQ(framework::LoadedLibraryCount(), loaded);
  EXPECT_FALSE(FreeLibrary(probe));
  EXPECT_EQ(GetProcAddress(probe, "ProbeAnswer"), nullptr);  // a freed handle finds nothing
}

TEST_F(LoaderTest, AMissingLibraryIsANullHandle) {
  EXPECT_FALSE(LoadLibrary("ColorMRU.dll"));  // not there unless the host puts it there
  EXPECT_FALSE(LoadLibrary(""));
  framework::ClearLibraryFolders();
  EXPECT_FALSE(LoadLibrary("PandexLoaderProbe.dll"));  // only the folders it was told of
}

class ShellTest : public ::testing::Test {
 protected:
  ShellTest() { framework::ClearShellRequestLog(); }
  ~ShellTest() override { std::filesystem::remove(report_); }

  std::filesystem::path report_ = std::filesystem::temp_directory_path() / "pandex_shell_test_selreport.txt";
};

TEST_F(ShellTest, OpenIsRecordedAndStartsNoViewerUnlessAllowed) {
  std::ofstream(report_) << "Report for selection : Front\r\n";
  const HWND owner(7);
  EXPECT_EQ(ShellExecute(owner, "open", report_.string(), "", "", SW_SHOWNORMAL), SE_ERR_NOASSOC);
  EXPECT_EQ(ShellExecute(owner, "open", "/no/such/selreport.txt", "", "", SW_SHOWNORMAL), SE_ERR_FNF);
  EXPECT_EQ(ShellExecute(HWND(), "print", report_.string(), "", "", SW_SHOWNORMAL), SE_ERR_NOASSOC);
  const auto& log = framework::ShellRequestLog();
  ASSERT_EQ(log.size(), 3U);
  EXPECT_EQ(log[0].owner, owner);
  EXPECT_EQ(log[0].verb, "open");
  EXPECT_EQ(log[0].file, report_.string());
  EXPECT_EQ(log[0].show, SW_SHOWNORMAL);
  EXPECT_EQ(log[1].result, SE_ERR_FNF);
  EXPECT_EQ(log[2].verb, "print");
}

}  // namespace
