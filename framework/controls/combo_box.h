// Combo boxes: a selection field with a button that drops a list of items below it, each item
// a text with 32-bit data. Every kind is a drop-down list (the field shows the chosen item and
// is not typed into). With CBS_OWNERDRAWFIXED the parent (or the control's object) measures
// the items once (WM_MEASUREITEM) and draws each item and the field (WM_DRAWITEM).
#pragma once

#include <string>

#include "framework/cwnd.h"

struct COMBOBOXINFO {
  UINT cbSize = sizeof(COMBOBOXINFO);
  RECT rcItem;    // the selection field
  RECT rcButton;  // the drop button
  DWORD stateButton = 0;
  HWND hwndCombo;
  HWND hwndItem;
  HWND hwndList;  // the drop-down list while it is open
};

class CComboBox : public CWnd {
 public:
  BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);

  int AddString(std::string_view text);
  int InsertString(int index, std::string_view text);
  int DeleteString(UINT index);
  void ResetContent();
  int GetCount() const;
  int GetCurSel() const;
  int SetCurSel(int index);  // -1 clears the selection
  std::string GetLBText(int index) const;
  int GetLBTextLen(int index) const;
  // Case-insensitive searches from the item after `startAfter` (-1: from the top), wrapping.
  int FindString(int startAfter, std::string_view prefix) const;
  int FindStringExact(int startAfter, std::string_view text) const;
  int SelectString(int startAfter, std::string_view prefix);
  DWORD_PTR GetItemData(int index) const;
  int SetItemData(int index, DWORD_PTR data);
  // Item -1 is the selection field.
  int SetItemHeight(int index, UINT height);
  int GetItemHeight(int index) const;
  void ShowDropDown(BOOL show = TRUE);
  BOOL GetDroppedState() const;

  // Owner-drawn combo boxes draw and measure their items here (the parent hands the requests
  // back to the control's object).
  virtual void DrawItem(LPDRAWITEMSTRUCT drawItem);
  virtual void MeasureItem(LPMEASUREITEMSTRUCT measureItem);

 protected:
  BOOL OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) override;
};

namespace framework {
// Registers the combo box, the extended combo box and their drop-down list.
void RegisterComboBoxClasses();
}
