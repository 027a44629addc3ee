#include "archive/CopiedArchive.h"

#include "archive/ArchiveCopies.h"
#include "platform/RuntimeError.h"

bool CopiedArchive::IsThere() {
  try {
    return ArchiveExists(parts_.Disk, parts_.UserDataFolder) ||
           !ArchiveCopies(parts_.Disk, parts_.UserDataFolder).empty();
  } catch (const RuntimeError&) {  // whoever opens it is told why that fails
    return true;
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
