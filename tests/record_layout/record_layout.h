// The sizes and offsets of the records the plug-in shares with the host, as this build lays
// them out, for a person comparing builds (static_asserts already hold them fixed).
#pragma once

#include <cstdio>

void PrintRecordLayout(std::FILE* out);
