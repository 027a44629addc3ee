#include "archive/history/ForgetMember.h"

#include <memory>

#include "archive/ArchiveCopies.h"
#include "archive/GameArchive.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"

namespace {

std::string NameOfFile(const std::string& path) {
  return path.substr(path.rfind('/') + 1);
}

}  // namespace

int GamesNaming(Sql& archive, std::int32_t number) {
  return static_cast<int>(WholeNumber(
      archive, "SELECT count(DISTINCT GameID) FROM GamePlayers WHERE MemberID = $1", {std::int64_t{number}}));
}

std::vector<std::string> ForgetMember::ArchivesInUse() const {
  std::vector<std::string> files;
  for (const char* name : {"/games.mdb", "/games-new.mdb"}) {
    if (parts_.Disk.FileExists(parts_.UserDataFolder + name)) {
      files.push_back(parts_.UserDataFolder + name);
    }
  }
  return files;
}

Forgotten ForgetMember::Forget(std::int32_t number) const {
  Forgotten forgotten;
  try {
    DeleteUnfinishedArchiveCopies(parts_.Disk, parts_.UserDataFolder);
  } catch (const RuntimeError& error) {
    forgotten.Failures.emplace_back(error.what());
  }
  for (const std::string& file : ArchivesInUse()) {
    forgotten.Games += ForgetIn(file, number, forgotten.Failures);
  }
  for (const std::string& file : ArchiveCopyPaths(parts_.Disk, parts_.UserDataFolder)) {
    ForgetIn(file, number, forgotten.Failures);
  }
  return forgotten;
}

int ForgetMember::ForgetIn(const std::string& file, std::int32_t number,
                           std::vector<std::string>& failures) const {
  OwnText failure = OwnText::ForgetFailed;
  int games = 0;
  try {
    const std::unique_ptr<Database> database = parts_.Engine.OpenDatabase(file);
    games = GameArchive(*database, parts_.DbMembers, parts_.Strings).Forget(number);
    failure = OwnText::ForgetRestStays;
    database->Rewrite();
  } catch (const RuntimeError& error) {
    failures.push_back(Filled(parts_.Strings.Text(failure), {NameOfFile(file), error.what()}));
  }
  return games;
}
