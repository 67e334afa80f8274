// Stands for an entity of a type the model does not wrap; every operation is the base one.
#pragma once

#include "model/hr_primitive.h"

class HRUnknown : public HRPrimitive {
 public:
  HRUnknown();
  void Reserved() override;
};
