// The member list of a block as the host hands it out, checked before anything trusts its count.
#pragma once

#include <cstdint>

#include "model/host_allocation.h"
#include "shell/host/host_types.h"

struct HostMemberList {
  HostAllocation<host::EntityHandle> handles;
  std::int32_t count = 0;
  // False when the host refused, or answered a count no list can have.
  bool valid = false;
};

HostMemberList GetHostMemberList(host::DatabaseHandle database, host::EntityHandle block);
