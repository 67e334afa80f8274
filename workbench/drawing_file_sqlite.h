// Owners of the SQLite connection and statements the drawing file code uses; every failure
// becomes a SqliteError carrying SQLite's own message.
#pragma once

#include <sqlite3.h>

#include <cstdint>
#include <span>
#include <stdexcept>
#include <string>
#include <string_view>

namespace wb::drawing_file {

class SqliteError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

class Statement {
 public:
  Statement(sqlite3* connection, const char* sql);
  ~Statement() { sqlite3_finalize(statement_); }
  Statement(const Statement&) = delete;
  Statement& operator=(const Statement&) = delete;

  // True while a row is there to read; false once the statement has run to its end.
  bool Step();
  // Readies an insert for the next row's values.
  void Reset() { sqlite3_reset(statement_); }

  // Texts and blobs are not copied: they must stay put until the statement has run. Empty blobs
  // are bound as NULL.
  void BindInt(int index, std::int64_t value);
  void BindText(int index, std::string_view text);
  void BindBlobOrNull(int index, std::span<const std::uint8_t> bytes);

  int ColumnType(int column) const { return sqlite3_column_type(statement_, column); }
  std::int64_t ColumnInt(int column) const { return sqlite3_column_int64(statement_, column); }
  std::span<const std::uint8_t> ColumnBlob(int column) const;
  std::string_view ColumnText(int column) const;

 private:
  void Check(int result) const;

  sqlite3* connection_;
  sqlite3_stmt* statement_ = nullptr;
};

class Connection {
 public:
  // An empty connection; Open or Deserialize gives it a database.
  Connection() = default;
  ~Connection() { sqlite3_close_v2(connection_); }
  Connection(const Connection&) = delete;
  Connection& operator=(const Connection&) = delete;

  // Opens an existing file for writing; the path must not be read as a URI (keep it absolute).
  void Open(const std::string& path);
  // Serves a read-only database from the bytes, which must outlive the connection.
  void Deserialize(std::span<const unsigned char> bytes);
  void Execute(const char* sql);
  // Closing can fail, and a save must know.
  void Close();

  sqlite3* Get() const { return connection_; }

 private:
  [[noreturn]] void Fail() const;

  sqlite3* connection_ = nullptr;
};

}  // namespace wb::drawing_file
