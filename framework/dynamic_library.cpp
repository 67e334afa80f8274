// The module table over the platform's loader: one handle a loaded library, counted loads.
#include "framework/dynamic_library.h"

#include <map>
#include <vector>

#include "framework/platform/native.h"

namespace {

struct Loaded {
  void* native = nullptr;
  int loads = 0;
};

struct ModuleTable {
  std::map<std::uint32_t, Loaded> modules;
  std::vector<std::string> folders;
  std::uint32_t next = 1;
};

ModuleTable& Table() {
  static ModuleTable table;
  return table;
}

void* OpenByName(std::string_view name) {
  const std::vector<std::string> files = framework::platform::LibraryFileNames(name);
  for (const std::string& folder : Table().folders) {
    for (const std::string& file : files) {
      if (void* native = framework::platform::OpenLibrary(folder + framework::platform::PathSeparator() + file)) {
        return native;
      }
    }
  }
  for (const std::string& file : files) {
    if (void* native = framework::platform::OpenLibrary(file)) return native;
  }
  return nullptr;
}

}  // namespace

HMODULE LoadLibrary(std::string_view name) {
  if (name.empty()) return HMODULE();
  void* native = OpenByName(name);
  if (native == nullptr) return HMODULE();
  ModuleTable& t = Table();
  // The loader hands out the same library again for a second load; so does this table.
  for (auto& [handle, loaded] : t.modules) {
    if (loaded.native == native) {
      ++loaded.loads;
      return HMODULE(handle);
    }
  }
  t.modules.emplace(t.next, Loaded{native, 1});
  return HMODULE(t.next++);
}

FARPROC GetProcAddress(HMODULE module, std::string_view name) {
  const auto it = Table().modules.find(module.Value());
  if (it == Table().modules.end() || name.empty()) return nullptr;
  return framework::platform::FindSymbol(it->second.native, std::string(name));
}

BOOL FreeLibrary(HMODULE module) {
  auto& modules = Table().modules;
  const auto it = modules.find(module.Value());
  if (it == modules.end()) return FALSE;
  framework::platform::CloseLibrary(it->second.native);
  if (--it->second.loads == 0) modules.erase(it);
  return TRUE;
}

namespace framework {

void AddLibraryFolder(std::string folder) { Table().folders.push_back(std::move(folder)); }
void ClearLibraryFolders() { Table().folders.clear(); }
std::size_t LoadedLibraryCount() { return Table().modules.size(); }

}  // namespace framework
