// Asking the system to open a document (a report in the viewer for text files). Every request
// is recorded; the system's opener runs only when the program has allowed it, so that tests and
// scripted runs never start a viewer.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "framework/win_types.h"

constexpr INT_PTR SE_ERR_FNF = 2;       // the file does not exist
constexpr INT_PTR SE_ERR_NOASSOC = 31;  // nothing opens it (no opener, or not allowed to start one)

// Answers more than 32 when the system took the request. Only the verb "open" (or none) is known.
INT_PTR ShellExecute(HWND owner, std::string_view verb, std::string_view file, std::string_view parameters,
                     std::string_view directory, int show);

namespace framework {

struct ShellRequest {
  HWND owner;
  std::string verb;
  std::string file;
  std::string parameters;
  std::string directory;
  int show = 0;
  INT_PTR result = 0;
};

const std::vector<ShellRequest>& ShellRequestLog();
void ClearShellRequestLog();
// Off until a program that shows its windows to a person turns it on.
void AllowSystemOpener(bool allow);

}  // namespace framework
