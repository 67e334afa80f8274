// The "Build 2D" batch without its dialog: walks the views ticked for 2D, puts each on screen,
// names its output file, skips files in use and makes one 2D drawing per view.
#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "display/output_names.h"
#include "shell/host/host_types.h"

class HRCamera;

namespace HRUtility {

enum class BuildMode : std::int32_t { Cameras = 0, Sections = 1, Plans = 2, All = 3 };

// One view handled by the batch.
struct BuildStep {
  enum class Outcome : std::uint8_t { Saved, Locked, Failed };
  std::string view;  // camera name, or section or plan name and camera name
  std::string file;  // output name without extension
  Outcome outcome = Outcome::Saved;
  std::string reason;                 // why a failed view was not saved, when known
  std::vector<std::string> warnings;  // what the user should know although the view was handled
};

// Reported after every view: the bar's position and upper bound and the "File n of m" line.
struct BuildProgress {
  std::int32_t position = 0;
  std::int32_t upper = 0;
  std::string status;
  const BuildStep* step = nullptr;
};

struct BuildResult {
  bool folderRefused = false;  // the 2D folder could not be made; nothing ran
  std::string folder;
  std::int32_t total = 0;      // views ticked for 2D
  std::vector<BuildStep> steps;
  std::int32_t Saved() const;
  bool AllSaved() const { return !folderRefused && Saved() == total; }
};

class Build2DBatch {
 public:
  Build2DBatch(BuildMode mode, std::vector<host::EntityHandle> sections, std::vector<host::EntityHandle> plans);

  void OnProgress(std::function<void(const BuildProgress&)> callback) { progress_ = std::move(callback); }
  // The folder that receives the 2D folder, in place of the drawing's own folder.
  void SetOutputParent(std::string folder) { outputParent_ = std::move(folder); }
  // Lets cameras' own 2D file names lead anywhere (see OwnOutputFile).
  void AllowOwnFilesAnywhere(bool allow) { ownFilesAnywhere_ = allow; }
  // Views ticked for 2D in this mode.
  std::int32_t Count() const;
  BuildResult Run();

 private:
  std::int32_t CountCameras() const;
  template <typename Owner>
  std::int32_t CountOwned(const std::vector<host::EntityHandle>& owners) const;
  void CameraPass(const OutputNames& names, BuildResult& result);
  template <typename Owner>
  void OwnedPass(const std::vector<host::EntityHandle>& owners, bool plans, const OutputNames& names,
                 BuildResult& result);
  void Generate(const HRCamera& camera, std::string view, std::string file, bool plan, BuildResult& result);

  BuildMode mode_;
  std::vector<host::EntityHandle> sections_;
  std::vector<host::EntityHandle> plans_;
  std::function<void(const BuildProgress&)> progress_;
  void Report(const BuildStep& step);

  std::string outputParent_;
  bool ownFilesAnywhere_ = false;
  std::string drawingFolder_;
  OutputFileClaims claims_;
  std::int32_t position_ = 0;
  std::int32_t upper_ = 0;
};

}  // namespace HRUtility
