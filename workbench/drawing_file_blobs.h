// Compact byte encodings of an entity's member list and attribute record, as stored in a
// drawing file. Little-endian whatever the machine, so files move between machines.
#pragma once

#include <cstdint>
#include <span>
#include <vector>

#include "shell/host/host_types.h"
#include "workbench/drawing.h"

namespace wb::drawing_file {

// The encoders append to `out`; they throw BadContent for values no file can hold.
void EncodeMembers(const std::vector<host::EntityHandle>& members, std::vector<std::uint8_t>& out);
void EncodeAttributes(const std::vector<Attribute>& attributes, std::vector<std::uint8_t>& out);

// The decoders replace `members` / `attributes`; they throw BadContent for bytes that are not a
// whole encoding, whatever the bytes are.
void DecodeMembers(std::span<const std::uint8_t> bytes, std::vector<host::EntityHandle>& members);
void DecodeAttributes(std::span<const std::uint8_t> bytes, std::vector<Attribute>& attributes);

}  // namespace wb::drawing_file
