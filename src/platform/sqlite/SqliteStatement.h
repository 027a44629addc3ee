#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

#include "platform/Database.h"

struct sqlite3_stmt;

class SqliteConnection;

/// A prepared statement. Each Bind resets it, and so does reaching the end. Stopped before its last row it
/// holds a lock on the file, so call Reset.
class SqliteStatement {
 public:
  SqliteStatement() = default;
  /// Throws RuntimeError (see SqliteError.h) if `sql` cannot be prepared.
  SqliteStatement(SqliteConnection& connection, const std::string& sql);
  SqliteStatement(SqliteConnection& connection, sqlite3_stmt* statement);
  ~SqliteStatement();
  SqliteStatement(SqliteStatement&& other) noexcept;
  SqliteStatement& operator=(SqliteStatement&& other) noexcept;

  explicit operator bool() const { return statement_ != nullptr; }

  /// Parameters count from 1. A text or blob must outlive the statement's run.
  void Bind(int parameter, const Value& value);
  void Bind(int parameter, std::int64_t value);

  /// Parameters count from 1; one that only has a number has no name: nullptr.
  int ParameterCount() const;
  const char* ParameterName(int parameter) const;
  /// Values that were bound are no longer needed.
  void ForgetValues();

  /// True if the statement cannot change the file.
  bool ReadsOnly() const;
  std::size_t ColumnCount() const;

  /// Moves to the next row; false at the end. On failure resets the statement and throws RuntimeError.
  bool Step();
  void Reset();

  /// Columns of the current row, counted from 0. Read reuses the memory of a text already in `value`.
  std::int64_t Integer(int column) const;
  std::string Text(int column) const;
  void Read(int column, Value& value) const;

 private:
  SqliteConnection* connection_ = nullptr;
  sqlite3_stmt* statement_ = nullptr;
};
