// Opening a drawing in a fresh workbench and loading the plug-in over it.
#include "app/plugin_session.h"

#include "shell/plugin_exports.h"
#include "workbench/workbench.h"

namespace app {

PluginSession::PluginSession(wb::Drawing drawing) {
  wb::Workbench& bench = wb::Workbench::Get();
  bench.Reset();
  const host::DatabaseHandle previous = bench.Current();
  bench.SetCurrent(bench.Open(std::move(drawing)));
  bench.Close(previous);
  bench.LoadPlugin({pandex::kExports.attach, pandex::kExports.detach, pandex::kExports.entry});
}

PluginSession::~PluginSession() { wb::Workbench::Get().UnloadPlugin(); }

const wb::Drawing& PluginSession::Drawing() const { return wb::Workbench::Get().CurrentDrawing(); }

}  // namespace app
