// What the library exports to the host: the entry and the load and unload notifications the
// host's loader sends on attach and detach.
#pragma once

// The one entry; the sub-command is in globi[0].
void Pandex();

namespace pandex {

// Constructs the process-wide objects (application object, current database, ...).
void LibraryAttach();
// Destroys them again; after this the library holds no state.
void LibraryDetach();

struct Exports {
  void (*attach)();
  void (*detach)();
  void (*entry)();
};
constexpr Exports kExports{&LibraryAttach, &LibraryDetach, &Pandex};

}  // namespace pandex
