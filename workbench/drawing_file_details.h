// The byte encoding of an entity's details: its name, library names, members and attribute
// record, kept together in one column so that the many entities without any cost one NULL.
#pragma once

#include <cstdint>
#include <span>
#include <vector>

#include "workbench/drawing.h"

namespace wb::drawing_file {

// Whether the entity has any details to store.
bool HasDetails(const Entity& entity);

// Appends the details to `out`; throws BadContent for values no file can hold.
void EncodeDetails(const Entity& entity, std::vector<std::uint8_t>& out);

// Sets the entity's details from the bytes; throws BadContent for bytes that are not a whole
// encoding, whatever the bytes are.
void DecodeDetails(std::span<const std::uint8_t> bytes, Entity& entity);

}  // namespace wb::drawing_file
