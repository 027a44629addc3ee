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

/// True if there is an archive already.
bool ArchiveExists(const Files& disk, const std::string& userDataFolder);

/// Opens "games.mdb" in the user's data folder. A missing file is made as a copy of `defaultPath`, unless
/// "games-new.mdb" is there. That one is also opened, or made, in place of one that is damaged, was set aside
/// or is no archive. Nobody is asked. Throws RuntimeError as DatabaseEngine::OpenDatabase and Files::Replace
/// do, for instance 3050 for a locked file and 3343 if the one beside it is damaged too.
ArchiveFile OpenArchive(DatabaseEngine& engine, Files& disk, const std::string& userDataFolder,
                        const std::string& defaultPath);

/// From now on, also in later runs, OpenArchive leaves the archive at `path` alone, since its damage was
/// found in use, unless the file is another one by then. No database on it may be open. Returns false, having
/// done nothing, for one that is already beside another. Throws RuntimeError as Files::Replace does.
bool SetArchiveAside(Files& disk, const std::string& path);

/// True if OpenArchive leaves the archive at `path` alone. Throws RuntimeError as Files does.
bool IsArchiveSetAside(const Files& disk, const std::string& path);

/// Leaves an archive that was set aside so while it is being changed, whatever is in it by then. Once no
/// database on it is open, call SetArchiveAside again. Throws RuntimeError as Files::Replace does.
void HoldArchiveAside(Files& disk, const std::string& path);
