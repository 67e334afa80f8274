// Unit conversion and number formatting for the dialogs.
#include "shell/display_units.h"

#include <cmath>
#include <cstdio>

#include "shell/host/argument_blocks.h"

namespace {

constexpr float kCentimetreToDisplay = 0.01F;
constexpr float kMetreToDisplay = 0.001F;
constexpr float kCentimetreFromDisplay = 100.0F;
constexpr float kMetreFromDisplay = 1000.0F;
// A double carries at most this many meaningful decimals; the host's setting is clamped to it
// so a damaged setting cannot make an unbounded or negative precision.
constexpr int kMaxDecimals = 17;

signed char UnitLetter() { return static_cast<signed char>(globc[94]); }

int DecimalsSetting() {
  const float setting = globr[56];
  if (!(setting > 0.0F)) return 0;  // negative, zero and NaN
  if (setting >= static_cast<float>(kMaxDecimals)) return kMaxDecimals;
  return static_cast<int>(setting);
}

}  // namespace

float ToDisplayLength(float value) {
  switch (UnitLetter()) {
    case 'c': return value * kCentimetreToDisplay;
    case 'l': return value * kMetreToDisplay;
    default: return value;
  }
}

float FromDisplayLength(float value) {
  switch (UnitLetter()) {
    case 'c': return value * kCentimetreFromDisplay;
    case 'l': return value * kMetreFromDisplay;
    default: return value;
  }
}

std::string FormatNumber(float value) {
  const int decimals = DecimalsSetting();
  const auto wide = static_cast<double>(value);
  const int length = std::snprintf(nullptr, 0, "%0.*f", decimals, wide);
  std::string text(static_cast<std::size_t>(length > 0 ? length : 0), '\0');
  std::snprintf(text.data(), text.size() + 1, "%0.*f", decimals, wide);
  return text;
}
