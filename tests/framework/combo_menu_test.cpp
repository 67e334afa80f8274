// Combo boxes and popup menus as a user chooses from them: what the control holds afterwards,
// what its parent hears, and what the picture shows.
#include <string>
#include <vector>

#include "framework/cdc.h"
#include "framework/controls/combo_box_ex.h"
#include "framework/image_list.h"
#include "framework/menu.h"
#include "framework/render.h"
#include "framework/resource_module.h"
#include "framework/toolkit/image_menu.h"
#include "framework/window_classes.h"
#include "tests/framework/framework_fixture.h"
#include "tests/framework/svg_reader.h"

namespace {

// A parent that writes down commands ("id:code") and owner-drawing requests.
class Parent : public CWnd {
 public:
  std::vector<std::string> commands;

 protected:
  BOOL OnCommand(WPARAM wParam, LPARAM lParam) override {
    commands.push_back(std::to_string(LOWORD(wParam)) + ":" + std::to_string(HIWORD(wParam)));
    return CWnd::OnCommand(wParam, lParam);
  }
};

// An owner-drawn colour list: a swatch of the item data's colour for each item, 12/10 as tall
// as proposed, the field as tall as proposed.
class ColourCombo : public CComboBox {
 public:
  std::vector<UINT> measured;
  std::vector<std::string> drawn;

  void MeasureItem(LPMEASUREITEMSTRUCT measure) override {
    measured.push_back(measure->itemID);
    if (static_cast<int>(measure->itemID) >= 0) measure->itemHeight = measure->itemHeight * 12 / 10;
  }
  void DrawItem(LPDRAWITEMSTRUCT draw) override {
    const bool field = (draw->itemState & ODS_COMBOBOXEDIT) != 0;
    drawn.push_back((field ? "field " : "") + std::to_string(static_cast<int>(draw->itemID)) +
                    ((draw->itemState & ODS_SELECTED) != 0 ? " selected" : ""));
    CDC::FromHandle(draw->hDC)->FillSolidRect(CRect(4, draw->rcItem.top + 2, 18, draw->rcItem.bottom - 2),
                                              static_cast<COLORREF>(draw->itemData));
  }
};

class ComboMenuTest : public FrameworkTest {
 protected:
  ComboMenuTest() {
    parent.CreateEx(0, framework::kDialogClass, "Choices", WS_POPUP | WS_CAPTION | WS_VISIBLE, CRect(60, 60, 460, 300),
                    nullptr, 0);
  }

  std::vector<std::string> Heard(int id) const {
    std::vector<std::string> codes;
    for (const std::string& c : parent.commands) {
      if (c.starts_with(std::to_string(id) + ":")) codes.push_back(c.substr(c.find(':') + 1));
    }
    return codes;
  }

  Parent parent;
};

const std::string kSelChange = std::to_string(CBN_SELCHANGE);

TEST_F(ComboMenuTest, ChoosingAComboItemSelectsItAndTellsTheParentOnce) {
  CComboBox scale;
  ASSERT_TRUE(scale.Create(WS_CHILD | WS_VISIBLE | CBS_DROPDOWNLIST, CRect(10, 10, 150, 100), &parent, 5079));
  for (const char* text : {"Auto scale", "Fixed scale", "Scale off"}) scale.AddString(text);
  RECT field;
  scale.GetWindowRect(&field);
  EXPECT_EQ(CRect(field).Height(), 21);  // the window keeps the field; the template height is the dropped one

  user.ChooseComboItem(scale.m_hWnd, "Scale off");
  EXPECT_EQ(scale.GetCurSel(), 2);
  EXPECT_EQ(scale.GetWindowText(), "Scale off");
  EXPECT_FALSE(scale.GetDroppedState());
  EXPECT_EQ(Heard(5079), (std::vector<std::string>{std::to_string(CBN_SETFOCUS), std::to_string(CBN_DROPDOWN),
                                                   std::to_string(CBN_CLOSEUP), std::to_string(CBN_SELENDOK), kSelChange}));

  // Dropped and dismissed (a press elsewhere, then Escape) changes nothing.
  parent.commands.clear();
  user.Click(scale.m_hWnd);
  user.Click(parent.m_hWnd, CPoint(300, 150));
  user.Click(scale.m_hWnd);
  user.Press(VK_ESCAPE);
  EXPECT_EQ(scale.GetCurSel(), 2);
  EXPECT_EQ(std::count(parent.commands.begin(), parent.commands.end(), "5079:" + kSelChange), 0);

  // The keys: Up chooses at once when closed; in the dropped list the arrows only move the
  // highlight until Enter.
  user.Press(VK_UP);
  EXPECT_EQ(scale.GetCurSel(), 1);
  user.PressWith(VK_MENU, VK_DOWN);
  EXPECT_TRUE(scale.GetDroppedState());
  user.Press(VK_UP);
  EXPECT_EQ(scale.GetCurSel(), 1);
  user.Press(VK_RETURN);
  EXPECT_EQ(scale.GetCurSel(), 0);
  EXPECT_EQ(std::count(parent.commands.begin(), parent.commands.end(), "5079:" + kSelChange), 2);  // Up, then Enter
}

TEST_F(ComboMenuTest, ALongListIsScrolledToTheItemWithItsScrollBar) {
  CComboBox layer;
  ASSERT_TRUE(layer.Create(WS_CHILD | WS_VISIBLE | CBS_DROPDOWNLIST, CRect(10, 10, 90, 150), &parent, 5086));
  for (int i = 1; i <= 255; ++i) layer.AddString(std::to_string(i));
  user.ChooseComboItem(layer.m_hWnd, "200");
  EXPECT_EQ(layer.GetCurSel(), 199);
  EXPECT_EQ(layer.FindStringExact(-1, "200"), 199);
  EXPECT_EQ(layer.FindString(0, "25"), 24);
  EXPECT_THROW(user.ChooseComboItem(layer.m_hWnd, "256"), framework::ScriptError);
}

TEST_F(ComboMenuTest, AnOwnerDrawnComboIsMeasuredOnceAndDrawnByItsObject) {
  ColourCombo colours;
  ASSERT_TRUE(colours.Create(WS_CHILD | WS_VISIBLE | CBS_DROPDOWNLIST | CBS_OWNERDRAWFIXED | CBS_HASSTRINGS,
                             CRect(10, 10, 150, 200), &parent, 5054));
  for (const auto& [text, rgb] : std::vector<std::pair<const char*, COLORREF>>{{"1", RGB(0, 0, 0)}, {"7", RGB(255, 0, 0)}}) {
    colours.SetItemData(colours.AddString(text), rgb);
  }
  colours.SetItemData(colours.AddString("Select color"), RGB(255, 255, 255));
  EXPECT_EQ(colours.measured, (std::vector<UINT>{static_cast<UINT>(-1), 0}));
  EXPECT_EQ(colours.GetItemHeight(0), 19);   // 16 proposed, 12/10 of it
  EXPECT_EQ(colours.GetItemHeight(-1), 15);  // the field keeps its height

  user.ChooseComboItem(colours.m_hWnd, "7");
  EXPECT_EQ(colours.GetItemData(colours.GetCurSel()), RGB(255, 0, 0));
  colours.drawn.clear();
  const SvgNode picture = ParseSvg(framework::RenderWindow(parent.m_hWnd));
  EXPECT_EQ(colours.drawn, std::vector<std::string>{"field 1 selected"});  // the field has the focus
  EXPECT_EQ(FindAll(*FindControl(picture, 5054), [](const SvgNode& n) { return n.Attribute("fill") == "#ff0000"; }).size(), 1U);

  user.Click(colours.m_hWnd);
  COMBOBOXINFO info;
  colours.SendMessage(CB_GETCOMBOBOXINFO, 0, reinterpret_cast<LPARAM>(&info));
  colours.drawn.clear();
  framework::RenderWindow(info.hwndList);
  EXPECT_EQ(colours.drawn, (std::vector<std::string>{"0", "1 selected", "2"}));
  user.Press(VK_ESCAPE);
}

TEST_F(ComboMenuTest, AnExtendedComboShowsEachItemsImage) {
  CImageList lineTypes;
  ASSERT_TRUE(lineTypes.Create(5039U, 49, 1, RGB(255, 0, 255)));
  EXPECT_EQ(lineTypes.GetImageCount(), 8);
  EXPECT_EQ(lineTypes.GetIconSize(), CSize(49, 12));
  CComboBoxEx types;
  ASSERT_TRUE(types.Create(WS_CHILD | WS_VISIBLE | CBS_DROPDOWNLIST, CRect(10, 10, 150, 200), &parent, 5052));
  types.SetImageList(&lineTypes);
  for (int i = 0; i < 8; ++i) types.InsertItem(i, std::to_string(i), i, i);
  COMBOBOXEXITEM item;
  item.mask = CBEIF_IMAGE | CBEIF_SELECTEDIMAGE;
  item.iItem = 3;
  ASSERT_TRUE(types.GetItem(&item));
  EXPECT_EQ(item.iImage, 3);

  user.ChooseComboItem(types.m_hWnd, 5);
  EXPECT_EQ(types.GetCurSel(), 5);
  EXPECT_EQ(Heard(5052).back(), kSelChange);
  const SvgNode picture = ParseSvg(framework::RenderWindow(parent.m_hWnd));
  const SvgNode* shown = FindControl(picture, 5052);
  EXPECT_EQ(IconsIn(*shown), std::vector<std::string>{"5039"});
  EXPECT_EQ(FindAll(*shown, [](const SvgNode& n) { return n.Attribute("data-image") == "5"; }).size(), 1U);
  EXPECT_EQ(TextsIn(*shown), std::vector<std::string>{"5"});
}

TEST_F(ComboMenuTest, APopupMenuAnswersTheChosenIdOrNone) {
  CMenu menu;
  ASSERT_TRUE(menu.CreatePopupMenu());
  menu.AppendMenu(MF_STRING, 1, "Select all for 2D");
  menu.AppendMenu(MF_SEPARATOR);
  menu.AppendMenu(MF_STRING | MF_GRAYED, 2, "Deselect all for 2D");
  menu.AppendMenu(MF_STRING, 3, "&Save 2D selections");
  const std::size_t windows = framework::LiveWindowCount();

  user.AnswerNextWithMenuItem("Select all for 2D");
  EXPECT_EQ(menu.TrackPopupMenu(TPM_CENTERALIGN | TPM_RETURNCMD, 200, 150, &parent), 1);
  user.AnswerNextWithMenuItem(2);  // greyed: the click chooses nothing, the next answer ends it
  user.AnswerNextByDismissingMenu();
  EXPECT_EQ(menu.TrackPopupMenu(TPM_RETURNCMD, 200, 150, &parent), 0);
  user.AnswerNext([](framework::ScriptedUser& u, HWND) {
    EXPECT_EQ(u.MenuItemTexts(), (std::vector<std::string>{"Select all for 2D", "Deselect all for 2D", "Save 2D selections"}));
    u.Press(VK_DOWN);
    u.Press(VK_DOWN);  // past the greyed item, which still takes the highlight
    u.Press(VK_DOWN);
    u.Press(VK_RETURN);
  });
  EXPECT_EQ(menu.TrackPopupMenu(TPM_RETURNCMD, 200, 150, &parent), 3);
  user.AnswerNext([](framework::ScriptedUser& u, HWND) { u.Press('S'); });  // the mnemonic
  EXPECT_EQ(menu.TrackPopupMenu(TPM_RETURNCMD, 200, 150, &parent), 3);
  EXPECT_EQ(menu.TrackPopupMenu(TPM_RETURNCMD, 200, 150, &parent), 0);  // nobody answers
  EXPECT_EQ(user.UnansweredModals(), 1);

  // Without TPM_RETURNCMD the choice reaches the owner as a command.
  user.AnswerNextWithMenuItem(3);
  EXPECT_TRUE(menu.TrackPopupMenu(TPM_LEFTALIGN, 200, 150, &parent));
  framework::PumpPendingMessages();
  EXPECT_EQ(parent.commands, std::vector<std::string>{"3:0"});
  EXPECT_EQ(framework::LiveWindowCount(), windows);  // every menu window is gone
}

TEST_F(ComboMenuTest, AMenuWithItemBitmapsAndAnImageMenuShowTheirPictures) {
  CMenu build;
  build.CreatePopupMenu();
  CBitmap selectAll;
  ASSERT_TRUE(selectAll.LoadBitmap(5057));
  build.AppendMenu(MF_STRING, 1, "Select all for 2D");
  build.AppendMenu(MF_STRING | MF_CHECKED, 2, "Plain");
  build.SetMenuItemBitmaps(0, MF_BYPOSITION, &selectAll, &selectAll);
  std::string svg;
  user.AnswerNext([&svg](framework::ScriptedUser& u, HWND) {
    svg = framework::RenderWindow(u.OpenMenu());
    u.DismissMenu();
  });
  build.TrackPopupMenu(TPM_RETURNCMD, 100, 100, &parent);
  SvgNode picture = ParseSvg(svg);
  const auto items = FindAll(picture, [](const SvgNode& n) { return !n.Attribute("data-command").empty(); });
  ASSERT_EQ(items.size(), 2U);
  EXPECT_EQ(IconsIn(*items[0]), std::vector<std::string>{"5057"});
  EXPECT_EQ(items[1]->States(), std::set<std::string>{"checked"});

  CImageList modes;
  ASSERT_TRUE(modes.Create(5027U, 16, 1, RGB(255, 0, 255)));
  CImageMenu displayModes;
  ASSERT_TRUE(displayModes.Create(modes));
  for (UINT code = 1; code <= 9; ++code) displayModes.AddItem(code + 1, AfxLoadString(16 + code), static_cast<int>(code));
  user.AnswerNext([&svg](framework::ScriptedUser& u, HWND) {
    svg = framework::RenderWindow(u.OpenMenu());
    u.ChooseMenuItem("Hiddenline");
  });
  EXPECT_EQ(displayModes.Track(&parent, CPoint(300, 200)), 3U);
  picture = ParseSvg(svg);
  std::vector<std::string> images;
  for (const SvgNode* n : FindAll(picture, [](const SvgNode& x) { return !x.Attribute("data-image").empty(); })) {
    images.push_back(n->Attribute("data-image"));
  }
  EXPECT_EQ(images, (std::vector<std::string>{"1", "2", "3", "4", "5", "6", "7", "8", "9"}));
  RECT r;
  ASSERT_FALSE(GetMenuItemRect(HWND(), displayModes.m_hMenu, 0, &r));  // no longer showing
}

TEST_F(ComboMenuTest, AMenuOpensCentredOnItsPointAndStaysOnTheScreen) {
  class Owner : public Parent {
   public:
    int initialised = 0;

   protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
      if (message == WM_INITMENUPOPUP) {
        ++initialised;
        ::EnableMenuItem(HMENU::FromParam(wParam), 1, MF_BYCOMMAND | MF_GRAYED);  // the owner may still change it
      }
      return Parent::WindowProc(message, wParam, lParam);
    }
  } owner;
  owner.CreateEx(0, framework::kDialogClass, "Owner", WS_POPUP | WS_VISIBLE, CRect(0, 0, 300, 200), nullptr, 0);
  CMenu menu;
  menu.CreatePopupMenu();
  menu.AppendMenu(MF_STRING, 1, "Level 5");
  menu.AppendMenu(MF_STRING, 2, "Level 10");
  std::vector<CRect> placed;
  const auto where = [&placed](framework::ScriptedUser& u, HWND) {
    RECT r;
    ::GetWindowRect(u.OpenMenu(), &r);
    placed.push_back(r);
    u.ChooseMenuItem(1);  // greyed by the owner: nothing chosen
    u.DismissMenu();
  };
  user.AnswerNext(where);
  EXPECT_EQ(menu.TrackPopupMenu(TPM_CENTERALIGN | TPM_VCENTERALIGN | TPM_RETURNCMD, 400, 300, &owner), 0);
  user.AnswerNext(where);
  menu.TrackPopupMenu(TPM_LEFTALIGN | TPM_RETURNCMD, 1275, 795, &owner);
  ASSERT_EQ(placed.size(), 2U);
  EXPECT_EQ(placed[0].CenterPoint(), CPoint(400, 300));
  EXPECT_EQ(placed[1].right, ::GetSystemMetrics(SM_CXSCREEN));
  EXPECT_EQ(placed[1].bottom, ::GetSystemMetrics(SM_CYSCREEN));
  EXPECT_EQ(owner.initialised, 2);
}

TEST_F(ComboMenuTest, TheDroppedListFollowsKeysAndLettersAndGoesWhenTheComboLosesTheFocus) {
  CComboBox cut;
  CComboBox other;
  ASSERT_TRUE(cut.Create(WS_CHILD | WS_VISIBLE | CBS_DROPDOWNLIST, CRect(10, 10, 150, 120), &parent, 5056));
  ASSERT_TRUE(other.Create(WS_CHILD | WS_VISIBLE | CBS_DROPDOWNLIST, CRect(200, 10, 300, 120), &parent, 5079));
  for (const char* text : {"By Color", "Off", "Whole"}) cut.AddString(text);
  cut.SetFocus();
  user.Press(VK_F4);
  EXPECT_TRUE(cut.GetDroppedState());
  user.Type("w");
  user.Press(VK_RETURN);
  EXPECT_EQ(cut.GetLBText(cut.GetCurSel()), "Whole");
  user.Type("o");  // closed: the letter chooses at once
  EXPECT_EQ(cut.GetCurSel(), 1);
  cut.ShowDropDown(TRUE);
  user.Press(VK_HOME);
  user.Click(other.m_hWnd);  // the press outside only closes the list, without a choice
  EXPECT_FALSE(cut.GetDroppedState());
  EXPECT_EQ(cut.GetCurSel(), 1);
  EXPECT_EQ(::GetFocus(), cut.m_hWnd);
  cut.ShowDropDown(TRUE);
  other.SetFocus();  // the focus going elsewhere takes the list with it
  EXPECT_FALSE(cut.GetDroppedState());
  EXPECT_EQ(Heard(5056).back(), std::to_string(CBN_KILLFOCUS));
}

}  // namespace
