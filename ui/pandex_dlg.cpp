// The manager pane's window: set-up from its template, docking into the host, showing and
// hiding, resizing, closing and the tips the host's mouse moves bring up.
#include "ui/pandex_dlg.h"

#include <algorithm>
#include <string>

#include "framework/cwinapp.h"
#include "framework/data_exchange.h"
#include "framework/resource_module.h"
#include "shell/host/argument_blocks.h"
#include "shell/host/pane_manager.h"
#include "shell/host/qelinfo.h"
#include "shell/host_messages.h"
#include "shell/pane_instance.h"
#include "views/hr_camera_mgr.h"

namespace {

constexpr int kTabIcons[] = {5006, 5007, 5008};

struct PaneButton {
  int id;
  UINT icon;
  UINT tip;  // string id
};
// In the order of their tips' registration.
constexpr PaneButton kButtons[] = {{5007, 5002, 75}, {5008, 5003, 76}, {5009, 5042, 77}, {5010, 5005, 78},
                                   {5018, 5010, 79}, {5021, 5064, 80}, {5019, 5067, 87}};
constexpr UINT kTabTips[] = {88, 89, 90};
constexpr UINT kPaneTitle = 86;

// Spacing inside the tip window and how it shows: 6 pixels below the mouse, at once, for five
// seconds, not shifted, gone when the mouse leaves the area.
constexpr int kTipSpacingX = 3;
constexpr int kTipSpacingY = 2;
constexpr CTipWindow::DisplayParameters kTipDisplay = {6, 0, 5000, 0, 1};

// The smallest size the anchored controls are laid out for.
constexpr int kLayoutMinWidth = 240;
constexpr int kLayoutMinHeight = 150;

// The room the host gives the docked pane, and the side it docks on.
constexpr RECT kDockRect = {0, 0, 280, 440};

}  // namespace

BEGIN_MESSAGE_MAP(CPandexDlg, CDialog)
ON_BN_CLICKED(5007, OnAddNew)
ON_BN_CLICKED(5008, OnRemove)
ON_BN_CLICKED(5009, OnUpdateCamera)
ON_BN_CLICKED(5010, OnExecute)
ON_BN_CLICKED(5018, OnAddCameraView)
ON_BN_CLICKED(5019, Refresh)
ON_BN_CLICKED(5021, OnBuild2D)
ON_NOTIFY(TCN_SELCHANGE, 5011, OnTabChange)
ON_NOTIFY(TVN_SELCHANGED, 5016, OnTreeSelChanged)
ON_NOTIFY(NM_CLICK, 5016, OnTreeClick)
ON_NOTIFY(TVN_KEYDOWN, 5016, OnTreeKeyDown)
ON_NOTIFY(TVN_ENDLABELEDIT, 5016, OnEndLabelEdit)
ON_NOTIFY(NM_DBLCLK, 5016, OnItemDoubleClick)
ON_MESSAGE(WM_APP, OnCheckChanged)
ON_REGISTERED_MESSAGE(pandex::preTranslateMessage, OnHostPreTranslate)
END_MESSAGE_MAP()

CPandexDlg::CPandexDlg() : CDialog(IDD) {}

// Destroying the window through its handlers undocks the pane and tells the host it is off,
// as when the window goes by itself.
CPandexDlg::~CPandexDlg() {
  if (m_hWnd) DestroyWindow();
}

bool CPandexDlg::Create(int templateId, CWnd* parent) {
  return CDialog::Create(static_cast<UINT>(templateId), parent) != FALSE;
}

CWnd* CPandexDlg::TabControl() { return tabs_.m_hWnd ? &tabs_ : nullptr; }

void CPandexDlg::DoDataExchange(CDataExchange* dx) {
  CDialog::DoDataExchange(dx);
  DDX_Control(dx, 5019, refreshButton_);
  DDX_Control(dx, 5009, updateButton_);
  DDX_Control(dx, 5021, buildButton_);
  DDX_Control(dx, 5018, addViewButton_);
  DDX_Control(dx, 5016, tree_);
  DDX_Control(dx, 5011, tabs_);
  DDX_Control(dx, 5008, removeButton_);
  DDX_Control(dx, 5010, executeButton_);
  DDX_Control(dx, 5007, addButton_);
}

BOOL CPandexDlg::OnInitDialog() {
  CDialog::OnInitDialog();
  ShowWindow(SW_HIDE);

  for (CImageList* images : {&tabImages_, &treeImages_}) {
    images->Create(16, 16, ILC_COLORDDB | ILC_MASK, 1, 1);
    for (const int icon : kTabIcons) images->Add(AfxLoadIcon(static_cast<UINT>(icon)));
  }
  tree_.SetImageList(&treeImages_, TVSIL_NORMAL);
  tabs_.SetImageList(tabImages_.GetSafeHandle());
  for (int tab = kCamerasTab; tab <= kPlansTab; ++tab) tabs_.InsertItem(tab, "", tab);
  for (const PaneButton& button : kButtons) {
    if (auto* icon = dynamic_cast<CButtonST*>(GetDlgItem(button.id))) icon->SetIcon(button.icon);
  }
  SetupTips();

  CollectSectionHandles();
  CollectPlanHandles();

  layout_.Setup(this);
  layout_.AddControl(5011, CResizeLayout::Rule::kStretch);
  layout_.AddControl(5016, CResizeLayout::Rule::kStretch);
  layout_.AddControl(5019, CResizeLayout::Rule::kFollowRight);
  layout_.AddControl(IDOK, CResizeLayout::Rule::kFollowCorner);

  const std::string title = AfxLoadString(kPaneTitle);
  if (CWnd* host = AfxGetMainWnd()) {
    paneManager_ = reinterpret_cast<CPaneManager*>(host->SendMessage(pandex::getPaneManagerMessage, 0, 0));
  }
  if (paneManager_ != nullptr) paneManager_->AddPane(kPaneId, title.c_str(), m_hWnd, kDockRect, xtpPaneDockLeft);

  ShowWindow(SW_SHOWNORMAL);
  return TRUE;
}

void CPandexDlg::SetupTips() {
  buttonTips_.Setup(
      this,
      [](CWnd* owner, int id, CPoint, CRect& area) {
        CWnd* control = owner->GetDlgItem(id);
        if (control == nullptr) return false;
        control->GetClientRect(&area);
        control->MapWindowPoints(owner, &area);
        return true;
      },
      kTipSpacingX, kTipSpacingY);
  buttonTips_.SetDisplayParameters(kTipDisplay[0], kTipDisplay[1], kTipDisplay[2], kTipDisplay[3], kTipDisplay[4]);
  for (const PaneButton& button : kButtons) buttonTips_.AddTip(button.id, button.tip);

  tabTips_.Setup(
      this,
      [this](CWnd* owner, int tab, CPoint point, CRect& area) {
        if (!tabs_.GetItemRect(tab, &area) || !area.PtInRect(point)) return false;
        tabs_.MapWindowPoints(owner, &area);
        return true;
      },
      kTipSpacingX, kTipSpacingY);
  tabTips_.SetDisplayParameters(kTipDisplay[0], kTipDisplay[1], kTipDisplay[2], kTipDisplay[3], kTipDisplay[4]);
  for (int tab = kCamerasTab; tab <= kPlansTab; ++tab) tabTips_.AddTip(tab, kTabTips[tab]);
}

void CPandexDlg::ShowPane(bool show) {
  if (!m_hWnd) return;
  if (show) {
    if (paneManager_ != nullptr) paneManager_->ReattachPane(kPaneId, m_hWnd);
    ShowWindow(SW_SHOW);
    SetCameraManagerOn();
  } else {
    ShowWindow(SW_HIDE);
    if (paneManager_ != nullptr) paneManager_->RemovePane(kPaneId);
    SetCameraManagerOff();
  }
}

// Shown or hidden alike, the pane reads the drawing again.
void CPandexDlg::OnShowWindow(BOOL show, UINT status) {
  CDialog::OnShowWindow(show, status);
  SetDatabase(db.handle);
  RefreshCurrentTab();
  RedrawWindow(nullptr, RDW_INVALIDATE | RDW_ERASE | RDW_ALLCHILDREN);
}

void CPandexDlg::OnSize(UINT type, int cx, int cy) {
  CDialog::OnSize(type, cx, cy);
  layout_.Resize(std::max(cx, kLayoutMinWidth), std::max(cy, kLayoutMinHeight));
}

void CPandexDlg::OnClose() {
  SetCameraManagerOff();
  ShowPane(false);
}

void CPandexDlg::OnDestroy() {
  ShowPane(false);
  CDialog::OnDestroy();
}

void CPandexDlg::OnOK() {
  ShowPane(false);
  CDialog::OnOK();
}

// Escape would end a modeless dialog by hiding it behind the host's back (still docked, the
// manager still on): the pane stays, and is closed the ways the host knows of.
void CPandexDlg::OnCancel() {}

// The last message of the window: the pane deletes itself and the library forgets it.
void CPandexDlg::PostNcDestroy() { pandex::ReleasePane(this); }

LRESULT CPandexDlg::OnHostPreTranslate(WPARAM wParam, LPARAM) {
  const MSG* msg = reinterpret_cast<const MSG*>(wParam);
  if (msg == nullptr || msg->message != WM_MOUSEMOVE || msg->wParam != 0) return 0;
  const CPoint point(GET_X_LPARAM(msg->lParam), GET_Y_LPARAM(msg->lParam));
  if (msg->hwnd == tabs_.m_hWnd) {
    tabTips_.RelayAll(point);
  } else if (msg->hwnd != m_hWnd) {
    if (const int id = ::GetDlgCtrlID(msg->hwnd); id != 0) buttonTips_.Relay(id, point);
  }
  return 0;
}

void CPandexDlg::OnBuild2D() {}

void CPandexDlg::OnItemDoubleClick(NMHDR*, LRESULT* result) { *result = 0; }
