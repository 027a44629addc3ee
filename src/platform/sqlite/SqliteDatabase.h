#pragma once

#include <chrono>
#include <memory>
#include <optional>
#include <string>
#include <utility>

#include "platform/Database.h"
#include "platform/sqlite/SqliteConnection.h"
#include "platform/sqlite/SqliteSql.h"

/// A database in an SQLite file. Its tables must have rowids, which are the keys of a dynaset.
class SqliteDatabase : public Database {
 public:
  SqliteDatabase(const std::string& path, std::chrono::milliseconds busyTimeout)
      : connection_(path, busyTimeout) {}

  std::unique_ptr<Recordset> OpenRecordset(const std::string& source) override;
  Sql& Statements() override { return statements_; }
  void RaiseCounter(const std::string& table, std::int64_t number) override;
  void BeginRead() override { connection_.BeginRead(); }
  void EndRead() noexcept override { connection_.EndRead(); }
  void BeginTrans() override { group_.emplace(connection_); }
  void CommitTrans() override;
  void Rollback() noexcept override { group_.reset(); }
  void BeforeChange(std::function<bool()> action) override { connection_.BeforeChange(std::move(action)); }
  void CopyTo(const std::string& path) override { connection_.CopyTo(path); }

 private:
  SqliteConnection connection_;
  std::optional<WriteTransaction> group_;
  SqliteSql statements_{connection_};
};

class SqliteEngine : public DatabaseEngine {
 public:
  /// `busyTimeout` is how long an operation waits for a file that another program has locked.
  explicit SqliteEngine(std::chrono::milliseconds busyTimeout = std::chrono::seconds(2))
      : busyTimeout_(busyTimeout) {}

  std::unique_ptr<Database> OpenDatabase(const std::string& path) override;

 private:
  std::chrono::milliseconds busyTimeout_;
};
