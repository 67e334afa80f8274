// Output names of the 2D batch: the folder and prefix from the drawing's path, and default file
// names that stay inside the folder as valid file names whatever a view is called.
#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "display/build_batch.h"

namespace {

using HRUtility::DefaultOutputFile;
using HRUtility::OutputNames;
using HRUtility::OutputNamesFor;

// Room left in a 255-byte file name for ".dxf" or ".svg" and a temporary suffix.
constexpr std::size_t kLongestName = 200;

::testing::AssertionResult ValidFileInside(const std::string& file, const std::string& folder) {
  const std::filesystem::path path(file);
  if (path.parent_path() != folder) return ::testing::AssertionFailure() << file << " is not inside " << folder;
  const std::string name = path.filename();
  if (name.empty() || name == "." || name == "..") return ::testing::AssertionFailure() << "name " << name;
  if (name.size() > kLongestName) return ::testing::AssertionFailure() << name.size() << " bytes";
  for (const char c : name) {
    const auto byte = static_cast<unsigned char>(c);
    if (byte < 0x20 || byte == 0x7F || std::string("/\\:*?\"<>|").find(c) != std::string::npos) {
      return ::testing::AssertionFailure() << "character " << int{byte} << " in " << name;
    }
  }
  return ::testing::AssertionSuccess();
}

TEST(OutputNamesTest, FolderAndPrefixComeFromTheDrawingPath) {
  const OutputNames names = OutputNamesFor("/jobs/house.pdx");
  EXPECT_EQ(names.folder, "/jobs/2D_");
  EXPECT_EQ(names.prefix, "house_");
  EXPECT_EQ(DefaultOutputFile(names, "Street"), "/jobs/2D_/house_Street");
  EXPECT_EQ(DefaultOutputFile(names, "A_Default"), "/jobs/2D_/house_A_Default");

  EXPECT_EQ(OutputNamesFor("/jobs/site.plan.pdx").prefix, "site.plan_") << "only the last extension goes";
  EXPECT_EQ(OutputNamesFor("/jobs/noextension").prefix, "noextension_");
  EXPECT_EQ(OutputNamesFor("/jobs/odd:name*.pdx").prefix, "odd_name__");
}

TEST(OutputNamesTest, HostileViewNamesStayInsideTheFolder) {
  const OutputNames names = OutputNamesFor("/jobs/house.pdx");
  const std::vector<std::string> hostile = {
      "../x", "a/b", "..", ".", "/", "", "/etc/passwd", "..\\..\\windows", "c:\\x", "what?*", "quote\"<pipe>|",
      std::string("line\nbreak\r\ttab\a\x1b\x7f"), std::string(1000, 'n'), std::string(1000, '/'),
      std::string("nul\0inside", 10)};
  for (const std::string& name : hostile) {
    const std::string file = DefaultOutputFile(names, name);
    EXPECT_TRUE(ValidFileInside(file, names.folder)) << "view named \"" << name << "\"";
  }
  EXPECT_EQ(DefaultOutputFile(names, "../x"), "/jobs/2D_/house_.._x");
  EXPECT_EQ(DefaultOutputFile(names, "a/b"), "/jobs/2D_/house_a_b");
  EXPECT_EQ(DefaultOutputFile(names, ".."), "/jobs/2D_/house_..");
}

TEST(OutputNamesTest, EmptyPrefixCannotTurnANameIntoAFolder) {
  const OutputNames bare{"/jobs/2D_", ""};
  EXPECT_EQ(DefaultOutputFile(bare, ".."), "/jobs/2D_/_..");
  EXPECT_EQ(DefaultOutputFile(bare, "."), "/jobs/2D_/_.");
  EXPECT_EQ(DefaultOutputFile(bare, ""), "/jobs/2D_/_");
}

TEST(OutputNamesTest, LongNamesAreCutWithoutSplittingACharacter) {
  const OutputNames names = OutputNamesFor("/jobs/house.pdx");
  std::string accents;
  for (int i = 0; i < 300; ++i) accents += "\xC3\xA9";  // e acute, two bytes
  const std::string name = std::filesystem::path(DefaultOutputFile(names, accents)).filename();
  EXPECT_LE(name.size(), kLongestName);
  EXPECT_EQ(name.size() % 2, 0U) << "house_ and whole characters only";
  EXPECT_EQ(name.substr(name.size() - 2), "\xC3\xA9");
}

}  // namespace
