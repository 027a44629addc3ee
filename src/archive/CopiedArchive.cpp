#include "archive/CopiedArchive.h"

#include "archive/ArchiveCopies.h"
#include "platform/RuntimeError.h"

bool CopiedArchive::IsThere() {
  try {
    if (!ArchiveExists(parts_.Disk, parts_.UserDataFolder) &&
        ArchiveCopies(parts_.Disk, parts_.UserDataFolder).empty()) {
      return false;
    }
    InUse();
    return true;
  } catch (const RuntimeError&) {  // the status line tells why games are not kept
    return false;
  }
}

CopiedDatabase CopiedArchive::Entry() {
  return {.Name = "games",
          .Table = "Games",
          .DefaultPath = DefaultPath(),
          .Title = OwnText::CopiedGames,
          .InUse = [this]() -> Database& { return InUse(); }};
}

Database& CopiedArchive::InUse() {
  if (!file_.Open || file_.Open->HasMoved()) {  // a copy has taken its place
    file_ = OpenArchive(parts_.Engine, parts_.Disk, parts_.UserDataFolder, DefaultPath());
  }
  return *file_.Open;
}
