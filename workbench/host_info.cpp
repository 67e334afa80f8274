// The host's information library: whether the manager pane is on.
#include "shell/host/qelinfo.h"
#include "workbench/host_call_support.h"

using namespace wb;

void SetCameraManagerOn() {
  if (call::Fault(__func__)) return;
  Workbench::Get().SetCameraManagerOn(true);
  call::JournalHostCall(__func__);
}

void SetCameraManagerOff() {
  if (call::Fault(__func__)) return;
  Workbench::Get().SetCameraManagerOn(false);
  call::JournalHostCall(__func__);
}
