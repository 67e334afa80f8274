// The shell's "open": recorded, checked, and handed to the platform's opener when allowed.
#include "framework/shell_execute.h"

#include <filesystem>

#include "framework/platform/native.h"

namespace {

std::vector<framework::ShellRequest>& Log() {
  static std::vector<framework::ShellRequest> log;
  return log;
}

bool& OpenerAllowed() {
  static bool allowed = false;
  return allowed;
}

INT_PTR Open(std::string_view verb, const std::string& file, const std::string& parameters, const std::string& directory,
             int show) {
  if (!verb.empty() && verb != "open") return SE_ERR_NOASSOC;
  std::error_code error;
  const std::filesystem::path path = directory.empty() ? std::filesystem::path(file) : std::filesystem::path(directory) / file;
  if (!std::filesystem::exists(path, error)) return SE_ERR_FNF;
  if (!OpenerAllowed()) return SE_ERR_NOASSOC;
  return framework::platform::OpenWithSystem(file, parameters, directory, show) ? 33 : SE_ERR_NOASSOC;
}

}  // namespace

INT_PTR ShellExecute(HWND owner, std::string_view verb, std::string_view file, std::string_view parameters,
                     std::string_view directory, int show) {
  framework::ShellRequest request{owner, std::string(verb), std::string(file), std::string(parameters),
                                  std::string(directory), show, 0};
  request.result = Open(verb, request.file, request.parameters, request.directory, show);
  Log().push_back(request);
  return request.result;
}

namespace framework {

const std::vector<ShellRequest>& ShellRequestLog() { return Log(); }
void ClearShellRequestLog() { Log().clear(); }
void AllowSystemOpener(bool allow) { OpenerAllowed() = allow; }

}  // namespace framework
