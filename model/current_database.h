// The process-wide database every operation without a database argument works on.
#pragma once

#include "shell/host/host_types.h"

host::DatabaseHandle GetCurrentDatabase();
// Set to the host's drawing when the library loads, and by the camera manager's SetDatabase.
void SetCurrentDatabase(host::DatabaseHandle database);
