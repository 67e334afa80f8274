// Reading a drawing back from its SQLite tables. Nothing in the file is trusted: every row is
// checked before it becomes part of the drawing.
#include <algorithm>
#include <array>
#include <cstring>
#include <limits>
#include <string>

#include "workbench/drawing_file_check.h"
#include "workbench/drawing_file_database.h"
#include "workbench/drawing_file_details.h"
#include "workbench/drawing_file_format.h"

namespace wb::drawing_file {
namespace {

// The fewest bytes a stored entity row takes, deleted ones included.
constexpr std::size_t kSmallestRow = 4;

// Exactly the objects of kSchema, so no forged view or trigger is ever run.
void CheckSchema(const Connection& database) {
  Statement objects(database.Get(), "SELECT type, name, tbl_name, sql FROM sqlite_schema");
  std::array<bool, kSchema.size()> seen{};
  std::size_t count = 0;
  while (objects.Step()) {
    ++count;
    const auto found = std::find_if(kSchema.begin(), kSchema.end(), [&](const SchemaObject& object) {
      return objects.ColumnText(0) == "table" && objects.ColumnText(1) == object.name &&
             objects.ColumnText(2) == object.name && objects.ColumnText(3) == object.sql;
    });
    if (found == kSchema.end()) throw BadContent("it holds tables that are not a drawing's");
    seen[static_cast<std::size_t>(found - kSchema.begin())] = true;
  }
  if (count != kSchema.size() || std::find(seen.begin(), seen.end(), false) != seen.end()) {
    throw BadContent("tables of the drawing are missing");
  }
}

void ReadTitle(const Connection& database, Drawing& drawing) {
  Statement rows(database.Get(), "SELECT title FROM drawing");
  if (!rows.Step() || rows.ColumnType(0) != SQLITE_TEXT) throw BadContent("the drawing has no title");
  drawing.title = rows.ColumnText(0);
  if (rows.Step()) throw BadContent("the drawing has more than one title");
}

void ReadLayers(const Connection& database, Drawing& drawing) {
  Statement rows(database.Get(), "SELECT layer_index, name, is_on FROM layers ORDER BY layer_index");
  std::size_t count = 0;
  for (; rows.Step(); ++count) {
    const std::string which = "layer " + std::to_string(count + 1);
    if (count >= drawing.layers.size() || rows.ColumnInt(0) != static_cast<std::int64_t>(count)) {
      throw BadContent("the layer table does not hold layers 1 to " + std::to_string(kLayerCount));
    }
    if (rows.ColumnType(1) != SQLITE_TEXT) throw BadContent(which + " has no name");
    if (rows.ColumnType(2) != SQLITE_INTEGER || (rows.ColumnInt(2) != 0 && rows.ColumnInt(2) != 1)) {
      throw BadContent(which + " is neither on nor off");
    }
    drawing.layers[count] = Layer{std::string(rows.ColumnText(1)), rows.ColumnInt(2) == 1};
  }
  if (count != drawing.layers.size()) {
    throw BadContent("the layer table does not hold layers 1 to " + std::to_string(kLayerCount));
  }
}

// The storage class each entity column may hold besides NULL, and its name for messages.
constexpr std::array<int, kEntityColumnCount> kColumnTypes = {SQLITE_INTEGER, SQLITE_BLOB, SQLITE_BLOB, SQLITE_BLOB};
constexpr std::array<const char*, kEntityColumnCount> kColumnNames = {"handle", "header", "record", "details"};

void ReadEntity(const Statement& row, Entity& entity, host::EntityHandle handle) {
  std::array<bool, kEntityColumnCount> present{};
  for (int column = kColumnHeader; column < kEntityColumnCount; ++column) {
    const auto index = static_cast<std::size_t>(column);
    const int type = row.ColumnType(column);
    if (type != SQLITE_NULL && type != kColumnTypes[index]) {
      throw BadContent(std::string("the wrong kind of value in its ") + kColumnNames[index]);
    }
    present[index] = type != SQLITE_NULL;
  }
  if (!present[kColumnHeader]) {
    if (present[kColumnRecord] || present[kColumnDetails]) throw BadContent("deleted, yet it holds data");
    return;  // stays a deleted slot
  }
  const std::span<const std::uint8_t> header = row.ColumnBlob(kColumnHeader);
  if (header.size() != sizeof entity.header.bytes) {
    throw BadContent("its header has " + std::to_string(header.size()) + " bytes");
  }
  entity.handle = handle;
  std::memcpy(entity.header.bytes, header.data(), header.size());
  if (present[kColumnRecord]) {
    const std::span<const std::uint8_t> record = row.ColumnBlob(kColumnRecord);
    entity.record.assign(record.begin(), record.end());
  }
  if (present[kColumnDetails]) DecodeDetails(row.ColumnBlob(kColumnDetails), entity);
}

void ReadEntities(const Connection& database, Drawing& drawing, std::size_t fileSize) {
  {
    Statement last(database.Get(), "SELECT max(handle) FROM entities");
    const std::int64_t rows = last.Step() ? std::max<std::int64_t>(last.ColumnInt(0), 0) : 0;
    drawing.slots.reserve(std::min(static_cast<std::size_t>(rows), fileSize / kSmallestRow));
  }
  Statement rows(database.Get(), "SELECT handle, header, record, details FROM entities ORDER BY handle");
  while (rows.Step()) {
    const std::int64_t handle = static_cast<std::int64_t>(drawing.slots.size()) + 1;
    if (handle > std::numeric_limits<host::EntityHandle>::max()) {
      throw BadContent("it holds more entities than there are handles");
    }
    if (const std::int64_t found = rows.ColumnInt(kColumnHandle); found != handle) {
      throw BadContent("handles do not count up from 1: " + std::to_string(found) + " where " +
                       std::to_string(handle) + " belongs");
    }
    try {
      ReadEntity(rows, drawing.slots.emplace_back(), static_cast<host::EntityHandle>(handle));
    } catch (const BadContent& problem) {
      throw BadContent("entity " + std::to_string(handle) + ": " + problem.what());
    }
  }
}

}  // namespace

void CheckPages(const Connection& database) {
  Statement check(database.Get(), "PRAGMA quick_check(1)");
  std::string verdict = check.Step() ? std::string(check.ColumnText(0)) : "no verdict from the page check";
  if (verdict == "ok") return;
  std::replace(verdict.begin(), verdict.end(), '\n', ' ');
  throw BadContent(verdict);
}

Drawing ReadDrawingDatabase(const Connection& database, std::size_t fileSize) {
  CheckSchema(database);
  Drawing drawing;
  ReadTitle(database, drawing);
  ReadLayers(database, drawing);
  ReadEntities(database, drawing, fileSize);
  if (std::optional<std::string> problem = FindInconsistency(drawing)) throw BadContent(*problem);
  return drawing;
}

}  // namespace wb::drawing_file
