// The pandex command line: makes 2D drawings from a drawing's ticked views, prepares drawings
// and inspects them.
#include <CLI/CLI.hpp>

#include <unistd.h>

#include <filesystem>
#include <iostream>
#include <map>
#include <stdexcept>
#include <string>
#include <vector>

#include "app/build_2d_command.h"
#include "app/drawing_access.h"
#include "app/drawing_summary.h"
#include "app/pane_command.h"
#include "app/plugin_session.h"
#include "app/view_edit.h"
#include "app/views_summary.h"
#include "samples/sample_drawing.h"
#include "workbench/drawing_file.h"

namespace {

wb::Drawing LoadOrSample(const std::string& path) {
  if (path.empty()) return samples::MakeSampleDrawing();
  return app::ReadDrawing(path);
}

}  // namespace

// An empty name given on purpose is a mistake, not a wish for the default.
const CLI::Validator kNamed(
    [](const std::string& value) { return value.empty() ? std::string("an empty name is no file or folder") : std::string(); },
    "", "named");

int main(int argc, char** argv) {
  CLI::App app{"Pandex: cameras, sections, plans and selection sets kept in a drawing, and 2D drawings made from them."};
  app.require_subcommand(1);

  app::Build2DOptions build;
  std::string modeName = "all";
  CLI::App* build2d = app.add_subcommand("build-2d", "Make a 2D drawing (DXF with an SVG preview) of every view ticked for 2D");
  build2d->add_option("DRAWING", build.drawing, "Drawing file (default: the built-in sample house)")->check(kNamed);
  build2d->add_option("--mode", modeName, "Which views: all, cameras, sections or plans")
      ->check(CLI::IsMember({"all", "cameras", "sections", "plans"}));
  build2d->add_option("--output-dir", build.outputDir,
                      "The folder that receives the 2D_ folder (default: the drawing's folder; for the built-in "
                      "sample, the current folder). Only its last part is made when missing")
      ->check(kNamed);
  build2d->add_flag("--allow-outside-2d-folder", build.ownFilesAnywhere,
                    "Let cameras' own 2D file names lead out of the drawing's folder or hold control characters");

  std::string infoPath;
  CLI::App* info = app.add_subcommand(
      "info", "Show what a drawing holds: entities by type, attribute records, layers, cameras, sections, plans and selection sets");
  info->add_option("DRAWING", infoPath, "Drawing file (default: the built-in sample drawing)")->check(kNamed);

  std::string samplePath;
  bool force = false;
  CLI::App* sample = app.add_subcommand("sample", "Write the built-in sample drawing to a file");
  sample->add_option("OUTPUT", samplePath, "Drawing file to write")->required()->check(kNamed);
  sample->add_flag("--force", force, "Replace the file when it exists (the old one is kept as OUTPUT.bak)");

  std::string tickPath;
  std::vector<std::string> tickViews;
  CLI::App* tick = app.add_subcommand("tick", "Tick views for 2D: a camera's name, or OWNER/CAMERA for a section's or plan's camera");
  tick->add_option("DRAWING", tickPath, "Drawing file, saved back")->required()->check(kNamed);
  tick->add_option("VIEW", tickViews, "Views to tick")->required();
  CLI::App* untick = app.add_subcommand("untick", "Untick views for 2D (named as for tick)");
  untick->add_option("DRAWING", tickPath, "Drawing file, saved back")->required()->check(kNamed);
  untick->add_option("VIEW", tickViews, "Views to untick")->required();

  std::string cameraPath;
  app::NewCamera camera;
  std::vector<float> eye;
  std::vector<float> target;
  bool noTick = false;
  CLI::App* addCamera = app.add_subcommand("add-camera", "Add a general camera from an eye point and a target point");
  addCamera->add_option("DRAWING", cameraPath, "Drawing file, saved back")->required()->check(kNamed);
  addCamera->add_option("NAME", camera.name, "Camera name")->required();
  addCamera->add_option("--eye", eye, "Eye point x y z")->expected(3)->required();
  addCamera->add_option("--target", target, "Target point x y z")->expected(3)->required();
  addCamera->add_flag("--perspective", camera.perspective, "Perspective projection (default: parallel)");
  addCamera->add_flag("--2d", camera.flat, "A 2D view (default: 3D)");
  addCamera->add_option("--display-mode", camera.displayMode, "Display mode 0 (Geometric) to 10 (Render)")
      ->check(CLI::Range(0, 10));
  addCamera->add_flag("--no-tick", noTick, "Do not tick the camera for 2D");

  const app::PaneCommand pane(app, kNamed);

  try {
    app.parse(argc, argv);
  } catch (const CLI::Success& done) {  // --help
    return app.exit(done);
  } catch (const CLI::ParseError& error) {
    // Like every other error: one line, then the exit code shells use for a misused command.
    std::cerr << "pandex: " << error.what() << " (see pandex --help)\n";
    return 2;
  }

  try {
    if (pane.Chosen()) return pane.Run(std::cout, std::cerr);
    if (*build2d) {
      static const std::map<std::string, HRUtility::BuildMode> kModes = {{"all", HRUtility::BuildMode::All},
                                                                         {"cameras", HRUtility::BuildMode::Cameras},
                                                                         {"sections", HRUtility::BuildMode::Sections},
                                                                         {"plans", HRUtility::BuildMode::Plans}};
      build.mode = kModes.at(modeName);
      build.progressBar = ::isatty(STDOUT_FILENO) != 0;
      return app::RunBuild2D(build, std::cout, std::cerr);
    }
    if (*info) {
      const app::PluginSession session(LoadOrSample(infoPath));
      app::PrintSummary(app::Summarize(session.Drawing()), std::cout);
      app::PrintViews(app::CollectViews(), std::cout);
    } else if (*sample) {
      std::error_code error;
      if (!force && std::filesystem::exists(std::filesystem::symlink_status(samplePath, error))) {
        throw std::runtime_error(samplePath + " exists; add --force to replace it");
      }
      wb::SaveDrawingFile(samples::MakeSampleDrawing(), samplePath);
      std::cout << "Wrote the sample drawing to " << samplePath << '\n';
    } else if (*tick || *untick) {
      const bool ticking = tick->parsed();
      app::EditDrawing(tickPath, [&] { app::SetTicks(tickViews, ticking); });
      std::cout << (ticking ? "Ticked " : "Unticked ") << tickViews.size() << " views in " << tickPath << '\n';
    } else if (*addCamera) {
      std::copy(eye.begin(), eye.end(), camera.eye.begin());
      std::copy(target.begin(), target.end(), camera.target.begin());
      camera.tick = !noTick;
      app::EditDrawing(cameraPath, [&] { app::AddCamera(camera); });
      std::cout << "Added camera \"" << camera.name << "\" to " << cameraPath << '\n';
    }
  } catch (const std::exception& error) {
    std::cerr << "pandex: " << error.what() << '\n';
    return 1;
  }
  return 0;
}
