// Lengths and numbers as the dialogs show them, following the host's unit and precision.
#pragma once

#include <string>

// Drawing units to the unit the user sees (host unit letter in globc[94]).
float ToDisplayLength(float value);
// The unit the user sees back to drawing units.
float FromDisplayLength(float value);
// The value with as many decimals as the host's precision setting (globr[56]) asks for.
std::string FormatNumber(float value);
