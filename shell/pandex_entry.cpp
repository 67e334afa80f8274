// The exported entry: reads the sub-command from globi[0] and starts its operation.
#include <cmath>
#include <limits>
#include <memory>
#include <optional>

#include "framework/resource_module.h"
#include "model/current_database.h"
#include "resources/resource_module.h"
#include "shell/host/argument_blocks.h"
#include "shell/host_messages.h"
#include "shell/pandex_app.h"
#include "shell/pane_instance.h"
#include "shell/plugin_exports.h"
#include "ui/pandex_dlg.h"
#include "views/hr_camera_mgr.h"
#include "views/section_symbols.h"

namespace {

enum SubCommand : std::int32_t {
  kShowPane = 1,
  kAddSection = 2,
  kShowAllSectionSymbols = 3,
  kAddPlan = 4,
  kHidePane = 5,
  kAddCamera = 6,
  kSelectTab = 7,
  kRefresh = 8,
};

std::unique_ptr<CPandexApp> application;

// Tabs are counted from 1 by the host; the tab control counts from 0. A value that has no
// integer form (NaN, out of range) selects nothing rather than an arbitrary tab.
std::optional<WPARAM> TabIndexFromHost(float tabNumber) {
  const float shifted = tabNumber - 0.5F;
  if (!std::isfinite(shifted) || std::fabs(shifted) >= 2147483648.0F) return std::nullopt;
  return static_cast<WPARAM>(static_cast<std::int32_t>(shifted));
}

void SelectTab(CPandexDlg& pane) {
  const std::optional<WPARAM> index = TabIndexFromHost(globr[0]);
  CWnd* tabs = pane.TabControl();
  if (index && tabs != nullptr) tabs->SendMessage(TCM_SETCURSEL, *index, 0);
}

}  // namespace

CPandexApp* TheApp() { return application.get(); }

namespace pandex {

void LibraryAttach() {
  framework::SetResourceModule(&resources::Module());
  application = std::make_unique<CPandexApp>();
  CreateCameraManager();
  SetCurrentDatabase(db.handle);
  SectionsShown = 0;
  RegisterHostMessages();
}

void LibraryDetach() {
  DestroyPane();
  SetPaneFactory(nullptr);
  DestroyCameraManager();
  SetCurrentDatabase(0);
  application.reset();
  framework::SetResourceModule(nullptr);
}

}  // namespace pandex

namespace {

void Dispatch(std::int32_t subCommand) {
  using pandex::EnsurePane;
  using pandex::GetPane;
  switch (subCommand) {
    case kShowPane:
      if (CPandexDlg* pane = EnsurePane()) pane->ShowPane(true);
      break;
    case kAddSection:
      if (CPandexDlg* pane = EnsurePane()) pane->CreateSection(globp[0], globp[1]);
      break;
    case kShowAllSectionSymbols:
      if (GetPane() != nullptr) ShowSectionSymbols();
      break;
    case kAddPlan:
      if (CPandexDlg* pane = EnsurePane()) pane->CreatePlan(globp[0], globp[1]);
      break;
    case kHidePane:
      if (CPandexDlg* pane = GetPane()) pane->ShowPane(false);
      break;
    case kAddCamera:
      if (CPandexDlg* pane = EnsurePane()) pane->CreateCamera();
      break;
    case kSelectTab:
      if (CPandexDlg* pane = EnsurePane()) SelectTab(*pane);
      break;
    case kRefresh:
      if (CPandexDlg* pane = GetPane()) pane->Refresh();
      break;
    default:
      break;
  }
}

}  // namespace

void Pandex() {
  // An exception cannot unwind into the host, which may be built by another compiler: an
  // operation that fails this way is abandoned and the host carries on.
  try {
    Dispatch(globi[0]);
  } catch (...) {
  }
}
