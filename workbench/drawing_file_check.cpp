// Consistency rules shared by saving and opening drawing files.
#include "workbench/drawing_file_check.h"

#include <cstdint>
#include <vector>

namespace wb::drawing_file {
namespace {

// The record size the host calls of a type read and write; other types keep records the
// plug-in never reads, of any size.
std::optional<std::size_t> RecordSize(std::uint8_t type) {
  switch (type) {
    case host::kTypeLine: return sizeof(host::LineRecord);
    case host::kTypePoint: return sizeof(host::PointRecord);
    case host::kTypeBlock: return sizeof(host::BlockRecord);
    case host::kTypeGroup: return sizeof(host::GroupRecord);
    case host::kTypePlacedBlock: return sizeof(host::PlacedBlockRecord);
    case host::kTypeElement: return sizeof(host::ElementRecord);
    default: return std::nullopt;
  }
}

// The block a placed block inserts, or 0.
host::EntityHandle PlacedBlockTarget(const Entity& entity) {
  if (entity.Type() != host::kTypePlacedBlock || entity.record.size() != sizeof(host::PlacedBlockRecord)) return 0;
  return ReadRecord<host::PlacedBlockRecord>(entity).block;
}

// The entities an entity contains, by index: its members, then (at index members.size()) the
// block it places, 0 when none.
host::EntityHandle Contained(const Entity& entity, std::size_t index) {
  return index < entity.members.size() ? entity.members[index] : PlacedBlockTarget(entity);
}

std::string Named(const Entity& entity) { return "entity " + std::to_string(entity.handle); }

// Also collects the slots that contain other entities, the only ones a cycle can pass through.
std::optional<std::string> FindBadSlot(const Drawing& drawing, std::vector<std::size_t>& containers) {
  const auto count = static_cast<host::EntityHandle>(drawing.slots.size());
  for (std::size_t i = 0; i < drawing.slots.size(); ++i) {
    const Entity& entity = drawing.slots[i];
    if (!entity.Alive()) continue;
    if (entity.handle != static_cast<host::EntityHandle>(i + 1)) {
      return "slot " + std::to_string(i + 1) + " holds handle " + std::to_string(entity.handle);
    }
    const std::optional<std::size_t> size = RecordSize(entity.Type());
    if (size && !entity.record.empty() && entity.record.size() != *size) {
      return Named(entity) + " has a record of " + std::to_string(entity.record.size()) +
             " bytes where its type takes " + std::to_string(*size);
    }
    for (host::EntityHandle member : entity.members) {
      if (member < 1 || member > count) {
        return Named(entity) + " lists the member " + std::to_string(member) + " that the drawing never had";
      }
    }
    const host::EntityHandle block = PlacedBlockTarget(entity);
    if (block < 0 || block > count) {
      return Named(entity) + " places the block " + std::to_string(block) + " that the drawing never had";
    }
    if (Contained(entity, 0) != 0) containers.push_back(i);
  }
  return std::nullopt;
}

// Depth-first walk over the containment graph with an explicit stack, so that deep nesting
// cannot overflow the call stack.
std::optional<std::string> FindContainmentCycle(const Drawing& drawing, const std::vector<std::size_t>& containers) {
  enum : std::uint8_t { kUnseen, kOnPath, kDone };
  // Entities that contain nothing cannot be on a cycle: marked done, they are never visited.
  std::vector<std::uint8_t> state(drawing.slots.size(), kDone);
  for (std::size_t container : containers) state[container] = kUnseen;
  struct Step {
    std::size_t slot;
    std::size_t next;
  };
  std::vector<Step> path;
  for (std::size_t root : containers) {
    if (state[root] != kUnseen) continue;
    state[root] = kOnPath;
    path.push_back({root, 0});
    while (!path.empty()) {
      Step& step = path.back();
      const Entity& entity = drawing.slots[step.slot];
      if (step.next > entity.members.size()) {
        state[step.slot] = kDone;
        path.pop_back();
        continue;
      }
      const host::EntityHandle inner = Contained(entity, step.next++);
      if (inner == 0) continue;  // a placed block without a block
      const auto slot = static_cast<std::size_t>(inner) - 1;
      if (state[slot] == kOnPath) return Named(drawing.slots[slot]) + " contains itself";
      if (state[slot] == kUnseen) {
        state[slot] = kOnPath;
        path.push_back({slot, 0});
      }
    }
  }
  return std::nullopt;
}

}  // namespace

std::optional<std::string> FindInconsistency(const Drawing& drawing) {
  std::vector<std::size_t> containers;
  if (std::optional<std::string> problem = FindBadSlot(drawing, containers)) return problem;
  return FindContainmentCycle(drawing, containers);
}

}  // namespace wb::drawing_file
