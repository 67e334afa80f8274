// Keeps track of the one application object a loaded library has.
#include "framework/cwinapp.h"

namespace {
CWinApp* currentApp = nullptr;
}

CWinApp::CWinApp() { currentApp = this; }

CWinApp::~CWinApp() {
  if (currentApp == this) currentApp = nullptr;
}

CWinApp* CWinApp::Current() { return currentApp; }

CWnd* AfxGetMainWnd() { return nullptr; }
