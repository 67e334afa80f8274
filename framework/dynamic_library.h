// Libraries loaded while the program runs, by name, over the system's dynamic loader (the
// host's colour library is found this way). A library loaded twice is the same module until it
// is freed as often as it was loaded.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "framework/win_types.h"

// An exported function, to be cast to its real type by the caller.
using FARPROC = void (*)();

// Null when no library of that name can be loaded. On Linux a name "ColorMRU.dll" is looked
// for as "libColorMRU.so", then "ColorMRU.so", then as given, first in the folders added below,
// then where the system's loader looks.
HMODULE LoadLibrary(std::string_view name);
FARPROC GetProcAddress(HMODULE module, std::string_view name);
BOOL FreeLibrary(HMODULE module);

namespace framework {

// Folders searched before the system's own places, in the order added (the host adds the
// folder of its libraries).
void AddLibraryFolder(std::string folder);
void ClearLibraryFolders();
std::size_t LoadedLibraryCount();

}  // namespace framework
