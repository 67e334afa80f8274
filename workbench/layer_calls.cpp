// The host's layer calls over the current drawing's 256 layers.
#include <cstdint>
#include <limits>

#include "shell/host/qeldll_view.h"
#include "workbench/host_call_support.h"
#include "workbench/layer_table.h"

using namespace wb;

namespace {

// The drawing whose table the handle names, or null.
Drawing* DrawingOfTable(host::LayerTableHandle table) {
  const std::int64_t database = static_cast<std::int64_t>(table) - kLayerTableHandleBase;
  if (database <= 0 || database > std::numeric_limits<host::DatabaseHandle>::max()) return nullptr;
  return Workbench::Get().Find(static_cast<host::DatabaseHandle>(database));
}

Layer* FindLayer(host::LayerTableHandle table, std::int32_t layer) {
  Drawing* drawing = DrawingOfTable(table);
  if (drawing == nullptr || layer < 0 || layer >= kLayerCount) return nullptr;
  return &drawing->layers[static_cast<std::size_t>(layer)];
}

// Faults name the layer index where other calls name an entity, so one layer can be made to
// refuse; the journal carries the index as the entry's code.
host::Status SwitchLayer(const char* function, host::LayerTableHandle table, std::int32_t layer, bool on) {
  if (auto fault = call::Fault(function, layer)) return call::AsStatus(*fault);
  Layer* found = FindLayer(table, layer);
  if (found == nullptr) return 0;
  found->on = on;
  call::AddToJournal(JournalEntry::Kind::HostCall, function, 0, layer);
  return host::kOk;
}

}  // namespace

const host::LayerEntry* GetLayersInCurrentHDL() {
  if (call::Fault(__func__)) return nullptr;
  Workbench& session = Workbench::Get();
  const Drawing* drawing = session.Find(session.Current());
  if (drawing == nullptr) return nullptr;
  LayerTableSnapshot& table = session.LayerTable();
  for (std::size_t i = 0; i < table.entries.size(); ++i) {
    table.entries[i] = {drawing->layers[i].on ? 0 : host::kLayerOffState, 0};
  }
  return table.entries.data();
}

host::LayerTableHandle HDL_Main() {
  if (auto fault = call::Fault(__func__)) return *fault;
  const host::DatabaseHandle current = Workbench::Get().Current();
  if (Workbench::Get().Find(current) == nullptr) return 0;
  return kLayerTableHandleBase + current;
}

host::Status HDL_Set_Layer_On(host::LayerTableHandle table, std::int32_t layer) {
  return SwitchLayer(__func__, table, layer, true);
}

host::Status HDL_Set_Layer_Off(host::LayerTableHandle table, std::int32_t layer) {
  return SwitchLayer(__func__, table, layer, false);
}

const char* HDL_Get_LayerName(host::LayerTableHandle table, std::int32_t layer) {
  if (call::Fault(__func__, layer)) return nullptr;
  const Layer* found = FindLayer(table, layer);
  if (found == nullptr) return nullptr;
  std::string& name = Workbench::Get().LayerTable().name;
  name = found->name;
  return name.c_str();
}
