#include "takeover/TakeOverWork.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeOldDatabases.h"
#include "tests/support/OldFiles.h"
#include "tests/takeover/TakeOverSite.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class TakeOvers : public testing::Test {
 protected:
  TakeOvers() { site.PutInstallation("old", "Eve"); }

  /// What Look finds of this kind.
  FoundItem Found(OldItem what) {
    for (FoundItem& item : site.Look(work, "old")) {
      if (item.What == what) {
        return item;
      }
    }
    return {.What = what};
  }

  std::string ColumnsWithoutTypes() {
    std::string columns;
    for (const std::string& name : site.Members->ColumnNames("Members")) {
      columns.append(columns.empty() ? "" : ", ").append(name);
    }
    return columns;
  }

  void ExpectUntouched() const {
    EXPECT_EQ(site.Labels(), site.LabelsOf("Now"));
    EXPECT_FALSE(HasTakeOverMark(site.Disk, site.Data()));
    EXPECT_THAT(site.Disk.FileNames(site.Data() + "/backups"), IsEmpty());
  }

  TakeOverSite site;
  TakeOverWork work{site.Parts()};
};

TEST_F(TakeOvers, TellRowsAndDatesOfBothSides) {
  std::filesystem::create_directories(site.Folder / "old/2012");
  WriteFile(site.Folder / "old/2012/a.xml", "<GameData/>");
  const auto all = site.Look(work, "old");
  ASSERT_EQ(all.size(), 5U);
  EXPECT_EQ(all[0].State, FoundItem::Usable);
  EXPECT_EQ(all[0].Count, 2);
  EXPECT_EQ(all[0].CountNow, 2);
  EXPECT_EQ(all[0].Changed, site.Disk.TimeOfChange(site.Folder / "old/members.mdb"));
  EXPECT_EQ(all[0].ChangedNow, site.Disk.TimeOfChange(site.Data() + "/members.mdb"));
  EXPECT_EQ(all[1].Count, 1);
  EXPECT_EQ(all[2].State, FoundItem::Usable);
  EXPECT_EQ(all[3].Count, 2);  // the port and the factor of heals
  EXPECT_EQ(all[3].Different, 0);
  EXPECT_EQ(all[4].Count, 1);
}

TEST_F(TakeOvers, ChangeNothingByLooking) {
  site.Look(work, "old");
  ExpectUntouched();
  EXPECT_EQ(site.Labels(), site.LabelsOf("Now"));
}

TEST_F(TakeOvers, ReplaceEverythingAndKeepCopies) {
  site.PutInstallation("old", "Zachary");
  site.Look(work, "old");
  const TakenOver taken = site.TakeAll(work);
  EXPECT_EQ(taken.What, TakenOver::Done) << taken.Reason;
  EXPECT_EQ(site.Labels(), site.LabelsOf("Zachary"));
  EXPECT_THAT(
      taken.KeptAs,
      ElementsAre("members-2013-05-21-143005-replaced.mdb", "scenarios-2013-05-21-143005-replaced.mdb",
                  "score_card-2013-05-21-143005-replaced.doc", "tessarine-2013-05-21-143005-replaced.ini"));
  EXPECT_EQ(ReadFile(site.Data() + "/backups/" + taken.KeptAs[2]), site.Document("Now"));
  EXPECT_EQ(OtherConnection(site.Data() + "/backups/" + taken.KeptAs[0])
                .Query("SELECT FirstName FROM Members ORDER BY ContactID"),
            "Now");
  EXPECT_THAT(site.Disk.FileNames(TakeOverFolder(site.Data())), IsEmpty());
}

TEST_F(TakeOvers, LeavePortsAndOwnSectionsOfTheSettings) {
  WriteFile(site.Data() + "/tessarine.ini",
            "[soldiering_calc]\nheals=3\n[ports]\ncom3=/dev/mine\n[audience]\nvenue=Hall\n");
  site.PutInstallation("old", "Zachary");
  site.Look(work, "old");
  work.Take({OldItem::Settings}, [](TakeStep) { return true; });
  const IniReader ini(site.Disk, site.Data() + "/tessarine.ini");
  EXPECT_EQ(ini.ReadIni("soldiering_calc", "heals", ""), "7");
  EXPECT_EQ(ini.ReadIni("comm", "commport", ""), "3");
  EXPECT_EQ(ini.ReadIni("ports", "com3", ""), "/dev/mine");
  EXPECT_EQ(ini.ReadIni("audience", "venue", ""), "Hall");
}

TEST_F(TakeOvers, TakeOnlyWhatIsWanted) {
  site.Look(work, "old");
  const TakenOver taken = work.Take({OldItem::Missions}, [](TakeStep) { return true; });
  EXPECT_EQ(taken.What, TakenOver::Done);
  EXPECT_EQ(site.Labels(), "Now Eve Now 3");
  EXPECT_THAT(taken.KeptAs, ElementsAre("scenarios-2013-05-21-143005-replaced.mdb"));
}

TEST_F(TakeOvers, NeverTakeWhatIsDamaged) {
  WriteFile(site.Folder / "old/members.mdb", "no database");
  WriteFile(site.Folder / "old/score_card.doc", "a letter");
  const auto all = site.Look(work, "old");
  EXPECT_EQ(all[0].State, FoundItem::Unusable);
  EXPECT_THAT(all[0].Remark, HasSubstr("Unrecognized database format"));
  EXPECT_EQ(all[1].State, FoundItem::Usable);
  EXPECT_EQ(all[2].State, FoundItem::Unusable);
  EXPECT_EQ(site.TakeAll(work).What, TakenOver::Done);
  EXPECT_EQ(site.Labels(), "Now Eve Now 3");
}

TEST_F(TakeOvers, RefuseADatabaseThatIsCutOff) {
  std::string bytes = ReadFile(site.Folder / "old/members.mdb");
  for (std::size_t kept : {bytes.size() / 2, bytes.size() - 1, std::size_t{100}, std::size_t{0}}) {
    WriteFile(site.Folder / "old/members.mdb", bytes.substr(0, kept));
    EXPECT_EQ(Found(OldItem::Members).State, FoundItem::Unusable) << kept;
  }
}

TEST_F(TakeOvers, RefuseADatabaseOfAnotherProgram) {
  std::filesystem::remove(site.Folder / "old/members.mdb");
  OtherConnection(site.Folder / "old/members.mdb").Execute("CREATE TABLE Other (x)");
  EXPECT_EQ(Found(OldItem::Members).State, FoundItem::Unusable);
  OtherConnection(site.Folder / "old/members.mdb")
      .Execute("CREATE TABLE Members (ContactID INTEGER PRIMARY KEY)");
  EXPECT_THAT(Found(OldItem::Members).Remark, HasSubstr("has no column"));
}

TEST_F(TakeOvers, RefuseRowsThatTheProgramCouldNotUse) {
  const struct {
    const char* Rows;
    const char* Reason;
  } cases[] = {
      {"('1', 'Ada', 0, 0, NULL), ('1', 'Bob', 0, 0, NULL)", "Row 2 of table Members does not fit: "},
      {"(NULL, 'Ada', 0, 0, NULL)", "Row 1 of table Members does not fit: ContactID"},
      {"('x', 'Ada', 0, 0, NULL)", "Row 1 of table Members does not fit: "},
      {"(1, 'Ada', 0, 0, NULL), (2, 'Bob', 'many', 0, NULL)",
       "Row 2 of table Members does not fit: TotalGamesPlayed"},
      {"(1, 'Ada', NULL, 0, NULL)", "Row 1 of table Members does not fit: "},
      {"(1, 'Ada', 0, x'00', NULL)", "Row 1 of table Members does not fit: TotalDamage"},
      {"(1, x'414243', 0, 0, NULL)", "Row 1 of table Members does not fit: FirstName"},
  };
  for (const auto& each : cases) {
    std::filesystem::remove(site.Folder / "old/members.mdb");
    OtherConnection other(site.Folder / "old/members.mdb");
    other.Execute("CREATE TABLE Members (" + ColumnsWithoutTypes() + ")");
    other.Execute(
        "INSERT INTO Members (ContactID, FirstName, TotalGamesPlayed, TotalDamage, Photograph) VALUES " +
        std::string(each.Rows));
    other.Execute(
        "UPDATE Members SET TotalSoldiering = 0, AverageDamage = 0, AverageSoldiering = 0, "
        "TotalPrimaryAccuracy = 0, PriZeroAccuracyCount = 0, AveragePrimAccuracy = 0, "
        "AverageSecAccuracy = 0");
    const FoundItem found = Found(OldItem::Members);
    EXPECT_EQ(found.State, FoundItem::Unusable) << each.Rows;
    EXPECT_THAT(found.Remark, testing::StartsWith(each.Reason)) << each.Rows;
  }
}

TEST_F(TakeOvers, MakeDatabasesOfThisProgramFromOthersWithTheSameColumns) {
  std::filesystem::remove(site.Folder / "old/members.mdb");
  {
    OtherConnection other(site.Folder / "old/members.mdb");
    other.Execute("CREATE TABLE Members (" + ColumnsWithoutTypes() + ", Extra)");
    other.Execute(
        "INSERT INTO Members (ContactID, FirstName, DallasID, TotalGamesPlayed, TotalDamage, "
        "TotalSoldiering, "
        "AverageDamage, AverageSoldiering, TotalPrimaryAccuracy, PriZeroAccuracyCount, AveragePrimAccuracy, "
        "AverageSecAccuracy, PhotographLength, Photograph) VALUES ('7', 'Ada', 12, '3', 1, 2, 3, 4, 5, 6, 7, "
        "8, "
        "3, x'FFD8FF'); CREATE TRIGGER Nosy AFTER INSERT ON Members BEGIN DELETE FROM Members; END");
  }
  EXPECT_EQ(Found(OldItem::Members).Remark, "");
  work.Take({OldItem::Members}, [](TakeStep) { return true; });
  OtherConnection taken(site.Data() + "/members.mdb");
  EXPECT_EQ(taken.Query("SELECT ContactID || FirstName || DallasID || typeof(TotalGamesPlayed) || "
                        "hex(Photograph) FROM Members"),
            "7Ada12integerFFD8FF");
  EXPECT_EQ(taken.Query("SELECT count(*) FROM sqlite_master WHERE type = 'trigger'"), "0");
  EXPECT_EQ(taken.Query("SELECT count(*) FROM sqlite_master WHERE type = 'index'"), "4");
  taken.Execute("INSERT INTO Members (FirstName) VALUES ('Bob')");
  EXPECT_EQ(taken.Query("SELECT max(ContactID) FROM Members"), "8");
}

TEST_F(TakeOvers, NeverGiveTheNumberOfADeletedMemberAgain) {
  OtherConnection(site.Folder / "old/members.mdb")
      .Execute("INSERT INTO Members (ContactID) VALUES (40); DELETE FROM Members WHERE ContactID = 40");
  site.Look(work, "old");
  work.Take({OldItem::Members}, [](TakeStep) { return true; });
  OtherConnection taken(site.Data() + "/members.mdb");
  taken.Execute("INSERT INTO Members (FirstName) VALUES ('Bob')");
  EXPECT_EQ(taken.Query("SELECT max(ContactID) FROM Members"), "41");
}

TEST_F(TakeOvers, KeepWhatTheyMakeFromOtherUsers) {
  const std::string folder = TakeOverFolder(site.Data());
  std::filesystem::create_directory(folder);  // as an earlier version did
  site.Look(work, "old");
  EXPECT_TRUE(site.Disk.FileExists(folder + "/members.mdb"));
  EXPECT_EQ(std::filesystem::status(folder).permissions(), std::filesystem::perms::owner_all);
}

TEST_F(TakeOvers, BringAnUnfinishedChangeOfTheOldDatabaseToItsEnd) {
  OtherConnection other(site.Folder / "old/members.mdb");
  other.Execute(
      "PRAGMA cache_size = 1; PRAGMA cache_spill = 1; BEGIN; "
      "UPDATE Members SET FirstName = 'Torn'; "
      "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 400) INSERT INTO "
      "Members (Photograph) SELECT randomblob(4000) FROM n");
  std::filesystem::create_directories(site.Folder / "torn");
  for (const char* file : {"members.mdb", "members.mdb-journal"}) {
    std::filesystem::copy_file(site.Folder / "old/" + file, site.Folder / "torn/" + file);
  }
  ASSERT_GT(std::filesystem::file_size(site.Folder / "torn/members.mdb"), 500'000U);
  EXPECT_EQ(site.Look(work, "torn")[0].Count, 2);
  work.Take({OldItem::Members}, [](TakeStep) { return true; });
  EXPECT_EQ(site.Labels(), "Eve Now Now 3");
  EXPECT_TRUE(std::filesystem::exists(site.Folder / "torn/members.mdb-journal"));
}

TEST_F(TakeOvers, OnlyReadTheOldInstallation) {
  const std::string before = ReadFile(site.Folder / "old/members.mdb");
  for (const auto& entry : std::filesystem::directory_iterator(site.Folder / "old")) {
    std::filesystem::permissions(entry, std::filesystem::perms(0444));
  }
  std::filesystem::permissions(site.Folder / "old", std::filesystem::perms(0555));
  site.Look(work, "old");
  EXPECT_EQ(site.TakeAll(work).What, TakenOver::Done);
  EXPECT_EQ(site.Labels(), site.LabelsOf("Eve"));
  EXPECT_EQ(ReadFile(site.Folder / "old/members.mdb"), before);
  EXPECT_EQ(site.Disk.FileNames(site.Folder / "old").size(), 4U);
  std::filesystem::permissions(site.Folder / "old", std::filesystem::perms(0755));
}

TEST_F(TakeOvers, StopAtAnyStepWithNothingChanged) {
  const OldInstallation old = FindOldInstallation(site.Disk, site.Folder / "old").value();
  int steps = 0;
  site.Look(work, "old");
  const auto all = {OldItem::Members, OldItem::Missions, OldItem::Template, OldItem::Settings};
  for (int last = 0;; ++last) {
    steps = 0;
    if (!work.Look(old, [&](OldItem) { return ++steps <= last; }).empty()) {
      break;
    }
    ExpectUntouched();
  }
  EXPECT_GT(steps, 8);
  for (int last = 0;; ++last) {
    steps = 0;
    const TakenOver taken = work.Take(all, [&](TakeStep) { return ++steps <= last; });
    if (taken.What == TakenOver::Done) {
      break;
    }
    EXPECT_EQ(taken.What, TakenOver::Stopped);
    ExpectUntouched();
  }
  EXPECT_GT(steps, 1);
  EXPECT_EQ(site.Labels(), site.LabelsOf("Eve"));
}

TEST_F(TakeOvers, LeaveNothingBesideWhenGivenUp) {
  {
    TakeOverWork other(site.Parts());
    site.Look(other, "old");
    EXPECT_FALSE(site.Disk.FileNames(TakeOverFolder(site.Data())).empty());
  }
  EXPECT_THAT(site.Disk.FileNames(TakeOverFolder(site.Data())), IsEmpty());
}

TEST_F(TakeOvers, AreRefusedWhileAnotherProgramWrites) {
  site.Look(work, "old");
  OtherConnection other(site.Data() + "/members.mdb");
  other.Execute("BEGIN IMMEDIATE");
  const TakenOver taken = site.TakeAll(work);
  EXPECT_EQ(taken.What, TakenOver::Refused);
  EXPECT_THAT(taken.Reason, HasSubstr("Could not lock file"));
  ExpectUntouched();
}

TEST_F(TakeOvers, FollowALinkToTheFileInUse) {
  std::filesystem::create_directories(site.Folder / "elsewhere");
  std::filesystem::rename(site.Data() + "/members.mdb", site.Folder / "elsewhere/m.mdb");
  std::filesystem::create_symlink(site.Folder / "elsewhere/m.mdb", site.Data() + "/members.mdb");
  site.Open();
  site.Look(work, "old");
  EXPECT_EQ(site.TakeAll(work).What, TakenOver::Done);
  EXPECT_TRUE(std::filesystem::is_symlink(site.Data() + "/members.mdb"));
  EXPECT_EQ(site.Labels(), site.LabelsOf("Eve"));
}

TEST_F(TakeOvers, KeepTheFilesOfTwoInOneSecondApart) {
  site.Look(work, "old");
  site.TakeAll(work);
  site.Open();
  site.Look(work, "old");
  EXPECT_EQ(site.TakeAll(work).KeptAs.back(), "tessarine-2013-05-21-143005-replaced2.ini");
}

TEST_F(TakeOvers, AreStoppedInTheMiddleOfAnOldFile) {
  FakeOldDatabases old;
  old.OldPaths = {site.Data() + "/.takeover/old-members.mdb"};
  int asked = 0;
  bool shownTwice = true;
  old.Run = [&](const OldDatabase& database, ConversionSteps& steps) {
    WriteFile(database.Path + ".new", "half");
    shownTwice = !steps.ShowsProgress();
    while (steps.KeepOn()) {
    }
    throw OldDatabaseStopped();
  };
  TakeOverWork::Parts parts = site.Parts();
  TakeOverWork stopped({.Engine = parts.Engine,
                        .Old = old,
                        .Disk = parts.Disk,
                        .Time = parts.Time,
                        .Strings = parts.Strings,
                        .DataFolder = parts.DataFolder,
                        .Databases = parts.Databases,
                        .Ask = parts.Ask,
                        .HasPort = parts.HasPort});
  const auto found = stopped.Look(FindOldInstallation(site.Disk, site.Folder / "old").value(),
                                  [&asked](OldItem) { return ++asked < 20; });
  ASSERT_EQ(old.Converted.size(), 1U);
  EXPECT_THAT(found, IsEmpty());
  EXPECT_EQ(asked, 20);
  EXPECT_FALSE(shownTwice);
  EXPECT_THAT(site.Disk.FileNames(site.Data() + "/.takeover"), IsEmpty());
  ExpectUntouched();
}

class JetTakeOvers : public TakeOvers {
 protected:
  void PutOldFiles() const {
    for (const char* file : {"members.mdb", "scenarios.mdb"}) {
      std::filesystem::copy_file(TESSARINE_OLD_FILES + std::string("/") + file, site.Folder / "old/" + file,
                                 std::filesystem::copy_options::overwrite_existing);
    }
  }
};

TEST_F(JetTakeOvers, AreConvertedAsAtTheStart) {
  SKIP_WITHOUT_OLD_FILES();
  PutOldFiles();
  const auto all = site.Look(work, "old");
  EXPECT_EQ(all[0].State, FoundItem::Usable) << all[0].Remark;
  EXPECT_EQ(all[1].State, FoundItem::Usable) << all[1].Remark;
  EXPECT_EQ(site.TakeAll(work).What, TakenOver::Done);
  EXPECT_EQ(OtherConnection(site.Data() + "/members.mdb").Query("SELECT count(*) FROM Members"),
            std::to_string(all[0].Count));
  EXPECT_EQ(OtherConnection(site.Data() + "/scenarios.mdb").Query("SELECT count(*) FROM Table1"),
            std::to_string(all[1].Count));
  EXPECT_GT(all[0].Count, 10);
  EXPECT_TRUE(site.Old.IsOld(site.Folder / "old/members.mdb"));
  EXPECT_FALSE(std::filesystem::exists(site.Folder / "old/members.mdb.jet"));
}

TEST_F(JetTakeOvers, AreRefusedWhenCutOff) {
  SKIP_WITHOUT_OLD_FILES();
  PutOldFiles();
  std::filesystem::permissions(site.Folder / "old/members.mdb", std::filesystem::perms(0644));
  std::filesystem::resize_file(site.Folder / "old/members.mdb", 40960);
  EXPECT_EQ(Found(OldItem::Members).State, FoundItem::Unusable);
  EXPECT_EQ(Found(OldItem::Missions).State, FoundItem::Usable);
}

}  // namespace
