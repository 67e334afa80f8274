// The plain list control as the dialogs use it: which cell a click was on, column clicks, the
// keys, and a parent that colours rows while the list is drawn.
#include <string>
#include <vector>

#include "framework/controls/list_ctrl.h"
#include "framework/image_list.h"
#include "framework/render.h"
#include "framework/window_classes.h"
#include "tests/framework/framework_fixture.h"
#include "tests/framework/svg_reader.h"

namespace {

// Writes down the list's notifications as "code row column" and colours odd rows.
class ListParent : public CWnd {
 public:
  std::vector<std::string> heard;

 protected:
  BOOL OnNotify(WPARAM wParam, LPARAM lParam, LRESULT* result) override {
    const auto* header = reinterpret_cast<const NMHDR*>(lParam);
    if (header->code == NM_CLICK || header->code == NM_DBLCLK) {
      const auto* click = reinterpret_cast<const NMITEMACTIVATE*>(lParam);
      heard.push_back(std::string(header->code == NM_CLICK ? "click " : "double ") + std::to_string(click->iItem) + " " +
                      std::to_string(click->iSubItem));
    } else if (header->code == LVN_COLUMNCLICK) {
      heard.push_back("column " + std::to_string(reinterpret_cast<const NMLISTVIEW*>(lParam)->iSubItem));
    } else if (header->code == NM_CUSTOMDRAW) {
      auto* draw = reinterpret_cast<NMLVCUSTOMDRAW*>(lParam);
      if (draw->nmcd.dwDrawStage == CDDS_PREPAINT) *result = CDRF_NOTIFYITEMDRAW;
      if (draw->nmcd.dwDrawStage == CDDS_ITEMPREPAINT && draw->nmcd.dwItemSpec % 2 == 1) draw->clrText = RGB(0, 0, 255);
      return TRUE;
    }
    return CWnd::OnNotify(wParam, lParam, result);
  }
};

class ListViewTest : public FrameworkTest {
 protected:
  ListViewTest() {
    parent.CreateEx(0, framework::kDialogClass, "List", WS_POPUP | WS_CAPTION | WS_VISIBLE, CRect(50, 50, 450, 350), nullptr, 0);
    list.Create(WS_CHILD | WS_VISIBLE | WS_BORDER | LVS_REPORT | LVS_SINGLESEL, CRect(5, 5, 390, 200), &parent, 5072);
    list.InsertColumn(0, "ID", LVCFMT_LEFT, 40);
    list.InsertColumn(1, "Name", LVCFMT_LEFT, 130);
    list.InsertColumn(2, "On/Off", LVCFMT_CENTER, 60);
    for (const char* name : {"Walls", "Slabs", "Roof"}) {
      const int row = list.InsertItem(list.GetItemCount(), std::to_string(list.GetItemCount()));
      list.SetItemText(row, 1, name);
    }
  }

  ListParent parent;
  CListCtrl list;
};

TEST_F(ListViewTest, AClickTellsTheParentTheRowAndColumnAndSelectsTheRow) {
  user.ClickListCell(list.m_hWnd, 1, 2);
  user.DoubleClickListCell(list.m_hWnd, 2, 0);
  user.ClickListHeader(list.m_hWnd, 1);
  user.Click(list.m_hWnd, CPoint(100, 180));  // below the rows
  EXPECT_EQ(parent.heard, (std::vector<std::string>{"click 1 2", "click 2 0", "double 2 0", "column 1", "click -1 -1"}));
  EXPECT_EQ(list.GetSelectedCount(), 0U);  // a click on no row clears the selection
  EXPECT_EQ(list.GetNextItem(-1, LVNI_FOCUSED), 2);

  user.Press(VK_UP);
  EXPECT_EQ(list.GetNextItem(-1, LVNI_SELECTED), 1);
  user.Press(VK_END);
  EXPECT_EQ(list.GetNextItem(-1, LVNI_SELECTED | LVNI_FOCUSED), 2);
  EXPECT_EQ(list.GetSelectedCount(), 1U);
}

TEST_F(ListViewTest, HitTestsNameThePartOfTheRowUnderThePoint) {
  CImageList images;
  images.Create(5052U, 15, 1, RGB(255, 0, 255));
  list.SetImageList(&images, LVSIL_SMALL);
  list.SetExtendedStyle(LVS_EX_CHECKBOXES | LVS_EX_SUBITEMIMAGES);
  LVITEM item;
  item.mask = LVIF_IMAGE;
  item.iItem = 0;
  item.iSubItem = 2;
  item.iImage = 2;
  list.SetItem(&item);
  RECT label;
  ASSERT_TRUE(list.GetSubItemRect(0, 2, LVIR_LABEL, &label));
  RECT icon;
  ASSERT_TRUE(list.GetSubItemRect(0, 2, LVIR_ICON, &icon));
  EXPECT_EQ(label.left, 170);  // a column's label rectangle is its whole cell, image and all
  EXPECT_EQ(CRect(icon).Width(), 15);

  const int y = CRect(label).CenterPoint().y;
  struct Probe {
    int x;
    int item;
    int subItem;
    UINT flags;
  };
  for (const Probe& p : {Probe{5, 0, 0, LVHT_ONITEMSTATEICON}, Probe{20, 0, 0, LVHT_ONITEMICON}, Probe{35, 0, 0, LVHT_ONITEMLABEL},
                         Probe{100, 0, 1, LVHT_ONITEMLABEL}, Probe{178, 0, 2, LVHT_ONITEMICON}, Probe{300, -1, -1, LVHT_NOWHERE}}) {
    LVHITTESTINFO info;
    info.pt = {p.x, y};
    list.SubItemHitTest(&info);
    EXPECT_EQ(info.iItem, p.item) << p.x;
    EXPECT_EQ(info.iSubItem, p.subItem) << p.x;
    EXPECT_EQ(info.flags, p.flags) << p.x;
  }
}

TEST_F(ListViewTest, TheParentColoursRowsWhileTheListIsDrawn) {
  const SvgNode picture = ParseSvg(framework::RenderWindow(parent.m_hWnd));
  const auto rows = FindAll(picture, [](const SvgNode& n) { return !n.Attribute("data-row").empty(); });
  ASSERT_EQ(rows.size(), 3U);
  std::vector<std::string> inks;
  for (const SvgNode* row : rows) {
    inks.push_back(FindAll(*row, [](const SvgNode& n) { return n.name == "text"; })[1]->Attribute("fill"));
  }
  EXPECT_EQ(inks, (std::vector<std::string>{"#000000", "#0000ff", "#000000"}));
}

TEST_F(ListViewTest, ALongListScrollsByItsBarAndByTheKeysTheFocusedRowFollows) {
  for (int i = 3; i < 40; ++i) list.InsertItem(i, std::to_string(i));
  const int perPage = list.GetCountPerPage();
  EXPECT_EQ(perPage, (195 - 2 - 20) / 17);  // the client area below the header, in rows
  user.ClickListCell(list.m_hWnd, 39, 0);  // scrolled to by its bar's arrows
  EXPECT_EQ(list.GetTopIndex(), 40 - perPage);
  user.Press(VK_HOME);
  EXPECT_EQ(list.GetTopIndex(), 0);
  user.Press(VK_NEXT);
  EXPECT_EQ(list.GetNextItem(-1, LVNI_FOCUSED), perPage);
  EXPECT_EQ(list.GetTopIndex(), 1);
  list.EnsureVisible(30, FALSE);
  EXPECT_EQ(list.GetTopIndex(), 31 - perPage);
  const SvgNode picture = ParseSvg(framework::RenderWindow(list.m_hWnd));
  const auto thumb = FindAll(picture, [](const SvgNode& n) { return n.Attribute("data-part") == "thumb"; });
  ASSERT_EQ(thumb.size(), 1U);
  EXPECT_EQ(thumb[0]->Attribute("data-position"), std::to_string(31 - perPage));
  EXPECT_EQ(thumb[0]->Attribute("data-range"), "0 39");
}

}  // namespace
