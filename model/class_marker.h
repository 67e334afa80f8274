// The "@Class=" marker that tells which of the plug-in's classes made an entity.
#pragma once

#include <string>

#include "shell/host/host_types.h"

inline constexpr const char* kClassAttribute = "@Class=";

// True only when the entity's record holds the marker and it equals `className` byte for byte;
// a record that does not open or lacks the marker belongs to no class.
bool HasClassMarker(host::DatabaseHandle database, host::EntityHandle entity, const std::string& className);
