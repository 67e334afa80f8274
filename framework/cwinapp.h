// Base of the library's application object; the UI layer finds the running one through it.
#pragma once

class CWnd;

class CWinApp {
 public:
  CWinApp();
  CWinApp(const CWinApp&) = delete;
  CWinApp& operator=(const CWinApp&) = delete;
  virtual ~CWinApp();

  // The application object of the loaded library, or null.
  static CWinApp* Current();
};

// The main window of the current thread: null while the host has given the library none.
CWnd* AfxGetMainWnd();
