// The library's user-visible texts by string id.
#pragma once

#include <string_view>

namespace resources {

enum StringId : int {
  kIdsModeRefused = 6,
  kIdsFirstDisplayMode = 16,  // 16 + display-mode code, codes 0 to 10
  kIdsCutByColor = 27,
  kIdsCutOff = 28,
  kIdsCutWhole = 29,
  kIdsFile = 42,
  kIdsOf = 43,
  kIdsStart = 44,
  kIdsDone = 45,
  kIdsError = 47,
  kIdsInfo = 49,
  kIdsDefaultCamera = 56,
  kIdsCannotCreate2DFolder = 91,
};

// The text of a string id; empty for an id the table does not hold.
std::string_view LoadString(int id);

}  // namespace resources
