// The message-box icons, drawn for this window system on a 32 x 32 grid.
#include "framework/system_icons.h"

#include "framework/win_constants.h"

namespace framework {

std::string_view SystemIconPicture(UINT id) {
  switch (static_cast<int>(id)) {
    case IDI_HAND:
      return R"(<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 32 32"><circle cx="16" cy="16" r="14" fill="#d32f2f" stroke="#8e1b1b" stroke-width="1.5"/><path d="M10 10 L22 22 M22 10 L10 22" stroke="#fff" stroke-width="3.5" stroke-linecap="round"/></svg>)";
    case IDI_QUESTION:
      return R"(<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 32 32"><circle cx="16" cy="16" r="14" fill="#1e6fd0" stroke="#12457f" stroke-width="1.5"/><path d="M11.5 12.5 C11.5 8 20.5 8 20.5 12.5 C20.5 16 16 16 16 19.5" fill="none" stroke="#fff" stroke-width="3" stroke-linecap="round"/><circle cx="16" cy="24" r="2" fill="#fff"/></svg>)";
    case IDI_EXCLAMATION:
      return R"(<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 32 32"><path d="M16 2 L31 29 L1 29 Z" fill="#f9c623" stroke="#9a7400" stroke-width="1.5" stroke-linejoin="round"/><path d="M16 11 L16 20" stroke="#222" stroke-width="3.5" stroke-linecap="round"/><circle cx="16" cy="25" r="2" fill="#222"/></svg>)";
    case IDI_ASTERISK:
      return R"(<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 32 32"><circle cx="16" cy="16" r="14" fill="#1e6fd0" stroke="#12457f" stroke-width="1.5"/><circle cx="16" cy="9.5" r="2.2" fill="#fff"/><path d="M16 14 L16 24" stroke="#fff" stroke-width="3.5" stroke-linecap="round"/></svg>)";
    default:
      return {};
  }
}

}  // namespace framework
