// The pane's tree: filling it with the cameras, sections or plans of the drawing, the tab
// change, and which buttons the selected item allows.
#include <string>
#include <vector>

#include "model/current_database.h"
#include "ui/pandex_dlg.h"
#include "ui/pane_objects.h"
#include "views/hr_camera.h"
#include "views/hr_camera_mgr.h"
#include "views/view_collection.h"

void CPandexDlg::CollectSectionHandles() {
  const std::vector<host::EntityHandle> found = ::CollectSectionHandles(GetCurrentDatabase());
  sectionHandles_.insert(sectionHandles_.end(), found.begin(), found.end());
}

void CPandexDlg::CollectPlanHandles() {
  const std::vector<host::EntityHandle> found = ::CollectPlanHandles(GetCurrentDatabase());
  planHandles_.insert(planHandles_.end(), found.begin(), found.end());
}

HTREEITEM CPandexDlg::InsertObject(const std::string& text, int image, DWORD_PTR data, bool checked,
                                   HTREEITEM parent) {
  const HTREEITEM item = tree_.InsertItem(text, image, image, parent);
  tree_.SetItemData(item, data);
  if (checked) tree_.SetCheck(item, TRUE);
  return item;
}

void CPandexDlg::FillCameraTree() {
  tree_.DeleteAllItems();
  for (std::int32_t i = 0; i < GetGeneralCameraCount(); ++i) {
    HRCamera camera;
    LoadGeneralCamera(camera, i);
    InsertObject(camera.GetName(), kCamerasTab, pane::ItemData(i), camera.IsFor2D() == 1);
  }
}

// Every entity of the drawing is examined, the first one and hidden ones included, so no
// section or plan is missing from the tree (or from the 2D commands that use the arrays).
template <class Owner>
void CPandexDlg::FillOwnerTree(int kind, std::vector<host::EntityHandle>& handles) {
  tree_.DeleteAllItems();
  handles = kind == kSectionsTab ? ::CollectSectionHandles(GetCurrentDatabase())
                                 : ::CollectPlanHandles(GetCurrentDatabase());
  for (const host::EntityHandle handle : handles) {
    Owner owner;
    owner.Load(handle);
    const HTREEITEM root =
        InsertObject(owner.GetName(), kind, pane::ItemData(handle),
                     owner.IsFor2D() == 1);
    for (std::int32_t k = 0; k < owner.GetCameraCount(); ++k) {
      HRCamera camera;
      owner.LoadCamera(k, camera);
      const HTREEITEM child =
          InsertObject(camera.GetName(), kCamerasTab, pane::ItemData(k), owner.IsCameraFor2D(k) == 1, root);
      tree_.EnsureVisible(child);
    }
  }
}

void CPandexDlg::FillSectionTree() { FillOwnerTree<HRSection>(kSectionsTab, sectionHandles_); }
void CPandexDlg::FillPlanTree() { FillOwnerTree<HRPlane>(kPlansTab, planHandles_); }

void CPandexDlg::RefreshCurrentTab() {
  switch (SelectedTab()) {
    case kCamerasTab:
      addViewButton_.ShowWindow(SW_HIDE);
      FillCameraTree();
      break;
    case kSectionsTab:
      addViewButton_.ShowWindow(SW_SHOW);
      FillSectionTree();
      break;
    case kPlansTab:
      addViewButton_.ShowWindow(SW_SHOW);
      FillPlanTree();
      break;
    default:
      return;
  }
  SetButtonStates(tree_.GetSelectedItem());
}

// Update and Execute need a camera; "Add camera view" needs a section or plan. On the cameras
// tab every item is a camera; on the other tabs the roots are sections or plans and their
// children cameras.
void CPandexDlg::SetButtonStates(HTREEITEM selected) {
  const bool camera = selected && (SelectedTab() == kCamerasTab || tree_.GetParentItem(selected));
  const bool owner = selected && SelectedTab() != kCamerasTab && !tree_.GetParentItem(selected);
  updateButton_.EnableWindow(camera);
  executeButton_.EnableWindow(camera);
  if (SelectedTab() != kCamerasTab) addViewButton_.EnableWindow(owner);
}

void CPandexDlg::OnTabChange(NMHDR*, LRESULT* result) {
  RefreshCurrentTab();
  *result = 0;
}

void CPandexDlg::OnTreeSelChanged(NMHDR* header, LRESULT* result) {
  const auto* change = reinterpret_cast<NMTREEVIEW*>(header);
  if (SelectedTab() == kCamerasTab) {
    updateButton_.EnableWindow(TRUE);
    executeButton_.EnableWindow(TRUE);
  } else {
    SetButtonStates(change->itemNew.hItem);
  }
  *result = 0;
}

int CPandexDlg::KindOf(HTREEITEM item) const {
  const HTREEITEM parent = tree_.GetParentItem(item);
  int image = -1;
  int selectedImage = -1;
  tree_.GetItemImage(parent ? parent : item, image, selectedImage);
  return image;
}

bool CPandexDlg::ShowsSelectedTab(HTREEITEM item) {
  if (KindOf(item) == SelectedTab()) return true;
  Refresh();
  return false;
}

void CPandexDlg::ShowTab(int tab) {
  if (SelectedTab() == tab) return;
  tabs_.SetCurSel(tab);
  RefreshCurrentTab();
}

std::vector<std::string> CPandexDlg::RootTexts() const {
  std::vector<std::string> texts;
  for (HTREEITEM item = tree_.GetRootItem(); item; item = tree_.GetNextSiblingItem(item)) {
    texts.push_back(tree_.GetItemText(item));
  }
  return texts;
}

std::vector<std::string> CPandexDlg::ChildTexts(HTREEITEM parent) const {
  std::vector<std::string> texts;
  for (HTREEITEM item = tree_.GetChildItem(parent); item; item = tree_.GetNextSiblingItem(item)) {
    texts.push_back(tree_.GetItemText(item));
  }
  return texts;
}
