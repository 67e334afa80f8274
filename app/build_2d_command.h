// `pandex build-2d`: one 2D drawing per ticked view, with progress on the terminal.
#pragma once

#include <ostream>
#include <string>

#include "display/build_batch.h"

namespace app {

struct Build2DOptions {
  std::string drawing;    // empty: the built-in sample
  std::string outputDir;  // receives the 2D_ folder in place of the drawing's folder; empty: no such folder
  HRUtility::BuildMode mode = HRUtility::BuildMode::All;
  bool progressBar = false;  // redraw one line on a terminal instead of a line per view
  bool ownFilesAnywhere = false;  // cameras' own 2D files may lie outside the drawing's folder
};

// Runs the batch; answers the process exit code (0 when every ticked view was saved).
int RunBuild2D(const Build2DOptions& options, std::ostream& out, std::ostream& errors);

}  // namespace app
