// One 2D save: the host calls it makes in order, the host settings it hands over and puts back,
// and which entities the preserve options set aside.
#include <map>
#include <optional>

#include "display/display_mode.h"
#include "shell/host/argument_blocks.h"
#include "tests/draft_output/locking_child.h"
#include "tests/output2d/output2d_fixture.h"

namespace output2d_test {
namespace {

using Calls = std::vector<std::string>;
using Handles = std::vector<host::EntityHandle>;

// Category codes as the database loop reports them: byte 3, then byte 1.
struct Category {
  std::uint8_t kind, code;
};
constexpr Category kText{1, 7}, kDimension{4, 44}, kNone{0, 0};

const View kGeometric{{3.0F, -4.0F, 2.0F}, {0.5F, 0.5F, 0.5F}, false, HRUtility::kGeometric};

class Save2DTest : public Output2DTest {
 protected:
  // A line the database loop reports with the given layer index, category and flag byte.
  static host::EntityHandle AddEntity(std::uint8_t layerIndex, Category category, std::uint8_t flags = 0) {
    wb::Entity& entity = draft_test::AddLine(Drawing(), {0.0F, 0.0F, 0.0F}, {1.0F, 0.0F, 0.0F}, layerIndex);
    entity.header.bytes[host::kHeaderCategoryKind] = category.kind;
    entity.header.bytes[host::kHeaderCategoryCode] = category.code;
    entity.header.bytes[host::kHeaderLoopFlags] = flags;
    return entity.handle;
  }
  static Handles Select(bool dimensions, bool texts, bool walls, std::optional<std::int32_t> layerNumber = {}) {
    HRUtility::ClearSelection();
    HRUtility::SelectPreserved(dimensions, texts, walls, layerNumber.has_value(), layerNumber.value_or(0));
    return HostState().selection;
  }
  static std::string Symbol() { return HostState().symbols.at("@config@save2drewrite"); }
};

TEST_F(Save2DTest, WithoutPreserveNothingIsSelectedExtractedOrBlanked) {
  AddCube();
  Show(kGeometric);
  globr[41] = 2.0F;
  Bench().GetJournal().Clear();
  ASSERT_TRUE(Save(Target(), {.removeCoincident = 1}));
  EXPECT_EQ(Steps(), (Calls{"qel_put_long_name 10", "create_2d_model", "qel_put_long_name 1", "overlay shadows",
                            "qel_put_long_name 211", "save2d_add_source", "merge_save2d_files", "SetSymbolString"}));
  // What the last steps handed over stays in the blocks; the clean-up setting is put back.
  EXPECT_EQ(std::string(globc + 9, 8), "_save2d_");
  EXPECT_EQ((std::string{globc[78], globc[84]}), "*T");
  EXPECT_EQ((std::array{globi[0], globi[1]}), (std::array{10, 211}));
  EXPECT_EQ((std::array{globr[31], globr[147], globr[41]}), (std::array{0.01F, 3.0F, 2.0F}));
  EXPECT_EQ(HostState().longNames.at(211), Target().string());
  EXPECT_EQ(HostState().longNames.at(1), Target().string()) << "the clean-up works on the target";
  EXPECT_TRUE(std::filesystem::exists(Target().string() + ".dxf"));
  EXPECT_TRUE(std::filesystem::exists(Target().string() + ".svg"));
}

TEST_F(Save2DTest, PreserveInGeometricSetsEntitiesAsideAndShowsThemAgain) {
  const host::EntityHandle text = AddEntity(5, kText), dimension = AddEntity(4, kDimension);
  Show(kGeometric);
  ASSERT_EQ(globc[26], 'w');
  Bench().GetJournal().Clear();
  ASSERT_TRUE(Save(Target(), {.dimensions = 1, .texts = 1}));
  EXPECT_EQ(Steps(), (Calls{"qel_put_long_name 10", "overlay qel_sel", "select_app_entity " + std::to_string(text),
                            "select_app_entity " + std::to_string(dimension), "write_to_record -1 -1",
                            "selection_exist", "overlay extract", "overlay blank", "overlay blank", "overlay blank",
                            "create_2d_model", "qel_put_long_name 1", "overlay extract", "qel_put_long_name 211",
                            "save2d_add_source", "merge_save2d_files", "SetSymbolString", "overlay blank",
                            "overlay blank", "overlay qel_sel"}));
  EXPECT_FALSE(Drawing().Find(text)->Hidden());
  EXPECT_FALSE(Drawing().Find(dimension)->Hidden());
  EXPECT_TRUE(HostState().selection.empty());
  EXPECT_TRUE(HostState().blanked.empty());
  // The set-aside entities go back through the host's work file, named in kind 1.
  EXPECT_EQ(HostState().longNames.at(1), (HostState().specialFolder / "work10T").string());
}

TEST_F(Save2DTest, SolidModesPreserveNothingAndRemoveHiddenLines) {
  AddEntity(5, kText);
  View hiddenline = kGeometric;
  hiddenline.displayMode = HRUtility::kHiddenline;
  Show(hiddenline);
  ASSERT_EQ(globc[26], 's');
  Bench().GetJournal().Clear();
  ASSERT_TRUE(Save(Target(), {.dimensions = 1, .texts = 1, .walls = 1, .layer = 1, .layerIndex = 5}));
  EXPECT_EQ(Steps(), (Calls{"qel_put_long_name 10", "hiden1", "overlay hconv", "qel_copy_file", "qel_put_long_name 211",
                            "save2d_add_source", "merge_save2d_files", "SetSymbolString"}));
  EXPECT_EQ(std::string(globc, 9), std::string("hdltmp  \0", 9)) << "copied with its zero, then again without";
  EXPECT_EQ(globr[2], 4000.0F);
  EXPECT_EQ(globc[78], '*');
}

TEST_F(Save2DTest, CleanupCodeFollowsTheTwoFlagsAndIsPutBack) {
  AddCube();
  Show(kGeometric);
  // Coincident removal and line merging, and the code that runs (-1: no clean-up runs).
  for (const auto [removeCoincident, lineMerge, code] : {std::array{1, 0, 1}, {0, 1, 2}, {1, 1, 3}, {0, 0, -1}}) {
    SCOPED_TRACE(testing::Message() << "coincident " << removeCoincident << ", merge " << lineMerge);
    globr[41] = 2.4F;  // put back as the code it stands for
    HostState().lastCleanupCode = -1;
    HostState().lastCleanupTolerance = 0.0;
    Bench().GetJournal().Clear();
    ASSERT_TRUE(Save(Target(), {.removeCoincident = static_cast<std::uint8_t>(removeCoincident),
                                .lineMerge = static_cast<std::uint8_t>(lineMerge)}));
    EXPECT_EQ(HostState().lastCleanupCode, code);
    EXPECT_EQ(Count("overlay shadows"), code < 0 ? 0 : 1);
    EXPECT_EQ(Count("qel_put_long_name 1"), code < 0 ? 0 : 1);
    EXPECT_FLOAT_EQ(static_cast<float>(HostState().lastCleanupTolerance), code < 0 ? 0.0F : 0.01F);
    EXPECT_EQ(globr[41], 2.0F);
  }
}

TEST_F(Save2DTest, RewriteSwitchHoldsOnlyDuringTheMergeAndIsAlwaysWrittenBack) {
  struct Case {
    const char* before;  // null: the host has no such symbol
    std::uint8_t overwrite;
    bool writtenBeforeMerge;
    std::string after;
  };
  AddCube();
  Show(kGeometric);
  for (const Case& c : {Case{nullptr, 0, true, "1"}, Case{nullptr, 1, false, "1"}, Case{"1", 1, false, "1"},
                        Case{"0", 0, false, "0"}, Case{"0", 1, true, "0"}, Case{"0.6", 1, false, "1"}}) {
    SCOPED_TRACE(testing::Message() << (c.before != nullptr ? c.before : "(none)") << ", " << int{c.overwrite});
    HostState().symbols.clear();
    if (c.before != nullptr) HostState().symbols["@config@save2drewrite"] = c.before;
    Bench().GetJournal().Clear();
    ASSERT_TRUE(Save(Target(), {.overwrite = c.overwrite}));
    Calls around{"merge_save2d_files", "SetSymbolString"}, seen;
    if (c.writtenBeforeMerge) around.insert(around.begin(), "SetSymbolString");
    std::ranges::copy_if(Steps(), std::back_inserter(seen),
                         [](const std::string& s) { return s == "SetSymbolString" || s == "merge_save2d_files"; });
    EXPECT_EQ(seen, around);
    EXPECT_EQ(HostState().lastMergeReplaced, c.overwrite == 1);
    EXPECT_EQ(Symbol(), c.after);
  }
  // A merge that fails is reported, and the switch and the clean-up setting are put back as well.
  HostState().symbols["@config@save2drewrite"] = "0";
  globr[41] = 2.0F;
  wb::FaultRule rule;
  rule.call = "execute_internal_command";
  rule.attribute = "merge_save2d_files";
  Bench().GetFaults().Add(rule);
  EXPECT_FALSE(Save(Folder() / "failed", {.overwrite = 1, .removeCoincident = 1}));
  EXPECT_EQ(Symbol(), "0");
  EXPECT_EQ(globr[41], 2.0F);
  EXPECT_FALSE(std::filesystem::exists(Folder() / "failed.dxf"));
}

TEST_F(Save2DTest, AViewThatComesOutEmptyIsNotSavedAndLeavesTheOldFiles) {
  AddCube();
  const std::filesystem::path dxf = Target().string() + ".dxf";
  drawing_file_samples::WriteBytes(dxf, {'o', 'l', 'd'});
  // Looking away from the only solid, in each merge mode.
  Show({{0.5F, -10.0F, 0.5F}, {0.5F, -20.0F, 0.5F}, true});
  for (const std::uint8_t overwrite : {std::uint8_t{1}, std::uint8_t{0}}) {
    EXPECT_FALSE(Save(Target(), {.overwrite = overwrite}));
    EXPECT_EQ(drawing_file_samples::ReadBytes(dxf), (std::vector<std::uint8_t>{'o', 'l', 'd'}));
    EXPECT_FALSE(std::filesystem::exists(Target().string() + ".svg"));
  }
}

TEST_F(Save2DTest, LockedTargetIsRefusedBeforeAnyTwoDCommand) {
  const host::EntityHandle text = AddEntity(5, kText);
  Show(kGeometric);
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

TEST_F(Save2DTest, EachOptionSelectsItsOwnCategoryAndFlagBitTwoKeepsAnyEntityOut) {
  // Over every pair of codes (byte 3 first): sixteen kinds of wall, eleven of dimension, five of text.
  std::map<std::int32_t, int> perCategory;
  for (int pair = 0; pair < 65536; ++pair) {
    ++perCategory[HRUtility::PreserveCategory(static_cast<std::uint8_t>(pair >> 8), static_cast<std::uint8_t>(pair))];
  }
  EXPECT_EQ(perCategory, (std::map<std::int32_t, int>{{-1, 65536 - 32}, {0, 16}, {1, 11}, {2, 5}}));
  EXPECT_EQ(HRUtility::PreserveCategory(4, 44), 1);

  const host::EntityHandle dimension = AddEntity(3, kDimension), uncategorised = AddEntity(3, {4, 3});
  // Every flag bit but bit 2 is no reason to keep an entity out.
  const host::EntityHandle text = AddEntity(3, {11, 7}), wall = AddEntity(3, {9, 33}, 0xFB);
  for (const Category category : {kDimension, kText, Category{1, 3}, kNone}) {
    for (const int flags : {4, 0xFF}) AddEntity(3, category, static_cast<std::uint8_t>(flags));
  }
  EXPECT_EQ(Select(true, false, false), (Handles{dimension}));
  EXPECT_EQ(Select(false, true, false), (Handles{text}));
  EXPECT_EQ(Select(false, false, true), (Handles{wall}));
  EXPECT_EQ(Select(true, true, true, 4), (Handles{dimension, uncategorised, text, wall}));
  EXPECT_TRUE(Select(false, false, false).empty());
  // The walk ends with the host's change record closed.
  EXPECT_EQ(Bench().GetJournal().ChangeRecords().back(), (std::pair<host::EntityHandle, std::int32_t>{-1, -1}));
}

TEST_F(Save2DTest, LayerOptionComparesTheLayerNumberWhichIsTheIndexPlusOne) {
  const host::EntityHandle onFifth = AddEntity(4, kNone);
  Show({{0.0F, -10.0F, 0.0F}, {0.0F, 0.0F, 0.0F}});
  for (const std::int16_t index : {std::int16_t{4}, std::int16_t{5}}) {
    Bench().GetJournal().Clear();
    ASSERT_TRUE(Save(Folder() / std::to_string(index), {.layer = 1, .layerIndex = index}));
    EXPECT_EQ(Count("select_app_entity " + std::to_string(onFifth)), index == 4 ? 1 : 0);
  }
  // The table's ends can be kept; numbers outside it match nothing, also not by wrapping round a byte.
  const host::EntityHandle first = AddEntity(0, kNone), last = AddEntity(255, kNone);
  EXPECT_EQ(Select(false, false, false, 1), (Handles{first}));
  EXPECT_EQ(Select(false, false, false, 256), (Handles{last}));
  for (const int outside : {0, 257, 261, -255}) EXPECT_EQ(Select(false, false, false, outside), Handles{}) << outside;
}

}  // namespace
}  // namespace output2d_test
