#include "platform/sqlite/SqliteSql.h"

#include <gmock/gmock.h>

#include <optional>

#include "tests/support/FileSizeLimit.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class Statements : public testing::Test {
 protected:
  Statements() {
    file.AddMembers();
    database = file.Open();
  }

  Sql& Run() { return database->Statements(); }

  std::vector<std::string> Texts(const std::string& query, const SqlValues& values = {}) {
    std::vector<std::string> texts;
    Run().Query(query, values, [&texts](const SqlRow& row) { texts.push_back(row.Text(0)); });
    return texts;
  }

  Thrown Failure(const std::string& query, const SqlValues& values = {}) {
    return ThrownBy([&] { Texts(query, values); });
  }

  std::string Names() const { return file.Query("SELECT group_concat(FirstName) FROM Members"); }

  TestDatabase file;
  std::unique_ptr<Database> database;
};

TEST_F(Statements, BindTheirValuesByNumberInWhateverOrder) {
  EXPECT_THAT(Texts("SELECT FirstName FROM Members WHERE DallasID = $2 AND ContactID > $1 ORDER BY ContactID",
                    {std::int64_t{1}, "BB"}),
              ElementsAre("Alice", "Zoe"));
  EXPECT_THAT(Texts("SELECT $2 || $1 || $2", {"a", "b"}), ElementsAre("bab"));
  EXPECT_THAT(Texts("SELECT $1 || $2 || $3 || $4 || $5 || $6 || $7 || $8 || $9 || $10",
                    {"a", "b", "c", "d", "e", "f", "g", "h", "i", "j"}),
              ElementsAre("abcdefghij"));
}

TEST_F(Statements, GiveEachKindOfValueBack) {
  const Blob bytes = {0, 255, 7};
  int rows = 0;
  Run().Query("SELECT $1, $2, $3, $4, $5, $6", {std::int64_t{1} << 40, 0.5, "O'Brien", bytes, {}, Blob()},
              [&](const SqlRow& row) {
                ++rows;
                EXPECT_EQ(row.Integer(0), std::int64_t{1} << 40);
                EXPECT_EQ(row.Real(0), 1099511627776.0);
                EXPECT_EQ(row.Real(1), 0.5);
                EXPECT_EQ(row.Text(2), "O'Brien");
                EXPECT_EQ(row.Bytes(3), bytes);
                EXPECT_TRUE(row.IsNull(4));
                EXPECT_EQ(row.Integer(4), 0);
                EXPECT_EQ(row.Text(4), "");
                EXPECT_FALSE(row.IsNull(5));
                EXPECT_THAT(row.Bytes(5), IsEmpty());
                EXPECT_EQ(NumberThrownBy([&] { row.Integer(2); }), 3421);
                EXPECT_EQ(NumberThrownBy([&] { row.Text(6); }), 9);
              });
  EXPECT_EQ(rows, 1);
}

TEST_F(Statements, MayRunWhileAnotherOfThemRuns) {
  const std::string query = "SELECT FirstName FROM Members WHERE ContactID > $1 ORDER BY ContactID LIMIT 2";
  std::vector<std::string> inner;
  Run().Query(query, {std::int64_t{0}}, [&](const SqlRow& row) {
    for (const std::string& text : Texts(query, {std::int64_t{2}})) {
      inner.push_back(row.Text(0) + text);
    }
  });
  EXPECT_THAT(inner, ElementsAre("SeanRhys", "SeanZoe", "AliceRhys", "AliceZoe"));
}

TEST_F(Statements, ChangeRowsAndTellHowMany) {
  EXPECT_EQ(Run().Change("UPDATE Members SET NickName = $1 WHERE DallasID = $2", {"N", "BB"}), 2);
  EXPECT_EQ(Run().Change("UPDATE Members SET NickName = $1 WHERE DallasID = $2", {"N", "none"}), 0);
  EXPECT_EQ(file.Query("SELECT group_concat(NickName) FROM Members WHERE DallasID = 'BB'"), "N,N");
}

TEST_F(Statements, InsertARowAndGiveItsNumber) {
  const std::string insertion = "INSERT INTO Members (FirstName) VALUES ($1) RETURNING ContactID";
  EXPECT_EQ(Run().Insert(insertion, {"New"}), 10);
  EXPECT_EQ(Run().Insert(insertion, {"Newer"}), 11);
  EXPECT_EQ(Names(), "Sean,Alice,Rhys,Zoe,New,Newer");
  EXPECT_EQ(NumberThrownBy([&] { Run().Insert("INSERT INTO Members (FirstName) VALUES ($1)", {"X"}); }),
            3075);
  EXPECT_EQ(Names(), "Sean,Alice,Rhys,Zoe,New,Newer");
}

TEST_F(Statements, AreRefusedWhereValuesAndParametersDoNotMatch) {
  EXPECT_EQ(Failure("SELECT $1 || $2", {"a"}).Number, 3075);
  EXPECT_EQ(Failure("SELECT $1", {"a", "b"}).Number, 3075);
  EXPECT_EQ(Failure("SELECT ?", {"a"}).Number, 3075);
  EXPECT_EQ(Failure("SELECT ?1", {"a"}).Number, 3075);
  EXPECT_EQ(Failure("SELECT :1", {"a"}).Number, 3075);
  EXPECT_EQ(Failure("SELECT $0", {"a"}).Number, 3075);
  EXPECT_EQ(Failure("SELECT $one", {"a"}).Number, 3075);
  EXPECT_THAT(Failure("SELECT $2", {"a"}).Text, HasSubstr("'SELECT $2'"));
}

TEST_F(Statements, AreOneAtATimeAndOfTheRightKind) {
  EXPECT_EQ(Failure("SELECT '1'; SELECT '2'").Number, 3075);
  EXPECT_EQ(Failure("").Number, 3075);
  EXPECT_EQ(Failure("DELETE FROM Members").Number, 3075);
  EXPECT_EQ(NumberThrownBy([&] { Run().Change("SELECT 1", {}); }), 3075);
  EXPECT_EQ(NumberThrownBy([&] { Run().Change("COMMIT", {}); }), 3075);
  EXPECT_EQ(Names(), "Sean,Alice,Rhys,Zoe");
}

TEST_F(Statements, TellSqlErrorsWithTheFile) {
  const Thrown failure = Failure("SELECT Nothing FROM Members");
  EXPECT_EQ(failure.Number, 3000);
  EXPECT_THAT(failure.Text, HasSubstr("Nothing"));
  EXPECT_THAT(failure.Text, HasSubstr(file.Path()));
}

TEST_F(Statements, AreCommittedWithTheirGroup) {
  WriteScope group(*database);
  Run().Change("UPDATE Members SET FirstName = 'A' WHERE ContactID = 1", {});
  const std::unique_ptr<Recordset> rows = database->OpenRecordset("Members");
  EXPECT_EQ(TextOf(*rows, "FirstName"), "A");
  Run().Change("DELETE FROM Members WHERE ContactID = 9", {});
  EXPECT_EQ(Names(), "Sean,Alice,Rhys,Zoe");
  group.Commit();
  EXPECT_EQ(Names(), "A,Alice,Rhys");
}

TEST_F(Statements, AreUndoneAsAWholeAfterAFaultInTheirGroup) {
  {
    WriteScope group(*database);
    Run().Change("UPDATE Members SET FirstName = 'A'", {});
    EXPECT_EQ(NumberThrownBy([&] { Run().Change("UPDATE Members SET Clan = 'refused'", {}); }), 3317);
    EXPECT_EQ(NumberThrownBy([&] { group.Commit(); }), 3034);
  }
  {
    const WriteScope group(*database);
    Run().Change("UPDATE Members SET FirstName = 'B'", {});
  }
  EXPECT_EQ(Names(), "Sean,Alice,Rhys,Zoe");
}

TEST_F(Statements, AreSeenByARecordsetInAGroupOfReads) {
  const std::unique_ptr<Recordset> rows = database->OpenRecordset("Members");
  const ReadScope reads(*database);
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
  Run().Change("UPDATE Members SET FirstName = 'A' WHERE ContactID = 1", {});
  rows->MoveFirst();
  EXPECT_EQ(TextOf(*rows, "FirstName"), "A");
  EXPECT_THAT(Texts("SELECT FirstName FROM Members WHERE ContactID = 1"), ElementsAre("A"));
}

TEST_F(Statements, FailByTheDatabasesNumbers) {
  EXPECT_EQ(NumberThrownBy([&] { Run().Change("INSERT INTO Members (ContactID) VALUES (1)", {}); }), 3022);
  OtherConnection other(file.Path());
  other.Execute("BEGIN EXCLUSIVE");
  EXPECT_EQ(Failure("SELECT FirstName FROM Members").Number, 3050);
  EXPECT_EQ(NumberThrownBy([&] { Run().Change("DELETE FROM Members", {}); }), 3050);
  other.Execute("COMMIT");
  EXPECT_EQ(Texts("SELECT FirstName FROM Members").size(), 4U);
}

TEST_F(Statements, ThatTheFullDiskCutsShortAreToldAndUndone) {
  {
    const FileSizeLimit full(4096);
    EXPECT_EQ(NumberThrownBy([&] {
                Run().Change("UPDATE Members SET Photograph = zeroblob($1)", {std::int64_t{20000}});
              }),
              3026);
  }
  EXPECT_EQ(file.Query("SELECT count(Photograph) FROM Members"), "0");
  EXPECT_EQ(Run().Change("UPDATE Members SET FirstName = 'A'", {}), 4);
}

TEST_F(Statements, OfAThousandKindsRunOneAfterAnother) {
  for (int number = 0; number < 1000; ++number) {
    const std::string text = std::to_string(number);
    ASSERT_THAT(Texts("SELECT '" + text + "'"), ElementsAre(text));
  }
}

TEST_F(Statements, CountAsChangesOfTheRun) {
  int calls = 0;
  database->BeforeChange([&calls] {
    ++calls;
    return true;
  });
  Texts("SELECT FirstName FROM Members");
  EXPECT_EQ(calls, 0);
  Run().Change("UPDATE Members SET FirstName = 'A'", {});
  Run().Change("UPDATE Members SET FirstName = 'B'", {});
  EXPECT_EQ(calls, 1);
}

class Counters : public Statements {};

TEST_F(Counters, RiseAndNeverFall) {
  database->RaiseCounter("Members", 40);
  database->RaiseCounter("Members", 12);
  EXPECT_EQ(Run().Insert("INSERT INTO Members (FirstName) VALUES ('N') RETURNING ContactID", {}), 41);
}

TEST_F(Counters, OfATableWithoutRowsRiseToo) {
  file.Execute("DELETE FROM Members; DELETE FROM sqlite_sequence");
  database->RaiseCounter("Members", 7);
  const std::unique_ptr<Recordset> rows = database->OpenRecordset("Members");
  rows->AddNew();
  rows->Update();
  rows->MoveLast();
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 8);
}

TEST_F(Counters, ThatAreHighEnoughAreNoChange) {
  database->BeforeChange([]() -> bool { throw std::runtime_error("a change"); });
  database->RaiseCounter("Members", 9);
  EXPECT_EQ(file.Query("SELECT seq FROM sqlite_sequence"), "9");
}

}  // namespace
