// What the library exports to the host: the entry and the load and unload notifications the
// host's loader sends on attach and detach.
#pragma once

// On Windows the entry is the library's one export, under its plain name: a C function with the
// C calling convention and no arguments, which the host finds by name and calls directly or
// through its overlay "Pandex".
#if defined(_WIN32)
#define PANDEX_EXPORT __declspec(dllexport)
#else
#define PANDEX_EXPORT
#endif

// The one entry; the sub-command is in globi[0]. Nothing is thrown out of it.
extern "C" PANDEX_EXPORT void Pandex();

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
