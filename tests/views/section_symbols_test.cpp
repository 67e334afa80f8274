// Section symbol visibility: which entities count as sections, and hiding and showing every
// section symbol of the drawing at once.
#include <string>
#include <vector>

#include "tests/views/views_fixture.h"
#include "views/hr_plane.h"
#include "views/hr_selection.h"
#include "views/section_symbols.h"
#include "views/view_collection.h"

namespace {

class SectionSymbolsTest : public ViewsTest {
 protected:
  static std::uint8_t& Flags(host::EntityHandle entity) { return Find(entity)->header.bytes[host::kHeaderFlags]; }
  static bool Hidden(host::EntityHandle entity) { return Find(entity)->Hidden(); }
};

TEST_F(SectionSymbolsTest, SectionTestIsExactAndCaseSensitive) {
  const host::EntityHandle section = StoreSection("A");
  const host::DatabaseHandle database = Bench().Current();
  EXPECT_TRUE(IsSection(database, section));
  for (const char* near : {"hrsection", "HRSection ", "HRCamera", "hrSecCam", "HRSectio", " HRSection"}) {
    PutString(section, "@Class=", near);
    EXPECT_FALSE(IsSection(database, section)) << '"' << near << '"';
  }
  DropAttribute(section, "@Class=");
  EXPECT_FALSE(IsSection(database, section));
  EXPECT_FALSE(IsSection(database, 12345));
  PutString(section, "@Class=", "HRSection");
  FailNext("qel_open_attribute_record");
  EXPECT_FALSE(IsSection(database, section));
  EXPECT_TRUE(IsSection(database, section));
}

TEST_F(SectionSymbolsTest, DrawingWithoutSectionsIsLeftAlone) {
  const host::EntityHandle line = Drawing().Add(host::kTypeLine).handle;
  const host::EntityHandle group = StoreCamera("Camera");
  Flags(group) |= host::kFlagHidden;
  ClearJournal();
  HideSectionSymbols();
  ShowSectionSymbols();
  EXPECT_TRUE(ChangeRecords().empty());
  EXPECT_FALSE(Hidden(line));
  EXPECT_TRUE(Hidden(group));  // showing reaches sections only
}

TEST_F(SectionSymbolsTest, HideReachesVisibleSectionsOnly) {
  const host::EntityHandle first = StoreSection("A");
  const host::EntityHandle alreadyHidden = StoreSection("B");
  const host::EntityHandle third = StoreSection("C");
  Flags(alreadyHidden) |= host::kFlagHidden;
  ClearJournal();
  HideSectionSymbols();
  EXPECT_TRUE(Hidden(first));
  EXPECT_TRUE(Hidden(alreadyHidden));
  EXPECT_TRUE(Hidden(third));
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{first, 5}, {-1, -1}, {third, 5}, {-1, -1}}));
}

TEST_F(SectionSymbolsTest, ShowReachesEverySectionHiddenOrNot) {
  const host::EntityHandle visible = StoreSection("A");
  const host::EntityHandle hidden = StoreSection("B");
  Flags(hidden) |= host::kFlagHidden;
  ClearJournal();
  ShowSectionSymbols();
  EXPECT_FALSE(Hidden(visible));
  EXPECT_FALSE(Hidden(hidden));
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{visible, 5}, {-1, -1}, {hidden, 5}, {-1, -1}}));
}

TEST_F(SectionSymbolsTest, HidingAndShowingKeepsTheOtherFlagBits) {
  const host::EntityHandle section = StoreSection("A");
  Flags(section) = 0x5A;
  HideSectionSymbols();
  EXPECT_EQ(Flags(section), 0xDA);
  ShowSectionSymbols();
  EXPECT_EQ(Flags(section), 0x5A);
}

TEST_F(SectionSymbolsTest, SymbolsOfOtherEntitiesAndMembersStayAsTheyAre) {
  const host::EntityHandle section = StoreSection("A");
  const host::EntityHandle block = wb::ReadRecord<host::PlacedBlockRecord>(*Find(section)).block;
  const host::EntityHandle line = Find(block)->members[0];
  HideSectionSymbols();
  EXPECT_TRUE(Hidden(section));
  EXPECT_FALSE(Hidden(block));
  EXPECT_FALSE(Hidden(line));
}

TEST_F(SectionSymbolsTest, UnreadableSectionIsSkippedAndTheWalkGoesOn) {
  const host::EntityHandle first = StoreSection("A");
  const host::EntityHandle second = StoreSection("B");
  FailForEntity("qel_read_entity_header", first);
  HideSectionSymbols();
  EXPECT_FALSE(Hidden(first));
  EXPECT_TRUE(Hidden(second));
}

TEST_F(SectionSymbolsTest, FlagStartsOffAndOnlyCameraApplicationWritesIt) {
  EXPECT_EQ(SectionsShown, 0);
  StoreSection("A");
  ShowSectionSymbols();
  EXPECT_EQ(SectionsShown, 0);
  SectionsShown = 1;
  HideSectionSymbols();
  EXPECT_EQ(SectionsShown, 1);
  // A fresh library starts with the flag off again.
  Bench().UnloadPlugin();
  Bench().LoadPlugin({pandex::kExports.attach, pandex::kExports.detach, pandex::kExports.entry});
  EXPECT_EQ(SectionsShown, 0);
}

TEST_F(SectionSymbolsTest, CollectionsFindEveryViewOfItsClassHiddenOnesIncluded) {
  const host::EntityHandle first = StoreSection("A");
  const host::EntityHandle hidden = StoreSection("B");
  Flags(hidden) |= host::kFlagHidden;
  StoreCamera("Not a view");
  HRPlane plan;
  const double base[3] = {0, 0, 0};
  plan.Define("P", base, base);
  ASSERT_EQ(plan.Create(), 0);
  Flags(plan.GetHandle()) |= host::kFlagHidden;
  HRSelection selection;
  selection.SetName("S");
  ASSERT_EQ(selection.Create(), 0);

  EXPECT_EQ(CollectSectionHandles(Bench().Current()), (std::vector<host::EntityHandle>{first, hidden}));
  EXPECT_EQ(CollectPlanHandles(Bench().Current()), std::vector<host::EntityHandle>{plan.GetHandle()});
  EXPECT_EQ(CollectSelectionHandles(), std::vector<host::EntityHandle>{selection.GetHandle()});
}

}  // namespace
