// Error-checked SQLite calls for the drawing file code.
#include "workbench/drawing_file_sqlite.h"

namespace wb::drawing_file {
namespace {

// A connection is used by one thread only; without its mutexes every column read is cheaper,
// which shows when a million rows are read.
constexpr int kFlags = SQLITE_OPEN_READWRITE | SQLITE_OPEN_NOMUTEX;

}  // namespace

Statement::Statement(sqlite3* connection, const char* sql) : connection_(connection) {
  Check(sqlite3_prepare_v2(connection, sql, -1, &statement_, nullptr));
}

void Statement::Check(int result) const {
  if (result != SQLITE_OK) throw SqliteError(sqlite3_errmsg(connection_));
}

bool Statement::Step() {
  const int result = sqlite3_step(statement_);
  if (result == SQLITE_ROW) return true;
  if (result == SQLITE_DONE) return false;
  throw SqliteError(sqlite3_errmsg(connection_));
}

void Statement::BindInt(int index, std::int64_t value) { Check(sqlite3_bind_int64(statement_, index, value)); }

void Statement::BindText(int index, std::string_view text) {
  Check(sqlite3_bind_text64(statement_, index, text.data(), text.size(), SQLITE_STATIC, SQLITE_UTF8));
}

void Statement::BindBlobOrNull(int index, std::span<const std::uint8_t> bytes) {
  if (bytes.empty()) {
    Check(sqlite3_bind_null(statement_, index));
  } else {
    Check(sqlite3_bind_blob64(statement_, index, bytes.data(), bytes.size(), SQLITE_STATIC));
  }
}

std::span<const std::uint8_t> Statement::ColumnBlob(int column) const {
  const void* bytes = sqlite3_column_blob(statement_, column);
  const int size = sqlite3_column_bytes(statement_, column);
  if (bytes == nullptr || size <= 0) return {};
  return {static_cast<const std::uint8_t*>(bytes), static_cast<std::size_t>(size)};
}

std::string_view Statement::ColumnText(int column) const {
  const unsigned char* text = sqlite3_column_text(statement_, column);
  const int size = sqlite3_column_bytes(statement_, column);
  if (text == nullptr || size <= 0) return {};
  return {reinterpret_cast<const char*>(text), static_cast<std::size_t>(size)};
}

void Connection::Open(const std::string& path) {
  if (sqlite3_open_v2(path.c_str(), &connection_, kFlags, nullptr) != SQLITE_OK) Fail();
}

void Connection::Deserialize(std::span<const unsigned char> bytes) {
  if (sqlite3_open_v2(":memory:", &connection_, kFlags, nullptr) != SQLITE_OK) Fail();
  const auto length = static_cast<sqlite3_int64>(bytes.size());
  // Read-only and not resizable: SQLite never writes to the bytes, so casting away const is safe
  // and several connections can read them at once.
  if (sqlite3_deserialize(connection_, "main", const_cast<unsigned char*>(bytes.data()), length, length,
                          SQLITE_DESERIALIZE_READONLY) != SQLITE_OK) {
    Fail();
  }
}

void Connection::Execute(const char* sql) {
  if (sqlite3_exec(connection_, sql, nullptr, nullptr, nullptr) != SQLITE_OK) Fail();
}

void Connection::Close() {
  const int result = sqlite3_close(connection_);
  if (result != SQLITE_OK) Fail();
  connection_ = nullptr;
}

void Connection::Fail() const {
  // SQLite answers its out-of-memory message for a null connection.
  throw SqliteError(sqlite3_errmsg(connection_));
}

}  // namespace wb::drawing_file
