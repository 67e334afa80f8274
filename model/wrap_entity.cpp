// Choosing the wrapper class for an entity.
#include "model/wrap_entity.h"

#include "model/hr_block.h"
#include "model/hr_group.h"
#include "model/hr_line.h"
#include "model/hr_placed_block.h"
#include "model/hr_placed_object.h"
#include "model/hr_point.h"
#include "model/hr_text.h"
#include "model/hr_unknown.h"
#include "model/status_codes.h"
#include "shell/host/qeldll.h"

namespace {

// Null for the types no class wraps.
std::unique_ptr<HRPrimitive> NewWrapperFor(host::DatabaseHandle database, host::EntityHandle entity,
                                           std::uint8_t type) {
  switch (type) {
    case host::kTypeLine:
      if (is_attribute_exist(database, entity, "tb=") != 0) return std::make_unique<HRText>();
      return std::make_unique<HRLine>();
    case host::kTypeElement:
      return std::make_unique<HRPlacedObject>();
    case host::kTypePoint:
      return std::make_unique<HRPoint>();
    case host::kTypeGroup:
      return std::make_unique<HRGroup>();
    case host::kTypeBlock:
      return std::make_unique<HRBlock>();
    case host::kTypePlacedBlock:
      return std::make_unique<HRPlacedBlock>();
    default:
      return nullptr;
  }
}

}  // namespace

std::int16_t WrapEntity(host::DatabaseHandle database, host::EntityHandle entity,
                        std::unique_ptr<HRPrimitive>& object) {
  host::EntityHeader header{};
  std::unique_ptr<HRPrimitive> wrapper;
  if (qel_read_entity_header(database, entity, &header) == host::kOk) {
    wrapper = NewWrapperFor(database, entity, header.bytes[host::kHeaderType]);
  }
  if (wrapper == nullptr) {
    object = std::make_unique<HRUnknown>();
    return model_status::kWrongEntity;
  }
  object = std::move(wrapper);
  return object->Read(database, entity);
}
