// The extended combo box's own calls: items with images and the image list they are drawn from.
#include "framework/controls/combo_box_ex.h"

#include "framework/image_list.h"

int CComboBoxEx::InsertItem(const COMBOBOXEXITEM* item) {
  return static_cast<int>(SendMessage(CBEM_INSERTITEM, 0, reinterpret_cast<LPARAM>(item)));
}

int CComboBoxEx::InsertItem(int index, std::string_view text, int image, int selectedImage) {
  std::string copy(text);
  COMBOBOXEXITEM item;
  item.mask = CBEIF_TEXT | CBEIF_IMAGE | CBEIF_SELECTEDIMAGE;
  item.iItem = index;
  item.pszText = copy.data();
  item.iImage = image;
  item.iSelectedImage = selectedImage;
  return InsertItem(&item);
}

int CComboBoxEx::DeleteItem(int index) { return static_cast<int>(SendMessage(CBEM_DELETEITEM, static_cast<WPARAM>(index))); }

BOOL CComboBoxEx::GetItem(COMBOBOXEXITEM* item) const {
  return static_cast<BOOL>(SendMessage(CBEM_GETITEM, 0, reinterpret_cast<LPARAM>(item)));
}

BOOL CComboBoxEx::SetItem(const COMBOBOXEXITEM* item) {
  return static_cast<BOOL>(SendMessage(CBEM_SETITEM, 0, reinterpret_cast<LPARAM>(item)));
}

HIMAGELIST CComboBoxEx::SetImageList(CImageList* list) {
  return HIMAGELIST::FromParam(
      SendMessage(CBEM_SETIMAGELIST, 0, (list != nullptr ? list->GetSafeHandle() : HIMAGELIST()).ToLParam()));
}

HIMAGELIST CComboBoxEx::GetImageList() const { return HIMAGELIST::FromParam(SendMessage(CBEM_GETIMAGELIST)); }
