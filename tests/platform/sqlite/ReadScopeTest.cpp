#include <gtest/gtest.h>

#include <sqlite3.h>

#include <cstdint>
#include <stdexcept>
#include <string>

#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

class Reading : public testing::Test {
 protected:
  Reading() {
    file.AddMembers();
    database = file.Open();
    rows = database->OpenRecordset("Members");
  }

  bool OthersCanWrite() const {
    OtherConnection other(file.Path());
    return other.Try("UPDATE Members SET Clan = Clan || 'x' WHERE ContactID = 9") == SQLITE_OK;
  }

  TestDatabase file;
  std::unique_ptr<Database> database;
  std::unique_ptr<Recordset> rows;
};

TEST_F(Reading, HoldsTheLockFromItsFirstReadToItsEnd) {
  {
    const ReadScope scope(*database);
    EXPECT_TRUE(OthersCanWrite());
    EXPECT_TRUE(rows->WalkTo("ContactID", std::int64_t{5}));
    EXPECT_FALSE(OthersCanWrite());
  }
  EXPECT_TRUE(OthersCanWrite());
}

TEST_F(Reading, WithoutAScopeHoldsNoLock) {
  EXPECT_TRUE(rows->WalkTo("DallasID", "BB"));
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 2);
  rows->FindFirst("ContactID > 1");
  EXPECT_TRUE(OthersCanWrite());
}

TEST_F(Reading, NestedScopesEndWithTheOutermost) {
  {
    const ReadScope outer(*database);
    {
      const ReadScope inner(*database);
      rows->WalkTo("ContactID", std::int64_t{5});
    }
    EXPECT_FALSE(OthersCanWrite());
  }
  EXPECT_TRUE(OthersCanWrite());
}

TEST_F(Reading, EndsAlsoByAnException) {
  try {
    const ReadScope scope(*database);
    rows->WalkTo("ContactID", std::int64_t{5});
    throw std::runtime_error("a failure of the caller");
  } catch (const std::runtime_error&) {
  }
  EXPECT_TRUE(OthersCanWrite());
}

TEST_F(Reading, SearchThatFindsNothingReleasesTheLock) {
  const ReadScope scope(*database);
  const auto hold = [&] {
    rows->WalkTo("ContactID", std::int64_t{5});
    rows->Fields("FirstName");
    return !OthersCanWrite();
  };
  EXPECT_TRUE(hold());
  EXPECT_FALSE(rows->WalkTo("ContactID", std::int64_t{77}));
  EXPECT_TRUE(OthersCanWrite());
  EXPECT_TRUE(hold());
  EXPECT_FALSE(rows->WalkTo("DallasID", "XX"));
  EXPECT_TRUE(OthersCanWrite());
  EXPECT_TRUE(hold());
  rows->FindFirst("ContactID= 77");
  EXPECT_TRUE(OthersCanWrite());
  EXPECT_TRUE(hold());
}

TEST_F(Reading, FailureReleasesTheLock) {
  file.Execute("DELETE FROM Members WHERE ContactID = 2");
  const ReadScope scope(*database);
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
  rows->MoveNext();
  EXPECT_EQ(NumberThrownBy([&] { rows->Fields("FirstName"); }), 3167);
  EXPECT_TRUE(OthersCanWrite());
  EXPECT_TRUE(rows->WalkTo("ContactID", std::int64_t{5}));
  EXPECT_EQ(NumberThrownBy([&] { rows->FindFirst("?"); }), 3077);
  EXPECT_TRUE(OthersCanWrite());
}

TEST_F(Reading, SeesWhatOthersChangedBeforeItTookTheLockAgain) {
  const ReadScope scope(*database);
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
  EXPECT_FALSE(rows->WalkTo("DallasID", "XX"));
  file.Execute("UPDATE Members SET FirstName = 'Changed' WHERE ContactID = 1");
  rows->MoveFirst();
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Changed");
}

TEST_F(Reading, WriteInsideIsDurableAtOnceAndTheReadsGoOn) {
  const ReadScope scope(*database);
  EXPECT_TRUE(rows->WalkTo("ContactID", std::int64_t{5}));
  rows->Edit();
  rows->SetField("FirstName", "John");
  rows->Update();
  EXPECT_EQ(file.Query("SELECT FirstName FROM Members WHERE ContactID = 5"), "John");
  EXPECT_TRUE(OthersCanWrite());
  EXPECT_EQ(TextOf(*rows, "FirstName"), "John");
  EXPECT_FALSE(OthersCanWrite());
  rows->AddNew();
  rows->Update();
  rows->MoveLast();
  rows->Delete();
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members"), "4");
}

TEST_F(Reading, TheNextScopeSeesWhatOthersChangedInRowsReadBefore) {
  const auto nameOfFive = [&] {
    const ReadScope scope(*database);
    rows->WalkTo("ContactID", std::int64_t{5});
    return TextOf(*rows, "FirstName");
  };
  const std::string before = nameOfFive();
  EXPECT_EQ(nameOfFive(), before);
  file.Execute("UPDATE Members SET FirstName = 'Changed' WHERE ContactID = 5");
  EXPECT_EQ(nameOfFive(), "Changed");
}

TEST_F(Reading, TheNextScopeSeesWhatOthersChangedInTextsSearchedBefore) {
  const auto search = [&](const char* dallasId) {
    const ReadScope scope(*database);
    return rows->WalkTo("DallasID", dallasId) ? IntegerOf(*rows, "ContactID") : 0;
  };
  EXPECT_EQ(search("BB"), 2);
  EXPECT_EQ(search("BB"), 2);
  EXPECT_EQ(search("NEW"), 0);
  file.Execute("UPDATE Members SET DallasID = 'NEW' WHERE ContactID = 2");
  EXPECT_EQ(search("BB"), 9);
  EXPECT_EQ(search("NEW"), 2);
  file.Execute("DELETE FROM Members WHERE ContactID = 2");
  EXPECT_EQ(search("NEW"), 0);
}

TEST_F(Reading, SeesWhatAnotherRecordsetOfTheDatabaseChanged) {
  const auto others = database->OpenRecordset("Members");
  const ReadScope scope(*database);
  EXPECT_TRUE(rows->WalkTo("DallasID", "BB"));
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 2);
  others->WalkTo("ContactID", std::int64_t{2});
  others->Edit();
  others->SetField("FirstName", "Changed");
  others->SetField("DallasID", "CC");
  others->Update();
  EXPECT_FALSE(rows->WalkTo("DallasID", "BB") && IntegerOf(*rows, "ContactID") == 2);
  EXPECT_TRUE(rows->WalkTo("ContactID", std::int64_t{2}));
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Changed");
}

TEST_F(Reading, ReadsAFurtherColumnOfARowReadBefore) {
  const ReadScope scope(*database);
  rows->WalkTo("ContactID", std::int64_t{2});
  EXPECT_EQ(TextOf(*rows, "DallasID"), "BB");
  rows->WalkTo("ContactID", std::int64_t{9});
  rows->WalkTo("ContactID", std::int64_t{2});
  EXPECT_EQ(TextOf(*rows, "FirstName"), file.Query("SELECT FirstName FROM Members WHERE ContactID = 2"));
}

TEST_F(Reading, GoesThroughMoreRowsThanAGameHasPlayers) {
  file.Execute(
      "WITH RECURSIVE n(i) AS (SELECT 100 UNION ALL SELECT i + 1 FROM n WHERE i < 3100) "
      "INSERT INTO Members (ContactID, DallasID, FirstName) SELECT i, 'D' || i, 'F' || i FROM n");
  rows = database->OpenRecordset("Members");
  const ReadScope scope(*database);
  for (int round = 0; round < 2; ++round) {
    for (int key = 100; key <= 3100; ++key) {
      ASSERT_TRUE(rows->WalkTo("DallasID", "D" + std::to_string(key)));
      ASSERT_EQ(TextOf(*rows, "FirstName"), "F" + std::to_string(key));
    }
  }
}

TEST_F(Reading, RecordsetMayBeOpenedInside) {
  const ReadScope scope(*database);
  EXPECT_EQ(AllNumbers(*database->OpenRecordset("SELECT * FROM Members WHERE DallasID = 'BB'")), "2 9 ");
}

}  // namespace
