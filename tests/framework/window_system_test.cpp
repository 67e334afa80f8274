// The window system under the framework classes: registered messages, the queue and the idle
// pump, destruction and its last message, focus, capture and coordinate mapping.
#include <string>
#include <vector>

#include "framework/cwnd.h"
#include "framework/input.h"
#include "framework/window_classes.h"
#include "tests/framework/framework_fixture.h"
#include "tests/framework/test_pane.h"

namespace {

using WindowSystemTest = FrameworkTest;

TEST_F(WindowSystemTest, RegisteredMessagesAreStableByNameInTheirRange) {
  const UINT paneManager = RegisterWindowMessage("Quorvel_GetPaneManager");
  const UINT preTranslate = RegisterWindowMessage("Quorvel_PreTranslateMessage");
  EXPECT_GE(paneManager, 0xC000U);
  EXPECT_LE(paneManager, 0xFFFFU);
  EXPECT_NE(paneManager, preTranslate);
  EXPECT_EQ(RegisterWindowMessage("Quorvel_GetPaneManager"), paneManager);
  EXPECT_EQ(RegisterWindowMessage("quorvel_getpanemanager"), paneManager);  // names ignore case
  EXPECT_EQ(RegisterWindowMessage(""), 0U);
}

// Records every message a window gets, and posts from inside one handler.
class RecordingWindow : public CWnd {
 public:
  std::vector<std::string> log;

 protected:
  LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
    if (message == WM_APP) {
      log.push_back("handler " + std::to_string(wParam) + " begins");
      if (wParam == 1) PostMessage(WM_APP, 2, 0);
      log.push_back("handler " + std::to_string(wParam) + " ends");
      return 0;
    }
    if (message == WM_DESTROY) log.push_back("destroy");
    if (message == WM_NCDESTROY) log.push_back("last message");
    return CWnd::WindowProc(message, wParam, lParam);
  }
  void PostNcDestroy() override { log.push_back("after the last message"); }
};

TEST_F(WindowSystemTest, PostedMessagesWaitForTheIdlePumpAndRunAfterTheHandlerThatPosted) {
  RecordingWindow window;
  ASSERT_TRUE(window.CreateEx(0, framework::kStaticClass, "", WS_POPUP, CRect(0, 0, 10, 10), nullptr, 0));
  window.PostMessage(WM_APP, 1, 0);
  EXPECT_TRUE(window.log.empty());  // nothing runs until someone pumps
  EXPECT_EQ(framework::PendingMessageCount(), 1U);
  EXPECT_EQ(framework::PumpPendingMessages(), 2U);
  EXPECT_EQ(window.log,
            (std::vector<std::string>{"handler 1 begins", "handler 1 ends", "handler 2 begins", "handler 2 ends"}));
}

TEST_F(WindowSystemTest, MessagesForADestroyedWindowAreDroppedAndItsHandleIsNeverReused) {
  RecordingWindow window;
  ASSERT_TRUE(window.CreateEx(0, framework::kStaticClass, "", WS_POPUP, CRect(0, 0, 10, 10), nullptr, 0));
  const HWND old = window.m_hWnd;
  window.PostMessage(WM_APP, 7, 0);
  window.DestroyWindow();
  EXPECT_EQ(window.log, (std::vector<std::string>{"destroy", "last message", "after the last message"}));
  EXPECT_FALSE(window.m_hWnd);
  EXPECT_EQ(framework::PumpPendingMessages(), 0U);

  RecordingWindow next;
  ASSERT_TRUE(next.CreateEx(0, framework::kStaticClass, "", WS_POPUP, CRect(0, 0, 10, 10), nullptr, 0));
  EXPECT_NE(next.m_hWnd, old);
  EXPECT_FALSE(IsWindow(old));
  EXPECT_EQ(SendMessage(old, WM_APP, 3, 0), 0);
  EXPECT_TRUE(next.log.empty());
}

TEST_F(WindowSystemTest, AWindowThatPostsToItselfForEverDoesNotHangTheIdlePump) {
  class Looping : public CWnd {
   protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
      if (message == WM_APP) PostMessage(WM_APP);
      return CWnd::WindowProc(message, wParam, lParam);
    }
  } looping;
  ASSERT_TRUE(looping.CreateEx(0, framework::kStaticClass, "", WS_POPUP, CRect(0, 0, 10, 10), nullptr, 0));
  looping.PostMessage(WM_APP);
  EXPECT_EQ(framework::PumpPendingMessages(), 10000U);
  EXPECT_EQ(framework::PendingMessageCount(), 1U);
}

TEST_F(WindowSystemTest, DestroyingAParentTakesItsChildrenAndItsOwnedPopupsAndTheFocus) {
  const std::size_t before = framework::LiveWindowCount();
  CWnd& frame = HostFrame();
  CWnd child;
  CWnd popup;
  ASSERT_TRUE(child.CreateEx(0, framework::kEditClass, "text", WS_CHILD | WS_VISIBLE, CRect(5, 5, 100, 25), &frame, 42));
  ASSERT_TRUE(popup.CreateEx(0, framework::kStaticClass, "", WS_POPUP, CRect(0, 0, 10, 10), &frame, 0));
  child.SetFocus();
  EXPECT_EQ(GetFocus(), child.m_hWnd);
  EXPECT_EQ(frame.GetDlgItem(42), &child);
  EXPECT_EQ(child.GetDlgCtrlID(), 42);
  EXPECT_EQ(child.GetParent(), &frame);
  EXPECT_EQ(popup.GetParent(), &frame);  // a popup's parent is its owner

  frame.DestroyWindow();
  EXPECT_FALSE(child.m_hWnd);
  EXPECT_FALSE(popup.m_hWnd);
  EXPECT_FALSE(GetFocus());
  EXPECT_EQ(framework::LiveWindowCount(), before);
}

TEST_F(WindowSystemTest, ClientAndScreenPointsMapThroughFramesAndParents) {
  CWnd& frame = HostFrame();  // at (20, 20) with a 1-pixel border and a 22-pixel caption
  CWnd child;
  ASSERT_TRUE(child.CreateEx(WS_EX_CLIENTEDGE, framework::kStaticClass, "", WS_CHILD | WS_VISIBLE,
                             CRect(10, 30, 110, 80), &frame, 1));
  CRect client;
  child.GetClientRect(&client);
  EXPECT_EQ(client, CRect(0, 0, 96, 46));  // the 2-pixel edge on each side
  POINT p{0, 0};
  child.ClientToScreen(&p);
  EXPECT_EQ(p, (POINT{20 + 1 + 10 + 2, 20 + 23 + 30 + 2}));
  child.ScreenToClient(&p);
  EXPECT_EQ(p, (POINT{0, 0}));
  CRect r;
  child.GetWindowRect(&r);
  EXPECT_EQ(r, CRect(31, 73, 131, 123));
}

TEST_F(WindowSystemTest, CaptureKeepsTheMouseUntilReleased) {
  CWnd& frame = HostFrame();
  CButton button;
  ASSERT_TRUE(button.Create("Press", WS_CHILD | WS_VISIBLE | BS_PUSHBUTTON, CRect(10, 10, 90, 40), &frame, 7));
  // Pressing captures; leaving the button while held shows it released, coming back pressed.
  HWND top = frame.m_hWnd;
  const POINT inside{1 + 10 + 40, 23 + 10 + 15};
  framework::input::MouseDown(top, inside);
  EXPECT_EQ(GetCapture(), button.m_hWnd);
  EXPECT_NE(button.GetState() & BST_PUSHED, 0U);
  framework::input::MouseMove(top, {300, 300});
  EXPECT_EQ(button.GetState() & BST_PUSHED, 0U);
  framework::input::MouseUp(top, {300, 300});  // released outside: no click
  EXPECT_FALSE(GetCapture());
  EXPECT_EQ(GetFocus(), button.m_hWnd);
}

}  // namespace
