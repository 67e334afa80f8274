// Dispatch of the library entry: which sub-commands create the pane and what each starts.
#include <limits>
#include <new>
#include <string>
#include <vector>

#include "framework/controls/tab_control.h"
#include "framework/window_classes.h"
#include "model/current_database.h"
#include "shell/host/argument_blocks.h"
#include "shell/pandex_app.h"
#include "shell/pane_instance.h"
#include "tests/shell/plugin_fixture.h"
#include "ui/pandex_dlg.h"

namespace {

struct SentMessage {
  UINT message;
  WPARAM wParam;
  LPARAM lParam;
};

// A tab control window that writes down the tab-control messages it receives.
class RecordingTabs : public CTabCtrl {
 public:
  RecordingTabs() { CreateEx(0, framework::kTabControlClass, "", WS_POPUP, CRect(0, 0, 100, 30), nullptr, 0); }
  std::vector<SentMessage> sent;

 protected:
  LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
    if (message >= TCM_FIRST && message < TCM_FIRST + 0x100) sent.push_back({message, wParam, lParam});
    return CTabCtrl::WindowProc(message, wParam, lParam);
  }
};

// Stands in for the pane and writes down every operation the entry starts.
class RecordingPane : public CPandexDlg {
 public:
  explicit RecordingPane(std::vector<std::string>& log) : log_(log) {}
  bool Create(int templateId, CWnd* parent) override {
    log_.push_back("Create " + std::to_string(templateId) + (parent == nullptr ? " without parent" : " with parent"));
    return true;
  }
  void ShowPane(bool show) override { log_.push_back(show ? "Show" : "Hide"); }
  void CreateSection(const host::Point3f& start, const host::Point3f& end) override {
    log_.push_back("Section " + Text(start) + " " + Text(end));
  }
  void CreatePlan(const host::Point3f& base, const host::Point3f& second) override {
    log_.push_back("Plan " + Text(base) + " " + Text(second));
  }
  void CreateCamera() override { log_.push_back("Camera"); }
  void Refresh() override { log_.push_back("Refresh"); }
  CWnd* TabControl() override { return &tabs; }

  RecordingTabs tabs;

 private:
  static std::string Text(const host::Point3f& p) {
    return std::to_string(static_cast<int>(p.x)) + "," + std::to_string(static_cast<int>(p.y)) + "," +
           std::to_string(static_cast<int>(p.z));
  }
  std::vector<std::string>& log_;
};

class EntryTest : public LoadedPluginTest {
 protected:
  void SetUp() override {
    LoadedPluginTest::SetUp();
    pandex::SetPaneFactory([this]() -> std::unique_ptr<CPandexDlg> {
      ++panesMade;
      if (refuseAllocation) return nullptr;
      return std::make_unique<RecordingPane>(log);
    });
  }

  void Run(std::int32_t subCommand) {
    globi[0] = subCommand;
    Pandex();
  }

  RecordingPane* Pane() { return static_cast<RecordingPane*>(pandex::GetPane()); }

  std::vector<std::string> log;
  int panesMade = 0;
  bool refuseAllocation = false;
};

TEST_F(EntryTest, CommandsThatNeedNoPaneDoNothingBeforeItExists) {
  for (std::int32_t code : {3, 5, 8}) Run(code);
  EXPECT_EQ(panesMade, 0);
  EXPECT_EQ(pandex::GetPane(), nullptr);
  EXPECT_TRUE(log.empty());
}

TEST_F(EntryTest, ShowTwiceCreatesThePaneOnceAndShowsItTwice) {
  Run(1);
  Run(1);
  EXPECT_EQ(panesMade, 1);
  EXPECT_EQ(log, (std::vector<std::string>{"Create 5000 without parent", "Show", "Show"}));
}

TEST_F(EntryTest, HideAndRefreshReachAnExistingPane) {
  Run(1);
  Run(5);
  Run(8);
  Run(1);
  EXPECT_EQ(log, (std::vector<std::string>{"Create 5000 without parent", "Show", "Hide", "Refresh", "Show"}));
}

TEST_F(EntryTest, SectionAndPlanTakeTheTwoPickedPoints) {
  globp[0] = {1.0F, 2.0F, 3.0F};
  globp[1] = {4.0F, 5.0F, 6.0F};
  Run(2);
  globp[0] = {7.0F, 8.0F, 0.0F};
  globp[1] = {7.0F, 8.0F, 5.0F};
  Run(4);
  Run(6);
  EXPECT_EQ(panesMade, 1);
  EXPECT_EQ(log, (std::vector<std::string>{"Create 5000 without parent", "Section 1,2,3 4,5,6", "Plan 7,8,0 7,8,5",
                                           "Camera"}));
}

TEST_F(EntryTest, EachPaneCommandCreatesThePaneOnFirstNeed) {
  for (std::int32_t code : {2, 4, 6, 7}) {
    wb::Workbench::Get().UnloadPlugin();
    wb::Workbench::Get().LoadPlugin({pandex::kExports.attach, pandex::kExports.detach, pandex::kExports.entry});
    pandex::SetPaneFactory([this]() -> std::unique_ptr<CPandexDlg> {
      ++panesMade;
      return std::make_unique<RecordingPane>(log);
    });
    Run(code);
    EXPECT_NE(pandex::GetPane(), nullptr) << "sub-command " << code;
  }
  EXPECT_EQ(panesMade, 4);
}

TEST_F(EntryTest, SelectTabCountsTabsFromOneAndTruncates) {
  const std::vector<std::pair<float, WPARAM>> cases = {{1.0F, 0}, {2.0F, 1}, {3.0F, 2}, {1.5F, 1}, {1.49F, 0}};
  for (const auto& [tabNumber, expected] : cases) {
    globr[0] = tabNumber;
    Run(7);
    ASSERT_FALSE(Pane()->tabs.sent.empty());
    const SentMessage& last = Pane()->tabs.sent.back();
    EXPECT_EQ(last.message, TCM_SETCURSEL);
    EXPECT_EQ(last.wParam, expected) << "tab number " << tabNumber;
    EXPECT_EQ(last.lParam, 0);
  }
  EXPECT_EQ(Pane()->tabs.sent.size(), cases.size());
}

TEST_F(EntryTest, SelectTabWithoutAnIntegerFormSendsNothing) {
  Run(1);
  for (float bad : {std::numeric_limits<float>::quiet_NaN(), std::numeric_limits<float>::infinity(), 1e20F}) {
    globr[0] = bad;
    Run(7);
  }
  EXPECT_TRUE(Pane()->tabs.sent.empty());
}

TEST_F(EntryTest, UnknownCodesAreIgnored) {
  for (std::int32_t code : {0, 9, -1, 1000}) Run(code);
  EXPECT_EQ(panesMade, 0);
  EXPECT_TRUE(log.empty());
}

TEST_F(EntryTest, AFailedAllocationStopsAndIsRetriedLater) {
  refuseAllocation = true;
  for (std::int32_t code : {1, 2, 4, 6, 7}) Run(code);
  EXPECT_EQ(panesMade, 5);
  EXPECT_EQ(pandex::GetPane(), nullptr);
  EXPECT_TRUE(log.empty());
  refuseAllocation = false;
  Run(1);
  EXPECT_EQ(log, (std::vector<std::string>{"Create 5000 without parent", "Show"}));
}

TEST_F(EntryTest, NothingThrownInsideReachesTheHost) {
  pandex::SetPaneFactory([this]() -> std::unique_ptr<CPandexDlg> {
    if (++panesMade == 1) throw std::bad_alloc();
    return std::make_unique<RecordingPane>(log);
  });
  EXPECT_NO_THROW(Run(1));
  EXPECT_EQ(pandex::GetPane(), nullptr);
  Run(1);
  EXPECT_EQ(log, (std::vector<std::string>{"Create 5000 without parent", "Show"}));
}

TEST_F(EntryTest, APaneWhoseWindowFailsIsKeptAndNotCreatedAgain) {
  pandex::SetPaneFactory([this]() -> std::unique_ptr<CPandexDlg> {
    ++panesMade;
    return std::make_unique<CPandexDlg>();  // its window creation answers false
  });
  Run(1);
  Run(6);
  EXPECT_EQ(panesMade, 1);
  EXPECT_NE(pandex::GetPane(), nullptr);
  EXPECT_FALSE(wb::Workbench::Get().CameraManagerOn()) << "no window was shown";
}

using LibraryLoadTest = LoadedPluginTest;

TEST_F(LibraryLoadTest, LoadGivesTheSectionDefaultsAndTheHostDrawing) {
  ASSERT_NE(TheApp(), nullptr);
  EXPECT_EQ(TheApp()->lineColor, 1);
  EXPECT_EQ(TheApp()->lineType, 1);
  EXPECT_EQ(TheApp()->lineWidth, 1);
  EXPECT_EQ(TheApp()->symbolFile, "...sec_sym\\sec01");
  EXPECT_EQ(GetCurrentDatabase(), db.handle);
  EXPECT_NE(GetCurrentDatabase(), 0);
  EXPECT_EQ(CWinApp::Current(), TheApp());
}

TEST_F(LibraryLoadTest, UnloadForgetsChangedDefaultsAndThePane) {
  TheApp()->lineColor = 7;
  TheApp()->symbolFile = "lib\\other";
  globi[0] = 1;
  Pandex();
  ASSERT_NE(pandex::GetPane(), nullptr);
  wb::Workbench::Get().UnloadPlugin();
  EXPECT_EQ(TheApp(), nullptr);
  EXPECT_EQ(pandex::GetPane(), nullptr);
  EXPECT_EQ(CWinApp::Current(), nullptr);
  wb::Workbench::Get().LoadPlugin({pandex::kExports.attach, pandex::kExports.detach, pandex::kExports.entry});
  EXPECT_EQ(TheApp()->lineColor, 1);
  EXPECT_EQ(TheApp()->symbolFile, "...sec_sym\\sec01");
  EXPECT_EQ(pandex::GetPane(), nullptr);
}

}  // namespace
