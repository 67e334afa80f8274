// The pandex command line: inspects drawings and writes the built-in sample.
#include <CLI/CLI.hpp>

#include <filesystem>
#include <iostream>
#include <optional>
#include <string>

#include "app/drawing_summary.h"
#include "app/plugin_session.h"
#include "app/views_summary.h"
#include "samples/sample_drawing.h"
#include "workbench/drawing_file.h"

namespace {

wb::Drawing LoadOrSample(const std::string& path) {
  if (path.empty()) return samples::MakeSampleDrawing();
  return wb::OpenDrawingFile(path);
}

}  // namespace

int main(int argc, char** argv) {
  CLI::App app{"Pandex: cameras, sections, plans and selection sets kept in a drawing, and 2D drawings made from them."};
  app.require_subcommand(1);

  std::string infoPath;
  CLI::App* info = app.add_subcommand("info", "Show what a drawing holds: entities by type, attribute records, layers, cameras, sections, plans and selection sets");
  info->add_option("DRAWING", infoPath, "Drawing file (default: the built-in sample drawing)");

  std::string samplePath;
  CLI::App* sample = app.add_subcommand("sample", "Write the built-in sample drawing to a file");
  sample->add_option("OUTPUT", samplePath, "Drawing file to write")->required();

  CLI11_PARSE(app, argc, argv);

  try {
    if (*info) {
      const app::PluginSession session(LoadOrSample(infoPath));
      app::PrintSummary(app::Summarize(session.Drawing()), std::cout);
      app::PrintViews(app::CollectViews(), std::cout);
    } else if (*sample) {
      wb::SaveDrawingFile(samples::MakeSampleDrawing(), samplePath);
      std::cout << "Wrote the sample drawing to " << samplePath << '\n';
    }
  } catch (const std::exception& error) {
    std::cerr << "pandex: " << error.what() << '\n';
    return 1;
  }
  return 0;
}
