// Header controls: the row of column titles above a report list. With HDS_BUTTONS the titles
// are buttons: a click on one tells the parent which column (HDN_ITEMCLICK).
#pragma once

#include <string>

#include "framework/cwnd.h"

constexpr UINT HDI_WIDTH = 0x0001;
constexpr UINT HDI_TEXT = 0x0002;
constexpr UINT HDI_FORMAT = 0x0004;
constexpr UINT HDI_LPARAM = 0x0008;
constexpr int HDF_LEFT = 0x0000;
constexpr int HDF_RIGHT = 0x0001;
constexpr int HDF_CENTER = 0x0002;
constexpr int HDF_JUSTIFYMASK = 0x0003;
constexpr int HDF_STRING = 0x4000;
constexpr UINT HHT_NOWHERE = 0x0001;
constexpr UINT HHT_ONHEADER = 0x0002;

struct HDITEM {
  UINT mask = 0;
  int cxy = 0;  // the width
  char* pszText = nullptr;
  int cchTextMax = 0;
  int fmt = 0;
  LPARAM lParam = 0;
};

struct HDHITTESTINFO {
  POINT pt;
  UINT flags = 0;
  int iItem = -1;
};

struct NMHEADER {
  NMHDR hdr;
  int iItem = -1;
  int iButton = 0;  // 0 left, 1 right, 2 middle
  HDITEM* pitem = nullptr;
};

class CHeaderCtrl : public CWnd {
 public:
  int GetItemCount() const;
  BOOL GetItem(int index, HDITEM* item) const;
  BOOL GetItemRect(int index, RECT* rect) const;
  std::string GetItemText(int index) const;
};

namespace framework {

inline constexpr int kHeaderHeight = 20;

void RegisterHeaderClass();

}  // namespace framework
