// The host's argument blocks and current-drawing block. The caller fills what a command
// reads, runs the command, and reads the results from the same blocks.
#pragma once

#include <cstdint>

#include "shell/host/host_api.h"
#include "shell/host/host_types.h"

namespace host {

constexpr int kGlobiSize = 64;
constexpr int kGlobrSize = 256;
constexpr int kGlobpSize = 64;
constexpr int kGlobcSize = 512;

// The current-drawing block. The handle is what every database call takes.
struct DbBlock {
  DatabaseHandle handle;
};

}  // namespace host

extern "C" {

extern QELDLL_DATA std::int32_t globi[host::kGlobiSize];
extern QELDLL_DATA float globr[host::kGlobrSize];
extern QELDLL_DATA host::Point3f globp[host::kGlobpSize];
extern QELDLL_DATA char globc[host::kGlobcSize];
extern QELDLL_DATA host::DbBlock db;

}  // extern "C"
