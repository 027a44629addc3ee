#include "archive/copies/CopyWork.h"

#include <gmock/gmock.h>
#include <sys/stat.h>

#include <fstream>

#include "tests/archive/copies/CopySite.h"
#include "tests/support/FileSizeLimit.h"
#include "tests/support/OrdinaryUser.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

constexpr const char* Early = "members-2013-05-01-200000.mdb";

class Copies : public testing::Test {
 protected:
  std::vector<std::string> FilesInData() const { return site.Disk.FileNames(site.Folder / "data"); }
  std::vector<std::string> FilesInCopies() const { return site.Disk.FileNames(site.CopyFolder()); }

  /// The data in use is as it was, nothing half done is there, and the reason is told.
  void ExpectRefused(const Restored& restored, const std::string& reason) const {
    EXPECT_EQ(restored.What, Restored::Refused);
    EXPECT_THAT(restored.Reason, HasSubstr(reason));
    ExpectUnchanged(restored);
  }
  void ExpectUnchanged(const Restored& restored) const {
    EXPECT_EQ(restored.KeptAs, "");
    EXPECT_EQ(site.Names(), "Ann Bob Cid");
    EXPECT_THAT(FilesInData(), ElementsAre("members.mdb"));
    EXPECT_THAT(FilesInCopies(), ElementsAre(Early));
  }

  CopySite site;
};

TEST_F(Copies, AreMadeNow) {
  EXPECT_EQ(site.Work.CopyNow(site.Members, [](CopyStep) { return true; }),
            "members-2013-05-21-143005-kept.mdb");
  EXPECT_EQ(site.NamesIn(site.CopyFolder() + "/members-2013-05-21-143005-kept.mdb"), "Ann Bob Cid");
  EXPECT_EQ(site.Work.CopyNow(site.Members, [](CopyStep) { return true; }),
            "members-2013-05-21-143005-kept2.mdb");
}

TEST_F(Copies, StoppedInTheMiddleLeaveNothing) {
  OtherConnection(site.MembersFile()).Execute("UPDATE Members SET Photograph = zeroblob(2000000)");
  EXPECT_EQ(site.Work.CopyNow(site.Members, [](CopyStep) { return false; }), std::nullopt);
  EXPECT_FALSE(
      site.Work.CopyToFile(site.MembersFile(), site.Folder / "stick.mdb", [](CopyStep) { return false; }));
  EXPECT_THAT(FilesInCopies(), IsEmpty());
  EXPECT_THAT(site.Disk.FileNames(site.Folder.Path()), IsEmpty());
}

TEST_F(Copies, AreCopiedToOtherFolders) {
  const BackupCopy copy = site.PutCopy(Early, CopySite::WithMembers("'Old'"));
  WriteFile(site.Folder / "stick.mdb", "to be replaced");
  EXPECT_TRUE(
      site.Work.CopyToFile(site.Work.PathOf(copy), site.Folder / "stick.mdb", [](CopyStep) { return true; }));
  EXPECT_EQ(site.NamesIn(site.Folder / "stick.mdb"), "Old");
  EXPECT_THAT(site.Disk.FileNames(site.Folder.Path()), ElementsAre("stick.mdb"));
}

TEST_F(Copies, LeaveTheOperatorsOwnFilesBesideThemAlone) {
  WriteFile(site.Folder / "stick.mdb.part", "dear");
  EXPECT_TRUE(
      site.Work.CopyToFile(site.MembersFile(), site.Folder / "stick.mdb", [](CopyStep) { return true; }));
  EXPECT_EQ(ReadFile(site.Folder / "stick.mdb.part"), "dear");
  EXPECT_THAT(site.Disk.FileNames(site.Folder.Path()), ElementsAre("stick.mdb", "stick.mdb.part"));
}

TEST_F(Copies, NameTheFolderThatTakesNone) {
  const Thrown thrown = ThrownBy([&] {
    site.Work.CopyToFile(site.MembersFile(), site.Folder / "nowhere/stick.mdb",
                         [](CopyStep) { return true; });
  });
  EXPECT_EQ(thrown.Number, 76);
  EXPECT_EQ(thrown.Text, "Path not found: " + site.Folder / "nowhere");
}

TEST_F(Copies, KnowWhereTheDataInUseLies) {
  const std::vector<CopiedDatabase> databases = {site.Members};
  const auto isInUse = [&](const std::string& file) { return site.Work.IsDataInUse(file, databases); };
  std::filesystem::create_directory_symlink(site.Folder / "data", site.Folder / "link");
  std::filesystem::create_symlink(site.MembersFile(), site.Folder / "soft.mdb");
  std::filesystem::create_hard_link(site.MembersFile(), site.Folder / "hard.mdb");
  for (const char* file : {"data/members.mdb", "data/new.mdb", "data/games.mdb", "data/../data/x.mdb",
                           "link/members.mdb", "link/x.mdb", "soft.mdb", "hard.mdb"}) {
    EXPECT_TRUE(isInUse(site.Folder / file)) << file;
  }
  std::filesystem::create_directory(site.Folder / "stick");
  WriteFile(site.Folder / "stick/members.mdb", "another one");
  for (const char* file : {"stick/members.mdb", "stick/new.mdb", "nowhere/new.mdb"}) {
    EXPECT_FALSE(isInUse(site.Folder / file)) << file;
  }
  std::filesystem::rename(site.MembersFile(), site.Folder / "stick/members.mdb");
  std::filesystem::create_symlink(site.Folder / "stick/members.mdb", site.MembersFile());
  EXPECT_TRUE(isInUse(site.Folder / "stick/members.mdb"));
  EXPECT_FALSE(isInUse(site.Folder / "stick/new.mdb"));
}

TEST_F(Copies, AreCounted) {
  EXPECT_EQ(site.Work.RowsIn(site.PutCopy(Early, CopySite::WithMembers("'Old', 'Two'")), site.Members), 2);
  const BackupCopy bad = site.PutCopy("members-2013-05-02-200000.mdb", "no database");
  EXPECT_EQ(NumberThrownBy([&] { site.Work.RowsIn(bad, site.Members); }), 3343);
}

TEST_F(Copies, BelongToTheirDatabase) {
  const auto owns = [this](const char* file) { return site.Members.Owns(*BackupCopyOf(file)); };
  EXPECT_TRUE(owns("members-2013-05-01-200000.mdb"));
  EXPECT_TRUE(owns("members-new-2013-05-01-200000-kept.mdb"));
  EXPECT_FALSE(owns("scenarios-2013-05-01-200000.mdb"));
}

class Restoring : public Copies {};

TEST_F(Restoring, PutsACopyInPlaceAndKeepsWhatWasThere) {
  const Restored restored = site.Restore(site.PutCopy(Early, CopySite::WithMembers("'Old', 'Two'")));
  EXPECT_EQ(restored.What, Restored::Done) << restored.Reason;
  EXPECT_EQ(restored.KeptAs, "members-2013-05-21-143005-replaced.mdb");
  EXPECT_EQ(site.Names(), "Old Two");
  EXPECT_EQ(site.NamesIn(site.CopyFolder() + "/" + restored.KeptAs), "Ann Bob Cid");
  EXPECT_EQ(site.NamesIn(site.CopyFolder() + "/" + Early), "Old Two");
  EXPECT_THAT(FilesInData(), ElementsAre("members.mdb"));
  EXPECT_THAT(FilesInCopies(), UnorderedElementsAre(Early, restored.KeptAs));
  EXPECT_EQ(OtherConnection(site.MembersFile()).Query("PRAGMA integrity_check"), "ok");
  EXPECT_EQ(OtherConnection(site.MembersFile()).Query("PRAGMA journal_mode"), "delete");
}

TEST_F(Restoring, CanBeTakenBackByTheCopyThatItMade) {
  const Restored restored = site.Restore(site.PutCopy(Early, CopySite::WithMembers("'Old'")));
  site.Open();
  EXPECT_EQ(site.Restore(*BackupCopyOf(restored.KeptAs)).What, Restored::Done);
  EXPECT_EQ(site.Names(), "Ann Bob Cid");
}

TEST_F(Restoring, KeepsThePermissionsAndReplacesTheFileBehindALink) {
  const std::string file = site.Folder / "elsewhere.mdb";
  std::filesystem::rename(site.MembersFile(), file);
  std::filesystem::create_symlink(file, site.MembersFile());
  chmod(file.c_str(), 0600);
  site.Open();
  EXPECT_EQ(site.Restore(site.PutCopy(Early, CopySite::WithMembers("'Old'"))).What, Restored::Done);
  EXPECT_TRUE(std::filesystem::is_symlink(site.MembersFile()));
  EXPECT_EQ(site.NamesIn(file), "Old");
  EXPECT_EQ(std::filesystem::status(file).permissions(), std::filesystem::perms(0600));
}

TEST_F(Restoring, LeavesNoJournalOrLogOfTheOldFileBesideTheNewOne) {
  for (const std::string mode : {"PERSIST", "WAL"}) {
    WriteFile(site.MembersFile(), CopySite::WithMembers("'Ann', 'Bob', 'Cid'"));
    {
      OtherConnection other(site.MembersFile());
      other.Query("PRAGMA journal_mode = " + mode);
      other.Execute("UPDATE Members SET City = 'x'");
    }
    site.Open();
    const Restored restored = site.Restore(site.PutCopy(Early, CopySite::WithMembers("'Old'")));
    EXPECT_EQ(restored.What, Restored::Done) << mode << restored.Reason;
    site.Open();
    EXPECT_THAT(FilesInData(), ElementsAre("members.mdb")) << mode;
    EXPECT_EQ(site.Names(), "Old") << mode;
  }
}

TEST_F(Restoring, TakesTheRowsOfACopyThatKeepsALog) {
  const BackupCopy copy = site.PutCopy(Early, CopySite::WithMembers("'Old'"));
  EXPECT_EQ(OtherConnection(site.Work.PathOf(copy)).Query("PRAGMA journal_mode = WAL"), "wal");
  EXPECT_EQ(site.Restore(copy).What, Restored::Done);
  EXPECT_EQ(site.Names(), "Old");
  EXPECT_EQ(OtherConnection(site.MembersFile()).Query("PRAGMA journal_mode"), "delete");
  EXPECT_THAT(FilesInData(), ElementsAre("members.mdb"));
}

TEST_F(Restoring, TakesThePlaceOfWhatACrashLeft) {
  const BackupCopy copy = site.PutCopy(Early, CopySite::WithMembers("'Old'"));
  WriteFile(site.MembersFile() + ".restored", "half of a database");
  WriteFile(site.CopyFolder() + "/members.part", "half of a database");
  EXPECT_EQ(site.Restore(copy).What, Restored::Done);
  EXPECT_EQ(site.Names(), "Old");
  EXPECT_THAT(FilesInData(), ElementsAre("members.mdb"));
  EXPECT_EQ(FilesInCopies().size(), 2U);
}

TEST_F(Restoring, RefusesWhatIsNoDatabaseOrIsDamaged) {
  ExpectRefused(site.Restore(site.PutCopy(Early, "no database")), Early);
  ExpectRefused(site.Restore(site.PutCopy(Early, std::string(9000, 'd'))), Early);
  std::string damaged = MadeDatabase("members",
                                     "INSERT INTO Members (FirstName, Photograph) VALUES ('Old', "
                                     "randomblob(200000))");
  damaged.replace(damaged.size() - 3 * 4096, 4096, std::string(4096, '\xEE'));
  ExpectRefused(site.Restore(site.PutCopy(Early, damaged)), Early);
  ExpectRefused(site.Restore(site.PutCopy(Early, damaged.substr(0, damaged.size() - 1000))), Early);
}

TEST_F(Restoring, RefusesACopyWithoutTheTableOrAColumn) {
  ExpectRefused(site.Restore(site.PutCopy(Early, MadeDatabase("scenarios"))), "Members");
  ExpectRefused(site.Restore(site.PutCopy(
                    Early, MadeDatabase("members", "ALTER TABLE Members DROP COLUMN PostalCode"))),
                "Its table Members has no column PostalCode.");
}

TEST_F(Restoring, TakesACopyWithColumnsOfItsOwnAndInOtherLetters) {
  const BackupCopy copy = site.PutCopy(
      Early, MadeDatabase("members",
                          "ALTER TABLE Members ADD COLUMN Shoe TEXT; ALTER TABLE Members RENAME "
                          "COLUMN City TO CITY; INSERT INTO Members (FirstName) VALUES ('Old')"));
  EXPECT_EQ(site.Restore(copy).What, Restored::Done);
  EXPECT_EQ(site.Names(), "Old");
}

TEST_F(Restoring, RefusesWhileAnotherProgramWrites) {
  const BackupCopy copy = site.PutCopy(Early, CopySite::WithMembers("'Old'"));
  OtherConnection other(site.MembersFile());
  other.Execute("BEGIN IMMEDIATE");
  ExpectRefused(site.Restore(copy), "Could not lock file");
  other.Execute("COMMIT");
  EXPECT_EQ(site.Restore(copy).What, Restored::Done);
}

TEST_F(Restoring, LosesNothingThatAnotherProgramWritesMeanwhile) {
  const BackupCopy copy = site.PutCopy(Early, CopySite::WithMembers("'Old'"));
  OtherConnection other(site.MembersFile());
  int refused = 0;
  site.KeepOn = [&](CopyStep step) {
    if (step != CopyStep::Checking) {
      EXPECT_EQ(other.Try("DELETE FROM Members"), SQLITE_BUSY);
      ++refused;
    }
    return true;
  };
  OtherConnection(site.MembersFile()).Execute("UPDATE Members SET Photograph = zeroblob(2000000)");
  EXPECT_EQ(site.Restore(copy).What, Restored::Done);
  EXPECT_GT(refused, 1);
}

TEST_F(Restoring, ChangesNothingWhenItIsStopped) {
  const std::string large = MadeDatabase(
      "members", "INSERT INTO Members (FirstName, Photograph) VALUES ('Old', zeroblob(3000000))");
  const BackupCopy copy = site.PutCopy(Early, large);
  OtherConnection(site.MembersFile()).Execute("UPDATE Members SET Photograph = zeroblob(2000000)");
  for (const CopyStep step : {CopyStep::KeepingPresent, CopyStep::Copying}) {
    site.KeepOn = [step](CopyStep now) { return now != step; };
    const Restored restored = site.Restore(copy);
    EXPECT_EQ(restored.What, Restored::Stopped) << static_cast<int>(step);
    ExpectUnchanged(restored);
  }
}

TEST_F(Restoring, ChangesNothingOnAFullDisk) {
  const std::string large =
      MadeDatabase("members", "INSERT INTO Members (FirstName, Photograph) VALUES ('Old', zeroblob(900000))");
  const BackupCopy copy = site.PutCopy(Early, large);
  const FileSizeLimit full(500'000);
  ExpectRefused(site.Restore(copy), "disk");
}

TEST_F(Restoring, ChangesNothingWhereTheCopiesCannotBeKept) {
  const BackupCopy copy = site.PutCopy(Early, CopySite::WithMembers("'Old'"));
  std::filesystem::permissions(site.CopyFolder(), std::filesystem::perms(0555));
  {
    const OrdinaryUser user;
    ExpectRefused(site.Restore(copy), site.CopyFolder());
  }
  std::filesystem::permissions(site.CopyFolder(), std::filesystem::perms(0755));
}

/// A disk that is nearly full.
class NarrowDisk : public LinuxFiles {
 public:
  std::uint64_t FreeSpace(const std::string& /*path*/) const override { return 30'000'000; }
};

TEST_F(Restoring, LeavesRoomToGamesAndSettings) {
  const BackupCopy copy = site.PutCopy(Early, CopySite::WithMembers("'Old'"));
  NarrowDisk disk;
  const CopyWork work({.Engine = site.Databases,
                       .Disk = disk,
                       .Time = site.Time,
                       .Strings = site.Strings,
                       .Folder = site.CopyFolder()});
  ExpectRefused(work.Restore(copy, site.Members, [](CopyStep) { return true; }), "Disk full");
  EXPECT_EQ(NumberThrownBy([&] { work.CopyNow(site.Members, [](CopyStep) { return true; }); }), 61);
}

/// Files whose replacement is not known to be durable.
class UnsureDisk : public LinuxFiles {
 public:
  void TakePlace(const std::string& path, const std::string& replaced) override {
    LinuxFiles::TakePlace(path, replaced);
    throw RuntimeError(Fault::PathAccess, "Path/File access error: " + replaced);
  }
};

TEST_F(Restoring, SaysWhenTheNewFileIsThereButPerhapsNotForGood) {
  const BackupCopy copy = site.PutCopy(Early, CopySite::WithMembers("'Old'"));
  UnsureDisk disk;
  const CopyWork work({.Engine = site.Databases,
                       .Disk = disk,
                       .Time = site.Time,
                       .Strings = site.Strings,
                       .Folder = site.CopyFolder()});
  const Restored restored = work.Restore(copy, site.Members, [](CopyStep) { return true; });
  EXPECT_EQ(restored.What, Restored::Uncertain);
  EXPECT_EQ(restored.Reason, "Path/File access error: " + site.MembersFile());
  EXPECT_EQ(site.Names(), "Old");
  EXPECT_EQ(site.NamesIn(site.CopyFolder() + "/" + restored.KeptAs), "Ann Bob Cid");
}

}  // namespace
