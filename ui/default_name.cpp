// Default names of new cameras, sections and plans.
#include "ui/default_name.h"

#include <algorithm>

namespace pane {

std::string DefaultName(std::string_view word, std::int32_t first, const std::vector<std::string>& taken) {
  // Among n taken names one of n + 1 numbers is free, so the search ends; 64 bits keep the
  // numbers from wrapping whatever the first one is.
  for (std::int64_t number = first;; ++number) {
    std::string candidate = std::string(word) + " " + std::to_string(number);
    if (std::find(taken.begin(), taken.end(), candidate) == taken.end()) return candidate;
  }
}

}  // namespace pane
