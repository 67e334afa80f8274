// The host session: reset, drawings by handle, plug-in load and unload, overlays, and host
// memory counted until log_free, with bad releases counted instead of crashing.
#include <cstdlib>
#include <random>
#include <stdexcept>
#include <string>
#include <vector>

#include "shell/host/qelinfo.h"
#include "tests/workbench/host_fixture.h"

namespace {

// A stand-in plug-in: its exports record what the host made them do.
std::vector<std::string> pluginEvents;

void TestAttach() { pluginEvents.push_back("attach"); }
void TestDetach() { pluginEvents.push_back("detach"); }
void TestEntry() {
  pluginEvents.push_back("entry " + std::to_string(globi[0]));
  execute_internal_command("from entry");
}
void OtherAttach() { pluginEvents.push_back("other attach"); }

constexpr wb::PluginExports kTestPlugin{&TestAttach, &TestDetach, &TestEntry};

class HostSession : public HostTest {
 protected:
  void SetUp() override {
    HostTest::SetUp();
    pluginEvents.clear();
  }
  static wb::HostMemory& Memory() { return Session().Memory(); }
};

}  // namespace

TEST_F(HostSession, ResetGivesAFreshHost) {
  Session().LoadPlugin(kTestPlugin);
  ASSERT_NE(OpenRecord(AddLine()), 0);
  char* kept = log_str_dup_new("kept", "Test", 1);
  Session().GetFaults().FailNext("qel_add_line");
  CommandMessage("/3secadd");
  SetCameraManagerOn();
  globi[3] = 9;
  globr[22] = 7.0F;
  globc[26] = 's';
  for (const char* command : {"set_perspective", "start_redraw_off", "set_background_color", "rnd_make"}) Run(command);
  execute_2d();
  remove_wait_cur();
  Session().Open(wb::Drawing{});

  Session().Reset();
  EXPECT_EQ(pluginEvents, (std::vector<std::string>{"attach", "detach"}));
  EXPECT_TRUE(db.handle == 1 && Current().slots.empty() && Session().Find(2) == nullptr);
  EXPECT_TRUE(Log().Entries().empty() && Session().CommandLines().empty());
  EXPECT_FALSE(Session().PluginLoaded() || Session().GetFaults().Armed() || Session().CameraManagerOn());
  EXPECT_EQ(Session().Records().OpenCount(), 0U);
  EXPECT_FALSE(View().perspective || View().waitCursorUnderflows || Display().renderImage);
  EXPECT_TRUE(View().threeD && View().redrawOn);
  EXPECT_EQ(std::tuple(globi[3], globr[22], globr[132], globc[26]), std::tuple(0, 2.5F, 3.0F, 'w'));
  EXPECT_EQ(Memory().Outstanding(), 0);
  log_free(kept);
  EXPECT_EQ(Memory().BadReleases(), 1) << "what was handed out before a reset is foreign after it";
}

TEST_F(HostSession, DrawingsAreOpenedByHandleAndKeptApart) {
  const DatabaseHandle first = db.handle;
  const DatabaseHandle second = Session().Open(wb::Drawing{});
  EXPECT_EQ(std::pair(second, db.handle), std::pair(2, first)) << "opening does not make current";
  AddLine();
  const host::LineRecord line = MakeLine({0, 0, 0}, {1, 1, 1});
  EntityHandle inSecond = 0;
  ASSERT_EQ(qel_add_line(second, &inSecond, &line), 1);
  EXPECT_EQ(std::pair(AddLine(), inSecond), std::pair(2, 1)) << "each drawing counts its own handles";

  Session().SetCurrent(second);
  EXPECT_THROW(Session().SetCurrent(42), std::out_of_range);
  const RecordHandle record = OpenRecord(inSecond);
  Session().Close(second);
  EXPECT_EQ(db.handle, 0);
  EXPECT_THROW(Current(), std::logic_error);
  EXPECT_EQ(qel_set_short_attribute(record, "x=", 1), 0) << "records close with their drawing";
  EXPECT_EQ(Session().Records().OpenCount(), 0U);
  EXPECT_EQ(Session().Open(wb::Drawing{}), 3) << "a closed handle is not handed out again";
}

TEST_F(HostSession, PluginIsAttachedOnceAndReenteredOnlyByOverlayPandex) {
  EXPECT_EQ(execute_quorvel_overlay("Pandex"), 0) << "no plug-in loaded";
  Session().LoadPlugin(kTestPlugin);
  globi[0] = 3;
  ASSERT_EQ(execute_quorvel_overlay("Pandex"), 1);
  EXPECT_EQ(execute_quorvel_overlay("toolbar"), 1);
  const std::vector<wb::JournalEntry> expected = {{Kind::Overlay, "Pandex"}, {Kind::Overlay, "Pandex"},
                                                  {Kind::Command, "from entry"}, {Kind::Overlay, "toolbar"}};
  EXPECT_EQ(Log().Entries(), expected) << "the overlay comes before what the entry did";

  Session().LoadPlugin(wb::PluginExports{&OtherAttach, nullptr, &TestEntry});
  Session().UnloadPlugin();
  Session().UnloadPlugin();
  EXPECT_EQ(pluginEvents, (std::vector<std::string>{"attach", "entry 3", "detach", "other attach"}));
  EXPECT_FALSE(Session().RunPluginEntry());
}

TEST_F(HostSession, LiveHostBlocksKeepTheirContentsAndAreCountedUntilReleased) {
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
  EXPECT_EQ(log_str_dup_new(nullptr, "Test", 1), nullptr);
  EXPECT_EQ(Memory().Outstanding(), 0);
  EXPECT_EQ(Memory().BadReleases(), 0);
}

TEST_F(HostSession, FreedForeignAndInnerPointersAreCountedNotFreed) {
  char onStack[32] = "stack";
  std::string owned(100, 'x');
  void* fromMalloc = std::malloc(64);
  char* large = log_str_dup_new(std::string(100000, 'q').c_str(), "Test", 1);
  char* text = log_str_dup_new("a longer host text", "Test", 2);
  log_free(large);
  for (void* foreign : {static_cast<void*>(large), static_cast<void*>(onStack), static_cast<void*>(owned.data()),
                        fromMalloc, static_cast<void*>(text + 1)}) {
    log_free(foreign);
  }
  std::free(fromMalloc);
  log_free(nullptr);
  EXPECT_EQ(Memory().BadReleases(), 5) << "null is no release at all";
  EXPECT_EQ(Memory().Outstanding(), 1);
  EXPECT_STREQ(text, "a longer host text");
  log_free(text);
}
