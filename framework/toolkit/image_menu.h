// A popup menu that shows an image of an image list beside each item's text, shown centred on
// a point, answering the chosen item's id (0 when the user chose none).
#pragma once

#include "framework/image_list.h"
#include "framework/menu.h"

class CImageMenu : public CMenu {
 public:
  // The images come from `images`, which must outlive the menu's showing.
  BOOL Create(const CImageList& images);
  BOOL AddItem(UINT id, std::string_view text, int image);
  UINT Track(CWnd* owner, CPoint screenPoint);

 private:
  HIMAGELIST images_;
};
