// The pandex command line: makes 2D drawings from a drawing's ticked views, prepares drawings
// and inspects them.
#include <CLI/CLI.hpp>

#include <unistd.h>

#include <filesystem>
#include <iostream>
#include <map>
#include <string>
#include <vector>

#include "app/build_2d_command.h"
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
  return wb::OpenDrawingFile(path);
}

// Opens a drawing file with the plug-in loaded, runs an edit and saves the drawing back.
template <typename Edit>
void EditDrawing(const std::string& path, Edit edit) {
  const app::PluginSession session(wb::OpenDrawingFile(path));
  edit();
  wb::SaveDrawingFile(session.Drawing(), path);
}

}  // namespace

int main(int argc, char** argv) {
  CLI::App app{"Pandex: cameras, sections, plans and selection sets kept in a drawing, and 2D drawings made from them."};
  app.require_subcommand(1);

  app::Build2DOptions build;
  std::string modeName = "all";
  CLI::App* build2d = app.add_subcommand("build-2d", "Make a 2D drawing (DXF with an SVG preview) of every view ticked for 2D");
  build2d->add_option("DRAWING", build.drawing, "Drawing file (default: the built-in sample house)");
  build2d->add_option("--mode", modeName, "Which views: all, cameras, sections or plans")
      ->check(CLI::IsMember({"all", "cameras", "sections", "plans"}));
  build2d->add_option("--output-dir", build.outputDir,
                      "For the built-in sample: the folder that receives its 2D_ folder (default: the current folder)");

  std::string infoPath;
  CLI::App* info = app.add_subcommand(
      "info", "Show what a drawing holds: entities by type, attribute records, layers, cameras, sections, plans and selection sets");
  info->add_option("DRAWING", infoPath, "Drawing file (default: the built-in sample drawing)");

  std::string samplePath;
  CLI::App* sample = app.add_subcommand("sample", "Write the built-in sample drawing to a file");
  sample->add_option("OUTPUT", samplePath, "Drawing file to write")->required();

  std::string tickPath;
  std::vector<std::string> tickViews;
  CLI::App* tick = app.add_subcommand("tick", "Tick views for 2D: a camera's name, or OWNER/CAMERA for a section's or plan's camera");
  tick->add_option("DRAWING", tickPath, "Drawing file, saved back")->required();
  tick->add_option("VIEW", tickViews, "Views to tick")->required();
  CLI::App* untick = app.add_subcommand("untick", "Untick views for 2D (named as for tick)");
  untick->add_option("DRAWING", tickPath, "Drawing file, saved back")->required();
  untick->add_option("VIEW", tickViews, "Views to untick")->required();

  std::string cameraPath;
  app::NewCamera camera;
  std::vector<float> eye;
  std::vector<float> target;
  bool noTick = false;
  CLI::App* addCamera = app.add_subcommand("add-camera", "Add a general camera from an eye point and a target point");
  addCamera->add_option("DRAWING", cameraPath, "Drawing file, saved back")->required();
  addCamera->add_option("NAME", camera.name, "Camera name")->required();
  addCamera->add_option("--eye", eye, "Eye point x y z")->expected(3)->required();
  addCamera->add_option("--target", target, "Target point x y z")->expected(3)->required();
  addCamera->add_flag("--perspective", camera.perspective, "Perspective projection (default: parallel)");
  addCamera->add_flag("--2d", camera.flat, "A 2D view (default: 3D)");
  addCamera->add_option("--display-mode", camera.displayMode, "Display mode 0 (Geometric) to 10 (Render)")
      ->check(CLI::Range(0, 10));
  addCamera->add_flag("--no-tick", noTick, "Do not tick the camera for 2D");

  const app::PaneCommand pane(app);

  CLI11_PARSE(app, argc, argv);

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
      wb::SaveDrawingFile(samples::MakeSampleDrawing(), samplePath);
      std::cout << "Wrote the sample drawing to " << samplePath << '\n';
    } else if (*tick || *untick) {
      const bool ticking = tick->parsed();
      EditDrawing(tickPath, [&] { app::SetTicks(tickViews, ticking); });
      std::cout << (ticking ? "Ticked " : "Unticked ") << tickViews.size() << " views in " << tickPath << '\n';
    } else if (*addCamera) {
      std::copy(eye.begin(), eye.end(), camera.eye.begin());
      std::copy(target.begin(), target.end(), camera.target.begin());
      camera.tick = !noTick;
      EditDrawing(cameraPath, [&] { app::AddCamera(camera); });
      std::cout << "Added camera \"" << camera.name << "\" to " << cameraPath << '\n';
    }
  } catch (const std::exception& error) {
    std::cerr << "pandex: " << error.what() << '\n';
    return 1;
  }
  return 0;
}
