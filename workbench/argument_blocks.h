// Setting the host's argument blocks to the state of a freshly started host.
#pragma once

namespace wb {

// Zeroes globi, globr, globp, globc and db, then fills the standing settings a fresh host
// holds (text settings, unit letter, decimals).
void ResetArgumentBlocks();

}  // namespace wb
