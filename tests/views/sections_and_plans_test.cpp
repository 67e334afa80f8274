// Sections and plans: the section symbol laid out in its frame, the records written on create and
// save, the cut and plan views, the class tests that find every kind of view, and hiding and
// showing every section symbol at once.
#include <string>
#include <vector>

#include "display/display_mode.h"
#include "model/status_codes.h"
#include "tests/views/views_fixture.h"
#include "views/hr_selection.h"
#include "views/section_symbols.h"
#include "views/view_collection.h"

namespace {

class SectionsAndPlansTest : public ViewsTest {
 protected:
  // The entities a stored section consists of, found from its instance as a reader would.
  struct Parts {
    host::EntityHandle instance, block, line, startMark, endMark, startLabel, endLabel;
  };
  static Parts PartsOf(host::EntityHandle instance) {
    const host::EntityHandle block = wb::ReadRecord<host::PlacedBlockRecord>(*Find(instance)).block;
    const std::vector<host::EntityHandle>& m = Find(block)->members;
    return {instance, block, m.at(0), m.at(1), m.at(2), m.at(3), m.at(4)};
  }

  // Where a point of an entity's own frame lies in the drawing: p' = (x, y, z, 1) * M, row by row.
  template <typename Record = host::PlacedBlockRecord>
  static host::Point3f Placed(host::EntityHandle entity, host::Point3f p) {
    const Record record = wb::ReadRecord<Record>(*Find(entity));
    const auto& m = record.placement;
    return {static_cast<float>(p.x * m[0] + p.y * m[4] + p.z * m[8] + m[12]),
            static_cast<float>(p.x * m[1] + p.y * m[5] + p.z * m[9] + m[13]),
            static_cast<float>(p.x * m[2] + p.y * m[6] + p.z * m[10] + m[14])};
  }
  static host::LineRecord LineOf(host::EntityHandle entity) { return wb::ReadRecord<host::LineRecord>(*Find(entity)); }
};

TEST_F(SectionsAndPlansTest, SectionSymbolIsLaidOutAlongTheSectionFrameAndMovesWithIt) {
  HRSection section;
  const Parts parts = PartsOf(StoreSection(section, "A-A"));
  // Line, label anchors and second points, and the end mark as the start mark mirrored.
  EXPECT_EQ(Rounded({LineOf(parts.line).end, LineOf(parts.startLabel).start, LineOf(parts.endLabel).start,
                     LineOf(parts.endLabel).end, Placed<host::ElementRecord>(parts.startMark, {1, 0, 0}),
                     Placed<host::ElementRecord>(parts.endMark, {1, 0, 0})}),
            "(5 0 0)(0.3 0 0)(4.7 0 0)(5.7 0 0)(1 0 0)(4 0 0)");
  EXPECT_EQ(AttributeOf(parts.endLabel, "t=")->text, "A-A");
  // The frame's second axis points left of the cut.
  const double start[3] = {5, 5, 0};
  const double end[3] = {5, 11, 0};
  section.Move(start, end);
  EXPECT_EQ(Rounded({LineOf(parts.line).end, Placed(parts.instance, {6, 0, 0}), Placed(parts.instance, {0, 6, 0})}),
            "(6 0 0)(5 11 0)(-1 5 0)");
  HRSection zero;  // a cut of zero length is laid out without failing
  EXPECT_EQ(Rounded({LineOf(PartsOf(StoreSection(zero, "C-C", {3, 3, 0}, {3, 3, 0})).endLabel).start}), "(-0.3 0 0)");
}

TEST_F(SectionsAndPlansTest, SectionCreateAndSaveWriteTheRecordMarksAndChangeRecordsInOrder) {
  HRSection section;
  SectionSettings settings;
  settings.cutType = HRSection::kCutWhole;
  section.SetName("D-D");
  section.SetSettings(settings);
  section.SetFor2D(7);
  ClearJournal();
  ASSERT_EQ(section.Create(), 0);
  const Parts parts = PartsOf(section.GetHandle());
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{parts.block, 1}, {parts.instance, 1}, {-1, -1}}));
  EXPECT_EQ(WritesTo(parts.instance), (StepList{"@Class=", "@sec=", "@S2D=", "@type="}));
  EXPECT_EQ(AttributeOf(parts.instance, "@S2D=")->shortValue, 7);  // create keeps the value as given
  EXPECT_EQ(AttributeOf(parts.instance, "@type=")->text, "w");
  EXPECT_EQ(AttributeOf(parts.endMark, "@dim_typ")->text, "end");  // the marks' role key has no "="

  ClearJournal();
  ASSERT_EQ(section.Save(), 0);
  std::vector<ChangeRecord> expected;
  for (const auto entity : {parts.block, parts.line, parts.startMark, parts.endMark, parts.startLabel, parts.endLabel})
    expected.emplace_back(entity, 5);
  expected.insert(expected.end(), {{parts.instance, 5}, {-1, -1}});
  EXPECT_EQ(ChangeRecords(), expected);
  EXPECT_EQ(WritesTo(parts.instance), (StepList{"@S2D=", "@type="}));
  EXPECT_EQ(AttributeOf(parts.instance, "@S2D=")->shortValue, 1);  // save writes 0 or 1
}

TEST_F(SectionsAndPlansTest, CutViewHandsTheHostTheFramePointsAndEndsInHiddenLines) {
  HRSection section;
  StoreSection(section, "S-S", {2, 2, 5}, {2, 6, 5});
  section.SetCutType(HRSection::kCutOff);
  ClearJournal();
  EXPECT_EQ(section.ShowView(-1), 0);
  // Start, end, a point above the start and the side point.
  EXPECT_EQ(Rounded({globp[0], globp[1], globp[2], globp[3]}), "(2 2 5)(2 6 5)(2 2 6)(-2 2 5)");
  EXPECT_EQ(Steps(), (StepList{"inq_render_mode", "inq_render_mode", "set_background_color", "wire_frame_all",
                               "set_dspmode_info", "new_solid", "redraw_all", "set_dspmode_info", "set_vsect_plane",
                               "inq_render_mode", "hidden_lines"}));
  EXPECT_EQ(Bench().View().section.cutType, 'o');
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kHiddenline);
  EXPECT_TRUE(Find(section.GetHandle())->Hidden());  // no section symbol shows in the cut view
}

TEST_F(SectionsAndPlansTest, PlanCreateAndSaveWriteTheRecordInOrderAndLoadNeedsAllOfIt) {
  HRPlane plane;
  plane.SetFor2D(1);
  ClearJournal();
  const host::EntityHandle entity = StorePlan(plane, "Level 1");
  EXPECT_EQ(WritesTo(entity), (StepList{"@Class=", "@base=", "@dir=", "@name=", "@S2D="}));
  EXPECT_EQ(AttributeOf(entity, "@base=")->floats, (std::vector<float>{1, 2, 0}));
  EXPECT_EQ(AttributeOf(entity, "@dir=")->floats, (std::vector<float>{1, 2, 5}));
  EXPECT_EQ(AttributeOf(entity, "@name=")->text, "Level 1");
  EXPECT_EQ(AttributeOf(entity, "@S2D=")->shortValue, 1);
  ClearJournal();
  ASSERT_EQ(plane.Save(), 0);
  EXPECT_EQ(WritesTo(entity), (StepList{"@base=", "@dir=", "@name=", "@S2D="}));  // no empty camera list

  const std::vector<wb::Attribute> intact = Find(entity)->attributes;
  for (const char* key : {"@base=", "@dir=", "@name="}) {
    DropAttribute(entity, key);
    EXPECT_EQ(plane.Load(entity), model_status::kAttributeFailed) << key;
    Find(entity)->attributes = intact;
  }
}

TEST_F(SectionsAndPlansTest, PlanViewHandsTheHostBaseAxesAndSecondPoint) {
  HRPlane plane;
  StorePlan(plane);
  plane.SetCutType('w');
  SectionsShown = 0;
  globr[103] = 0.0F;
  ClearJournal();
  EXPECT_EQ(plane.ShowView(-1), 0);
  EXPECT_EQ(Rounded({globp[0], globp[1], globp[2], globp[3]}), "(1 2 0)(101 2 0)(1 102 0)(1 2 5)");
  EXPECT_EQ(Steps(), (StepList{"inq_render_mode", "set_background_color", "wire_frame_all", "set_dspmode_info",
                               "draw_text_on_off", "new_solid", "redraw_all", "set_dspmode_info", "planv",
                               "inq_render_mode", "hidden_lines"}));
  EXPECT_EQ(Bench().View().plan.cutType, 'w');
  EXPECT_FALSE(Bench().Display().textShown);
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kHiddenline);

  // While rendering the plan view is refused before anything changes.
  HRUtility::SetDisplayMode(HRUtility::kRender);
  ClearJournal();
  EXPECT_EQ(plane.ShowView(-1), -28);
  EXPECT_EQ(Steps(), StepList{"inq_render_mode"});
}

TEST_F(SectionsAndPlansTest, ViewClassTestsAreExactAndCollectionsFindEveryViewOfTheirClass) {
  HRPlane plan;
  HRSelection selection;
  ASSERT_EQ(selection.Create(), 0);
  struct ViewKind {
    std::string marker, lowerCase;
    host::EntityHandle entity;
    bool (*is)(host::EntityHandle);
  };
  const ViewKind kinds[] = {
      {"HRSection", "hrsection", StoreSection(), [](host::EntityHandle e) { return IsSection(Bench().Current(), e); }},
      {"HRPlane", "hrplane", StorePlan(plan), [](host::EntityHandle e) { return IsPlaneEntity(Bench().Current(), e); }},
      {"HRSelection", "hrselection", selection.GetHandle(), [](host::EntityHandle e) { return IsSelection(e) == 1; }},
  };
  for (const ViewKind& kind : kinds) {
    SCOPED_TRACE(kind.marker);
    EXPECT_TRUE(kind.is(kind.entity));
    for (const std::string& near : {kind.lowerCase, kind.marker + " ", kind.marker.substr(0, kind.marker.size() - 1)}) {
      PutString(kind.entity, "@Class=", near);
      EXPECT_FALSE(kind.is(kind.entity)) << '"' << near << '"';
    }
    PutString(kind.entity, "@Class=", kind.marker);
  }
  // The collections find every view of their own class, hidden ones included.
  Flags(plan.GetHandle()) |= host::kFlagHidden;
  const host::EntityHandle second = StoreSection("B");
  EXPECT_EQ(CollectSectionHandles(Bench().Current()), (std::vector<host::EntityHandle>{kinds[0].entity, second}));
  EXPECT_EQ(CollectPlanHandles(Bench().Current()), std::vector<host::EntityHandle>{plan.GetHandle()});
  EXPECT_EQ(CollectSelectionHandles(), std::vector<host::EntityHandle>{selection.GetHandle()});
}

TEST_F(SectionsAndPlansTest, HidingAndShowingSymbolsReachesSectionsOnlyAndKeepsTheOtherFlagBits) {
  const host::EntityHandle camera = StoreCamera("Camera");
  Flags(camera) |= host::kFlagHidden;
  const host::EntityHandle first = StoreSection("A");
  const host::EntityHandle alreadyHidden = StoreSection("B");
  const host::EntityHandle third = StoreSection("C");
  Flags(first) = 0x5A;
  Flags(alreadyHidden) |= host::kFlagHidden;
  SectionsShown = 1;
  ClearJournal();
  HideSectionSymbols();
  EXPECT_EQ(Flags(first), 0xDA);
  EXPECT_TRUE(Find(third)->Hidden());
  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{first, 5}, {-1, -1}, {third, 5}, {-1, -1}}));
  EXPECT_EQ(SectionsShown, 1);  // only applying a camera changes the flag
  ShowSectionSymbols();
  EXPECT_EQ(Flags(first), 0x5A);
  EXPECT_FALSE(Find(alreadyHidden)->Hidden());
  EXPECT_TRUE(Find(camera)->Hidden());
  // An unreadable section is skipped and the walk goes on.
  FailOn("qel_read_entity_header", "", first);
  HideSectionSymbols();
  EXPECT_EQ(Flags(first), 0x5A);
  EXPECT_TRUE(Find(third)->Hidden());
  // A section with fewer members than it should have still loads, and hides its own symbol alike.
  Bench().GetFaults().Clear();
  Find(wb::ReadRecord<host::PlacedBlockRecord>(*Find(first)).block)->members.resize(3);
  HRSection section;
  ASSERT_EQ(section.Load(first), 0);
  EXPECT_EQ(section.HideSymbol(), 0);
  EXPECT_EQ(Flags(first), 0xDA);
}

}  // namespace
