// The workbench host session: open drawings by database handle, the current drawing in the
// `db` block, open attribute records, the call journal, fault injection, host memory
// accounting and the loaded plug-in. Every host call of shell/host is implemented over this
// one session.
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <string>
#include <utility>
#include <vector>

#include "shell/host/host_types.h"
#include "workbench/attribute_records.h"
#include "workbench/display_state.h"
#include "workbench/drawing.h"
#include "workbench/output2d_state.h"
#include "workbench/faults.h"
#include "workbench/host_memory.h"
#include "workbench/journal.h"
#include "workbench/layer_table.h"
#include "workbench/view_state.h"

namespace wb {

// What the host's loader needs of a plug-in library.
struct PluginExports {
  void (*attach)() = nullptr;
  void (*detach)() = nullptr;
  void (*entry)() = nullptr;
};

class Workbench {
 public:
  static Workbench& Get();

  // Back to a fresh host: the plug-in unloaded, every drawing closed, one new empty drawing
  // open and current (database handle 1), argument blocks zeroed apart from the standing
  // settings, journal, faults, open records and memory counts cleared, view and display as a
  // freshly started host shows them.
  void Reset();

  // Opens a drawing in the session and answers its database handle (not reused until Reset).
  host::DatabaseHandle Open(Drawing drawing);
  // Closes a drawing and every record open on it; when it was current, `db` holds 0 after.
  void Close(host::DatabaseHandle database);
  // The drawing behind a handle, or null.
  Drawing* Find(host::DatabaseHandle database) {
    // Host calls arrive in long runs on one drawing; the map is asked only when that changes.
    if (database == cachedDatabase_ && cachedDrawing_ != nullptr) return cachedDrawing_;
    return FindAndCache(database);
  }
  // Makes the drawing current: its handle goes into the `db` block. Throws std::out_of_range
  // for a handle that is not open.
  void SetCurrent(host::DatabaseHandle database);
  host::DatabaseHandle Current() const;
  // Throws std::logic_error when no drawing is current.
  Drawing& CurrentDrawing();

  Journal& GetJournal() { return journal_; }
  Faults& GetFaults() { return faults_; }
  HostMemory& Memory() { return memory_; }
  AttributeRecords& Records() { return records_; }

  // The view and display the host's commands and view calls work on; tests and the 2D
  // output read them, and may script them.
  ViewState& View() { return view_; }
  const ViewState& View() const { return view_; }
  DisplayState& Display() { return display_; }
  const DisplayState& Display() const { return display_; }
  LayerTableSnapshot& LayerTable() { return layerTable_; }

  // The command lines handed to the host with CommandMessage, in order, for the host (or a
  // scripted user) to run.
  const std::vector<std::string>& CommandLines() const { return commandLines_; }
  void AddCommandLine(std::string commandLine);
  // Who runs the command lines as they come (the main frame); without one they are only kept.
  void SetCommandLineRunner(std::function<void(const std::string&)> runner) { commandLineRunner_ = std::move(runner); }

  // Loading runs the library's attach; unloading its detach. Loading a second time first
  // unloads the first.
  void LoadPlugin(const PluginExports& exports);
  void UnloadPlugin();
  bool PluginLoaded() const { return plugin_.entry != nullptr; }
  // Runs the loaded plug-in's entry (the overlay "Pandex" does this); false when none.
  bool RunPluginEntry();

  // The 2D commands' state (long names, symbols, selection, models in the making).
  Output2DState& Output2D() { return output2D_; }
  // The file a drawing was opened from or will be saved to; what db_title_file_name reports.
  void SetDrawingPath(host::DatabaseHandle database, std::string path) { drawingPaths_[database] = std::move(path); }
  std::string DrawingPath(host::DatabaseHandle database) const;

  // Whether the host shows the manager pane as on (SetCameraManagerOn / Off).
  bool CameraManagerOn() const { return cameraManagerOn_; }
  void SetCameraManagerOn(bool on) { cameraManagerOn_ = on; }

 private:
  Workbench();
  Drawing* FindAndCache(host::DatabaseHandle database);

  std::map<host::DatabaseHandle, Drawing> drawings_;
  host::DatabaseHandle nextDatabase_ = 1;
  host::DatabaseHandle cachedDatabase_ = 0;
  Drawing* cachedDrawing_ = nullptr;
  Journal journal_;
  Faults faults_;
  HostMemory memory_;
  AttributeRecords records_;
  ViewState view_;
  DisplayState display_;
  LayerTableSnapshot layerTable_;
  std::vector<std::string> commandLines_;
  std::function<void(const std::string&)> commandLineRunner_;
  Output2DState output2D_;
  std::map<host::DatabaseHandle, std::string> drawingPaths_;
  PluginExports plugin_;
  bool cameraManagerOn_ = false;
};

}  // namespace wb
