// Pictures of windows read back as a person would read them: which controls show, in which
// state, with which texts and icons; the same state gives the same bytes.
#include <string>
#include <vector>

#include "framework/cdialog.h"
#include "framework/controls/button.h"
#include "framework/controls/edit.h"
#include "framework/message_box.h"
#include "framework/render.h"
#include "framework/window_classes.h"
#include "tests/framework/framework_fixture.h"
#include "tests/framework/svg_reader.h"
#include "tests/framework/test_pane.h"

namespace {

using RenderTest = FrameworkTest;

// A dialog with one control of each simple kind, made from a template written here.
const DialogTemplate& SettingsTemplate() {
  using namespace framework;
  static const DialogTemplate settings{
      9001, WS_POPUP | WS_CAPTION | WS_SYSMENU | DS_MODALFRAME, 0, 0, 0, 200, 90, "Settings <&> \"1\"", "MS Shell Dlg", 8,
      false,
      {
          {IDC_STATIC, kButtonClass, " 2D Drawing Settings", WS_VISIBLE | BS_GROUPBOX, 0, 4, 2, 192, 58},
          {5077, kButtonClass, "Auto clip", WS_VISIBLE | WS_TABSTOP | BS_AUTOCHECKBOX, 0, 10, 14, 90, 10},
          {5083, kButtonClass, "Preserve\xA0XY dimension", WS_VISIBLE | WS_TABSTOP | WS_DISABLED | BS_AUTOCHECKBOX, 0,
           10, 28, 120, 10},
          {5035, kEditClass, "a < b & c", WS_VISIBLE | WS_BORDER | ES_READONLY | ES_AUTOHSCROLL, 0, 10, 42, 100, 12},
          {IDOK, kButtonClass, "OK", WS_VISIBLE | WS_TABSTOP | BS_DEFPUSHBUTTON, 0, 90, 68, 50, 14},
          {IDCANCEL, kButtonClass, "Cancel", WS_TABSTOP | BS_PUSHBUTTON, 0, 146, 68, 50, 14},
      }};
  return settings;
}

TEST_F(RenderTest, ADialogShowsEachControlWithItsStateAndEscapedTexts) {
  CDialog dialog(SettingsTemplate(), &HostFrame());
  ASSERT_TRUE(dialog.CreateIndirect(SettingsTemplate(), &HostFrame()));
  dialog.ShowWindow(SW_SHOW);
  dialog.CheckDlgButton(5083, BST_CHECKED);
  user.Click(5077);  // ticks it and takes the focus
  const std::string svg = framework::RenderWindow(dialog.m_hWnd);
  SaveRender("settings_dialog", svg);
  const SvgNode picture = ParseSvg(svg);

  const SvgNode* autoClip = FindControl(picture, 5077);
  ASSERT_NE(autoClip, nullptr);
  EXPECT_EQ(autoClip->States(), (std::set<std::string>{"checked", "focused"}));
  EXPECT_EQ(TextsIn(*autoClip), std::vector<std::string>{"Auto clip"});
  EXPECT_EQ(FindAll(*autoClip, [](const SvgNode& n) { return n.Attribute("data-focus") == "true"; }).size(), 1U);

  const SvgNode* preserve = FindControl(picture, 5083);
  ASSERT_NE(preserve, nullptr);
  EXPECT_EQ(preserve->States(), (std::set<std::string>{"checked", "disabled"}));
  EXPECT_EQ(TextsIn(*preserve), std::vector<std::string>{"Preserve\u00A0XY dimension"});  // the code page's no-break space
  EXPECT_EQ(FindAll(*preserve, [](const SvgNode& n) { return n.Attribute("fill") == "#6d6d6d"; }).size(), 1U);

  const SvgNode* comment = FindControl(picture, 5035);
  ASSERT_NE(comment, nullptr);
  EXPECT_EQ(comment->States(), std::set<std::string>{"readonly"});
  EXPECT_EQ(TextsIn(*comment), std::vector<std::string>{"a < b & c"});

  EXPECT_EQ(FindControl(picture, IDOK)->States(), std::set<std::string>{"default"});
  const SvgNode* cancel = FindControl(picture, IDCANCEL);
  EXPECT_EQ(cancel->States(), std::set<std::string>{"hidden"});
  EXPECT_TRUE(cancel->children.empty());  // a hidden control is a marker, never drawn
  EXPECT_EQ(TextsIn(picture).front(), "Settings <&> \"1\"");  // the caption
}

TEST_F(RenderTest, ThePaneShowsItsIconButtonsTabsAndTheTreeItemsWithTheirChecks) {
  TestPane pane;
  ASSERT_TRUE(pane.Create(5000, &HostFrame()));
  pane.ShowWindow(SW_SHOW);
  pane.FillSections();
  user.ToggleCheck(pane.tree.m_hWnd, "Section 0/Default");
  user.SelectItem(pane.tree.m_hWnd, "Section 1");
  pane.GetDlgItem(5009)->EnableWindow(FALSE);
  const std::string svg = framework::RenderWindow(pane.m_hWnd);
  SaveRender("manager_pane", svg);
  const SvgNode picture = ParseSvg(svg);

  EXPECT_EQ(IconsIn(*FindControl(picture, 5007)), std::vector<std::string>{"5002"});
  EXPECT_EQ(IconsIn(*FindControl(picture, 5019)), std::vector<std::string>{"5067"});
  const SvgNode* update = FindControl(picture, 5009);
  EXPECT_TRUE(update->States().contains("disabled"));
  EXPECT_EQ(FindAll(*update, [](const SvgNode& n) { return n.Attribute("opacity") == "0.35"; }).size(), 1U);

  const SvgNode* tabs = FindControl(picture, 5011);
  EXPECT_EQ(IconsIn(*tabs), (std::vector<std::string>{"5007", "5008", "5006"}));  // the selected tab last, on top
  const auto selectedTab = FindAll(*tabs, [](const SvgNode& n) { return n.Attribute("data-state") == "selected"; });
  ASSERT_EQ(selectedTab.size(), 1U);
  EXPECT_EQ(selectedTab[0]->Attribute("data-tab"), "0");

  const SvgNode* tree = FindControl(picture, 5016);
  std::vector<std::string> items;
  for (const SvgNode* item : FindAll(*tree, [](const SvgNode& n) { return !n.Attribute("data-item").empty(); })) {
    items.push_back(item->Attribute("data-item") + ": " + item->Attribute("data-state"));
  }
  EXPECT_EQ(items, (std::vector<std::string>{"Section 0: unchecked expanded", "Default: checked",
                                             "Camera 1: unchecked", "Section 1: unchecked selected"}));
  EXPECT_EQ(FindControl(picture, IDOK)->States(), (std::set<std::string>{"hidden", "default"}));
}

TEST_F(RenderTest, TheSameStateGivesTheSameBytes) {
  const auto render = [this] {
    TestPane pane;
    pane.Create(5000, &HostFrame());
    pane.ShowWindow(SW_SHOW);
    pane.FillSections();
    return framework::RenderWindow(pane.m_hWnd);
  };
  const std::string first = render();
  EXPECT_EQ(render(), first);
  EXPECT_NE(first.find("data-item=\"Camera 1\""), std::string::npos);
}

TEST_F(RenderTest, AMessageBoxShowsItsIconTextAndButtons) {
  std::string svg;
  user.AnswerNext([&svg](framework::ScriptedUser& u, HWND box) {
    svg = framework::RenderWindow(box);
    u.Click("Yes");
  });
  EXPECT_EQ(AfxMessageBox("Delete \"Section 0\" & its cameras?", MB_YESNO | MB_ICONQUESTION), IDYES);
  SaveRender("message_box", svg);
  const SvgNode picture = ParseSvg(svg);
  EXPECT_EQ(TextsIn(picture), (std::vector<std::string>{"Pandex", "Delete \"Section 0\" & its cameras?", "Yes", "No"}));
  EXPECT_EQ(IconsIn(picture), std::vector<std::string>{"32514"});
  EXPECT_TRUE(FindControl(picture, IDYES)->States().contains("focused"));
}

}  // namespace
