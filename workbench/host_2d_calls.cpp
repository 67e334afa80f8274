// Host calls of 2D generation: long names, file locks, special folders, configuration symbols,
// the category walk and selection.
#include <algorithm>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <system_error>
#include <unistd.h>

#include "shell/host/qeldll_2d.h"
#include "workbench/draft/file_lock.h"
#include "workbench/host_call_support.h"

namespace {

using namespace wb;
using call::Fault;

Output2DState& State() { return Workbench::Get().Output2D(); }

// Host-owned texts handed out by the calls below stay valid until the next such call.
const char* Keep(std::string text) {
  static std::string kept;
  kept = std::move(text);
  return kept.c_str();
}

std::filesystem::path SpecialFolder() {
  Output2DState& state = State();
  if (state.specialFolder.empty()) {
    state.specialFolder = std::filesystem::temp_directory_path() / ("pandex-host-" + std::to_string(::getpid()));
  }
  std::error_code error;
  std::filesystem::create_directories(state.specialFolder, error);
  return state.specialFolder;
}

}  // namespace

const char* db_title_file_name() {
  if (Fault("db_title_file_name")) return nullptr;
  Workbench& bench = Workbench::Get();
  std::string path = bench.DrawingPath(bench.Current());
  if (path.empty()) path = (std::filesystem::current_path() / "untitled.pdx").string();
  return Keep(std::move(path));
}

void qel_put_long_name(const char* name, std::int32_t kind, std::int32_t* word) {
  if (auto fault = Fault("qel_put_long_name")) {
    if (word != nullptr) *word = *fault;
    return;
  }
  State().longNames[kind] = name != nullptr ? name : "";
  if (word != nullptr) *word = 1;
  call::JournalHostCall("qel_put_long_name", kind);
}

const char* qel_get_long_name(std::int32_t kind) {
  if (Fault("qel_get_long_name")) return nullptr;
  const auto found = State().longNames.find(kind);
  return Keep(found != State().longNames.end() ? found->second : std::string());
}

host::Status Session_CheckLockEx(const char* file, char userText[host::kLockTextSize],
                                 char detailText[host::kLockTextSize]) {
  if (auto fault = Fault("Session_CheckLockEx")) return call::AsStatus(*fault);
  if (file == nullptr || *file == '\0') return 0;
  const std::filesystem::path dxf = std::string(file) + ".dxf";
  bool locked = false;
  try {
    locked = draft::IsLockedByAnotherProcess(dxf);
  } catch (const std::exception&) {
    // A file that exists but cannot be opened is in no state to be replaced; a name no file
    // can have (too long, say) is nobody's file, and the save reports its own failure.
    std::error_code error;
    locked = std::filesystem::exists(dxf, error);
  }
  if (userText != nullptr) std::snprintf(userText, host::kLockTextSize, "%s", locked ? "another process" : "");
  if (detailText != nullptr) std::snprintf(detailText, host::kLockTextSize, "%s", locked ? "advisory lock held" : "");
  return locked ? 1 : 0;
}

char* GetFileFromSpecialDir(std::int32_t kind, char letter) {
  if (Fault("GetFileFromSpecialDir")) return nullptr;
  const std::string name = "work" + std::to_string(kind) + std::string(1, letter);
  return Workbench::Get().Memory().DuplicateText((SpecialFolder() / name).string());
}

std::int32_t GetSymbolString(const char* name, char** text) {
  if (text != nullptr) *text = nullptr;
  if (auto fault = Fault("GetSymbolString")) return *fault;
  if (name == nullptr || text == nullptr) return 0;
  const auto found = State().symbols.find(name);
  if (found == State().symbols.end()) return 0;
  *text = Workbench::Get().Memory().DuplicateText(found->second);
  return 1;
}

void SetSymbolString(const char* name, const char* value) {
  if (Fault("SetSymbolString") || name == nullptr) return;
  State().symbols[name] = value != nullptr ? value : "";
  call::JournalHostCall("SetSymbolString");
}

void dbloop(host::DatabaseHandle database, host::EntityHandle* entity, std::uint8_t bytes[4], std::int16_t* end) {
  if (end == nullptr || entity == nullptr || bytes == nullptr) return;
  *end = 1;
  if (Fault("dbloop")) return;
  const Drawing* drawing = Workbench::Get().Find(database);
  if (drawing == nullptr || *entity < 0) return;
  for (auto slot = static_cast<std::size_t>(*entity); slot < drawing->slots.size(); ++slot) {
    const Entity& found = drawing->slots[slot];
    if (!found.Alive()) continue;
    *entity = found.handle;
    bytes[0] = static_cast<std::uint8_t>(found.header.bytes[host::kHeaderLayer] + 1);  // layer number
    bytes[1] = found.header.bytes[host::kHeaderCategoryCode];
    bytes[2] = found.header.bytes[host::kHeaderLoopFlags];
    bytes[3] = found.header.bytes[host::kHeaderCategoryKind];
    *end = 0;
    return;
  }
}

host::Status select_app_entity(host::DatabaseHandle database, host::EntityHandle entity) {
  if (auto fault = Fault("select_app_entity", entity)) return call::AsStatus(*fault);
  if (call::FindEntity(database, entity) == nullptr) return 0;
  std::vector<host::EntityHandle>& selection = State().selection;
  if (std::find(selection.begin(), selection.end(), entity) == selection.end()) selection.push_back(entity);
  call::JournalHostCall("select_app_entity", entity);
  return host::kOk;
}
