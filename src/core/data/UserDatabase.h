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
  std::string Path;         ///< of the file, ending in ".mdb"
  std::string Table;        ///< the one that it is about
  std::string DefaultPath;  ///< of the file that a new installation starts with
};

/// What is needed to open one.
struct DatabaseParts {
  DatabaseEngine& Engine;
  OldDatabases& Old;
  Files& Disk;
  MessageBoxes& Boxes;
  Backups& Copies;
  const StringTable& Strings;
};

/// Opens a database, of which a backup copy will be made before its first change. A file of an old
/// installation is converted first, which is told. One that cannot be read stays untouched: the operator is
/// asked whether to go on with a fresh copy beside it, named "...-new.mdb", which is kept for the next such
/// start. Returns nullptr when the operator chose to end the program. Throws RuntimeError as
/// DatabaseEngine::OpenDatabase does for all but an unrecognized format.
std::unique_ptr<Database> OpenUserDatabase(const UserDatabase& database, const DatabaseParts& parts);
