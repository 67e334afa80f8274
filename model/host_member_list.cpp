// Asking the host for a block's members.
#include "model/host_member_list.h"

#include "shell/host/qeldll.h"

namespace {

// Far beyond any block the plug-in makes; a larger count is a damaged answer, and trusting it
// would read past the end of the host's list.
constexpr std::int32_t kMostMembers = 1 << 20;

}  // namespace

HostMemberList GetHostMemberList(host::DatabaseHandle database, host::EntityHandle block) {
  HostMemberList list;
  host::EntityHandle* handles = nullptr;
  const host::Status result = get_whole_vector_of_block_members(database, block, &handles, &list.count);
  list.handles.reset(handles);
  list.valid = result == host::kOk && list.count >= 0 && list.count <= kMostMembers &&
               (list.count == 0 || list.handles != nullptr);
  return list;
}
