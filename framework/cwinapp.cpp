// Keeps track of the one application object a loaded library has, and of the host's main window.
#include "framework/cwinapp.h"

#include "framework/resource_module.h"

namespace {
CWinApp* currentApp = nullptr;
HWND hostMainWindow;
}  // namespace

CWinApp::CWinApp() { currentApp = this; }

CWinApp::~CWinApp() {
  if (currentApp == this) currentApp = nullptr;
}

CWinApp* CWinApp::Current() { return currentApp; }

CWinApp* AfxGetApp() { return currentApp; }

CWnd* AfxGetMainWnd() {
  if (::IsWindow(hostMainWindow)) return CWnd::FromHandle(hostMainWindow);
  return currentApp != nullptr ? currentApp->m_pMainWnd : nullptr;
}

namespace framework {

void SetHostMainWindow(HWND hwnd) { hostMainWindow = hwnd; }

}  // namespace framework
