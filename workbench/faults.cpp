// Matching host calls against the armed fault rules.
#include "workbench/faults.h"

#include <cstring>
#include <utility>

namespace wb {

namespace {

bool Matches(const FaultRule& rule, const char* call, host::EntityHandle entity, const char* attribute) {
  if (rule.call != call) return false;
  if (rule.entity != FaultRule::kAnyEntity && rule.entity != entity) return false;
  if (!rule.attribute.empty() && (attribute == nullptr || rule.attribute != attribute)) return false;
  return true;
}

}  // namespace

void Faults::Add(FaultRule rule) {
  // A rule that can never fire would only slow every call down.
  if (rule.times == 0) return;
  rules_.push_back(std::move(rule));
}

void Faults::FailNext(const std::string& call, std::int32_t result) {
  FaultRule rule;
  rule.call = call;
  rule.result = result;
  Add(std::move(rule));
}

std::optional<std::int32_t> Faults::CheckRules(const char* call, host::EntityHandle entity, const char* attribute) {
  if (call == nullptr) return std::nullopt;
  for (auto rule = rules_.begin(); rule != rules_.end(); ++rule) {
    if (!Matches(*rule, call, entity, attribute)) continue;
    if (rule->skip > 0) {
      --rule->skip;
      continue;
    }
    const std::int32_t result = rule->result;
    if (rule->times > 0 && --rule->times == 0) rules_.erase(rule);
    return result;
  }
  return std::nullopt;
}

}  // namespace wb
