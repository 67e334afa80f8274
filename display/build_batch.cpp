// The 2D batch: camera, section and plan passes, output names, lock checks and progress.
#include "display/build_batch.h"

#include <algorithm>
#include <cstring>
#include <filesystem>
#include <optional>
#include <system_error>

#include "display/save2d.h"
#include "resources/string_table.h"
#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll_2d.h"
#include "shell/pandex_app.h"
#include "views/hr_camera_mgr.h"
#include "views/hr_plane.h"
#include "views/hr_section.h"

namespace HRUtility {
namespace {

constexpr std::int32_t kTargetKind = 10;
constexpr int kPlanNameSlot = 210;

// The plan pass hands the host the name from globc[210] on; it never runs past the block.
void PutPlanName(const std::string& file) {
  const std::size_t room = host::kGlobcSize - kPlanNameSlot - 1;
  const std::size_t length = std::min(file.size(), room);
  std::memcpy(globc + kPlanNameSlot, file.data(), length);
  globc[kPlanNameSlot + length] = '\0';
}

bool Locked(const std::string& file) {
  char userText[host::kLockTextSize] = {};
  char detailText[host::kLockTextSize] = {};
  return Session_CheckLockEx(file.c_str(), userText, detailText) == 1;
}

}  // namespace

std::int32_t BuildResult::Saved() const {
  return static_cast<std::int32_t>(
      std::count_if(steps.begin(), steps.end(), [](const BuildStep& s) { return s.outcome == BuildStep::Outcome::Saved; }));
}

Build2DBatch::Build2DBatch(BuildMode mode, std::vector<host::EntityHandle> sections,
                           std::vector<host::EntityHandle> plans)
    : mode_(mode), sections_(std::move(sections)), plans_(std::move(plans)) {}

std::int32_t Build2DBatch::CountCameras() const {
  std::int32_t count = 0;
  for (std::int32_t i = 0; i < GetGeneralCameraCount(); ++i) {
    HRCamera camera;
    if (LoadGeneralCamera(camera, i) == 0 && camera.IsFor2D() == 1) ++count;
  }
  return count;
}

template <typename Owner>
std::int32_t Build2DBatch::CountOwned(const std::vector<host::EntityHandle>& owners) const {
  std::int32_t count = 0;
  for (const host::EntityHandle handle : owners) {
    Owner owner;
    if (owner.Load(handle) != 0) continue;
    for (std::int32_t k = 0; k < owner.GetCameraCount(); ++k) {
      if (owner.IsCameraFor2D(k) == 1) ++count;
    }
  }
  return count;
}

std::int32_t Build2DBatch::Count() const {
  switch (mode_) {
    case BuildMode::Cameras: return CountCameras();
    case BuildMode::Sections: return CountOwned<HRSection>(sections_);
    case BuildMode::Plans: return CountOwned<HRPlane>(plans_);
    case BuildMode::All: return CountCameras() + CountOwned<HRSection>(sections_) + CountOwned<HRPlane>(plans_);
  }
  return 0;
}

void Build2DBatch::Generate(const HRCamera& camera, std::string view, std::string file, bool plan,
                            BuildResult& result) {
  BuildStep& step = result.steps.emplace_back();
  step.view = std::move(view);
  if (!camera.Get2DFile().empty()) {
    std::optional<std::string> own = OwnOutputFile(camera.Get2DFile(), drawingFolder_, ownFilesAnywhere_, step.reason);
    if (!own) {
      step.file = camera.Get2DFile();
      step.outcome = BuildStep::Outcome::Failed;
      Report(step);
      return;
    }
    file = std::move(*own);
  }
  OutputFileClaims::Claim claim = claims_.Take(step.view, file, camera.GetOverwrite2D() == 0);
  step.file = std::move(claim.file);
  if (!claim.warning.empty()) step.warnings.push_back(std::move(claim.warning));
  if (Locked(step.file)) {
    step.outcome = BuildStep::Outcome::Locked;
    return;  // skipped: no save and no progress report
  }
  if (plan) PutPlanName(step.file);
  std::int32_t word = -1;
  qel_put_long_name(step.file.c_str(), kTargetKind, &word);
  const bool saved =
      Save2D(step.file, camera.GetAutoClip(), camera.GetOverwrite2D(), camera.GetRemoveCoincident(),
             camera.GetLineMerge(), camera.GetPreserveDimensions(), camera.GetPreserveText(),
             camera.GetPreserveWalls(), camera.GetPreserveLayer(), camera.GetPreserveLayerIndex());
  step.outcome = saved ? BuildStep::Outcome::Saved : BuildStep::Outcome::Failed;
  if (saved) ++position_;
  Report(step);
}

// The progress step after a save or a refusal: the bar moves on success only, the status line
// always.
void Build2DBatch::Report(const BuildStep& step) {
  if (!progress_) return;
  const std::string status = std::string(resources::LoadString(resources::kIdsFile)) + " " +
                             std::to_string(position_) + " " + std::string(resources::LoadString(resources::kIdsOf)) +
                             " " + std::to_string(upper_);
  progress_({position_, upper_, status, &step});
}

void Build2DBatch::CameraPass(const OutputNames& names, BuildResult& result) {
  for (std::int32_t i = 0; i < GetGeneralCameraCount(); ++i) {
    HRCamera camera;
    if (LoadGeneralCamera(camera, i) != 0 || camera.IsFor2D() != 1) continue;
    camera.Execute(TheApp());
    Generate(camera, camera.GetName(), DefaultOutputFile(names, camera.GetName()), false, result);
  }
}

template <typename Owner>
void Build2DBatch::OwnedPass(const std::vector<host::EntityHandle>& owners, bool plans, const OutputNames& names,
                             BuildResult& result) {
  for (const host::EntityHandle handle : owners) {
    Owner owner;
    if (owner.Load(handle) != 0) continue;
    for (std::int32_t k = 0; k < owner.GetCameraCount(); ++k) {
      if (owner.IsCameraFor2D(k) != 1) continue;
      owner.ShowView(k);
      HRCamera camera;
      owner.LoadCamera(k, camera);
      const std::string view = owner.GetName() + "_" + camera.GetName();
      Generate(camera, view, DefaultOutputFile(names, view), plans, result);
    }
  }
}

BuildResult Build2DBatch::Run() {
  BuildResult result;
  const char* drawing = db_title_file_name();
  // Without the drawing's name there is no place beside it; the folder would land wherever
  // the host process happens to run.
  if (drawing == nullptr || *drawing == '\0') {
    result.folderRefused = true;
    return result;
  }
  OutputNames names = OutputNamesFor(drawing);
  drawingFolder_ = std::filesystem::path(drawing).parent_path().string();
  if (!outputParent_.empty()) names.folder = (std::filesystem::path(outputParent_) / "2D_").string();
  result.folder = names.folder;
  claims_ = OutputFileClaims();
  // Only the 2D folder itself is made: a folder above it that is missing is a mistyped path.
  std::error_code error;
  std::filesystem::create_directory(names.folder, error);
  if (!std::filesystem::is_directory(names.folder, error)) {
    result.folderRefused = true;
    return result;
  }
  result.total = Count();
  upper_ = std::clamp(result.total, 0, 0xFFFF);  // the bar's range is 16-bit
  position_ = 0;
  switch (mode_) {
    case BuildMode::Cameras: CameraPass(names, result); break;
    case BuildMode::Sections: OwnedPass<HRSection>(sections_, false, names, result); break;
    case BuildMode::Plans: OwnedPass<HRPlane>(plans_, true, names, result); break;
    case BuildMode::All:
      CameraPass(names, result);
      OwnedPass<HRSection>(sections_, false, names, result);
      OwnedPass<HRPlane>(plans_, true, names, result);
      break;
  }
  return result;
}

}  // namespace HRUtility
