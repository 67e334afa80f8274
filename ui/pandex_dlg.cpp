// Hooks of the manager pane that the entry calls; the pane's own layout and commands replace
// their bodies.
#include "ui/pandex_dlg.h"

bool CPandexDlg::Create(int, CWnd*) { return false; }
void CPandexDlg::ShowPane(bool) {}
void CPandexDlg::CreateSection(const host::Point3f&, const host::Point3f&) {}
void CPandexDlg::CreatePlan(const host::Point3f&, const host::Point3f&) {}
void CPandexDlg::CreateCamera() {}
void CPandexDlg::Refresh() {}
CWnd* CPandexDlg::TabControl() { return nullptr; }
