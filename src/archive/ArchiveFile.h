#pragma once

#include <memory>
#include <string>

#include "platform/Database.h"
#include "platform/Files.h"

/// The archive's file in use.
struct ArchiveFile {
  std::unique_ptr<Database> Open;
  std::string Path;
  /// Of the usual file if it cannot be used: it stays as it is, and this one lies beside it. Empty otherwise.
  std::string Unusable;
};

/// Opens "games.mdb" in the user's data folder. A missing file is made as a copy of `defaultPath`. In place
/// of one that is damaged, or no archive, "games-new.mdb" beside it is opened, or made. Nobody is asked.
/// Throws RuntimeError as DatabaseEngine::OpenDatabase and Files::Replace do, for instance 3050 for a locked
/// file and 3343 if the one beside it is damaged too.
ArchiveFile OpenArchive(DatabaseEngine& engine, Files& disk, const std::string& userDataFolder,
                        const std::string& defaultPath);
