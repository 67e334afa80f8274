// Creation of the manager pane: the pointer is kept before the window exists, and kept even
// when the window cannot be made, so a pane is never created twice.
#include "shell/pane_instance.h"

#include "framework/cwinapp.h"
#include "ui/pandex_dlg.h"

namespace pandex {
namespace {

std::unique_ptr<CPandexDlg> pane;

PaneFactory& Factory() {
  static PaneFactory factory;
  return factory;
}

std::unique_ptr<CPandexDlg> MakeDefaultPane() { return std::make_unique<CPandexDlg>(); }

}  // namespace

CPandexDlg* GetPane() { return pane.get(); }

CPandexDlg* EnsurePane() {
  if (pane) return pane.get();
  pane = Factory() ? Factory()() : MakeDefaultPane();
  if (!pane) return nullptr;
  CWnd* parent = CWinApp::Current() != nullptr ? AfxGetMainWnd() : nullptr;
  pane->Create(CPandexDlg::IDD, parent);
  return pane.get();
}

void SetPaneFactory(PaneFactory factory) { Factory() = std::move(factory); }

void ReleasePane(CPandexDlg* released) {
  if (released == pane.get()) pane.reset();
}

void DestroyPane() { pane.reset(); }

}  // namespace pandex
