// Opening and closing of attribute records.
#include "model/attribute_record.h"

#include <cstdint>

#include "shell/host/qeldll.h"

AttributeRecord::AttributeRecord(host::DatabaseHandle database, host::EntityHandle entity) : database_(database) {
  std::int16_t status = 0;
  record_ = qel_open_attribute_record(database, entity, &status);
  open_ = status == host::kOk;
}

AttributeRecord::~AttributeRecord() { Close(); }

void AttributeRecord::Close() {
  if (!open_) return;
  open_ = false;
  qel_close_attribute_record(database_, record_);
}
