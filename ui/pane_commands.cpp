// What the pane's buttons and the host's sub-commands do: add, remove, update and execute
// cameras, sections and plans, and reload the drawing.
#include <algorithm>
#include <array>
#include <string>

#include "display/display_mode.h"
#include "framework/message_box.h"
#include "framework/resource_module.h"
#include "resources/string_table.h"
#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll.h"
#include "shell/pandex_app.h"
#include "ui/default_name.h"
#include "ui/pandex_dlg.h"
#include "ui/pane_objects.h"
#include "views/hr_camera.h"
#include "views/hr_camera_mgr.h"

namespace {

constexpr UINT kCameraWord = 4;
constexpr UINT kSectionWord = 5;
constexpr UINT kPlanWord = 8;  // "Hsection ", with its trailing space

// How often "Add new" switches the display to Geometric before it gives up: one switch is
// enough in any state the host can be brought out of; a display that stays refuses for good.
constexpr int kGeometricAttempts = 3;

// A new section or plan is picked in plain geometry.
bool SectionReady() { return globc[26] == 'w' && globc[32] != 'a' && globc[32] != 'r'; }

void RefuseMode() { AfxMessageBox(resources::kIdsModeRefused, MB_OK, 0); }

}  // namespace

void CPandexDlg::CreateCamera() {
  if (!m_hWnd) return;
  // The name must be new among the cameras, so they are what the tree shows.
  ShowTab(kCamerasTab);
  HRCamera camera;
  camera.CaptureView();
  camera.SetName(pane::DefaultName(AfxLoadString(kCameraWord), GetGeneralCameraCount(), RootTexts()));
  camera.SetShowSections(0);
  camera.SetAutoClip(0);
  camera.SetOverwrite2D(0);
  camera.SetRemoveCoincident(0);
  camera.SetLineMerge(0);
  const std::int32_t index = AddGeneralCamera(camera);
  if (index < 0) return;  // not stored: nothing to show
  InsertObject(camera.GetName(), kCamerasTab, pane::ItemData(index), false);
}

void CPandexDlg::CreateSection(const host::Point3f& start, const host::Point3f& end) {
  if (!m_hWnd) return;
  ShowTab(kSectionsTab);
  const std::string name =
      pane::DefaultName(AfxLoadString(kSectionWord), static_cast<std::int32_t>(sectionHandles_.size()), RootTexts());
  SectionSettings settings;
  std::copy_n(std::array{start.x, start.y, start.z}.begin(), 3, settings.start);
  std::copy_n(std::array{end.x, end.y, end.z}.begin(), 3, settings.end);
  const CPandexApp* app = TheApp();
  settings.symbolFile = app->symbolFile;
  settings.lineType = static_cast<std::uint16_t>(app->lineType);
  settings.lineWidth = static_cast<std::uint16_t>(app->lineWidth);
  settings.lineColor = static_cast<std::uint16_t>(app->lineColor);
  settings.cutType = HRSection::kCutByColor;

  HRSection section;
  section.SetName(name);
  section.SetSettings(settings);
  section.Create();
  section.ShowView(-1);
  section.AddCamera(AfxLoadString(resources::kIdsDefaultCamera));
  FillSectionTree();
}

void CPandexDlg::CreatePlan(const host::Point3f& base, const host::Point3f& second) {
  if (!m_hWnd) return;
  ShowTab(kPlansTab);
  const std::string name =
      pane::DefaultName(AfxLoadString(kPlanWord), static_cast<std::int32_t>(planHandles_.size()), RootTexts());
  HRPlane plan;
  const float from[3] = {base.x, base.y, base.z};
  const float towards[3] = {second.x, second.y, second.z};
  plan.DefineFromPoints(name, from, towards);
  plan.Create();
  plan.ShowView(-1);
  plan.AddCamera(AfxLoadString(resources::kIdsDefaultCamera));
  FillPlanTree();
}

// On the sections and plans tabs the host asks the user for two points and comes back with
// sub-command 2 or 4. A display that stays out of plain geometry would make this ask for the
// switch forever: after a few attempts the user is told instead.
void CPandexDlg::OnAddNew() {
  for (int attempt = 0;; ++attempt) {
    const int tab = SelectedTab();
    if (tab == kCamerasTab) {
      if (HRUtility::IsModeAcceptable()) {
        CreateCamera();
      } else {
        RefuseMode();
      }
      return;
    }
    if (tab != kSectionsTab && tab != kPlansTab) return;
    if (SectionReady()) {
      CommandMessage(tab == kSectionsTab ? "/3secadd" : "/3planead");
      return;
    }
    if (attempt == kGeometricAttempts) {
      RefuseMode();
      return;
    }
    HRUtility::SetDisplayMode(HRUtility::kGeometric);
  }
}

void CPandexDlg::OnRemove() {
  const HTREEITEM item = tree_.GetSelectedItem();
  if (!item || !ShowsSelectedTab(item)) return;
  const int tab = SelectedTab();
  if (tab == kCamerasTab) {
    RemoveGeneralCamera(pane::IndexOf(tree_.GetItemData(item)));
    FillCameraTree();
    return;
  }
  const HTREEITEM parent = tree_.GetParentItem(item);
  pane::WithOwner(tab, [&](auto& owner) {
    if (parent) {
      if (owner.Load(pane::HandleOf(tree_.GetItemData(parent))) == 0) {
        owner.RemoveCamera(pane::IndexOf(tree_.GetItemData(item)));
        tree_.DeleteItem(item);
      }
    } else if (owner.Load(pane::HandleOf(tree_.GetItemData(item))) == 0) {
      owner.Delete();
      tree_.DeleteItem(item);
    }
    return 0;
  });
  if (tab == kSectionsTab) {
    FillSectionTree();
  } else {
    FillPlanTree();
  }
}

// A camera that does not load (changed behind the pane) is not written over with what little
// was read of it: the pane reloads instead.
void CPandexDlg::OnUpdateCamera() {
  const HTREEITEM item = tree_.GetSelectedItem();
  if (!item || !ShowsSelectedTab(item)) return;
  const int tab = SelectedTab();
  HRCamera camera;
  if (tab == kCamerasTab) {
    const std::int32_t index = pane::IndexOf(tree_.GetItemData(item));
    if (LoadGeneralCamera(camera, index) != 0) {
      Refresh();
      return;
    }
    camera.UpdateView();
    UpdateGeneralCamera(camera, index);
    return;
  }
  const HTREEITEM parent = tree_.GetParentItem(item);
  if (!parent) return;
  const bool updated = pane::WithOwner(tab, [&](auto& owner) {
    const std::int32_t k = pane::IndexOf(tree_.GetItemData(item));
    if (owner.Load(pane::HandleOf(tree_.GetItemData(parent))) != 0 || owner.LoadCamera(k, camera) != 0) return false;
    camera.UpdateView();
    owner.SaveCamera(k, camera);
    return true;
  });
  if (!updated) Refresh();
}

void CPandexDlg::OnExecute() {
  const HTREEITEM item = tree_.GetSelectedItem();
  if (!item || !ShowsSelectedTab(item)) return;
  const int tab = SelectedTab();
  if (tab == kCamerasTab) {
    HRCamera camera;
    if (LoadGeneralCamera(camera, pane::IndexOf(tree_.GetItemData(item))) == 0) camera.Execute(TheApp());
    return;
  }
  const HTREEITEM parent = tree_.GetParentItem(item);
  if (!parent) return;
  pane::WithOwner(tab, [&](auto& owner) {
    if (owner.Load(pane::HandleOf(tree_.GetItemData(parent))) == 0) {
      pane::ShowOwnerView(owner, pane::IndexOf(tree_.GetItemData(item)));
    }
    return 0;
  });
}

void CPandexDlg::OnAddCameraView() {
  const int tab = SelectedTab();
  if (tab != kSectionsTab && tab != kPlansTab) return;
  if (!HRUtility::IsModeAcceptable()) {
    RefuseMode();
    return;
  }
  const HTREEITEM item = tree_.GetSelectedItem();
  if (!item || tree_.GetParentItem(item) || !ShowsSelectedTab(item)) return;
  pane::WithOwner(tab, [&](auto& owner) {
    // A section or plan that no longer loads would get a camera it does not list.
    if (owner.Load(pane::HandleOf(tree_.GetItemData(item))) != 0) {
      Refresh();
      return 0;
    }
    const std::string name = pane::DefaultName(AfxLoadString(kCameraWord), owner.GetCameraCount(), ChildTexts(item));
    const std::int16_t before = owner.GetCameraCount();
    const std::int32_t k = owner.AddCamera(name);
    // AddCamera answers 0 for a failure too: only a longer camera list means a new camera.
    if (owner.GetCameraCount() != before + 1) return 0;
    HRCamera camera;
    owner.LoadCamera(k, camera);
    const HTREEITEM child = InsertObject(camera.GetName(), kCamerasTab, pane::ItemData(k), false, item);
    tree_.EnsureVisible(child);
    return 0;
  });
}

void CPandexDlg::Refresh() {
  if (!m_hWnd) return;
  SetDatabase(db.handle);
  switch (SelectedTab()) {
    case kCamerasTab:
      FillCameraTree();
      break;
    case kSectionsTab:
      FillSectionTree();
      break;
    case kPlansTab:
      FillPlanTree();
      break;
    default:
      break;
  }
}
