#include <gtest/gtest.h>

#include <cerrno>
#include <chrono>
#include <cmath>
#include <limits>
#include <memory>
#include <string>

#include "core/game/MissionList.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/ScoredGame.h"
#include "tests/support/SystemFaults.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using Lasting = SystemFaults::Lasting;

/// A members file with an edit of its first row pending.
class PendingEdit : public testing::Test {
 protected:
  PendingEdit() {
    file.AddMembers();
    database = file.Open();
    rows = database->OpenRecordset("Members");
    Pend();
  }

  void Pend() {
    rows->Edit();
    rows->SetField("FirstName", std::string("John"));
  }

  Thrown UpdateWith(FileCall call, int error, int first = 1) {
    const SystemFaults faults(file.Folder().Path(), {"", Only(call), error}, first, Lasting::Once);
    const Thrown told = ThrownBy([this] { rows->Update(); });
    EXPECT_TRUE(faults.Failed());
    return told;
  }

  std::string FirstName() const { return file.Query("SELECT FirstName FROM Members WHERE ContactID = 1"); }

  TestDatabase file;
  std::unique_ptr<Database> database;
  std::unique_ptr<Recordset> rows;
};

TEST_F(PendingEdit, OfAFullDiskOrQuotaIs3026WhereverItShows) {
  for (const int error : {ENOSPC, EDQUOT, EFBIG}) {
    for (const FileCall call : {FileCall::Write, FileCall::Flush}) {
      for (int first = 1; first <= 3; ++first) {  // in the journal twice, then in the file
        const Thrown told = UpdateWith(call, error, first);
        EXPECT_EQ(told.Number, 3026) << error << " " << first;
        EXPECT_EQ(told.Text, "Not enough space on disk: " + file.Path());
        EXPECT_EQ(FirstName(), "Sean");
      }
    }
  }
}

TEST_F(PendingEdit, OfABrokenDiskIs3043AlsoAfterOneThatWasFull) {
  const int inTheFile = 3;
  EXPECT_EQ(UpdateWith(FileCall::Flush, ENOSPC, inTheFile).Number, 3026);
  for (const FileCall call : {FileCall::Write, FileCall::Flush}) {
    const Thrown told = UpdateWith(call, EIO);
    EXPECT_EQ(told.Number, 3043);
    EXPECT_EQ(told.Text, "Disk error: " + file.Path());
  }
  EXPECT_EQ(FirstName(), "Sean");
}

TEST_F(PendingEdit, IsNotWrittenWhenTheJournalCannotBeDeleted) {
  EXPECT_EQ(UpdateWith(FileCall::Delete, EIO).Number, 3043);
  EXPECT_EQ(FirstName(), "Sean");
  EXPECT_EQ(rows->EditMode(), EditMode::InProgress);
  rows->Update();
  EXPECT_EQ(FirstName(), "John");
}

TEST_F(PendingEdit, IsDoneWhenTheJournalWasDeletedAllTheSame) {
  const FileFault deletedButFailed{"", Only(FileCall::Delete), EIO, FileFault::Effect::Whole};
  const SystemFaults faults(file.Folder().Path(), deletedButFailed, 1, Lasting::FromThenOn);
  rows->Update();
  EXPECT_TRUE(faults.Failed());
  EXPECT_EQ(FirstName(), "John");
  EXPECT_EQ(rows->EditMode(), EditMode::None);
}

// Whether a commit that was told as failed is in the file is found out by its values.
TEST_F(PendingEdit, IsFoundInTheFileWhateverItsValues) {
  file.Execute(
      "CREATE TABLE Kinds (ID INTEGER PRIMARY KEY, T TEXT COLLATE NOCASE, N NUMERIC, R REAL, I INTEGER, "
      "B BLOB, P BLOB); INSERT INTO Kinds (ID, T, B, P) VALUES (1, 'same', x'01', x'02')");
  const auto kinds = database->OpenRecordset("Kinds");
  const SystemFaults faults(file.Folder().Path(), {"", Only(FileCall::FlushFolder), EIO}, 1,
                            Lasting::FromThenOn);
  kinds->Edit();
  kinds->SetField("T", std::string("SAME"));
  kinds->SetField("N", std::string("12"));
  kinds->SetField("R", std::int64_t{7});
  kinds->SetField("I", std::numeric_limits<double>::quiet_NaN());
  kinds->SetField("B", Value());
  kinds->AppendChunk("P", Blob(9000, 0));
  kinds->Update();
  kinds->Edit();
  kinds->SetField("T", std::int64_t{5});
  kinds->SetField("N", std::string("1e300"));
  kinds->SetField("R", 0.1);
  kinds->SetField("I", 3.0);
  kinds->AppendChunk("P", Blob());
  kinds->Update();
  kinds->AddNew();
  kinds->Update();
  kinds->MoveFirst();
  kinds->Delete();
  EXPECT_TRUE(faults.Failed());
  EXPECT_EQ(file.Query("SELECT group_concat(ID) FROM Kinds"), "2");
}

TEST_F(PendingEdit, IsNotMistakenForARowThatDiffersInCaseAlone) {
  file.Execute(
      "CREATE TABLE Names (ID INTEGER PRIMARY KEY, Name TEXT COLLATE NOCASE); "
      "INSERT INTO Names VALUES (1, 'same')");
  const auto names = database->OpenRecordset("Names");
  names->Edit();
  names->SetField("Name", std::string("SAME"));
  const SystemFaults faults(file.Folder().Path(), {"", Only(FileCall::Delete), EIO}, 1, Lasting::Once);
  EXPECT_EQ(NumberThrownBy([&] { names->Update(); }), 3043);
  EXPECT_EQ(file.Query("SELECT Name FROM Names"), "same");
}

TEST_F(PendingEdit, StandsOnceHoweverOftenItIsSavedWhereFoldersCannotBeFlushed) {
  const SystemFaults faults(file.Folder().Path(), {"", Only(FileCall::FlushFolder), EINVAL}, 1,
                            Lasting::FromThenOn);
  rows->AddNew();
  rows->SetField("FirstName", std::string("New"));
  rows->Update();
  EXPECT_EQ(rows->EditMode(), EditMode::None);
  EXPECT_EQ(NumberThrownBy([this] { rows->Update(); }), 3020);  // nothing is left to save again
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members WHERE FirstName = 'New'"), "1");
  // From now on such a file system is asked only when the journal is made, where nobody waits for its answer.
  const int before = faults.Calls();
  Pend();
  rows->Update();
  EXPECT_EQ(faults.Calls(), before + 1);
}

TEST_F(PendingEdit, FlushesTheFolderAgainWhereThatFailedOnce) {
  const SystemFaults faults(file.Folder().Path(), {"", Only(FileCall::FlushFolder), EIO}, 2, Lasting::Once);
  rows->Update();
  EXPECT_EQ(faults.Calls(), 3);
  EXPECT_EQ(FirstName(), "John");
}

TEST_F(PendingEdit, IsLostWithItsGroupEvenIfTheRestOfItChangedNothing) {
  WriteScope group(*database);
  rows->CancelUpdate();
  rows->Edit();
  rows->SetField("FirstName", std::string("Sean"));  // what the file holds anyway
  rows->Update();
  rows->Edit();
  rows->SetField("Clan", std::string("refused"));
  EXPECT_EQ(NumberThrownBy([this] { rows->Update(); }), 3317);
  EXPECT_EQ(NumberThrownBy([&] { group.Commit(); }), 3034);
}

class Opening : public testing::Test {
 protected:
  Opening() { file.AddMembers(); }

  Thrown OpenWith(FileCall call, int error) {
    const SystemFaults faults(file.Folder().Path(), {"", Only(call), error}, 1, Lasting::Once);
    const Thrown told = ThrownBy([this] { file.Open(); });
    EXPECT_TRUE(faults.Failed());
    return told;
  }

  TestDatabase file;
};

TEST_F(Opening, AFileThatIsNotToBeHadIs3051) {
  for (const FileCall call : {FileCall::Status, FileCall::Open}) {
    const Thrown told = OpenWith(call, EACCES);
    EXPECT_EQ(told.Number, 3051);
    EXPECT_EQ(told.Text, "Cannot open the file '" + file.Path() + "'. You may lack the permission for it.");
  }
}

TEST_F(Opening, AFolderIs3051AndSaysSo) {
  const Thrown told =
      ThrownBy([this] { SqliteEngine(std::chrono::milliseconds(0)).OpenDatabase(file.Folder().Path()); });
  EXPECT_EQ(told.Number, 3051);
  EXPECT_EQ(told.Text, "Cannot open the file '" + file.Folder().Path() + "'. It is no file.");
}

TEST_F(Opening, AFileOnABrokenDiskIs3043AndNotCalledDamaged) {
  const Thrown told = OpenWith(FileCall::Read, EIO);
  EXPECT_EQ(told.Number, 3043);
  EXPECT_EQ(told.Text, "Disk error: " + file.Path());
}

// The database library would go on with a file that can only be read, for the whole run.
TEST_F(Opening, DoesNotMakeAFileReadOnlyBecauseItFailedOnce) {
  EXPECT_EQ(OpenWith(FileCall::Open, EIO).Number, 3051);
  const auto database = file.Open();
  database->OpenRecordset("Members")->Delete();
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members"), "3");
}

TEST(MissionListOnABrokenDisk, TellsOfItAtWhateverRow) {
  ScoredGame venue;
  ExecuteSql(venue.ScenariosFile(),
             "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 300) "
             "INSERT INTO Table1 (MissionName, MissionDescription) SELECT i, printf('%0900d', i) FROM n");
  for (int first = 1; first < 200; first += 6) {
    const auto database = SqliteEngine(std::chrono::milliseconds(0)).OpenDatabase(venue.ScenariosFile());
    const auto rows = database->OpenRecordset("Table1");
    MissionList missions(*rows, venue.Strings, venue.Boxes);
    {
      const SystemFaults faults(venue.Folder.Path(), {"", Only(FileCall::Read), EIO}, first, Lasting::Once);
      EXPECT_EQ(NumberThrownBy([&] { missions.FillMissionList(); }), 3043) << first;
    }
    missions.FillMissionList();
    EXPECT_EQ(missions.Items().size(), 302U);
  }
}

TEST(FileOnABrokenDisk, IsNotSaidToBeMissing) {
  const TemporaryFolder folder;
  WriteFile(folder / "mine", "x");
  for (const auto& [error, number] : {std::pair{EIO, 75}, {EACCES, 70}}) {
    const SystemFaults faults(folder.Path(), {"", Only(FileCall::Status), error}, 1, Lasting::Once);
    const Thrown told = ThrownBy([&] { LinuxFiles().FileExists(folder / "mine"); });
    EXPECT_EQ(told.Number, number);
    EXPECT_TRUE(told.Text.ends_with(": " + folder / "mine")) << told.Text;
    EXPECT_TRUE(LinuxFiles().FileExists(folder / "mine"));
  }
}

}  // namespace
