// The "pane" command: the workbench's main window with the plug-in's manager pane docked in
// it, driven by a script of a user's actions, with a picture of the screen after each.
#pragma once

#include <ostream>
#include <string>

namespace CLI {
class App;
class Validator;
}

namespace app {

class PaneCommand {
 public:
  // Adds the command and its options to the program; `named` refuses an empty file name.
  PaneCommand(CLI::App& program, const CLI::Validator& named);

  bool Chosen() const;
  // Loads the drawing (the sample house without one) and the plug-in, shows the pane, runs the
  // script; 0 when every action was done, 1 with a "pandex:" line naming the script's line
  // otherwise.
  int Run(std::ostream& out, std::ostream& err) const;

 private:
  CLI::App* command_;
  std::string drawing_;
  std::string script_;
  std::string renderFolder_;
  bool undocked_ = false;
};

}  // namespace app
