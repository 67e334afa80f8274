// What the pane's tree items stand for: a root's data is a section's or plan's entity handle
// or a general camera's index, a child's the index of a camera of its section or plan. Sections
// and plans own cameras through the same operations, so the pane handles both with one piece
// of code, choosing the class by the item's kind.
#pragma once

#include <cstdint>

#include "framework/win_types.h"
#include "shell/host/host_types.h"
#include "shell/pandex_app.h"
#include "views/hr_plane.h"
#include "views/hr_section.h"

namespace pane {

// Item data holds 32 bits.
inline host::EntityHandle HandleOf(DWORD_PTR data) {
  return static_cast<host::EntityHandle>(static_cast<std::uint32_t>(data));
}
inline std::int32_t IndexOf(DWORD_PTR data) { return static_cast<std::int32_t>(static_cast<std::uint32_t>(data)); }
inline DWORD_PTR ItemData(std::int32_t value) { return static_cast<DWORD_PTR>(static_cast<std::uint32_t>(value)); }

// Runs `action` on a fresh section (kind 1) or plan (kind 2) and answers its result.
template <class Action>
auto WithOwner(int kind, Action action) {
  if (kind == 1) {
    HRSection section;
    return action(section);
  }
  HRPlane plan;
  return action(plan);
}

// A section's cut, a plan's view, or one of their cameras applied to the host view.
inline std::int16_t ShowOwnerView(HRSection& section, std::int32_t camera) { return section.ShowView(camera); }
inline std::int16_t ShowOwnerView(HRPlane& plan, std::int32_t camera) { return plan.ShowView(camera, TheApp()); }

}  // namespace pane
