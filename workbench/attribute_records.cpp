// Bookkeeping of open attribute records.
#include "workbench/attribute_records.h"

#include <algorithm>
#include <limits>

namespace wb {

host::RecordHandle AttributeRecords::Open(host::DatabaseHandle database, host::EntityHandle entity) {
  const host::RecordHandle handle = next_;
  // After two thousand million opens start again at 1; nothing stays open that long.
  next_ = next_ == std::numeric_limits<host::RecordHandle>::max() ? 1 : next_ + 1;
  open_.push_back(OpenRecord{handle, database, entity});
  return handle;
}

bool AttributeRecords::Close(host::DatabaseHandle database, host::RecordHandle record) {
  for (auto open = open_.rbegin(); open != open_.rend(); ++open) {
    if (open->handle != record) continue;
    if (open->database != database) return false;
    open_.erase(std::next(open).base());
    return true;
  }
  return false;
}

void AttributeRecords::CloseAllOf(host::DatabaseHandle database) {
  std::erase_if(open_, [database](const OpenRecord& open) { return open.database == database; });
}

void AttributeRecords::Clear() {
  open_.clear();
  next_ = 1;
}

}  // namespace wb
