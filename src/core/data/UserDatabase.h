#pragma once

#include <memory>
#include <string>

#include "core/data/Backups.h"
#include "core/text/StringTable.h"
#include "platform/Database.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "platform/OldDatabases.h"

/// One of the two databases in the user's data folder.
struct UserDatabase {
  std::string Path;         ///< ends in ".mdb"
  std::string Table;        ///< its main table, the one converted from an old file
  std::string DefaultPath;  ///< the file that a new installation starts with
};

/// What OpenUserDatabase works with.
struct DatabaseParts {
  DatabaseEngine& Engine;
  OldDatabases& Old;
  Files& Disk;
  MessageBoxes& Boxes;
  Backups& Copies;
  const StringTable& Strings;
};

/// Title of the boxes about the databases.
inline constexpr const char* DatabaseBoxTitle = "Database status";

/// Path of the database that is used in place of one that cannot be: "-new" behind its name.
std::string FreshPath(const UserDatabase& database);

/// Opens a database and has it backed up before its first change. A file from an old installation is
/// converted first, which a box reports. A file that cannot be read is left untouched: the operator is asked
/// whether to go on with a fresh copy beside it, named "...-new.mdb", which later starts will use again.
/// Returns nullptr if the operator chooses to end the program. Throws RuntimeError as
/// DatabaseEngine::OpenDatabase does, except for an unrecognized format.
std::unique_ptr<Database> OpenUserDatabase(const UserDatabase& database, const DatabaseParts& parts);
