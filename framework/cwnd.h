// The framework's window object: a C++ object attached to a window handle that answers the
// window's messages through its message map and its virtual handlers.
#pragma once

#include <string>
#include <string_view>

#include "framework/geometry.h"
#include "framework/message_map.h"
#include "framework/message_queue.h"
#include "framework/win_constants.h"
#include "framework/win_messages.h"
#include "framework/win_structs.h"
#include "framework/win_styles.h"
#include "framework/window_system.h"

class CDataExchange;

// Anything with a message map.
class CCmdTarget {
 public:
  CCmdTarget() = default;
  CCmdTarget(const CCmdTarget&) = delete;
  CCmdTarget& operator=(const CCmdTarget&) = delete;
  virtual ~CCmdTarget() = default;

 protected:
  static const framework::MessageMap* GetThisMessageMap();
  virtual const framework::MessageMap* GetMessageMap() const;
  // Runs the first entry of this class's map (then its bases') for the message, notification
  // code and control id; answers whether an entry handled it.
  bool DispatchToMap(UINT message, UINT code, UINT id, bool anyId, WPARAM wParam, LPARAM lParam, LRESULT& result);
};

class CWnd : public CCmdTarget, public framework::AttachedObject {
 public:
  CWnd() = default;
  ~CWnd() override;

  HWND m_hWnd;

  // The object attached to a window; for a window without one a temporary object that lives
  // as long as the window.
  static CWnd* FromHandle(HWND hwnd);
  static CWnd* FromHandlePermanent(HWND hwnd);
  HWND GetSafeHwnd() const { return m_hWnd; }

  // Creation and destruction. A window made here, or subclassed, belongs to this object and is
  // destroyed with it.
  BOOL Create(std::string_view className, std::string_view text, DWORD style, const RECT& rect, CWnd* parent,
              UINT id);
  BOOL CreateEx(DWORD exStyle, std::string_view className, std::string_view text, DWORD style, const RECT& rect,
                CWnd* parent, UINT id, LPARAM createParam = 0);
  virtual BOOL DestroyWindow();
  // Takes over an existing window (a control made from a dialog template).
  BOOL SubclassWindow(HWND hwnd);
  BOOL SubclassDlgItem(UINT id, CWnd* parent);
  HWND UnsubclassWindow();

  LRESULT SendMessage(UINT message, WPARAM wParam = 0, LPARAM lParam = 0) const;
  BOOL PostMessage(UINT message, WPARAM wParam = 0, LPARAM lParam = 0) const;
  LRESULT SendDlgItemMessage(int id, UINT message, WPARAM wParam = 0, LPARAM lParam = 0) const;

  CWnd* GetParent() const;
  CWnd* GetDlgItem(int id) const;
  int GetDlgCtrlID() const;
  CWnd* GetTopLevelParent() const;
  CWnd* GetWindow(UINT relation) const;
  BOOL IsChild(const CWnd* wnd) const;

  void SetWindowText(std::string_view text);
  std::string GetWindowText() const;
  int GetWindowTextLength() const;
  void SetDlgItemText(int id, std::string_view text);
  std::string GetDlgItemText(int id) const;
  void CheckDlgButton(int id, UINT check);
  UINT IsDlgButtonChecked(int id) const;

  DWORD GetStyle() const;
  DWORD GetExStyle() const;
  BOOL ModifyStyle(DWORD remove, DWORD add, UINT flags = 0);
  BOOL ModifyStyleEx(DWORD remove, DWORD add, UINT flags = 0);

  void GetWindowRect(RECT* rect) const;
  void GetClientRect(RECT* rect) const;
  void ClientToScreen(POINT* point) const;
  void ClientToScreen(RECT* rect) const;
  void ScreenToClient(POINT* point) const;
  void ScreenToClient(RECT* rect) const;
  void MapWindowPoints(const CWnd* to, RECT* rect) const;
  void MoveWindow(int x, int y, int width, int height, BOOL repaint = TRUE);
  void MoveWindow(const RECT& rect, BOOL repaint = TRUE);
  BOOL SetWindowPos(int x, int y, int width, int height, UINT flags);

  BOOL ShowWindow(int command);
  BOOL IsWindowVisible() const;
  BOOL EnableWindow(BOOL enable = TRUE);
  BOOL IsWindowEnabled() const;

  void Invalidate(BOOL erase = TRUE);
  void InvalidateRect(const RECT* rect, BOOL erase = TRUE);
  BOOL RedrawWindow(const RECT* rect = nullptr, UINT flags = RDW_INVALIDATE | RDW_UPDATENOW | RDW_ERASE);
  void UpdateWindow();

  CWnd* SetFocus();
  static CWnd* GetFocus();
  CWnd* SetCapture();
  static CWnd* GetCapture();

  UINT_PTR SetTimer(UINT_PTR id, UINT elapseMs);
  BOOL KillTimer(UINT_PTR id);

  // A message box owned by this window; an empty caption gives the application's name.
  int MessageBox(std::string_view text, std::string_view caption = {}, UINT type = MB_OK);

  // Moves values between the controls and the object's members (DoDataExchange); false when a
  // control held a value that could not be taken.
  BOOL UpdateData(BOOL saveAndValidate = TRUE);

  // Offered every queued message for this window or one of its children before dispatch.
  virtual BOOL PreTranslateMessage(MSG* msg);

 protected:
  virtual LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam);
  virtual BOOL OnWndMsg(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result);
  // The window's class behaviour (a control's own handling), then the system's default.
  virtual LRESULT DefWindowProc(UINT message, WPARAM wParam, LPARAM lParam);
  // DefWindowProc with the message now being handled.
  LRESULT Default();

  virtual BOOL OnCommand(WPARAM wParam, LPARAM lParam);
  virtual BOOL OnNotify(WPARAM wParam, LPARAM lParam, LRESULT* result);
  // A notification this control sent, handed back by its parent; true when handled here.
  virtual BOOL OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result);
  BOOL ReflectChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result);
  // Hands a child's notification back to the child's own object first.
  static BOOL ReflectLastMsg(HWND child, UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result);

  virtual BOOL PreCreateWindow(CREATESTRUCT& cs);
  virtual void PreSubclassWindow();
  // The last call the object gets for its window; an object that owns itself deletes itself here.
  virtual void PostNcDestroy();
  virtual void DoDataExchange(CDataExchange* dx);

  // Handlers of standard messages; each default runs the window's default handling.
  virtual int OnCreate(CREATESTRUCT* cs);
  virtual void OnDestroy();
  virtual void OnNcDestroy();
  virtual void OnShowWindow(BOOL show, UINT status);
  virtual void OnSize(UINT type, int cx, int cy);
  virtual void OnClose();
  virtual void OnTimer(UINT_PTR id);
  virtual void OnMouseMove(UINT flags, CPoint point);
  virtual void OnLButtonDown(UINT flags, CPoint point);
  virtual void OnLButtonUp(UINT flags, CPoint point);
  virtual void OnLButtonDblClk(UINT flags, CPoint point);
  virtual void OnRButtonDown(UINT flags, CPoint point);
  virtual void OnRButtonUp(UINT flags, CPoint point);
  virtual void OnMButtonDown(UINT flags, CPoint point);
  virtual void OnKeyDown(UINT key, UINT repeat, UINT flags);
  virtual void OnKeyUp(UINT key, UINT repeat, UINT flags);
  virtual void OnChar(UINT character, UINT repeat, UINT flags);
  virtual void OnSetFocus(CWnd* oldWnd);
  virtual void OnKillFocus(CWnd* newWnd);
  virtual UINT OnGetDlgCode();

  DECLARE_MESSAGE_MAP()

 private:
  LRESULT WindowProcedure(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam) final;
  bool PreTranslate(MSG& msg) final;
  BOOL DispatchStandardMessage(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result);

  bool owned_ = false;  // the window was made or subclassed by this object
};
