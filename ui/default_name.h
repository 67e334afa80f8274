// Names for new objects: a word, one space and the first number from `first` up that gives a
// name none of `taken` has (exact, byte for byte).
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace pane {

std::string DefaultName(std::string_view word, std::int32_t first, const std::vector<std::string>& taken);

}  // namespace pane
