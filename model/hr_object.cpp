// Construction of the root object.
#include "model/hr_object.h"

#include <utility>

HRObject::HRObject() = default;

HRObject::HRObject(std::string className) : className_(std::move(className)) {}

HRObject::~HRObject() = default;
