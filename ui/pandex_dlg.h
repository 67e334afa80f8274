// The manager pane: a modeless dialog docked in the host's main frame, with the cameras, the
// sections or the plans of the drawing in a tree with check boxes under three icon tabs, and a
// row of icon buttons that add, remove, update, execute and refresh them.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "framework/cdialog.h"
#include "framework/controls/tree_control.h"
#include "framework/image_list.h"
#include "framework/toolkit/button_st.h"
#include "shell/host/host_types.h"
#include "ui/controls/resize_layout.h"
#include "ui/controls/tab_ctrl_ex.h"
#include "ui/controls/tip_manager.h"

class CPaneManager;

class CPandexDlg : public CDialog {
 public:
  static constexpr int IDD = 5000;  // dialog template of the pane
  static constexpr int kPaneId = 62000;  // the pane's id in the host's pane manager

  // What the tabs show; a tree item's image is the kind of its object (a child's kind is read
  // from its parent's image).
  enum Tab : int { kCamerasTab = 0, kSectionsTab = 1, kPlansTab = 2 };

  CPandexDlg();
  ~CPandexDlg() override;

  // Creates the modeless pane window from its template; answers whether a window exists.
  virtual bool Create(int templateId, CWnd* parent);
  // Shows (docked, host told the manager is on) or hides the pane.
  virtual void ShowPane(bool show);
  // What the host's sub-commands start: a section or a plan from the two points the user
  // picked, a camera of the current view, and a reload of the drawing.
  virtual void CreateSection(const host::Point3f& start, const host::Point3f& end);
  virtual void CreatePlan(const host::Point3f& base, const host::Point3f& second);
  virtual void CreateCamera();
  virtual void Refresh();
  // The icon tab control (cameras, sections, plans); null while the pane has no window.
  virtual CWnd* TabControl();

  // Empty the tree and fill it with one tab's objects; sections and plans also rebuild their
  // handle arrays.
  void FillCameraTree();
  void FillSectionTree();
  void FillPlanTree();
  // The tab-change logic: fill the tree of the selected tab and set the button states.
  void RefreshCurrentTab();

  // Every section and plan entity of the drawing, in database order, as last collected; the
  // 2D commands work from these.
  const std::vector<host::EntityHandle>& SectionHandles() const { return sectionHandles_; }
  const std::vector<host::EntityHandle>& PlanHandles() const { return planHandles_; }
  // The host's pane manager, or null when the host did not answer (the pane is not docked).
  CPaneManager* PaneManager() const { return paneManager_; }

 protected:
  void DoDataExchange(CDataExchange* dx) override;
  BOOL OnInitDialog() override;
  void OnShowWindow(BOOL show, UINT status) override;
  void OnSize(UINT type, int cx, int cy) override;
  void OnClose() override;
  void OnDestroy() override;
  void OnOK() override;
  void OnCancel() override;
  void PostNcDestroy() override;

  // Buttons.
  void OnAddNew();
  void OnRemove();
  void OnUpdateCamera();
  void OnExecute();
  void OnAddCameraView();
  // The "Build 2D" menu and the settings dialogs of a double-click are not part of the pane
  // yet: the button and the double-click do nothing until they are.
  void OnBuild2D();
  void OnItemDoubleClick(NMHDR* header, LRESULT* result);

  // Tree and tabs.
  void OnTabChange(NMHDR* header, LRESULT* result);
  void OnTreeSelChanged(NMHDR* header, LRESULT* result);
  void OnTreeClick(NMHDR* header, LRESULT* result);
  void OnTreeKeyDown(NMHDR* header, LRESULT* result);
  void OnEndLabelEdit(NMHDR* header, LRESULT* result);
  // A check box changed earlier (posted by the click or key handler); lParam is the item.
  LRESULT OnCheckChanged(WPARAM wParam, LPARAM lParam);
  // The host's mouse messages, for the tips; wParam points at the host's MSG.
  LRESULT OnHostPreTranslate(WPARAM wParam, LPARAM lParam);

  DECLARE_MESSAGE_MAP()

 private:
  // Stores an item's check state into the objects it stands for.
  void ApplyCheckState(HTREEITEM item);
  void CollectSectionHandles();
  void CollectPlanHandles();
  template <class Owner>
  void FillOwnerTree(int kind, std::vector<host::EntityHandle>& handles);
  void SetButtonStates(HTREEITEM selected);

  int SelectedTab() const { return tabs_.GetCurSel(); }
  // The image of an item's root: the kind of object the item belongs to.
  int KindOf(HTREEITEM item) const;
  // Whether an item stands for an object of the selected tab; a tree that still holds another
  // tab's objects (the tab was changed without a refill) is reloaded instead of acted on.
  bool ShowsSelectedTab(HTREEITEM item);
  std::vector<std::string> RootTexts() const;
  std::vector<std::string> ChildTexts(HTREEITEM parent) const;
  HTREEITEM InsertObject(const std::string& text, int image, DWORD_PTR data, bool checked,
                         HTREEITEM parent = TVI_ROOT);
  // Makes the tree show one tab's objects before an object of that kind is added to it.
  void ShowTab(int tab);
  void SetupTips();

  // Controls, bound to the template's ids.
  CButtonST refreshButton_;  // 5019
  CButtonST updateButton_;   // 5009
  CButtonST buildButton_;    // 5021
  CButtonST addViewButton_;  // 5018
  CTreeCtrl tree_;           // 5016
  CTabCtrlEx tabs_;          // 5011
  CButtonST removeButton_;   // 5008
  CButtonST executeButton_;  // 5010
  CButtonST addButton_;      // 5007
  CResizeLayout layout_;
  CTipManager buttonTips_;
  CTipManager tabTips_;
  CImageList tabImages_;
  CImageList treeImages_;
  std::vector<host::EntityHandle> sectionHandles_;
  std::vector<host::EntityHandle> planHandles_;
  CPaneManager* paneManager_ = nullptr;  // the host's; never owned
};
