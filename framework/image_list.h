// Image lists: numbered images of one size that trees, tabs and lists draw their items with.
#pragma once

#include <cstddef>

#include "framework/geometry.h"
#include "framework/win_types.h"

class CDC;

constexpr UINT ILC_MASK = 0x0001;
constexpr UINT ILC_COLOR = 0x0000;
constexpr UINT ILC_COLOR32 = 0x0020;
constexpr UINT ILC_COLORDDB = 0x00FE;
constexpr UINT ILD_NORMAL = 0x0000;
constexpr UINT ILD_TRANSPARENT = 0x0001;

HIMAGELIST ImageList_Create(int cx, int cy, UINT flags, int initial, int grow);
BOOL ImageList_Destroy(HIMAGELIST list);
// Appends an icon (index -1) or replaces image `index`; answers the image's index or -1.
int ImageList_ReplaceIcon(HIMAGELIST list, int index, HICON icon);
inline int ImageList_AddIcon(HIMAGELIST list, HICON icon) { return ImageList_ReplaceIcon(list, -1, icon); }
int ImageList_GetImageCount(HIMAGELIST list);
BOOL ImageList_GetIconSize(HIMAGELIST list, int* cx, int* cy);
HICON ImageList_GetIcon(HIMAGELIST list, int index, UINT flags);
// Draws image `index` at its size with its top-left corner at (x, y); false for no such image.
BOOL ImageList_Draw(HIMAGELIST list, int index, HDC hdc, int x, int y, UINT style);

namespace framework {
std::size_t LiveImageListCount();
// Draws an image faint, as a disabled control shows it.
BOOL DrawImageDimmed(HIMAGELIST list, int index, HDC hdc, int x, int y);
}  // namespace framework

// An image list owned by an object: destroyed with it.
class CImageList {
 public:
  CImageList() = default;
  CImageList(const CImageList&) = delete;
  CImageList& operator=(const CImageList&) = delete;
  ~CImageList();

  HIMAGELIST m_hImageList;

  BOOL Create(int cx, int cy, UINT flags, int initial, int grow);
  BOOL DeleteImageList();
  HIMAGELIST GetSafeHandle() const { return m_hImageList; }
  int Add(HICON icon);
  int GetImageCount() const;
  HICON ExtractIcon(int index) const;
  BOOL Draw(CDC* dc, int index, POINT point, UINT style) const;
  CSize GetIconSize() const;
};
