// The host's own commands and overlays by name: what execute_internal_command and
// execute_quorvel_overlay run once the call is journaled and past the fault check.
#pragma once

#include <optional>
#include <span>
#include <string_view>

#include "shell/host/host_types.h"

namespace wb {

using CommandHandler = host::Status (*)();

struct NamedCommand {
  std::string_view name;
  CommandHandler run;
};

// The families of the table, each kept beside the state it changes.
std::span<const NamedCommand> ViewCommands();
std::span<const NamedCommand> DisplayCommands();
std::span<const NamedCommand> DisplayOverlays();
std::span<const NamedCommand> Output2DCommands();
std::span<const NamedCommand> Output2DOverlays();

// A solid build that carries a section or plan cut (globc[243] 's', the cut's points in
// globp[0..3]) makes that cut the view's; back in plain geometry no cut is shown.
void TakeCutFromSolidBuild();
void DropCuts();

// The result of the named command or overlay; nullopt when the host has none of that name.
std::optional<host::Status> RunHostCommand(std::string_view name);
std::optional<host::Status> RunHostOverlay(std::string_view name);

}  // namespace wb
