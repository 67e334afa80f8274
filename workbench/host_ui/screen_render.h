// A picture of the whole screen: every visible top-level window (the main frame, an open
// dialog or message box, a tip) where it stands, from the bottom of the stacking order up.
#pragma once

#include <string>

namespace wb::ui {

std::string RenderScreen();

}  // namespace wb::ui
