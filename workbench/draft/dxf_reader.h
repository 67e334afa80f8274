// Reads back the DXF files DxfWriter writes, so that a new 2D drawing can be merged into the
// file an earlier generation left at the same target.
#pragma once

#include <cstdint>
#include <filesystem>
#include <istream>
#include <stdexcept>
#include <string_view>

#include "workbench/draft/sheet.h"

namespace wb::draft {

// Whatever the reader cannot take over whole: a damaged or truncated file, an entity other than
// LINE and TEXT (merging would silently drop it), a value no sheet can carry. The message names
// the file and the line.
class DxfReadError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

// A sheet larger than this is not something a generation wrote; reading it would only exhaust
// memory.
constexpr std::uintmax_t kMaxDxfFileBytes = std::uintmax_t{1} << 30;

// Layers come back under their sheet index (kept in the entities' extended data) and their
// DXF names; entities drawn "by layer" take the layer's colour. Throws DxfReadError.
Sheet ReadDxfSheet(const std::filesystem::path& path);
// The same from a stream; source names it in messages.
Sheet ParseDxfSheet(std::istream& in, std::string_view source);

}  // namespace wb::draft
