// The factory that wraps any entity in the wrapper class matching its type.
#pragma once

#include <cstdint>
#include <memory>

#include "model/hr_primitive.h"

// Hands the caller exactly one new wrapper that has read the entity, and answers that read's
// result. An entity that cannot be read or is of a type no class wraps gives an unread
// HRUnknown and -4.
std::int16_t WrapEntity(host::DatabaseHandle database, host::EntityHandle entity,
                        std::unique_ptr<HRPrimitive>& object);
