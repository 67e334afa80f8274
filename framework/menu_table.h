// The menus behind the menu handles, shared by the menu calls and the popup-menu window.
#pragma once

#include <string>
#include <vector>

#include "framework/win_types.h"

namespace framework::detail {

struct MenuItem {
  UINT id = 0;
  UINT flags = 0;  // MF_SEPARATOR, MF_GRAYED, MF_DISABLED, MF_CHECKED
  std::string text;
  HBITMAP unchecked;
  HBITMAP checked;
  HIMAGELIST images;
  int image = -1;
};

// The items of a live menu, or null.
const std::vector<MenuItem>* MenuItems(HMENU menu);

}  // namespace framework::detail
