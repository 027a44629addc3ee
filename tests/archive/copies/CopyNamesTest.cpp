#include "archive/copies/CopyNames.h"

#include <gmock/gmock.h>

#include "core/data/DatedFiles.h"
#include "tests/fakes/FakeFiles.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::vector<std::string> FilesOf(const std::vector<BackupCopy>& copies) {
  std::vector<std::string> files;
  for (const BackupCopy& copy : copies) {
    files.push_back(copy.File);
  }
  return files;
}

TEST(CopyNames, TellDatabaseTimeAndReason) {
  EXPECT_EQ(
      BackupCopyOf("members-2026-11-21-201500.mdb"),
      (BackupCopy{"members-2026-11-21-201500.mdb", "members", "2026-11-21 20:15:00", CopyKind::FirstChange}));
  EXPECT_EQ(BackupCopyOf("members-new-2026-11-21-201500-kept.mdb"),
            (BackupCopy{"members-new-2026-11-21-201500-kept.mdb", "members-new", "2026-11-21 20:15:00",
                        CopyKind::ByHand}));
  EXPECT_EQ(BackupCopyOf("scenarios-2026-11-21-201500-replaced12.mdb"),
            (BackupCopy{"scenarios-2026-11-21-201500-replaced12.mdb", "scenarios", "2026-11-21 20:15:00",
                        CopyKind::BeforeRestore}));
  EXPECT_EQ(
      BackupCopyOf("games-2026-11-21-201500-weekly.mdb"),
      (BackupCopy{"games-2026-11-21-201500-weekly.mdb", "games", "2026-11-21 20:15:00", CopyKind::Weekly}));
}

TEST(CopyNames, AreNotThoseOfOtherFiles) {
  for (const char* file :
       {"", ".mdb", "members.mdb", "members.part", "-2026-11-21-201500.mdb", "members-2026-11-21.mdb",
        "members-2026-11-21-20150.mdb", "members-2026-11-21-201500.mdb.jet", "members-2026-11-21-201500",
        "members-2026-11-21-201500-other.mdb", "members-2026-11-21-2015002.mdb", "notes-kept.mdb"}) {
    EXPECT_FALSE(BackupCopyOf(file)) << file;
  }
}

TEST(CopyNames, AreFree) {
  FakeFiles disk;
  disk.AddFolder("/b");
  const auto next = [&disk](CopyKind kind) {
    const std::string name = FreeCopyName(disk, "/b", "members", "2026-11-21 20:15:00", kind);
    disk.Put("/b/" + name, "");
    EXPECT_EQ(BackupCopyOf(name)->Kind, kind);
    EXPECT_EQ(BackupCopyOf(name)->Database, "members");
    return name;
  };
  EXPECT_EQ(next(CopyKind::ByHand), "members-2026-11-21-201500-kept.mdb");
  EXPECT_EQ(next(CopyKind::ByHand), "members-2026-11-21-201500-kept2.mdb");
  EXPECT_EQ(next(CopyKind::ByHand), "members-2026-11-21-201500-kept3.mdb");
  EXPECT_EQ(next(CopyKind::BeforeRestore), "members-2026-11-21-201500-replaced.mdb");
  EXPECT_EQ(next(CopyKind::Weekly), "members-2026-11-21-201500-weekly.mdb");
}

TEST(CopyNames, AreNeitherCountedNorDeletedAmongTheLastOnesUnlessAProgramRunMadeThem) {
  FakeFiles disk;
  for (int day = 10; day < 15; ++day) {
    const std::string time = "2026-11-" + std::to_string(day) + " 20:15:00";
    for (const CopyKind kind : {CopyKind::FirstChange, CopyKind::ByHand, CopyKind::BeforeRestore}) {
      disk.Put("/b/" + FreeCopyName(disk, "/b", "members", time, kind), "");
    }
  }
  DatedFiles(disk, "/b", "members", ".mdb", 2).DeleteOldest("members-2026-11-14-201500.mdb");
  int ofRuns = 0;
  for (const BackupCopy& copy : CopiesIn(disk, "/b")) {
    ofRuns += copy.Kind == CopyKind::FirstChange ? 1 : 0;
  }
  EXPECT_EQ(ofRuns, 2);
  EXPECT_EQ(disk.FileNames("/b").size(), 12U);
}

TEST(CopyNames, AreListedFromTheNewest) {
  FakeFiles disk;
  for (const char* file :
       {"members-2026-11-21-201500.mdb", "scenarios-2026-11-22-090000.mdb", "notes.txt", "members.part",
        "members-2026-11-21-201500-replaced.mdb", "members-2025-12-31-235959-kept.mdb"}) {
    disk.Put("/b/" + std::string(file), "");
  }
  EXPECT_THAT(FilesOf(CopiesIn(disk, "/b")),
              ElementsAre("scenarios-2026-11-22-090000.mdb", "members-2026-11-21-201500-replaced.mdb",
                          "members-2026-11-21-201500.mdb", "members-2025-12-31-235959-kept.mdb"));
  EXPECT_THAT(CopiesIn(disk, "/none"), IsEmpty());
}

}  // namespace
