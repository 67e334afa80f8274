// Views of the call journal that tests compare against expected sequences.
#include "workbench/journal.h"

namespace wb {

std::vector<std::string> Journal::Names(JournalEntry::Kind kind) const {
  std::vector<std::string> names;
  for (const JournalEntry& entry : entries_) {
    if (entry.kind == kind) names.push_back(entry.name);
  }
  return names;
}

std::vector<std::pair<host::EntityHandle, std::int32_t>> Journal::ChangeRecords() const {
  std::vector<std::pair<host::EntityHandle, std::int32_t>> records;
  for (const JournalEntry& entry : entries_) {
    if (entry.kind == JournalEntry::Kind::ChangeRecord) records.emplace_back(entry.entity, entry.code);
  }
  return records;
}

}  // namespace wb
