// Tab controls: a row of tabs, each with a text and an image, one of them selected; drawn by
// the control or, with TCS_OWNERDRAWFIXED, tab by tab by its parent (or the control's object).
#pragma once

#include <string>

#include "framework/cwnd.h"

constexpr UINT TCIF_TEXT = 0x0001;
constexpr UINT TCIF_IMAGE = 0x0002;
constexpr UINT TCIF_PARAM = 0x0008;
constexpr UINT TCHT_NOWHERE = 0x0001;
constexpr UINT TCHT_ONITEMICON = 0x0002;
constexpr UINT TCHT_ONITEMLABEL = 0x0004;
constexpr UINT TCHT_ONITEM = TCHT_ONITEMICON | TCHT_ONITEMLABEL;

struct TCITEM {
  UINT mask = 0;
  DWORD dwState = 0;
  DWORD dwStateMask = 0;
  char* pszText = nullptr;  // the text to set, or the buffer to fill
  int cchTextMax = 0;
  int iImage = -1;
  LPARAM lParam = 0;
};

struct TCHITTESTINFO {
  POINT pt;
  UINT flags = 0;
};

class CTabCtrl : public CWnd {
 public:
  BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);

  LONG InsertItem(int index, std::string_view text, int image = -1);
  BOOL DeleteItem(int index);
  BOOL DeleteAllItems();
  int GetItemCount() const;
  BOOL GetItem(int index, TCITEM* item) const;
  BOOL SetItem(int index, TCITEM* item);
  int GetCurSel() const;
  int SetCurSel(int index);
  BOOL GetItemRect(int index, RECT* rect) const;
  int HitTest(TCHITTESTINFO* info) const;
  HIMAGELIST SetImageList(HIMAGELIST list);
  HIMAGELIST GetImageList() const;

  // Tabs of a TCS_OWNERDRAWFIXED control are drawn here (the parent hands the request back).
  virtual void DrawItem(LPDRAWITEMSTRUCT drawItem);

 protected:
  BOOL OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) override;
};

namespace framework {
void RegisterTabControlClass();
}
