#include "platform/sqlite/LikeRange.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;

class LikeRange : public testing::Test {
 protected:
  std::string Ranged(const std::string& condition) const { return WithLikeRanges(members, condition); }

  TestDatabase file;
  SqliteConnection connection{file.Path(), std::chrono::milliseconds(30)};
  SqliteTable members{connection, "Members"};
};

TEST_F(LikeRange, IsAddedBesideAPatternThatBeginsWithText) {
  EXPECT_EQ(Ranged("[FirstName] LIKE 'mo*'"),
            "([FirstName] LIKE 'mo*' AND [FirstName] >= 'mo' COLLATE NOCASE AND [FirstName] < 'mp' "
            "COLLATE NOCASE)");
}

TEST_F(LikeRange, IsAddedToEachTerm) {
  const std::string ranged = Ranged("([FirstName] LIKE 'Z*' OR NOT [NickName] like 'a?b')");
  EXPECT_THAT(ranged, HasSubstr("[FirstName] >= 'z' COLLATE NOCASE AND [FirstName] < '{'"));
  EXPECT_THAT(ranged, HasSubstr("NOT ([NickName] like 'a?b' AND [NickName] >= 'a'"));
}

TEST_F(LikeRange, KeepsQuotesAndScriptsWithoutCase) {
  EXPECT_THAT(Ranged("[LastName] LIKE 'o''b*'"), HasSubstr(">= 'o''b' COLLATE NOCASE"));
  EXPECT_THAT(Ranged("[LastName] LIKE '王*'"), HasSubstr(">= '王' COLLATE NOCASE AND [LastName] < '玌'"));
  EXPECT_THAT(Ranged("[LastName] LIKE 'א*'"), HasSubstr(">= 'א'"));
}

TEST_F(LikeRange, EndsBeforeTheFirstLetterWithOtherForms) {
  EXPECT_THAT(Ranged("[LastName] LIKE 'jörg*'"), HasSubstr(">= 'j' COLLATE NOCASE AND [LastName] < 'k'"));
}

TEST_F(LikeRange, IsLeftOutWhereItWouldNotHold) {
  for (const char* condition : {"[FirstName] LIKE '*mo'",
                                "[FirstName] LIKE '[a-c]*'",
                                "[FirstName] LIKE 'mo[*'",
                                "[FirstName] LIKE 'Ö*'",
                                "[TotalGamesPlayed] LIKE '1*'",
                                "[ContactID] LIKE '1*'",
                                "[Photograph] LIKE 'a*'",
                                "[Nowhere] LIKE 'a*'",
                                "[FirstName] LIKE 'a*' || 'b'",
                                "'x' = [FirstName] LIKE 'a*'",
                                "m.[FirstName] LIKE 'a*'",
                                "[FirstName] LIKE 'a*' ESCAPE 'b'",
                                "[FirstName] LIKE 'a*",
                                "[FirstName] LIKE",
                                "[FirstName]",
                                "[FirstName",
                                "",
                                "FirstName = '[LastName] LIKE ''a*'''",
                                "[FirstName] LIKE 'a*' -- OR",
                                "1 /* [FirstName] LIKE 'a*' */"}) {
    EXPECT_EQ(Ranged(condition), condition);
  }
}

TEST_F(LikeRange, IsAddedToEachOfSeveralAlternatives) {
  EXPECT_THAT(LikeAlternatives(members, "([FirstName] LIKE 'mo*' or [LastName]  like 'o''b*' )"),
              ElementsAre("[FirstName] LIKE 'mo*' AND [FirstName] >= 'mo' COLLATE NOCASE AND [FirstName] < "
                          "'mp' COLLATE NOCASE",
                          "[LastName]  like 'o''b*' AND [LastName] >= 'o''b' COLLATE NOCASE AND [LastName] < "
                          "'o''c' COLLATE NOCASE"));
  EXPECT_THAT(LikeAlternatives(members, "[NickName] LIKE 'a*'"), SizeIs(1));
  const std::string unreadable = std::string("[NickName] LIKE 'a") + '\0' + "'";
  for (const std::string& condition :
       {std::string("[FirstName] LIKE 'mo*' AND [LastName] LIKE 'a*'"),
        std::string("[FirstName] LIKE 'mo*' OR NOT [LastName] LIKE 'a*'"),
        std::string("([FirstName] LIKE 'mo*') OR ([LastName] LIKE 'a*')"),
        std::string("[FirstName] LIKE 'mo*' OR [LastName] LIKE '*a'"),
        std::string("[FirstName] LIKE 'mo*' OR [LastName] LIKE 'o'b*'"),
        std::string("[FirstName] LIKE 'mo*' OR 1"), std::string("[FirstName] LIKE 'mo*' OR"),
        std::string("[FirstName] LIKE 'mo*' --"), std::string("FirstName = 'a'"), std::string("()"),
        std::string(), unreadable}) {
    EXPECT_THAT(LikeAlternatives(members, condition), IsEmpty()) << condition;
  }
}

class PrefixSearch : public testing::Test {
 protected:
  PrefixSearch() {
    file.Execute(
        "CREATE INDEX ByFirst ON Members (FirstName COLLATE NOCASE); INSERT INTO Members (ContactID, "
        "FirstName) "
        "VALUES (1, 'Morgan'), (2, 'mole'), (3, 'Belmont'), (4, 'MO'), (5, 'mp'), (6, NULL), (7, 'zebra'), "
        "(8, 'Zoë'), (9, '{'), (10, 'O''Brien'), (11, 'o''brian'), (12, '王小明'), (13, 'Ödön'), (14, "
        "'ödipus'), "
        "(15, '@home'), (16, 'אבי'), (17, 'Иван'), (18, 'Istanbul'), (19, 'ISLE'), (20, 'a' || char(127))");
    database = file.Open();
  }

  std::string Found(const std::string& pattern) const {
    return AllNumbers(
        *database->OpenRecordset("SELECT * FROM Members WHERE [FirstName] LIKE '" + pattern + "'"));
  }

  TestDatabase file;
  std::unique_ptr<Database> database;
};

TEST_F(PrefixSearch, FindsWhatTheMatchingRulesFind) {
  EXPECT_EQ(Found("mo*"), "1 2 4 ");
  EXPECT_EQ(Found("MO*"), "1 2 4 ");
  EXPECT_EQ(Found("z*"), "7 8 ");
  EXPECT_EQ(Found("o''b*"), "10 11 ");
  EXPECT_EQ(Found("o''bri?n"), "10 11 ");
  EXPECT_EQ(Found("王*"), "12 ");
  EXPECT_EQ(Found("ö*"), "13 14 ");
  EXPECT_EQ(Found("@*"), "15 ");
  EXPECT_EQ(Found("א*"), "16 ");
  EXPECT_EQ(Found("и*"), "17 ");
  EXPECT_EQ(Found("is*"), "18 19 ");
  EXPECT_EQ(Found("ZOË*"), "8 ");
  EXPECT_EQ(Found("mor#*"), "");
  EXPECT_EQ(Found("a\x7f*"), "20 ");
}

TEST_F(PrefixSearch, FindsARowOnceInTableOrderByWhicheverColumns) {
  file.Execute(
      "UPDATE Members SET LastName = 'Moore' WHERE ContactID IN (1, 2); "
      "UPDATE Members SET LastName = 'mouse' WHERE ContactID = 3");
  const auto rows =
      database->OpenRecordset("SELECT * FROM Members WHERE ([LastName] LIKE 'mo*' OR [FirstName] LIKE 'm*')");
  EXPECT_EQ(AllNumbers(*rows), "1 2 3 4 5 ");
}

TEST_F(PrefixSearch, ReportsAnInvalidPatternOrAnApostropheWithTheOriginalText) {
  EXPECT_EQ(NumberThrownBy([&] { Found("mo[*"); }), 93);
  const Thrown thrown = ThrownBy([&] {
    database->OpenRecordset(
        "SELECT * FROM Members WHERE ([FirstName] LIKE 'mo*' OR [FirstName] LIKE 'o'b*')");
  });
  EXPECT_EQ(thrown.Number, 3075);
  EXPECT_THAT(thrown.Text, HasSubstr("[FirstName] LIKE 'mo*' OR [FirstName] LIKE 'o'b*'"));
  EXPECT_THAT(thrown.Text, Not(HasSubstr("NOCASE")));
}

}  // namespace
