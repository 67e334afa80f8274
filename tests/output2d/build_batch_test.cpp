// The "Build 2D" batch: which views it walks and in what order, the files it names and skips,
// the progress it reports, and the folder beside the drawing.
#include <cctype>
#include <cstring>

#include "display/build_batch.h"
#include "display/display_mode.h"
#include "samples/sample_house.h"
#include "shell/host/argument_blocks.h"
#include "tests/draft_output/locking_child.h"
#include "tests/output2d/output2d_fixture.h"
#include "views/hr_plane.h"
#include "views/view_collection.h"
#include "workbench/draft/dxf_reader.h"

namespace output2d_test {
namespace {

using HRUtility::BuildMode;
using HRUtility::BuildResult;
using HRUtility::BuildStep;
using Outcome = BuildStep::Outcome;
using Strings = std::vector<std::string>;

const View kFront{{0.5F, -10.0F, 2.0F}, {0.5F, 0.5F, 0.5F}, false, HRUtility::kGeometric};

class BuildBatchTest : public Output2DTest {
 protected:
  // Runs the batch and keeps every progress report as "status at position of upper: view".
  BuildResult Run(BuildMode mode) {
    const host::DatabaseHandle database = Bench().Current();
    HRUtility::Build2DBatch batch(mode, CollectSectionHandles(database), CollectPlanHandles(database));
    batch.OnProgress([this](const HRUtility::BuildProgress& progress) {
      reports_.push_back(progress.status + " at " + std::to_string(progress.position) + " of " +
                         std::to_string(progress.upper) + ": " + progress.step->view);
    });
    return batch.Run();
  }
  template <typename Value>
  static std::vector<Value> Each(const BuildResult& result, Value BuildStep::*member) {
    std::vector<Value> values;
    for (const BuildStep& step : result.steps) values.push_back(step.*member);
    return values;
  }
  static Strings Names(const std::filesystem::path& folder) {
    Strings names;
    for (const auto& entry : std::filesystem::directory_iterator(folder)) names.push_back(entry.path().filename());
    std::ranges::sort(names);
    return names;
  }
  std::filesystem::path OutputFolder() const { return Folder() / "2D_"; }

  Strings reports_;
};

TEST_F(BuildBatchTest, LockedSecondOfThreeIsSkippedAndTheBarEndsAtTwoOfThree) {
  AddCube();
  for (const char* name : {"One", "Two", "Three"}) AddCamera(name, kFront);
  std::filesystem::create_directory(OutputFolder());
  const std::filesystem::path locked = OutputFolder() / "house_Two.dxf";
  drawing_file_samples::WriteBytes(locked, {'o', 'l', 'd'});
  draft_output_samples::LockingChild otherUser(locked, draft_output_samples::LockingChild::Lock::ExclusiveGuard);
  Bench().GetJournal().Clear();

  const BuildResult result = Run(BuildMode::Cameras);
  EXPECT_EQ(result.total, 3);
  EXPECT_EQ(Each(result, &BuildStep::outcome), (std::vector{Outcome::Saved, Outcome::Locked, Outcome::Saved}));
  EXPECT_FALSE(result.AllSaved());
  EXPECT_EQ(reports_, (Strings{"File 1 of 3 at 1 of 3: One", "File 2 of 3 at 2 of 3: Three"}))
      << "a skipped file makes no progress step";
  EXPECT_EQ(Count("merge_save2d_files"), 2);
  EXPECT_EQ(Count("qel_put_long_name 10"), 2) << "the locked name is never registered";
  EXPECT_EQ(drawing_file_samples::ReadBytes(locked), (std::vector<std::uint8_t>{'o', 'l', 'd'}));
  EXPECT_EQ(Names(OutputFolder()),
            (Strings{"house_One.dxf", "house_One.svg", "house_Three.dxf", "house_Three.svg", "house_Two.dxf"}));
}

TEST_F(BuildBatchTest, ModesWalkTheirOwnViewsAndAllTakesCamerasThenSectionsThenPlans) {
  samples::BuildSampleHouse();
  const Strings cameras = {"Street perspective", "Axonometric", "Site plan"};
  const Strings sections = {"A_Default", "B_Default"}, plans = {"Ground floor_Default"};
  EXPECT_EQ(Each(Run(BuildMode::Cameras), &BuildStep::view), cameras);
  EXPECT_EQ(Each(Run(BuildMode::Sections), &BuildStep::view), sections);
  EXPECT_EQ(Each(Run(BuildMode::Plans), &BuildStep::view), plans);
  reports_.clear();

  const BuildResult all = Run(BuildMode::All);
  Strings everything = cameras;
  everything.insert(everything.end(), sections.begin(), sections.end());
  everything.insert(everything.end(), plans.begin(), plans.end());
  EXPECT_EQ(Each(all, &BuildStep::view), everything);
  EXPECT_TRUE(all.AllSaved());
  EXPECT_EQ(reports_.back(), "File 6 of 6 at 6 of 6: Ground floor_Default");
  const auto cuts = [](const BuildStep& step) {
    return std::ranges::count(wb::draft::ReadDxfSheet(step.file + ".dxf").strokes, wb::draft::StrokeKind::Cut,
                              &wb::draft::Stroke::kind);
  };
  for (std::size_t i = 0; i < all.steps.size(); ++i) {
    EXPECT_EQ(std::filesystem::path(all.steps[i].file).parent_path(), OutputFolder());
    EXPECT_EQ(cuts(all.steps[i]) > 0, i >= cameras.size()) << "sections and plans draw their cut";
  }
  // Straight after a plan, no cut follows into the cameras.
  for (const BuildStep& step : Run(BuildMode::Cameras).steps) EXPECT_EQ(cuts(step), 0) << step.view;
}

TEST_F(BuildBatchTest, CameraWithItsOwnFileNameIsSavedThereNotInTheFolder) {
  AddCube();
  std::filesystem::create_directory(Folder() / "elsewhere");
  const std::string own = (Folder() / "elsewhere" / "front elevation").string();
  AddCamera("Front", kFront, true, own);
  AddCamera("Plain", kFront);
  const BuildResult result = Run(BuildMode::Cameras);
  EXPECT_EQ(Each(result, &BuildStep::file), (Strings{own, (OutputFolder() / "house_Plain").string()}));
  EXPECT_TRUE(result.AllSaved());
  EXPECT_TRUE(std::filesystem::exists(own + ".dxf"));
  EXPECT_EQ(Names(OutputFolder()), (Strings{"house_Plain.dxf", "house_Plain.svg"}));
}

TEST_F(BuildBatchTest, OwnFileNamesAreTakenFromTheDrawingsFolderAndMayNotLeaveIt) {
  AddCube();
  const std::filesystem::path job = Folder() / "job";
  std::filesystem::create_directories(job / "sub");
  std::filesystem::create_directory(Folder() / "outside");
  std::filesystem::create_directory_symlink(Folder() / "outside", job / "link");
  Bench().SetDrawingPath(Bench().Current(), (job / "house.pdx").string());
  const Strings own = {"sub/front", "../outside/escaped", (Folder() / "outside" / "absolute").string(),
                       "link/through", "bell\a", (job / "sub" / "absolute").string()};
  for (std::size_t i = 0; i < own.size(); ++i) AddCamera("C" + std::to_string(i), kFront, true, own[i]);

  const BuildResult refused = Run(BuildMode::Cameras);
  EXPECT_EQ(Each(refused, &BuildStep::outcome), (std::vector{Outcome::Saved, Outcome::Failed, Outcome::Failed,
                                                             Outcome::Failed, Outcome::Failed, Outcome::Saved}));
  EXPECT_EQ(refused.steps[0].file, (job / "sub" / "front").string()) << "from the drawing's folder, not the process's";
  EXPECT_EQ(refused.steps[1].reason, "its own 2D file " + (Folder() / "outside" / "escaped").string() +
                                         " lies outside the drawing's folder " + job.string());
  EXPECT_EQ(refused.steps[4].reason, "its own 2D file name holds control characters");
  EXPECT_TRUE(std::filesystem::is_empty(Folder() / "outside")) << "nothing written where a refused name leads";
  EXPECT_EQ(reports_.size(), own.size()) << "a refused view still reports its step";

  HRUtility::Build2DBatch anywhere(BuildMode::Cameras, {}, {});
  anywhere.AllowOwnFilesAnywhere(true);
  EXPECT_TRUE(anywhere.Run().AllSaved());
  EXPECT_TRUE(std::filesystem::exists(Folder() / "outside" / "escaped.dxf"));
  EXPECT_TRUE(std::filesystem::exists(job / "link" / "through.dxf"));
  // The camera keeps its name as the user gave it.
  HRCamera camera;
  ASSERT_EQ(LoadGeneralCamera(camera, 1), 0);
  EXPECT_EQ(camera.Get2DFile(), "../outside/escaped");
}

TEST_F(BuildBatchTest, HostileViewNamesStayInsideTheFolderAsValidFileNames) {
  AddCube();
  std::string accents;
  for (int i = 0; i < 300; ++i) accents += "\xC3\xA9";  // e acute, two bytes
  const Strings names = {"../x", "a/b", "..", ".", "back\\slash:colon*star?query\"<>|", "tab\tbell\a\x7f" "end",
                         std::string(1000, 'n'), "/etc/passwd", std::string("nul\0inside", 10), accents};
  for (const std::string& name : names) AddCamera(name, kFront);
  const BuildResult result = Run(BuildMode::Cameras);
  ASSERT_EQ(result.steps.size(), names.size());
  EXPECT_TRUE(result.AllSaved());
  EXPECT_EQ(result.steps[0].file, (OutputFolder() / "house_.._x").string());
  EXPECT_EQ(result.steps[2].file, (OutputFolder() / "house_..").string());
  EXPECT_EQ(Names(Folder()), Strings{"2D_"}) << "nothing was written outside the folder";
  const auto forbidden = [](char c) {
    return std::iscntrl(static_cast<unsigned char>(c)) || std::strchr("/\\:*?\"<>|", c) != nullptr;
  };
  for (const BuildStep& step : result.steps) {
    const std::string name = std::filesystem::path(step.file).filename();
    EXPECT_EQ(std::filesystem::path(step.file).parent_path(), OutputFolder()) << step.view;
    EXPECT_TRUE(std::filesystem::is_regular_file(step.file + ".dxf")) << step.view;
    EXPECT_LE(name.size() + 4, 255U) << "cut only as far as the extension needs";
    EXPECT_TRUE(std::ranges::none_of(name, forbidden)) << name;
  }
  // A long name is cut between characters, not inside one.
  const std::string cut = std::filesystem::path(result.steps.back().file).filename();
  EXPECT_EQ(cut.size() % 2, 0U) << "house_ and whole characters only";
  // With no prefix at all, a name still cannot turn into a folder.
  EXPECT_EQ(HRUtility::DefaultOutputFile({"/jobs/2D_", ""}, ".."), "/jobs/2D_/_..");
}

TEST_F(BuildBatchTest, ViewsWhoseFilesWouldCollideWriteDistinctFilesWithAWarning) {
  AddCube();
  const auto add = [](const std::string& name, const std::string& file, std::uint8_t overwrite) {
    CameraSettings settings = SettingsFor(kFront);
    settings.file2D = file;
    settings.overwrite2D = overwrite;
    HRCamera camera;
    camera.SetSettings(settings);
    camera.SetName(name);
    camera.SetFor2D(1);
    ASSERT_GE(AddGeneralCamera(camera), 0);
  };
  const std::string longName(400, 'L');
  // Equal once '/' is replaced, equal without regard to case, equal once cut to fit.
  for (const std::string& name : {std::string("a/b"), std::string("a_b"), std::string("A_B"), longName + "1",
                                  longName + "2", std::string("Plain")}) {
    add(name, "", 1);
  }
  // A camera's own file that replaces what it names is told apart; one that adds to it shares it.
  const std::string plain = (OutputFolder() / "house_Plain").string();
  add("Own", plain, 1);
  add("Adds", plain, 0);

  const BuildResult result = Run(BuildMode::Cameras);
  EXPECT_TRUE(result.AllSaved());
  Strings files, warned;
  for (const BuildStep& step : result.steps) {
    files.push_back(std::filesystem::path(step.file).filename());
    if (!step.warnings.empty()) warned.push_back(step.view);
  }
  const std::string cut = "house_" + std::string(251 - 6, 'L');
  const std::string cutForSuffix = "house_" + std::string(251 - 6 - 2, 'L');
  EXPECT_EQ(files, (Strings{"house_a_b", "house_a_b~2", "house_A_B~3", cut, cutForSuffix + "~2", "house_Plain",
                            "house_Plain~2", "house_Plain"}));
  EXPECT_EQ(warned, (Strings{"a_b", "A_B", longName + "2", "Own"}));
  EXPECT_EQ(result.steps[1].warnings.at(0),
            "its file house_a_b is also the file of \"a/b\"; written as house_a_b~2 instead");
  // Every file holds one view's drawing, but the one shared on purpose holds two.
  const auto strokes = [&](const std::string& file) {
    return wb::draft::ReadDxfSheet(OutputFolder() / (file + ".dxf")).strokes.size();
  };
  const std::size_t one = strokes("house_a_b");
  ASSERT_GT(one, 0U);
  for (const std::string& file : files) EXPECT_EQ(strokes(file), file == "house_Plain" ? 2 * one : one) << file;
}

TEST_F(BuildBatchTest, PlanPassHandsTheNameOverInTheCharacterBlockAndNeverPastIt) {
  samples::BuildSampleHouse();
  std::memset(globc + 205, 'X', 10);
  Run(BuildMode::Cameras);
  EXPECT_EQ(globc[210], 'X') << "only the plan pass writes the name there";
  const BuildResult plans = Run(BuildMode::Plans);
  EXPECT_EQ(std::string(globc + 210), plans.steps.at(0).file) << "copied with its terminating zero";
  EXPECT_EQ(globc[209], 'X');

  HRPlane plan;
  HRCamera camera;
  ASSERT_EQ(plan.Load(CollectPlanHandles(Bench().Current()).at(0)), 0);
  ASSERT_EQ(plan.LoadCamera(0, camera), 0);
  const std::string own = (Folder() / std::string(600, 'q')).string();
  camera.Set2DFile(own);
  camera.SetAutoClip(0);  // the failure wanted here is the save's, not the clip's
  ASSERT_EQ(plan.SaveCamera(0, camera), 0);
  reports_.clear();
  const BuildResult longName = Run(BuildMode::Plans);
  EXPECT_EQ(Each(longName, &BuildStep::outcome), std::vector{Outcome::Failed}) << "no file system takes that name";
  const std::size_t room = host::kGlobcSize - 210 - 1;
  EXPECT_EQ(std::string(globc + 210, room), own.substr(0, room));
  EXPECT_EQ(globc[host::kGlobcSize - 1], '\0');
  EXPECT_EQ(reports_, Strings{"File 0 of 1 at 0 of 1: Ground floor_Default"}) << "a failed save still reports";
}

}  // namespace
}  // namespace output2d_test
