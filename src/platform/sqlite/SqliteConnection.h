#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <string>
#include <utility>

#include "platform/sqlite/SqliteStatement.h"

class SqliteTable;
struct sqlite3;

/// One connection to a database file, with Jet's LIKE.
class SqliteConnection {
 public:
  /// Opens an existing file, read-only where it may not be written. Throws as DatabaseEngine::OpenDatabase
  /// does.
  SqliteConnection(const std::string& path, std::chrono::milliseconds busyTimeout);
  ~SqliteConnection();
  SqliteConnection(const SqliteConnection&) = delete;
  SqliteConnection& operator=(const SqliteConnection&) = delete;

  sqlite3* Handle() const { return handle_; }
  const std::string& Path() const { return path_; }

  /// The keys of the rows of `table` that `condition` holds for, in table order. Throws RuntimeError
  /// `syntaxError` when the condition cannot be read.
  SqliteStatement PrepareSearch(const SqliteTable& table, const std::string& condition, int syntaxError);

  /// See Database::BeginRead.
  void BeginRead() { ++readers_; }
  void EndRead() noexcept;

  /// To be called before each read: inside a group of reads takes the lock where it is not held.
  void PrepareRead();
  /// True inside a group of reads: then nobody but this connection can change the file after PrepareRead.
  bool InGroup() const { return readers_ > 0; }
  /// A number for the state of the file that a group of reads sees; another one whenever a row may have
  /// changed.
  std::uint64_t State() const { return state_; }
  /// To be called before each write.
  void LeaveState() { ++state_; }
  /// A group of reads lets go of its lock until its next read. Does nothing between the writes of a
  /// transaction.
  void Rollback() noexcept;

  /// See Database::BeforeChange and CopyTo.
  void BeforeChange(std::function<bool()> action) { beforeChange_ = std::move(action); }
  void CopyTo(const std::string& path);

  void Execute(const char* sql);
  std::int64_t LastInsertedKey() const;
  std::int64_t ChangedRows() const;

  /// Throws what the last call of SQLite reported; the open transaction is rolled back.
  [[noreturn]] void Fail();

 private:
  friend class WriteTransaction;

  void PrepareChange();
  void Undo() noexcept;
  void Configure(std::chrono::milliseconds busyTimeout);
  void CheckWholePages();

  std::string path_;
  sqlite3* handle_ = nullptr;
  int readers_ = 0;
  bool writing_ = false;  ///< a WriteTransaction is open
  SqliteStatement dataVersion_;
  std::int64_t versionRead_ = 0;  ///< counts the changes by others
  std::uint64_t state_ = 1;
  std::function<bool()> beforeChange_;
};

/// Writes that reach the file together when Commit returns, or not at all. One inside another is a part of
/// it; a fault in the part undoes the whole.
class WriteTransaction {
 public:
  /// Throws RuntimeError 3034 inside one that was undone.
  explicit WriteTransaction(SqliteConnection& connection);
  ~WriteTransaction();
  WriteTransaction(const WriteTransaction&) = delete;
  WriteTransaction& operator=(const WriteTransaction&) = delete;

  /// What was written is durable on return, unless this is part of another.
  void Commit();

 private:
  SqliteConnection& connection_;
  const bool isPart_;
};
