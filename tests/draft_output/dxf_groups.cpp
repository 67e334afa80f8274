// DXF text as a list of groups, the way a test wants to look at it.
#include "tests/draft_output/dxf_groups.h"

#include <stdexcept>

namespace draft_output_samples {

std::vector<DxfGroup> SplitDxfGroups(std::string_view text) {
  std::vector<std::string> lines;
  while (!text.empty()) {
    const std::size_t end = text.find("\r\n");
    if (end == std::string_view::npos) throw std::runtime_error("a DXF line does not end in CR LF");
    lines.emplace_back(text.substr(0, end));
    text.remove_prefix(end + 2);
  }
  if (lines.size() % 2 != 0) throw std::runtime_error("a DXF group code without its value");
  std::vector<DxfGroup> groups;
  for (std::size_t i = 0; i < lines.size(); i += 2) groups.push_back({std::stoi(lines[i]), lines[i + 1]});
  return groups;
}

std::vector<std::vector<DxfGroup>> DxfEntries(const std::vector<DxfGroup>& groups, std::string_view type) {
  std::vector<std::vector<DxfGroup>> entries;
  for (std::size_t i = 0; i < groups.size(); ++i) {
    if (groups[i].code != 0 || groups[i].value != type) continue;
    std::vector<DxfGroup>& entry = entries.emplace_back();
    for (std::size_t k = i + 1; k < groups.size() && groups[k].code != 0; ++k) entry.push_back(groups[k]);
  }
  return entries;
}

std::string DxfValue(const std::vector<DxfGroup>& entry, int code) {
  for (const DxfGroup& group : entry) {
    if (group.code == code) return group.value;
  }
  return "<missing>";
}

}  // namespace draft_output_samples
