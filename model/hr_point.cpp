// Point values: nothing is read, updated or created; only the class marker is written.
#include "model/hr_point.h"

#include "model/host_point.h"
#include "model/status_codes.h"

HRPoint::HRPoint() : HRPrimitive("HRPoint") {}

HRPoint::HRPoint(float x, float y, float z) : HRPoint() { SetPosition(x, y, z); }

std::int16_t HRPoint::Read(host::DatabaseHandle, host::EntityHandle) { return model_status::kSuccess; }

std::int16_t HRPoint::Update(host::DatabaseHandle) { return model_status::kSuccess; }

std::int16_t HRPoint::Create(host::DatabaseHandle) {
  WriteClassMarker();
  return model_status::kSuccess;
}

void HRPoint::Reserved() {}

HRMath::Vector HRPoint::GetPosition() const { return ToVector(point_.position); }
