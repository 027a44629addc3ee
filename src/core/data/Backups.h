#pragma once

#include <string>

#include "core/text/StringTable.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/Files.h"

/// Copies of databases as they were before the first change of a run of the program, in a folder that is made
/// when it is needed: "members-2026-11-21-201500.mdb" for "members.mdb". The last ten of each are kept. Has
/// to outlive the databases that it guards.
class Backups {
 public:
  Backups(std::string folder, Files& disk, const Clock& time, const StringTable& strings)
      : folder_(std::move(folder)), disk_(disk), time_(time), strings_(strings) {}

  /// Has `database`, whose file is at `path` and ends in ".mdb", copied before its first change. A copy that
  /// cannot be made does not hold up the change.
  void Guard(Database& database, const std::string& path);

  /// What the operator should know of a copy that could not be made; empty for nothing new.
  std::string TakeFailure();

 private:
  bool TryCopy(Database& database, const std::string& path);
  void Copy(Database& database, const std::string& name);
  void DeleteOldest(const std::string& name, const std::string& newest);

  const std::string folder_;
  Files& disk_;
  const Clock& time_;
  const StringTable& strings_;
  std::string failure_;
};
