// Any bytes as a pane script: reading them must either refuse them with a ScriptError naming a
// line of the text, or give actions in line order, each on a line the text has. Anything else
// (a crash, a sanitizer report, another exception, a hang) is a finding.
#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <string_view>

#include "app/pane_script/pane_script.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string_view text(reinterpret_cast<const char*>(data), size);
  const auto lines = static_cast<int>(std::count(text.begin(), text.end(), '\n')) + 1;
  try {
    const app::script::Script script = app::script::ReadScript(text);
    int previous = 0;
    for (const app::script::Action& action : script.actions) {
      if (action.line <= previous || action.line > lines || action.verb.empty()) std::abort();
      previous = action.line;
    }
  } catch (const app::script::ScriptError& error) {
    if (error.Line() < 1 || error.Line() > lines) std::abort();
  }
  return 0;
}
