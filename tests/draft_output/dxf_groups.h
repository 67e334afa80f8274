// Splits DXF text into its groups so that tests can check what a file says, entity by entity.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace draft_output_samples {

struct DxfGroup {
  int code = 0;
  std::string value;
  bool operator==(const DxfGroup&) const = default;
};

// Throws std::runtime_error unless the text is whole pairs of lines, each ending in CR LF.
std::vector<DxfGroup> SplitDxfGroups(std::string_view text);

// The groups after each "0 <type>" up to the next 0 group, in file order: the entities of a
// type, or the entries of a table.
std::vector<std::vector<DxfGroup>> DxfEntries(const std::vector<DxfGroup>& groups, std::string_view type);

// The value of the first group with this code in an entry, or "<missing>".
std::string DxfValue(const std::vector<DxfGroup>& entry, int code);

}  // namespace draft_output_samples
