#include "archive/ArchiveFile.h"

#include "platform/RuntimeError.h"
#include "platform/Sql.h"

namespace {

void MakeIfMissing(Files& disk, const std::string& path, const std::string& defaultPath) {
  if (disk.FileExists(path)) {
    return;
  }
  // A journal that was left alone would be played back into the new file.
  const std::string journal = path + "-journal";
  if (disk.FileExists(journal)) {
    disk.Delete(journal);
  }
  disk.Replace(path, disk.Read(defaultPath));
}

/// Throws RuntimeError 3343 for a database that has other tables than an archive.
void CheckTables(Database& database, const std::string& path) {
  constexpr const char* queries[] = {
      "SELECT GameID, Played, Deleted FROM Games LIMIT 1", "SELECT GameID, MemberID FROM GamePlayers LIMIT 1",
      "SELECT GameID, Name FROM GameFiles LIMIT 1",        "SELECT name, mode, mtime, sz FROM sqlar LIMIT 1",
      "SELECT MemberID, Digest FROM KnownMembers LIMIT 1", "SELECT Secret FROM ArchiveKey LIMIT 1"};
  for (const char* query : queries) {
    try {
      database.Statements().Query(query, {}, [](const SqlRow&) {});
    } catch (const RuntimeError& error) {
      if (error.Number() != Fault::DatabaseError) {
        throw;
      }
      throw RuntimeError(Fault::UnrecognizedDatabase, "Unrecognized database format '" + path + "'.");
    }
  }
}

std::unique_ptr<Database> OpenChecked(DatabaseEngine& engine, Files& disk, const std::string& path,
                                      const std::string& defaultPath) {
  MakeIfMissing(disk, path, defaultPath);
  std::unique_ptr<Database> database = engine.OpenDatabase(path);
  CheckTables(*database, path);
  return database;
}

}  // namespace

ArchiveFile OpenArchive(DatabaseEngine& engine, Files& disk, const std::string& userDataFolder,
                        const std::string& defaultPath) {
  const std::string usual = userDataFolder + "/games.mdb";
  try {
    return {OpenChecked(engine, disk, usual, defaultPath), usual, {}};
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::UnrecognizedDatabase) {
      throw;
    }
  }
  const std::string fresh = userDataFolder + "/games-new.mdb";
  return {OpenChecked(engine, disk, fresh, defaultPath), fresh, usual};
}
