// Running a pane script from the command line.
#include "app/pane_command.h"

#include <CLI/CLI.hpp>

#include <filesystem>
#include <fstream>
#include <optional>
#include <sstream>

#include "app/pane_script/pane_script.h"
#include "app/pane_script/pane_script_runner.h"
#include "app/plugin_session.h"
#include "samples/sample_drawing.h"
#include "workbench/drawing_file.h"
#include "workbench/drawing_file_lock.h"
#include "workbench/host_ui/main_frame.h"
#include "workbench/workbench.h"

namespace app {
namespace {

constexpr int kShowPane = 1;

std::string ReadScriptFile(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  if (!in) throw std::runtime_error("cannot read the script " + path);
  std::string text;
  text.resize(script::kMaxScriptBytes + 1);
  in.read(text.data(), static_cast<std::streamsize>(text.size()));
  text.resize(static_cast<std::size_t>(in.gcount()));
  if (in.bad()) throw std::runtime_error("cannot read the script " + path);
  return text;
}

}  // namespace

PaneCommand::PaneCommand(CLI::App& program, const CLI::Validator& named) {
  command_ = program.add_subcommand(
      "pane", "Show the manager pane docked in the workbench's main window and do what a script of a user's actions says");
  command_->add_option("DRAWING", drawing_, "Drawing file, saved when the script says so (default: the built-in sample house)")
      ->check(named);
  command_->add_option("--script", script_, "The user's actions, one a line (see the README)")->required()->check(named);
  command_->add_option("--render", renderFolder_, "Folder for a picture (SVG) of the screen after each action")
      ->check(named);
  command_->add_flag("--undocked", undocked_, "The host does not dock panes: the pane stays a plain window in the frame");
}

bool PaneCommand::Chosen() const { return command_->parsed(); }

int PaneCommand::Run(std::ostream& out, std::ostream& err) const {
  // The whole script is read before anything runs, so a mistake anywhere changes nothing.
  script::Script script;
  try {
    script = script::ReadScript(ReadScriptFile(script_));
  } catch (const script::ScriptError& error) {
    err << "pandex: " << script_ << ": " << error.what() << '\n';
    return 1;
  }
  if (!renderFolder_.empty()) std::filesystem::create_directories(renderFolder_);

  // The pane edits the drawing: no other command changes it while the script runs.
  std::optional<wb::DrawingFileLock> lock;
  if (!drawing_.empty()) lock.emplace(drawing_, wb::DrawingFileLock::Mode::Exclusive);
  const PluginSession session(drawing_.empty() ? samples::MakeSampleDrawing() : wb::OpenDrawingFile(drawing_));
  wb::Workbench& bench = wb::Workbench::Get();
  if (!drawing_.empty()) bench.SetDrawingPath(bench.Current(), drawing_);
  wb::ui::MainFrame frame;
  const std::string shown = drawing_.empty() ? "sample house" : std::filesystem::path(drawing_).filename().string();
  if (!frame.Create("Workbench - " + shown, !undocked_)) throw std::runtime_error("cannot open the main window");
  frame.RunSubCommand(kShowPane);

  script::Runner runner(frame, {drawing_, renderFolder_}, out);
  try {
    runner.Run(script);
  } catch (const script::ScriptError& error) {
    err << "pandex: " << script_ << ": " << error.what() << '\n';
    return 1;
  }
  if (!renderFolder_.empty()) out << "Wrote " << runner.Renders() << " pictures to " << renderFolder_ << '\n';
  return 0;
}

}  // namespace app
