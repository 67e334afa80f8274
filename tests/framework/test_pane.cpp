// The test pane: the manager pane's shape on the window layer, recording its handlers.
#include "tests/framework/test_pane.h"

#include <algorithm>

#include "framework/data_exchange.h"
#include "framework/resource_module.h"

namespace {

constexpr int kTabIcons[] = {5006, 5007, 5008};
constexpr int kButtonIcons[] = {5002, 5003, 5042, 5005, 5010, 5064, 5067};
constexpr UINT kButtonTips[] = {75, 76, 77, 78, 79, 80, 87};

}  // namespace

UINT PreTranslateMessageNumber() { return RegisterWindowMessage("Quorvel_PreTranslateMessage"); }

namespace {
const UINT preTranslateMessage = PreTranslateMessageNumber();
}  // namespace

BEGIN_MESSAGE_MAP(TestPane, CDialog)
ON_NOTIFY(NM_CLICK, 5016, OnTreeClick)
ON_NOTIFY(TVN_KEYDOWN, 5016, OnTreeKeyDown)
ON_NOTIFY(TVN_ENDLABELEDIT, 5016, OnEndLabelEdit)
ON_NOTIFY(TCN_SELCHANGE, 5011, OnTabChange)
ON_BN_CLICKED(5007, OnAddNew)
ON_MESSAGE(WM_APP, OnApplyCheck)
ON_MESSAGE(WM_APP + 1, OnPosted)
ON_REGISTERED_MESSAGE(preTranslateMessage, OnPreTranslate)
END_MESSAGE_MAP()

void TestPane::DoDataExchange(CDataExchange* dx) {
  DDX_Control(dx, 5011, tabs);
  DDX_Control(dx, 5016, tree);
  for (int i = 0; i < 7; ++i) DDX_Control(dx, kButtonIds[i], buttons[i]);
}

BOOL TestPane::OnInitDialog() {
  CDialog::OnInitDialog();
  for (CImageList* list : {&tabImages, &treeImages}) {
    list->Create(16, 16, ILC_COLORDDB | ILC_MASK, 1, 1);
    for (int icon : kTabIcons) list->Add(AfxLoadIcon(static_cast<UINT>(icon)));
  }
  tree.SetImageList(&treeImages, TVSIL_NORMAL);
  tabs.SetImageList(tabImages.GetSafeHandle());
  for (int i = 0; i < 3; ++i) tabs.InsertItem(i, "", i);
  for (int i = 0; i < 7; ++i) buttons[i].SetIcon(static_cast<UINT>(kButtonIcons[i]));

  buttonTips.Setup(
      this,
      [](CWnd* owner, int id, CPoint, CRect& area) {
        CWnd* control = owner->GetDlgItem(id);
        control->GetClientRect(&area);
        control->MapWindowPoints(owner, &area);
        return true;
      },
      3, 2);
  buttonTips.SetDisplayParameters(6, 0, 5000, 0, 1);
  for (int i = 0; i < 7; ++i) buttonTips.AddTip(kButtonIds[i], kButtonTips[i]);
  tabTips.Setup(
      this,
      [this](CWnd* owner, int index, CPoint point, CRect& area) {
        if (!tabs.GetItemRect(index, &area) || !area.PtInRect(point)) return false;
        tabs.MapWindowPoints(owner, &area);
        return true;
      },
      3, 2);
  tabTips.SetDisplayParameters(6, 0, 5000, 0, 1);
  for (int i = 0; i < 3; ++i) tabTips.AddTip(i, static_cast<UINT>(88 + i));

  layout.Setup(this);
  layout.AddControl(5011, CResizeLayout::Rule::kStretch);
  layout.AddControl(5016, CResizeLayout::Rule::kStretch);
  layout.AddControl(5019, CResizeLayout::Rule::kFollowRight);
  layout.AddControl(IDOK, CResizeLayout::Rule::kFollowCorner);
  return TRUE;
}

void TestPane::FillSections() {
  tree.DeleteAllItems();
  const HTREEITEM section = tree.InsertItem("Section 0", 1, 1);
  for (const char* camera : {"Default", "Camera 1"}) {
    const HTREEITEM child = tree.InsertItem(camera, 0, 0, section);
    tree.EnsureVisible(child);
  }
  tree.InsertItem("Section 1", 1, 1);
}

void TestPane::OnSize(UINT type, int cx, int cy) {
  CDialog::OnSize(type, cx, cy);
  layout.Resize(std::max(cx, 240), std::max(cy, 150));
}

void TestPane::OnOK() { events.push_back("ok"); }

void TestPane::OnTreeClick(NMHDR*, LRESULT* result) {
  const DWORD pos = ::GetMessagePos();
  CPoint point(static_cast<std::int16_t>(LOWORD(pos)), static_cast<std::int16_t>(HIWORD(pos)));
  tree.ScreenToClient(&point);
  UINT flags = 0;
  const HTREEITEM item = tree.HitTest(point, &flags);
  if (item && (flags & TVHT_ONITEMSTATEICON) != 0) {
    events.push_back("click " + tree.GetItemText(item) + (tree.GetCheck(item) ? " checked" : " unchecked"));
    PostMessage(WM_APP, 5016, item.ToLParam());
  }
  *result = 0;
}

void TestPane::OnTreeKeyDown(NMHDR* header, LRESULT* result) {
  const auto* key = reinterpret_cast<NMTVKEYDOWN*>(header);
  if (key->wVKey == VK_SPACE) PostMessage(WM_APP, 5016, tree.GetSelectedItem().ToLParam());
  *result = 0;
}

LRESULT TestPane::OnApplyCheck(WPARAM, LPARAM lParam) {
  const HTREEITEM item = HTREEITEM::FromParam(lParam);
  events.push_back("apply " + tree.GetItemText(item) + (tree.GetCheck(item) ? " checked" : " unchecked"));
  return 0;
}

void TestPane::OnEndLabelEdit(NMHDR* header, LRESULT* result) {
  const auto* info = reinterpret_cast<NMTVDISPINFO*>(header);
  *result = 0;
  if (info->item.pszText == nullptr) {
    events.push_back("edit cancelled");
    return;
  }
  const std::string text = info->item.pszText;
  for (HTREEITEM root = tree.GetRootItem(); root; root = tree.GetNextSiblingItem(root)) {
    if (tree.GetItemText(root) == text) {
      events.push_back("rename to " + text + " refused");
      return;
    }
  }
  events.push_back("rename to " + text);
  *result = 1;
}

void TestPane::OnTabChange(NMHDR*, LRESULT* result) {
  events.push_back("tab " + std::to_string(tabs.GetCurSel()));
  *result = 0;
}

void TestPane::OnAddNew() {
  events.push_back("add new begins");
  PostMessage(WM_APP + 1, 0, 0);
  events.push_back("add new ends");
}

LRESULT TestPane::OnPosted(WPARAM, LPARAM) {
  events.push_back("posted message runs");
  return 0;
}

LRESULT TestPane::OnPreTranslate(WPARAM wParam, LPARAM) {
  const MSG* msg = reinterpret_cast<const MSG*>(wParam);
  if (msg == nullptr || msg->message != WM_MOUSEMOVE || msg->wParam != 0) return 0;
  const CPoint point(GET_X_LPARAM(msg->lParam), GET_Y_LPARAM(msg->lParam));
  if (msg->hwnd == tabs.m_hWnd) {
    tabTips.RelayAll(point);
  } else if (msg->hwnd != m_hWnd && ::GetDlgCtrlID(msg->hwnd) != 0) {
    buttonTips.Relay(::GetDlgCtrlID(msg->hwnd), point);
  }
  return 0;
}
