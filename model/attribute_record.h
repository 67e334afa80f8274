// An entity's attribute record, open for the lifetime of this object and closed on every path.
#pragma once

#include "shell/host/host_types.h"

class AttributeRecord {
 public:
  AttributeRecord(host::DatabaseHandle database, host::EntityHandle entity);
  ~AttributeRecord();
  AttributeRecord(const AttributeRecord&) = delete;
  AttributeRecord& operator=(const AttributeRecord&) = delete;

  bool IsOpen() const { return open_; }
  host::RecordHandle Get() const { return record_; }
  // Closes ahead of the end of scope, where later steps must run on a closed record.
  void Close();

 private:
  host::DatabaseHandle database_;
  host::RecordHandle record_ = 0;
  bool open_ = false;
};
