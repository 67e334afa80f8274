// Finding every section, plan and selection set of a drawing by walking its database.
#pragma once

#include <vector>

#include "shell/host/host_types.h"

// Handles in walk order, hidden entities included.
std::vector<host::EntityHandle> CollectSectionHandles(host::DatabaseHandle database);
std::vector<host::EntityHandle> CollectPlanHandles(host::DatabaseHandle database);
// Selection sets of the current database.
std::vector<host::EntityHandle> CollectSelectionHandles();
