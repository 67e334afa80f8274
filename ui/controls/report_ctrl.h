// The report list: a list control in report view whose rows carry colours per column, sorted by
// a click on a column title (in groups between separator rows), with four check-box modes and
// in-place editing of cells. Its parent hears of check boxes the user changed, of sorts and of
// edited cells by the three messages below.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "framework/controls/edit.h"
#include "framework/controls/list_ctrl.h"

// To the parent: a check box was changed by the mouse (wParam the row, lParam the mouse message).
constexpr UINT WM_REPORT_CHECKBOX_CHANGED = WM_APP + 10000;  // 42768
// To the parent: the rows were sorted (wParam the column, lParam 1 ascending, 0 descending).
constexpr UINT WM_REPORT_SORTED = WM_APP + 10001;          // 42769
// To the parent: an edit changed a cell's text (wParam the row, lParam the column).
constexpr UINT WM_REPORT_CELL_EDITED = WM_APP + 10002;     // 42770

// Row states, for the queries and changes below; several flags must all hold.
constexpr DWORD RC_ITEM_ALL = 0x01;  // any row
constexpr DWORD RC_ITEM_SELECTED = 0x02;
constexpr DWORD RC_ITEM_UNSELECTED = 0x04;
constexpr DWORD RC_ITEM_CHECKED = 0x08;
constexpr DWORD RC_ITEM_UNCHECKED = 0x10;
constexpr DWORD RC_ITEM_FOCUSED = 0x20;
constexpr DWORD RC_ITEM_UNFOCUSED = 0x40;

// What a click on a row's check box does (the boxes show with LVS_EX_CHECKBOXES).
constexpr int RC_CHKBOX_NONE = 0;    // nothing more than the box
constexpr int RC_CHKBOX_NORMAL = 1;  // the row becomes the selection; the parent is told
constexpr int RC_CHKBOX_SINGLE = 2;  // as normal, and at most one row stays checked
constexpr int RC_CHKBOX_FIXED = 3;   // the user cannot change a box

class CReportCtrl : public CListCtrl {
 public:
  CReportCtrl();
  ~CReportCtrl() override;

  // Columns: inserting or deleting one widens or narrows every row's colours.
  int InsertColumn(int column, std::string_view heading, int format = LVCFMT_LEFT, int width = -1, int subItem = -1);
  BOOL DeleteColumn(int column);
  int GetColumnCount();

  // Rows. Each change ends an edit in progress (committing it); a row inserted or a text set
  // forgets the last sort.
  int InsertItem(int index, std::string_view text, int image = -1);
  BOOL DeleteItem(int index);
  BOOL DeleteAllItems();
  // Deletes every row in the given states; answers how many went.
  int DeleteAllItems(DWORD states);
  BOOL SetItemText(int row, int column, std::string_view text);
  BOOL SetItemImage(int row, int column, int image);
  int GetItemImage(int row, int column) const;  // -1 when the row cannot be read
  // The caller's own value of a row.
  BOOL SetItemData(int row, DWORD_PTR data);
  DWORD_PTR GetItemData(int row) const;
  HIMAGELIST SetImageList(CImageList* images);

  // Colours of a cell; column -1 sets every column of the row.
  BOOL SetItemTextColor(int row, int column, COLORREF color);
  BOOL SetItemBkColor(int row, int column, COLORREF color);
  COLORREF GetItemTextColor(int row, int column) const;
  COLORREF GetItemBkColor(int row, int column) const;

  // States by the RC_ITEM_ flags.
  bool ItemHasStates(int row, DWORD states) const;
  int GetFirstItem(DWORD states, int startAfter = -1) const;
  int CountItems(DWORD states) const;
  // Selects (RC_ITEM_SELECTED) or unselects, checks or unchecks, focuses or unfocuses a row;
  // row -1 changes every row.
  BOOL SetItemStates(int row, DWORD states);

  void SetCheckboxMode(int mode);  // RC_CHKBOX_
  int GetCheckboxMode() const { return checkboxMode_; }

  // Sorting: rows whose text in the sorted column equals the separator stay in place and part
  // the rows into groups sorted on their own.
  void SetSortSeparator(std::optional<std::string> separator);
  // Nothing happens (FALSE) for a column that does not exist or a list whose column titles
  // are not buttons.
  BOOL SortItems(int column, bool ascending);
  int GetSortedColumn() const { return sortColumn_; }
  bool IsSortAscending() const { return sortAscending_; }

  // In-place editing of cells, off until enabled.
  void SetEditable(bool editable = true);
  bool IsEditable() const { return editable_; }
  BOOL StartEdit(int row, int column);
  // Ends the edit, taking the text into the cell when `commit` is set and it changed.
  BOOL EndEdit(bool commit = true);
  bool IsEditing() const { return editRow_ >= 0; }
  int GetEditRow() const { return editRow_; }
  int GetEditColumn() const { return editColumn_; }
  CEdit* GetEditControl() { return &editor_; }

  BOOL PreTranslateMessage(MSG* msg) override;

 protected:
  void PreSubclassWindow() override;
  LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override;
  void OnCustomDraw(NMHDR* header, LRESULT* result);
  void OnColumnClick(NMHDR* header, LRESULT* result);
  BOOL OnDeleteItem(NMHDR* header, LRESULT* result);

  DECLARE_MESSAGE_MAP()

 private:
  struct RowRecord {
    DWORD_PTR data = 0;
    std::vector<COLORREF> text;
    std::vector<COLORREF> background;
  };

  RowRecord* RecordOf(int row) const;
  void OnCheckChanged(int row, bool checked, UINT mouseMessage);
  void MoveEdit(int row, int column);
  void NotifyParent(UINT message, WPARAM wParam, LPARAM lParam);

  CEdit editor_;
  std::optional<std::string> separator_;
  bool editable_ = false;
  int editRow_ = -1;
  int editColumn_ = -1;
  int checkboxMode_ = RC_CHKBOX_NORMAL;
  int editorAlignment_ = LVCFMT_LEFT;
  int sortColumn_ = -1;
  bool sortAscending_ = true;
  std::unordered_map<const RowRecord*, std::unique_ptr<RowRecord>> records_;
};
