// The library's dialog templates: each opens with the controls of its kinds and ids, laid out
// without overlaps inside the dialog, and a dialog worked through its controls leaves nothing
// behind when it closes.
#include <map>
#include <string>
#include <vector>

#include "framework/cdialog.h"
#include "framework/controls/combo_box.h"
#include "framework/controls/progress_ctrl.h"
#include "framework/data_exchange.h"
#include "framework/image_list.h"
#include "framework/menu.h"
#include "framework/resource_module.h"
#include "framework/toolkit/button_st.h"
#include "framework/toolkit/image_menu.h"
#include "framework/window_classes.h"
#include "resources/dialog_templates.h"
#include "tests/framework/framework_fixture.h"
#include "ui/controls/report_ctrl.h"

namespace {

using DialogTemplatesTest = FrameworkTest;

// The controls with an id of their own, by id: their class.
std::map<int, std::string> ControlsOf(HWND dialog) {
  std::map<int, std::string> controls;
  for (HWND child : framework::GetChildren(dialog)) {
    if (::GetDlgCtrlID(child) != IDC_STATIC) controls[::GetDlgCtrlID(child)] = ::GetClassName(child);
  }
  return controls;
}

TEST_F(DialogTemplatesTest, EachDialogHasTheControlsOfItsKindsAndIds) {
  const std::string button(framework::kButtonClass);
  const std::string edit(framework::kEditClass);
  const std::string combo(framework::kComboBoxClass);
  const std::map<int, std::map<int, std::string>> expected = {
      {5012, {{5057, "Static"}, {5058, "Static"}, {5059, "Static"}, {5030, button}, {5031, button}, {5061, button},
              {5032, button}, {5033, button}, {5079, combo}, {5035, edit}, {5063, button}, {5077, button},
              {5078, button}, {5080, button}, {5081, button}, {5082, button}, {5083, button}, {5084, button},
              {5085, button}, {5086, combo}, {5062, button}, {IDOK, button}, {IDCANCEL, button}}},
      {5038, {{5056, combo}, {5054, combo}, {5053, "ComboBoxEx32"}, {5052, "ComboBoxEx32"}, {5041, edit},
              {5047, edit}, {5046, edit}, {5045, edit}, {5051, edit}, {5050, edit}, {5049, edit}, {5048, edit},
              {5055, button}, {IDOK, button}, {IDCANCEL, button}}},
      {5046, {{5064, "SysListView32"}, {5065, button}, {5066, button}, {IDOK, button}, {IDCANCEL, button}}},
      {5054, {{5069, "Static"}, {5068, "msctls_progress32"}, {5070, button}, {IDCANCEL, button}}},
      {5055, {{5075, button}, {5072, "SysListView32"}, {5073, button}, {5074, button}, {IDOK, button}}},
      {5062, {{5074, edit}, {IDOK, button}, {IDCANCEL, button}}},
  };
  for (const auto& [id, controls] : expected) {
    CDialog dialog;
    ASSERT_TRUE(dialog.Create(static_cast<UINT>(id), &HostFrame())) << id;
    EXPECT_EQ(ControlsOf(dialog.m_hWnd), controls) << id;
    dialog.DestroyWindow();
  }
}

TEST_F(DialogTemplatesTest, TheTemplatesTextsStylesAndSizesAreTheOnesTheDialogsNeed) {
  CDialog camera;
  ASSERT_TRUE(camera.Create(resources::kIddCameraSettings, &HostFrame()));
  RECT client;
  camera.GetClientRect(&client);
  EXPECT_EQ(CRect(client).Size(), CSize(407, 497));  // 271 x 306 dialog units
  EXPECT_EQ(camera.GetWindowText(), "Camera Settings");
  EXPECT_EQ(camera.GetDlgItemText(5083), "Preserve\xA0XY dimension");
  CComboBox scale;
  scale.SubclassDlgItem(5079, &camera);
  EXPECT_EQ(scale.GetCount(), 3);
  EXPECT_EQ(scale.GetLBText(1), "Fixed scale");
  EXPECT_FALSE(camera.GetDlgItem(5062)->IsWindowVisible());  // the detail level is there, hidden

  CDialog section;
  ASSERT_TRUE(section.Create(resources::kIddSectionSettings, &HostFrame()));
  EXPECT_NE(section.GetDlgItem(5041)->GetStyle() & ES_READONLY, 0U);
  EXPECT_EQ(section.GetDlgItem(5054)->GetStyle() & (CBS_OWNERDRAWFIXED | CBS_HASSTRINGS), CBS_OWNERDRAWFIXED | CBS_HASSTRINGS);

  CDialog layers;
  ASSERT_TRUE(layers.Create(resources::kIddLayerSettings, &HostFrame()));
  layers.GetClientRect(&client);
  EXPECT_EQ(CRect(client).Size(), CSize(264, 306));  // 176 x 188 dialog units
  EXPECT_EQ(layers.GetDlgItem(5064)->GetStyle() & (LVS_TYPEMASK | LVS_SINGLESEL), LVS_REPORT | LVS_SINGLESEL);
}

TEST_F(DialogTemplatesTest, NoTwoControlsOverlapAndEveryControlLiesInItsDialog) {
  for (const DialogTemplate* t : resources::AllDialogTemplates()) {
    const CRect dialog = framework::DialogUnitsToPixels(0, 0, t->cx, t->cy);
    std::vector<std::pair<int, CRect>> placed;
    for (const DialogItemTemplate& item : t->items) {
      // A combo box is placed by its field; its template height is the dropped list's.
      const bool combo = item.className == framework::kComboBoxClass || item.className == framework::kComboBoxExClass;
      const CRect r = framework::DialogUnitsToPixels(item.x, item.y, item.cx, combo ? 13 : item.cy);
      EXPECT_TRUE(r.left >= 0 && r.top >= 0 && r.right <= dialog.right && r.bottom <= dialog.bottom)
          << t->id << ": control " << item.id << " leaves the dialog";
      const bool groupBox = item.className == framework::kButtonClass && (item.style & BS_TYPEMASK) == BS_GROUPBOX;
      const bool tabs = item.className == framework::kTabControlClass;  // the pane's tabs lie under its controls
      if (groupBox || tabs || (item.style & WS_VISIBLE) == 0) continue;
      for (const auto& [otherId, other] : placed) {
        CRect overlap;
        EXPECT_FALSE(overlap.IntersectRect(r, other)) << t->id << ": controls " << item.id << " and " << otherId << " overlap";
      }
      placed.emplace_back(item.id, r);
    }
  }
}

// A dialog on template 5012 worked the way the camera settings will be: its display-mode
// button opens a menu of images, the scale and layer are chosen from their lists, a box ticked.
class CameraSettingsLike : public CDialog {
 public:
  CameraSettingsLike() : CDialog(resources::kIddCameraSettings) {}
  int scaleIndex = 0;
  int layerIndex = 0;
  int autoClip = 0;
  UINT displayMode = 0;

 protected:
  void DoDataExchange(CDataExchange* dx) override {
    DDX_Control(dx, 5032, displayButton_);
    DDX_Control(dx, 5086, layers_);
    DDX_CBIndex(dx, 5079, scaleIndex);
    DDX_CBIndex(dx, 5086, layerIndex);
    DDX_Check(dx, 5077, autoClip);
  }
  BOOL OnInitDialog() override {
    images_.Create(5027U, 16, 1, RGB(255, 0, 255));
    CDialog::OnInitDialog();
    for (int layer = 1; layer <= 255; ++layer) layers_.AddString(std::to_string(layer));
    UpdateData(FALSE);
    displayButton_.SetIcon(images_.ExtractIcon(0));
    displayButton_.SetWindowText(AfxLoadString(16));
    return TRUE;
  }
  void OnDisplayMode() {
    CImageMenu menu;
    menu.Create(images_);
    for (UINT code = 0; code <= 10; ++code) menu.AddItem(code + 1, AfxLoadString(16 + code), static_cast<int>(code));
    POINT mouse;
    ::GetCursorPos(&mouse);
    if (const UINT chosen = menu.Track(this, mouse); chosen != 0) {
      displayMode = chosen - 1;
      displayButton_.SetIcon(images_.ExtractIcon(static_cast<int>(displayMode)));
      displayButton_.SetWindowText(AfxLoadString(16 + displayMode));
    }
  }

  DECLARE_MESSAGE_MAP()

 private:
  CButtonST displayButton_;
  CComboBox layers_;
  CImageList images_;
};

BEGIN_MESSAGE_MAP(CameraSettingsLike, CDialog)
ON_BN_CLICKED(5032, OnDisplayMode)
END_MESSAGE_MAP()

TEST_F(DialogTemplatesTest, ADialogWorkedThroughItsControlsLeavesNoWindowListOrMenuBehind) {
  HostFrame();
  const std::size_t windows = framework::LiveWindowCount();
  const std::size_t imageLists = framework::LiveImageListCount();
  const std::size_t menus = framework::LiveMenuCount();
  const std::size_t timers = framework::LiveTimerCount();

  {
    CameraSettingsLike dialog;
    user.AnswerNext([](framework::ScriptedUser& u, HWND modal) {
      u.AnswerNextWithMenuItem("Hiddenline");
      u.Click(u.Find(5032, modal));
      u.ChooseComboItem(u.Find(5079, modal), "Fixed scale");
      u.ChooseComboItem(u.Find(5086, modal), "12");
      u.Click("Auto clip");
      u.Click("OK");
    });
    EXPECT_EQ(dialog.DoModal(), IDOK);
    EXPECT_EQ(dialog.displayMode, 2U);
    EXPECT_EQ(dialog.scaleIndex, 1);
    EXPECT_EQ(dialog.layerIndex, 11);
    EXPECT_EQ(dialog.autoClip, BST_CHECKED);
    EXPECT_EQ(user.UnansweredModals(), 0);
  }
  EXPECT_EQ(framework::LiveWindowCount(), windows);
  EXPECT_EQ(framework::LiveImageListCount(), imageLists);
  EXPECT_EQ(framework::LiveMenuCount(), menus);
  EXPECT_EQ(framework::LiveTimerCount(), timers);
}

TEST_F(DialogTemplatesTest, TheLayersListAndTheProgressBarWorkInTheirTemplates) {
  CDialog layers;
  ASSERT_TRUE(layers.Create(resources::kIddLayerSettings, &HostFrame()));
  layers.ShowWindow(SW_SHOW);
  const std::size_t windows = framework::LiveWindowCount();
  {
    CReportCtrl list;
    ASSERT_TRUE(list.SubclassDlgItem(5064, &layers));
    list.InsertColumn(0, AfxLoadString(39), LVCFMT_LEFT, 40);
    list.InsertColumn(1, AfxLoadString(40), LVCFMT_LEFT, 130);
    list.InsertColumn(2, AfxLoadString(41), LVCFMT_LEFT, 60);
    for (int layer = 0; layer < 256; ++layer) {
      if (layer == 215 || layer == 218) continue;
      const int row = list.InsertItem(list.GetItemCount(), std::to_string(layer));
      list.SetItemData(row, static_cast<DWORD_PTR>(layer));
    }
    user.ClickListCell(list.m_hWnd, 250, 2);  // far down: the list scrolls to it
    EXPECT_EQ(list.GetFirstItem(RC_ITEM_SELECTED), 250);
    EXPECT_EQ(list.GetItemData(250), 252U);
    EXPECT_GT(list.GetTopIndex(), 200);
  }
  EXPECT_EQ(framework::LiveWindowCount(), windows - 3);  // the list went with its object, header and scroll bar too
  layers.DestroyWindow();
  EXPECT_EQ(framework::LiveWindowCount(), windows - 8);

  CDialog progress;
  ASSERT_TRUE(progress.Create(resources::kIddProgress, &HostFrame()));
  CProgressCtrl bar;
  ASSERT_TRUE(bar.SubclassDlgItem(5068, &progress));
  bar.SetRange(0, 3);
  bar.SetStep(1);
  bar.StepIt();
  bar.StepIt();
  int low = -1;
  int high = -1;
  bar.GetRange(low, high);
  EXPECT_EQ(bar.GetPos(), 2);
  EXPECT_EQ(high, 3);
  bar.StepIt();
  EXPECT_EQ(bar.StepIt(), 3);  // a step past the end starts again from the beginning
  EXPECT_EQ(bar.GetPos(), 1);
  EXPECT_EQ(bar.SetPos(99), 1);
  EXPECT_EQ(bar.GetPos(), 3);
}

}  // namespace
