// What the combo box, list, menu and bitmap calls keep and answer when a program (not the user)
// changes them: indexes after insertions and deletions, refusals, previous states, slices.
#include <string>
#include <vector>

#include "framework/controls/combo_box.h"
#include "framework/controls/list_ctrl.h"
#include "framework/menu.h"
#include "framework/resource_module.h"
#include "framework/window_classes.h"
#include "tests/framework/framework_fixture.h"

namespace {

class ControlModelsTest : public FrameworkTest {
 protected:
  ControlModelsTest() {
    parent.CreateEx(0, framework::kDialogClass, "Models", WS_POPUP | WS_VISIBLE, CRect(0, 0, 400, 300), nullptr, 0);
  }
  CWnd parent;
};

std::vector<std::string> Items(const CComboBox& combo) {
  std::vector<std::string> items;
  for (int i = 0; i < combo.GetCount(); ++i) items.push_back(combo.GetLBText(i));
  return items;
}

TEST_F(ControlModelsTest, AComboKeepsItsSelectionOnTheSameItemAsItemsComeAndGo) {
  CComboBox sorted;
  ASSERT_TRUE(sorted.Create(WS_CHILD | CBS_DROPDOWNLIST | CBS_SORT, CRect(0, 0, 100, 100), &parent, 1));
  for (const char* text : {"Whole", "by Color", "Off"}) sorted.AddString(text);
  EXPECT_EQ(Items(sorted), (std::vector<std::string>{"by Color", "Off", "Whole"}));  // sorted without regard to case

  CComboBox combo;
  ASSERT_TRUE(combo.Create(WS_CHILD | CBS_DROPDOWNLIST, CRect(0, 0, 100, 100), &parent, 2));
  for (const char* text : {"1", "2", "3"}) combo.SetItemData(combo.AddString(text), 10);
  EXPECT_EQ(combo.SetCurSel(1), 1);
  combo.InsertString(0, "0");
  EXPECT_EQ(combo.GetCurSel(), 2);  // still "2"
  combo.DeleteString(0);
  EXPECT_EQ(combo.GetLBText(combo.GetCurSel()), "2");
  combo.DeleteString(1);
  EXPECT_EQ(combo.GetCurSel(), -1);  // the chosen item went
  EXPECT_EQ(combo.SetCurSel(7), CB_ERR);
  EXPECT_EQ(combo.SelectString(-1, "3"), 1);
  EXPECT_EQ(combo.GetCurSel(), 1);
  EXPECT_EQ(combo.FindStringExact(-1, "Select Color"), CB_ERR);
  combo.AddString("Select color");
  EXPECT_EQ(combo.FindStringExact(-1, "SELECT COLOR"), 2);  // exact, but without regard to case
  EXPECT_EQ(combo.GetItemData(9), static_cast<DWORD_PTR>(CB_ERR));
  EXPECT_EQ(combo.GetLBTextLen(9), CB_ERR);
  combo.ResetContent();
  EXPECT_EQ(combo.GetCount(), 0);
  EXPECT_EQ(combo.GetCurSel(), -1);
  EXPECT_EQ(combo.GetWindowText(), "");
}

TEST_F(ControlModelsTest, AListsColumnsMoveTheCellsAndItsParentMayRefuseASelection) {
  class Refusing : public CWnd {
   public:
    bool refuse = false;
    std::vector<LPARAM> deleted;

   protected:
    BOOL OnNotify(WPARAM wParam, LPARAM lParam, LRESULT* result) override {
      const auto* nm = reinterpret_cast<const NMLISTVIEW*>(lParam);
      if (nm->hdr.code == LVN_ITEMCHANGING && refuse && (nm->uNewState & LVIS_SELECTED) != 0) {
        *result = TRUE;
        return TRUE;
      }
      if (nm->hdr.code == LVN_DELETEITEM) deleted.push_back(nm->lParam);
      return CWnd::OnNotify(wParam, lParam, result);
    }
  } owner;
  owner.CreateEx(0, framework::kDialogClass, "Owner", WS_POPUP | WS_VISIBLE, CRect(0, 0, 400, 300), nullptr, 0);
  {
    CListCtrl list;
    ASSERT_TRUE(list.Create(WS_CHILD | WS_VISIBLE | LVS_REPORT | LVS_SINGLESEL, CRect(0, 0, 300, 200), &owner, 1));
    list.InsertColumn(0, "ID", LVCFMT_LEFT, 40);
    list.InsertColumn(1, "On/Off", LVCFMT_LEFT, 60);
    for (int i = 0; i < 3; ++i) {
      list.InsertItem(i, std::to_string(i));
      list.SetItemText(i, 1, i % 2 == 0 ? "on" : "off");
      list.SetItemData(i, static_cast<DWORD_PTR>(100 + i));
    }
    list.InsertColumn(1, "Name", LVCFMT_LEFT, 130);  // between the two: the texts move right
    EXPECT_EQ(list.GetItemText(1, 1), "");
    EXPECT_EQ(list.GetItemText(1, 2), "off");
    EXPECT_EQ(list.GetHeaderCtrl()->GetItemText(1), "Name");
    list.DeleteColumn(0);
    EXPECT_EQ(list.GetItemText(2, 1), "on");
    EXPECT_EQ(list.GetColumnWidth(0), 130);
    const std::string longName(1500, 'x');
    list.SetItemText(0, 0, longName);
    EXPECT_EQ(list.GetItemText(0, 0), longName);

    EXPECT_TRUE(list.SetItemState(0, LVIS_SELECTED, LVIS_SELECTED));
    EXPECT_TRUE(list.SetItemState(2, LVIS_SELECTED, LVIS_SELECTED));
    EXPECT_EQ(list.GetSelectedCount(), 1U);  // one row at a time
    owner.refuse = true;
    EXPECT_FALSE(list.SetItemState(1, LVIS_SELECTED, LVIS_SELECTED));
    EXPECT_EQ(list.GetNextItem(-1, LVNI_SELECTED), 2);
    list.DeleteItem(1);
    EXPECT_EQ(owner.deleted, std::vector<LPARAM>{101});
  }
  // The rows left when the list's window went were each reported, so their owners can let go.
  EXPECT_EQ(owner.deleted, (std::vector<LPARAM>{101, 100, 102}));
}

TEST_F(ControlModelsTest, MenuCallsFindItemsByPositionOrCommandAndAnswerThePreviousState) {
  const std::size_t menus = framework::LiveMenuCount();
  {
    CMenu menu;
    ASSERT_TRUE(menu.CreatePopupMenu());
    menu.AppendMenu(MF_STRING, 10, "Level 5");
    menu.AppendMenu(MF_STRING, 30, "Level 50");
    menu.InsertMenu(30, MF_BYCOMMAND | MF_STRING, 20, "Level 10");  // before the item with command 30
    menu.InsertMenu(0, MF_BYPOSITION | MF_SEPARATOR);
    EXPECT_FALSE(menu.AppendMenu(MF_POPUP, 40, "Sub"));
    EXPECT_EQ(menu.GetMenuItemCount(), 4);
    EXPECT_EQ(menu.GetMenuItemID(0), 0U);  // a separator
    EXPECT_EQ(menu.GetMenuItemID(2), 20U);
    EXPECT_EQ(menu.GetMenuItemID(9), 0xFFFFFFFFU);
    EXPECT_EQ(menu.GetMenuString(30, MF_BYCOMMAND), "Level 50");
    EXPECT_EQ(menu.CheckMenuItem(20, MF_BYCOMMAND | MF_CHECKED), MF_UNCHECKED);
    EXPECT_EQ(menu.CheckMenuItem(20, MF_BYCOMMAND | MF_UNCHECKED), MF_CHECKED);
    EXPECT_EQ(menu.EnableMenuItem(1, MF_BYPOSITION | MF_GRAYED), MF_ENABLED);
    EXPECT_EQ(menu.GetMenuState(10, MF_BYCOMMAND), MF_GRAYED);
    EXPECT_EQ(menu.GetMenuState(99, MF_BYCOMMAND), 0xFFFFFFFFU);
    EXPECT_TRUE(menu.DeleteMenu(10, MF_BYCOMMAND));
    EXPECT_FALSE(menu.DeleteMenu(10, MF_BYCOMMAND));
    EXPECT_EQ(framework::LiveMenuCount(), menus + 1);
  }
  EXPECT_EQ(framework::LiveMenuCount(), menus);
}

TEST_F(ControlModelsTest, BitmapStripsAreCutIntoImagesOfTheirWidth) {
  const std::string_view strip = framework::IconPicture(AfxLoadIcon(5027));
  EXPECT_EQ(framework::PictureSize(strip), SIZE({192, 16}));
  const HICON eleventh = framework::LoadPictureSlice(5027, 11, 16);
  ASSERT_TRUE(eleventh);
  EXPECT_EQ(framework::LoadPictureSlice(5027, 11, 16), eleventh);  // one handle a slice
  EXPECT_EQ(framework::IconResourceId(eleventh), 5027U);
  EXPECT_NE(framework::IconPicture(eleventh).find("viewBox=\"176 0 16 16\""), std::string_view::npos);
  EXPECT_FALSE(framework::LoadPictureSlice(5027, 12, 16));  // past the strip's end
  EXPECT_FALSE(framework::LoadPictureSlice(4999, 0, 16));
  EXPECT_TRUE(AfxLoadBitmap(5061));
  EXPECT_FALSE(AfxLoadBitmap(4999));
}

}  // namespace
