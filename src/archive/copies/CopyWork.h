#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "archive/copies/CopyNames.h"
#include "core/text/StringTable.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/Files.h"

/// A database of the program that has copies.
struct CopiedDatabase {
  std::string Name;                  ///< of its file, without ".mdb"
  std::string Table;                 ///< the one whose rows are counted
  std::string DefaultPath;           ///< a new one; a copy needs all columns that it has
  OwnText Title;                     ///< what the operator calls it
  std::function<Database&()> InUse;  ///< as it is open at the moment

  /// True for its copies, also for those of a fresh file that the program once had to go on with.
  bool Owns(const BackupCopy& copy) const { return copy.Database == Name || copy.Database == Name + "-new"; }
};

/// What a long operation on copies is doing.
enum class CopyStep { Checking, KeepingPresent, Copying };

/// How a restore ended.
struct Restored {
  enum Ending {
    Done,
    Stopped,   ///< nothing was changed
    Refused,   ///< nothing was changed
    Uncertain  ///< the copy is in its place, but a power failure may undo that
  };
  Ending What = Done;
  std::string KeptAs = {};  ///< name of the copy of what was there before
  std::string Reason = {};  ///< for the operator, if it failed
};

/// Makes, counts, copies and restores copies of databases. Long operations ask between their steps whether to
/// keep on. All operations but Restore throw RuntimeError, then with nothing half done left behind.
class CopyWork {
 public:
  using OnStep = std::function<bool(CopyStep)>;

  struct Parts {
    DatabaseEngine& Engine;
    Files& Disk;
    const Clock& Time;
    const StringTable& Strings;
    std::string Folder;  ///< of the copies, in that of the data; made when needed
  };

  explicit CopyWork(Parts parts) : parts_(std::move(parts)) {}

  std::string PathOf(const BackupCopy& copy) const { return parts_.Folder + "/" + copy.File; }

  /// A name for a copy of a database as it is now.
  std::string NameOfNow(const CopiedDatabase& database) const;

  /// Number of rows that a copy holds.
  int RowsIn(const BackupCopy& copy, const CopiedDatabase& database) const;

  /// Copies a database as it is now and returns the copy's name; nothing if it was stopped.
  std::optional<std::string> CopyNow(const CopiedDatabase& database, const OnStep& keepOn) const;

  /// Does the same ahead of a replacement of the whole database, so the copy's name says that. It may be held
  /// against writers.
  std::optional<std::string> KeepPresent(const CopiedDatabase& database, const OnStep& keepOn) const;

  /// True if a file at `target` would lie where the databases in use lie, or be one of them, be it by a link.
  bool IsDataInUse(const std::string& target, const std::vector<CopiedDatabase>& databases) const;

  /// Copies the database at `path` to the file `target`, replacing any file there. False if it was stopped.
  bool CopyToFile(const std::string& path, const std::string& target, const OnStep& keepOn) const;

  /// Puts a copy in the place of the database. The copy is checked first, and the present state becomes a
  /// copy too. When it was Done or is Uncertain, what is open still belongs to the old file: open it anew.
  Restored Restore(const BackupCopy& copy, const CopiedDatabase& database, const OnStep& keepOn) const;

 private:
  class PartFile;

  void CheckColumns(Database& copy, const CopiedDatabase& database) const;
  /// Throws RuntimeError 61 unless there is room for another file of the size of that at `path`.
  void CheckRoom(const std::string& path, const std::string& folder) const;
  std::optional<std::string> Keep(const std::string& path, CopyKind kind, CopyStep step,
                                  const OnStep& keepOn) const;
  bool PutCopyInPlace(const BackupCopy& copy, const CopiedDatabase& database, const OnStep& keepOn,
                      Restored& restored) const;
  void DeleteCopy(const std::string& file) const;

  Parts parts_;
};
