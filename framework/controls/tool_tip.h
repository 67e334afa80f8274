// Tool-tip controls: tools (a window or a rectangle of it) with a text; resting the mouse on a
// tool shows its text in a small window beside the pointer.
#pragma once

#include <string>

#include "framework/cwnd.h"

struct TOOLINFO {
  UINT cbSize = sizeof(TOOLINFO);
  UINT uFlags = 0;
  HWND hwnd;          // the window the tool lies in
  UINT_PTR uId = 0;   // the tool's id, or with TTF_IDISHWND the window that is the tool
  RECT rect;          // the tool's area in hwnd's client coordinates (without TTF_IDISHWND)
  char* lpszText = nullptr;  // the text, or MAKEINTRESOURCE of a string id
  LPARAM lParam = 0;
};

// A string id carried where a text pointer is expected, as resource ids travel.
inline char* MAKEINTRESOURCE(UINT id) { return reinterpret_cast<char*>(static_cast<std::uintptr_t>(id & 0xFFFF)); }
inline bool IS_INTRESOURCE(const char* text) { return (reinterpret_cast<std::uintptr_t>(text) >> 16) == 0; }

constexpr WPARAM TTDT_AUTOMATIC = 0;
constexpr WPARAM TTDT_RESHOW = 1;
constexpr WPARAM TTDT_AUTOPOP = 2;
constexpr WPARAM TTDT_INITIAL = 3;

class CToolTipCtrl : public CWnd {
 public:
  BOOL Create(CWnd* parent, DWORD style = 0);

  // A tool for a window (its whole client area unless a rectangle is given); the tool tip
  // follows the mouse over it by itself (TTF_SUBCLASS).
  BOOL AddTool(CWnd* wnd, std::string_view text, const RECT* toolRect = nullptr, UINT_PTR toolId = 0);
  BOOL AddTool(CWnd* wnd, UINT textId, const RECT* toolRect = nullptr, UINT_PTR toolId = 0);
  void DelTool(CWnd* wnd, UINT_PTR toolId = 0);
  void UpdateTipText(std::string_view text, CWnd* wnd, UINT_PTR toolId = 0);
  std::string GetText(CWnd* wnd, UINT_PTR toolId = 0) const;
  int GetToolCount() const;
  void Activate(BOOL activate);
  void SetDelayTime(WPARAM which, int milliseconds);
  void RelayEvent(MSG* msg);
  void Pop();

 private:
  BOOL AddToolInfo(CWnd* wnd, char* text, const RECT* toolRect, UINT_PTR toolId);
};

namespace framework {
void RegisterToolTipClass();
}
