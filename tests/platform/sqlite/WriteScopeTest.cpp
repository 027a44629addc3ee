#include <gtest/gtest.h>

#include <optional>

#include "tests/support/FileSizeLimit.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

class WriteGroup : public testing::Test {
 protected:
  WriteGroup() {
    file.AddMembers();
    database = file.Open();
    rows = database->OpenRecordset("Members");
  }

  void Rename(std::int64_t member, const std::string& name) {
    ASSERT_TRUE(rows->WalkTo("ContactID", member));
    rows->Edit();
    rows->SetField("FirstName", name);
    rows->Update();
  }

  std::string Names() const { return file.Query("SELECT group_concat(FirstName) FROM Members"); }

  TestDatabase file;
  std::unique_ptr<Database> database;
  std::unique_ptr<Recordset> rows;
};

TEST_F(WriteGroup, ReachesTheFileAtItsCommit) {
  WriteScope group(*database);
  Rename(1, "A");
  Rename(5, "B");
  EXPECT_EQ(Names(), "Sean,Alice,Rhys,Zoe");
  group.Commit();
  EXPECT_EQ(Names(), "A,Alice,B,Zoe");
}

TEST_F(WriteGroup, SeesItsOwnRows) {
  const WriteScope group(*database);
  Rename(1, "A");
  ASSERT_TRUE(rows->WalkTo("ContactID", std::int64_t{1}));
  EXPECT_EQ(TextOf(*rows, "FirstName"), "A");
}

TEST_F(WriteGroup, IsUndoneWithoutCommit) {
  {
    const WriteScope group(*database);
    Rename(1, "A");
    rows->AddNew();
    rows->SetField("FirstName", "New");
    rows->Update();
  }
  EXPECT_EQ(Names(), "Sean,Alice,Rhys,Zoe");
  rows->MoveFirst();
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
}

TEST_F(WriteGroup, ForgetsUndoneRowsInAGroupOfReads) {
  const ReadScope reads(*database);
  {
    const WriteScope group(*database);
    Rename(1, "A");
    EXPECT_EQ(TextOf(*rows, "FirstName"), "A");
  }
  rows->WalkTo("ContactID", std::int64_t{1});
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
}

TEST_F(WriteGroup, SurvivesASearchWithoutResult) {
  WriteScope group(*database);
  Rename(1, "A");
  EXPECT_FALSE(rows->WalkTo("ContactID", std::int64_t{77}));
  rows->FindFirst("FirstName = 'nobody'");
  EXPECT_TRUE(rows->NoMatch());
  Rename(9, "D");
  group.Commit();
  EXPECT_EQ(Names(), "A,Alice,Rhys,D");
}

TEST_F(WriteGroup, SurvivesTheEndOfAGroupOfReads) {
  WriteScope group(*database);
  {
    const ReadScope reads(*database);
    Rename(1, "A");
  }
  Rename(9, "D");
  group.Commit();
  EXPECT_EQ(Names(), "A,Alice,Rhys,D");
}

TEST_F(WriteGroup, IsLostAsAWholeAfterAFaultInIt) {
  WriteScope group(*database);
  Rename(1, "A");
  rows->Edit();
  rows->SetField("Clan", "refused");
  EXPECT_EQ(NumberThrownBy([&] { rows->Update(); }), 3317);
  rows->CancelUpdate();
  EXPECT_EQ(NumberThrownBy([&] { Rename(5, "B"); }), 3034);
  EXPECT_NE(NumberThrownBy([&] { group.Commit(); }), 0);
  EXPECT_EQ(Names(), "Sean,Alice,Rhys,Zoe");
}

TEST_F(WriteGroup, IsOverAfterAFaultAndLetsSingleWritesThrough) {
  {
    const WriteScope group(*database);
    rows->Edit();
    rows->SetField("Clan", "refused");
    EXPECT_EQ(NumberThrownBy([&] { rows->Update(); }), 3317);
  }
  Rename(5, "B");
  EXPECT_EQ(Names(), "Sean,Alice,B,Zoe");
}

TEST_F(WriteGroup, CannotBeginInALockedFile) {
  OtherConnection other(file.Path());
  other.Execute("BEGIN IMMEDIATE");
  EXPECT_EQ(NumberThrownBy([&] { const WriteScope group(*database); }), 3050);
  other.Execute("COMMIT");
  Rename(1, "A");
  EXPECT_EQ(Names(), "A,Alice,Rhys,Zoe");
}

TEST_F(WriteGroup, LeavesTheOldRowsWhenTheLastFlushFails) {
  std::optional<WriteScope> group;
  group.emplace(*database);
  Rename(1, "A");
  rows->AddNew();
  rows->AppendChunk("Photograph", Blob(20000, 7));
  rows->Update();
  {
    const FileSizeLimit full(4096);
    EXPECT_EQ(NumberThrownBy([&] { group->Commit(); }), 3026);
    group.reset();
  }
  EXPECT_EQ(Names(), "Sean,Alice,Rhys,Zoe");
  Rename(1, "A");
  EXPECT_EQ(Names(), "A,Alice,Rhys,Zoe");
}

TEST_F(WriteGroup, ThatWasFlushedIsUndoneAndCommittedAsAnyOther) {
  for (const bool commits : {false, true}) {
    WriteScope group(*database);
    Rename(1, "A");
    database->FlushGroup();
    EXPECT_EQ(OtherConnection(file.Path()).Try("SELECT * FROM Members"), SQLITE_BUSY);
    Rename(5, "B");
    database->FlushGroup();
    if (commits) {
      group.Commit();
    } else {
      database->Rollback();
      EXPECT_EQ(Names(), "Sean,Alice,Rhys,Zoe");
    }
  }
  EXPECT_EQ(Names(), "A,Alice,B,Zoe");
  EXPECT_EQ(file.Query("PRAGMA integrity_check"), "ok");
  database->FlushGroup();  // nothing without a group
}

TEST_F(WriteGroup, CommitsThoughItCannotBeFlushedWhileOthersRead) {
  OtherConnection other(file.Path());
  other.Execute("BEGIN; SELECT count(*) FROM Members");
  WriteScope group(*database);
  Rename(1, "A");
  database->FlushGroup();
  other.Execute("COMMIT");
  group.Commit();
  EXPECT_EQ(Names(), "A,Alice,Rhys,Zoe");
}

TEST_F(WriteGroup, NeedsABeginning) {
  EXPECT_EQ(NumberThrownBy([&] { database->CommitTrans(); }), 3034);
}

}  // namespace
