// Dialogs made from templates: modeless (Create) or modal (DoModal, a real modal loop that ends
// on EndDialog), with OK and Cancel, Enter and Escape, Tab between controls and data exchange.
#pragma once

#include "framework/cwnd.h"
#include "framework/dialog_template.h"

class CDialog : public CWnd {
 public:
  CDialog() = default;
  explicit CDialog(UINT templateId, CWnd* parent = nullptr);
  // A dialog whose template is made in code (it must outlive the dialog's window).
  CDialog(const DialogTemplate& dialogTemplate, CWnd* parent);

  // Modeless: creates the window from the template; false when the template or a control class
  // is missing, or a child dialog has no parent.
  BOOL Create(UINT templateId, CWnd* parent = nullptr);
  BOOL CreateIndirect(const DialogTemplate& dialogTemplate, CWnd* parent = nullptr);

  // Modal: disables the owner, runs messages until EndDialog, destroys the window and answers
  // the result (IDOK, IDCANCEL, ...); -1 when the window could not be made. When no one is
  // there to answer (no input source, or it has no more input) the run ends with IDCANCEL.
  virtual INT_PTR DoModal();
  // Ends a modal run with the result; hides a modeless dialog.
  void EndDialog(int result);

  virtual BOOL OnInitDialog();
  virtual void OnOK();
  virtual void OnCancel();

  BOOL PreTranslateMessage(MSG* msg) override;

  void NextDlgCtrl() const;
  void PrevDlgCtrl() const;
  void GotoDlgCtrl(CWnd* control);
  // The default button's id (DM_GETDEFID) and setting it.
  DWORD GetDefID() const;
  void SetDefID(UINT id);

 protected:
  CWnd* m_pParentWnd = nullptr;

  LRESULT HandleInitDialog(WPARAM wParam, LPARAM lParam);

  DECLARE_MESSAGE_MAP()

 private:
  const DialogTemplate* FindTemplate() const;
  BOOL CreateFrom(const DialogTemplate& dialogTemplate, HWND parentOrOwner);

  UINT templateId_ = 0;
  const DialogTemplate* template_ = nullptr;
  bool modal_ = false;
  bool continueModal_ = false;
  int modalResult_ = -1;
};

// Dialog keyboard handling for messages of a dialog's controls: Tab moves between tab stops,
// Enter runs the focused push button or the default button, Escape runs IDCANCEL; keys the
// focused control asks for (WM_GETDLGCODE) reach it. Answers whether the message was the
// dialog's (it has then been dispatched).
BOOL IsDialogMessage(HWND dialog, MSG* msg);

namespace framework {

// Creates a dialog window and its controls from a template; `attach` gets the dialog window
// before its first message. Sends WM_INITDIALOG and sets the first focus.
HWND CreateDialogWindow(const DialogTemplate& dialogTemplate, HWND parentOrOwner, CWnd* attach,
                        LPARAM initParam = 0);

}  // namespace framework
