// The "Build 2D" batch: which views it walks and in what order, the files it names and skips,
// the progress it reports, and the folder beside the drawing.
#include <cstring>

#include "display/build_batch.h"
#include "display/display_mode.h"
#include "resources/string_table.h"
#include "samples/sample_house.h"
#include "shell/host/argument_blocks.h"
#include "tests/draft_output/locking_child.h"
#include "tests/output2d/output2d_fixture.h"
#include "views/hr_plane.h"
#include "views/view_collection.h"
#include "workbench/draft/dxf_reader.h"

namespace output2d_test {
namespace {

using HRUtility::Build2DBatch;
using HRUtility::BuildMode;
using HRUtility::BuildProgress;
using HRUtility::BuildResult;
using HRUtility::BuildStep;
using Outcome = BuildStep::Outcome;

const View kFront{{0.5F, -10.0F, 2.0F}, {0.5F, 0.5F, 0.5F}, false, HRUtility::kGeometric};

class BuildBatchTest : public Output2DTest {
 protected:
  void SetUp() override {
    Output2DTest::SetUp();
    AddCube({0.0F, 0.0F, 0.0F});
  }

  // Runs the batch and keeps every progress report.
  BuildResult Run(BuildMode mode) {
    const host::DatabaseHandle database = Bench().Current();
    Build2DBatch batch(mode, CollectSectionHandles(database), CollectPlanHandles(database));
    batch.OnProgress([this](const BuildProgress& progress) {
      reports_.push_back({progress.position, progress.upper, progress.status, *progress.step});
    });
    return batch.Run();
  }

  // A plan with one camera ticked for 2D; answers the plan's handle.
  static host::EntityHandle AddPlan(const std::string& name, const std::string& file2D = "") {
    HRPlane plan;
    const float base[3] = {0.5F, 0.5F, 0.5F};
    const float dir[3] = {0.5F, 0.5F, 5.0F};
    plan.DefineFromPoints(name, base, dir);
    EXPECT_EQ(plan.Create(), 0);
    plan.AddCamera("Default");
    HRCamera camera;
    EXPECT_EQ(plan.LoadCamera(0, camera), 0);
    camera.SetSettings(SettingsFor({{0.5F, 0.5F, 20.0F}, {0.5F, 0.5F, 0.0F}}));
    camera.SetName("Default");
    camera.Set2DFile(file2D);
    camera.SetFor2D(1);
    EXPECT_EQ(plan.SaveCamera(0, camera), 0);
    return plan.GetHandle();
  }

  static std::vector<Outcome> Outcomes(const BuildResult& result) {
    std::vector<Outcome> outcomes;
    for (const BuildStep& step : result.steps) outcomes.push_back(step.outcome);
    return outcomes;
  }
  static std::vector<std::string> Views(const BuildResult& result) {
    std::vector<std::string> views;
    for (const BuildStep& step : result.steps) views.push_back(step.view);
    return views;
  }
  std::vector<std::string> OutputNames() const {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(OutputFolder())) names.push_back(entry.path().filename());
    std::sort(names.begin(), names.end());
    return names;
  }

  struct Report {
    std::int32_t position;
    std::int32_t upper;
    std::string status;
    BuildStep step;
  };
  std::vector<Report> reports_;
};

TEST_F(BuildBatchTest, LockedSecondOfThreeIsSkippedAndTheBarEndsAtTwoOfThree) {
  for (const char* name : {"One", "Two", "Three"}) AddCamera(name, kFront);
  std::filesystem::create_directory(OutputFolder());
  const std::filesystem::path locked = OutputFolder() / "house_Two.dxf";
  drawing_file_samples::WriteBytes(locked, {'o', 'l', 'd'});
  draft_output_samples::LockingChild otherUser(locked, draft_output_samples::LockingChild::Lock::ExclusiveGuard);
  Bench().GetJournal().Clear();

  const BuildResult result = Run(BuildMode::Cameras);
  EXPECT_EQ(result.total, 3);
  EXPECT_EQ(Outcomes(result), (std::vector<Outcome>{Outcome::Saved, Outcome::Locked, Outcome::Saved}));
  EXPECT_EQ(result.Saved(), 2);
  EXPECT_FALSE(result.AllSaved());
  ASSERT_EQ(reports_.size(), 2U) << "a skipped file makes no progress step";
  EXPECT_EQ(reports_[0].status, "File 1 of 3");
  EXPECT_EQ(reports_[1].status, "File 2 of 3");
  EXPECT_EQ(reports_[1].position, 2);
  EXPECT_EQ(reports_[1].upper, 3);
  EXPECT_EQ(reports_[1].step.view, "Three");

  EXPECT_EQ(Count(Steps(), "merge_save2d_files"), 2);
  EXPECT_EQ(Count(Steps(), "qel_put_long_name 10"), 2) << "the locked name is never registered";
  EXPECT_EQ(drawing_file_samples::ReadBytes(locked), (std::vector<std::uint8_t>{'o', 'l', 'd'}));
  EXPECT_EQ(OutputNames(), (std::vector<std::string>{"house_One.dxf", "house_One.svg", "house_Three.dxf",
                                                     "house_Three.svg", "house_Two.dxf"}));
}

TEST_F(BuildBatchTest, NothingTickedGivesAnEmptyRangeAndSavesNothing) {
  AddCamera("One", kFront, false);
  AddCamera("Two", kFront, false);
  AddPlan("Ground");
  HRPlane plan;
  ASSERT_EQ(plan.Load(CollectPlanHandles(Bench().Current()).at(0)), 0);
  plan.SetCameraFor2D(0, 0);
  Bench().GetJournal().Clear();

  const BuildResult result = Run(BuildMode::All);
  EXPECT_FALSE(result.folderRefused);
  EXPECT_EQ(result.total, 0);
  EXPECT_TRUE(result.steps.empty());
  EXPECT_TRUE(result.AllSaved());
  EXPECT_TRUE(reports_.empty());
  EXPECT_TRUE(std::filesystem::is_directory(OutputFolder())) << "the folder is made before counting";
  EXPECT_TRUE(OutputNames().empty());
  EXPECT_EQ(Count(Steps(), "create_2d_model") + Count(Steps(), "hiden1"), 0);
}

TEST_F(BuildBatchTest, ModesWalkTheirOwnViewsAndAllTakesCamerasThenSectionsThenPlans) {
  samples::BuildSampleHouse();
  const host::DatabaseHandle database = Bench().Current();
  const std::vector<std::string> cameras = {"Street perspective", "Axonometric", "Site plan"};
  const std::vector<std::string> sections = {"A_Default", "B_Default"};
  const std::vector<std::string> plans = {"Ground floor_Default"};

  EXPECT_EQ(Views(Run(BuildMode::Cameras)), cameras);
  EXPECT_EQ(Views(Run(BuildMode::Sections)), sections);
  EXPECT_EQ(Views(Run(BuildMode::Plans)), plans);
  EXPECT_EQ(Build2DBatch(BuildMode::Sections, CollectSectionHandles(database), {}).Count(), 2);

  reports_.clear();
  const BuildResult all = Run(BuildMode::All);
  std::vector<std::string> everything = cameras;
  everything.insert(everything.end(), sections.begin(), sections.end());
  everything.insert(everything.end(), plans.begin(), plans.end());
  EXPECT_EQ(Views(all), everything);
  EXPECT_EQ(all.total, 6);
  EXPECT_TRUE(all.AllSaved());
  ASSERT_EQ(reports_.size(), 6U);
  EXPECT_EQ(reports_.back().status, "File 6 of 6");
  for (const BuildStep& step : all.steps) {
    EXPECT_EQ(std::filesystem::path(step.file).parent_path(), OutputFolder());
    EXPECT_FALSE(wb::draft::ReadDxfSheet(step.file + ".dxf").strokes.empty()) << step.view;
  }
}

TEST_F(BuildBatchTest, SectionsAndPlansDrawTheirCutAndNoCutFollowsIntoTheCameras) {
  samples::BuildSampleHouse();
  const auto cutStrokes = [](const BuildStep& step) {
    const wb::draft::Sheet sheet = wb::draft::ReadDxfSheet(step.file + ".dxf");
    return std::count_if(sheet.strokes.begin(), sheet.strokes.end(),
                         [](const wb::draft::Stroke& s) { return s.kind == wb::draft::StrokeKind::Cut; });
  };
  for (const BuildMode mode : {BuildMode::Sections, BuildMode::Plans}) {
    for (const BuildStep& step : Run(mode).steps) EXPECT_GT(cutStrokes(step), 0) << step.view;
    // Straight after a cut view; the street view is a solid mode like the sections.
    for (const BuildStep& step : Run(BuildMode::Cameras).steps) EXPECT_EQ(cutStrokes(step), 0) << step.view;
  }
}

TEST_F(BuildBatchTest, CameraWithItsOwnFileNameIsSavedThereNotInTheFolder) {
  std::filesystem::create_directory(Folder() / "elsewhere");
  const std::string own = (Folder() / "elsewhere" / "front elevation").string();
  AddCamera("Front", kFront, true, own);
  AddCamera("Plain", kFront);

  const BuildResult result = Run(BuildMode::Cameras);
  ASSERT_EQ(result.steps.size(), 2U);
  EXPECT_EQ(result.steps[0].file, own);
  EXPECT_EQ(result.steps[1].file, (OutputFolder() / "house_Plain").string());
  EXPECT_TRUE(result.AllSaved());
  EXPECT_TRUE(std::filesystem::exists(own + ".dxf"));
  EXPECT_EQ(OutputNames(), (std::vector<std::string>{"house_Plain.dxf", "house_Plain.svg"}));
}

TEST_F(BuildBatchTest, HostileViewNamesStayInsideTheFolderAsValidFileNames) {
  const std::vector<std::string> names = {"../x", "a/b", "..", ".", "back\\slash:colon*star?query\"<>|",
                                          std::string("tab\tbell\a\x7f") + "end", std::string(1000, 'n'),
                                          "/etc/passwd"};
  for (const std::string& name : names) AddCamera(name, kFront);

  const BuildResult result = Run(BuildMode::Cameras);
  ASSERT_EQ(result.steps.size(), names.size());
  EXPECT_TRUE(result.AllSaved());
  for (const BuildStep& step : result.steps) {
    const std::filesystem::path file(step.file);
    EXPECT_EQ(file.parent_path(), OutputFolder()) << step.view;
    EXPECT_TRUE(std::filesystem::is_regular_file(step.file + ".dxf")) << step.view;
  }
  // Nothing was written outside the folder, and the folder holds only files.
  std::vector<std::string> beside;
  for (const auto& entry : std::filesystem::directory_iterator(Folder())) beside.push_back(entry.path().filename());
  std::sort(beside.begin(), beside.end());
  EXPECT_EQ(beside, (std::vector<std::string>{"2D_"}));
  for (const auto& entry : std::filesystem::directory_iterator(OutputFolder())) {
    EXPECT_TRUE(entry.is_regular_file()) << entry.path();
  }
}

TEST_F(BuildBatchTest, PlanPassHandsTheNameOverInTheCharacterBlock) {
  std::memset(globc + 205, 'X', 10);
  AddCamera("Front", kFront);
  Run(BuildMode::Cameras);
  EXPECT_EQ(globc[210], 'X') << "only the plan pass writes the name there";

  AddPlan("Ground");
  const BuildResult result = Run(BuildMode::Plans);
  ASSERT_EQ(result.steps.size(), 1U);
  const std::string& file = result.steps[0].file;
  EXPECT_EQ(std::string(globc + 210), file) << "copied with its terminating zero";
  EXPECT_EQ(globc[209], 'X');
}

TEST_F(BuildBatchTest, PlanPassNeverWritesPastTheCharacterBlock) {
  const std::string own = (Folder() / std::string(600, 'q')).string();
  AddPlan("Ground", own);
  const BuildResult result = Run(BuildMode::Plans);
  ASSERT_EQ(result.steps.size(), 1U);
  EXPECT_EQ(result.steps[0].file, own);
  EXPECT_EQ(result.steps[0].outcome, Outcome::Failed) << "no file system takes a name that long";
  const std::size_t room = host::kGlobcSize - 210 - 1;
  EXPECT_EQ(std::string(globc + 210, room), own.substr(0, room));
  EXPECT_EQ(globc[host::kGlobcSize - 1], '\0');
  ASSERT_EQ(reports_.size(), 1U);
  EXPECT_EQ(reports_[0].status, "File 0 of 1") << "a failed save still updates the status line";
}

TEST_F(BuildBatchTest, FolderThatCannotBeMadeStopsTheRunBeforeAnything) {
  AddCamera("One", kFront);
  drawing_file_samples::WriteBytes(OutputFolder(), {'f', 'i', 'l', 'e'});
  Bench().GetJournal().Clear();

  const BuildResult result = Run(BuildMode::All);
  EXPECT_TRUE(result.folderRefused);
  EXPECT_FALSE(result.AllSaved());
  EXPECT_TRUE(result.steps.empty());
  EXPECT_TRUE(reports_.empty());
  EXPECT_TRUE(Steps().empty()) << "no view was put on screen and nothing generated";
  EXPECT_EQ(drawing_file_samples::ReadBytes(OutputFolder()), (std::vector<std::uint8_t>{'f', 'i', 'l', 'e'}));
  EXPECT_EQ(resources::LoadString(resources::kIdsCannotCreate2DFolder), "Cannot create 2D folder.");
}

TEST_F(BuildBatchTest, DrawingWithoutANameHasNoPlaceForTheFolder) {
  AddCamera("One", kFront);
  const std::filesystem::path here = std::filesystem::current_path();
  std::filesystem::current_path(Folder());
  Bench().GetFaults().FailNext("db_title_file_name");
  const BuildResult result = Run(BuildMode::Cameras);
  std::filesystem::current_path(here);
  EXPECT_TRUE(result.folderRefused);
  EXPECT_TRUE(result.steps.empty());
  EXPECT_FALSE(std::filesystem::exists(OutputFolder()));
}

}  // namespace
}  // namespace output2d_test
