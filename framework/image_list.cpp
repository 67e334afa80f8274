// The image-list table: each list keeps its image size and its images by index.
#include "framework/image_list.h"

#include <map>
#include <vector>

#include "framework/canvas.h"
#include "framework/cdc.h"
#include "framework/resource_module.h"

namespace {

struct ImageList {
  int cx = 16;
  int cy = 16;
  std::vector<HICON> images;
};

struct ImageListTable {
  std::map<std::uint32_t, ImageList> lists;
  std::uint32_t next = 1;
};

ImageListTable& Table() {
  static ImageListTable table;
  return table;
}

ImageList* Find(HIMAGELIST list) {
  const auto it = Table().lists.find(list.Value());
  return it == Table().lists.end() ? nullptr : &it->second;
}

BOOL DrawImage(HIMAGELIST list, int index, HDC hdc, int x, int y, bool dimmed) {
  const ImageList* l = Find(list);
  if (l == nullptr || hdc == nullptr || index < 0 || index >= static_cast<int>(l->images.size())) return FALSE;
  const HICON icon = l->images[static_cast<std::size_t>(index)];
  hdc->Picture(CRect(x, y, x + l->cx, y + l->cy), framework::IconPicture(icon), dimmed,
               {{"data-icon", std::to_string(framework::IconResourceId(icon))}, {"data-image", std::to_string(index)}});
  return TRUE;
}

}  // namespace

HIMAGELIST ImageList_Create(int cx, int cy, UINT, int initial, int) {
  if (cx <= 0 || cy <= 0) return HIMAGELIST();
  ImageListTable& t = Table();
  ImageList list{cx, cy, {}};
  list.images.reserve(static_cast<std::size_t>(std::max(0, initial)));
  t.lists.emplace(t.next, std::move(list));
  return HIMAGELIST(t.next++);
}

BOOL ImageList_Destroy(HIMAGELIST list) { return Table().lists.erase(list.Value()) > 0 ? TRUE : FALSE; }

int ImageList_ReplaceIcon(HIMAGELIST list, int index, HICON icon) {
  ImageList* l = Find(list);
  if (l == nullptr || !icon) return -1;
  if (index < 0) {
    l->images.push_back(icon);
    return static_cast<int>(l->images.size()) - 1;
  }
  if (index >= static_cast<int>(l->images.size())) return -1;
  l->images[static_cast<std::size_t>(index)] = icon;
  return index;
}

int ImageList_GetImageCount(HIMAGELIST list) {
  const ImageList* l = Find(list);
  return l != nullptr ? static_cast<int>(l->images.size()) : 0;
}

BOOL ImageList_GetIconSize(HIMAGELIST list, int* cx, int* cy) {
  const ImageList* l = Find(list);
  if (l == nullptr || cx == nullptr || cy == nullptr) return FALSE;
  *cx = l->cx;
  *cy = l->cy;
  return TRUE;
}

HICON ImageList_GetIcon(HIMAGELIST list, int index, UINT) {
  const ImageList* l = Find(list);
  if (l == nullptr || index < 0 || index >= static_cast<int>(l->images.size())) return HICON();
  return l->images[static_cast<std::size_t>(index)];
}

BOOL ImageList_Draw(HIMAGELIST list, int index, HDC hdc, int x, int y, UINT) {
  return DrawImage(list, index, hdc, x, y, false);
}

namespace framework {

std::size_t LiveImageListCount() { return Table().lists.size(); }

BOOL DrawImageDimmed(HIMAGELIST list, int index, HDC hdc, int x, int y) { return DrawImage(list, index, hdc, x, y, true); }

}  // namespace framework

CImageList::~CImageList() { DeleteImageList(); }

BOOL CImageList::Create(int cx, int cy, UINT flags, int initial, int grow) {
  DeleteImageList();
  m_hImageList = ImageList_Create(cx, cy, flags, initial, grow);
  return m_hImageList ? TRUE : FALSE;
}

BOOL CImageList::DeleteImageList() {
  if (!m_hImageList) return FALSE;
  ImageList_Destroy(m_hImageList);
  m_hImageList = HIMAGELIST();
  return TRUE;
}

int CImageList::Add(HICON icon) { return ImageList_AddIcon(m_hImageList, icon); }
int CImageList::GetImageCount() const { return ImageList_GetImageCount(m_hImageList); }
HICON CImageList::ExtractIcon(int index) const { return ImageList_GetIcon(m_hImageList, index, ILD_NORMAL); }

BOOL CImageList::Draw(CDC* dc, int index, POINT point, UINT style) const {
  return dc != nullptr && ImageList_Draw(m_hImageList, index, dc->GetSafeHdc(), point.x, point.y, style);
}

CSize CImageList::GetIconSize() const {
  int cx = 0;
  int cy = 0;
  ImageList_GetIconSize(m_hImageList, &cx, &cy);
  return {cx, cy};
}
