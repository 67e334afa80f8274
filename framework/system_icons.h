// The system's own pictures: the four message-box icons.
#pragma once

#include <string_view>

#include "framework/win_types.h"

namespace framework {

// The SVG picture of IDI_HAND, IDI_QUESTION, IDI_EXCLAMATION or IDI_ASTERISK; empty otherwise.
std::string_view SystemIconPicture(UINT id);

}  // namespace framework
