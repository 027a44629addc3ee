#pragma once

#include <string>

#include "archive/ArchiveFile.h"
#include "archive/copies/CopyWork.h"

/// The archive as one of the databases that have copies, by a connection of its own.
class CopiedArchive {
 public:
  struct Parts {
    DatabaseEngine& Engine;
    Files& Disk;
    std::string UserDataFolder;
    std::string ProgramFolder;
  };

  explicit CopiedArchive(Parts parts) : parts_(std::move(parts)) {}

  /// True if there is an archive, though it may be one that cannot be opened, or a copy from which there
  /// could be one again.
  bool IsThere();

  /// For the list of the databases. Valid as long as this object.
  CopiedDatabase Entry();

 private:
  std::string DefaultPath() const { return parts_.ProgramFolder + "/games_default.mdb"; }
  Database& InUse();

  const Parts parts_;
  ArchiveFile file_;
};
