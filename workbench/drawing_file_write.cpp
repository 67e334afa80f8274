// Writing a drawing into a fresh SQLite file: one transaction, prepared inserts in handle order.
#include <span>
#include <string>
#include <vector>

#include "workbench/drawing_file_blobs.h"
#include "workbench/drawing_file_database.h"
#include "workbench/drawing_file_format.h"

namespace wb::drawing_file {
namespace {

// The file is a temporary that is thrown away whole when the save fails, so it needs no journal;
// without one, and with a fixed page size and nothing time-dependent, the same drawing always
// gives the same bytes. The cache holds a large drawing without spilling half-built pages.
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

void WriteEntities(const Connection& database, const Drawing& drawing) {
  Statement insert(database.Get(), "INSERT INTO entities VALUES(?1, ?2, ?3, ?4, ?5, ?6, ?7, ?8)");
  // A deleted slot keeps only its handle: written as an empty entity, every value goes in as NULL.
  static const Entity kDeleted{};
  std::vector<std::uint8_t> members;
  std::vector<std::uint8_t> attributes;
  for (std::size_t i = 0; i < drawing.slots.size(); ++i) {
    const bool alive = drawing.slots[i].Alive();
    const Entity& entity = alive ? drawing.slots[i] : kDeleted;
    members.clear();
    attributes.clear();
    EncodeMembers(entity.members, members);
    EncodeAttributes(entity.attributes, attributes);
    insert.BindInt(kColumnHandle + 1, static_cast<std::int64_t>(i) + 1);
    insert.BindBlobOrNull(kColumnHeader + 1, alive ? std::span<const std::uint8_t>(entity.header.bytes)
                                                   : std::span<const std::uint8_t>());
    insert.BindBlobOrNull(kColumnRecord + 1, entity.record);
    insert.BindTextOrNull(kColumnName + 1, entity.name);
    insert.BindBlobOrNull(kColumnMembers + 1, members);
    insert.BindTextOrNull(kColumnConfigPath + 1, entity.configPath);
    insert.BindTextOrNull(kColumnElementName + 1, entity.elementName);
    insert.BindBlobOrNull(kColumnAttributes + 1, attributes);
    insert.Step();
    insert.Reset();
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
