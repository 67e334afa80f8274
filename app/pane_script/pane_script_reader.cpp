// Reading a pane script: lines into words, words into typed actions, every value checked.
#include <charconv>
#include <cmath>
#include <functional>
#include <map>

#include "app/pane_script/pane_script.h"
#include "framework/win_constants.h"
#include "workbench/host_ui/point_pick.h"

namespace app::script {
namespace {

using Words = std::vector<std::string>;

// Thrown by the readers of one line; the line number is added by ReadScript.
struct LineError {
  std::string message;
};

Words SplitWords(std::string_view line) {
  Words words;
  std::size_t i = 0;
  while (i < line.size()) {
    if (line[i] == ' ' || line[i] == '\t') {
      ++i;
      continue;
    }
    std::string word;
    if (line[i] == '"') {
      ++i;
      bool closed = false;
      while (i < line.size()) {
        const char c = line[i++];
        if (c == '"') {
          closed = true;
          break;
        }
        if (c == '\\') {
          if (i == line.size() || (line[i] != '"' && line[i] != '\\')) {
            throw LineError{"a backslash in quotes stands only before \" or \\"};
          }
          word += line[i++];
        } else {
          word += c;
        }
      }
      if (!closed) throw LineError{"a quoted word is not closed"};
      if (i < line.size() && line[i] != ' ' && line[i] != '\t') throw LineError{"a blank must follow a quoted word"};
    } else {
      while (i < line.size() && line[i] != ' ' && line[i] != '\t') {
        if (line[i] == '"') throw LineError{"a quote in the middle of a word"};
        word += line[i++];
      }
    }
    words.push_back(std::move(word));
  }
  return words;
}

void ExpectCount(const Words& args, std::size_t least, std::size_t most, const char* usage) {
  if (args.size() < least || args.size() > most) throw LineError{std::string("usage: ") + usage};
}

int Integer(const std::string& word, int least, int most, const char* what) {
  int value = 0;
  const auto [end, error] = std::from_chars(word.data(), word.data() + word.size(), value);
  if (word.empty() || error != std::errc() || end != word.data() + word.size() || value < least || value > most) {
    throw LineError{std::string(what) + " must be a whole number from " + std::to_string(least) + " to " +
                    std::to_string(most) + ", not \"" + word + "\""};
  }
  return value;
}

float Number(const std::string& word, const char* what) {
  float value = 0.0F;
  const auto [end, error] = std::from_chars(word.data(), word.data() + word.size(), value);
  if (word.empty() || error != std::errc() || end != word.data() + word.size() || !std::isfinite(value)) {
    throw LineError{std::string(what) + " must be a number, not \"" + word + "\""};
  }
  return value;
}

host::Point3f Point(const std::string& word) {
  const std::optional<host::Point3f> point = wb::ui::ParseTypedPoint(word);
  if (!point) throw LineError{"\"" + word + "\" is no point: write x,y or x,y,z"};
  return *point;
}

int TabOf(const std::string& word) {
  static const std::map<std::string, int> kTabs = {{"cameras", 0}, {"sections", 1}, {"plans", 2}};
  const auto found = kTabs.find(word);
  if (found == kTabs.end()) throw LineError{"no tab \"" + word + "\": cameras, sections or plans"};
  return found->second;
}

Control ControlOf(const std::string& word) {
  static const std::map<std::string, int> kPaneButtons = {{"add", 5007},      {"remove", 5008},   {"update", 5009},
                                                          {"execute", 5010},  {"add-view", 5018}, {"build-2d", 5021},
                                                          {"refresh", 5019}};
  if (const auto found = kPaneButtons.find(word); found != kPaneButtons.end()) return {found->second, {}, true};
  if (!word.empty() && word.find_first_not_of("0123456789") == std::string::npos) {
    return {Integer(word, 1, 65535, "a control id"), {}, false};
  }
  if (word.empty()) throw LineError{"an empty control name"};
  return {0, word, false};
}

std::string Path(const std::string& word) {
  if (word.empty()) throw LineError{"an empty item path"};
  return word;
}

ActionKind ReadTab(const Words& args) {
  ExpectCount(args, 1, 1, "tab cameras|sections|plans");
  return SelectTab{TabOf(args[0])};
}

ActionKind ReadClick(const Words& args) {
  ExpectCount(args, 1, 1, "click BUTTON (add, remove, update, execute, add-view, build-2d, refresh, an id or a text)");
  return Click{ControlOf(args[0])};
}

ActionKind ReadHover(const Words& args) {
  ExpectCount(args, 1, 2, "hover BUTTON | hover tab cameras|sections|plans");
  if (args.size() == 2) {
    if (args[0] != "tab") throw LineError{"usage: hover BUTTON | hover tab cameras|sections|plans"};
    return Hover{{}, TabOf(args[1])};
  }
  return Hover{ControlOf(args[0]), std::nullopt};
}

ActionKind ReadSelect(const Words& args) {
  ExpectCount(args, 1, 1, "select PATH");
  return SelectItem{Path(args[0])};
}

ActionKind ReadTick(const Words& args) {
  ExpectCount(args, 1, 1, "tick PATH");
  return SetCheck{Path(args[0]), true};
}

ActionKind ReadUntick(const Words& args) {
  ExpectCount(args, 1, 1, "untick PATH");
  return SetCheck{Path(args[0]), false};
}

ActionKind ReadRename(const Words& args) {
  ExpectCount(args, 2, 3, "rename PATH NEW-NAME [cancel]");
  if (args.size() == 3 && args[2] != "cancel") throw LineError{"usage: rename PATH NEW-NAME [cancel]"};
  return Rename{Path(args[0]), args[1], args.size() == 2};
}

ActionKind ReadPick(const Words& args) {
  if (args.size() == 1 && args[0] == "cancel") return PickPoints{};
  ExpectCount(args, 2, 2, "pick X,Y[,Z] X,Y[,Z] | pick cancel");
  return PickPoints{{Point(args[0]), Point(args[1])}};
}

ActionKind ReadAnswer(const Words& args) {
  static const std::map<std::string, int> kButtons = {{"ok", IDOK},      {"cancel", IDCANCEL}, {"yes", IDYES},
                                                      {"no", IDNO},      {"abort", IDABORT},   {"retry", IDRETRY},
                                                      {"ignore", IDIGNORE}};
  ExpectCount(args, 1, 1, "answer ok|cancel|yes|no|abort|retry|ignore");
  const auto found = kButtons.find(args[0]);
  if (found == kButtons.end()) throw LineError{"no answer \"" + args[0] + "\": ok, cancel, yes, no, abort, retry or ignore"};
  return Answer{found->second};
}

ActionKind ReadRun(const Words& args) {
  if (args.empty()) throw LineError{"usage: run N [TAB-NUMBER | X,Y[,Z] X,Y[,Z]]"};
  RunSubCommand run;
  run.code = Integer(args[0], -1000000, 1000000, "a sub-command");
  if (run.code == 2 || run.code == 4) {
    ExpectCount(args, 3, 3, "run 2|4 X,Y[,Z] X,Y[,Z]");
    run.points = {Point(args[1]), Point(args[2])};
  } else if (run.code == 7) {
    ExpectCount(args, 2, 2, "run 7 TAB-NUMBER (1 cameras, 2 sections, 3 plans)");
    run.number = Number(args[1], "the tab number");
  } else {
    ExpectCount(args, 1, 1, "run N (2, 4 and 7 take more)");
  }
  return run;
}

ActionKind ReadWait(const Words& args) {
  ExpectCount(args, 1, 1, "wait MILLISECONDS");
  return Wait{Integer(args[0], 0, 3600000, "the time")};
}

ActionKind ReadResize(const Words& args) {
  ExpectCount(args, 2, 2, "resize WIDTH HEIGHT");
  return ResizePane{Integer(args[0], 0, 10000, "the width"), Integer(args[1], 0, 10000, "the height")};
}

ActionKind ReadView(const Words& args) {
  constexpr const char* kUsage = "view eye X,Y,Z target X,Y,Z [perspective|parallel]";
  ExpectCount(args, 4, 5, kUsage);
  if (args[0] != "eye" || args[2] != "target") throw LineError{std::string("usage: ") + kUsage};
  SetView view{Point(args[1]), Point(args[3]), false};
  if (args.size() == 5) {
    if (args[4] != "perspective" && args[4] != "parallel") throw LineError{std::string("usage: ") + kUsage};
    view.perspective = args[4] == "perspective";
  }
  return view;
}

ActionKind ReadSave(const Words& args) {
  ExpectCount(args, 0, 1, "save [FILE]");
  if (!args.empty() && args[0].empty()) throw LineError{"an empty file name"};
  return Save{args.empty() ? std::string() : args[0]};
}

ActionKind ReadPrint(const Words& args) {
  ExpectCount(args, 0, 0, "print");
  return Print{};
}

using Reader = ActionKind (*)(const Words&);

const std::map<std::string, Reader>& Verbs() {
  static const std::map<std::string, Reader> kVerbs = {
      {"tab", ReadTab},       {"click", ReadClick},   {"hover", ReadHover},     {"select", ReadSelect},
      {"tick", ReadTick},     {"untick", ReadUntick}, {"rename", ReadRename},   {"pick", ReadPick},
      {"answer", ReadAnswer}, {"run", ReadRun},       {"wait", ReadWait},       {"resize", ReadResize},
      {"view", ReadView},     {"save", ReadSave},     {"print", ReadPrint},
  };
  return kVerbs;
}

std::string VerbList() {
  std::string list;
  for (const auto& [verb, reader] : Verbs()) list += (list.empty() ? "" : ", ") + verb;
  return list;
}

void CheckCharacters(std::string_view line) {
  for (const char c : line) {
    const auto byte = static_cast<unsigned char>(c);
    if ((byte < 0x20 && c != '\t') || byte == 0x7F) throw LineError{"a control character in the line"};
  }
}

}  // namespace

Script ReadScript(std::string_view text) {
  if (text.size() > kMaxScriptBytes) {
    throw ScriptError(1, "the script is longer than " + std::to_string(kMaxScriptBytes) + " bytes");
  }
  Script script;
  int number = 0;
  std::size_t start = 0;
  while (start < text.size()) {
    ++number;
    std::size_t end = text.find('\n', start);
    if (end == std::string_view::npos) end = text.size();
    std::string_view line = text.substr(start, end - start);
    start = end + 1;
    if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
    try {
      if (line.size() > kMaxLineBytes) throw LineError{"longer than " + std::to_string(kMaxLineBytes) + " bytes"};
      CheckCharacters(line);
      const std::size_t first = line.find_first_not_of(" \t");
      if (first == std::string_view::npos || line[first] == '#') continue;
      Words words = SplitWords(line);
      const auto verb = Verbs().find(words.front());
      if (verb == Verbs().end()) throw LineError{"no action \"" + words.front() + "\" (actions: " + VerbList() + ")"};
      const Words args(words.begin() + 1, words.end());
      script.actions.push_back({number, words.front(), verb->second(args)});
    } catch (const LineError& error) {
      throw ScriptError(number, error.message);
    }
  }
  return script;
}

}  // namespace app::script
