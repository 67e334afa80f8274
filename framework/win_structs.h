// The records that travel in message parameters between windows and their parents.
#pragma once

#include "framework/win_types.h"

// Head of every WM_NOTIFY record.
struct NMHDR {
  HWND hwndFrom;
  UINT_PTR idFrom = 0;
  UINT code = 0;
};

// WM_DRAWITEM: an owner-drawn control asks its parent to draw one item.
struct DRAWITEMSTRUCT {
  UINT CtlType = 0;
  UINT CtlID = 0;
  UINT itemID = 0;
  UINT itemAction = 0;
  UINT itemState = 0;
  HWND hwndItem;
  HDC hDC = nullptr;
  RECT rcItem;
  UINT_PTR itemData = 0;
};
using LPDRAWITEMSTRUCT = DRAWITEMSTRUCT*;

// WM_CREATE and WM_NCCREATE: what the window is being created with.
struct CREATESTRUCT {
  LPARAM lpCreateParams = 0;
  int id = 0;
  HWND hwndParent;
  int cy = 0;
  int cx = 0;
  int y = 0;
  int x = 0;
  DWORD style = 0;
  const char* lpszName = "";
  const char* lpszClass = "";
  DWORD dwExStyle = 0;
};
