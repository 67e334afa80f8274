// The layout of a drawing file, shared by the code that writes it and the code that reads it.
#pragma once

#include <array>
#include <cstdint>
#include <stdexcept>

namespace wb::drawing_file {

// Stored in the SQLite header so that other programs' databases are told apart from drawings.
constexpr std::uint32_t kApplicationId = 0x504E4458;  // "PNDX"
// Raised whenever the tables change shape; a file with a larger number is from a newer Pandex.
constexpr std::uint32_t kFormatVersion = 1;
// Fixed so that the same drawing always gives the same bytes.
constexpr int kPageSize = 4096;

struct SchemaObject {
  const char* name;
  const char* sql;
};

// The whole schema. An opened file must hold exactly these objects with exactly this text, so
// that no view, trigger or altered column of a damaged or forged file runs or is read.
inline constexpr std::array<SchemaObject, 3> kSchema = {{
    {"drawing", "CREATE TABLE drawing(title TEXT NOT NULL)"},
    {"layers", "CREATE TABLE layers(layer_index INTEGER PRIMARY KEY, name TEXT NOT NULL, is_on INTEGER NOT NULL)"},
    // One row per handle, deleted ones included (header NULL and nothing else), so that the
    // numbering survives and every row costs the file some bytes: a small file can never
    // announce a huge drawing. Few columns, NULL when empty: SQLite's cost per column is what
    // bounds the speed of saving and opening large drawings.
    {"entities", "CREATE TABLE entities(handle INTEGER PRIMARY KEY, header BLOB, record BLOB, details BLOB)"},
}};

// Column order of the entities table in both the insert and the select.
enum EntityColumn : int {
  kColumnHandle,
  kColumnHeader,
  kColumnRecord,
  kColumnDetails,
  kEntityColumnCount,
};

// Content that does not fit the layout. The opener reports it as a damaged file, the saver as
// a drawing it cannot write.
class BadContent : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

}  // namespace wb::drawing_file
