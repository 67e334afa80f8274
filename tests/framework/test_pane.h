// A pane built on the window layer the way the manager pane is built: template 5000, controls
// bound by data exchange, icon buttons, icon tabs, tips and anchors. It writes down what its
// handlers receive, so that tests follow a user's action to the handler it reaches.
#pragma once

#include <string>
#include <vector>

#include "framework/cdialog.h"
#include "framework/controls/tree_control.h"
#include "framework/image_list.h"
#include "framework/toolkit/button_st.h"
#include "ui/controls/resize_layout.h"
#include "ui/controls/tab_ctrl_ex.h"
#include "ui/controls/tip_manager.h"

class TestPane : public CDialog {
 public:
  static constexpr int kButtonIds[7] = {5007, 5008, 5009, 5010, 5018, 5021, 5019};

  TestPane() = default;

  // Fills the tree with sections and their cameras ("Section 0" > "Default", "Camera 1").
  void FillSections();

  CTabCtrlEx tabs;
  CTreeCtrl tree;
  CButtonST buttons[7];
  CImageList tabImages;
  CImageList treeImages;
  CTipManager buttonTips;
  CTipManager tabTips;
  CResizeLayout layout;
  std::vector<std::string> events;

 protected:
  void DoDataExchange(CDataExchange* dx) override;
  BOOL OnInitDialog() override;
  void OnSize(UINT type, int cx, int cy) override;
  void OnOK() override;
  void OnTreeClick(NMHDR* header, LRESULT* result);
  void OnTreeKeyDown(NMHDR* header, LRESULT* result);
  void OnEndLabelEdit(NMHDR* header, LRESULT* result);
  void OnTabChange(NMHDR* header, LRESULT* result);
  void OnAddNew();
  LRESULT OnApplyCheck(WPARAM wParam, LPARAM lParam);
  LRESULT OnPosted(WPARAM wParam, LPARAM lParam);
  LRESULT OnPreTranslate(WPARAM wParam, LPARAM lParam);

  DECLARE_MESSAGE_MAP()
};

// The registered message a host forwards its mouse messages with.
UINT PreTranslateMessageNumber();
