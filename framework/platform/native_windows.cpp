// The operating-system calls on Windows: the system's loader and its shell.
#include <windows.h>
#include <shellapi.h>

#include "framework/platform/native.h"

namespace framework::platform {

std::vector<std::string> LibraryFileNames(std::string_view name) { return {std::string(name)}; }

char PathSeparator() { return '\\'; }

void* OpenLibrary(const std::string& path) { return reinterpret_cast<void*>(::LoadLibraryA(path.c_str())); }

Function FindSymbol(void* library, const std::string& name) {
  return reinterpret_cast<Function>(::GetProcAddress(static_cast<HMODULE>(library), name.c_str()));
}

void CloseLibrary(void* library) { ::FreeLibrary(static_cast<HMODULE>(library)); }

bool OpenWithSystem(const std::string& file, const std::string& parameters, const std::string& directory, int show) {
  const HINSTANCE result = ::ShellExecuteA(nullptr, "open", file.c_str(), parameters.empty() ? nullptr : parameters.c_str(),
                                           directory.empty() ? nullptr : directory.c_str(), show);
  return reinterpret_cast<INT_PTR>(result) > 32;
}

}  // namespace framework::platform
