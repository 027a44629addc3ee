#include <gmock/gmock.h>

#include <filesystem>
#include <fstream>

#include "tests/support/OrdinaryUser.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;

class WholeDatabaseFile : public testing::Test {
 protected:
  WholeDatabaseFile() {
    file.AddMembers();
    file.Execute("UPDATE Members SET Photograph = randomblob(600000)");
  }

  std::string Other() const { return file.Folder() / "other.mdb"; }
  static bool Exists(const std::string& path) { return std::filesystem::exists(path); }

  TestDatabase file;
  int asked = 0;
  KeepOn always = [this] { return ++asked > 0; };
};

TEST_F(WholeDatabaseFile, IsCopiedInSteps) {
  EXPECT_TRUE(file.Open()->CopyInSteps(Other(), always));
  EXPECT_GE(asked, 2);
  EXPECT_EQ(OtherConnection(Other()).Query("SELECT sum(length(Photograph)) FROM Members"), "2400000");
  EXPECT_EQ(OtherConnection(Other()).Query("PRAGMA integrity_check"), "ok");
}

TEST_F(WholeDatabaseFile, IsNotCopiedToItsEndWhenThatIsStopped) {
  EXPECT_FALSE(file.Open()->CopyInSteps(Other(), [this] { return ++asked < 2; }));
  EXPECT_EQ(asked, 2);
}

TEST_F(WholeDatabaseFile, MayBeWrittenByOthersBetweenTheSteps) {
  EXPECT_TRUE(file.Open()->CopyInSteps(Other(), [this] {
    if (++asked == 1) {
      file.Execute("UPDATE Members SET Clan = 'late'");
    }
    return true;
  }));
  EXPECT_EQ(OtherConnection(Other()).Query("SELECT count(*) FROM Members WHERE Clan = 'late'"), "4");
}

TEST_F(WholeDatabaseFile, ThatKeepsALogHasACopyWithoutOne) {
  EXPECT_EQ(file.Query("PRAGMA journal_mode = WAL"), "wal");
  file.Open()->CopyTo(Other());
  EXPECT_EQ(OtherConnection(Other()).Query("PRAGMA journal_mode"), "delete");
  EXPECT_FALSE(Exists(Other() + "-wal"));
  EXPECT_FALSE(Exists(Other() + "-shm"));
}

TEST_F(WholeDatabaseFile, IsCopiedStepByStepWithWhatIsWrittenMeanwhile) {
  const std::unique_ptr<Database> database = file.Open();
  {
    const std::unique_ptr<StepwiseCopy> copy = database->BeginCopy(Other());
    EXPECT_FALSE(copy->Step());
    const auto rows = database->OpenRecordset("Members");
    rows->Edit();
    rows->SetField("Clan", std::string("late"));
    rows->Update();
    while (!copy->Step()) {
      ASSERT_LT(++asked, 100);
    }
  }
  EXPECT_EQ(OtherConnection(Other()).Query("SELECT count(*) FROM Members WHERE Clan = 'late'"), "1");
  EXPECT_EQ(OtherConnection(Other()).Query("SELECT sum(length(Photograph)) FROM Members"), "2400000");
  EXPECT_EQ(OtherConnection(Other()).Query("PRAGMA integrity_check"), "ok");
}

TEST_F(WholeDatabaseFile, ThatIsLockedWaitsWithTheNextStepOfItsCopy) {
  const std::unique_ptr<Database> database = file.Open();
  const std::unique_ptr<StepwiseCopy> copy = database->BeginCopy(Other());
  {
    OtherConnection other(file.Path());
    other.Execute("BEGIN EXCLUSIVE");
    EXPECT_FALSE(copy->Step());
    EXPECT_FALSE(copy->Step());
    other.Execute("ROLLBACK");
  }
  while (!copy->Step()) {
    ASSERT_LT(++asked, 100);
  }
  EXPECT_EQ(OtherConnection(Other()).Query("SELECT count(*) FROM Members"), "4");
}

/// Copies the file step by step to `target`.
void CopyByStep(const std::string& path, const std::string& target) {
  const std::unique_ptr<Database> database = SqliteEngine(std::chrono::milliseconds(0)).OpenDatabase(path);
  const std::unique_ptr<StepwiseCopy> copy = database->BeginCopy(target);
  while (!copy->Step()) {
  }
}

TEST_F(WholeDatabaseFile, IsFoundDamagedByTheStepsOfItsCopy) {
  file.Execute("CREATE INDEX MembersByClan ON Members (Clan, FirstName)");
  EXPECT_NO_THROW(CopyByStep(file.Path(), Other() + ".sound"));
  const std::string sound = ReadFile(file.Path());
  for (const double place : {0.1, 0.5, 0.9}) {
    std::string damaged = sound;
    const auto at = static_cast<std::size_t>(place * static_cast<double>(sound.size())) / 4096 * 4096;
    WriteFile(Other(), damaged.replace(at, 4096, std::string(4096, '\xEE')));
    EXPECT_EQ(NumberThrownBy([this] { CopyByStep(Other(), Other() + ".copy"); }), 3343) << place;
  }
}

TEST_F(WholeDatabaseFile, WithAnIndexThatLacksOrMixesUpRowsIsFoundDamagedByTheStepsOfItsCopy) {
  for (const char* wrong : {"DELETE FROM Shadow WHERE Word = 'c'", "INSERT INTO Shadow VALUES ('d')",
                            "UPDATE Shadow SET Word = 'zz'"}) {
    WriteFile(Other(), "");
    OtherConnection other(Other());
    other.Execute("CREATE TABLE Words (Word TEXT); INSERT INTO Words VALUES ('a'), ('b'), ('c')");
    other.Execute("CREATE TABLE Shadow (Word TEXT); INSERT INTO Shadow SELECT * FROM Words");
    // Tables without row numbers and indexes of all kinds stand beside them.
    other.Execute(
        "CREATE TABLE Pairs (A, B, C, PRIMARY KEY (A, B)) WITHOUT ROWID; CREATE INDEX ByC ON Pairs (C, A); "
        "CREATE INDEX ByLower ON Pairs (lower(C)); CREATE INDEX SomeB ON Pairs (B) WHERE B > 1; CREATE TABLE "
        "\"Odd \"\"'name\" (\"a b\" TEXT UNIQUE COLLATE NOCASE, D REAL); INSERT INTO Pairs VALUES (1, 2, "
        "'X'), "
        "(1, 3, NULL); INSERT INTO \"Odd \"\"'name\" VALUES ('x', 1), (NULL, 2), (NULL, NULL)");
    // The index of one table is handed to its twin, whose rows are then changed behind its back.
    other.Execute("CREATE INDEX ByWord ON Words (Word)");
    EXPECT_NO_THROW(CopyByStep(Other(), Other() + ".sound"));
    other.Execute(
        "PRAGMA writable_schema = ON; UPDATE sqlite_schema SET tbl_name = 'Shadow', sql = 'CREATE INDEX "
        "ByWord ON Shadow (Word)' WHERE name = 'ByWord'");
    other.Execute(wrong);
    EXPECT_EQ(NumberThrownBy([this] { CopyByStep(Other(), Other() + ".copy"); }), 3343) << wrong;
    for (const char* ending : {"", ".sound"}) {
      std::filesystem::remove(Other() + ending);
    }
  }
}

TEST_F(WholeDatabaseFile, TellsWhetherItHasMoved) {
  const std::unique_ptr<Database> database = file.Open();
  EXPECT_FALSE(database->HasMoved());
  std::filesystem::rename(file.Path(), Other());
  EXPECT_TRUE(database->HasMoved());
  std::filesystem::copy_file(Other(), file.Path());
  EXPECT_TRUE(database->HasMoved());
}

TEST_F(WholeDatabaseFile, IsWrittenAnewWithoutWhatWasDeleted) {
  // Another program need not wipe what it deletes.
  file.Execute(
      "PRAGMA secure_delete = OFF; UPDATE Members SET Photograph = CAST('Forget me not' || "
      "hex(randomblob(300000)) AS BLOB); UPDATE Members SET Photograph = NULL");
  ASSERT_NE(ReadFile(file.Path()).find("Forget me not"), std::string::npos);
  const std::string before = ReadFile(file.Path());
  EXPECT_TRUE(file.Open()->RewriteTo(Other(), always));
  EXPECT_EQ(ReadFile(Other()).find("Forget me not"), std::string::npos);
  EXPECT_LT(std::filesystem::file_size(Other()), before.size() / 2);
  EXPECT_EQ(OtherConnection(Other()).Query("SELECT sum(ContactID) FROM Members"), "17");
  EXPECT_EQ(ReadFile(file.Path()), before);
}

TEST_F(WholeDatabaseFile, IsWrittenAnewAtAnyPath) {
  const std::string path = Other() + "'s copy";
  EXPECT_TRUE(file.Open()->RewriteTo(path, nullptr));
  EXPECT_EQ(OtherConnection(path).Query("SELECT count(*) FROM Members"), "4");
}

TEST_F(WholeDatabaseFile, IsWrittenAnewUntilItIsStopped) {
  file.Execute(
      "WITH RECURSIVE n(i) AS (SELECT 100 UNION ALL SELECT i + 1 FROM n WHERE i < 9000) "
      "INSERT INTO Members (ContactID, Photograph) SELECT i, randomblob(500) FROM n");
  EXPECT_FALSE(file.Open()->RewriteTo(Other(), [this] { return ++asked < 20; }));
  EXPECT_EQ(asked, 20);
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members WHERE ContactID < 100"), "4");
}

TEST_F(WholeDatabaseFile, IsNotWrittenAnewWhileItIsLocked) {
  OtherConnection other(file.Path());
  const std::unique_ptr<Database> database = file.Open();
  other.Execute("BEGIN EXCLUSIVE");
  EXPECT_EQ(NumberThrownBy([&] { database->RewriteTo(Other(), always); }), 3050);
}

TEST_F(WholeDatabaseFile, IsFoundSound) {
  EXPECT_TRUE(file.Open()->CheckWhole(always));
  EXPECT_TRUE(file.Open()->CheckWhole(nullptr));
}

TEST_F(WholeDatabaseFile, IsFoundDamagedInsideToo) {
  const auto size = std::filesystem::file_size(file.Path());
  for (const double place : {0.1, 0.5, 0.9}) {
    std::filesystem::copy_file(file.Path(), Other(), std::filesystem::copy_options::overwrite_existing);
    std::fstream damaged(Other(), std::ios::in | std::ios::out | std::ios::binary);
    damaged.seekp(static_cast<std::streamoff>(place * static_cast<double>(size)) / 4096 * 4096);
    damaged << std::string(4096, '\xEE');
    damaged.close();
    const auto check = [this] {
      SqliteEngine(std::chrono::milliseconds(0)).OpenDatabase(Other())->CheckWhole(always);
    };
    EXPECT_EQ(NumberThrownBy(check), 3343) << place;
  }
}

TEST_F(WholeDatabaseFile, IsReadInPiecesBeforeItIsLookedThrough) {
  file.Execute("UPDATE Members SET Photograph = randomblob(3000000)");
  EXPECT_TRUE(file.Open()->CheckWhole(always));
  EXPECT_GE(asked, 12) << "four rows of three megabytes";
  asked = 0;
  EXPECT_FALSE(file.Open()->CheckWhole([this] { return ++asked < 9; }));
  EXPECT_EQ(asked, 9);
}

TEST_F(WholeDatabaseFile, IsNotLookedThroughToItsEndWhenThatIsStopped) {
  file.Execute(
      "WITH RECURSIVE n(i) AS (SELECT 10 UNION ALL SELECT i + 1 FROM n WHERE i < 20000) "
      "INSERT INTO Members (ContactID, FirstName) SELECT i, 'Ann' FROM n");
  const std::unique_ptr<Database> database = file.Open();
  EXPECT_FALSE(database->CheckWhole([this] { return ++asked < 2; }));
  EXPECT_EQ(asked, 2);
  EXPECT_EQ(database->OpenRecordset("Members")->RecordCount(), 19995);  // it is no worse for that
}

TEST_F(WholeDatabaseFile, NamesTheColumnsOfATable) {
  EXPECT_THAT(file.Open()->ColumnNames("Members"),
              ElementsAre("ContactID", "DallasID", "FirstName", "LastName", "NickName", "Photograph",
                          "PhotographLength", "TotalGamesPlayed", "TotalDamage", "Clan"));
  EXPECT_EQ(NumberThrownBy([this] { file.Open()->ColumnNames("Table1"); }), 3078);
}

TEST_F(WholeDatabaseFile, TellsItsPathAndThatBehindALink) {
  std::filesystem::create_symlink(file.Path(), Other());
  const auto database = SqliteEngine().OpenDatabase(Other());
  EXPECT_EQ(database->Path(), Other());
  EXPECT_EQ(database->FilePath(), file.Path());
}

TEST_F(WholeDatabaseFile, IsWrittenByNobodyElseWhileItIsHeld) {
  const std::unique_ptr<Database> database = file.Open();
  OtherConnection other(file.Path());
  {
    const WritersHeld held(*database);
    EXPECT_EQ(other.Try("DELETE FROM Members"), SQLITE_BUSY);
    EXPECT_EQ(file.Open()->OpenRecordset("Members")->RecordCount(), 4);
    EXPECT_TRUE(file.Open()->CopyInSteps(Other(), always));
  }
  EXPECT_EQ(other.Try("DELETE FROM Members"), SQLITE_OK);
}

TEST_F(WholeDatabaseFile, HasNoJournalBesideItWhileItIsHeld) {
  OtherConnection other(file.Path());
  EXPECT_EQ(other.Query("PRAGMA journal_mode = PERSIST"), "persist");
  other.Execute("DELETE FROM Members WHERE ContactID = 9");
  ASSERT_TRUE(Exists(file.Path() + "-journal"));
  const std::unique_ptr<Database> database = file.Open();
  const WritersHeld held(*database);
  EXPECT_FALSE(Exists(file.Path() + "-journal"));
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members"), "3");
}

TEST_F(WholeDatabaseFile, HasNoLogBesideItWhileItIsHeld) {
  EXPECT_EQ(file.Query("PRAGMA journal_mode = WAL"), "wal");
  const std::unique_ptr<Database> database = file.Open();
  const WritersHeld held(*database);
  EXPECT_FALSE(Exists(file.Path() + "-wal"));
  EXPECT_FALSE(Exists(file.Path() + "-shm"));
}

TEST_F(WholeDatabaseFile, IsNotHeldWhileAnotherWrites) {
  const std::unique_ptr<Database> database = file.Open();
  OtherConnection other(file.Path());
  other.Execute("BEGIN IMMEDIATE");
  EXPECT_EQ(NumberThrownBy([&] { const WritersHeld held(*database); }), 3050);
  other.Execute("COMMIT");
  EXPECT_EQ(NumberThrownBy([&] { const WritersHeld held(*database); }), 0);
}

TEST_F(WholeDatabaseFile, IsNotHeldWhereItIsWriteProtected) {
  std::filesystem::permissions(file.Path(), std::filesystem::perms(0444));
  const OrdinaryUser user;
  const std::unique_ptr<Database> database = file.Open();
  EXPECT_EQ(NumberThrownBy([&] { const WritersHeld held(*database); }), 3027);
}

TEST_F(WholeDatabaseFile, MakesNoBackupCopyBecauseItIsHeld) {
  const std::unique_ptr<Database> database = file.Open();
  database->BeforeChange([this] { return ++asked > 0; });
  { const WritersHeld held(*database); }
  EXPECT_EQ(asked, 0);
}

}  // namespace
