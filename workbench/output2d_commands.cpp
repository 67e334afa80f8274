// The host's 2D commands and overlays: build the 2D model of the view (all edges, or hidden
// lines removed), set entities aside and carry them over, clean lines up, and merge the result
// into the target's DXF and SVG files.
#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <filesystem>
#include <system_error>

#include "shell/host/argument_blocks.h"
#include "workbench/command_table.h"
#include "workbench/draft/dxf_reader.h"
#include "workbench/draft/generate_sheet.h"
#include "workbench/draft/preserved_entities.h"
#include "workbench/draft/sheet_files.h"
#include "workbench/draft/stroke_cleanup.h"
#include "workbench/draft/window_clip.h"
#include "workbench/workbench.h"

namespace wb {
namespace {

constexpr std::int32_t kTargetKind = 10;
constexpr std::int32_t kSourceKind = 211;
constexpr const char* kRewriteSymbol = "@config@save2drewrite";
constexpr int kCleanupSlot = 41;
constexpr int kToleranceSlot = 31;

Output2DState& State() { return Workbench::Get().Output2D(); }

draft::GenerateOptions OptionsForView(bool hideHiddenLines) {
  const ViewState& view = Workbench::Get().View();
  draft::GenerateOptions options;
  options.view.eye = view.eye;
  options.view.target = view.target;
  options.view.perspective = view.perspective;
  options.hideHiddenLines = hideHiddenLines;
  if (view.section.active) options.section = draft::SectionCut{view.section.points, view.section.cutType};
  if (view.plan.active) options.plan = draft::PlanCut{view.plan.base, view.plan.cutType};
  return options;
}

draft::Sheet ModelOfView(bool hideHiddenLines) {
  draft::Sheet sheet = draft::GenerateSheet(Workbench::Get().CurrentDrawing(), OptionsForView(hideHiddenLines));
  const Drawing& drawing = Workbench::Get().CurrentDrawing();
  for (int i = 0; i < kLayerCount; ++i) sheet.layerNames[static_cast<std::size_t>(i)] = drawing.layers[static_cast<std::size_t>(i)].name;
  return sheet;
}

// The entity flags are the host's hidden bit; blanking for the generation uses it and
// remembers which entities it changed, so that only those are shown again.
void SetHidden(host::EntityHandle handle, bool hidden) {
  Entity* entity = Workbench::Get().CurrentDrawing().Find(handle);
  if (entity == nullptr) return;
  std::uint8_t& flags = entity->header.bytes[host::kHeaderFlags];
  flags = static_cast<std::uint8_t>(hidden ? (flags | host::kFlagHidden) : (flags & ~host::kFlagHidden));
}

std::string LongName(std::int32_t kind) {
  const auto found = State().longNames.find(kind);
  return found != State().longNames.end() ? found->second : std::string();
}

// The rewrite switch: 1 (also when the symbol is missing) replaces the target.
bool OverwriteTarget() {
  const auto found = State().symbols.find(kRewriteSymbol);
  if (found == State().symbols.end()) return true;
  return std::lround(std::strtod(found->second.c_str(), nullptr)) == 1;
}

host::Status Create2DModel() {
  State().model = ModelOfView(false);
  return host::kOk;
}

host::Status HiddenLines() {
  State().hiddenLineModel = ModelOfView(true);
  return host::kOk;
}

host::Status CopyHiddenLineModel() {
  if (!State().hiddenLineModel) return 0;
  State().model = std::move(*State().hiddenLineModel);
  State().hiddenLineModel.reset();
  return host::kOk;
}

host::Status SelectionExists() {
  globr[0] = State().selection.empty() ? 0.0F : 1.0F;
  return host::kOk;
}

host::Status AddSource() {
  Output2DState& state = State();
  if (!state.model) return 0;
  state.sources.push_back(std::move(*state.model));
  state.model.reset();
  state.sourceTarget = LongName(kSourceKind);
  return host::kOk;
}

// The sources are taken whether or not they can be written: left behind, they would end up in
// the next view's file.
host::Status MergeSources() {
  Output2DState& state = State();
  std::vector<draft::Sheet> sources = std::move(state.sources);
  state.sources.clear();
  if (sources.empty() || state.sourceTarget.empty()) return 0;
  const bool replace = OverwriteTarget();
  state.lastMergeReplaced = replace;
  state.lastMerge.reset();
  try {
    Output2DState::Merge merge{state.sourceTarget, std::move(sources.front()), std::nullopt};
    for (std::size_t i = 1; i < sources.size(); ++i) merge.added = draft::MergeSheets(merge.added, sources[i]);
    // An empty drawing is what a view that failed to come out looks like; it is never saved.
    if (merge.added.strokes.empty() && merge.added.labels.empty()) return 0;
    draft::WriteSheetFiles(merge.added, merge.target, replace, &merge.before);
    state.lastMerge = std::move(merge);
  } catch (const std::exception&) {
    return 0;  // the old files stay as they were
  }
  ++state.mergesWritten;
  return host::kOk;
}

// Clips the target to the view's window. After a merge into it, only what the merge added is
// clipped: what the file held before belongs to other views and their windows.
host::Status AutoClip() {
  const std::string target = LongName(kTargetKind);
  std::optional<Output2DState::Merge> merge = std::move(State().lastMerge);
  State().lastMerge.reset();
  const std::filesystem::path dxf = target + ".dxf";
  std::error_code error;
  if (target.empty() || !std::filesystem::exists(dxf, error)) return 0;
  try {
    const std::array<double, 4>& window = Workbench::Get().View().window;
    const draft::Box2 box{{window[0], window[1]}, {window[2], window[3]}};
    draft::Sheet sheet;
    if (merge && merge->target == target) {
      sheet = std::move(merge->added);
      draft::ClipToWindow(sheet, box);
      if (merge->before) sheet = draft::MergeSheets(*merge->before, sheet);
    } else {
      sheet = draft::ReadDxfSheet(dxf);
      draft::ClipToWindow(sheet, box);
    }
    // A window beside the drawing would leave an empty file; the drawing stays unclipped.
    if (sheet.strokes.empty() && sheet.labels.empty()) return 0;
    draft::WriteSheetFiles(sheet, target, true);
  } catch (const std::exception&) {
    return 0;
  }
  return host::kOk;
}

// Overlays ----------------------------------------------------------------------------------

host::Status ClearOrKeepSelection() {
  if (globc[0] == '0') State().selection.clear();
  return host::kOk;
}

// "extract" with globr[9] = 1 sets aside what the selection shows on screen (an entity hidden
// or on a layer switched off is no part of the view); with 0 it carries that into the 2D model
// of the view, once: a later view that set nothing aside (its selection was empty) must not
// receive this one's entities.
host::Status Extract() {
  Output2DState& state = State();
  if (globr[9] == 1.0F) {
    const Drawing& drawing = Workbench::Get().CurrentDrawing();
    state.preserved.clear();
    for (const host::EntityHandle handle : state.selection) {
      const Entity* entity = drawing.Find(handle);
      if (entity != nullptr && !entity->Hidden() && drawing.layers[entity->header.bytes[host::kHeaderLayer]].on) {
        state.preserved.push_back(handle);
      }
    }
    return host::kOk;
  }
  const std::vector<host::EntityHandle> preserved = std::move(state.preserved);
  state.preserved.clear();
  if (!state.model) state.model = draft::Sheet{};
  draft::AddPreservedEntities(Workbench::Get().CurrentDrawing(), preserved, OptionsForView(false).view, *state.model);
  return host::kOk;
}

host::Status Blank() {
  Output2DState& state = State();
  switch (globc[0]) {
    case '1':  // hide the selected entities for the generation
      for (const host::EntityHandle handle : state.selection) {
        const Entity* entity = Workbench::Get().CurrentDrawing().Find(handle);
        if (entity == nullptr || entity->Hidden()) continue;
        SetHidden(handle, true);
        state.blanked.push_back(handle);
      }
      break;
    case '0':  // show them again; globr[0] = 1 tells the caller all are back
      for (const host::EntityHandle handle : state.blanked) SetHidden(handle, false);
      state.blanked.clear();
      globr[0] = 1.0F;
      break;
    case '6':
      globr[114] = 1.0F;
      break;
    default:  // '2', '3', '4': the host's other blanking passes have nothing to do here
      break;
  }
  return host::kOk;
}

host::Status CleanLines() {
  Output2DState& state = State();
  if (!state.model) return 0;
  const auto code = static_cast<int>(std::lround(globr[kCleanupSlot]));
  const double tolerance = globr[kToleranceSlot] > 0.0F ? globr[kToleranceSlot] : 0.01;
  state.lastCleanupCode = code;
  state.lastCleanupTolerance = tolerance;
  if ((code & 1) != 0) draft::RemoveCoincidentStrokes(*state.model, tolerance);
  if ((code & 2) != 0) draft::MergeCollinearStrokes(*state.model, tolerance);
  return host::kOk;
}

host::Status ConvertHiddenLines() { return State().hiddenLineModel ? host::kOk : 0; }

constexpr NamedCommand kOutput2DCommands[] = {
    {"create_2d_model", &Create2DModel},   {"hiden1", &HiddenLines},
    {"qel_copy_file", &CopyHiddenLineModel}, {"selection_exist", &SelectionExists},
    {"save2d_add_source", &AddSource},     {"merge_save2d_files", &MergeSources},
    {"AutoClip", &AutoClip},
};

constexpr NamedCommand kOutput2DOverlays[] = {
    {"qel_sel", &ClearOrKeepSelection}, {"extract", &Extract},   {"blank", &Blank},
    {"shadows", &CleanLines},           {"hconv", &ConvertHiddenLines},
};

}  // namespace

std::span<const NamedCommand> Output2DCommands() { return kOutput2DCommands; }
std::span<const NamedCommand> Output2DOverlays() { return kOutput2DOverlays; }

}  // namespace wb
