// The wrapper of last resort.
#include "model/hr_unknown.h"

HRUnknown::HRUnknown() {
  SetHeaderByte(host::kHeaderByte8, 0);
  SetHeaderByte(host::kHeaderByte9, 0);
  SetHeaderByte(host::kHeaderType, 0);
}

void HRUnknown::Reserved() {}
