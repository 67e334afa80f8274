// Which entities the preserve options set aside: the category table, the layer option, the
// flag that keeps an entity out, design-mode frames, and the extraction that follows.
#include <array>
#include <map>

#include "display/save2d.h"
#include "shell/host/argument_blocks.h"
#include "tests/output2d/output2d_fixture.h"

namespace output2d_test {
namespace {

class PreserveSelectionTest : public Output2DTest {
 protected:
  // An entity the loop reports with the given bytes: layer index, category and flag byte.
  static host::EntityHandle AddEntity(std::uint8_t layerIndex, Category category, std::uint8_t flags = 0) {
    wb::Entity& entity = draft_test::AddLine(Drawing(), {0.0F, 0.0F, 0.0F}, {1.0F, 0.0F, 0.0F}, layerIndex);
    SetCategory(entity, category);
    entity.header.bytes[host::kHeaderLoopFlags] = flags;
    return entity.handle;
  }

  struct Wanted {
    bool dimensions = false;
    bool texts = false;
    bool walls = false;
    bool layer = false;
    std::int32_t layerNumber = 0;
  };
  static std::vector<host::EntityHandle> Select(const Wanted& wanted) {
    HRUtility::ClearSelection();
    HRUtility::SelectPreserved(wanted.dimensions, wanted.texts, wanted.walls, wanted.layer, wanted.layerNumber);
    return HostState().selection;
  }
  static bool Selected(host::EntityHandle entity, const Wanted& wanted) {
    const std::vector<host::EntityHandle> selection = Select(wanted);
    return std::find(selection.begin(), selection.end(), entity) != selection.end();
  }
};

TEST_F(PreserveSelectionTest, CategoryTableSortsByteCodesIntoWallsDimensionsAndTexts) {
  EXPECT_EQ(HRUtility::PreserveCategory(4, 44), 1);
  EXPECT_EQ(HRUtility::PreserveCategory(4, 3), -1);
  EXPECT_EQ(HRUtility::PreserveCategory(3, 4), -1) << "byte 3 first, byte 1 second";
  EXPECT_EQ(HRUtility::PreserveCategory(1, 3), 0);
  EXPECT_EQ(HRUtility::PreserveCategory(10, 28), 0);
  EXPECT_EQ(HRUtility::PreserveCategory(10, 46), 1);
  EXPECT_EQ(HRUtility::PreserveCategory(12, 7), 2);
  EXPECT_EQ(HRUtility::PreserveCategory(0, 0), -1);

  // Over every pair of codes: sixteen kinds of wall, eleven of dimension, five of text.
  std::map<std::int32_t, int> perCategory;
  for (int kind = 0; kind < 256; ++kind) {
    for (int code = 0; code < 256; ++code) {
      ++perCategory[HRUtility::PreserveCategory(static_cast<std::uint8_t>(kind), static_cast<std::uint8_t>(code))];
    }
  }
  EXPECT_EQ(perCategory[0], 16);
  EXPECT_EQ(perCategory[1], 11);
  EXPECT_EQ(perCategory[2], 5);
  EXPECT_EQ(perCategory.size(), 4U);
}

TEST_F(PreserveSelectionTest, EachOptionSelectsItsOwnCategoryOnly) {
  const host::EntityHandle dimension = AddEntity(3, {4, 44});
  const host::EntityHandle noCategory = AddEntity(3, {4, 3});
  const host::EntityHandle text = AddEntity(3, {11, 7});
  const host::EntityHandle wall = AddEntity(3, {9, 33});

  using Handles = std::vector<host::EntityHandle>;
  EXPECT_EQ(Select({.dimensions = true}), (Handles{dimension}));
  EXPECT_EQ(Select({.texts = true}), (Handles{text}));
  EXPECT_EQ(Select({.walls = true}), (Handles{wall}));
  EXPECT_EQ(Select({.dimensions = true, .texts = true, .walls = true}), (Handles{dimension, text, wall}));
  EXPECT_EQ(Select({.layer = true, .layerNumber = 4}), (Handles{dimension, noCategory, text, wall}));
  EXPECT_TRUE(Select({}).empty());

  // The walk ends with the host's change record closed.
  const std::vector<std::pair<host::EntityHandle, std::int32_t>> records = Bench().GetJournal().ChangeRecords();
  ASSERT_FALSE(records.empty());
  EXPECT_EQ(records.back(), (std::pair<host::EntityHandle, std::int32_t>{-1, -1}));
}

TEST_F(PreserveSelectionTest, LayerOptionComparesTheLayerNumberWhichIsTheIndexPlusOne) {
  const host::EntityHandle onFifth = AddEntity(4, {0, 0});  // layer number 5
  Show({{0.0F, -10.0F, 0.0F}, {0.0F, 0.0F, 0.0F}});

  Bench().GetJournal().Clear();
  ASSERT_TRUE(Save(Folder() / "index4", {.layer = 1, .layerIndex = 4}));
  EXPECT_EQ(Count(Steps(), "select_app_entity " + std::to_string(onFifth)), 1);

  Bench().GetJournal().Clear();
  ASSERT_TRUE(Save(Folder() / "index5", {.layer = 1, .layerIndex = 5}));
  EXPECT_EQ(Count(Steps(), "select_app_entity " + std::to_string(onFifth)), 0);
}

TEST_F(PreserveSelectionTest, EveryLayerOfTheTableCanBeKept) {
  for (const int index : {0, 126, 127, 128, 199, 254, 255}) {
    SCOPED_TRACE(testing::Message() << "layer index " << index);
    const host::EntityHandle entity = AddEntity(static_cast<std::uint8_t>(index), {0, 0});
    const host::EntityHandle neighbour = AddEntity(static_cast<std::uint8_t>(index == 255 ? 0 : index + 1), {0, 0});
    EXPECT_EQ(Select({.layer = true, .layerNumber = index + 1}), (std::vector<host::EntityHandle>{entity}));
    Drawing().Remove(entity);
    Drawing().Remove(neighbour);
  }
  // Numbers outside the table match nothing, also not by wrapping round a byte.
  const host::EntityHandle first = AddEntity(0, {0, 0});
  EXPECT_FALSE(Selected(first, {.layer = true, .layerNumber = 257}));
  EXPECT_FALSE(Selected(first, {.layer = true, .layerNumber = 0}));
  EXPECT_FALSE(Selected(first, {.layer = true, .layerNumber = -255}));
}

TEST_F(PreserveSelectionTest, FlagBitTwoKeepsAnEntityOutWhateverItIs) {
  const Wanted everything{.dimensions = true, .texts = true, .walls = true, .layer = true, .layerNumber = 3};
  for (const Category category : {Category{4, 44}, Category{1, 7}, Category{1, 3}, Category{0, 0}}) {
    EXPECT_FALSE(Selected(AddEntity(2, category, 4), everything));
    EXPECT_FALSE(Selected(AddEntity(2, category, 0xFF), everything));
    EXPECT_TRUE(Selected(AddEntity(2, category, 0xFB), everything)) << "every other flag bit is no reason";
  }
}

TEST_F(PreserveSelectionTest, DesignModeLeavesTheSheetFramesOut) {
  const host::EntityHandle frame = AddEntity(2, kTextCategory);
  wb::Attribute marker;
  marker.name = "@dsgframe=";
  marker.type = wb::AttributeType::Short;
  Drawing().Find(frame)->attributes.push_back(marker);
  const host::EntityHandle text = AddEntity(2, kTextCategory);

  globc[65] = 'p';
  EXPECT_EQ(Select({.texts = true}), (std::vector<host::EntityHandle>{text}));
  globc[65] = ' ';
  EXPECT_EQ(Select({.texts = true}), (std::vector<host::EntityHandle>{frame, text}));
}

TEST_F(PreserveSelectionTest, ExtractionRunsOnlyForASelectionAndNamesTheModesWorkFile) {
  AddEntity(2, kTextCategory);
  Bench().GetJournal().Clear();
  HRUtility::ClearSelection();
  HRUtility::ExtractSelection();
  EXPECT_EQ(Steps(), (std::vector<std::string>{"overlay qel_sel", "selection_exist"}));
  EXPECT_EQ(globc[320], ' ');
  EXPECT_EQ(globc[400], ' ');

  for (const char mode : {' ', 'p'}) {
    globc[65] = mode;
    Select({.texts = true});
    Bench().GetJournal().Clear();
    HRUtility::ExtractSelection();
    EXPECT_EQ(Steps(), (std::vector<std::string>{"selection_exist", "overlay extract"}));
    EXPECT_EQ(std::string(globc, 8), mode == 'p' ? "prespdsg" : "presp   ");
    EXPECT_EQ(globr[9], 1.0F);
    EXPECT_EQ(HostState().preserved, HostState().selection);
  }
}

TEST_F(PreserveSelectionTest, BlankingHidesTheSelectionAndShowsOnlyThatAgain) {
  const host::EntityHandle kept = AddEntity(2, kTextCategory);
  const host::EntityHandle alreadyHidden = AddEntity(2, kTextCategory);
  Drawing().Find(alreadyHidden)->header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
  const host::EntityHandle other = AddEntity(2, {0, 0});
  Select({.texts = true});

  Bench().GetJournal().Clear();
  HRUtility::BlankForGeneration();
  EXPECT_EQ(Steps(), (std::vector<std::string>{"overlay blank", "overlay blank", "overlay blank"}));
  EXPECT_EQ(globc[0], '4') << "the passes run '3', '1', '4'";
  EXPECT_TRUE(Drawing().Find(kept)->Hidden());
  EXPECT_FALSE(Drawing().Find(other)->Hidden());

  HRUtility::UnblankAfterGeneration();
  EXPECT_FALSE(Drawing().Find(kept)->Hidden());
  EXPECT_TRUE(Drawing().Find(alreadyHidden)->Hidden()) << "what was hidden before stays hidden";
  EXPECT_EQ(globc[0], '2');
}

}  // namespace
}  // namespace output2d_test
