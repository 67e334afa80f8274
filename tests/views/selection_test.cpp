// Selection sets: the record written on create, loading (damaged counts and entries included),
// applying the ticks to cameras, sections and plans, the class test, deletion, and selection
// sets kept through a saved drawing file.
#include <string>
#include <vector>

#include "model/status_codes.h"
#include "tests/views/views_fixture.h"
#include "views/hr_plane.h"
#include "views/hr_section.h"
#include "views/hr_selection.h"

namespace {

using Indices = std::vector<std::int32_t>;

class SelectionTest : public ViewsTest {
 protected:
  // General cameras 0..count-1, each ticked so that clearing shows.
  static void StoreGeneralCameras(int count, std::uint16_t for2D = 1) {
    for (int i = 0; i < count; ++i) {
      HRCamera camera;
      camera.SetSettings(DistinctSettings());
      camera.SetName("Camera " + std::to_string(i));
      camera.SetFor2D(static_cast<std::int16_t>(for2D));
      EXPECT_EQ(AddGeneralCamera(camera), i);
    }
  }

  static std::vector<std::uint16_t> GeneralFlags() {
    std::vector<std::uint16_t> flags;
    for (std::int32_t i = 0; i < GetGeneralCameraCount(); ++i) {
      HRCamera camera;
      EXPECT_EQ(LoadGeneralCamera(camera, i), 0);
      flags.push_back(camera.IsFor2D());
    }
    return flags;
  }

  template <typename View>
  static std::vector<std::uint16_t> CameraFlags(host::EntityHandle entity) {
    View view;
    EXPECT_EQ(view.Load(entity), 0);
    std::vector<std::uint16_t> flags;
    for (std::int32_t k = 0; k < view.GetCameraCount(); ++k) flags.push_back(view.IsCameraFor2D(k));
    return flags;
  }

  // A section with the given number of cameras, all ticked.
  static host::EntityHandle SectionWithCameras(int cameras) {
    HRSection section;
    StoreSection("S", &section);
    for (int k = 0; k < cameras; ++k) {
      section.AddCamera("Camera " + std::to_string(k));
      section.SetCameraFor2D(k, 1);
    }
    return section.GetHandle();
  }

  static host::EntityHandle PlanWithCameras(int cameras) {
    HRPlane plan;
    const double base[3] = {0, 0, 0};
    const double dir[3] = {0, 0, 3};
    plan.Define("P", base, dir);
    EXPECT_EQ(plan.Create(), 0);
    for (int k = 0; k < cameras; ++k) {
      plan.AddCamera("Camera " + std::to_string(k));
      plan.SetCameraFor2D(k, 1);
    }
    return plan.GetHandle();
  }

  static host::EntityHandle CreateSelection(HRSelection& selection) {
    EXPECT_EQ(selection.Create(), 0);
    return selection.GetHandle();
  }
};

TEST_F(SelectionTest, CreateWritesNameListsCountsEntriesAndClassLast) {
  HRSelection selection;
  selection.SetName("Facades");
  selection.AddCamera(0);
  selection.AddCamera(3);
  selection.AddSection(41, {0, 2});
  selection.AddSection(42, {});
  selection.AddPlan(51, {1});
  ClearJournal();
  const host::EntityHandle entity = CreateSelection(selection);

  std::vector<std::string> writes = WritesTo(entity);
  ASSERT_FALSE(writes.empty());
  writes.erase(writes.begin());  // the marker the new group carries
  EXPECT_EQ(writes, (std::vector<std::string>{"@SNAME=", "@SCL=", "@SSC=", "@SSL0=", "@SSL1=", "@SPC=", "@SPL0=",
                                              "@Class="}));
  EXPECT_EQ(AttributeOf(entity, "@SNAME=")->text, "Facades");
  EXPECT_EQ(AttributeOf(entity, "@SCL=")->longs, (Indices{0, 3}));
  EXPECT_EQ(AttributeOf(entity, "@SSC=")->shortValue, 2);
  EXPECT_EQ(AttributeOf(entity, "@SSL0=")->longs, (Indices{41, 0, 2}));
  EXPECT_EQ(AttributeOf(entity, "@SSL1=")->longs, (Indices{42}));
  EXPECT_EQ(AttributeOf(entity, "@SPC=")->shortValue, 1);
  EXPECT_EQ(AttributeOf(entity, "@SPL0=")->longs, (Indices{51, 1}));
  EXPECT_EQ(AttributeOf(entity, "@Class=")->text, "HRSelection");
  EXPECT_EQ(IsSelection(entity), 1);
}

TEST_F(SelectionTest, TwelveSectionEntriesUseTwoDigitKeys) {
  HRSelection selection;
  selection.SetName("Many");
  for (std::int32_t i = 0; i < 12; ++i) selection.AddSection(100 + i, {i});
  const host::EntityHandle entity = CreateSelection(selection);
  EXPECT_EQ(AttributeOf(entity, "@SSC=")->shortValue, 12);
  for (int i = 0; i < 12; ++i) {
    const std::string key = "@SSL" + std::to_string(i) + "=";
    ASSERT_NE(AttributeOf(entity, key), nullptr) << key;
    EXPECT_EQ(AttributeOf(entity, key)->longs, (Indices{100 + i, i}));
  }
  EXPECT_EQ(AttributeOf(entity, "@SSL1=")->longs, (Indices{101, 1}));
  EXPECT_EQ(AttributeOf(entity, "@SSL12="), nullptr);

  HRSelection loaded;
  ASSERT_EQ(loaded.Load(entity), 0);
  ASSERT_EQ(loaded.GetSectionCount(), 12);
  EXPECT_EQ(loaded.GetSectionHandle(10), 110);
  Indices cameras;
  loaded.GetSectionCameras(11, cameras);
  EXPECT_EQ(cameras, (Indices{11}));
}

TEST_F(SelectionTest, LoadGivesBackWhatCreateWrote) {
  HRSelection selection;
  selection.SetName("Everything");
  selection.AddCamera(1);
  selection.AddCamera(2);
  selection.AddSection(7, {0, 1, 4});
  selection.AddPlan(8, {});
  selection.AddPlan(9, {2});
  const host::EntityHandle entity = CreateSelection(selection);

  HRSelection loaded;
  ASSERT_EQ(loaded.Load(entity), 0);
  EXPECT_EQ(loaded.GetName(), "Everything");
  ASSERT_EQ(loaded.GetCameraCount(), 2);
  EXPECT_EQ(loaded.GetCamera(0), 1);
  EXPECT_EQ(loaded.GetCamera(1), 2);
  ASSERT_EQ(loaded.GetSectionCount(), 1);
  EXPECT_EQ(loaded.GetSectionHandle(0), 7);
  Indices cameras = {99};
  loaded.GetSectionCameras(0, cameras);
  EXPECT_EQ(cameras, (Indices{0, 1, 4}));
  ASSERT_EQ(loaded.GetPlanCount(), 2);
  EXPECT_EQ(loaded.GetPlanHandle(1), 9);
  loaded.GetPlanCameras(0, cameras);
  EXPECT_EQ(cameras, Indices{});
  loaded.GetPlanCameras(1, cameras);
  EXPECT_EQ(cameras, (Indices{2}));
}

TEST_F(SelectionTest, NoTickedCameraMeansNoCameraKey) {
  HRSelection selection;
  selection.SetName("Sections only");
  selection.AddSection(5, {0});
  const host::EntityHandle entity = CreateSelection(selection);
  EXPECT_EQ(AttributeOf(entity, "@SCL="), nullptr);
  HRSelection loaded;
  ASSERT_EQ(loaded.Load(entity), 0);
  EXPECT_EQ(loaded.GetCameraCount(), 0);
  EXPECT_EQ(loaded.GetSectionCount(), 1);
}

TEST_F(SelectionTest, CreateStopsAtTheFirstRefusedWrite) {
  HRSelection selection;
  selection.SetName("Half");
  selection.AddSection(5, {0});
  selection.AddSection(6, {1});
  selection.AddPlan(7, {});
  FailOn("qel_set_long_vector_attribute", "@SSL1=");
  EXPECT_EQ(selection.Create(), model_status::kAttributeFailed);
  const host::EntityHandle entity = selection.GetHandle();
  EXPECT_NE(AttributeOf(entity, "@SSL0="), nullptr);
  EXPECT_EQ(AttributeOf(entity, "@SPC="), nullptr);
  const wb::Attribute* marker = AttributeOf(entity, "@Class=");
  EXPECT_TRUE(marker == nullptr || marker->text != "HRSelection");
  EXPECT_EQ(IsSelection(entity), 0);
}

TEST_F(SelectionTest, LoadRefusesOtherEntitiesAndIncompleteRecords) {
  HRSelection notOne;
  EXPECT_EQ(notOne.Load(StoreCamera("Camera")), model_status::kWrongEntity);
  EXPECT_EQ(notOne.Load(31337), model_status::kHeaderNotRead);

  HRSelection selection;
  selection.SetName("Incomplete");
  selection.AddSection(5, {0});
  selection.AddPlan(6, {0});
  const host::EntityHandle entity = CreateSelection(selection);
  DropAttribute(entity, "@SPL0=");
  HRSelection missingEntry;
  EXPECT_EQ(missingEntry.Load(entity), model_status::kAttributeFailed);

  DropAttribute(entity, "@SSC=");
  HRSelection missingCount;
  EXPECT_EQ(missingCount.Load(entity), model_status::kAttributeFailed);

  DropAttribute(entity, "@SNAME=");
  HRSelection missingName;
  EXPECT_EQ(missingName.Load(entity), model_status::kAttributeFailed);
}

TEST_F(SelectionTest, DamagedCountsAndEntriesNeverCrashOrLoop) {
  HRSelection selection;
  selection.SetName("Damaged");
  selection.AddSection(5, {0});
  selection.AddSection(6, {1});
  const host::EntityHandle entity = CreateSelection(selection);

  PutShort(entity, "@SSC=", 32767);
  HRSelection huge;
  EXPECT_EQ(huge.Load(entity), model_status::kAttributeFailed);

  PutShort(entity, "@SSC=", -4);
  HRSelection negative;
  EXPECT_EQ(negative.Load(entity), 0);
  EXPECT_EQ(negative.GetSectionCount(), 0);

  PutShort(entity, "@SSC=", 2);
  PutLongs(entity, "@SSL1=", {});
  HRSelection emptyEntry;
  EXPECT_EQ(emptyEntry.Load(entity), model_status::kAttributeFailed);

  PutString(entity, "@SSL1=", "6 1");
  HRSelection wrongKind;
  EXPECT_NE(wrongKind.Load(entity), 0);

  PutLongs(entity, "@SSL1=", {6, 1});
  PutString(entity, "@SCL=", "0 1");  // an unreadable camera list counts as empty
  HRSelection repaired;
  EXPECT_EQ(repaired.Load(entity), 0);
  EXPECT_EQ(repaired.GetCameraCount(), 0);
  EXPECT_EQ(repaired.GetSectionCount(), 2);
}

TEST_F(SelectionTest, ApplyTicksExactlyTheListedGeneralCameras) {
  StoreGeneralCameras(4);
  HRSelection selection;
  selection.AddCamera(0);
  selection.AddCamera(2);
  selection.Apply();
  EXPECT_EQ(GeneralFlags(), (std::vector<std::uint16_t>{1, 0, 1, 0}));
}

TEST_F(SelectionTest, ListOutOfOrderTicksOnlyWhatItReachesInStep) {
  StoreGeneralCameras(4);
  HRSelection selection;
  selection.AddCamera(2);
  selection.AddCamera(0);
  selection.Apply();
  EXPECT_EQ(GeneralFlags(), (std::vector<std::uint16_t>{0, 0, 1, 0}));
}

TEST_F(SelectionTest, IndicesBeyondTheCamerasNeverMatch) {
  StoreGeneralCameras(2, 0);
  HRSelection selection;
  selection.AddCamera(1);
  selection.AddCamera(7);
  selection.Apply();
  EXPECT_EQ(GeneralFlags(), (std::vector<std::uint16_t>{0, 1}));
}

TEST_F(SelectionTest, ApplyTicksSectionAndPlanCamerasAndLeavesTheRest) {
  const host::EntityHandle listed = SectionWithCameras(3);
  const host::EntityHandle cleared = SectionWithCameras(2);
  const host::EntityHandle unlisted = SectionWithCameras(2);
  const host::EntityHandle plan = PlanWithCameras(3);
  {
    HRSection section;
    ASSERT_EQ(section.Load(listed), 0);
    section.SetFor2D(1);
    ASSERT_EQ(section.Save(), 0);
  }
  HRSelection selection;
  selection.AddSection(listed, {1});
  selection.AddSection(cleared, {});
  selection.AddSection(55555, {0});  // a section that no longer loads is skipped
  selection.AddPlan(plan, {0, 2});
  selection.Apply();

  EXPECT_EQ(CameraFlags<HRSection>(listed), (std::vector<std::uint16_t>{0, 1, 0}));
  EXPECT_EQ(CameraFlags<HRSection>(cleared), (std::vector<std::uint16_t>{0, 0}));
  EXPECT_EQ(CameraFlags<HRSection>(unlisted), (std::vector<std::uint16_t>{1, 1}));
  EXPECT_EQ(CameraFlags<HRPlane>(plan), (std::vector<std::uint16_t>{1, 0, 1}));
  HRSection section;
  ASSERT_EQ(section.Load(listed), 0);
  EXPECT_EQ(section.IsFor2D(), 1);  // the views' own flags stay as they were
}

TEST_F(SelectionTest, ApplyLeavesCamerasThatDoNotLoadUntouched) {
  StoreGeneralCameras(3);
  const host::EntityHandle broken = CameraManager().Handles()[1];
  DropAttribute(broken, "@SHOWSEC=");
  const std::vector<wb::Attribute> before = Find(broken)->attributes;
  HRSelection selection;
  selection.AddCamera(2);
  selection.Apply();
  EXPECT_EQ(Find(broken)->attributes, before);
  HRCamera camera;
  ASSERT_EQ(LoadGeneralCamera(camera, 0), 0);
  EXPECT_EQ(camera.IsFor2D(), 0);
  ASSERT_EQ(LoadGeneralCamera(camera, 2), 0);
  EXPECT_EQ(camera.IsFor2D(), 1);
}

TEST_F(SelectionTest, ClassTestAndDeletion) {
  HRSelection selection;
  selection.SetName("To delete");
  const host::EntityHandle entity = CreateSelection(selection);
  EXPECT_EQ(IsSelection(entity), 1);
  EXPECT_EQ(IsSelection(StoreCamera("Camera")), 0);
  EXPECT_EQ(IsSelection(Drawing().Add(host::kTypeGroup).handle), 0);
  EXPECT_EQ(IsSelection(Drawing().Add(host::kTypeLine).handle), 0);
  PutString(entity, "@Class=", "HRSelection ");
  EXPECT_EQ(IsSelection(entity), 0);

  FailNext("qel_delete_group");
  EXPECT_EQ(DeleteSelection(entity), model_status::kNotDeleted);
  EXPECT_NE(Find(entity), nullptr);
  EXPECT_EQ(DeleteSelection(entity), 0);
  EXPECT_EQ(Find(entity), nullptr);
  EXPECT_EQ(DeleteSelection(entity), model_status::kNotDeleted);
}

TEST_F(SelectionTest, SelectionSetsComeBackFromASavedDrawingFile) {
  StoreGeneralCameras(3, 0);
  const host::EntityHandle section = SectionWithCameras(2);
  const host::EntityHandle plan = PlanWithCameras(2);
  HRSelection selection;
  selection.SetName("Saved set");
  selection.AddCamera(1);
  selection.AddSection(section, {1});
  selection.AddPlan(plan, {0});
  const host::EntityHandle entity = CreateSelection(selection);

  ReopenThroughFile();
  HRSelection loaded;
  ASSERT_EQ(loaded.Load(entity), 0);
  EXPECT_EQ(loaded.GetName(), "Saved set");
  ASSERT_EQ(loaded.GetCameraCount(), 1);
  EXPECT_EQ(loaded.GetCamera(0), 1);
  ASSERT_EQ(loaded.GetSectionCount(), 1);
  EXPECT_EQ(loaded.GetSectionHandle(0), section);
  ASSERT_EQ(loaded.GetPlanCount(), 1);
  EXPECT_EQ(loaded.GetPlanHandle(0), plan);
  Indices cameras;
  loaded.GetSectionCameras(0, cameras);
  EXPECT_EQ(cameras, (Indices{1}));

  // Applied in the reopened drawing, it reaches the views stored there.
  loaded.Apply();
  EXPECT_EQ(GeneralFlags(), (std::vector<std::uint16_t>{0, 1, 0}));
  EXPECT_EQ(CameraFlags<HRSection>(section), (std::vector<std::uint16_t>{0, 1}));
  EXPECT_EQ(CameraFlags<HRPlane>(plan), (std::vector<std::uint16_t>{1, 0}));
}

}  // namespace
