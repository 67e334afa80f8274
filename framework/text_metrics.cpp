// Advance widths of the window font, in 1/2048 em, for the printable ASCII characters.
#include "framework/text_metrics.h"

#include <array>
#include <cmath>

namespace framework {
namespace {

constexpr std::array<int, 95> kAdvance = {
    651,  823,  940,  1716, 1303, 1946, 1597, 563,  799,  799,  1024, 1716, 651,  739,  651,  690,   // ' ' to '/'
    1303, 1303, 1303, 1303, 1303, 1303, 1303, 1303, 1303, 1303, 690,  690,  1716, 1716, 1716, 1087,  // '0' to '?'
    2048, 1401, 1405, 1430, 1577, 1294, 1178, 1587, 1540, 604,  604,  1343, 1141, 1767, 1532, 1612,  // '@' to 'O'
    1235, 1612, 1423, 1300, 1251, 1499, 1401, 2025, 1403, 1251, 1403, 799,  690,  799,  1716, 1024,  // 'P' to '_'
    1024, 1255, 1300, 1126, 1300, 1260, 721,  1300, 1298, 569,  569,  1186, 569,  1995, 1298, 1253,  // '`' to 'o'
    1300, 1300, 842,  1067, 803,  1298, 1212, 1675, 1212, 1212, 1075, 1303, 690,  1303, 1716,        // 'p' to '~'
};

// Letters above ASCII (accented letters of the 8-bit code page) take an average letter's width.
constexpr int kOtherAdvance = 1260;

}  // namespace

int TextWidth(std::string_view text, bool bold) {
  long total = 0;
  for (unsigned char c : text) total += (c >= 32 && c < 127) ? kAdvance[c - 32] : kOtherAdvance;
  const double scale = bold ? 1.1 : 1.0;
  return static_cast<int>(std::lround(static_cast<double>(total) * kFontSize * scale / 2048.0));
}

}  // namespace framework
