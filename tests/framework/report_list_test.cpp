// The report list as a user works it: sorting by a click on a column title, check boxes in each
// mode, editing cells in place, and what its parent hears of each.
#include <string>
#include <vector>

#include "framework/controls/button.h"
#include "framework/image_list.h"
#include "framework/render.h"
#include "framework/window_classes.h"
#include "tests/framework/framework_fixture.h"
#include "tests/framework/svg_reader.h"
#include "ui/controls/report_ctrl.h"
#include "ui/controls/report_sort.h"

namespace {

// The list's parent: writes down the three messages the list sends it.
class ReportParent : public CWnd {
 public:
  struct Heard {
    UINT message;
    WPARAM wParam;
    LPARAM lParam;
    bool operator==(const Heard&) const = default;
  };
  std::vector<Heard> heard;

 protected:
  LRESULT OnChecked(WPARAM wParam, LPARAM lParam) { return Record(WM_REPORT_CHECKBOX_CHANGED, wParam, lParam); }
  LRESULT OnSorted(WPARAM wParam, LPARAM lParam) { return Record(WM_REPORT_SORTED, wParam, lParam); }
  LRESULT OnEdited(WPARAM wParam, LPARAM lParam) { return Record(WM_REPORT_CELL_EDITED, wParam, lParam); }

  DECLARE_MESSAGE_MAP()

 private:
  LRESULT Record(UINT message, WPARAM wParam, LPARAM lParam) {
    heard.push_back({message, wParam, lParam});
    return 0;
  }
};

BEGIN_MESSAGE_MAP(ReportParent, CWnd)
ON_MESSAGE(WM_REPORT_CHECKBOX_CHANGED, OnChecked)
ON_MESSAGE(WM_REPORT_SORTED, OnSorted)
ON_MESSAGE(WM_REPORT_CELL_EDITED, OnEdited)
END_MESSAGE_MAP()

class ReportListTest : public FrameworkTest {
 protected:
  ReportListTest() {
    parent.CreateEx(0, framework::kDialogClass, "Report", WS_POPUP | WS_CAPTION | WS_VISIBLE, CRect(50, 50, 450, 350),
                    nullptr, 0);
    list.Create(WS_CHILD | WS_VISIBLE | WS_BORDER | LVS_SHOWSELALWAYS, CRect(5, 5, 390, 230), &parent, 5064);
  }

  // One row a line of `cells`, one column a cell.
  void Fill(const std::vector<std::string>& titles, const std::vector<std::vector<std::string>>& rows) {
    for (std::size_t c = 0; c < titles.size(); ++c) list.InsertColumn(static_cast<int>(c), titles[c], LVCFMT_LEFT, 100);
    for (const auto& cells : rows) {
      const int row = list.InsertItem(list.GetItemCount(), cells[0]);
      for (std::size_t c = 1; c < cells.size(); ++c) list.SetItemText(row, static_cast<int>(c), cells[c]);
    }
  }

  std::vector<std::string> Column(int column) {
    std::vector<std::string> texts;
    for (int row = 0; row < list.GetItemCount(); ++row) texts.push_back(list.GetItemText(row, column));
    return texts;
  }

  ReportParent parent;
  CReportCtrl list;
};

using Heard = ReportParent::Heard;
using Texts = std::vector<std::string>;

TEST_F(ReportListTest, AClickOnAColumnTitleSortsItAndASecondClickReverses) {
  Fill({"ID", "Share", "Name"}, {{"100", "10%", "apple"}, {"9", "9%", "Banana"}, {"10", "100%", "cherry"}, {"0", "0.5%", "Apple"}});
  list.SetItemData(0, 1000);
  list.SetItemTextColor(0, 2, RGB(200, 0, 0));
  list.SetCheck(0, TRUE);

  user.ClickListHeader(list.m_hWnd, 0);
  EXPECT_EQ(Column(0), (Texts{"0", "9", "10", "100"}));
  user.ClickListHeader(list.m_hWnd, 0);
  EXPECT_EQ(Column(0), (Texts{"100", "10", "9", "0"}));
  user.ClickListHeader(list.m_hWnd, 1);
  EXPECT_EQ(Column(1), (Texts{"0.5%", "9%", "10%", "100%"}));
  user.ClickListHeader(list.m_hWnd, 2);  // upper case before lower case, byte by byte
  EXPECT_EQ(Column(2), (Texts{"Apple", "Banana", "apple", "cherry"}));
  EXPECT_EQ(parent.heard, (std::vector<Heard>{{WM_REPORT_SORTED, 0, 1}, {WM_REPORT_SORTED, 0, 0},
                                              {WM_REPORT_SORTED, 1, 1}, {WM_REPORT_SORTED, 2, 1}}));

  // A row keeps its own value, colours and check box wherever it goes.
  const int apple = 2;
  EXPECT_EQ(list.GetItemText(apple, 0), "100");
  EXPECT_EQ(list.GetItemData(apple), 1000U);
  EXPECT_EQ(list.GetItemTextColor(apple, 2), RGB(200, 0, 0));
  EXPECT_TRUE(list.GetCheck(apple));
  EXPECT_EQ(list.CountItems(RC_ITEM_CHECKED), 1);

  // A new row forgets the sort: the next click on the same title sorts ascending again.
  list.InsertItem(4, "50");
  user.ClickListHeader(list.m_hWnd, 2);
  EXPECT_EQ(parent.heard.back(), (Heard{WM_REPORT_SORTED, 2, 1}));
}

TEST_F(ReportListTest, SeparatorRowsStayInPlaceAndEachGroupIsSortedOnItsOwn) {
  Fill({"Layer"}, {{"b"}, {"a"}, {"----"}, {"d"}, {"----"}, {"f"}, {"e"}, {"c"}});
  list.SetSortSeparator("----");
  EXPECT_TRUE(list.SortItems(0, true));
  EXPECT_EQ(Column(0), (Texts{"a", "b", "----", "d", "----", "c", "e", "f"}));
  EXPECT_TRUE(list.SortItems(0, false));
  EXPECT_EQ(Column(0), (Texts{"b", "a", "----", "d", "----", "f", "e", "c"}));
  EXPECT_FALSE(list.SortItems(3, true));  // no such column
}

TEST_F(ReportListTest, ListsWhoseTitlesAreNotButtonsDoNotSort) {
  list.ModifyStyle(0, LVS_NOSORTHEADER);
  Fill({"ID"}, {{"2"}, {"1"}});
  EXPECT_FALSE(list.SortItems(0, true));
  EXPECT_EQ(Column(0), (Texts{"2", "1"}));
  EXPECT_TRUE(parent.heard.empty());
}

TEST(ReportSortOrderTest, EachPairIsComparedByTheFirstRuleThatReadsBoth) {
  struct Case {
    const char* a;
    const char* b;
    bool less;
  };
  const Case cases[] = {
      {"9", "10", true},        {"10", "100", true},      {"ff", "100", true},  // hexadecimal: 0xff < 0x100
      {"9%", "10%", true},      {"10%", "9", false},      {"2.5", "10", true},
      {"-5", "3", true},        {"-10", "-5", true},      // no sign in the hexadecimal rule
      {"12/31/2023", "1/2/2024", true},                   // dates, whatever their form
      {"2024-01-05", "1/2/2024", false},                  {"1/2/2024 1:00 PM", "1/2/2024 11:00 AM", false},
      {"Zeta", "alpha", true},  {"", "0", true},          {"1", "nan", true},  // not-a-number is text
  };
  for (const Case& c : cases) EXPECT_EQ(report_sort::Less(c.a, c.b), c.less) << c.a << " < " << c.b;

  EXPECT_EQ(report_sort::ReadDate("2024-02-29T23:59:59").value() - report_sort::ReadDate("2024-02-29").value(), 86399);
  EXPECT_EQ(report_sort::ReadDate("3/1/2024").value() - report_sort::ReadDate("2/28/2024").value(), 2 * 86400);
  EXPECT_EQ(report_sort::ReadDate("1/1/2024 12:00 AM"), report_sort::ReadDate("2024-01-01 00:00"));
  for (const char* notDate : {"2023-02-29", "13/1/2024", "1/32/2024", "2024-1-5", "1/2/24", "2024-01-05 25:00",
                              "1/2/2024 13:00 PM", "2024-01-05x", "Jan 5 2024"}) {
    EXPECT_FALSE(report_sort::ReadDate(notDate).has_value()) << notDate;
  }
}

TEST(ReportSortOrderTest, TextsThatCompareInACircleAreSortedWithoutLosingARow) {
  // "20" < "1e1" as hexadecimal numbers, "1e1" < "15.5" and "15.5" < "20" as decimal numbers.
  std::vector<std::string> texts;
  for (int i = 0; i < 300; ++i) texts.push_back(std::vector<std::string>{"20", "1e1", "15.5", "a", "-1"}[i % 5]);
  std::vector<int> order(texts.size());
  for (int i = 0; i < static_cast<int>(order.size()); ++i) order[static_cast<std::size_t>(i)] = i;
  report_sort::StableSort(order, [&](int a, int b) { return report_sort::Less(texts[a], texts[b]); });
  std::vector<int> seen = order;
  std::sort(seen.begin(), seen.end());
  for (int i = 0; i < static_cast<int>(seen.size()); ++i) ASSERT_EQ(seen[static_cast<std::size_t>(i)], i);
}

TEST_F(ReportListTest, CheckBoxModesDecideWhatAClickOnABoxDoes) {
  list.SetExtendedStyle(list.GetExtendedStyle() | LVS_EX_CHECKBOXES);
  Fill({"Name"}, {{"Walls"}, {"Slabs"}, {"Roof"}});

  list.SetCheckboxMode(RC_CHKBOX_SINGLE);
  user.ToggleListCheck(list.m_hWnd, 0);
  user.ToggleListCheck(list.m_hWnd, 2);
  EXPECT_FALSE(list.GetCheck(0));  // at most one stays checked
  EXPECT_TRUE(list.GetCheck(2));
  EXPECT_EQ(list.GetFirstItem(RC_ITEM_SELECTED | RC_ITEM_FOCUSED), 2);
  EXPECT_EQ(list.CountItems(RC_ITEM_SELECTED), 1);
  user.ToggleListCheck(list.m_hWnd, 2);  // unticking leaves none
  EXPECT_EQ(list.CountItems(RC_ITEM_CHECKED), 0);

  list.SetCheckboxMode(RC_CHKBOX_FIXED);
  user.ToggleListCheck(list.m_hWnd, 1);
  EXPECT_EQ(list.CountItems(RC_ITEM_CHECKED), 0);  // the user cannot change a box

  list.SetCheckboxMode(RC_CHKBOX_NORMAL);
  user.ToggleListCheck(list.m_hWnd, 0);
  user.ToggleListCheck(list.m_hWnd, 1);
  EXPECT_EQ(list.CountItems(RC_ITEM_CHECKED), 2);

  list.SetCheckboxMode(RC_CHKBOX_NONE);
  user.ToggleListCheck(list.m_hWnd, 2);
  EXPECT_EQ(list.CountItems(RC_ITEM_CHECKED), 3);

  // Modes 1 and 2 tell the parent (row, mouse message); modes 0 and 3 do not.
  EXPECT_EQ(parent.heard, (std::vector<Heard>{{WM_REPORT_CHECKBOX_CHANGED, 0, WM_LBUTTONDOWN},
                                              {WM_REPORT_CHECKBOX_CHANGED, 2, WM_LBUTTONDOWN},
                                              {WM_REPORT_CHECKBOX_CHANGED, 2, WM_LBUTTONDOWN},
                                              {WM_REPORT_CHECKBOX_CHANGED, 0, WM_LBUTTONDOWN},
                                              {WM_REPORT_CHECKBOX_CHANGED, 1, WM_LBUTTONDOWN}}));
  user.Press(VK_SPACE);  // swallowed: the keyboard does not tick past the mode
  EXPECT_EQ(list.CountItems(RC_ITEM_CHECKED), 3);

  EXPECT_EQ(list.DeleteAllItems(RC_ITEM_CHECKED | RC_ITEM_UNSELECTED), 2);
  EXPECT_EQ(Column(0), Texts{"Roof"});
}

TEST_F(ReportListTest, EditingACellInPlaceCommitsWithEnterAndCancelsWithEscape) {
  Fill({"ID", "Name", "On/Off"}, {{"1", "Walls", "on"}, {"2", "Slabs", "off"}});
  list.SetEditable();

  user.EditListCell(list.m_hWnd, 1, 1, "Floors", VK_ESCAPE);
  EXPECT_EQ(list.GetItemText(1, 1), "Slabs");
  EXPECT_FALSE(list.IsEditing());
  EXPECT_TRUE(parent.heard.empty());  // Escape sends nothing

  user.EditListCell(list.m_hWnd, 1, 1, "Floors", VK_RETURN);
  EXPECT_EQ(list.GetItemText(1, 1), "Floors");
  EXPECT_EQ(parent.heard, (std::vector<Heard>{{WM_REPORT_CELL_EDITED, 1, 1}}));

  user.EditListCell(list.m_hWnd, 1, 1, "Floors", VK_RETURN);  // the same text: nothing changed
  EXPECT_EQ(parent.heard.size(), 1U);
}

TEST_F(ReportListTest, TabAndTheArrowKeysCarryTheEditorToTheNextCell) {
  Fill({"ID", "Name"}, {{"1", "Walls"}, {"2", "Slabs"}, {"3", "Roof"}});
  list.SetEditable();

  user.EditListCell(list.m_hWnd, 0, 1, "Outer walls", VK_TAB);  // on to column 0 of the same row
  EXPECT_EQ(list.GetEditRow(), 0);
  EXPECT_EQ(list.GetEditColumn(), 0);
  user.Type("10");
  user.Press(VK_DOWN);
  EXPECT_EQ(list.GetEditRow(), 1);
  EXPECT_EQ(list.GetEditColumn(), 0);
  user.Press(VK_UP);
  user.Press(VK_UP);  // nothing above the first row: the edit stays
  EXPECT_EQ(list.GetEditRow(), 0);
  user.Type("11");
  user.Press(VK_RETURN);
  EXPECT_EQ(Column(0), (Texts{"11", "2", "3"}));
  EXPECT_EQ(Column(1), (Texts{"Outer walls", "Slabs", "Roof"}));
  EXPECT_EQ(parent.heard, (std::vector<Heard>{{WM_REPORT_CELL_EDITED, 0, 1}, {WM_REPORT_CELL_EDITED, 0, 0},
                                              {WM_REPORT_CELL_EDITED, 0, 0}}));
}

TEST_F(ReportListTest, TheEditorCoversTheCellsLabelWithTheColumnsAlignment) {
  CImageList images;
  images.Create(5052U, 15, 1, RGB(255, 0, 255));
  list.SetImageList(&images);
  list.InsertColumn(0, "ID", LVCFMT_LEFT, 40);
  list.InsertColumn(1, "Name", LVCFMT_RIGHT, 130);
  list.InsertColumn(2, "On/Off", LVCFMT_LEFT, 60);
  list.InsertItem(0, "1");
  list.SetItemText(0, 1, "Walls");
  list.SetItemText(0, 2, "on");
  list.SetItemImage(0, 2, 2);

  user.ClickListCell(list.m_hWnd, 0, 0);
  EXPECT_THROW(user.EditListCell(list.m_hWnd, 0, 1, "Floors"), framework::ScriptError);  // not editable yet
  list.SetEditable();
  user.ClickListCell(list.m_hWnd, 0, 1);
  CEdit* editor = list.GetEditControl();
  EXPECT_NE(editor->GetStyle() & ES_RIGHT, 0U);  // the right-aligned column's editor
  EXPECT_EQ(editor->GetWindowText(), "Walls");
  user.Press(VK_TAB);
  EXPECT_EQ(editor->GetStyle() & ES_RIGHT, 0U);  // made anew for the next column
  EXPECT_EQ(editor->GetWindowText(), "on");
  RECT cell;
  list.GetSubItemRect(0, 2, LVIR_LABEL, &cell);
  RECT placed;
  editor->GetWindowRect(&placed);
  list.ScreenToClient(reinterpret_cast<POINT*>(&placed));
  EXPECT_EQ(placed.left, cell.left + 16);  // clear of the cell's image
}

TEST_F(ReportListTest, NewColumnsGiveEveryRowTheSystemColoursThere) {
  Fill({"ID", "Name"}, {{"1", "Walls"}, {"2", "Slabs"}});
  list.SetItemTextColor(0, -1, RGB(200, 0, 0));
  list.InsertColumn(1, "Layer", LVCFMT_LEFT, 60);
  EXPECT_EQ(list.GetItemTextColor(0, 0), RGB(200, 0, 0));
  EXPECT_EQ(list.GetItemTextColor(0, 1), ::GetSysColor(COLOR_WINDOWTEXT));
  EXPECT_EQ(list.GetItemBkColor(0, 1), ::GetSysColor(COLOR_WINDOW));
  EXPECT_EQ(list.GetItemTextColor(0, 2), RGB(200, 0, 0));
  EXPECT_TRUE(list.DeleteColumn(0));
  EXPECT_EQ(list.GetItemTextColor(0, 1), RGB(200, 0, 0));
  EXPECT_FALSE(list.SetItemTextColor(0, 5, RGB(0, 0, 0)));
  EXPECT_EQ(list.GetItemImage(9, 0), -1);
  EXPECT_EQ(list.GetItemData(9), 0U);
}

TEST_F(ReportListTest, AnEditLeftByAClickElsewhereKeepsItsText) {
  CButton ok;
  ok.Create("OK", WS_CHILD | WS_VISIBLE | BS_PUSHBUTTON, CRect(300, 236, 390, 262), &parent, IDOK);
  Fill({"ID", "Name"}, {{"1", "Walls"}});
  list.SetEditable();
  user.ClickListCell(list.m_hWnd, 0, 1);
  user.ClickListCell(list.m_hWnd, 0, 1);
  user.Type("Facade");
  user.Click(ok.m_hWnd);
  EXPECT_FALSE(list.IsEditing());
  EXPECT_EQ(list.GetItemText(0, 1), "Facade");
  EXPECT_EQ(parent.heard, (std::vector<Heard>{{WM_REPORT_CELL_EDITED, 0, 1}}));
}

TEST_F(ReportListTest, ThePictureShowsTitlesRowsChecksAndCellColours) {
  list.SetExtendedStyle(list.GetExtendedStyle() | LVS_EX_CHECKBOXES);
  Fill({"ID", "Name"}, {{"1", "Walls"}, {"2", "Slabs"}});
  list.SetCheck(1, TRUE);
  list.SetItemBkColor(0, 1, RGB(255, 244, 200));
  list.SetItemTextColor(1, -1, RGB(200, 0, 0));
  list.SetItemStates(1, RC_ITEM_SELECTED | RC_ITEM_FOCUSED);
  const std::string svg = framework::RenderWindow(parent.m_hWnd);
  SaveRender("report_list", svg);
  const SvgNode picture = ParseSvg(svg);
  const SvgNode* shown = FindControl(picture, 5064);
  ASSERT_NE(shown, nullptr);
  const auto header = FindAll(*shown, [](const SvgNode& n) { return n.Attribute("data-class") == "SysHeader32"; });
  ASSERT_EQ(header.size(), 1U);
  EXPECT_EQ(TextsIn(*header[0]), (Texts{"ID", "Name"}));

  const auto rows = FindAll(*shown, [](const SvgNode& n) { return !n.Attribute("data-row").empty(); });
  ASSERT_EQ(rows.size(), 2U);
  EXPECT_EQ(rows[0]->States(), std::set<std::string>{"unchecked"});
  EXPECT_EQ(rows[1]->States(), (std::set<std::string>{"checked", "selected", "focused"}));
  const auto cell = [&](int row, const std::string& column) {
    return FindAll(*rows[static_cast<std::size_t>(row)], [&](const SvgNode& n) { return n.Attribute("data-column") == column; })[0];
  };
  EXPECT_EQ(cell(0, "1")->children.front().Attribute("fill"), "#fff4c8");
  EXPECT_EQ(TextsIn(*cell(0, "1")), Texts{"Walls"});
  // The selected row is drawn grey while the list has no focus; its texts keep their colour.
  EXPECT_EQ(FindAll(*cell(1, "0"), [](const SvgNode& n) { return n.name == "text"; })[0]->Attribute("fill"), "#c80000");
}

}  // namespace
