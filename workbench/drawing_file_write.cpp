// Writing a drawing into a fresh SQLite file: one transaction, batched inserts in handle order.
#include <span>
#include <string>
#include <vector>

#include "workbench/drawing_file_database.h"
#include "workbench/drawing_file_details.h"
#include "workbench/drawing_file_format.h"

namespace wb::drawing_file {
namespace {

// The file is a temporary that is thrown away whole when the save fails, so it needs no journal;
// without one, and with a fixed page size and nothing time-dependent, the same drawing always
// gives the same bytes. Rows are appended in order, so a small cache that spills finished pages
// to the file early is faster than one that holds the whole file in memory.
constexpr const char* kSettings =
    "PRAGMA page_size=4096; PRAGMA journal_mode=OFF; PRAGMA synchronous=FULL; "
    "PRAGMA locking_mode=EXCLUSIVE; PRAGMA cache_size=-8192;";
static_assert(kPageSize == 4096, "kSettings spells the page size out");

void WriteTitle(const Connection& database, const Drawing& drawing) {
  Statement insert(database.Get(), "INSERT INTO drawing(title) VALUES(?1)");
  insert.BindText(1, drawing.title);
  insert.Step();
}

void WriteLayers(const Connection& database, const Drawing& drawing) {
  Statement insert(database.Get(), "INSERT INTO layers(layer_index, name, is_on) VALUES(?1, ?2, ?3)");
  for (std::size_t i = 0; i < drawing.layers.size(); ++i) {
    insert.BindInt(1, static_cast<std::int64_t>(i));
    insert.BindText(2, drawing.layers[i].name);
    insert.BindInt(3, drawing.layers[i].on ? 1 : 0);
    insert.Step();
    insert.Reset();
  }
}

// Rows go in many to a statement: running a statement costs SQLite far more than a row does.
constexpr std::size_t kRowsPerInsert = 64;

// SQLite numbers the rows of an empty table 1, 2, 3 and on by itself, in the order they are
// given, which is the slots' handles; appending is also faster than inserting given handles.
std::string InsertSql(std::size_t rows) {
  std::string sql = "INSERT INTO entities(header, record, details) VALUES(?, ?, ?)";
  for (std::size_t row = 1; row < rows; ++row) sql += ", (?, ?, ?)";
  return sql;
}

// Binds the slots to the statement's rows; `details` holds one buffer per row, as SQLite reads
// them only when the statement runs. A deleted slot binds NULLs only.
void BindSlots(Statement& insert, std::span<const Entity> slots, std::vector<std::vector<std::uint8_t>>& details) {
  for (std::size_t row = 0; row < slots.size(); ++row) {
    const Entity& entity = slots[row];
    const int first = static_cast<int>(row) * (kEntityColumnCount - 1);
    std::vector<std::uint8_t>& detail = details[row];
    detail.clear();
    const bool alive = entity.Alive();
    if (alive && HasDetails(entity)) EncodeDetails(entity, detail);
    insert.BindBlobOrNull(first + kColumnHeader,
                          alive ? std::span<const std::uint8_t>(entity.header.bytes) : std::span<const std::uint8_t>());
    insert.BindBlobOrNull(first + kColumnRecord, alive ? std::span<const std::uint8_t>(entity.record)
                                                       : std::span<const std::uint8_t>());
    insert.BindBlobOrNull(first + kColumnDetails, detail);
  }
}

void WriteEntities(const Connection& database, const Drawing& drawing) {
  const std::span<const Entity> slots(drawing.slots);
  std::vector<std::vector<std::uint8_t>> details(kRowsPerInsert);
  std::size_t done = 0;
  {
    Statement insert(database.Get(), InsertSql(kRowsPerInsert).c_str());
    for (; slots.size() - done >= kRowsPerInsert; done += kRowsPerInsert) {
      BindSlots(insert, slots.subspan(done, kRowsPerInsert), details);
      insert.Step();
      insert.Reset();
    }
  }
  if (done < slots.size()) {
    Statement insert(database.Get(), InsertSql(slots.size() - done).c_str());
    BindSlots(insert, slots.subspan(done), details);
    insert.Step();
  }
  if (!slots.empty() && sqlite3_last_insert_rowid(database.Get()) != static_cast<sqlite3_int64>(slots.size())) {
    throw SqliteError("the entities were not numbered by their handles");
  }
}

}  // namespace

void WriteDrawingDatabase(const Drawing& drawing, const std::filesystem::path& path) {
  Connection database;
  database.Open(path.string());
  database.Execute(kSettings);
  database.Execute("BEGIN");
  for (const SchemaObject& object : kSchema) database.Execute(object.sql);
  database.Execute(("PRAGMA application_id=" + std::to_string(kApplicationId)).c_str());
  database.Execute(("PRAGMA user_version=" + std::to_string(kFormatVersion)).c_str());
  WriteTitle(database, drawing);
  WriteLayers(database, drawing);
  WriteEntities(database, drawing);
  database.Execute("COMMIT");
  database.Close();
}

}  // namespace wb::drawing_file
