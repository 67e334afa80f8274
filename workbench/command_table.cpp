// Name lookup over the command families.
#include "workbench/command_table.h"

#include <exception>
#include <initializer_list>
#include <string_view>
#include <unordered_map>

namespace wb {

namespace {

using CommandMap = std::unordered_map<std::string_view, CommandHandler>;

CommandMap BuildMap(std::initializer_list<std::span<const NamedCommand>> families) {
  CommandMap map;
  for (std::span<const NamedCommand> family : families) {
    for (const NamedCommand& command : family) map.emplace(command.name, command.run);
  }
  return map;
}

std::optional<host::Status> Run(const CommandMap& map, std::string_view name) {
  const auto found = map.find(name);
  if (found == map.end()) return std::nullopt;
  // Nothing is thrown across the host boundary: a command that fails answers 0.
  try {
    return found->second();
  } catch (const std::exception&) {
    return host::Status{0};
  }
}

}  // namespace

std::optional<host::Status> RunHostCommand(std::string_view name) {
  static const CommandMap commands = BuildMap({ViewCommands(), DisplayCommands(), Output2DCommands()});
  return Run(commands, name);
}

std::optional<host::Status> RunHostOverlay(std::string_view name) {
  static const CommandMap overlays = BuildMap({DisplayOverlays(), Output2DOverlays()});
  return Run(overlays, name);
}

}  // namespace wb
