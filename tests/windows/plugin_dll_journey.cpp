// Loads Pandex.dll the way the host does and follows a journey through it on the sample house:
// the loader attaches and detaches the library, its one export runs sub-commands on the
// workbench's drawing, and the host's display commands re-enter it while a 2D build of every
// ticked camera, section and plan runs. Ends with "N passed, N failed" and a non-zero exit on
// any failure.
#include <windows.h>

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "display/build_batch.h"
#include "samples/sample_drawing.h"
#include "shell/host/argument_blocks.h"
#include "shell/plugin_exports.h"
#include "tests/record_layout/record_layout.h"
#include "views/hr_camera_mgr.h"
#include "views/section_symbols.h"
#include "views/view_collection.h"
#include "workbench/workbench.h"

namespace {

int passed = 0;
int failed = 0;

void Check(bool ok, const std::string& what) {
  std::printf("%s %s\n", ok ? "ok    " : "FAILED", what.c_str());
  ++(ok ? passed : failed);
}

using Entry = void (*)();
Entry dllEntry = nullptr;
int reentries = 0;

// What the workbench's overlay "Pandex" runs: the library's export, counted.
void CountedEntry() {
  ++reentries;
  dllEntry();
}

void RunSubCommand(std::int32_t subCommand) {
  globi[0] = subCommand;
  dllEntry();
}

// The hidden flags of the section symbols of the current drawing, in handle order.
std::vector<bool> SectionSymbolsHidden() {
  std::vector<bool> hidden;
  for (host::EntityHandle section : CollectSectionHandles(db.handle)) {
    hidden.push_back(wb::Workbench::Get().CurrentDrawing().Find(section)->Hidden());
  }
  return hidden;
}

void HideSectionSymbolsInTheHost() {
  for (host::EntityHandle section : CollectSectionHandles(db.handle)) {
    wb::Workbench::Get().CurrentDrawing().Find(section)->header.bytes[host::kHeaderFlags] |= host::kFlagHidden;
  }
}

std::string ReadFile(const std::filesystem::path& path) {
  std::ifstream in(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

HMODULE LoadPlugin() {
  HMODULE module = LoadLibraryW(L"Pandex.dll");
  Check(module != nullptr, "LoadLibrary(\"Pandex.dll\") runs the library's attach");
  if (module == nullptr) return nullptr;
  dllEntry = reinterpret_cast<Entry>(reinterpret_cast<void*>(GetProcAddress(module, "Pandex")));
  Check(dllEntry != nullptr, "the library exports \"Pandex\" under its plain name");
  if (dllEntry == nullptr) return nullptr;
  // Loaded and attached by the system: the host only learns where the entry is.
  wb::Workbench::Get().LoadPlugin({nullptr, nullptr, &CountedEntry});
  return module;
}

void UnloadPlugin(HMODULE module) {
  wb::Workbench::Get().UnloadPlugin();
  Check(FreeLibrary(module) != 0 && GetModuleHandleW(L"Pandex.dll") == nullptr,
        "FreeLibrary runs the library's detach and unloads it");
  dllEntry = nullptr;
}

// The sub-commands on the loaded library: symbols come back only once the pane exists; the
// rest leave the drawing as it is.
void SubCommandJourney() {
  wb::Workbench& bench = wb::Workbench::Get();
  HideSectionSymbolsInTheHost();
  const std::vector<bool> allHidden(SectionSymbolsHidden().size(), true);
  RunSubCommand(3);
  Check(allHidden.size() == 2 && SectionSymbolsHidden() == allHidden,
        "sub-command 3 before the pane exists leaves both section symbols hidden");
  RunSubCommand(1);
  RunSubCommand(3);
  Check(SectionSymbolsHidden() == std::vector<bool>(2, false),
        "sub-command 3 after sub-command 1 shows every section symbol again");
  const std::vector<std::pair<host::EntityHandle, std::int32_t>> changes = bench.GetJournal().ChangeRecords();
  const std::vector<host::EntityHandle> sections = CollectSectionHandles(db.handle);
  Check(std::all_of(sections.begin(), sections.end(),
                    [&](host::EntityHandle section) {
                      return std::find(changes.begin(), changes.end(), std::pair{section, 5}) != changes.end();
                    }),
        "each shown section symbol is written to the change record as changed");

  const wb::Drawing before = bench.CurrentDrawing();
  globr[0] = 2.0F;
  for (std::int32_t subCommand : {7, 8, 5, 0, 9}) RunSubCommand(subCommand);
  Check(bench.CurrentDrawing() == before, "sub-commands 7, 8, 5 and unknown codes leave the drawing unchanged");
}

// A target another program holds open without sharing, as an editor does, is in use: the
// cameras' build skips it and leaves it as it was, and makes the others.
void LockedTargetJourney(const HRUtility::BuildStep& first) {
  const std::filesystem::path dxf = first.file + ".dxf";
  const std::string before = ReadFile(dxf);
  HANDLE held = CreateFileW(dxf.c_str(), GENERIC_READ | GENERIC_WRITE, 0, nullptr, OPEN_EXISTING, 0, nullptr);
  HRUtility::Build2DBatch cameras(HRUtility::BuildMode::Cameras, {}, {});
  const HRUtility::BuildResult result = cameras.Run();
  CloseHandle(held);
  Check(held != INVALID_HANDLE_VALUE && result.steps.size() == 3 &&
            result.steps[0].outcome == HRUtility::BuildStep::Outcome::Locked && result.Saved() == 2 &&
            ReadFile(dxf) == before,
        "a target held open by another program is skipped as in use and kept, the others are made");
}

// The 2D build of every ticked view. The batch runs in this program (the pane's "Build 2D" menu
// is its way in on the real host); each switch back to the geometric mode runs the host's
// overlay "Pandex", which re-enters the loaded library.
void BuildJourney(const std::filesystem::path& folder) {
  pandex::LibraryAttach();
  SetDatabase(db.handle);
  reentries = 0;
  HRUtility::Build2DBatch batch(HRUtility::BuildMode::All, CollectSectionHandles(db.handle),
                                CollectPlanHandles(db.handle));
  const HRUtility::BuildResult result = batch.Run();
  Check(result.total == 6 && result.AllSaved(), "the 2D build saves all 6 ticked views (" +
                                                    std::to_string(result.Saved()) + " of " +
                                                    std::to_string(result.total) + ")");
  Check(reentries > 0, "the build re-entered the library " + std::to_string(reentries) + " times");
  bool filesWhole = !result.steps.empty();
  for (const HRUtility::BuildStep& step : result.steps) {
    const std::string dxf = ReadFile(step.file + ".dxf");
    const std::string svg = ReadFile(step.file + ".svg");
    const bool whole = dxf.find("ENTITIES") != std::string::npos && dxf.find("LINE") != std::string::npos &&
                       dxf.ends_with("0\r\nEOF\r\n") && svg.find("<svg") != std::string::npos &&
                       std::filesystem::path(step.file).parent_path() == folder / "2D_";
    if (!whole) std::printf("       %s -> %s is not a whole drawing\n", step.view.c_str(), step.file.c_str());
    filesWhole = filesWhole && whole;
  }
  Check(filesWhole, "every view has a DXF with lines and an SVG preview in the 2D_ folder");
  if (!result.steps.empty()) LockedTargetJourney(result.steps.front());
  pandex::LibraryDetach();
}

}  // namespace

int main() {
  PrintRecordLayout(stdout);
  Check(sizeof(void*) == 4 && sizeof(LPARAM) == 4, "a 32-bit build");

  const std::filesystem::path folder =
      std::filesystem::temp_directory_path() / ("pandex-journey-" + std::to_string(GetCurrentProcessId()));
  std::filesystem::create_directories(folder);
  wb::Workbench& bench = wb::Workbench::Get();
  wb::Drawing house = samples::MakeSampleDrawing();
  bench.SetCurrent(bench.Open(std::move(house)));
  bench.SetDrawingPath(db.handle, (folder / "house.pdx").string());

  if (HMODULE module = LoadPlugin()) {
    SubCommandJourney();
    BuildJourney(folder);
    UnloadPlugin(module);
  }
  // A second load starts afresh: the pane of the first is gone with its detach.
  if (HMODULE module = LoadPlugin()) {
    HideSectionSymbolsInTheHost();
    RunSubCommand(3);
    Check(SectionSymbolsHidden() == std::vector<bool>(2, true), "a reloaded library has no pane until asked");
    UnloadPlugin(module);
  }
  Check(bench.Memory().Outstanding() == 0, "every text and list the host handed out was released");

  std::error_code ignored;
  std::filesystem::remove_all(folder, ignored);
  std::printf("%d passed, %d failed\n", passed, failed);
  return failed == 0 ? 0 : 1;
}
