#pragma once

#include <chrono>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "platform/Database.h"
#include "platform/sqlite/SqliteConnection.h"
#include "platform/sqlite/SqliteSql.h"
#include "platform/sqlite/WholeFile.h"

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
  void FlushGroup() override;
  void BeforeChange(std::function<bool()> action) override { connection_.BeforeChange(std::move(action)); }
  void CopyTo(const std::string& path) override { CopyWhole(connection_, path, nullptr); }
  bool CopyInSteps(const std::string& path, const KeepOn& keepOn) override {
    return CopyWhole(connection_, path, keepOn);
  }
  std::unique_ptr<StepwiseCopy> BeginCopy(const std::string& path) override {
    return BeginWholeCopy(connection_, path);
  }
  bool CheckWhole(const KeepOn& keepOn) override { return ::CheckWhole(connection_, keepOn); }
  bool RewriteTo(const std::string& path, const KeepOn& keepOn) override {
    return RewriteWhole(connection_, path, keepOn);
  }
  std::vector<std::string> ColumnNames(const std::string& table) override;
  std::string Path() const override { return connection_.Path(); }
  std::string FilePath() const override;
  bool HasMoved() const override;
  void HoldWriters() override { connection_.HoldWriters(); }
  void ReleaseWriters() noexcept override { connection_.ReleaseWriters(); }

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
