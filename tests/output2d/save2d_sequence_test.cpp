// The host calls one 2D save makes, in order, and the host settings it hands over and puts back.
#include <cstring>
#include <fstream>

#include "display/display_mode.h"
#include "display/save2d.h"
#include "shell/host/argument_blocks.h"
#include "tests/draft_output/locking_child.h"
#include "tests/drawing_file/scratch_folder.h"
#include "tests/output2d/output2d_fixture.h"

namespace output2d_test {
namespace {

using Calls = std::vector<std::string>;

const View kGeometricView{{3.0F, -4.0F, 2.0F}, {0.5F, 0.5F, 0.5F}, false, HRUtility::kGeometric};
const View kHiddenlineView{{3.0F, -4.0F, 2.0F}, {0.5F, 0.5F, 0.5F}, false, HRUtility::kHiddenline};

class Save2DSequenceTest : public Output2DTest {
 protected:
  void SetUp() override {
    Output2DTest::SetUp();
    AddCube({0.0F, 0.0F, 0.0F});
  }
  std::filesystem::path Target() const { return Folder() / "view"; }
  static std::string Field(int first, int last) { return std::string(globc + first, globc + last + 1); }
  static std::string Symbol() { return HostState().symbols.at("@config@save2drewrite"); }
};

TEST_F(Save2DSequenceTest, WithoutPreserveNothingIsSelectedExtractedOrBlanked) {
  Show(kGeometricView);
  globr[41] = 2.0F;
  Bench().GetJournal().Clear();
  ASSERT_TRUE(Save(Target(), {.removeCoincident = 1}));

  EXPECT_EQ(Steps(), (Calls{"qel_put_long_name 10", "create_2d_model", "qel_put_long_name 1", "overlay shadows",
                            "qel_put_long_name 211", "save2d_add_source", "merge_save2d_files", "SetSymbolString"}));
  // What the last steps handed over stays in the blocks.
  EXPECT_EQ(Field(9, 16), "_save2d_");
  EXPECT_EQ(globc[78], '*');
  EXPECT_EQ(globc[84], 'T');
  EXPECT_EQ(globi[0], 10);
  EXPECT_EQ(globi[1], 211);
  EXPECT_EQ(globr[31], 0.01F);
  EXPECT_EQ(globr[147], 3.0F);
  EXPECT_EQ(globr[41], 2.0F) << "the clean-up setting is put back";
  EXPECT_EQ(HostState().longNames.at(211), Target().string());
  EXPECT_EQ(HostState().longNames.at(1), Target().string()) << "the clean-up works on the target";
  EXPECT_TRUE(std::filesystem::exists(Target().string() + ".dxf"));
  EXPECT_TRUE(std::filesystem::exists(Target().string() + ".svg"));
}

TEST_F(Save2DSequenceTest, PreserveInGeometricSetsEntitiesAsideAndShowsThemAgain) {
  const host::EntityHandle text = AddText("Hall", {0.5F, 0.5F, 0.0F}).handle;
  const host::EntityHandle dimension = AddDimension({0.0F, -1.0F, 0.0F}, {1.0F, -1.0F, 0.0F}, "1.00").handle;
  Show(kGeometricView);
  ASSERT_EQ(globc[26], 'w');
  Bench().GetJournal().Clear();
  ASSERT_TRUE(Save(Target(), {.dimensions = 1, .texts = 1}));

  const std::string selectText = "select_app_entity " + std::to_string(text);
  const std::string selectDimension = "select_app_entity " + std::to_string(dimension);
  EXPECT_EQ(Steps(), (Calls{"qel_put_long_name 10", "overlay qel_sel", selectText, selectDimension,
                            "write_to_record -1 -1", "selection_exist", "overlay extract", "overlay blank",
                            "overlay blank", "overlay blank", "create_2d_model", "qel_put_long_name 1",
                            "overlay extract", "qel_put_long_name 211", "save2d_add_source", "merge_save2d_files",
                            "SetSymbolString", "overlay blank", "overlay blank", "overlay qel_sel"}));
  EXPECT_FALSE(Drawing().Find(text)->Hidden());
  EXPECT_FALSE(Drawing().Find(dimension)->Hidden());
  EXPECT_TRUE(HostState().selection.empty());
  EXPECT_TRUE(HostState().blanked.empty());
  // The set-aside entities go back through the host's work file, named in kind 1.
  EXPECT_EQ(HostState().longNames.at(1), (HostState().specialFolder / "work10T").string());
}

TEST_F(Save2DSequenceTest, SolidModesPreserveNothingAndRemoveHiddenLines) {
  AddText("Hall", {0.5F, 0.5F, 0.0F});
  Show(kHiddenlineView);
  ASSERT_EQ(globc[26], 's');
  Bench().GetJournal().Clear();
  ASSERT_TRUE(Save(Target(), {.dimensions = 1, .texts = 1, .walls = 1, .layer = 1, .layerIndex = 5}));

  EXPECT_EQ(Steps(), (Calls{"qel_put_long_name 10", "hiden1", "overlay hconv", "qel_copy_file", "qel_put_long_name 211",
                            "save2d_add_source", "merge_save2d_files", "SetSymbolString"}));
  EXPECT_EQ(Field(0, 8), std::string("hdltmp  \0", 9)) << "copied with its terminating zero, then again without";
  EXPECT_EQ(globr[2], 4000.0F);
  EXPECT_EQ(globc[78], '*');
}

TEST_F(Save2DSequenceTest, CleanupCodeFollowsTheTwoFlagsAndIsPutBack) {
  struct Case {
    std::uint8_t removeCoincident;
    std::uint8_t lineMerge;
    int code;  // -1: no clean-up runs
  };
  Show(kGeometricView);
  for (const Case& c : {Case{1, 0, 1}, Case{0, 1, 2}, Case{1, 1, 3}, Case{0, 0, -1}}) {
    SCOPED_TRACE(testing::Message() << "coincident " << int{c.removeCoincident} << ", merge " << int{c.lineMerge});
    globr[41] = 2.4F;  // kept as the code it stands for
    HostState().lastCleanupCode = -1;
    Bench().GetJournal().Clear();
    ASSERT_TRUE(Save(Target(), {.removeCoincident = c.removeCoincident, .lineMerge = c.lineMerge}));
    EXPECT_EQ(HostState().lastCleanupCode, c.code);
    EXPECT_EQ(Count(Steps(), "overlay shadows"), c.code < 0 ? 0 : 1);
    EXPECT_EQ(Count(Steps(), "qel_put_long_name 1"), c.code < 0 ? 0 : 1);
    EXPECT_FLOAT_EQ(static_cast<float>(HostState().lastCleanupTolerance), c.code < 0 ? 0.0F : 0.01F);
    HostState().lastCleanupTolerance = 0.0;
    EXPECT_EQ(globr[41], 2.0F);
  }

  globr[41] = 3.0F;
  HRUtility::SetLineCleanup(1, 0);
  EXPECT_EQ(globr[41], 1.0F);
  HRUtility::RestoreLineCleanup();
  EXPECT_EQ(globr[41], 3.0F);
  HRUtility::SetLineCleanup(0, 0);
  EXPECT_EQ(globr[41], 0.0F);
  HRUtility::RestoreLineCleanup();
  EXPECT_EQ(globr[41], 3.0F);
}

TEST_F(Save2DSequenceTest, RewriteSwitchHoldsOnlyDuringTheMergeAndIsAlwaysWrittenBack) {
  struct Case {
    const char* before;  // null: the host has no such symbol
    std::uint8_t overwrite;
    Calls around;        // symbol writes and the merge, in order
    bool replaced;       // how the merge wrote the target
    std::string after;
  };
  const Calls writeMergeWrite{"SetSymbolString", "merge_save2d_files", "SetSymbolString"};
  const Calls mergeWrite{"merge_save2d_files", "SetSymbolString"};
  Show(kGeometricView);
  for (const Case& c : {Case{nullptr, 0, writeMergeWrite, false, "1"}, Case{nullptr, 1, mergeWrite, true, "1"},
                        Case{"1", 1, mergeWrite, true, "1"}, Case{"0", 0, mergeWrite, false, "0"},
                        Case{"0", 1, writeMergeWrite, true, "0"}, Case{"0.6", 1, mergeWrite, true, "1"}}) {
    SCOPED_TRACE(testing::Message() << "symbol " << (c.before != nullptr ? c.before : "(none)") << ", overwrite "
                                    << int{c.overwrite});
    HostState().symbols.clear();
    if (c.before != nullptr) HostState().symbols["@config@save2drewrite"] = c.before;
    Bench().GetJournal().Clear();
    ASSERT_TRUE(Save(Target(), {.overwrite = c.overwrite}));
    Calls around;
    for (const std::string& step : Steps()) {
      if (step == "SetSymbolString" || step == "merge_save2d_files") around.push_back(step);
    }
    EXPECT_EQ(around, c.around);
    EXPECT_EQ(HostState().lastMergeReplaced, c.replaced);
    EXPECT_EQ(Symbol(), c.after);
  }
}

TEST_F(Save2DSequenceTest, FailedMergeIsReportedButSettingsArePutBack) {
  Show(kGeometricView);
  HostState().symbols["@config@save2drewrite"] = "0";
  globr[41] = 2.0F;
  wb::FaultRule rule;
  rule.call = "execute_internal_command";
  rule.attribute = "merge_save2d_files";
  Bench().GetFaults().Add(rule);
  EXPECT_FALSE(Save(Target(), {.overwrite = 1, .removeCoincident = 1}));
  EXPECT_EQ(Symbol(), "0");
  EXPECT_EQ(globr[41], 2.0F);
  EXPECT_FALSE(std::filesystem::exists(Target().string() + ".dxf"));

  // A target the host cannot write (its folder is missing) fails the same way.
  Bench().GetJournal().Clear();
  EXPECT_FALSE(Save(Folder() / "no such folder" / "view", {.removeCoincident = 1}));
  EXPECT_EQ(Count(Steps(), "merge_save2d_files"), 1);
  EXPECT_EQ(Symbol(), "0");
}

TEST_F(Save2DSequenceTest, LockedTargetIsRefusedBeforeAnyTwoDCommand) {
  const host::EntityHandle text = AddText("Hall", {0.5F, 0.5F, 0.0F}).handle;
  Show(kGeometricView);
  const std::filesystem::path dxf = Target().string() + ".dxf";
  drawing_file_samples::WriteBytes(dxf, {'o', 'l', 'd'});
  draft_output_samples::LockingChild otherUser(dxf, draft_output_samples::LockingChild::Lock::ExclusiveGuard);
  globr[41] = 2.0F;
  Bench().GetJournal().Clear();

  EXPECT_FALSE(Save(Target(), {.overwrite = 1, .removeCoincident = 1, .texts = 1}));
  EXPECT_EQ(Steps(), (Calls{"qel_put_long_name 10"}));
  EXPECT_FALSE(Drawing().Find(text)->Hidden()) << "nothing was set aside for a file that cannot be written";
  EXPECT_TRUE(HostState().selection.empty());
  EXPECT_EQ(globr[41], 2.0F);
  EXPECT_EQ(drawing_file_samples::ReadBytes(dxf), (std::vector<std::uint8_t>{'o', 'l', 'd'}));
  EXPECT_FALSE(HRUtility::IsTargetFree(Target().c_str()));
  otherUser.Release();
  EXPECT_TRUE(HRUtility::IsTargetFree(Target().c_str()));
}

TEST_F(Save2DSequenceTest, AutoClipRunsLastAndOnlyWhenAsked) {
  Show(kGeometricView);
  Bench().GetJournal().Clear();
  ASSERT_TRUE(Save(Target(), {.autoClip = 1}));
  const Calls withClip = Steps();
  ASSERT_FALSE(withClip.empty());
  EXPECT_EQ(withClip.back(), "AutoClip");
  EXPECT_EQ(withClip[withClip.size() - 2], "SetSymbolString") << "the switch is back before the clip";

  Bench().GetJournal().Clear();
  ASSERT_TRUE(Save(Target(), {.autoClip = 0}));
  EXPECT_EQ(Count(Steps(), "AutoClip"), 0);
}

}  // namespace
}  // namespace output2d_test
