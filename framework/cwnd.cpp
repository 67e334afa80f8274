// Message routing of the framework's window object: reflection, maps, standard handlers.
#include "framework/cwnd.h"

#include <map>
#include <memory>
#include <vector>

#include "framework/data_exchange.h"
#include "framework/message_box.h"
#include "framework/resource_module.h"
#include "framework/window_table.h"

namespace {

struct CurrentMessage {
  UINT message = 0;
  WPARAM wParam = 0;
  LPARAM lParam = 0;
};

// The messages being handled, innermost last; kept outside the objects because a handler may
// destroy (and delete) the object it runs in.
std::vector<CurrentMessage>& MessageStack() {
  static std::vector<CurrentMessage> stack;
  return stack;
}

// Wrappers for windows that have no object of their own; each lives as long as its window.
std::map<std::uint32_t, std::unique_ptr<CWnd>>& Temporaries() {
  static std::map<std::uint32_t, std::unique_ptr<CWnd>> temporaries;
  return temporaries;
}

CPoint MousePoint(LPARAM lParam) { return {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)}; }

bool IsNotifyKind(UINT message) {
  return message == WM_COMMAND || message == WM_NOTIFY || message == WM_REFLECT_BASE + WM_COMMAND ||
         message == WM_REFLECT_BASE + WM_NOTIFY;
}

}  // namespace

const framework::MessageMap* CCmdTarget::GetThisMessageMap() {
  static const framework::MessageMap map{nullptr, {}};
  return &map;
}

const framework::MessageMap* CCmdTarget::GetMessageMap() const { return GetThisMessageMap(); }

bool CCmdTarget::DispatchToMap(UINT message, UINT code, UINT id, bool anyId, WPARAM wParam, LPARAM lParam,
                               LRESULT& result) {
  for (const framework::MessageMap* map = GetMessageMap(); map != nullptr; map = map->base) {
    for (const framework::MessageMapEntry& entry : map->entries) {
      if (!entry.MatchesMessage(message)) continue;
      if (IsNotifyKind(message) && (entry.code != code || (!anyId && (id < entry.idFirst || id > entry.idLast)))) {
        continue;
      }
      if (entry.invoke(*this, wParam, lParam, result)) return true;
    }
  }
  return false;
}

BEGIN_MESSAGE_MAP(CWnd, CCmdTarget)
END_MESSAGE_MAP()

CWnd::~CWnd() {
  if (m_hWnd && owned_ && framework::GetAttachedObject(m_hWnd) == this) {
    // The object is half gone: its window is destroyed with the class's default handling only.
    framework::AttachObject(m_hWnd, nullptr);
    ::DestroyWindow(m_hWnd);
  }
}

CWnd* CWnd::FromHandlePermanent(HWND hwnd) {
  return dynamic_cast<CWnd*>(framework::GetAttachedObject(hwnd));
}

CWnd* CWnd::FromHandle(HWND hwnd) {
  if (!::IsWindow(hwnd)) return nullptr;
  if (CWnd* permanent = FromHandlePermanent(hwnd)) return permanent;
  auto& temporaries = Temporaries();
  std::erase_if(temporaries, [](const auto& entry) { return !::IsWindow(entry.second->m_hWnd); });
  auto& slot = temporaries[hwnd.Value()];
  if (!slot) {
    slot = std::make_unique<CWnd>();
    slot->m_hWnd = hwnd;
  }
  return slot.get();
}

BOOL CWnd::Create(std::string_view className, std::string_view text, DWORD style, const RECT& rect, CWnd* parent,
                  UINT id) {
  return CreateEx(0, className, text, style, rect, parent, id);
}

BOOL CWnd::CreateEx(DWORD exStyle, std::string_view className, std::string_view text, DWORD style, const RECT& rect,
                    CWnd* parent, UINT id, LPARAM createParam) {
  const std::string classCopy(className);
  const std::string textCopy(text);
  const CRect r(rect);
  CREATESTRUCT cs{createParam, static_cast<int>(id), parent != nullptr ? parent->m_hWnd : HWND(), r.Height(),
                  r.Width(), r.top, r.left, style, textCopy.c_str(), classCopy.c_str(), exStyle};
  if (!PreCreateWindow(cs)) return FALSE;
  owned_ = true;
  framework::AttachToNextWindow(this);
  const HWND hwnd = ::CreateWindowEx(cs.dwExStyle, cs.lpszClass, cs.lpszName, cs.style, cs.x, cs.y, cs.cx, cs.cy,
                                     cs.hwndParent, cs.id, cs.lpCreateParams);
  if (!hwnd) {
    owned_ = false;
    m_hWnd = HWND();
    return FALSE;
  }
  m_hWnd = hwnd;
  return TRUE;
}

BOOL CWnd::DestroyWindow() { return ::DestroyWindow(m_hWnd); }

BOOL CWnd::SubclassWindow(HWND hwnd) {
  if (!::IsWindow(hwnd) || framework::GetAttachedObject(hwnd) != nullptr || m_hWnd) return FALSE;
  m_hWnd = hwnd;
  owned_ = true;
  PreSubclassWindow();
  framework::AttachObject(hwnd, this);
  return TRUE;
}

BOOL CWnd::SubclassDlgItem(UINT id, CWnd* parent) {
  return parent != nullptr && SubclassWindow(::GetDlgItem(parent->m_hWnd, static_cast<int>(id)));
}

HWND CWnd::UnsubclassWindow() {
  const HWND hwnd = m_hWnd;
  if (framework::GetAttachedObject(hwnd) == this) framework::AttachObject(hwnd, nullptr);
  m_hWnd = HWND();
  owned_ = false;
  return hwnd;
}

LRESULT CWnd::SendMessage(UINT message, WPARAM wParam, LPARAM lParam) const {
  return ::SendMessage(m_hWnd, message, wParam, lParam);
}

BOOL CWnd::PostMessage(UINT message, WPARAM wParam, LPARAM lParam) const {
  return ::PostMessage(m_hWnd, message, wParam, lParam);
}

LRESULT CWnd::SendDlgItemMessage(int id, UINT message, WPARAM wParam, LPARAM lParam) const {
  return ::SendDlgItemMessage(m_hWnd, id, message, wParam, lParam);
}

CWnd* CWnd::GetParent() const { return FromHandle(::GetParent(m_hWnd)); }
CWnd* CWnd::GetDlgItem(int id) const { return FromHandle(::GetDlgItem(m_hWnd, id)); }
int CWnd::GetDlgCtrlID() const { return ::GetDlgCtrlID(m_hWnd); }
CWnd* CWnd::GetTopLevelParent() const { return FromHandle(framework::GetTopLevelWindow(m_hWnd)); }
CWnd* CWnd::GetWindow(UINT relation) const { return FromHandle(::GetWindow(m_hWnd, relation)); }
BOOL CWnd::IsChild(const CWnd* wnd) const { return wnd != nullptr && ::IsChild(m_hWnd, wnd->m_hWnd); }

void CWnd::SetWindowText(std::string_view text) { ::SetWindowText(m_hWnd, text); }
std::string CWnd::GetWindowText() const { return ::GetWindowText(m_hWnd); }
int CWnd::GetWindowTextLength() const { return ::GetWindowTextLength(m_hWnd); }
void CWnd::SetDlgItemText(int id, std::string_view text) { ::SetDlgItemText(m_hWnd, id, text); }
std::string CWnd::GetDlgItemText(int id) const { return ::GetDlgItemText(m_hWnd, id); }

void CWnd::CheckDlgButton(int id, UINT check) { SendDlgItemMessage(id, BM_SETCHECK, check, 0); }

UINT CWnd::IsDlgButtonChecked(int id) const { return static_cast<UINT>(SendDlgItemMessage(id, BM_GETCHECK, 0, 0)); }

DWORD CWnd::GetStyle() const { return ::GetWindowStyle(m_hWnd); }
DWORD CWnd::GetExStyle() const { return ::GetWindowExStyle(m_hWnd); }

BOOL CWnd::ModifyStyle(DWORD remove, DWORD add, UINT) {
  if (!::IsWindow(m_hWnd)) return FALSE;
  ::SetWindowStyle(m_hWnd, (GetStyle() & ~remove) | add);
  return TRUE;
}

BOOL CWnd::ModifyStyleEx(DWORD remove, DWORD add, UINT) {
  if (!::IsWindow(m_hWnd)) return FALSE;
  ::SetWindowExStyle(m_hWnd, (GetExStyle() & ~remove) | add);
  return TRUE;
}

void CWnd::GetWindowRect(RECT* rect) const { ::GetWindowRect(m_hWnd, rect); }
void CWnd::GetClientRect(RECT* rect) const { ::GetClientRect(m_hWnd, rect); }
void CWnd::ClientToScreen(POINT* point) const { ::ClientToScreen(m_hWnd, point); }
void CWnd::ScreenToClient(POINT* point) const { ::ScreenToClient(m_hWnd, point); }

void CWnd::ClientToScreen(RECT* rect) const {
  ::MapWindowPoints(m_hWnd, HWND(), reinterpret_cast<POINT*>(rect), 2);
}

void CWnd::ScreenToClient(RECT* rect) const {
  ::MapWindowPoints(HWND(), m_hWnd, reinterpret_cast<POINT*>(rect), 2);
}

void CWnd::MapWindowPoints(const CWnd* to, RECT* rect) const {
  ::MapWindowPoints(m_hWnd, to != nullptr ? to->m_hWnd : HWND(), reinterpret_cast<POINT*>(rect), 2);
}

void CWnd::MoveWindow(int x, int y, int width, int height, BOOL repaint) {
  ::MoveWindow(m_hWnd, x, y, width, height, repaint);
}

void CWnd::MoveWindow(const RECT& rect, BOOL repaint) {
  MoveWindow(rect.left, rect.top, rect.right - rect.left, rect.bottom - rect.top, repaint);
}

BOOL CWnd::SetWindowPos(int x, int y, int width, int height, UINT flags) {
  return ::SetWindowPos(m_hWnd, x, y, width, height, flags);
}

BOOL CWnd::ShowWindow(int command) { return ::ShowWindow(m_hWnd, command); }
BOOL CWnd::IsWindowVisible() const { return ::IsWindowVisible(m_hWnd); }
BOOL CWnd::EnableWindow(BOOL enable) { return ::EnableWindow(m_hWnd, enable); }
BOOL CWnd::IsWindowEnabled() const { return ::IsWindowEnabled(m_hWnd); }
void CWnd::Invalidate(BOOL erase) { ::InvalidateRect(m_hWnd, nullptr, erase); }
void CWnd::InvalidateRect(const RECT* rect, BOOL erase) { ::InvalidateRect(m_hWnd, rect, erase); }
BOOL CWnd::RedrawWindow(const RECT* rect, UINT flags) { return ::RedrawWindow(m_hWnd, rect, flags); }
void CWnd::UpdateWindow() { ::UpdateWindow(m_hWnd); }

CWnd* CWnd::SetFocus() { return FromHandle(::SetFocus(m_hWnd)); }
CWnd* CWnd::GetFocus() { return FromHandle(::GetFocus()); }
CWnd* CWnd::SetCapture() { return FromHandle(::SetCapture(m_hWnd)); }
CWnd* CWnd::GetCapture() { return FromHandle(::GetCapture()); }

UINT_PTR CWnd::SetTimer(UINT_PTR id, UINT elapseMs) { return ::SetTimer(m_hWnd, id, elapseMs); }
BOOL CWnd::KillTimer(UINT_PTR id) { return ::KillTimer(m_hWnd, id); }

int CWnd::MessageBox(std::string_view text, std::string_view caption, UINT type) {
  return ::MessageBox(m_hWnd, text, caption.empty() ? framework::ApplicationName() : caption, type);
}

BOOL CWnd::UpdateData(BOOL saveAndValidate) {
  CDataExchange dx(this, saveAndValidate);
  DoDataExchange(&dx);
  return dx.Failed() ? FALSE : TRUE;
}

void CWnd::DoDataExchange(CDataExchange*) {}

BOOL CWnd::PreTranslateMessage(MSG*) { return FALSE; }

LRESULT CWnd::WindowProcedure(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) {
  if (!m_hWnd) {
    // A window created for this object: its first message introduces it.
    m_hWnd = hwnd;
    owned_ = true;
    PreSubclassWindow();
  }
  // Nothing of this object is touched after WindowProc: on WM_NCDESTROY the object may have
  // deleted itself in PostNcDestroy.
  MessageStack().push_back({message, wParam, lParam});
  const LRESULT result = WindowProc(message, wParam, lParam);
  MessageStack().pop_back();
  return result;
}

bool CWnd::PreTranslate(MSG& msg) { return PreTranslateMessage(&msg) != FALSE; }

LRESULT CWnd::WindowProc(UINT message, WPARAM wParam, LPARAM lParam) {
  LRESULT result = 0;
  if (!OnWndMsg(message, wParam, lParam, &result)) result = DefWindowProc(message, wParam, lParam);
  return result;
}

LRESULT CWnd::DefWindowProc(UINT message, WPARAM wParam, LPARAM lParam) {
  return framework::detail::CallBehaviour(m_hWnd, message, wParam, lParam);
}

LRESULT CWnd::Default() {
  const CurrentMessage current = MessageStack().empty() ? CurrentMessage{} : MessageStack().back();
  return DefWindowProc(current.message, current.wParam, current.lParam);
}

BOOL CWnd::OnWndMsg(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
  if (message == WM_COMMAND) {
    if (OnCommand(wParam, lParam)) {
      *result = 0;
      return TRUE;
    }
    return FALSE;
  }
  if (message == WM_NOTIFY) return OnNotify(wParam, lParam, result);
  if (message == WM_DRAWITEM && lParam != 0) {
    const auto* item = reinterpret_cast<const DRAWITEMSTRUCT*>(lParam);
    if (ReflectLastMsg(item->hwndItem, message, wParam, lParam, result)) return TRUE;
  }
  if (!IsNotifyKind(message) && DispatchToMap(message, 0, 0, true, wParam, lParam, *result)) return TRUE;
  return DispatchStandardMessage(message, wParam, lParam, result);
}

BOOL CWnd::DispatchStandardMessage(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
  const UINT flags = static_cast<UINT>(wParam);
  const UINT repeat = LOWORD(static_cast<std::uintptr_t>(lParam));
  const UINT keyFlags = HIWORD(static_cast<std::uintptr_t>(lParam));
  switch (message) {
    case WM_CREATE:
      *result = OnCreate(reinterpret_cast<CREATESTRUCT*>(lParam));
      return TRUE;
    case WM_DESTROY:
      OnDestroy();
      break;
    case WM_NCDESTROY:
      OnNcDestroy();
      break;
    case WM_SHOWWINDOW:
      OnShowWindow(static_cast<BOOL>(wParam), static_cast<UINT>(lParam));
      break;
    case WM_SIZE:
      OnSize(flags, GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam));
      break;
    case WM_CLOSE:
      OnClose();
      break;
    case WM_TIMER:
      OnTimer(wParam);
      break;
    case WM_MOUSEMOVE:
      OnMouseMove(flags, MousePoint(lParam));
      break;
    case WM_LBUTTONDOWN:
      OnLButtonDown(flags, MousePoint(lParam));
      break;
    case WM_LBUTTONUP:
      OnLButtonUp(flags, MousePoint(lParam));
      break;
    case WM_LBUTTONDBLCLK:
      OnLButtonDblClk(flags, MousePoint(lParam));
      break;
    case WM_RBUTTONDOWN:
      OnRButtonDown(flags, MousePoint(lParam));
      break;
    case WM_RBUTTONUP:
      OnRButtonUp(flags, MousePoint(lParam));
      break;
    case WM_MBUTTONDOWN:
      OnMButtonDown(flags, MousePoint(lParam));
      break;
    case WM_KEYDOWN:
      OnKeyDown(flags, repeat, keyFlags);
      break;
    case WM_KEYUP:
      OnKeyUp(flags, repeat, keyFlags);
      break;
    case WM_CHAR:
      OnChar(flags, repeat, keyFlags);
      break;
    case WM_SETFOCUS:
      OnSetFocus(FromHandle(HWND::FromParam(wParam)));
      break;
    case WM_KILLFOCUS:
      OnKillFocus(FromHandle(HWND::FromParam(wParam)));
      break;
    case WM_GETDLGCODE:
      *result = OnGetDlgCode();
      return TRUE;
    default:
      return FALSE;
  }
  *result = 0;
  return TRUE;
}

BOOL CWnd::OnCommand(WPARAM wParam, LPARAM lParam) {
  const UINT id = LOWORD(wParam);
  const UINT code = HIWORD(wParam);
  const HWND control = HWND::FromParam(lParam);
  LRESULT result = 0;
  if (control && ReflectLastMsg(control, WM_COMMAND, wParam, lParam, &result)) return TRUE;
  return DispatchToMap(WM_COMMAND, code, id, false, wParam, lParam, result) ? TRUE : FALSE;
}

BOOL CWnd::OnNotify(WPARAM, LPARAM lParam, LRESULT* result) {
  const auto* header = reinterpret_cast<const NMHDR*>(lParam);
  if (header == nullptr) return FALSE;
  if (header->hwndFrom && ReflectLastMsg(header->hwndFrom, WM_NOTIFY, header->idFrom, lParam, result)) return TRUE;
  return DispatchToMap(WM_NOTIFY, header->code, static_cast<UINT>(header->idFrom), false, header->idFrom, lParam,
                       *result)
             ? TRUE
             : FALSE;
}

BOOL CWnd::ReflectLastMsg(HWND child, UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
  CWnd* object = FromHandlePermanent(child);
  return object != nullptr && object->OnChildNotify(message, wParam, lParam, result);
}

BOOL CWnd::OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
  return ReflectChildNotify(message, wParam, lParam, result);
}

BOOL CWnd::ReflectChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
  LRESULT ignored = 0;
  LRESULT& out = result != nullptr ? *result : ignored;
  if (message == WM_COMMAND) {
    return DispatchToMap(WM_REFLECT_BASE + WM_COMMAND, HIWORD(wParam), 0, true, wParam, lParam, out) ? TRUE : FALSE;
  }
  if (message == WM_NOTIFY) {
    const auto* header = reinterpret_cast<const NMHDR*>(lParam);
    return DispatchToMap(WM_REFLECT_BASE + WM_NOTIFY, header->code, 0, true, wParam, lParam, out) ? TRUE : FALSE;
  }
  return OnWndMsg(WM_REFLECT_BASE + message, wParam, lParam, &out);
}

BOOL CWnd::PreCreateWindow(CREATESTRUCT&) { return TRUE; }
void CWnd::PreSubclassWindow() {}
void CWnd::PostNcDestroy() {}

int CWnd::OnCreate(CREATESTRUCT*) { return static_cast<int>(Default()); }
void CWnd::OnDestroy() { Default(); }

void CWnd::OnNcDestroy() {
  Default();
  m_hWnd = HWND();
  owned_ = false;
  PostNcDestroy();
}

void CWnd::OnShowWindow(BOOL, UINT) { Default(); }
void CWnd::OnSize(UINT, int, int) { Default(); }
void CWnd::OnClose() { Default(); }
void CWnd::OnTimer(UINT_PTR) { Default(); }
void CWnd::OnMouseMove(UINT, CPoint) { Default(); }
void CWnd::OnLButtonDown(UINT, CPoint) { Default(); }
void CWnd::OnLButtonUp(UINT, CPoint) { Default(); }
void CWnd::OnLButtonDblClk(UINT, CPoint) { Default(); }
void CWnd::OnRButtonDown(UINT, CPoint) { Default(); }
void CWnd::OnRButtonUp(UINT, CPoint) { Default(); }
void CWnd::OnMButtonDown(UINT, CPoint) { Default(); }
void CWnd::OnKeyDown(UINT, UINT, UINT) { Default(); }
void CWnd::OnKeyUp(UINT, UINT, UINT) { Default(); }
void CWnd::OnChar(UINT, UINT, UINT) { Default(); }
void CWnd::OnSetFocus(CWnd*) { Default(); }
void CWnd::OnKillFocus(CWnd*) { Default(); }
UINT CWnd::OnGetDlgCode() { return static_cast<UINT>(Default()); }
