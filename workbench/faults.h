// Fault injection: rules that make chosen host calls fail so every error path can be reached.
#pragma once

#include <cstdint>
#include <limits>
#include <optional>
#include <string>
#include <vector>

#include "shell/host/host_types.h"

namespace wb {

// A rule matches a call by function name and, when given, by entity handle or attribute name
// (for commands, overlays and command lines: the command text). It lets `skip` matching calls
// pass, then fails `times` matching calls (negative: every one) by answering `result`.
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
  void Clear() { rules_.clear(); }
  bool Armed() const { return !rules_.empty(); }

  // Asked at the start of each host call; answers the result to fail with, if a rule fires.
  // Rules are tried in the order they were added and the first that fires decides; spent
  // rules are dropped, so an idle session pays one branch per call.
  std::optional<std::int32_t> Check(const char* call, host::EntityHandle entity = FaultRule::kAnyEntity,
                                    const char* attribute = nullptr) {
    if (rules_.empty()) [[likely]]
      return std::nullopt;
    return CheckRules(call, entity, attribute);
  }

 private:
  std::optional<std::int32_t> CheckRules(const char* call, host::EntityHandle entity, const char* attribute);
  std::vector<FaultRule> rules_;
};

}  // namespace wb
