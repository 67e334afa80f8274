// Sections: the symbol laid out in the section's frame, the entities and record written on
// create and save, loading (damaged records included), the section's cameras, its cut view,
// deletion, and sections kept through a saved drawing file.
#include <algorithm>
#include <string>
#include <vector>

#include "display/display_mode.h"
#include "model/status_codes.h"
#include "tests/views/views_fixture.h"
#include "views/hr_section.h"
#include "views/section_symbols.h"

namespace {

struct Point {
  double x, y, z;
};

// p' = (x, y, z, 1) * M with M stored row by row.
template <typename Element>
Point Apply(const Element (&m)[16], Point p) {
  return {p.x * m[0] + p.y * m[4] + p.z * m[8] + m[12], p.x * m[1] + p.y * m[5] + p.z * m[9] + m[13],
          p.x * m[2] + p.y * m[6] + p.z * m[10] + m[14]};
}

void ExpectNear(Point actual, Point expected, const char* what) {
  EXPECT_NEAR(actual.x, expected.x, 1e-4) << what;
  EXPECT_NEAR(actual.y, expected.y, 1e-4) << what;
  EXPECT_NEAR(actual.z, expected.z, 1e-4) << what;
}

void ExpectNear(const host::Point3f& actual, Point expected, const char* what) {
  ExpectNear(Point{actual.x, actual.y, actual.z}, expected, what);
}

class SectionTest : public ViewsTest {
 protected:
  // The entities a stored section consists of, found from its instance as a reader would.
  struct Parts {
    host::EntityHandle instance, block, line, startMark, endMark, startLabel, endLabel;
  };

  static SectionSettings Settings(Point start, Point end) {
    SectionSettings settings;
    settings.start[0] = static_cast<float>(start.x);
    settings.start[1] = static_cast<float>(start.y);
    settings.start[2] = static_cast<float>(start.z);
    settings.end[0] = static_cast<float>(end.x);
    settings.end[1] = static_cast<float>(end.y);
    settings.end[2] = static_cast<float>(end.z);
    settings.symbolFile = "...sec_sym\\sec01";
    return settings;
  }

  // Made as the pane makes a new section: name, settings, create.
  static host::EntityHandle MakeSection(const std::string& name, Point start, Point end, HRSection* keep = nullptr) {
    HRSection local;
    HRSection& section = keep != nullptr ? *keep : local;
    section.SetName(name);
    section.SetSettings(Settings(start, end));
    EXPECT_EQ(section.Create(), 0);
    return section.GetHandle();
  }

  static Parts PartsOf(host::EntityHandle instance) {
    Parts parts{};
    parts.instance = instance;
    parts.block = wb::ReadRecord<host::PlacedBlockRecord>(*Find(instance)).block;
    const std::vector<host::EntityHandle>& members = Find(parts.block)->members;
    EXPECT_EQ(members.size(), 5U);
    if (members.size() == 5) {
      parts.line = members[0];
      parts.startMark = members[1];
      parts.endMark = members[2];
      parts.startLabel = members[3];
      parts.endLabel = members[4];
    }
    return parts;
  }

  static Point Placed(host::EntityHandle instance, Point frame) {
    return Apply(wb::ReadRecord<host::PlacedBlockRecord>(*Find(instance)).placement, frame);
  }

  static host::LineRecord LineOf(host::EntityHandle entity) { return wb::ReadRecord<host::LineRecord>(*Find(entity)); }
};

TEST_F(SectionTest, SymbolIsLaidOutAlongTheSectionFrame) {
  const Parts parts = PartsOf(MakeSection("A-A", {0, 0, 0}, {10, 0, 0}));
  EXPECT_EQ(Find(parts.instance)->Type(), host::kTypePlacedBlock);
  EXPECT_EQ(Find(parts.block)->Type(), host::kTypeBlock);
  EXPECT_EQ(Find(parts.line)->Type(), host::kTypeLine);
  EXPECT_EQ(Find(parts.startMark)->Type(), host::kTypeElement);
  EXPECT_EQ(Find(parts.endMark)->Type(), host::kTypeElement);
  EXPECT_NE(AttributeOf(parts.startLabel, "tb="), nullptr);
  EXPECT_EQ(AttributeOf(parts.line, "tb="), nullptr);

  const host::LineRecord line = LineOf(parts.line);
  ExpectNear(line.start, {0, 0, 0}, "line start");
  ExpectNear(line.end, {10, 0, 0}, "line end");
  ExpectNear(LineOf(parts.startLabel).start, {0.3, 0, 0}, "start label anchor");
  ExpectNear(LineOf(parts.startLabel).end, {1.3, 0, 0}, "start label second point");
  ExpectNear(LineOf(parts.endLabel).start, {9.7, 0, 0}, "end label anchor");
  ExpectNear(LineOf(parts.endLabel).end, {10.7, 0, 0}, "end label second point");
  EXPECT_EQ(AttributeOf(parts.endLabel, "tb=")->floats.at(6), 2.0F);
  EXPECT_EQ(AttributeOf(parts.endLabel, "t=")->text, "A-A");

  // The end mark is the start mark mirrored onto the far end.
  const auto endMark = wb::ReadRecord<host::ElementRecord>(*Find(parts.endMark));
  ExpectNear(Apply(endMark.placement, {1, 0, 0}), {9, 0, 0}, "end mark");
  const auto startMark = wb::ReadRecord<host::ElementRecord>(*Find(parts.startMark));
  ExpectNear(Apply(startMark.placement, {1, 0, 0}), {1, 0, 0}, "start mark");
  EXPECT_EQ(AttributeOf(parts.startMark, "@lfname=")->text, "sec01");
  EXPECT_EQ(AttributeOf(parts.startMark, "URL=")->text, "...sec_sym\\");

  ExpectNear(Placed(parts.instance, {0, 0, 0}), {0, 0, 0}, "origin");
  ExpectNear(Placed(parts.instance, {10, 0, 0}), {10, 0, 0}, "end");
  ExpectNear(Placed(parts.instance, {0, 10, 0}), {0, 10, 0}, "side point");
}

TEST_F(SectionTest, FramePutsTheSidePointLeftOfTheCut) {
  const host::EntityHandle instance = MakeSection("B-B", {2, 2, 5}, {2, 6, 5});
  ExpectNear(Placed(instance, {0, 0, 0}), {2, 2, 5}, "start");
  ExpectNear(Placed(instance, {4, 0, 0}), {2, 6, 5}, "end");
  ExpectNear(Placed(instance, {0, 4, 0}), {-2, 2, 5}, "side point");
  ExpectNear(Placed(instance, {0, 0, 1}), {2, 2, 6}, "up");
}

TEST_F(SectionTest, CutOfZeroLengthIsStoredWithoutFailing) {
  const Parts parts = PartsOf(MakeSection("C-C", {3, 3, 0}, {3, 3, 0}));
  ExpectNear(LineOf(parts.line).end, {0, 0, 0}, "line end");
  ExpectNear(LineOf(parts.endLabel).start, {-0.3, 0, 0}, "end label");
  HRSection loaded;
  ASSERT_EQ(loaded.Load(parts.instance), 0);
  EXPECT_EQ(loaded.GetName(), "C-C");
}

TEST_F(SectionTest, CreateWritesTheRecordMarksAndChangeRecordInOrder) {
  HRSection section;
  section.SetName("D-D");
  section.SetSettings(Settings({0, 0, 0}, {5, 5, 0}));
  section.SetFor2D(7);
  section.SetCutType(HRSection::kCutWhole);
  ClearJournal();
  ASSERT_EQ(section.Create(), 0);
  const Parts parts = PartsOf(section.GetHandle());

  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{parts.block, 1}, {parts.instance, 1}, {-1, -1}}));
  EXPECT_EQ(WritesTo(parts.instance), (std::vector<std::string>{"@Class=", "@sec=", "@S2D=", "@type="}));
  EXPECT_EQ(AttributeOf(parts.instance, "@Class=")->text, "HRSection");
  EXPECT_EQ(AttributeOf(parts.instance, "@sec=")->text, "0");
  EXPECT_EQ(AttributeOf(parts.instance, "@S2D=")->shortValue, 7);  // create keeps the value as given
  EXPECT_EQ(AttributeOf(parts.instance, "@type=")->text, "w");
  EXPECT_EQ(AttributeOf(parts.instance, "@CamLst="), nullptr);

  // The role key of the marks has no "=".
  EXPECT_EQ(WritesTo(parts.startMark).back(), "@dim_typ");
  EXPECT_EQ(AttributeOf(parts.startMark, "@dim_typ")->text, "start");
  EXPECT_EQ(AttributeOf(parts.endMark, "@dim_typ")->text, "end");
  EXPECT_EQ(AttributeOf(parts.startMark, "@dim_typ="), nullptr);
}

TEST_F(SectionTest, SaveUpdatesEveryEntityAndReportsEachChange) {
  HRSection section;
  const Parts parts = PartsOf(MakeSection("E-E", {0, 0, 0}, {8, 0, 0}, &section));
  section.SetFor2D(7);
  section.SetCutType(HRSection::kCutOff);
  ClearJournal();
  ASSERT_EQ(section.Save(), 0);

  EXPECT_EQ(ChangeRecords(), (std::vector<ChangeRecord>{{parts.block, 5},
                                                         {parts.line, 5},
                                                         {parts.startMark, 5},
                                                         {parts.endMark, 5},
                                                         {parts.startLabel, 5},
                                                         {parts.endLabel, 5},
                                                         {parts.instance, 5},
                                                         {-1, -1}}));
  EXPECT_EQ(WritesTo(parts.instance), (std::vector<std::string>{"@S2D=", "@type="}));
  EXPECT_EQ(AttributeOf(parts.instance, "@S2D=")->shortValue, 1);  // save writes 0 or 1
  EXPECT_EQ(AttributeOf(parts.instance, "@type=")->text, "o");
  EXPECT_EQ(AttributeOf(parts.startMark, "@dim_typ")->text, "start");
  EXPECT_EQ(AttributeOf(parts.endLabel, "tb=")->floats.at(6), 2.0F);

  section.SetFor2D(0);
  ASSERT_EQ(section.Save(), 0);
  EXPECT_EQ(AttributeOf(parts.instance, "@S2D=")->shortValue, 0);
}

TEST_F(SectionTest, SettingsComeBackFromALoadedSection) {
  HRSection section;
  section.SetName("F-F");
  SectionSettings settings = Settings({1, 2, 3}, {7, -4, 3});
  settings.lineType = 5;
  settings.lineWidth = 2;
  settings.lineColor = 300;  // the line keeps the low eight bits
  settings.cutType = HRSection::kCutOff;
  settings.comment = "not kept";
  section.SetSettings(settings);
  section.SetFor2D(1);
  ASSERT_EQ(section.Create(), 0);

  HRSection loaded;
  ASSERT_EQ(loaded.Load(section.GetHandle()), 0);
  SectionSettings read;
  loaded.GetSettings(read);
  for (int i = 0; i < 3; ++i) {
    EXPECT_NEAR(read.start[i], settings.start[i], 1e-4);
    EXPECT_NEAR(read.end[i], settings.end[i], 1e-4);
  }
  EXPECT_EQ(read.symbolFile, "...sec_sym\\sec01");
  EXPECT_EQ(read.comment, "");
  EXPECT_EQ(read.lineType, 5);
  EXPECT_EQ(read.lineWidth, 2);
  EXPECT_EQ(read.lineColor, 44);
  EXPECT_EQ(read.cutType, 'o');
  EXPECT_EQ(loaded.GetName(), "F-F");
  EXPECT_EQ(loaded.IsFor2D(), 1);
  EXPECT_EQ(loaded.GetCameraCount(), 0);
}

TEST_F(SectionTest, MoveLaysTheSymbolOutAgainInTheDrawing) {
  HRSection section;
  const Parts parts = PartsOf(MakeSection("G-G", {0, 0, 0}, {10, 0, 0}, &section));
  const double start[3] = {5, 5, 0};
  const double end[3] = {5, 11, 0};
  section.Move(start, end);
  ExpectNear(LineOf(parts.line).end, {6, 0, 0}, "line end");
  ExpectNear(LineOf(parts.endLabel).start, {5.7, 0, 0}, "end label");
  ExpectNear(Placed(parts.instance, {6, 0, 0}), {5, 11, 0}, "moved end");
  ExpectNear(Placed(parts.instance, {0, 6, 0}), {-1, 5, 0}, "moved side point");
  EXPECT_EQ(AttributeOf(parts.endLabel, "t=")->text, "G-G");
}

TEST_F(SectionTest, RecordWithoutTypeOrCameraListLoadsEmpty) {
  const host::EntityHandle instance = MakeSection("H-H", {0, 0, 0}, {4, 0, 0});
  DropAttribute(instance, "@type=");
  HRSection loaded;
  ASSERT_EQ(loaded.Load(instance), 0);
  EXPECT_EQ(loaded.GetCutType(), '\0');
  EXPECT_EQ(loaded.GetCameraCount(), 0);
}

TEST_F(SectionTest, LoadRefusesWhatIsNoSectionInstance) {
  HRSection section;
  EXPECT_EQ(section.Load(999), model_status::kHeaderNotRead);
  const host::EntityHandle group = Drawing().Add(host::kTypeGroup).handle;
  EXPECT_NE(section.Load(group), 0);
  // An instance whose block is gone.
  const Parts parts = PartsOf(MakeSection("I-I", {0, 0, 0}, {4, 0, 0}));
  Drawing().Remove(parts.block);
  EXPECT_NE(section.Load(parts.instance), 0);
}

TEST_F(SectionTest, BlockWithFewerMembersLoadsWhatItHas) {
  const Parts parts = PartsOf(MakeSection("J-J", {0, 0, 0}, {4, 0, 0}));
  Find(parts.block)->members.resize(3);
  HRSection loaded;
  ASSERT_EQ(loaded.Load(parts.instance), 0);
  EXPECT_EQ(loaded.GetName(), "");  // the labels are not members any more
  SectionSettings read;
  loaded.GetSettings(read);
  EXPECT_NEAR(read.end[0], 4.0F, 1e-4);
  EXPECT_EQ(read.symbolFile, "...sec_sym\\sec01");

  Find(parts.block)->members.clear();
  HRSection bare;
  EXPECT_EQ(bare.Load(parts.instance), 0);
  EXPECT_EQ(bare.GetName(), "");
}

TEST_F(SectionTest, DamagedCameraListsNeverReachPastTheList) {
  const host::EntityHandle instance = MakeSection("K-K", {0, 0, 0}, {4, 0, 0});
  PutString(instance, "@CamLst=", "12 13");
  HRSection wrongKind;
  ASSERT_EQ(wrongKind.Load(instance), 0);
  EXPECT_EQ(wrongKind.GetCameraCount(), 0);

  PutLongs(instance, "@CamLst=", {});
  HRSection empty;
  ASSERT_EQ(empty.Load(instance), 0);
  EXPECT_EQ(empty.GetCameraCount(), 0);

  // Handles of entities that are no cameras, or no entities at all.
  const host::EntityHandle line = Drawing().Add(host::kTypeLine).handle;
  PutLongs(instance, "@CamLst=", {line, 99999, -5});
  HRSection strangers;
  ASSERT_EQ(strangers.Load(instance), 0);
  ASSERT_EQ(strangers.GetCameraCount(), 3);
  ClearJournal();
  for (std::int32_t k = 0; k < 3; ++k) {
    EXPECT_EQ(strangers.GetCameraName(k), "");
    EXPECT_EQ(strangers.IsCameraFor2D(k), 0);
    strangers.SetCameraFor2D(k, 1);
    strangers.RenameCamera("renamed", k);
  }
  EXPECT_TRUE(WritesTo(line).empty());
  EXPECT_NE(strangers.RemoveCamera(0), 0);
  EXPECT_EQ(strangers.GetCameraCount(), 2);
  EXPECT_EQ(AttributeOf(instance, "@CamLst=")->longs, (std::vector<std::int32_t>{99999, -5}));
  EXPECT_NE(Find(line), nullptr);
}

TEST_F(SectionTest, CamerasAreAddedListedAndRemovedAtOnce) {
  HRSection section;
  const host::EntityHandle instance = MakeSection("L-L", {0, 0, 0}, {6, 0, 0}, &section);
  EXPECT_EQ(section.AddCamera("Default"), 0);
  EXPECT_EQ(section.AddCamera("Second"), 1);
  EXPECT_EQ(section.AddCamera("Third"), 2);
  const std::vector<host::EntityHandle> cameras = section.Cameras();
  EXPECT_EQ(AttributeOf(instance, "@CamLst=")->longs, cameras);
  EXPECT_EQ(AttributeOf(cameras[0], "@Class=")->text, "hrSecCam");
  EXPECT_EQ(section.GetCameraName(1), "Second");
  std::string copied;
  section.CopyCameraName(2, copied);
  EXPECT_EQ(copied, "Third");
  // Section cameras never join the general cameras.
  SetDatabase(Bench().Current());
  EXPECT_EQ(GetGeneralCameraCount(), 0);

  section.SetCameraFor2D(1, 1);
  section.RenameCamera("Renamed", 2);
  HRSection reloaded;
  ASSERT_EQ(reloaded.Load(instance), 0);
  EXPECT_EQ(reloaded.IsCameraFor2D(0), 0);
  EXPECT_EQ(reloaded.IsCameraFor2D(1), 1);
  EXPECT_EQ(reloaded.GetCameraName(2), "Renamed");

  EXPECT_EQ(reloaded.RemoveCamera(0), 0);
  EXPECT_EQ(Find(cameras[0]), nullptr);
  EXPECT_EQ(reloaded.GetCameraName(0), "Second");
  EXPECT_EQ(AttributeOf(instance, "@CamLst=")->longs, (std::vector<std::int32_t>{cameras[1], cameras[2]}));
  EXPECT_EQ(reloaded.RemoveCamera(1), 0);
  EXPECT_EQ(reloaded.RemoveCamera(0), 0);
  // The last removal takes the key away rather than leaving an empty list.
  EXPECT_EQ(AttributeOf(instance, "@CamLst="), nullptr);
  EXPECT_TRUE(Journaled(Kind::AttributeRemove, "@CamLst="));
}

TEST_F(SectionTest, RemovingACameraDeletedElsewhereDropsTheEntryOnly) {
  HRSection section;
  const host::EntityHandle instance = MakeSection("M-M", {0, 0, 0}, {6, 0, 0}, &section);
  section.AddCamera("One");
  section.AddCamera("Two");
  const std::vector<host::EntityHandle> cameras = section.Cameras();
  Drawing().Remove(cameras[0]);
  EXPECT_EQ(section.RemoveCamera(0), model_status::kHeaderNotRead);
  EXPECT_EQ(AttributeOf(instance, "@CamLst=")->longs, (std::vector<std::int32_t>{cameras[1]}));
  EXPECT_NE(Find(cameras[1]), nullptr);
}

TEST_F(SectionTest, FailedCameraCreationLeavesTheListAlone) {
  HRSection section;
  const host::EntityHandle instance = MakeSection("N-N", {0, 0, 0}, {6, 0, 0}, &section);
  FailNext("qel_create_group");
  EXPECT_EQ(section.AddCamera("Lost"), 0);
  EXPECT_EQ(section.GetCameraCount(), 0);
  EXPECT_EQ(AttributeOf(instance, "@CamLst="), nullptr);
}

TEST_F(SectionTest, SavedCameraGoesToTheHandleAtTheIndex) {
  HRSection section;
  MakeSection("O-O", {0, 0, 0}, {6, 0, 0}, &section);
  section.AddCamera("One");
  section.AddCamera("Two");
  HRCamera camera;
  ASSERT_EQ(section.LoadCamera(0, camera), 0);
  camera.SetComment("moved");
  EXPECT_EQ(section.SaveCamera(1, camera), 0);
  EXPECT_EQ(AttributeOf(section.Cameras()[1], "@COMMENT=")->text, "moved");
  EXPECT_EQ(AttributeOf(section.Cameras()[0], "@COMMENT=")->text, "");
}

TEST_F(SectionTest, DeleteRemovesSymbolMembersAndCameras) {
  HRSection section;
  const host::EntityHandle unrelated = Drawing().Add(host::kTypeLine).handle;
  const Parts parts = PartsOf(MakeSection("P-P", {0, 0, 0}, {6, 0, 0}, &section));
  section.AddCamera("One");
  section.AddCamera("Two");
  HRSection loaded;
  ASSERT_EQ(loaded.Load(parts.instance), 0);
  ClearJournal();
  EXPECT_EQ(loaded.Delete(), 0);
  EXPECT_EQ(loaded.GetCameraCount(), 0);
  EXPECT_EQ(Drawing().LiveCount(), 1U);
  EXPECT_NE(Find(unrelated), nullptr);
  const std::vector<ChangeRecord> records = ChangeRecords();
  EXPECT_EQ(records.front(), (ChangeRecord{parts.instance, 2}));
  EXPECT_NE(std::find(records.begin(), records.end(), ChangeRecord{parts.block, 2}), records.end());
  EXPECT_NE(std::find(records.begin(), records.end(), ChangeRecord{parts.line, 2}), records.end());
}

TEST_F(SectionTest, HideAndShowSymbolFlipOnlyTheHiddenFlag) {
  HRSection section;
  const host::EntityHandle instance = MakeSection("Q-Q", {0, 0, 0}, {6, 0, 0}, &section);
  Find(instance)->header.bytes[host::kHeaderFlags] = 0x15;
  HRSection loaded;
  ASSERT_EQ(loaded.Load(instance), 0);
  EXPECT_EQ(loaded.HideSymbol(), 0);
  EXPECT_EQ(Find(instance)->header.bytes[host::kHeaderFlags], 0x95);
  EXPECT_EQ(loaded.ShowSymbol(), 0);
  EXPECT_EQ(Find(instance)->header.bytes[host::kHeaderFlags], 0x15);
}

TEST_F(SectionTest, CutViewHandsTheHostTheFramePointsAndEndsInHiddenLines) {
  HRSection section;
  MakeSection("S-S", {2, 2, 5}, {2, 6, 5}, &section);
  section.SetCutType(HRSection::kCutOff);
  ClearJournal();
  EXPECT_EQ(section.ShowView(-1), 0);
  ExpectNear(globp[0], {2, 2, 5}, "start");
  ExpectNear(globp[1], {2, 6, 5}, "end");
  ExpectNear(globp[2], {2, 2, 6}, "above the start");
  ExpectNear(globp[3], {-2, 2, 5}, "side point");
  EXPECT_EQ(Steps(), (std::vector<std::string>{"inq_render_mode", "inq_render_mode", "set_background_color",
                                               "wire_frame_all", "set_dspmode_info", "new_solid", "redraw_all",
                                               "set_dspmode_info", "set_vsect_plane", "inq_render_mode",
                                               "hidden_lines"}));
  EXPECT_EQ(globc[109], 'o');
  EXPECT_EQ(globc[243], 's');
  EXPECT_EQ(globp[25].y, 7.0F);
  const wb::SectionCut& cut = Bench().View().section;
  EXPECT_TRUE(cut.active);
  EXPECT_EQ(cut.cutType, 'o');
  ExpectNear(cut.points[3], {-2, 2, 5}, "cut side point");
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kHiddenline);
  // No section symbol shows in the cut view.
  EXPECT_TRUE(Find(section.GetHandle())->Hidden());
}

TEST_F(SectionTest, CameraViewEndsInTheCamerasModeOrHiddenLines) {
  HRSection section;
  MakeSection("T-T", {0, 0, 0}, {6, 0, 0}, &section);
  section.AddCamera("Plain");
  section.AddCamera("Shaded");
  for (std::int32_t k = 0; k < 2; ++k) {
    HRCamera camera;
    ASSERT_EQ(section.LoadCamera(k, camera), 0);
    CameraSettings settings = SettingsOf(camera);
    settings.displayMode = k == 0 ? HRUtility::kGeometric : HRUtility::kShaded;
    settings.eye[0] = 40.0F + static_cast<float>(k);
    camera.SetSettings(settings);
    ASSERT_EQ(section.SaveCamera(k, camera), 0);
  }
  ClearJournal();
  EXPECT_EQ(section.ShowView(0), 0);
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kHiddenline);
  EXPECT_EQ(Bench().View().eye.x, 40.0F);
  EXPECT_EQ(Bench().View().waitCursor, 0);
  EXPECT_FALSE(Journaled(Kind::Command, "set_vsect_plane"));
  ExpectNear(globp[1], {6, 0, 0}, "end");

  EXPECT_EQ(section.ShowView(1), 0);
  EXPECT_EQ(HRUtility::GetDisplayMode(), HRUtility::kShaded);
  EXPECT_EQ(Bench().View().eye.x, 41.0F);
  EXPECT_EQ(Bench().View().waitCursor, 0);
}

TEST_F(SectionTest, CutViewIsRefusedWhileTheHostKeepsRendering) {
  HRSection section;
  MakeSection("U-U", {0, 0, 0}, {6, 0, 0}, &section);
  section.AddCamera("Default");
  HRUtility::SetDisplayMode(HRUtility::kRender);
  FailOn("execute_internal_command", "render_on");
  EXPECT_EQ(section.ShowView(-1), -28);
  EXPECT_EQ(section.ShowView(0), -28);
  EXPECT_FALSE(Journaled(Kind::Command, "set_vsect_plane"));
  EXPECT_FALSE(Bench().View().section.active);
  // The camera's first phase turned the wait cursor on; the refusal turns it off again.
  EXPECT_EQ(Bench().View().waitCursor, 0);
  EXPECT_EQ(Bench().View().waitCursorUnderflows, 0);
}

TEST_F(SectionTest, CameraThatDoesNotLoadLeavesTheViewAlone) {
  HRSection section;
  MakeSection("V-V", {0, 0, 0}, {6, 0, 0}, &section);
  section.AddCamera("Default");
  Drawing().Remove(section.Cameras()[0]);
  Drawing().layers[3].on = true;
  const wb::ViewState before = Bench().View();
  ClearJournal();
  EXPECT_EQ(section.ShowView(0), model_status::kHeaderNotRead);
  EXPECT_TRUE(Steps().empty());
  EXPECT_TRUE(Drawing().layers[3].on);
  EXPECT_EQ(Bench().View().eye.x, before.eye.x);
  EXPECT_EQ(Bench().View().waitCursor, 0);
}

TEST_F(SectionTest, SectionsAndTheirCamerasComeBackFromASavedDrawingFile) {
  HRSection section;
  SectionSettings settings = Settings({1.5, -2, 0.5}, {9, 4.25, 0.5});
  settings.lineColor = 6;
  settings.lineType = 3;
  settings.cutType = HRSection::kCutOff;
  section.SetName("R-R");
  section.SetSettings(settings);
  section.SetFor2D(1);
  ASSERT_EQ(section.Create(), 0);
  section.AddCamera("Default");
  section.AddCamera("Close");
  section.SetCameraFor2D(1, 1);
  const host::EntityHandle instance = section.GetHandle();

  std::vector<CameraSettings> before;
  for (std::int32_t k = 0; k < 2; ++k) {
    HRCamera camera;
    ASSERT_EQ(section.LoadCamera(k, camera), 0);
    before.push_back(SettingsOf(camera));
  }

  ReopenThroughFile();
  HRSection loaded;
  ASSERT_EQ(loaded.Load(instance), 0);
  SectionSettings read;
  loaded.GetSettings(read);
  for (int i = 0; i < 3; ++i) {
    EXPECT_NEAR(read.start[i], settings.start[i], 1e-4);
    EXPECT_NEAR(read.end[i], settings.end[i], 1e-4);
  }
  EXPECT_EQ(read.lineColor, 6);
  EXPECT_EQ(read.lineType, 3);
  EXPECT_EQ(read.cutType, 'o');
  EXPECT_EQ(read.symbolFile, settings.symbolFile);
  EXPECT_EQ(loaded.GetName(), "R-R");
  EXPECT_EQ(loaded.IsFor2D(), 1);
  EXPECT_EQ(loaded.Cameras(), section.Cameras());
  EXPECT_EQ(loaded.GetCameraName(0), "Default");
  EXPECT_EQ(loaded.GetCameraName(1), "Close");
  EXPECT_EQ(loaded.IsCameraFor2D(0), 0);
  EXPECT_EQ(loaded.IsCameraFor2D(1), 1);
  for (std::int32_t k = 0; k < 2; ++k) {
    HRCamera camera;
    ASSERT_EQ(loaded.LoadCamera(k, camera), 0);
    ExpectSameSettings(SettingsOf(camera), before[static_cast<std::size_t>(k)]);
  }
}

}  // namespace
