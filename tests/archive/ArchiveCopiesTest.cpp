#include "archive/ArchiveCopies.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeFiles.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST(ArchiveCopies, AreThoseOfTheArchiveWhateverMadeThem) {
  FakeFiles disk;
  for (const char* file :
       {"games-2026-11-14-201500-weekly.mdb", "games-2026-11-15-201500-kept.mdb",
        "games-new-2026-11-16-201500-weekly.mdb", "games-2026-11-17-201500-replaced.mdb",
        "members-2026-11-18-201500.mdb", "games-other-2026-11-18-201500.mdb", "games.part", "games.mdb"}) {
    disk.Put("/data/backups/" + std::string(file), "");
  }
  EXPECT_THAT(ArchiveCopyPaths(disk, "/data"),
              ElementsAre("/data/backups/games-2026-11-17-201500-replaced.mdb",
                          "/data/backups/games-new-2026-11-16-201500-weekly.mdb",
                          "/data/backups/games-2026-11-15-201500-kept.mdb",
                          "/data/backups/games-2026-11-14-201500-weekly.mdb"));
  EXPECT_EQ(ArchiveCopies(disk, "/data").back().Kind, CopyKind::Weekly);
}

TEST(ArchiveCopies, AreNoneWithoutAFolderOfCopies) {
  const FakeFiles disk;
  EXPECT_THAT(ArchiveCopyPaths(disk, "/data"), IsEmpty());
}

TEST(ArchiveCopies, ThatAreNotWholeAreDeletedAlone) {
  FakeFiles disk;
  for (const std::string& file :
       {std::string("/data/backups/games.part"), std::string("/data/backups/games-new.part"),
        UnfinishedWeeklyCopy("/data/games.mdb", "/data"),
        UnfinishedWeeklyCopy("/data/games-new.mdb", "/data"), std::string("/data/backups/members.part"),
        std::string("/data/backups/games-2026-11-14-201500-weekly.mdb")}) {
    disk.Put(file, "");
  }
  DeleteUnfinishedArchiveCopies(disk, "/data");
  EXPECT_THAT(disk.FileNames("/data/backups"),
              ElementsAre("games-2026-11-14-201500-weekly.mdb", "members.part"));
}

TEST(ArchiveCopies, AreFreeOfWhatAKilledRestoreLeft) {
  FakeFiles disk;
  for (const char* file : {"/data/games.mdb", "/data/games.mdb.restored", "/data/games-new.mdb.restored",
                           "/data/games.mdb.rewritten", "/data/members.mdb.restored",
                           "/data/games.mdb.damaged", "/data/backups/games-2026-11-14-201500-weekly.mdb",
                           "/data/backups/games-2026-11-14-201500-weekly.mdb.rewritten"}) {
    disk.Put(file, "");
  }
  DeleteLeftArchives(disk, "/data");
  EXPECT_THAT(disk.FileNames("/data"), ElementsAre("games.mdb", "games.mdb.damaged", "members.mdb.restored"));
  EXPECT_THAT(disk.FileNames("/data/backups"), ElementsAre("games-2026-11-14-201500-weekly.mdb"));
}

}  // namespace
