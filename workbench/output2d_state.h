// What the host's 2D commands work with between calls: registered long names, configuration
// symbols, the selection, entities set aside for preservation, the 2D models being built and
// the sources waiting to be merged into the target file.
#pragma once

#include <cstdint>
#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "shell/host/host_types.h"
#include "workbench/draft/sheet.h"

namespace wb {

struct Output2DState {
  std::map<std::int32_t, std::string> longNames;  // by kind
  std::map<std::string, std::string> symbols;     // host configuration symbols
  std::vector<host::EntityHandle> selection;      // in selection order, no repeats
  std::vector<host::EntityHandle> preserved;      // set aside by "extract" to be carried over
  std::vector<host::EntityHandle> blanked;        // hidden for the generation, shown again after
  std::optional<draft::Sheet> hiddenLineModel;    // "hiden1" output before "qel_copy_file"
  std::optional<draft::Sheet> model;              // the 2D model of the view being made
  std::vector<draft::Sheet> sources;              // handed to "merge_save2d_files"
  std::string sourceTarget;                       // where those sources go
  std::filesystem::path specialFolder;            // the host's folder for its own work files
  int mergesWritten = 0;
  // The last merge: its target, what it added and what the target held before (nothing when
  // it replaced the target), so that a clip after it cuts only what was added.
  struct Merge {
    std::string target;
    draft::Sheet added;
    std::optional<draft::Sheet> before;
  };
  std::optional<Merge> lastMerge;
  // How the last clean-up and the last merge were asked to work, as the host log would show:
  // the clean-up code (1 coincident lines, 2 merge, -1 none ran) and its tolerance, and
  // whether the merge replaced its target or added to it.
  int lastCleanupCode = -1;
  double lastCleanupTolerance = 0.0;
  std::optional<bool> lastMergeReplaced;

  // Back to a host that has made no 2D drawing; keeps the special folder.
  void Reset();
};

}  // namespace wb
