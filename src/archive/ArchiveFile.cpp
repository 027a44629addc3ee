#include "archive/ArchiveFile.h"

#include "platform/RuntimeError.h"
#include "platform/Sql.h"

namespace {

std::string UsualPath(const std::string& userDataFolder) {
  return userDataFolder + "/games.mdb";
}

std::string FreshPath(const std::string& userDataFolder) {
  return userDataFolder + "/games-new.mdb";
}

/// Beside an archive that was set aside: what told it from others then.
std::string MarkPath(const std::string& path) {
  return path + ".damaged";
}

/// In the place of that: the archive stays aside whatever it becomes.
constexpr const char* MarkOfAny = "any\n";

/// The file's length and header, which holds a count of all its changes.
std::string MarkOfArchive(const Files& disk, const std::string& path) {
  constexpr std::size_t headerLength = 100;
  return std::to_string(disk.FileLen(path)) + "\n" + disk.ReadPart(path, 0, headerLength);
}

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

bool ArchiveExists(const Files& disk, const std::string& userDataFolder) {
  return disk.FileExists(UsualPath(userDataFolder)) || disk.FileExists(FreshPath(userDataFolder));
}

ArchiveFile OpenArchive(DatabaseEngine& engine, Files& disk, const std::string& userDataFolder,
                        const std::string& defaultPath) {
  const std::string usual = UsualPath(userDataFolder);
  const std::string fresh = FreshPath(userDataFolder);
  const bool usualExists = disk.FileExists(usual);
  if (!usualExists && disk.FileExists(fresh)) {  // the damaged one was taken away
    return {OpenChecked(engine, disk, fresh, defaultPath), fresh, {}};
  }
  try {
    if (!usualExists || !IsArchiveSetAside(disk, usual)) {
      return {OpenChecked(engine, disk, usual, defaultPath), usual, {}};
    }
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::UnrecognizedDatabase) {
      throw;
    }
  }
  return {OpenChecked(engine, disk, fresh, defaultPath), fresh, usual};
}

bool IsArchiveSetAside(const Files& disk, const std::string& path) {
  const std::string mark = MarkPath(path);
  if (!disk.FileExists(mark)) {
    return false;
  }
  const std::string text = disk.Read(mark);
  return text == MarkOfAny || text == MarkOfArchive(disk, path);
}

void HoldArchiveAside(Files& disk, const std::string& path) {
  disk.Replace(MarkPath(path), MarkOfAny);
}

bool SetArchiveAside(Files& disk, const std::string& path) {
  if (!path.ends_with("/games.mdb")) {
    return false;
  }
  disk.Replace(MarkPath(path), MarkOfArchive(disk, path));
  return true;
}
