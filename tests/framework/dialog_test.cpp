// Dialogs from templates: the modal run and how it ends, data exchange, the pane template's
// controls, message boxes, and that closing a dialog leaves no window, timer or list behind.
#include <string>

#include "framework/cdialog.h"
#include "framework/data_exchange.h"
#include "framework/image_list.h"
#include "framework/message_box.h"
#include "tests/framework/framework_fixture.h"
#include "tests/framework/test_pane.h"

namespace {

// The selection-name dialog of template 5062 with its name bound to the edit.
class NameDialog : public CDialog {
 public:
  explicit NameDialog(CWnd* parent) : CDialog(5062, parent) {}
  std::string name = "Old";
  int okPresses = 0;

 protected:
  void DoDataExchange(CDataExchange* dx) override { DDX_Text(dx, 5074, name); }
  void OnOK() override {
    ++okPresses;
    CDialog::OnOK();
  }
};

struct Counts {
  std::size_t windows = framework::LiveWindowCount();
  std::size_t timers = framework::LiveTimerCount();
  std::size_t imageLists = framework::LiveImageListCount();
  bool operator==(const Counts&) const = default;
};

using DialogTest = FrameworkTest;

TEST_F(DialogTest, TheModalRunEndsWithTheButtonOrKeyTheUserChose) {
  CWnd& frame = HostFrame();
  struct Case {
    const char* what;
    framework::ScriptedUser::Answer answer;
    INT_PTR result;
    std::string name;
  };
  const Case cases[] = {
      {"typing and clicking OK",
       [](framework::ScriptedUser& u, HWND) {
         u.Type("Front");
         u.Click("OK");
       },
       IDOK, "Front"},
      {"clicking Cancel", [](framework::ScriptedUser& u, HWND) { u.Click("Cancel"); }, IDCANCEL, "Old"},
      {"typing and pressing Enter",
       [](framework::ScriptedUser& u, HWND) {
         u.Type("Side");
         u.Press(VK_RETURN);
       },
       IDOK, "Side"},
      {"pressing Escape after typing",
       [](framework::ScriptedUser& u, HWND) {
         u.Type("Lost");
         u.Press(VK_ESCAPE);
       },
       IDCANCEL, "Old"},
      {"the close box", [](framework::ScriptedUser& u, HWND modal) {
         RECT r;
         GetWindowRect(modal, &r);
         u.Click(modal, {r.right - r.left - 14 - 6, -12});  // the caption's right end, above the client area
       },
       IDCANCEL, "Old"},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.what);
    const Counts before;
    NameDialog dialog(&frame);
    user.AnswerNext(c.answer);
    EXPECT_EQ(dialog.DoModal(), c.result);
    EXPECT_EQ(dialog.name, c.name);
    EXPECT_EQ(Counts(), before);  // the dialog and its controls are gone
    EXPECT_TRUE(frame.IsWindowEnabled());
  }
  EXPECT_EQ(user.UnansweredModals(), 0);
}

TEST_F(DialogTest, TheOwnerTakesNoClicksWhileTheDialogRuns) {
  CWnd& frame = HostFrame();
  TestPane pane;
  ASSERT_TRUE(pane.Create(5000, &frame));
  pane.ShowWindow(SW_SHOW);
  NameDialog dialog(&frame);
  user.AnswerNext([&pane](framework::ScriptedUser& u, HWND) {
    EXPECT_FALSE(IsWindowEnabled(pane.GetTopLevelParent()->m_hWnd));
    u.Click(pane.GetDlgItem(5007)->m_hWnd);  // "Add new" of the pane behind the dialog
    u.Click("Cancel");
  });
  EXPECT_EQ(dialog.DoModal(), IDCANCEL);
  EXPECT_TRUE(pane.events.empty());
  user.Click(pane.GetDlgItem(5007)->m_hWnd);  // and again once the dialog is gone
  EXPECT_EQ(pane.events.front(), "add new begins");
}

TEST_F(DialogTest, ADialogNobodyAnswersEndsAsCancelled) {
  NameDialog dialog(&HostFrame());
  EXPECT_EQ(dialog.DoModal(), IDCANCEL);
  EXPECT_EQ(user.UnansweredModals(), 1);
}

TEST_F(DialogTest, ANumberFieldRefusesTextAndKeepsTheDialogOpen) {
  class CountDialog : public CDialog {
   public:
    explicit CountDialog(CWnd* parent) : CDialog(5062, parent) {}
    int count = 3;

   protected:
    void DoDataExchange(CDataExchange* dx) override { DDX_Text(dx, 5074, count); }
  } dialog(&HostFrame());
  user.AnswerNext([](framework::ScriptedUser& u, HWND) {
    u.PressWith(VK_SHIFT, VK_HOME);
    u.Type("12x");
    u.Click("OK");  // refused with a message box
  });
  user.AnswerNextWithButton(IDOK);  // the message box
  user.AnswerNext([](framework::ScriptedUser& u, HWND modal) {
    EXPECT_EQ(GetFocus(), GetDlgItem(modal, 5074));  // back in the field, its text selected
    u.Type("12");
    u.Click("OK");
  });
  EXPECT_EQ(dialog.DoModal(), IDOK);
  EXPECT_EQ(dialog.count, 12);
  ASSERT_EQ(framework::MessageBoxLog().size(), 1U);
  EXPECT_EQ(framework::MessageBoxLog()[0].text, "Please enter an integer.");
}

TEST_F(DialogTest, ThePaneTemplatePlacesItsControlsByDialogUnits) {
  CWnd& frame = HostFrame();
  TestPane pane;
  ASSERT_TRUE(pane.Create(5000, &frame));
  EXPECT_FALSE(pane.IsWindowVisible());  // the template has no WS_VISIBLE
  EXPECT_TRUE(pane.GetStyle() & WS_CHILD);
  CRect client;
  pane.GetClientRect(&client);
  EXPECT_EQ(client, CRect(0, 0, 254, 400));  // 169 x 246 units at 6 x 13 pixels a character

  const auto placed = [&pane](int id) {
    CRect r;
    pane.GetDlgItem(id)->GetWindowRect(&r);
    pane.ScreenToClient(&r);
    return r;
  };
  EXPECT_EQ(placed(5016), CRect(3, 63, 251, 395));
  EXPECT_EQ(placed(5007), CRect(5, 33, 29, 56));
  EXPECT_EQ(placed(5019), CRect(185, 33, 208, 56));
  EXPECT_EQ(placed(IDOK), CRect(179, 375, 254, 398));
  EXPECT_FALSE(pane.GetDlgItem(IDOK)->IsWindowVisible());
  EXPECT_EQ(pane.tree.GetStyle() & (TVS_CHECKBOXES | TVS_EDITLABELS), TVS_CHECKBOXES | TVS_EDITLABELS);
  EXPECT_EQ(pane.GetDefID(), MAKELONG(IDOK, DC_HASDEFID));

  // Enter in the pane runs its OK command even though the OK button is hidden.
  pane.ShowWindow(SW_SHOW);
  pane.tree.SetFocus();
  user.Press(VK_RETURN);
  EXPECT_EQ(pane.events, std::vector<std::string>{"ok"});
}

TEST_F(DialogTest, ClosingThePaneFreesEveryWindowTimerAndImageList) {
  const Counts before;
  {
    TestPane pane;
    ASSERT_TRUE(pane.Create(5000, &HostFrame()));
    pane.ShowWindow(SW_SHOW);
    pane.FillSections();
    EXPECT_GT(framework::LiveWindowCount(), before.windows + 10);
    user.RenameItem(pane.tree.m_hWnd, "Section 0", "Front");
    user.Click(pane.tree.m_hWnd);
    pane.DestroyWindow();
  }
  HostFrame().DestroyWindow();
  EXPECT_EQ(Counts(), before);
}

TEST_F(DialogTest, MessageBoxesAreAnsweredLikeAnyDialogAndRecorded) {
  HostFrame();
  user.AnswerNextWithButton(IDNO);
  EXPECT_EQ(AfxMessageBox("Remove the section?", MB_YESNO | MB_ICONQUESTION), IDNO);
  // Escape closes a box that has only OK; a Yes/No box waits for one of its buttons.
  user.AnswerNext([](framework::ScriptedUser& u, HWND) { u.Press(VK_ESCAPE); });
  EXPECT_EQ(AfxMessageBox(52, MB_OK | MB_ICONEXCLAMATION), IDOK);
  user.AnswerNext([](framework::ScriptedUser& u, HWND) { u.Press(VK_ESCAPE); });
  user.AnswerNext([](framework::ScriptedUser& u, HWND) { u.Press(VK_RETURN); });
  EXPECT_EQ(AfxMessageBox("Keep it?", MB_YESNO), IDYES);

  const auto& log = framework::MessageBoxLog();
  ASSERT_EQ(log.size(), 3U);
  EXPECT_EQ(log[0].caption, "Pandex");
  EXPECT_EQ(log[0].type, MB_YESNO | MB_ICONQUESTION);
  EXPECT_EQ(log[1].text, "No name has been typed for the selection");
  EXPECT_EQ(log[1].answer, IDOK);
  EXPECT_EQ(log[2].answer, IDYES);
  EXPECT_EQ(user.UnansweredModals(), 0);
}

}  // namespace
