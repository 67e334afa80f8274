// Calls into the host's main library used to make 2D drawings: long names, file locks, special
// folders, symbols, the category walk and selection.
#pragma once

#include <cstdint>

#include "shell/host/host_types.h"

namespace host {
constexpr int kLockTextSize = 100;  // each of Session_CheckLockEx's two text buffers
}

extern "C" {

// The full path of the current drawing file (host-owned).
const char* db_title_file_name();

// File names registered by kind for the next host command that reads them. The result word
// is the host's; callers preset it.
void qel_put_long_name(const char* name, std::int32_t kind, std::int32_t* word);
// The name registered under the kind (host-owned; empty when none).
const char* qel_get_long_name(std::int32_t kind);

// Answers 1 when another user has the file in use; the two texts receive who and since when.
host::Status Session_CheckLockEx(const char* file, char userText[host::kLockTextSize],
                                 char detailText[host::kLockTextSize]);

// A host-allocated path in one of the host's special folders (release with log_free).
char* GetFileFromSpecialDir(std::int32_t kind, char letter);

// Host configuration symbols: non-zero when the symbol exists; the text is host-allocated.
std::int32_t GetSymbolString(const char* name, char** text);
void SetSymbolString(const char* name, const char* value);

// Walks every entity: start with *entity = 0; each call delivers the next entity's handle, its
// four category bytes (layer number, code, flags, kind) and sets *end non-zero when no entity
// is left.
void dbloop(host::DatabaseHandle database, host::EntityHandle* entity, std::uint8_t bytes[4], std::int16_t* end);
// Adds the entity to the host's selection.
host::Status select_app_entity(host::DatabaseHandle database, host::EntityHandle entity);

}  // extern "C"
