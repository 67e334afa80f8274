// Host calls on host memory: releasing what the host handed out, and host-owned copies.
#include <cstring>

#include "shell/host/qeldll.h"
#include "workbench/host_call_support.h"

using namespace wb;

// A pointer the host did not hand out, or one released already, is counted, never freed.
void log_free(void* hostMemory) {
  if (call::Fault(__func__)) return;
  Workbench::Get().Memory().Release(hostMemory);
}

// The source name and line tell a developer where a copy was made; this host keeps no record
// of them.
char* log_str_dup_new(const char* text, const char* /*sourceName*/, std::int32_t /*line*/) {
  if (call::Fault(__func__) || text == nullptr) return nullptr;
  return Workbench::Get().Memory().DuplicateText(text, std::strlen(text));
}
