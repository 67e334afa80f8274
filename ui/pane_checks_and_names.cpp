// Ticking objects for 2D through the tree's check boxes, and renaming them in place.
#include <algorithm>
#include <string>
#include <vector>

#include "ui/pandex_dlg.h"
#include "ui/pane_objects.h"
#include "views/hr_camera.h"
#include "views/hr_camera_mgr.h"

namespace {

constexpr int kTreeId = 5016;

}  // namespace

// The tree changes the check state after it has told the pane of the click, so the pane reads
// it later, from a message it posts itself.
void CPandexDlg::OnTreeClick(NMHDR*, LRESULT* result) {
  const DWORD position = ::GetMessagePos();
  CPoint point(static_cast<std::int16_t>(LOWORD(position)), static_cast<std::int16_t>(HIWORD(position)));
  tree_.ScreenToClient(&point);
  UINT flags = 0;
  const HTREEITEM item = tree_.HitTest(point, &flags);
  if (item && (flags & TVHT_ONITEMSTATEICON) != 0) PostMessage(WM_APP, kTreeId, item.ToLParam());
  *result = 0;
}

void CPandexDlg::OnTreeKeyDown(NMHDR* header, LRESULT* result) {
  if (reinterpret_cast<NMTVKEYDOWN*>(header)->wVKey == VK_SPACE) {
    PostMessage(WM_APP, kTreeId, tree_.GetSelectedItem().ToLParam());
  }
  *result = 0;
}

LRESULT CPandexDlg::OnCheckChanged(WPARAM, LPARAM lParam) {
  ApplyCheckState(HTREEITEM::FromParam(lParam));
  return 0;
}

void CPandexDlg::ApplyCheckState(HTREEITEM item) {
  // The tree may have been refilled since the change was posted: its items are gone.
  TVITEM exists;
  exists.mask = TVIF_HANDLE;
  exists.hItem = item;
  if (!item || !tree_.GetItem(&exists)) return;
  const auto checked = static_cast<std::int16_t>(tree_.GetCheck(item) == TRUE ? 1 : 0);
  const HTREEITEM parent = tree_.GetParentItem(item);
  const int kind = KindOf(item);
  if (kind == kCamerasTab) {
    if (parent) return;  // cameras own no cameras
    HRCamera camera;
    const std::int32_t index = pane::IndexOf(tree_.GetItemData(item));
    if (LoadGeneralCamera(camera, index) != 0) {
      Refresh();
      return;
    }
    camera.SetFor2D(checked);
    UpdateGeneralCamera(camera, index);
    return;
  }
  if (kind != kSectionsTab && kind != kPlansTab) return;
  const bool loaded = pane::WithOwner(kind, [&](auto& owner) {
    if (owner.Load(pane::HandleOf(tree_.GetItemData(parent ? parent : item))) != 0) return false;
    if (parent) {
      owner.SetCameraFor2D(pane::IndexOf(tree_.GetItemData(item)), checked);
      return true;
    }
    // A section or plan ticks or unticks all its cameras with it. A camera that does not load
    // is left as it is rather than written over with a camera's defaults.
    owner.SetFor2D(checked);
    for (HTREEITEM child = tree_.GetChildItem(item); child; child = tree_.GetNextSiblingItem(child)) {
      const std::int32_t k = pane::IndexOf(tree_.GetItemData(child));
      HRCamera camera;
      if (owner.LoadCamera(k, camera) != 0) continue;
      camera.SetFor2D(checked);
      tree_.SetCheck(child, checked);
      owner.SaveCamera(k, camera);
    }
    owner.Save();
    return true;
  });
  if (!loaded) Refresh();
}

// A new label is kept (result 1) only when the object took the name: an empty name, a name
// its siblings already have, or an object that no longer loads leave the old label.
void CPandexDlg::OnEndLabelEdit(NMHDR* header, LRESULT* result) {
  const auto* info = reinterpret_cast<NMTVDISPINFO*>(header);
  *result = 0;
  if (info->item.pszText == nullptr) return;  // the edit was cancelled
  const std::string text = info->item.pszText;
  const HTREEITEM item = info->item.hItem;
  const HTREEITEM parent = tree_.GetParentItem(item);
  const std::vector<std::string> siblings = parent ? ChildTexts(parent) : RootTexts();
  if (text.empty() || std::find(siblings.begin(), siblings.end(), text) != siblings.end()) return;

  const int kind = KindOf(item);
  bool renamed = false;
  if (kind == kCamerasTab && !parent) {
    HRCamera camera;
    const std::int32_t index = pane::IndexOf(tree_.GetItemData(item));
    if (LoadGeneralCamera(camera, index) == 0) {
      camera.SetName(text);
      renamed = UpdateGeneralCamera(camera, index) == 0;
    } else {
      Refresh();
      return;
    }
  } else if (kind == kSectionsTab || kind == kPlansTab) {
    const bool loaded = pane::WithOwner(kind, [&](auto& owner) {
      if (owner.Load(pane::HandleOf(tree_.GetItemData(parent ? parent : item))) != 0) return false;
      if (parent) {
        const std::int32_t k = pane::IndexOf(tree_.GetItemData(item));
        HRCamera camera;
        if (owner.LoadCamera(k, camera) != 0) return false;
        owner.RenameCamera(text, k);
      } else {
        owner.SetName(text);
        owner.Save();
      }
      renamed = true;
      return true;
    });
    if (!loaded) {
      Refresh();
      return;
    }
  }
  *result = renamed ? 1 : 0;
}
