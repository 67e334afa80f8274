// The library's attach and detach on Windows: the system's loader calls DllMain when the host
// loads the library and when it frees it.
#include "shell/plugin_exports.h"

namespace {

// The loader's reasons (DLL_PROCESS_DETACH, DLL_PROCESS_ATTACH); thread notices need nothing.
constexpr unsigned long kProcessDetach = 0;
constexpr unsigned long kProcessAttach = 1;

}  // namespace

// Declared by hand (BOOL, HINSTANCE, DWORD, LPVOID) so that the plug-in needs no system header.
extern "C" int __stdcall DllMain(void*, unsigned long reason, void*) {
  try {
    if (reason == kProcessAttach) pandex::LibraryAttach();
    if (reason == kProcessDetach) pandex::LibraryDetach();
    return 1;
  } catch (...) {
    // Nothing may reach the loader; a failed attach makes the host's LoadLibrary fail instead.
    return 0;
  }
}
