// The pane's icon tabs, its anchors on resize, its tips, and a posted message after a button.
#include <string>
#include <vector>

#include "framework/canvas.h"
#include "framework/render.h"
#include "tests/framework/framework_fixture.h"
#include "tests/framework/svg_reader.h"
#include "tests/framework/test_pane.h"

namespace {

class PaneTest : public FrameworkTest {
 protected:
  PaneTest() {
    pane.Create(5000, &HostFrame());
    pane.ShowWindow(SW_SHOW);
  }

  CRect Placed(int id) {
    CRect r;
    pane.GetDlgItem(id)->GetWindowRect(&r);
    pane.ScreenToClient(&r);
    return r;
  }

  TestPane pane;
};

TEST_F(PaneTest, ClickingATabSelectsItWhileSelectingByMessageTellsNobody) {
  user.SelectTab(pane.tabs.m_hWnd, 2);
  EXPECT_EQ(pane.tabs.GetCurSel(), 2);
  EXPECT_EQ(pane.tabs.SendMessage(TCM_SETCURSEL, 1), 2);  // answers the previous tab
  EXPECT_EQ(pane.tabs.SendMessage(TCM_SETCURSEL, 7), -1);  // no tab 7: nothing changes
  EXPECT_EQ(pane.tabs.GetCurSel(), 1);
  EXPECT_EQ(pane.events, std::vector<std::string>{"tab 2"});
}

TEST_F(PaneTest, ButtonsOnTheTabPageTakeTheirClicksAndPostedMessagesRunAfterTheHandler) {
  user.Click(5007);
  EXPECT_EQ(pane.events, (std::vector<std::string>{"add new begins", "add new ends", "posted message runs"}));
  pane.GetDlgItem(5007)->EnableWindow(FALSE);
  user.Click(pane.GetDlgItem(5007)->m_hWnd);  // a disabled button takes no click
  EXPECT_EQ(pane.events.size(), 3U);
}

TEST_F(PaneTest, ResizingBelowTheSmallestSizeLaysOutAsForTheSmallestSize) {
  pane.MoveWindow(0, 0, 240, 150);
  const std::vector<CRect> smallest = {Placed(5011), Placed(5016), Placed(5019), Placed(IDOK)};
  pane.MoveWindow(0, 0, 100, 100);
  EXPECT_EQ((std::vector<CRect>{Placed(5011), Placed(5016), Placed(5019), Placed(IDOK)}), smallest);
  // At 240 x 150 each rule moved its control by the change from the template's 254 x 400.
  EXPECT_EQ(smallest[1], CRect(3, 63, 251 - 14, 395 - 250));   // stretch
  EXPECT_EQ(smallest[2], CRect(185 - 14, 33, 208 - 14, 56));   // follow right
  EXPECT_EQ(smallest[3], CRect(179 - 14, 375 - 250, 254 - 14, 398 - 250));  // follow corner
  EXPECT_EQ(Placed(5007), CRect(5, 33, 29, 56));  // not anchored
  EXPECT_GT(framework::GetPaintCounters(pane.GetDlgItem(5016)->m_hWnd).invalidations, 0);
}

TEST_F(PaneTest, TheHostsMouseMovesShowTheTipOfTheButtonOrTabUnderTheMouse) {
  const int filter = framework::AddMessageFilter([this](MSG& msg) {
    ::SendMessage(pane.m_hWnd, PreTranslateMessageNumber(), reinterpret_cast<WPARAM>(&msg), 0);
    return false;
  });
  CTipWindow& buttonTip = pane.buttonTips.TipWindow();
  user.MoveTo(pane.GetDlgItem(5010)->m_hWnd, {3, 4});
  EXPECT_TRUE(buttonTip.IsWindowVisible());
  EXPECT_EQ(buttonTip.GetWindowText(), "Execute");
  EXPECT_EQ(buttonTip.Title(), "");
  EXPECT_EQ(buttonTip.Parameters(), (CTipWindow::DisplayParameters{6, 0, 5000, 0, 1}));
  EXPECT_EQ(buttonTip.HitArea(), Placed(5010));
  EXPECT_EQ(buttonTip.ShownPoint(), CPoint(3, 4));

  // Leaving the button hides its tip (the fifth parameter); the tabs have their own tips.
  CRect tab;
  pane.tabs.GetItemRect(1, &tab);
  user.MoveTo(pane.tabs.m_hWnd, tab.CenterPoint());
  user.Wait(200);
  EXPECT_FALSE(buttonTip.IsWindowVisible());
  CTipWindow& tabTip = pane.tabTips.TipWindow();
  EXPECT_TRUE(tabTip.IsWindowVisible());
  EXPECT_EQ(tabTip.GetWindowText(), "Vertical Section");
  user.Wait(6000);  // shown for five seconds at most
  EXPECT_FALSE(tabTip.IsWindowVisible());

  // The tab control's page (below the tabs) is no tab: no tip.
  pane.tabTips.TipWindow().Hide();
  EXPECT_FALSE(pane.tabTips.RelayAll(CPoint(100, 300)));
  framework::RemoveMessageFilter(filter);
}

TEST_F(PaneTest, ATipAddedTwiceKeepsOneEntryWithTheNewText) {
  pane.buttonTips.AddTip(5007, 76);
  EXPECT_EQ(pane.buttonTips.Entries().size(), 7U);
  EXPECT_EQ(pane.buttonTips.Entries().front(), (std::pair<int, std::string>{5007, "Remove"}));
  EXPECT_FALSE(pane.buttonTips.Relay(4242, CPoint(1, 1)));  // no tip for that id
}

// Draws one tab of an owner-drawn icon tab control into a canvas and reads the picture back.
SvgNode DrawTab(CTabCtrlEx& tabs, int index, bool selected) {
  Canvas canvas(60, 30);
  DRAWITEMSTRUCT item;
  item.CtlType = ODT_TAB;
  item.itemID = static_cast<UINT>(index);
  item.itemState = selected ? ODS_SELECTED : 0;
  item.hwndItem = tabs.m_hWnd;
  item.hDC = &canvas;
  item.rcItem = CRect(0, 0, 60, 24);
  tabs.DrawItem(&item);
  return ParseSvg(canvas.Svg());
}

TEST_F(PaneTest, IconTabsDrawTheirIconAfterASpaceAndTheSelectedTextCentredInBlue) {
  pane.tabs.InsertItem(3, "Plans");  // a tab without image
  pane.tabs.SetCurSel(3);
  const SvgNode plain = DrawTab(pane.tabs, 3, true);
  EXPECT_TRUE(IconsIn(plain).empty());
  const auto texts = FindAll(plain, [](const SvgNode& n) { return n.name == "text"; });
  ASSERT_EQ(texts.size(), 1U);
  EXPECT_EQ(texts[0]->text, "Plans");
  EXPECT_EQ(texts[0]->Attribute("fill"), "#0000ff");
  EXPECT_EQ(texts[0]->Attribute("y"), "15");  // the baseline of a line centred in 24 pixels
  const SvgNode icon = DrawTab(pane.tabs, 1, false);
  EXPECT_EQ(IconsIn(icon), std::vector<std::string>{"5007"});
  const auto pictures = FindAll(icon, [](const SvgNode& n) { return !n.Attribute("data-icon").empty(); });
  ASSERT_EQ(pictures.size(), 1U);
  const SvgNode& placed = pictures[0]->children.at(0);
  EXPECT_EQ(placed.Attribute("x"), "3");  // the width of a space
  EXPECT_EQ(placed.Attribute("y"), "2");  // below the edge of an unselected tab
  EXPECT_EQ(placed.Attribute("width"), "16");
  EXPECT_TRUE(TextsIn(icon).empty());          // the pane's tabs have empty texts
}

}  // namespace
