// A window that answers messages by number.
#pragma once

#include "framework/win_types.h"

class CWnd {
 public:
  CWnd() = default;
  CWnd(const CWnd&) = delete;
  CWnd& operator=(const CWnd&) = delete;
  virtual ~CWnd() = default;

  // Delivers a message at once and answers the window's result; a plain window answers 0.
  virtual LRESULT SendMessage(UINT message, WPARAM wParam, LPARAM lParam);
};

// Message numbers the library sends.
constexpr UINT TCM_SETCURSEL = 4876;
