// Host calls that hand the host work by name: internal commands, overlays, command lines, and
// the change record.
#include <cstring>

#include "shell/host/qeldll.h"
#include "workbench/command_table.h"
#include "workbench/host_call_support.h"

using namespace wb;

namespace {

constexpr const char* kPluginOverlay = "Pandex";

}  // namespace

// Every command is journaled, known or not; one the host does not have answers 0, since
// nothing was done.
Status execute_internal_command(const char* name) {
  if (auto fault = call::Fault(__func__, call::kNoEntity, name)) return call::AsStatus(*fault);
  if (name == nullptr) return 0;
  call::AddToJournal(JournalEntry::Kind::Command, name);
  return RunHostCommand(name).value_or(Status{0});
}

// The overlay "Pandex" re-enters the loaded plug-in through its entry; it is journaled before
// it runs, so the journal shows the plug-in's nested calls after it.
Status execute_quorvel_overlay(const char* name) {
  if (auto fault = call::Fault(__func__, call::kNoEntity, name)) return call::AsStatus(*fault);
  if (name == nullptr) return 0;
  call::AddToJournal(JournalEntry::Kind::Overlay, name);
  if (std::strcmp(name, kPluginOverlay) == 0) return Workbench::Get().RunPluginEntry() ? host::kOk : Status{0};
  return RunHostOverlay(name).value_or(Status{0});
}

void CommandMessage(const char* commandLine) {
  if (call::Fault(__func__, call::kNoEntity, commandLine) || commandLine == nullptr) return;
  call::AddToJournal(JournalEntry::Kind::CommandMessage, commandLine);
  Workbench::Get().AddCommandLine(commandLine);
}

void write_to_record(EntityHandle entity, std::int32_t code) {
  if (call::Fault(__func__, entity)) return;
  call::AddToJournal(JournalEntry::Kind::ChangeRecord, __func__, entity, code);
}
