// The operating-system calls on Linux: dlopen for libraries, xdg-open for documents.
#include <dlfcn.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <cstring>

#include "framework/platform/native.h"

extern char** environ;

namespace framework::platform {

std::vector<std::string> LibraryFileNames(std::string_view name) {
  std::string stem(name);
  if (stem.find('/') != std::string::npos) return {stem};  // a path is taken as it is
  if (stem.size() > 4 && (stem.ends_with(".dll") || stem.ends_with(".DLL"))) stem.resize(stem.size() - 4);
  return {"lib" + stem + ".so", stem + ".so", std::string(name)};
}

char PathSeparator() { return '/'; }

void* OpenLibrary(const std::string& path) { return ::dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL); }

Function FindSymbol(void* library, const std::string& name) {
  void* symbol = ::dlsym(library, name.c_str());
  Function function = nullptr;
  static_assert(sizeof function == sizeof symbol);
  std::memcpy(&function, &symbol, sizeof function);  // the loader hands functions out as data pointers
  return function;
}

void CloseLibrary(void* library) { ::dlclose(library); }

namespace {

// The opener found on the PATH, or empty.
std::string FindOpener() {
  const char* path = std::getenv("PATH");
  std::string_view folders = path != nullptr ? path : "";
  while (!folders.empty()) {
    const auto colon = folders.find(':');
    std::string candidate(folders.substr(0, colon));
    candidate += "/xdg-open";
    if (!candidate.starts_with("/xdg-open") && ::access(candidate.c_str(), X_OK) == 0) return candidate;
    folders = colon == std::string_view::npos ? std::string_view() : folders.substr(colon + 1);
  }
  return {};
}

}  // namespace

bool OpenWithSystem(const std::string& file, const std::string&, const std::string& directory, int) {
  const std::string opener = FindOpener();
  if (opener.empty()) return false;
  // The document goes to the opener as one argument, never through a shell.
  std::string target = file;
  if (!directory.empty() && !file.starts_with('/')) target = directory + "/" + file;
  std::string program = opener;
  char* argv[] = {program.data(), target.data(), nullptr};
  pid_t child = 0;
  if (::posix_spawn(&child, opener.c_str(), nullptr, nullptr, argv, environ) != 0) return false;
  int status = 0;
  // The opener hands the document to its viewer and ends.
  if (::waitpid(child, &status, 0) != child) return false;
  return WIFEXITED(status) && WEXITSTATUS(status) == 0;
}

}  // namespace framework::platform
