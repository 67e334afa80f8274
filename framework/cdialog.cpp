// The dialog object: template lookup, modeless creation, the modal run and OK/Cancel.
#include "framework/cdialog.h"

#include "framework/cwinapp.h"
#include "framework/resource_module.h"

BEGIN_MESSAGE_MAP(CDialog, CWnd)
ON_MESSAGE(WM_INITDIALOG, HandleInitDialog)
ON_COMMAND(IDOK, OnOK)
ON_COMMAND(IDCANCEL, OnCancel)
END_MESSAGE_MAP()

CDialog::CDialog(UINT templateId, CWnd* parent) : m_pParentWnd(parent), templateId_(templateId) {}

CDialog::CDialog(const DialogTemplate& dialogTemplate, CWnd* parent)
    : m_pParentWnd(parent), template_(&dialogTemplate) {}

const DialogTemplate* CDialog::FindTemplate() const {
  return template_ != nullptr ? template_ : AfxFindDialogTemplate(templateId_);
}

BOOL CDialog::CreateFrom(const DialogTemplate& dialogTemplate, HWND parentOrOwner) {
  if (m_hWnd) return FALSE;
  return framework::CreateDialogWindow(dialogTemplate, parentOrOwner, this) ? TRUE : FALSE;
}

BOOL CDialog::Create(UINT templateId, CWnd* parent) {
  templateId_ = templateId;
  template_ = nullptr;
  m_pParentWnd = parent;
  const DialogTemplate* found = FindTemplate();
  return found != nullptr ? CreateFrom(*found, parent != nullptr ? parent->m_hWnd : HWND()) : FALSE;
}

BOOL CDialog::CreateIndirect(const DialogTemplate& dialogTemplate, CWnd* parent) {
  template_ = &dialogTemplate;
  m_pParentWnd = parent;
  return CreateFrom(dialogTemplate, parent != nullptr ? parent->m_hWnd : HWND());
}

INT_PTR CDialog::DoModal() {
  const DialogTemplate* found = FindTemplate();
  if (found == nullptr || m_hWnd) return -1;
  // The owner is the top-level window of the parent, else the main window.
  CWnd* parent = m_pParentWnd != nullptr ? m_pParentWnd : AfxGetMainWnd();
  const HWND owner = parent != nullptr ? framework::GetTopLevelWindow(parent->m_hWnd) : HWND();
  const HWND focusBefore = ::GetFocus();
  const bool disableOwner = ::IsWindow(owner) && ::IsWindowEnabled(owner);
  if (disableOwner) ::EnableWindow(owner, FALSE);

  modal_ = true;
  continueModal_ = true;
  modalResult_ = -1;
  DialogTemplate modalTemplate = *found;
  modalTemplate.style &= ~WS_CHILD;  // a modal dialog is a window of its own
  if (CreateFrom(modalTemplate, owner)) {
    if (continueModal_) {
      ShowWindow(SW_SHOWNORMAL);
      const HWND self = m_hWnd;
      const bool answered =
          framework::RunModalLoop(self, [this, self] { return !continueModal_ || !::IsWindow(self); });
      if (!answered && continueModal_) modalResult_ = IDCANCEL;
    }
    if (::IsWindow(m_hWnd)) ShowWindow(SW_HIDE);
  }
  if (disableOwner) ::EnableWindow(owner, TRUE);
  if (::IsWindow(owner) && (!::GetActiveWindow() || ::GetActiveWindow() == m_hWnd)) ::SetActiveWindow(owner);
  if (::IsWindow(m_hWnd)) DestroyWindow();
  if (::IsWindow(focusBefore)) ::SetFocus(focusBefore);
  modal_ = false;
  return modalResult_;
}

void CDialog::EndDialog(int result) {
  if (modal_) {
    modalResult_ = result;
    continueModal_ = false;
  } else if (m_hWnd) {
    ShowWindow(SW_HIDE);
  }
}

LRESULT CDialog::HandleInitDialog(WPARAM, LPARAM) { return OnInitDialog(); }

BOOL CDialog::OnInitDialog() {
  UpdateData(FALSE);
  return TRUE;
}

void CDialog::OnOK() {
  if (!UpdateData(TRUE)) return;
  EndDialog(IDOK);
}

void CDialog::OnCancel() { EndDialog(IDCANCEL); }

BOOL CDialog::PreTranslateMessage(MSG* msg) {
  const bool keyboard = msg->message == WM_KEYDOWN || msg->message == WM_KEYUP || msg->message == WM_CHAR;
  return keyboard && ::IsDialogMessage(m_hWnd, msg);
}

void CDialog::NextDlgCtrl() const { ::SendMessage(m_hWnd, WM_NEXTDLGCTL, 0, 0); }
void CDialog::PrevDlgCtrl() const { ::SendMessage(m_hWnd, WM_NEXTDLGCTL, 1, 0); }

void CDialog::GotoDlgCtrl(CWnd* control) {
  if (control != nullptr) ::SendMessage(m_hWnd, WM_NEXTDLGCTL, control->m_hWnd.ToWParam(), TRUE);
}

DWORD CDialog::GetDefID() const { return static_cast<DWORD>(::SendMessage(m_hWnd, DM_GETDEFID, 0, 0)); }
void CDialog::SetDefID(UINT id) { ::SendMessage(m_hWnd, DM_SETDEFID, id, 0); }
