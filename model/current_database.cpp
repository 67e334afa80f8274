// Storage of the current database handle.
#include "model/current_database.h"

namespace {
host::DatabaseHandle currentDatabase = 0;
}

host::DatabaseHandle GetCurrentDatabase() { return currentDatabase; }

void SetCurrentDatabase(host::DatabaseHandle database) { currentDatabase = database; }
