// Host memory: accounting until log_free, and releases of freed, foreign or inner pointers
// that are counted instead of crashing.
#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <random>
#include <string>
#include <vector>

#include "tests/workbench/host_fixture.h"

class HostMemoryTest : public HostTest {
 protected:
  wb::HostMemory& Memory() { return Session().Memory(); }
};

TEST_F(HostMemoryTest, CopiesAreCountedUntilReleased) {
  char* a = log_str_dup_new("first", "Test", 10);
  char* b = log_str_dup_new("", "Test", 11);
  EXPECT_STREQ(a, "first");
  EXPECT_STREQ(b, "");
  EXPECT_EQ(Memory().Outstanding(), 2);
  log_free(a);
  EXPECT_EQ(Memory().Outstanding(), 1);
  log_free(b);
  EXPECT_EQ(Memory().Outstanding(), 0);
  EXPECT_EQ(Memory().TotalHandedOut(), 2);
  EXPECT_EQ(log_str_dup_new(nullptr, "Test", 12), nullptr);
}

TEST_F(HostMemoryTest, DoubleReleasesAreCountedAndChangeNothing) {
  char* kept = log_str_dup_new("kept", "Test", 1);
  char* text = log_str_dup_new("text", "Test", 2);
  log_free(text);
  log_free(text);
  EXPECT_EQ(Memory().BadReleases(), 1);
  EXPECT_EQ(Memory().Outstanding(), 1);
  EXPECT_STREQ(kept, "kept");
  log_free(kept);
}

TEST_F(HostMemoryTest, ForeignAndInnerPointersAreCountedNotFreed) {
  char onStack[32] = "stack";
  std::string owned(100, 'x');
  void* fromMalloc = std::malloc(64);
  char* text = log_str_dup_new("a longer host text", "Test", 1);
  log_free(onStack);
  log_free(owned.data());
  log_free(fromMalloc);
  log_free(text + 1);
  log_free(nullptr);
  EXPECT_EQ(Memory().BadReleases(), 4) << "null is no release at all";
  EXPECT_EQ(Memory().Outstanding(), 1);
  EXPECT_STREQ(text, "a longer host text");
  log_free(text);
  std::free(fromMalloc);
  EXPECT_EQ(Memory().BadReleases(), 4);
}

TEST_F(HostMemoryTest, LargeBlocksAreAccountedAndCheckedAlike) {
  const std::string big(100000, 'q');
  char* copy = log_str_dup_new(big.c_str(), "Test", 1);
  EXPECT_EQ(std::strlen(copy), big.size());
  log_free(copy);
  log_free(copy);
  EXPECT_EQ(Memory().Outstanding(), 0);
  EXPECT_EQ(Memory().BadReleases(), 1);
}

TEST_F(HostMemoryTest, ManyLiveBlocksKeepTheirContentsWhileOthersComeAndGo) {
  std::mt19937 random(7);
  std::vector<std::pair<char*, std::string>> live;
  for (int round = 0; round < 5000; ++round) {
    if (!live.empty() && random() % 3 == 0) {
      const std::size_t pick = random() % live.size();
      ASSERT_STREQ(live[pick].first, live[pick].second.c_str());
      log_free(live[pick].first);
      live.erase(live.begin() + static_cast<std::ptrdiff_t>(pick));
    } else {
      const std::string text(random() % 6000, static_cast<char>('a' + round % 26));
      live.emplace_back(log_str_dup_new(text.c_str(), "Test", round), text);
    }
  }
  EXPECT_EQ(Memory().Outstanding(), static_cast<std::int64_t>(live.size()));
  for (auto& [pointer, text] : live) {
    ASSERT_STREQ(pointer, text.c_str());
    log_free(pointer);
  }
  EXPECT_EQ(Memory().Outstanding(), 0);
  EXPECT_EQ(Memory().BadReleases(), 0);
}

TEST_F(HostMemoryTest, ReadsLeaveOneBlockPerTextUntilReleased) {
  const EntityHandle entity = AddGroup();
  SetString(entity, "@Class=", "HRCamera");
  const RecordHandle record = OpenRecord(entity);
  std::vector<char*> texts(3, nullptr);
  for (char*& text : texts) ASSERT_EQ(qel_read_string_attribute(record, "@Class=", &text), 1);
  EXPECT_EQ(Memory().Outstanding(), 3);
  EXPECT_NE(texts[0], texts[1]) << "each read hands out its own copy";
  for (char* text : texts) log_free(text);
  EXPECT_EQ(Memory().Outstanding(), 0);
}

TEST_F(HostMemoryTest, PointersFromBeforeAResetAreForeignAfterIt) {
  char* text = log_str_dup_new("old", "Test", 1);
  Session().Reset();
  log_free(text);
  EXPECT_EQ(Memory().BadReleases(), 1);
  EXPECT_EQ(Memory().Outstanding(), 0);
}
