// Running the 2D batch from the command line and reporting where the files went.
#include "app/build_2d_command.h"

#include <filesystem>
#include <stdexcept>

#include "app/drawing_access.h"
#include "app/plugin_session.h"
#include "resources/string_table.h"
#include "samples/sample_drawing.h"
#include "shell/host/argument_blocks.h"
#include "views/hr_camera_mgr.h"
#include "views/view_collection.h"
#include "workbench/draft/sheet_files.h"
#include "workbench/workbench.h"

namespace app {
namespace {

constexpr int kBarWidth = 30;

void ShowProgress(const HRUtility::BuildProgress& progress, bool bar, std::ostream& out) {
  const HRUtility::BuildStep& step = *progress.step;
  const char* outcome = step.outcome == HRUtility::BuildStep::Outcome::Saved ? "saved" : "FAILED";
  if (!bar) {
    out << progress.status << ": " << step.view << " -> " << step.file << " (" << outcome << ")\n";
    return;
  }
  const int filled = progress.upper > 0 ? kBarWidth * progress.position / progress.upper : kBarWidth;
  out << "\r[" << std::string(static_cast<std::size_t>(filled), '#')
      << std::string(static_cast<std::size_t>(kBarWidth - filled), ' ') << "] " << progress.status << std::flush;
}

const char* OutcomeText(HRUtility::BuildStep::Outcome outcome) {
  switch (outcome) {
    case HRUtility::BuildStep::Outcome::Saved: return "saved";
    case HRUtility::BuildStep::Outcome::Locked: return "skipped, in use by another user";
    case HRUtility::BuildStep::Outcome::Failed: return "failed";
  }
  return "";
}

// The folder asked for with --output-dir: made when only its last part is missing, refused
// when more is, since a whole new tree is more likely a mistyped path than a wish.
std::filesystem::path OutputParent(const std::string& folder, std::ostream& out) {
  const std::filesystem::path path = std::filesystem::absolute(folder).lexically_normal();
  std::error_code error;
  if (std::filesystem::is_directory(path, error)) return path;
  if (std::filesystem::exists(path, error)) throw std::runtime_error("the output folder " + path.string() + " is a file");
  const std::filesystem::path parent = path.has_filename() ? path.parent_path() : path.parent_path().parent_path();
  if (!std::filesystem::is_directory(parent, error)) {
    throw std::runtime_error("the output folder " + path.string() + " cannot be made: " + parent.string() +
                             " does not exist");
  }
  if (!std::filesystem::create_directory(path, error) && error) {
    throw std::runtime_error("the output folder " + path.string() + " cannot be made: " + error.message());
  }
  out << "Made the output folder " << path.string() << '\n';
  return path;
}

}  // namespace

int RunBuild2D(const Build2DOptions& options, std::ostream& out, std::ostream& errors) {
  const bool sample = options.drawing.empty();
  const std::filesystem::path outputParent =
      options.outputDir.empty() ? std::filesystem::path() : OutputParent(options.outputDir, out);
  const std::filesystem::path drawingPath =
      (sample ? (outputParent.empty() ? std::filesystem::current_path() : outputParent) / "sample.pdx"
              : std::filesystem::absolute(options.drawing))
          .lexically_normal();
  PluginSession session(sample ? samples::MakeSampleDrawing() : ReadDrawing(drawingPath));
  wb::Workbench::Get().SetDrawingPath(db.handle, drawingPath.string());

  SetDatabase(db.handle);
  HRUtility::Build2DBatch batch(options.mode, CollectSectionHandles(db.handle), CollectPlanHandles(db.handle));
  if (!outputParent.empty()) batch.SetOutputParent(outputParent.string());
  batch.AllowOwnFilesAnywhere(options.ownFilesAnywhere);
  // What writes killed in an earlier run left behind goes before this run writes anything.
  wb::draft::RemoveStaleSheetTemporaries((outputParent.empty() ? drawingPath.parent_path() : outputParent) / "2D_");
  batch.OnProgress([&](const HRUtility::BuildProgress& progress) { ShowProgress(progress, options.progressBar, out); });
  const HRUtility::BuildResult result = batch.Run();
  if (options.progressBar && !result.steps.empty()) out << '\n';

  if (result.folderRefused) {
    errors << "pandex: " << resources::LoadString(resources::kIdsCannotCreate2DFolder) << " (" << result.folder
           << ")\n";
    return 1;
  }
  out << result.Saved() << " of " << result.total << " views saved to " << result.folder << '\n';
  for (const HRUtility::BuildStep& step : result.steps) {
    out << "  " << step.view << ": " << step.file << ".dxf, .svg (" << OutcomeText(step.outcome)
        << (step.reason.empty() ? "" : ": " + step.reason) << ")\n";
    for (const std::string& warning : step.warnings) errors << "pandex: warning: " << step.view << ": " << warning << '\n';
  }
  return result.AllSaved() ? 0 : 1;
}

}  // namespace app
