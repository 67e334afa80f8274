// Pane scripts: what the reader refuses and how it reads the rest, the runner's refusals named
// by line, the pictures it writes, and the README's tour of the sample house.
#include <filesystem>
#include <fstream>
#include <sstream>

#include "app/pane_script/pane_script.h"
#include "shell/host/argument_blocks.h"
#include "tests/pane/pane_fixture.h"

namespace {

using app::script::ReadScript;
using app::script::ScriptError;

std::string ReadError(std::string_view text) {
  try {
    ReadScript(text);
  } catch (const ScriptError& error) {
    return error.what();
  }
  return {};
}

TEST(PaneScriptReaderTest, RefusesTheFirstBadLineByNumber) {
  const std::vector<std::pair<std::string, std::string>> cases = {
      {"tab cameras\nfly away", "line 2: no action \"fly\""},
      {"tab kitchens", "line 1: no tab \"kitchens\""},
      {"\n\nselect \"Section 0", "line 3: a quoted word is not closed"},
      {"select \"A\"B", "line 1: a blank must follow a quoted word"},
      {"rename A \"x\\y\"", "line 1: a backslash in quotes"},
      {"pick 1,2 3", "line 1: \"3\" is no point"},
      {"pick 1,2 nan,4", "line 1: \"nan,4\" is no point"},
      {"run 2 1,2", "line 1: usage: run 2|4"},
      {"run 7 inf", "line 1: the tab number must be a number"},
      {"run 99999999999", "line 1: a sub-command must be a whole number"},
      {"wait -5", "line 1: the time must be a whole number from 0"},
      {"click 70000", "line 1: a control id must be a whole number"},
      {"answer maybe", "line 1: no answer \"maybe\""},
      {"view eye 1,2,3 target", "line 1: usage: view eye"},
      {"tick", "line 1: usage: tick PATH"},
      {"select \"\"", "line 1: an empty item path"},
      {std::string("select A\x01"), "line 1: a control character"},
      {"print " + std::string(5000, 'x'), "line 1: longer than 4096 bytes"},
      {std::string(app::script::kMaxScriptBytes + 1, '#'), "line 1: the script is longer than"},
  };
  for (const auto& [text, message] : cases) {
    EXPECT_EQ(ReadError(text).rfind(message, 0), 0U) << "script: " << text.substr(0, 60) << "\ngot: " << ReadError(text);
  }
}

TEST(PaneScriptReaderTest, ReadsQuotedWordsCommentsAndEveryLineEnding) {
  const app::script::Script script = ReadScript(
      "# a tour\r\n  \r\nrename \"Section 0/Default\" \"say \\\"hi\\\" \\\\ there\"\r\n\tpick 1.5,-2 3,4,5  \n"
      "run 7 2.5\nclick add\nclick \"Browse...\"\nclick 1\nhover tab plans");
  ASSERT_EQ(script.actions.size(), 7U);
  const auto& rename = std::get<app::script::Rename>(script.actions[0].kind);
  EXPECT_EQ(script.actions[0].line, 3);
  EXPECT_EQ(rename.path, "Section 0/Default");
  EXPECT_EQ(rename.text, "say \"hi\" \\ there");
  const auto& pick = std::get<app::script::PickPoints>(script.actions[1].kind);
  ASSERT_EQ(pick.points.size(), 2U);
  EXPECT_EQ(std::vector<float>({pick.points[0].x, pick.points[0].y, pick.points[0].z, pick.points[1].z}),
            (std::vector<float>{1.5F, -2, 0, 5}));
  EXPECT_EQ(std::get<app::script::RunSubCommand>(script.actions[2].kind).number, 2.5F);
  const auto control = [&](std::size_t i) { return std::get<app::script::Click>(script.actions[i].kind).control; };
  EXPECT_TRUE(control(3).paneButton);
  EXPECT_EQ(control(3).id, 5007);
  EXPECT_EQ(control(4).text, "Browse...");
  EXPECT_EQ(control(5).id, 1);
  EXPECT_FALSE(control(5).paneButton);
  EXPECT_EQ(std::get<app::script::Hover>(script.actions[6].kind).tab, 2);
}

TEST_F(PaneTest, AStepThatCannotBeDoneStopsTheScriptAtItsLine) {
  EXPECT_EQ(RunFailing("tab sections\nselect \"C\"\nclick remove"), "line 2: no tree item \"C\"");
  EXPECT_EQ(RunFailing("pick 1,1 2,2"), "line 1: the host is not asking for points");
  EXPECT_EQ(RunFailing("answer ok"), "line 1: no message box is open");
  EXPECT_EQ(RunFailing("tab cameras\nclick update"), "line 2: the control is disabled");
  EXPECT_EQ(RunFailing("tick \"Site plan\""), "line 1: \"Site plan\" is ticked already");
  EXPECT_EQ(RunFailing("save"), "line 1: the drawing has no file yet: save FILE");
  EXPECT_EQ(RunFailing("tab sections\nclick add"),
            "line 2: the host was still asking \"Section: start point (x,y or x,y,z)\" when the script ended");
  EXPECT_EQ(OfClass("HRSection").size(), 2U) << "the unanswered pick added nothing";
  globc[32] = 'r';  // a geometric variant: no camera can be taken
  EXPECT_EQ(RunFailing("tab cameras\nclick add"),
            "line 2: \"Pandex\" (This operation can be performed only in Geometric , Render and Solid mode) was still "
            "waiting for an answer when the script ended");
  EXPECT_EQ(RunFailing("run 5\ntab plans"), "line 2: the pane is not shown (run 1 shows it)");
}

// The tour of the README, as the pane command runs it, with a picture after each action.
TEST_F(PaneTest, TheReadmeTourRunsOnTheSampleHouseAndLeavesAPictureOfEachStep) {
  const std::filesystem::path folder =
      std::filesystem::path(::testing::TempDir()) / ("pane_tour_" + std::to_string(::getpid()));
  std::filesystem::create_directories(folder);
  std::ifstream in(PANDEX_SOURCE_DIR "/samples/scripts/tour.pane");
  std::stringstream tour;
  tour << in.rdbuf();
  const app::script::Script script = ReadScript(tour.str());
  std::ostringstream out;
  app::script::Runner runner(Frame(), {(folder / "house.pdx").string(), folder.string()}, out);
  runner.Run(script);
  EXPECT_EQ(runner.Renders(), static_cast<int>(script.actions.size()) + 1);
  EXPECT_TRUE(std::filesystem::exists(folder / "000-start.svg"));
  EXPECT_TRUE(std::filesystem::exists(folder / "house.pdx"));
  EXPECT_NE(out.str().find("Sections:\n  [ ] A\n    [x] Default\n  [ ] B\n    [x] Default\n  [x] Garden\n"),
            std::string::npos)
      << out.str();
  std::filesystem::remove_all(folder);
}

}  // namespace
