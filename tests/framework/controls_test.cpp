// The simple controls as a user works them: typing into an edit, pressing buttons and check
// boxes, resting the mouse on a tool, and the image lists behind icons.
#include <string>
#include <vector>

#include "framework/cdc.h"
#include "framework/cdialog.h"
#include "framework/resource_module.h"
#include "framework/controls/button.h"
#include "framework/controls/edit.h"
#include "framework/image_list.h"
#include "framework/render.h"
#include "framework/window_classes.h"
#include "tests/framework/framework_fixture.h"
#include "tests/framework/svg_reader.h"
#include "ui/controls/tool_tip_ctrl_ex.h"

namespace {

// A window that hosts controls and writes down the commands they send it.
class Host : public CWnd {
 public:
  std::vector<std::string> commands;

 protected:
  BOOL OnCommand(WPARAM wParam, LPARAM lParam) override {
    commands.push_back(std::to_string(LOWORD(wParam)) + ":" + std::to_string(HIWORD(wParam)));
    return CWnd::OnCommand(wParam, lParam);
  }
};

class ControlsTest : public FrameworkTest {
 protected:
  ControlsTest() {
    host.CreateEx(0, framework::kDialogClass, "Controls", WS_POPUP | WS_CAPTION | WS_VISIBLE, CRect(100, 100, 500, 300),
                  nullptr, 0);
  }

  std::string Text(const CWnd& w) const { return w.GetWindowText(); }

  Host host;
};

TEST_F(ControlsTest, TypingEditsTheTextAtTheCaretAndReportsEachChange) {
  CEdit edit;
  ASSERT_TRUE(edit.Create(WS_CHILD | WS_VISIBLE | WS_BORDER | ES_AUTOHSCROLL, CRect(10, 10, 210, 32), &host, 30));
  user.Click(edit.m_hWnd);
  user.Type("Camra 1");
  for (int i = 0; i < 4; ++i) user.Press(VK_LEFT);
  user.Type("e");  // "Camera 1"
  user.Press(VK_END);
  user.Press(VK_BACK);
  user.Type("2");
  EXPECT_EQ(Text(edit), "Camera 2");
  user.Press(VK_HOME);
  user.PressWith(VK_SHIFT, VK_RIGHT);
  user.Press(VK_DELETE);  // deletes the selected "C"
  EXPECT_EQ(Text(edit), "amera 2");
  int start = -1;
  int end = -1;
  edit.GetSel(start, end);
  EXPECT_EQ(start, 0);
  EXPECT_EQ(end, 0);
  // One EN_CHANGE per change: eight characters typed, one taken back, one selection deleted,
  // and one more typed.
  const auto changes = std::count(host.commands.begin(), host.commands.end(), "30:" + std::to_string(EN_CHANGE));
  EXPECT_EQ(changes, 11);
}

TEST_F(ControlsTest, ALongTextScrollsSoThatTheCaretStaysInView) {
  CEdit edit;
  ASSERT_TRUE(edit.Create(WS_CHILD | WS_VISIBLE | WS_BORDER | ES_AUTOHSCROLL, CRect(10, 10, 90, 32), &host, 30));
  user.Click(edit.m_hWnd);
  user.Type("...sec_sym\\very long symbol library name");
  const SvgNode picture = ParseSvg(framework::RenderWindow(edit.m_hWnd));
  const std::vector<std::string> texts = TextsIn(picture);
  ASSERT_EQ(texts.size(), 1U);
  EXPECT_TRUE(std::string("...sec_sym\\very long symbol library name").ends_with(texts[0]));
  EXPECT_LT(texts[0].size(), 15U);  // only the end shows in 80 pixels
  EXPECT_EQ(texts[0].back(), 'e');
}

TEST_F(ControlsTest, ReadOnlyNumberAndShortEditsRefuseWhatTheyCannotTake) {
  CEdit readOnly;
  CEdit digits;
  CEdit fixed;
  ASSERT_TRUE(readOnly.Create(WS_CHILD | WS_VISIBLE | ES_READONLY, CRect(10, 10, 200, 30), &host, 31));
  ASSERT_TRUE(digits.Create(WS_CHILD | WS_VISIBLE | ES_NUMBER | ES_AUTOHSCROLL, CRect(10, 40, 200, 60), &host, 32));
  ASSERT_TRUE(fixed.Create(WS_CHILD | WS_VISIBLE, CRect(10, 70, 40, 90), &host, 33));  // no sideways scrolling
  readOnly.SetWindowText("c:\\lib\\sec01");
  user.Click(readOnly.m_hWnd);
  user.Type("x");
  user.Press(VK_DELETE);
  EXPECT_EQ(Text(readOnly), "c:\\lib\\sec01");
  user.Click(digits.m_hWnd);
  user.Type("2a5.0");
  EXPECT_EQ(Text(digits), "250");
  digits.SetLimitText(4);
  user.Type("123");
  EXPECT_EQ(Text(digits), "2501");
  user.Click(fixed.m_hWnd);
  user.Type("Mmmmmmmmmmmm");
  EXPECT_EQ(Text(fixed), "Mm");  // what fits in 26 pixels
}

TEST_F(ControlsTest, AButtonClicksOnReleaseInsideAndCheckBoxesToggleByMouseOrSpace) {
  CButton push;
  CButton check;
  CButton radio;
  ASSERT_TRUE(push.Create("Start", WS_CHILD | WS_VISIBLE | BS_PUSHBUTTON, CRect(10, 10, 90, 35), &host, 5070));
  ASSERT_TRUE(check.Create("Auto clip", WS_CHILD | WS_VISIBLE | BS_AUTOCHECKBOX, CRect(10, 50, 150, 65), &host, 5077));
  ASSERT_TRUE(radio.Create("Whole", WS_CHILD | WS_VISIBLE | BS_AUTORADIOBUTTON, CRect(10, 70, 150, 85), &host, 40));
  user.Click("Start");
  user.Click("Auto clip");
  EXPECT_EQ(check.GetCheck(), BST_CHECKED);
  user.Press(VK_SPACE);  // the check box has the focus now
  EXPECT_EQ(check.GetCheck(), BST_UNCHECKED);
  user.Click(radio.m_hWnd);
  user.Click(radio.m_hWnd);
  EXPECT_EQ(radio.GetCheck(), BST_CHECKED);  // a radio button stays chosen
  push.SendMessage(BM_CLICK);
  push.EnableWindow(FALSE);
  push.SendMessage(BM_CLICK);  // a disabled button cannot be pressed
  EXPECT_EQ(host.commands, (std::vector<std::string>{"5070:0", "5077:0", "5077:0", "40:0", "40:0", "5070:0"}));
}

TEST_F(ControlsTest, AnOwnerDrawnButtonIsDrawnByItsObjectThroughItsParent) {
  class Swatch : public CButton {
   public:
    UINT lastState = 0;
    void DrawItem(LPDRAWITEMSTRUCT item) override {
      lastState = item->itemState;
      CDC::FromHandle(item->hDC)->FillSolidRect(item->rcItem, RGB(255, 0, 0));
    }
  } swatch;
  ASSERT_TRUE(swatch.Create("", WS_CHILD | WS_VISIBLE | BS_OWNERDRAW, CRect(10, 10, 40, 30), &host, 5054));
  swatch.SetFocus();
  const SvgNode picture = ParseSvg(framework::RenderWindow(host.m_hWnd));
  const SvgNode* drawn = FindControl(picture, 5054);
  ASSERT_NE(drawn, nullptr);
  EXPECT_EQ(FindAll(*drawn, [](const SvgNode& n) { return n.Attribute("fill") == "#ff0000"; }).size(), 1U);
  EXPECT_EQ(swatch.lastState, ODS_FOCUS);
}

TEST_F(ControlsTest, AToolTipShowsTheStringOfItsToolAfterTheMouseRestsAndHidesOnAClick) {
  CButton layers;
  CToolTipCtrlEx tips;
  ASSERT_TRUE(layers.Create("Layers", WS_CHILD | WS_VISIBLE | BS_PUSHBUTTON, CRect(10, 10, 110, 40), &host, 5033));
  ASSERT_TRUE(tips.Create(&host));
  ASSERT_TRUE(tips.AddTool(&layers, 71));
  EXPECT_EQ(tips.GetToolCount(), 1);
  EXPECT_EQ(tips.GetText(&layers), "Layer Configuration");

  user.MoveTo(layers.m_hWnd, {20, 10});
  EXPECT_FALSE(tips.IsWindowVisible());  // not before the mouse has rested
  user.Wait(600);
  EXPECT_TRUE(tips.IsWindowVisible());
  EXPECT_EQ(tips.GetWindowText(), "Layer Configuration");
  RECT tipRect;
  tips.GetWindowRect(&tipRect);
  POINT mouse;
  GetCursorPos(&mouse);
  EXPECT_EQ(tipRect.top, mouse.y + 20);  // below the pointer

  user.Click(layers.m_hWnd);
  EXPECT_FALSE(tips.IsWindowVisible());
  user.MoveTo(host.m_hWnd, {300, 150});  // off the tool: nothing comes back
  user.Wait(1000);
  EXPECT_FALSE(tips.IsWindowVisible());
}

TEST_F(ControlsTest, ImageListsHoldIconsByIndexUntilDestroyed) {
  const std::size_t lists = framework::LiveImageListCount();
  {
    CImageList images;
    ASSERT_TRUE(images.Create(16, 16, ILC_COLORDDB | ILC_MASK, 1, 1));
    EXPECT_EQ(images.Add(AfxLoadIcon(5006)), 0);
    EXPECT_EQ(images.Add(AfxLoadIcon(5008)), 1);
    EXPECT_EQ(images.Add(AfxLoadIcon(4999)), -1);  // no such picture
    EXPECT_EQ(images.GetImageCount(), 2);
    EXPECT_EQ(framework::IconResourceId(images.ExtractIcon(1)), 5008U);
    EXPECT_EQ(ImageList_ReplaceIcon(images.GetSafeHandle(), 0, AfxLoadIcon(5007)), 0);
    EXPECT_EQ(framework::IconResourceId(images.ExtractIcon(0)), 5007U);
    EXPECT_EQ(AfxLoadIcon(5007), images.ExtractIcon(0));  // one handle per icon
    EXPECT_EQ(framework::LiveImageListCount(), lists + 1);
  }
  EXPECT_EQ(framework::LiveImageListCount(), lists);
}

}  // namespace
