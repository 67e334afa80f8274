// The docked manager pane: the operations the library's entry starts. Layout, tree and
// commands fill these in; until then each is a named, empty hook.
#pragma once

#include "framework/cwnd.h"
#include "shell/host/host_types.h"

class CPandexDlg : public CWnd {
 public:
  static constexpr int IDD = 5000;  // dialog template of the pane

  // Creates the modeless pane window from its template; answers whether a window exists.
  virtual bool Create(int templateId, CWnd* parent);
  // Shows (docked, host told the manager is on) or hides the pane.
  virtual void ShowPane(bool show);
  virtual void CreateSection(const host::Point3f& start, const host::Point3f& end);
  virtual void CreatePlan(const host::Point3f& base, const host::Point3f& second);
  virtual void CreateCamera();
  virtual void Refresh();
  // The icon tab control (cameras, sections, plans); null while the pane has no window.
  virtual CWnd* TabControl();
};
