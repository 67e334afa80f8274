// The one font windows draw text in, and how wide its texts are: the advance widths of the
// sans-serif face the pictures name first, so that centring and hit tests match the picture.
#pragma once

#include <string_view>

namespace framework {

inline constexpr std::string_view kFontFamily = "DejaVu Sans, Verdana, sans-serif";
inline constexpr int kFontSize = 11;     // pixels
inline constexpr int kLineHeight = 13;   // pixels from one line's top to the next
inline constexpr int kFontAscent = 10;   // pixels from a line's top to its baseline

// Width in pixels of a text in the window font (bytes of the 8-bit code page).
int TextWidth(std::string_view text, bool bold = false);

}  // namespace framework
