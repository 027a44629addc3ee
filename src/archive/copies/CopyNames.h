#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/Files.h"

/// Why a copy of a database was made.
enum class CopyKind {
  FirstChange,    ///< by the program, before the first change of a run; only the last ones are kept
  ByHand,         ///< by the operator
  BeforeRestore,  ///< of what a restored copy took the place of
  Weekly          ///< by the program, of the archive, once a week; only the last ones are kept
};

/// A copy of a database in the folder of the backup copies.
struct BackupCopy {
  std::string File;      ///< "members-2026-11-21-201500.mdb"
  std::string Database;  ///< "members"
  std::string Time;      ///< "2026-11-21 20:15:00"
  CopyKind Kind = CopyKind::FirstChange;

  bool operator==(const BackupCopy&) const = default;
};

/// What the name of a file in that folder tells; nothing if it is no copy's.
std::optional<BackupCopy> BackupCopyOf(const std::string& file);

/// A name for a copy of `database` made at `now` ("YYYY-MM-DD HH:MM:SS") that no file in `folder` has.
std::string FreeCopyName(const Files& disk, const std::string& folder, const std::string& database,
                         const std::string& now, CopyKind kind);

/// The copies in a folder, the newest first.
std::vector<BackupCopy> CopiesIn(const Files& disk, const std::string& folder);
