// The workbench host session: open drawings by database handle, the current drawing in the
// `db` block, the call journal, fault injection, host memory accounting and the loaded
// plug-in. Every host call of shell/host is implemented over this one session.
#pragma once

#include <cstdint>
#include <limits>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "shell/host/host_types.h"
#include "workbench/drawing.h"

namespace wb {

// What the host saw the plug-in do, in order.
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

// Makes chosen host calls fail. A rule matches a call by function name and, when given, by
// entity handle or attribute name; it lets `skip` matching calls pass, then fails `times`
// matching calls (negative: every one) by answering `result`.
struct FaultRule {
  static constexpr host::EntityHandle kAnyEntity = std::numeric_limits<host::EntityHandle>::min();
  std::string call;
  host::EntityHandle entity = kAnyEntity;
  std::string attribute;  // empty: any
  int skip = 0;
  int times = 1;
  std::int32_t result = 0;
};

class Faults {
 public:
  void Add(FaultRule rule);
  // Shorthand: the next call of `call` answers `result`.
  void FailNext(const std::string& call, std::int32_t result = 0);
  void Clear();
  bool Armed() const { return !rules_.empty(); }
  // Asked by each host call; answers the result to fail with, if a rule fires.
  std::optional<std::int32_t> Check(const char* call, host::EntityHandle entity = FaultRule::kAnyEntity,
                                    const char* attribute = nullptr);

 private:
  std::vector<FaultRule> rules_;
};

// Counts every text and list the host hands out until log_free releases it.
class HostMemory {
 public:
  char* DuplicateText(const std::string& text);
  void* Allocate(std::size_t bytes);
  // Answers false (and changes nothing) when the pointer is no live host allocation.
  bool Release(void* memory);
  std::int64_t Outstanding() const { return outstanding_; }
  std::int64_t TotalHandedOut() const { return total_; }
  std::int64_t BadReleases() const { return badReleases_; }

 private:
  std::int64_t outstanding_ = 0;
  std::int64_t total_ = 0;
  std::int64_t badReleases_ = 0;
};

// What the host's loader needs of a plug-in library.
struct PluginExports {
  void (*attach)() = nullptr;
  void (*detach)() = nullptr;
  void (*entry)() = nullptr;
};

class Workbench {
 public:
  static Workbench& Get();

  // Back to a fresh host: the plug-in unloaded, every drawing closed, one new empty drawing
  // open and current, argument blocks zeroed, journal, faults and memory counts cleared.
  void Reset();

  // Opens a drawing in the session and answers its database handle (never reused).
  host::DatabaseHandle Open(Drawing drawing);
  void Close(host::DatabaseHandle database);
  // The drawing behind a handle, or null.
  Drawing* Find(host::DatabaseHandle database);
  // Makes the drawing current: its handle goes into the `db` block.
  void SetCurrent(host::DatabaseHandle database);
  host::DatabaseHandle Current() const;
  Drawing& CurrentDrawing();

  Journal& GetJournal() { return journal_; }
  Faults& GetFaults() { return faults_; }
  HostMemory& Memory() { return memory_; }

  // Loading runs the library's attach; unloading its detach. Loading a second time first
  // unloads the first.
  void LoadPlugin(const PluginExports& exports);
  void UnloadPlugin();
  bool PluginLoaded() const { return plugin_.entry != nullptr; }
  // Runs the loaded plug-in's entry (the overlay "Pandex" does this); false when none.
  bool RunPluginEntry();

 private:
  Workbench() = default;
  std::map<host::DatabaseHandle, Drawing> drawings_;
  host::DatabaseHandle nextDatabase_ = 1;
  Journal journal_;
  Faults faults_;
  HostMemory memory_;
  PluginExports plugin_;
};

}  // namespace wb
