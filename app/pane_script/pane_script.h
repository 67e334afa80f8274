// Scripts of a user working in the manager pane: one action a line, read into typed actions
// before anything runs, so that a mistake anywhere is reported with its line and nothing done.
//
// A line is a verb and its words, separated by blanks; a word with blanks is written in double
// quotes (\" and \\ inside them stand for " and \). Empty lines and lines starting with # are
// skipped. To add an action: an action struct below, a reader in pane_script_reader.cpp's verb
// table, and a Run overload in the runner.
#pragma once

#include <cstddef>
#include <optional>
#include <stdexcept>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "shell/host/host_types.h"

namespace app::script {

// A control of a window: one of the pane's buttons by name ("add", "remove", "update",
// "execute", "add-view", "build-2d", "refresh"), else a control id or the text on a control of
// the window the user works in (an open dialog or message box first).
struct Control {
  int id = 0;             // 0 when found by text
  std::string text;
  bool paneButton = false;
};

struct SelectTab {  // tab cameras|sections|plans
  int tab = 0;
};
struct Click {  // click CONTROL
  Control control;
};
struct Hover {  // hover CONTROL | hover tab cameras|sections|plans
  Control control;
  std::optional<int> tab;
};
struct SelectItem {  // select PATH ("Section 0/Default")
  std::string path;
};
struct SetCheck {  // tick PATH | untick PATH
  std::string path;
  bool checked = true;
};
struct Rename {  // rename PATH NEW-NAME | rename PATH NEW-NAME cancel
  std::string path;
  std::string text;
  bool confirm = true;
};
struct PickPoints {  // pick X,Y[,Z] X,Y[,Z] | pick cancel: answers the host asking for points
  std::vector<host::Point3f> points;  // empty: cancel
};
struct Answer {  // answer ok|cancel|yes|no|abort|retry|ignore: a button of the open message box
  int button = 0;
};
struct RunSubCommand {  // run N [TAB-NUMBER | X,Y[,Z] X,Y[,Z]]: the host calls the plug-in
  int code = 0;
  float number = 0.0F;                // globr[0], for sub-command 7
  std::vector<host::Point3f> points;  // globp[0], globp[1], for sub-commands 2 and 4
};
struct Wait {  // wait MILLISECONDS
  int milliseconds = 0;
};
struct ResizePane {  // resize WIDTH HEIGHT: the host gives the pane another size
  int width = 0;
  int height = 0;
};
struct SetView {  // view EYE-X,Y,Z TARGET-X,Y,Z [perspective|parallel]: the user moves the view
  host::Point3f eye{};
  host::Point3f target{};
  bool perspective = false;
};
struct Save {  // save [FILE]: the drawing, to its own file or to FILE
  std::string file;
};
struct Print {};  // print: the tab and the tree the pane holds (shown or not), on standard output

using ActionKind = std::variant<SelectTab, Click, Hover, SelectItem, SetCheck, Rename, PickPoints, Answer,
                                RunSubCommand, Wait, ResizePane, SetView, Save, Print>;

struct Action {
  int line = 0;      // counted from 1
  std::string verb;  // as written, for messages and render names
  ActionKind kind;
};

struct Script {
  std::vector<Action> actions;
};

// A script that cannot be read, or a step that cannot be done: the message names the line.
class ScriptError : public std::runtime_error {
 public:
  ScriptError(int line, const std::string& message)
      : std::runtime_error("line " + std::to_string(line) + ": " + message), line_(line) {}
  int Line() const { return line_; }

 private:
  int line_;
};

// Limits on what a script may be, so that any input is read in bounded time and memory.
inline constexpr std::size_t kMaxScriptBytes = 1 << 20;
inline constexpr std::size_t kMaxLineBytes = 4096;

// Reads a whole script; throws ScriptError for the first line that cannot be read.
Script ReadScript(std::string_view text);

}  // namespace app::script
