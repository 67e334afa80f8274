// Data exchange between a dialog's controls and the values its object keeps.
#pragma once

#include <string>

#include "framework/win_types.h"

class CWnd;

class CDataExchange {
 public:
  CDataExchange(CWnd* dialog, BOOL saveAndValidate) : m_pDlgWnd(dialog), m_bSaveAndValidate(saveAndValidate) {}

  CWnd* m_pDlgWnd;
  BOOL m_bSaveAndValidate;  // TRUE: controls to values; FALSE: values to controls

  // The control of an id for the next exchange; null (and the exchange fails) when the dialog
  // has no such control.
  HWND PrepareCtrl(int id);
  // Ends the exchange: the control last prepared gets the focus and later exchanges do nothing.
  void Fail();
  bool Failed() const { return failed_; }

 private:
  HWND lastControl_;
  bool failed_ = false;
};

// Binds a control object to the dialog's control of that id (it takes over the window).
void DDX_Control(CDataExchange* dx, int id, CWnd& control);
void DDX_Text(CDataExchange* dx, int id, std::string& value);
// Numbers: a text that is not wholly a number refuses the exchange with a message box, so a
// value is never silently replaced by 0.
void DDX_Text(CDataExchange* dx, int id, int& value);
void DDX_Text(CDataExchange* dx, int id, double& value);
void DDX_Text(CDataExchange* dx, int id, float& value);
void DDX_Check(CDataExchange* dx, int id, int& value);
