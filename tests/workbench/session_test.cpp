// The host session: reset, drawings by handle, plug-in load and unload, commands, overlays,
// the journal's order and the standing settings.
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

}  // namespace

class HostSession : public HostTest {
 protected:
  void SetUp() override {
    HostTest::SetUp();
    pluginEvents.clear();
  }
};

TEST_F(HostSession, ResetGivesAFreshHost) {
  Session().LoadPlugin(kTestPlugin);
  AddLine();
  const RecordHandle record = OpenRecord(1);
  ASSERT_NE(record, 0);
  log_str_dup_new("kept", "Test", 1);
  Session().GetFaults().FailNext("qel_add_line");
  globi[3] = 9;
  globr[22] = 7.0F;
  Session().Open(wb::Drawing{});
  SetCameraManagerOn();

  Session().Reset();
  EXPECT_EQ(pluginEvents, (std::vector<std::string>{"attach", "detach"}));
  EXPECT_FALSE(Session().PluginLoaded());
  EXPECT_EQ(db.handle, 1);
  EXPECT_EQ(Current().slots.size(), 0U);
  EXPECT_EQ(Session().Find(2), nullptr);
  EXPECT_TRUE(Log().Entries().empty());
  EXPECT_FALSE(Session().GetFaults().Armed());
  EXPECT_EQ(Session().Memory().Outstanding(), 0);
  EXPECT_EQ(Session().Records().OpenCount(), 0U);
  EXPECT_FALSE(Session().CameraManagerOn());
  EXPECT_EQ(globi[3], 0);
  EXPECT_EQ(globr[22], 2.5F);
}

TEST_F(HostSession, StandingSettingsHoldTheTextDefaults) {
  const std::vector<std::pair<int, float>> floats = {{20, 1.0F},  {22, 2.5F}, {23, 0.0F}, {24, 0.0F}, {25, 1.0F},
                                                     {26, 12.0F}, {50, 0.0F}, {56, 2.0F}, {57, 0.0F}, {93, 0.0F}};
  for (const auto& [slot, value] : floats) EXPECT_EQ(globr[slot], value) << "globr[" << slot << "]";
  EXPECT_EQ(globc[89], ' ');
  EXPECT_EQ(globc[94], 'm');
  EXPECT_EQ(globi[0], 0);
}

TEST_F(HostSession, DrawingsAreOpenedByHandleAndOneIsCurrent) {
  wb::Drawing second;
  second.title = "second";
  const DatabaseHandle handle = Session().Open(std::move(second));
  EXPECT_EQ(handle, 2);
  EXPECT_EQ(db.handle, 1) << "opening does not make current";
  Session().SetCurrent(handle);
  EXPECT_EQ(db.handle, handle);
  EXPECT_EQ(Current().title, "second");
  EXPECT_THROW(Session().SetCurrent(42), std::out_of_range);

  const EntityHandle line = AddLine();
  const RecordHandle record = OpenRecord(line);
  Session().Close(handle);
  EXPECT_EQ(db.handle, 0);
  EXPECT_THROW(Current(), std::logic_error);
  EXPECT_EQ(qel_set_short_attribute(record, "x=", 1), 0) << "records close with their drawing";
  EXPECT_EQ(Session().Records().OpenCount(), 0U);
  EXPECT_EQ(Session().Open(wb::Drawing{}), 3) << "a closed handle is not handed out again";
}

TEST_F(HostSession, EntitiesOfTwoDrawingsAreKeptApart) {
  const DatabaseHandle first = db.handle;
  const DatabaseHandle second = Session().Open(wb::Drawing{});
  const host::LineRecord line = MakeLine(0, 0, 0, 1, 1, 1);
  EntityHandle inFirst = 0;
  EntityHandle inSecond = 0;
  ASSERT_EQ(qel_add_line(first, &inFirst, &line), 1);
  ASSERT_EQ(qel_add_line(first, &inFirst, &line), 1);
  ASSERT_EQ(qel_add_line(second, &inSecond, &line), 1);
  EXPECT_EQ(inFirst, 2);
  EXPECT_EQ(inSecond, 1);
  ASSERT_EQ(qel_delete_entity(second, 1), 1);
  host::EntityHeader header{};
  EXPECT_EQ(qel_read_entity_header(first, 1, &header), 1);
}

TEST_F(HostSession, LoadingRunsAttachAndUnloadingDetachOnce) {
  Session().LoadPlugin(kTestPlugin);
  EXPECT_TRUE(Session().PluginLoaded());
  Session().LoadPlugin(wb::PluginExports{&OtherAttach, nullptr, &TestEntry});
  Session().UnloadPlugin();
  Session().UnloadPlugin();
  EXPECT_EQ(pluginEvents, (std::vector<std::string>{"attach", "detach", "other attach"}));
  EXPECT_FALSE(Session().PluginLoaded());
  EXPECT_FALSE(Session().RunPluginEntry());
}

TEST_F(HostSession, OverlayPandexReentersThePluginEntry) {
  EXPECT_EQ(execute_quorvel_overlay("Pandex"), 0) << "no plug-in loaded";
  Session().LoadPlugin(kTestPlugin);
  globi[0] = 3;
  ASSERT_EQ(execute_quorvel_overlay("Pandex"), 1);
  EXPECT_EQ(pluginEvents, (std::vector<std::string>{"attach", "entry 3"}));
  EXPECT_EQ(execute_quorvel_overlay("toolbar"), 1);
  EXPECT_EQ(pluginEvents.size(), 2U) << "other overlays do not run the plug-in";

  const std::vector<wb::JournalEntry> expected = {
      {wb::JournalEntry::Kind::Overlay, "Pandex", 0, 0},
      {wb::JournalEntry::Kind::Overlay, "Pandex", 0, 0},
      {wb::JournalEntry::Kind::Command, "from entry", 0, 0},
      {wb::JournalEntry::Kind::Overlay, "toolbar", 0, 0},
  };
  EXPECT_EQ(Log().Entries(), expected) << "the overlay comes before what the entry did";
}

TEST_F(HostSession, JournalKeepsEveryKindInCallOrder) {
  const EntityHandle group = AddGroup();
  Session().GetJournal().Clear();
  execute_internal_command("set_vsect_plane");
  write_to_record(group, 1);
  SetString(group, "@Class=", "HRCamera");
  CommandMessage("/3secadd");
  SetCameraManagerOn();
  write_to_record(-1, -1);
  EXPECT_EQ(execute_internal_command(nullptr), 0);

  using Kind = wb::JournalEntry::Kind;
  const std::vector<wb::JournalEntry> expected = {
      {Kind::Command, "set_vsect_plane", 0, 0},     {Kind::ChangeRecord, "write_to_record", group, 1},
      {Kind::AttributeWrite, "@Class=", group, 0},  {Kind::CommandMessage, "/3secadd", 0, 0},
      {Kind::HostCall, "SetCameraManagerOn", 0, 0}, {Kind::ChangeRecord, "write_to_record", -1, -1},
  };
  EXPECT_EQ(Log().Entries(), expected);
  EXPECT_EQ(Log().ChangeRecords(), (std::vector<std::pair<EntityHandle, std::int32_t>>{{group, 1}, {-1, -1}}));
  EXPECT_EQ(Log().Names(Kind::CommandMessage), (std::vector<std::string>{"/3secadd"}));
}

TEST_F(HostSession, ManagerPaneStateFollowsOnAndOff) {
  SetCameraManagerOn();
  EXPECT_TRUE(Session().CameraManagerOn());
  SetCameraManagerOff();
  EXPECT_FALSE(Session().CameraManagerOn());
}
