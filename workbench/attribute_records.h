// The attribute records the plug-in has open: each record handle is bound to one entity of one
// drawing until it is closed.
#pragma once

#include <cstddef>
#include <vector>

#include "shell/host/host_types.h"

namespace wb {

struct OpenRecord {
  host::RecordHandle handle;
  host::DatabaseHandle database;
  host::EntityHandle entity;
};

class AttributeRecords {
 public:
  // Handles count up and are not reused, so a record used after its close is refused rather
  // than landing on someone else's entity.
  host::RecordHandle Open(host::DatabaseHandle database, host::EntityHandle entity);
  // False when the record is not open in that database.
  bool Close(host::DatabaseHandle database, host::RecordHandle record);
  // The open record, or null. Few records are open at a time, newest most used: a backwards
  // scan beats any map here.
  const OpenRecord* Find(host::RecordHandle record) const {
    for (auto open = open_.rbegin(); open != open_.rend(); ++open) {
      if (open->handle == record) return &*open;
    }
    return nullptr;
  }
  void CloseAllOf(host::DatabaseHandle database);
  std::size_t OpenCount() const { return open_.size(); }
  void Clear();

 private:
  std::vector<OpenRecord> open_;
  host::RecordHandle next_ = 1;
};

}  // namespace wb
