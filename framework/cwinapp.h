// The library's application object and the main window its windows are parented to.
#pragma once

#include <string>

#include "framework/cwnd.h"
#include "framework/resource_module.h"

class CWinApp : public CCmdTarget {
 public:
  CWinApp();
  ~CWinApp() override;

  // The application object of the loaded library, or null.
  static CWinApp* Current();

  HICON LoadIcon(UINT id) const { return AfxLoadIcon(id); }

  // The application's own main window, when it has one; a library inside a host has none.
  CWnd* m_pMainWnd = nullptr;
};

CWinApp* AfxGetApp();

// The main window of the user-interface thread: the host's main window when the host gave one,
// else the application's own, else null.
CWnd* AfxGetMainWnd();

namespace framework {

// The host names its main window (null when it closes it).
void SetHostMainWindow(HWND hwnd);

}  // namespace framework
