// How messages find their handlers: maps by message, id and code, base maps, reflected
// notifications, registered messages; and the dialog keys that move between controls.
#include <string>
#include <vector>

#include "framework/cdialog.h"
#include "framework/controls/button.h"
#include "framework/controls/tab_control.h"
#include "framework/cwinapp.h"
#include "framework/data_exchange.h"
#include "framework/window_classes.h"
#include "tests/framework/framework_fixture.h"

namespace {

std::vector<std::string> journal;

const UINT kAskManager = RegisterWindowMessage("Quorvel_GetPaneManager");

// A tab control that handles its own selection change, and lets the parent see it only when
// asked to.
class SelfishTabs : public CTabCtrl {
 public:
  BOOL passOn = FALSE;

 protected:
  BOOL OnSelChange(NMHDR*, LRESULT* result) {
    journal.push_back("tabs saw the change");
    *result = 0;
    return !passOn;
  }
  DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(SelfishTabs, CTabCtrl)
ON_NOTIFY_REFLECT_EX(TCN_SELCHANGE, OnSelChange)
END_MESSAGE_MAP()

// A dialog with a base map and a derived map; the derived one wins for the ids both handle.
class BaseDialog : public CDialog {
 public:
  explicit BaseDialog(const DialogTemplate& t) : CDialog(t, nullptr) {}

 protected:
  void OnFirst() { journal.push_back("base first"); }
  void OnSecond() { journal.push_back("base second"); }
  DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(BaseDialog, CDialog)
ON_BN_CLICKED(101, OnFirst)
ON_BN_CLICKED(102, OnSecond)
END_MESSAGE_MAP()

class RoutingDialog : public BaseDialog {
 public:
  explicit RoutingDialog(const DialogTemplate& t) : BaseDialog(t) {}
  SelfishTabs tabs;
  int flag = 0;

 protected:
  void DoDataExchange(CDataExchange* dx) override {
    DDX_Control(dx, 110, tabs);
    DDX_Check(dx, 103, flag);
  }
  void OnSecondHere() { journal.push_back("derived second"); }
  void OnTabChange(NMHDR*, LRESULT*) { journal.push_back("dialog saw the change"); }
  LRESULT OnAskManager(WPARAM, LPARAM) { return 62000; }
  void OnCancel() override {
    journal.push_back("cancel");
    CDialog::OnCancel();
  }
  DECLARE_MESSAGE_MAP()
};

BEGIN_MESSAGE_MAP(RoutingDialog, BaseDialog)
ON_BN_CLICKED(102, OnSecondHere)
ON_NOTIFY(TCN_SELCHANGE, 110, OnTabChange)
ON_REGISTERED_MESSAGE(kAskManager, OnAskManager)
END_MESSAGE_MAP()

const DialogTemplate& RoutingTemplate() {
  using namespace framework;
  static const DialogTemplate t{
      9002, WS_POPUP | WS_CAPTION | DS_MODALFRAME, 0, 0, 0, 220, 120, "Routing", "MS Shell Dlg", 8, false,
      {
          {101, kButtonClass, "First", WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON, 0, 5, 5, 50, 14},
          {102, kButtonClass, "Second", WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON, 0, 60, 5, 50, 14},
          {103, kButtonClass, "Flag", WS_VISIBLE | WS_TABSTOP | BS_AUTOCHECKBOX, 0, 5, 25, 60, 10},
          {104, kEditClass, "name", WS_VISIBLE | WS_TABSTOP | WS_BORDER | ES_AUTOHSCROLL, 0, 5, 40, 80, 12},
          {105, kButtonClass, "Hidden", WS_TABSTOP | BS_PUSHBUTTON, 0, 90, 40, 50, 14},
          {106, kButtonClass, "Off", WS_VISIBLE | WS_TABSTOP | WS_DISABLED | BS_PUSHBUTTON, 0, 145, 40, 50, 14},
          {110, kTabControlClass, "", WS_VISIBLE, 0, 5, 60, 200, 30},
          {IDOK, kButtonClass, "OK", WS_VISIBLE | WS_TABSTOP | BS_DEFPUSHBUTTON, 0, 110, 100, 50, 14},
          {IDCANCEL, kButtonClass, "Cancel", WS_VISIBLE | WS_TABSTOP | BS_PUSHBUTTON, 0, 165, 100, 50, 14},
      }};
  return t;
}

class RoutingTest : public FrameworkTest {
 protected:
  RoutingTest() { journal.clear(); }
};

TEST_F(RoutingTest, DerivedMapsWinAndBaseMapsAnswerTheRest) {
  RoutingDialog dialog(RoutingTemplate());
  user.AnswerNext([](framework::ScriptedUser& u, HWND) {
    u.Click("First");
    u.Click("Second");
    u.Click("Cancel");
  });
  EXPECT_EQ(dialog.DoModal(), IDCANCEL);
  EXPECT_EQ(journal, (std::vector<std::string>{"base first", "derived second", "cancel"}));
}

TEST_F(RoutingTest, AControlHandlesItsReflectedNotificationAndPassesItOnOnlyWhenItSaysSo) {
  RoutingDialog dialog(RoutingTemplate());
  ASSERT_TRUE(dialog.CreateIndirect(RoutingTemplate()));
  dialog.ShowWindow(SW_SHOW);
  dialog.tabs.InsertItem(0, "Cameras");
  dialog.tabs.InsertItem(1, "Sections");
  user.SelectTab(dialog.tabs.m_hWnd, 1);
  EXPECT_EQ(journal, std::vector<std::string>{"tabs saw the change"});
  dialog.tabs.passOn = TRUE;
  user.SelectTab(dialog.tabs.m_hWnd, 0);
  EXPECT_EQ(journal, (std::vector<std::string>{"tabs saw the change", "tabs saw the change", "dialog saw the change"}));
  EXPECT_EQ(dialog.SendMessage(kAskManager), 62000);
  EXPECT_EQ(dialog.SendMessage(RegisterWindowMessage("Something_Else")), 0);
}

TEST_F(RoutingTest, TabVisitsTheTabStopsThatCanTakeTheFocusAndEnterPressesTheFocusedButton) {
  RoutingDialog dialog(RoutingTemplate());
  std::vector<int> visited;
  user.AnswerNext([&visited](framework::ScriptedUser& u, HWND modal) {
    visited.push_back(GetDlgCtrlID(GetFocus()));  // the first tab stop has the focus
    for (int i = 0; i < 6; ++i) {
      u.Press(VK_TAB);
      visited.push_back(GetDlgCtrlID(GetFocus()));
    }
    u.PressWith(VK_SHIFT, VK_TAB);
    visited.push_back(GetDlgCtrlID(GetFocus()));
    DWORD start = 1;
    DWORD end = 0;
    SendDlgItemMessage(modal, 104, EM_GETSEL, reinterpret_cast<WPARAM>(&start), reinterpret_cast<LPARAM>(&end));
    EXPECT_EQ(start, 0U);
    EXPECT_EQ(end, 4U);  // an edit reached by Tab has all its text selected
    u.Press(VK_RETURN);  // presses the focused Cancel, not the default OK
  });
  EXPECT_EQ(dialog.DoModal(), IDCANCEL);
  // The hidden and the disabled buttons are passed over; the tab control takes no tab stop.
  EXPECT_EQ(visited, (std::vector<int>{101, 102, 103, 104, IDOK, IDCANCEL, 101, IDCANCEL}));
}

TEST_F(RoutingTest, SpaceTicksTheFocusedCheckBoxAndOkTakesItIntoTheValue) {
  RoutingDialog dialog(RoutingTemplate());
  user.AnswerNext([](framework::ScriptedUser& u, HWND) {
    u.Press(VK_TAB);
    u.Press(VK_TAB);
    u.Press(VK_SPACE);
    u.Click("OK");
  });
  EXPECT_EQ(dialog.DoModal(), IDOK);
  EXPECT_EQ(dialog.flag, 1);
}

TEST_F(RoutingTest, EscapeDoesNothingWhileCancelIsDisabled) {
  RoutingDialog dialog(RoutingTemplate());
  user.AnswerNext([](framework::ScriptedUser& u, HWND modal) {
    EnableWindow(GetDlgItem(modal, IDCANCEL), FALSE);
    u.Press(VK_ESCAPE);
  });
  user.AnswerNext([](framework::ScriptedUser& u, HWND) { u.Click("OK"); });
  EXPECT_EQ(dialog.DoModal(), IDOK);
  EXPECT_TRUE(journal.empty());  // OnCancel never ran
}

TEST_F(RoutingTest, AModalDialogGivesTheFocusBackToWhereItWas) {
  CWnd& frame = HostFrame();
  CButton button;
  ASSERT_TRUE(button.Create("Here", WS_CHILD | WS_VISIBLE | BS_PUSHBUTTON, CRect(5, 5, 80, 30), &frame, 7));
  button.SetFocus();
  EXPECT_EQ(AfxGetMainWnd(), &frame);
  RoutingDialog dialog(RoutingTemplate());
  user.AnswerNext([&frame](framework::ScriptedUser& u, HWND modal) {
    EXPECT_EQ(GetParent(modal), frame.m_hWnd);  // owned by the host's main window
    EXPECT_EQ(GetActiveWindow(), modal);
    u.Press(VK_ESCAPE);
  });
  EXPECT_EQ(dialog.DoModal(), IDCANCEL);
  EXPECT_EQ(GetFocus(), button.m_hWnd);
  EXPECT_EQ(GetActiveWindow(), frame.m_hWnd);
}

TEST_F(RoutingTest, TheScriptedUserSaysWhatItCouldNotFind) {
  RoutingDialog dialog(RoutingTemplate());
  ASSERT_TRUE(dialog.CreateIndirect(RoutingTemplate()));
  dialog.ShowWindow(SW_SHOW);
  EXPECT_THROW(user.Click(4242), framework::ScriptError);
  EXPECT_THROW(user.Click("Apply"), framework::ScriptError);
  EXPECT_THROW(user.SelectTab(dialog.tabs.m_hWnd, 3), framework::ScriptError);
  EXPECT_NO_THROW(user.Click("&First"));  // the ampersand only marks the key
}

}  // namespace
