#include "core/data/Backups.h"

#include <gmock/gmock.h>

#include "platform/linux/LinuxFiles.h"
#include "tests/fakes/FakeClock.h"
#include "tests/support/FileSizeLimit.h"
#include "tests/support/OrdinaryUser.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// A disk with that much space left.
class DiskWithSpace : public LinuxFiles {
 public:
  std::uint64_t Space = std::uint64_t{1} << 40U;
  std::uint64_t FreeSpace(const std::string& /*path*/) const override { return Space; }
};

/// A members file whose backups go to a folder beside it.
class Backup : public testing::Test {
 protected:
  Backup() { file.AddMembers(); }

  /// Opens the database, as at the start of a program run.
  void Open() {
    rows.reset();
    database = file.Open();
    backups = std::make_unique<Backups>(Folder(), disk, clock, strings);
    backups->Guard(*database, file.Path());
    rows = database->OpenRecordset("Members");
  }

  void Change(const std::string& nickName) {
    rows->Edit();
    rows->SetField("NickName", nickName);
    rows->Update();
  }

  /// A program run at the time `moment` that makes one change.
  void RunAt(const std::string& moment) {
    clock.DateAndTime = moment;
    Open();
    Change(moment);
  }

  std::string Folder() const { return file.Folder() / "backups"; }
  std::vector<std::string> Copies() const { return disk.FileNames(Folder()); }
  std::string NickNameIn(const std::string& copy) const {
    return OtherConnection(Folder() + "/" + copy).Query("SELECT NickName FROM Members WHERE ContactID = 1");
  }

  TestDatabase file;
  DiskWithSpace disk;
  FakeClock clock;
  StringTable strings{Language::English};
  std::unique_ptr<Backups> backups;
  std::unique_ptr<Database> database;
  std::unique_ptr<Recordset> rows;
};

TEST_F(Backup, IsMadeBeforeTheFirstChangeOfARunAndNotAgain) {
  Open();
  Change("first");
  clock.DateAndTime = "2013-05-21 15:00:00";
  Change("second");
  rows->Delete();
  EXPECT_THAT(Copies(), ElementsAre("members-2013-05-21-143005.mdb"));
  EXPECT_EQ(NickNameIn("members-2013-05-21-143005.mdb"), "Shamrock");
  EXPECT_EQ(backups->TakeFailure(), "");
}

TEST_F(Backup, IsMadeAnewWhenAskedWhichCountsAsThatOfTheRun) {
  Open();
  Change("first");
  clock.DateAndTime = "2013-05-21 15:00:00";
  backups->CopyNow(*database, file.Path(), nullptr);
  Change("second");
  EXPECT_THAT(Copies(), ElementsAre("members-2013-05-21-143005.mdb", "members-2013-05-21-150000.mdb"));
  EXPECT_EQ(NickNameIn("members-2013-05-21-150000.mdb"), "first");
  Open();
  clock.DateAndTime = "2013-05-22 15:00:00";
  backups->CopyNow(*database, file.Path(), nullptr);
  Change("third");
  EXPECT_EQ(Copies().size(), 3U);
}

TEST_F(Backup, IsNotMadeWithoutAChange) {
  Open();
  for (rows->MoveFirst(); !rows->Eof(); rows->MoveNext()) {
    rows->Fields("FirstName");
  }
  rows->MoveFirst();
  rows->Edit();
  rows->Update();  // writes nothing
  EXPECT_THAT(Copies(), IsEmpty());
  EXPECT_FALSE(disk.FolderExists(Folder()));
}

TEST_F(Backup, IsMadeOfEveryKindOfChange) {
  Open();
  rows->AddNew();
  rows->SetField("FirstName", std::string("New"));
  rows->Update();
  EXPECT_EQ(Copies().size(), 1U);
  clock.DateAndTime = "2013-05-22 00:00:00";
  Open();
  rows->Delete();
  EXPECT_EQ(Copies().size(), 2U);
  clock.DateAndTime = "2013-05-23 00:00:00";
  Open();
  WriteScope group(*database);
  Change("grouped");
  group.Commit();
  EXPECT_EQ(Copies().size(), 3U);
  EXPECT_EQ(NickNameIn(Copies()[1]), "Shamrock");
  EXPECT_EQ(NickNameIn(Copies()[2]), "none");  // deleted in the previous run
}

TEST_F(Backup, IsMadeWithinAGroupOfReads) {
  Open();
  const ReadScope reads(*database);
  rows->Fields("NickName");
  Change("first");
  EXPECT_EQ(NickNameIn("members-2013-05-21-143005.mdb"), "Shamrock");
  EXPECT_EQ(TextOf(*rows, "NickName"), "first");
}

TEST_F(Backup, HoldsPhotosAndBringsAllBackWhenItIsCopiedToTheDatabase) {
  file.Execute("UPDATE Members SET Photograph = zeroblob(50000), PhotographLength = 50000");
  Open();
  file.Execute("DELETE FROM Members WHERE ContactID > 1");
  Change("changed");
  rows.reset();
  database.reset();
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members"), "1");
  std::filesystem::copy_file(Folder() + "/members-2013-05-21-143005.mdb", file.Path(),
                             std::filesystem::copy_options::overwrite_existing);
  EXPECT_EQ(file.Query("SELECT NickName || length(Photograph) FROM Members"), "Shamrock50000");
  EXPECT_EQ(file.Query("PRAGMA integrity_check"), "ok");
}

TEST_F(Backup, KeepsTheLastTen) {
  for (int day = 10; day < 23; ++day) {
    RunAt("2013-05-" + std::to_string(day) + " 20:00:00");
  }
  const std::vector<std::string> copies = Copies();
  ASSERT_EQ(copies.size(), 10U);
  EXPECT_EQ(copies.front(), "members-2013-05-13-200000.mdb");
  EXPECT_EQ(copies.back(), "members-2013-05-22-200000.mdb");
  EXPECT_EQ(NickNameIn(copies.back()), "2013-05-21 20:00:00");
}

TEST_F(Backup, DeletesNothingButCopiesOfItsOwn) {
  disk.CreateFolder(Folder());
  const std::vector<std::string> others = {"members-2013-05-09.mdb", "members-new-2013-05-09-200000.mdb",
                                           "members.mdb", "notes.txt", "scenarios-2013-05-09-200000.mdb"};
  for (const std::string& other : others) {
    WriteFile(Folder() + "/" + other, "other");
  }
  for (int day = 10; day < 22; ++day) {
    RunAt("2013-05-" + std::to_string(day) + " 20:00:00");
  }
  const std::vector<std::string> copies = Copies();
  EXPECT_EQ(copies.size(), 10 + others.size());
  EXPECT_THAT(copies, testing::IsSupersetOf(others));
}

TEST_F(Backup, KeepsTheNewestWhenTheClockWasSetBack) {
  for (int day = 10; day < 20; ++day) {
    RunAt("2013-05-" + std::to_string(day) + " 20:00:00");
  }
  RunAt("2001-01-01 00:00:00");
  EXPECT_EQ(Copies().size(), 10U);
  EXPECT_EQ(NickNameIn("members-2001-01-01-000000.mdb"), "2013-05-19 20:00:00");
}

TEST_F(Backup, TakesThePlaceOfOneThatACrashLeftHalfWritten) {
  disk.CreateFolder(Folder());
  WriteFile(Folder() + "/members.part", "half of a database");
  Open();
  Change("first");
  EXPECT_THAT(Copies(), ElementsAre("members-2013-05-21-143005.mdb"));
  EXPECT_EQ(NickNameIn("members-2013-05-21-143005.mdb"), "Shamrock");
}

TEST_F(Backup, ThatCannotBeMadeIsReportedOnceAndDelaysNoChange) {
  WriteFile(Folder(), "a file in place of the folder");
  Open();
  Change("first");
  EXPECT_THAT(backups->TakeFailure(), testing::StartsWith("The backup copies of " + file.Path() +
                                                          " could not be brought up to date. "));
  Change("second");
  EXPECT_EQ(backups->TakeFailure(), "");
  EXPECT_EQ(file.Query("SELECT NickName FROM Members WHERE ContactID = 1"), "second");
}

TEST_F(Backup, OnAFullDiskLeavesNoPartBehind) {
  file.Execute("UPDATE Members SET Photograph = zeroblob(500000)");
  Open();
  {
    const FileSizeLimit full(100'000);
    EXPECT_EQ(NumberThrownBy([this] { Change("first"); }), 3026);
  }
  EXPECT_NE(backups->TakeFailure(), "");
  EXPECT_THAT(Copies(), IsEmpty());
  EXPECT_TRUE(disk.FolderExists(Folder()));
}

TEST_F(Backup, IsTriedAgainWhenTheFileWasLocked) {
  Open();
  {
    OtherConnection other(file.Path());
    other.Execute("BEGIN EXCLUSIVE");
    EXPECT_EQ(NumberThrownBy([this] { database->OpenRecordset("Members"); }), 3050);
    EXPECT_EQ(NumberThrownBy([this] { WriteScope(*database).Commit(); }), 3050);
  }
  EXPECT_EQ(backups->TakeFailure(), "");
  EXPECT_THAT(Copies(), IsEmpty());
  Change("first");
  EXPECT_EQ(NickNameIn("members-2013-05-21-143005.mdb"), "Shamrock");
}

TEST_F(Backup, IsNotMadeOfAFileThatCannotBeChanged) {
  std::filesystem::permissions(file.Path(), std::filesystem::perms(0444));
  const OrdinaryUser user;
  Open();
  EXPECT_EQ(NumberThrownBy([this] { Change("first"); }), 3027);
  EXPECT_THAT(Copies(), IsEmpty());
  EXPECT_EQ(backups->TakeFailure(), "");
}

TEST_F(Backup, OfNowIsMadeInStepsUnlessItIsStopped) {
  Open();
  file.Execute("UPDATE Members SET Photograph = randomblob(2000000)");
  const std::vector<std::string> before = Copies();
  clock.DateAndTime = "2026-11-22 10:00:00";
  EXPECT_FALSE(backups->CopyNow(*database, file.Path(), [] { return false; }));
  EXPECT_EQ(Copies(), before);
  int asked = 0;
  EXPECT_TRUE(backups->CopyNow(*database, file.Path(), [&asked] { return ++asked > 0; }));
  EXPECT_GE(asked, 2);
  EXPECT_EQ(NickNameIn("members-2026-11-22-100000.mdb"), "Shamrock");
}

TEST_F(Backup, LeavesRoomForGamesAndIsMadeBeforeALaterChange) {
  Open();
  disk.Space = (std::uint64_t{32} << 20U) + std::filesystem::file_size(file.Path()) - 1;
  Change("first");
  EXPECT_THAT(Copies(), IsEmpty());
  EXPECT_EQ(backups->TakeFailure(), "");
  EXPECT_TRUE(backups->LacksRoom());
  EXPECT_EQ(NumberThrownBy([this] { backups->CopyNow(*database, file.Path(), nullptr); }), 61);
  ++disk.Space;
  Change("second");
  EXPECT_FALSE(backups->LacksRoom());
  EXPECT_EQ(Copies().size(), 1U);
  EXPECT_EQ(NickNameIn(Copies().front()), "first");
}

}  // namespace
