// The pane fixture: a fresh workbench, main window and plug-in for each test, and the checks
// every journey ends with.
#include "tests/pane/pane_fixture.h"

#include <sstream>

#include "app/pane_script/pane_script.h"
#include "framework/message_box.h"
#include "framework/message_queue.h"
#include "framework/window_system.h"
#include "samples/sample_drawing.h"
#include "shell/pane_instance.h"
#include "shell/plugin_exports.h"

namespace {

const wb::Drawing& SampleHouse() {
  static const wb::Drawing house = samples::MakeSampleDrawing();
  return house;
}

}  // namespace

void PaneTest::Open(Start start, bool docking) {
  Open(start == Start::kSampleHouse ? SampleHouse() : wb::Drawing{}, docking);
}

void PaneTest::Open(wb::Drawing drawing, bool docking) {
  if (frame_) Close();
  framework::ResetMessageQueue();
  framework::ClearMessageBoxLog();
  windowsBefore_ = framework::LiveWindowCount();
  Bench().Reset();
  const host::DatabaseHandle empty = Bench().Current();
  Bench().SetCurrent(Bench().Open(std::move(drawing)));
  Bench().Close(empty);
  Bench().LoadPlugin({pandex::kExports.attach, pandex::kExports.detach, pandex::kExports.entry});
  frame_ = std::make_unique<wb::ui::MainFrame>();
  ASSERT_TRUE(frame_->Create("Workbench - test", docking));
  frame_->RunSubCommand(1);
}

void PaneTest::Close() {
  frame_.reset();
  EXPECT_EQ(pandex::GetPane(), nullptr) << "the pane outlived its frame";
  Bench().UnloadPlugin();
  EXPECT_EQ(framework::LiveWindowCount(), windowsBefore_) << "windows were left behind";
}

void PaneTest::TearDown() {
  if (frame_) Close();
  EXPECT_EQ(Bench().Records().OpenCount(), 0U) << "an attribute record was left open";
  EXPECT_EQ(Bench().Memory().Outstanding(), 0) << "host memory was not released";
  EXPECT_EQ(Bench().Memory().BadReleases(), 0);
  Bench().GetFaults().Clear();
}

std::string PaneTest::Run(std::string_view lines) {
  std::ostringstream out;
  app::script::Runner runner(*frame_, {}, out);
  runner.Run(app::script::ReadScript(lines));
  return out.str();
}

std::string PaneTest::RunFailing(std::string_view lines) {
  try {
    Run(lines);
  } catch (const app::script::ScriptError& error) {
    return error.what();
  }
  return {};
}

std::vector<const wb::Entity*> PaneTest::OfClass(const std::string& className) {
  std::vector<const wb::Entity*> found;
  for (const wb::Entity& entity : Drawing().slots) {
    const wb::Attribute* marker = entity.Alive() ? entity.FindAttribute("@Class=") : nullptr;
    if (marker != nullptr && marker->text == className) found.push_back(&entity);
  }
  return found;
}

const wb::Entity& PaneTest::CameraNamed(const std::string& name, const std::string& className) {
  const wb::Entity* match = nullptr;
  for (const wb::Entity* camera : OfClass(className)) {
    if (Text(*camera, "@CAMNAME=") != name) continue;
    EXPECT_EQ(match, nullptr) << "two cameras named " << name;
    match = camera;
  }
  if (match == nullptr) throw std::runtime_error("no " + className + " named " + name);
  return *match;
}

std::vector<float> PaneTest::Floats(const wb::Entity& entity, const char* name) {
  const wb::Attribute* value = entity.FindAttribute(name);
  return value != nullptr ? value->floats : std::vector<float>{};
}

std::int16_t PaneTest::Short(const wb::Entity& entity, const char* name) {
  const wb::Attribute* value = entity.FindAttribute(name);
  return value != nullptr ? value->shortValue : std::int16_t{-1};
}

std::string PaneTest::Text(const wb::Entity& entity, const char* name) {
  const wb::Attribute* value = entity.FindAttribute(name);
  return value != nullptr ? value->text : std::string("(absent)");
}

std::vector<std::int32_t> PaneTest::Longs(const wb::Entity& entity, const char* name) {
  const wb::Attribute* value = entity.FindAttribute(name);
  return value != nullptr ? value->longs : std::vector<std::int32_t>{};
}

std::vector<std::string> PaneTest::PaneCalls() {
  std::vector<std::string> calls;
  for (const wb::JournalEntry& entry : Bench().GetJournal().Entries()) {
    if (entry.kind != wb::JournalEntry::Kind::HostCall) continue;
    if (entry.name.starts_with("CPaneManager::")) calls.push_back(entry.name + " " + std::to_string(entry.code));
    if (entry.name.starts_with("SetCameraManager")) calls.push_back(entry.name);
  }
  return calls;
}

HWND PaneTest::PaneWindow() const {
  for (const HWND child : framework::GetChildren(frame_->m_hWnd)) {
    if (::GetDlgItem(child, 5016)) return child;
  }
  return HWND();
}

CRect PaneTest::Placed(int id) const {
  CRect r;
  ::GetWindowRect(::GetDlgItem(PaneWindow(), id), &r);
  ::MapWindowPoints(HWND(), PaneWindow(), reinterpret_cast<POINT*>(&r), 2);
  return r;
}
