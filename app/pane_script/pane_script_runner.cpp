// The runner: each action done as a person would do it, a picture after each, and the next
// lines given as the answer to whatever waits for input.
#include "app/pane_script/pane_script_runner.h"

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iomanip>
#include <sstream>

#include "framework/controls/tab_control.h"
#include "framework/controls/tree_control.h"
#include "framework/window_system.h"
#include "shell/host/argument_blocks.h"
#include "workbench/drawing_file.h"
#include "workbench/host_ui/screen_render.h"
#include "workbench/workbench.h"

namespace app::script {
namespace {

constexpr const char* kTabNames[] = {"Cameras", "Sections", "Plans"};

// How a person types a point at the host's prompt.
std::string TypedPoint(const host::Point3f& p) {
  char text[64];
  std::snprintf(text, sizeof text, "%.9g,%.9g,%.9g", static_cast<double>(p.x), static_cast<double>(p.y),
                static_cast<double>(p.z));
  return text;
}

// A wrapper that reads a window without taking it over.
template <class Control>
struct Viewed : Control {
  explicit Viewed(HWND hwnd) { this->m_hWnd = hwnd; }
};

void PrintItems(const CTreeCtrl& tree, HTREEITEM first, int depth, std::ostream& out) {
  for (HTREEITEM item = first; item; item = tree.GetNextSiblingItem(item)) {
    out << std::string(static_cast<std::size_t>(depth) * 2 + 2, ' ') << (tree.GetCheck(item) ? "[x] " : "[ ] ")
        << tree.GetItemText(item) << '\n';
    PrintItems(tree, tree.GetChildItem(item), depth + 1, out);
  }
}

}  // namespace

Runner::Runner(wb::ui::MainFrame& frame, RunOptions options, std::ostream& out)
    : previous_(framework::GetInputSource()), frame_(frame), options_(std::move(options)), out_(out) {
  framework::SetInputSource(this);
}

Runner::~Runner() { framework::SetInputSource(previous_); }

void Runner::Run(const Script& script) {
  script_ = &script;
  next_ = 0;
  failure_.reset();
  lastStarted_ = nullptr;
  rendered_ = false;
  while (next_ < script.actions.size() && !failure_) Step();
  // The last picture shows the end, or what the screen held when an action could not be done.
  try {
    user_.Wait(kPauseMs);
    RenderPending();
  } catch (const std::exception& error) {
    if (!failure_) failure_ = ScriptError(lastStarted_ != nullptr ? lastStarted_->line : 0, error.what());
  }
  script_ = nullptr;
  if (failure_) throw *failure_;
}

// Nothing thrown here leaves it: the action may run inside the plug-in's handlers (answering a
// message box they opened), which must not be unwound.
void Runner::Step() {
  const Action& action = script_->actions[next_];
  try {
    // A person takes a moment between two actions (tips the mouse has left go away), then
    // looks at the screen: that is the picture of the last action.
    if (lastStarted_ != nullptr) user_.Wait(kPauseMs);
    RenderPending();
    ++next_;
    lastStarted_ = &action;
    rendered_ = false;
    std::visit([this](const auto& kind) { Do(kind); }, action.kind);
  } catch (const ScriptError& error) {
    if (!failure_) failure_ = error;
  } catch (const std::exception& error) {
    if (!failure_) failure_ = ScriptError(action.line, error.what());
  }
}

// Whatever waits for input gets the next line; with no lines left (or after a failure) no one
// answers, and the window waiting is told so (a message box closes as cancelled).
bool Runner::AwaitInput(HWND modalWindow) {
  if (script_ == nullptr || failure_) return false;
  const int line = lastStarted_ != nullptr ? lastStarted_->line : 0;
  if (next_ >= script_->actions.size()) {
    const std::string waiting = DescribeWaiting(modalWindow);
    // The last picture shows the window left waiting; the failure is reported either way.
    try {
      user_.Wait(kPauseMs);
      RenderPending();
    } catch (const std::exception&) {
    }
    failure_ = ScriptError(line, waiting + " when the script ended");
    return false;
  }
  if (depth_ == kMaxDepth) {
    failure_ = ScriptError(line, "more than " + std::to_string(kMaxDepth) + " windows wait one within another");
    return false;
  }
  ++depth_;
  Step();
  --depth_;
  return !failure_;
}

std::string Runner::DescribeWaiting(HWND modalWindow) const {
  if (const wb::ui::PointPick* pick = frame_.Pick()) return "the host was still asking \"" + pick->Prompt() + "\"";
  std::string text;
  for (const HWND child : framework::GetChildren(modalWindow)) {
    if (::GetClassName(child) == "Static" && ::GetWindowText(child).size() > text.size()) text = ::GetWindowText(child);
  }
  return "\"" + ::GetWindowText(modalWindow) + "\" (" + text + ") was still waiting for an answer";
}

void Runner::RenderPending() {
  if (rendered_ || options_.renderFolder.empty()) {
    rendered_ = true;
    return;
  }
  rendered_ = true;
  std::ostringstream name;
  name << std::setw(3) << std::setfill('0') << (lastStarted_ != nullptr ? lastStarted_->line : 0) << '-'
       << (lastStarted_ != nullptr ? lastStarted_->verb : std::string("start")) << ".svg";
  const std::filesystem::path file = std::filesystem::path(options_.renderFolder) / name.str();
  std::ofstream out(file, std::ios::binary | std::ios::trunc);
  out << wb::ui::RenderScreen();
  if (!out) throw std::runtime_error("cannot write the picture " + file.string());
  ++renders_;
}

HWND Runner::PaneControl(int id) const {
  const HWND control = user_.Find(id, frame_.m_hWnd);
  if (!::IsWindowVisible(control)) throw std::runtime_error("the pane is not shown (run 1 shows it)");
  return control;
}

HWND Runner::ControlOf(const Control& control) const {
  if (control.paneButton) return PaneControl(control.id);
  return control.id != 0 ? user_.Find(control.id) : user_.FindByText(control.text);
}

void Runner::Do(const SelectTab& action) { user_.SelectTab(PaneControl(kTabsId), action.tab); }

void Runner::Do(const Click& action) {
  const HWND control = ControlOf(action.control);
  if (!::IsWindowVisible(control)) throw std::runtime_error("the control is not shown");
  if (!::IsWindowEnabled(control)) throw std::runtime_error("the control is disabled");
  user_.Click(control);
}

void Runner::Do(const Hover& action) {
  if (!action.tab) {
    const HWND control = ControlOf(action.control);
    CRect client;
    ::GetClientRect(control, &client);
    user_.MoveTo(control, client.CenterPoint());
    return;
  }
  const HWND tabs = PaneControl(kTabsId);
  CRect tab;
  if (!::SendMessage(tabs, TCM_GETITEMRECT, static_cast<WPARAM>(*action.tab), reinterpret_cast<LPARAM>(&tab))) {
    throw std::runtime_error("the pane has no such tab");
  }
  user_.MoveTo(tabs, tab.CenterPoint());
}

void Runner::Do(const SelectItem& action) { user_.SelectItem(Tree(), action.path); }

void Runner::Do(const SetCheck& action) {
  const HWND tree = Tree();
  const Viewed<CTreeCtrl> view(tree);
  const HTREEITEM item = user_.FindItem(tree, action.path);
  if ((view.GetCheck(item) != FALSE) == action.checked) {
    throw std::runtime_error("\"" + action.path + "\" is " + (action.checked ? "ticked" : "unticked") + " already");
  }
  user_.ToggleCheck(tree, action.path);
}

void Runner::Do(const Rename& action) { user_.RenameItem(Tree(), action.path, action.text, action.confirm); }

void Runner::Do(const PickPoints& action) {
  if (frame_.Pick() == nullptr) throw std::runtime_error("the host is not asking for points");
  user_.Click(frame_.CommandLine());
  if (action.points.empty()) {
    user_.Press(VK_ESCAPE);
    return;
  }
  for (const host::Point3f& point : action.points) {
    if (frame_.Pick() == nullptr) throw std::runtime_error("the host asked for fewer points");
    user_.Type(TypedPoint(point));
    user_.Press(VK_RETURN);
  }
}

void Runner::Do(const Answer& action) {
  const HWND active = user_.ActiveWindow();
  if (!active || active == frame_.m_hWnd) throw std::runtime_error("no message box is open");
  user_.Click(user_.Find(action.button, active));
}

void Runner::Do(const RunSubCommand& action) {
  if (action.points.size() == 2) {
    globp[0] = action.points[0];
    globp[1] = action.points[1];
  }
  globr[0] = action.number;
  frame_.RunSubCommand(action.code);
}

void Runner::Do(const Wait& action) { user_.Wait(static_cast<DWORD>(action.milliseconds)); }

void Runner::Do(const ResizePane& action) {
  const HWND pane = ::GetParent(PaneControl(kTreeId));
  CRect place;
  ::GetWindowRect(pane, &place);
  frame_.ScreenToClient(&place);
  ::MoveWindow(pane, place.left, place.top, action.width, action.height, TRUE);
}

void Runner::Do(const SetView& action) {
  wb::ViewState& view = wb::Workbench::Get().View();
  view.eye = action.eye;
  view.target = action.target;
  view.perspective = action.perspective;
  frame_.View().Invalidate(FALSE);
}

void Runner::Do(const Save& action) {
  const std::string file = action.file.empty() ? options_.drawingPath : action.file;
  if (file.empty()) throw std::runtime_error("the drawing has no file yet: save FILE");
  wb::Workbench& bench = wb::Workbench::Get();
  wb::SaveDrawingFile(bench.CurrentDrawing(), file);
  bench.SetDrawingPath(bench.Current(), file);
  out_ << "Saved the drawing to " << file << '\n';
}

// What the pane holds, shown or not.
void Runner::Do(const Print&) {
  const int tab = static_cast<int>(::SendMessage(user_.Find(kTabsId, frame_.m_hWnd), TCM_GETCURSEL, 0, 0));
  out_ << (tab >= 0 && tab < 3 ? kTabNames[tab] : "No tab") << ":\n";
  const Viewed<CTreeCtrl> tree(user_.Find(kTreeId, frame_.m_hWnd));
  PrintItems(tree, tree.GetRootItem(), 0, out_);
}

}  // namespace app::script
