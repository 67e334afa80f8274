// Calls into the host's design-mode library.
#pragma once

#include <cstdint>

#include "shell/host/host_types.h"

extern "C" {

// Non-zero when the entity is a frame of the design mode's sheet layout.
std::int16_t IsDsgFrameEntity(host::DatabaseHandle database, host::EntityHandle entity);

}  // extern "C"
