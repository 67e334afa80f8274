// Calls into the host's main library: database and entities, attribute records, walks, the
// change record, commands, memory and small geometry helpers. Every call answers 1 for
// success unless its comment says otherwise.
#pragma once

#include <cstdint>

#include "shell/host/argument_blocks.h"
#include "shell/host/host_types.h"

using host::DatabaseHandle;
using host::EntityHandle;
using host::RecordHandle;
using host::Status;

extern "C" {

// --- Entities --------------------------------------------------------------------------
Status qel_read_entity_header(DatabaseHandle database, EntityHandle entity, host::EntityHeader* header);
Status qel_update_entity_header(DatabaseHandle database, EntityHandle entity, const host::EntityHeader* header);
Status qel_delete_entity(DatabaseHandle database, EntityHandle entity);

Status qel_read_line(DatabaseHandle database, EntityHandle entity, host::LineRecord* line);
Status qel_update_line(DatabaseHandle database, EntityHandle entity, const host::LineRecord* line);
Status qel_add_line(DatabaseHandle database, EntityHandle* newEntity, const host::LineRecord* line);
// A text is a line entity holding its text under "t="; `style` names the host's text style.
Status qel_add_text(DatabaseHandle database, EntityHandle* newEntity, const host::LineRecord* line,
                    const char* style, const char* text, std::int16_t mode);

// Blocks: `hostName` and `hostList` are host allocations the caller releases with log_free.
Status qel_read_block(DatabaseHandle database, EntityHandle entity, host::BlockRecord* block, char** hostName);
Status qel_update_block(DatabaseHandle database, EntityHandle entity, const host::BlockRecord* block);
Status qel_create_block(DatabaseHandle database, EntityHandle* newEntity, std::int32_t memberCount,
                        const EntityHandle* members, const char* name, const host::BlockRecord* block);
Status qel_delete_block(DatabaseHandle database, EntityHandle entity);
Status get_whole_vector_of_block_members(DatabaseHandle database, EntityHandle entity, EntityHandle** hostList,
                                         std::int32_t* count);
Status qel_add_members_to_block(DatabaseHandle database, EntityHandle block, std::int32_t count,
                                const EntityHandle* members);
Status qel_unlink_members_from_block(DatabaseHandle database, EntityHandle block, std::int32_t count,
                                     const EntityHandle* members);

Status qel_read_group(DatabaseHandle database, EntityHandle entity, host::GroupRecord* group, char** hostName);
Status qel_update_group(DatabaseHandle database, EntityHandle entity, const host::GroupRecord* group);
Status qel_create_group(DatabaseHandle database, EntityHandle* newEntity, std::int32_t memberCount,
                        const EntityHandle* members, const char* name, const host::GroupRecord* group);
Status qel_delete_group(DatabaseHandle database, EntityHandle entity);

Status qel_read_placed_block(DatabaseHandle database, EntityHandle entity, host::PlacedBlockRecord* placed,
                             char** hostName);
Status qel_update_placed_block(DatabaseHandle database, EntityHandle entity, const host::PlacedBlockRecord* placed,
                               std::int32_t flags);
Status qel_add_placed_block(DatabaseHandle database, EntityHandle* newEntity, const char* name,
                            const host::PlacedBlockRecord* placed);

Status qel_read_element(DatabaseHandle database, EntityHandle entity, host::ElementRecord* element);
Status qel_update_element(DatabaseHandle database, EntityHandle entity, const host::ElementRecord* element);
Status qel_add_element(DatabaseHandle database, EntityHandle* newEntity, const host::ElementRecord* element,
                       std::int32_t flags);
// Host-allocated texts (release with log_free); null when the entity is no element.
char* qel_get_config_path(DatabaseHandle database, EntityHandle entity);
char* qel_get_element_name(DatabaseHandle database, EntityHandle entity, const char* shortName);
// Writes the up-to-8-character library short name of `fileName` into `buffer` (9 bytes) and
// returns it.
const char* qel_get_short_name(const char* fileName, char* buffer);

// --- Attribute records -----------------------------------------------------------------
// `status` is set to 1 when the record is open.
RecordHandle qel_open_attribute_record(DatabaseHandle database, EntityHandle entity, std::int16_t* status);
Status qel_close_attribute_record(DatabaseHandle database, RecordHandle record);

Status qel_set_string_attribute(RecordHandle record, const char* name, const char* text);
Status qel_read_string_attribute(RecordHandle record, const char* name, char** hostText);
Status qel_set_short_attribute(RecordHandle record, const char* name, std::int16_t value);
Status qel_read_short_attribute(RecordHandle record, const char* name, std::int16_t* value);
Status qel_set_float_attribute(RecordHandle record, const char* name, float value, std::int16_t format);
Status qel_read_float_attribute(RecordHandle record, const char* name, float* value);
Status qel_set_float_vector_attribute(RecordHandle record, const char* name, const float* values,
                                      std::int32_t count, std::int16_t format);
// Reads exactly `count` values into `values`; a shorter stored vector is refused.
Status qel_read_fixed_float_vector(RecordHandle record, const char* name, float* values, std::int32_t count);
Status qel_read_fixed_short_vector(RecordHandle record, const char* name, std::int16_t* values, std::int32_t count);
Status qel_set_short_vector_attribute(RecordHandle record, const char* name, const std::int16_t* values,
                                      std::int32_t count);
Status qel_read_unknown_short_vector(RecordHandle record, const char* name, std::int32_t* count,
                                     std::int16_t** hostValues);
Status qel_set_long_vector_attribute(RecordHandle record, const char* name, std::int32_t count,
                                     const std::int32_t* values);
// The unknown-length readers hand back the count and a host list (release with log_free).
Status qel_read_unknown_long_vector(RecordHandle record, const char* name, std::int32_t* count,
                                    std::int32_t** hostValues);
Status qel_read_unknown_float_vector(RecordHandle record, const char* name, std::int32_t* count,
                                     float** hostValues);
Status qel_remove_attribute_from_record(RecordHandle record, const char* name);
// Answers 1 when the entity's record holds the attribute, 0 otherwise.
std::int16_t is_attribute_exist(DatabaseHandle database, EntityHandle entity, const char* name);

// --- Walks -----------------------------------------------------------------------------
// Start with *entity = 0 and *cursor = 0; each call delivering an entity answers 1, the end
// of the walk answers 0.
Status loop_on_database(DatabaseHandle database, EntityHandle* entity, std::int32_t* cursor);
Status loop_on_database_blank(DatabaseHandle database, EntityHandle* entity, std::int32_t* cursor);
Status loop_on_database_blank_h(DatabaseHandle database, EntityHandle* entity, std::int32_t* cursor,
                                host::EntityHeader* header);

// --- Change record ---------------------------------------------------------------------
// (entity, 1) created, (entity, 2) removed, (entity, 5) changed, (-1, -1) closes the series.
void write_to_record(EntityHandle entity, std::int32_t code);

// --- Commands --------------------------------------------------------------------------
Status execute_internal_command(const char* name);
Status execute_quorvel_overlay(const char* name);
void CommandMessage(const char* commandLine);

// --- Memory ----------------------------------------------------------------------------
void log_free(void* hostMemory);
char* log_str_dup_new(const char* text, const char* sourceName, std::int32_t line);

// --- Geometry and text helpers ---------------------------------------------------------
// View frame from three points (origin, towards x, in the xy plane) as a row-vector matrix.
void g32d(const float points[9], float matrix[16], std::int32_t* status);
float distance_3d(const host::Point3f* a, const host::Point3f* b);
// Answers 1 when the text holds double-byte characters.
std::int16_t iskanji_string(const char* text);

}  // extern "C"
