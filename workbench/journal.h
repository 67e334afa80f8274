// The call journal: what the host saw the plug-in do, in order.
#pragma once

#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include "shell/host/host_types.h"

namespace wb {

struct JournalEntry {
  enum class Kind : std::uint8_t {
    Command,          // execute_internal_command(name)
    Overlay,          // execute_quorvel_overlay(name)
    CommandMessage,   // CommandMessage(name)
    ChangeRecord,     // write_to_record(entity, code)
    AttributeWrite,   // a set_* call on a record: name = attribute, entity = owner
    AttributeRemove,  // qel_remove_attribute_from_record: name = attribute, entity = owner
    HostCall,         // any other host function that changes state: name = function
  };
  Kind kind;
  std::string name;
  host::EntityHandle entity = 0;
  std::int32_t code = 0;

  bool operator==(const JournalEntry&) const = default;
};

class Journal {
 public:
  void Record(JournalEntry entry) { entries_.push_back(std::move(entry)); }
  const std::vector<JournalEntry>& Entries() const { return entries_; }
  // The names of the entries of one kind, in order (commands, attribute names, ...).
  std::vector<std::string> Names(JournalEntry::Kind kind) const;
  // The (entity, code) pairs handed to write_to_record, in order.
  std::vector<std::pair<host::EntityHandle, std::int32_t>> ChangeRecords() const;
  void Clear() { entries_.clear(); }

 private:
  std::vector<JournalEntry> entries_;
};

}  // namespace wb
