#pragma once

#include <set>
#include <string>

#include "core/text/StringTable.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/Files.h"

/// Copies of databases as they were before the program run's first change, in a folder that is created when
/// needed: "members-2026-11-21-201500.mdb" for "members.mdb". The last ten of each are kept. Must outlive the
/// databases that it guards.
class Backups {
 public:
  Backups(std::string folder, Files& disk, const Clock& time, const StringTable& strings)
      : folder_(std::move(folder)), disk_(disk), time_(time), strings_(strings) {}

  /// From now on copies `database`, whose file is at `path` and ends in ".mdb", before its first change,
  /// unless a copy of that file was made in this run already: it may be opened anew. The change goes ahead
  /// even if the copy fails.
  void Guard(Database& database, const std::string& path);

  /// Copies `database` as it is now, ahead of a change of many rows. False if it was stopped. Throws
  /// RuntimeError if it cannot.
  bool CopyNow(Database& database, const std::string& path, const KeepOn& keepOn);

  /// Returns the operator's message about a copy that failed since the last call, or an empty text.
  std::string TakeFailure();

  /// True if the last change went ahead without a copy, to leave room on the disk for games and settings. The
  /// next change tries again.
  bool LacksRoom() const { return lacksRoom_; }

 private:
  bool HasRoomFor(const std::string& path) const;
  bool TryCopy(Database& database, const std::string& path);
  bool Copy(Database& database, const std::string& name, const KeepOn& keepOn);

  const std::string folder_;
  Files& disk_;
  const Clock& time_;
  const StringTable& strings_;
  std::set<std::string> copied_;  // names of the databases that were copied
  std::string failure_;
  bool lacksRoom_ = false;
};
