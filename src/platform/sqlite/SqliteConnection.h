#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <string>
#include <utility>

#include "platform/sqlite/SqliteStatement.h"
#include "platform/sqlite/WrittenRows.h"

class SqliteTable;
struct sqlite3;

/// One connection to a database file, on which LIKE follows Jet's rules.
class SqliteConnection {
 public:
  /// Opens an existing file, read-only if it is write-protected. Throws as DatabaseEngine::OpenDatabase does.
  SqliteConnection(const std::string& path, std::chrono::milliseconds busyTimeout);
  ~SqliteConnection();
  SqliteConnection(const SqliteConnection&) = delete;
  SqliteConnection& operator=(const SqliteConnection&) = delete;

  sqlite3* Handle() const { return handle_; }
  const std::string& Path() const { return path_; }

  enum class Order {
    Table,
    Any  ///< and the same key may come several times
  };

  /// A query for the keys of the rows of `table` for which `condition` is true. Throws RuntimeError
  /// `syntaxError` if the condition is malformed.
  SqliteStatement PrepareSearch(const SqliteTable& table, const std::string& condition, Order order,
                                int syntaxError);

  /// See Database::BeginRead.
  void BeginRead() { ++readers_; }
  void EndRead() noexcept;

  /// Call before each read: inside a group of reads, takes the lock if it is not held.
  void PrepareRead();
  /// True inside a group of reads: after PrepareRead only this connection can then change the file.
  bool InGroup() const { return readers_ > 0; }
  /// Identifies the state of the file that a group of reads sees; differs whenever a row may have changed.
  std::uint64_t State() const { return state_; }
  /// Call before each write.
  void LeaveState() { ++state_; }
  /// Releases the lock of a group of reads until its next read. Does nothing within a WriteTransaction.
  void Rollback() noexcept;

  /// See Database::BeforeChange and HoldWriters.
  void BeforeChange(std::function<bool()> action) { beforeChange_ = std::move(action); }
  void HoldWriters();
  void ReleaseWriters() noexcept;

  void Execute(const char* sql);
  std::int64_t LastInsertedKey() const;
  std::int64_t ChangedRows() const;

  /// Rolls back the open transaction and throws the error of the last SQLite call.
  [[noreturn]] void Fail(int systemError = 0);

 private:
  friend class WriteTransaction;

  void PrepareChange();
  void Commit();
  bool HoldsWhatWasWritten(int commitResult);
  bool HasNewCounter();
  std::uint32_t ChangeCounter() const;
  void FlushFolder() noexcept;
  void Undo() noexcept;
  void CheckWritable();
  void Configure(std::chrono::milliseconds busyTimeout);
  void CheckWholePages();

  std::string path_;
  std::string folder_;  ///< of the file itself, behind symbolic links
  sqlite3* handle_ = nullptr;
  int readers_ = 0;
  bool writing_ = false;             ///< a WriteTransaction is open
  WrittenRows written_;              ///< by it
  std::uint32_t counterBefore_ = 0;  ///< its commit; read only if not all rows are told
  SqliteStatement dataVersion_;
  std::int64_t versionRead_ = 0;  ///< last data_version; differs after a change by another connection
  std::uint64_t state_ = 1;
  std::function<bool()> beforeChange_;
};

/// Writes that are committed together, or not at all. A nested transaction is part of the outer one; an error
/// in it rolls back the whole.
class WriteTransaction {
 public:
  /// Throws RuntimeError 3034 inside a transaction that was rolled back.
  explicit WriteTransaction(SqliteConnection& connection);
  ~WriteTransaction();
  WriteTransaction(const WriteTransaction&) = delete;
  WriteTransaction& operator=(const WriteTransaction&) = delete;

  /// Tell of each row that was written, before Commit.
  WrittenRows& Written() { return connection_.written_; }

  /// The writes are durable on return. Does nothing in a nested transaction. Throws RuntimeError only if the
  /// file does not hold them.
  void Commit();

 private:
  SqliteConnection& connection_;
  const bool isPart_;
};
