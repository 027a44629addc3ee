#pragma once

#include <cstdint>
#include <string>

#include "platform/Database.h"

struct sqlite3_stmt;

class SqliteConnection;

/// A prepared statement. It is reset by each Bind and when it has run to its end; one left in the midst of
/// its rows holds a lock on the file, so call Reset.
class SqliteStatement {
 public:
  SqliteStatement() = default;
  /// Throws RuntimeError (see SqliteError.h) when `sql` cannot be prepared.
  SqliteStatement(SqliteConnection& connection, const std::string& sql);
  SqliteStatement(SqliteConnection& connection, sqlite3_stmt* statement);
  ~SqliteStatement();
  SqliteStatement(SqliteStatement&& other) noexcept;
  SqliteStatement& operator=(SqliteStatement&& other) noexcept;

  explicit operator bool() const { return statement_ != nullptr; }

  /// Parameters count from 1. A text or blob must live until the statement has run.
  void Bind(int parameter, const Value& value);
  void Bind(int parameter, std::int64_t value);

  /// Goes to the next row; false at the end. Throws RuntimeError, the statement being reset then.
  bool Step();
  void Reset();

  /// Columns of the present row, counted from 0. Read keeps the memory that `value` already holds for a text.
  std::int64_t Integer(int column) const;
  std::string Text(int column) const;
  void Read(int column, Value& value) const;

 private:
  SqliteConnection* connection_ = nullptr;
  sqlite3_stmt* statement_ = nullptr;
};
