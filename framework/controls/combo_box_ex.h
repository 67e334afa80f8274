// Extended combo boxes: a drop-down list whose items show an image of an image list beside
// their text (a line type, a line width).
#pragma once

#include "framework/controls/combo_box.h"

class CImageList;

constexpr UINT CBEIF_TEXT = 0x0001;
constexpr UINT CBEIF_IMAGE = 0x0002;
constexpr UINT CBEIF_SELECTEDIMAGE = 0x0004;
constexpr UINT CBEIF_INDENT = 0x0010;
constexpr UINT CBEIF_LPARAM = 0x0020;

struct COMBOBOXEXITEM {
  UINT mask = 0;
  INT_PTR iItem = 0;  // -1 appends
  char* pszText = nullptr;  // the text to set, or the buffer to fill
  int cchTextMax = 0;
  int iImage = -1;
  int iSelectedImage = -1;  // the image shown while the item is selected (highlighted)
  int iOverlay = 0;
  int iIndent = 0;
  LPARAM lParam = 0;
};

class CComboBoxEx : public CComboBox {
 public:
  BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);

  int InsertItem(const COMBOBOXEXITEM* item);
  // Appends or inserts an item with a text and its image (also when selected).
  int InsertItem(int index, std::string_view text, int image, int selectedImage);
  int DeleteItem(int index);
  BOOL GetItem(COMBOBOXEXITEM* item) const;
  BOOL SetItem(const COMBOBOXEXITEM* item);
  HIMAGELIST SetImageList(CImageList* list);
  HIMAGELIST GetImageList() const;
};
