#pragma once

#include <string>
#include <vector>

#include "archive/copies/CopyNames.h"
#include "platform/Files.h"

/// Folder of the backup copies of all databases, the archive's among them.
std::string BackupFolderIn(const std::string& userDataFolder);

/// The archive's copies among them: of "games.mdb" and of "games-new.mdb", whatever made them, the newest
/// first.
std::vector<BackupCopy> ArchiveCopies(const Files& disk, const std::string& userDataFolder);

/// The paths of these, for whoever has to change all of them.
std::vector<std::string> ArchiveCopyPaths(const Files& disk, const std::string& userDataFolder);

/// Deletes what is there of copies that are not whole: of one that a crash broke off, and of the weekly one
/// while it is being made, which then begins anew. Throws RuntimeError as Files::Delete does.
void DeleteUnfinishedArchiveCopies(Files& disk, const std::string& userDataFolder);

/// Deletes what a killed restore or Forget This Member left beside the archive and its copies. Throws
/// RuntimeError as Files::Delete does.
void DeleteLeftArchives(Files& disk, const std::string& userDataFolder);

/// Where an archive or a copy is written anew, until that takes its place.
std::string RewrittenArchive(const std::string& path);

/// Where the weekly copy of the archive at `path` is made, until it is whole.
std::string UnfinishedWeeklyCopy(const std::string& path, const std::string& userDataFolder);
