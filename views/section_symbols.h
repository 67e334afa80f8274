// Visibility of every section symbol of the current drawing at once, and the test that tells
// a section's entity from any other.
#pragma once

#include <cstdint>

#include "shell/host/host_types.h"

// 1 while the section symbols are meant to be shown; written by camera application, read by
// the plan view and the solid modes. 0 when the library loads.
extern std::uint8_t SectionsShown;

// True when the entity's "@Class=" is exactly "HRSection".
bool IsSection(host::DatabaseHandle database, host::EntityHandle entity);
// Hides the symbol of every visible section of the current database.
void HideSectionSymbols();
// Shows the symbol of every section of the current database, hidden ones included.
void ShowSectionSymbols();
