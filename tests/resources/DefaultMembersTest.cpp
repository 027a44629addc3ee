#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/resources/DefaultDatabase.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;

const std::vector<std::string> Details = {
    "DallasID", "FirstName",  "LastName",  "NickName",    "Clan",       "Birthdate",     "Address",
    "City",     "PostalCode", "EmailName", "PhoneNumber", "DateJoined", "LastPlayedDate"};

const std::vector<std::string> History = {
    "TotalGamesPlayed",     "TotalDamage",         "TotalSoldiering",
    "AverageDamage",        "AverageSoldiering",   "TotalPrimaryAccuracy",
    "PriZeroAccuracyCount", "AveragePrimAccuracy", "AverageSecAccuracy"};

class DefaultMembers : public testing::Test {
 protected:
  DefaultDatabase database{"members_default.mdb"};
};

TEST_F(DefaultMembers, AreNone) {
  EXPECT_EQ(database.Single("SELECT count(*) FROM Members"), "0");
  EXPECT_EQ(database.Single("PRAGMA user_version"), "1");
}

TEST_F(DefaultMembers, HaveTheColumnsOfTheMemberTableWithThePhotographLast) {
  std::vector<std::string> columns = {"ContactID"};
  columns.insert(columns.end(), Details.begin(), Details.end());
  columns.insert(columns.end(), History.begin(), History.end());
  columns.insert(columns.end(), {"PhotographLength", "Photograph"});
  EXPECT_EQ(database.Column("SELECT name FROM pragma_table_info('Members')"), columns);
}

TEST_F(DefaultMembers, StartWithAHistoryOfZerosAndNoDetails) {
  ASSERT_TRUE(
      database.Run("INSERT INTO Members (DateJoined, FirstName, LastName) "
                   "VALUES ('2026-11-21 10:15:00', 'Enter Name', 'Enter Name')"));
  EXPECT_EQ(database.Single("SELECT ContactID FROM Members"), "1");
  for (const std::string& column : History) {
    EXPECT_EQ(database.Single("SELECT " + column + " = 0 FROM Members"), "1") << column;
  }
  EXPECT_EQ(database.Single("SELECT PhotographLength FROM Members"), "0");
  EXPECT_EQ(database.Single("SELECT Photograph FROM Members"), "NULL");
  EXPECT_EQ(database.Single("SELECT DallasID FROM Members"), "NULL");
  EXPECT_EQ(database.Single("SELECT LastPlayedDate FROM Members"), "NULL");
  EXPECT_EQ(database.Single("SELECT DateJoined FROM Members"), "2026-11-21 10:15:00");
}

TEST_F(DefaultMembers, MayLeaveEveryDetailNullButNoHistoryFigure) {
  ASSERT_TRUE(database.Run("INSERT INTO Members DEFAULT VALUES"));
  for (const std::string& column : Details) {
    EXPECT_TRUE(database.Run("UPDATE Members SET " + column + " = NULL")) << column;
  }
  EXPECT_TRUE(database.Run("UPDATE Members SET Photograph = NULL, PhotographLength = NULL"));
  for (const std::string& column : History) {
    EXPECT_FALSE(database.Run("UPDATE Members SET " + column + " = NULL")) << column;
  }
}

TEST_F(DefaultMembers, KeepLeadingZerosOfTexts) {
  ASSERT_TRUE(
      database.Run("INSERT INTO Members (DallasID, PostalCode, PhoneNumber) "
                   "VALUES ('0000000000000001', '01234', '0031')"));
  EXPECT_EQ(database.Single("SELECT DallasID || ' ' || PostalCode || ' ' || PhoneNumber FROM Members"),
            "0000000000000001 01234 0031");
}

TEST_F(DefaultMembers, AreFoundByButtonToTheLetterAndByNameWithoutCase) {
  ASSERT_TRUE(database.Run("INSERT INTO Members (DallasID, FirstName) VALUES ('AB0000000000000C', 'Ann')"));
  EXPECT_EQ(database.Single("SELECT count(*) FROM Members WHERE DallasID = 'AB0000000000000C'"), "1");
  EXPECT_EQ(database.Single("SELECT count(*) FROM Members WHERE DallasID = 'ab0000000000000c'"), "0");
  EXPECT_EQ(database.Single("SELECT count(*) FROM Members WHERE FirstName = 'aNN'"), "1");
}

TEST_F(DefaultMembers, HaveAnIndexForButtonsAndNames) {
  for (const char* column : {"DallasID", "FirstName", "LastName", "NickName"}) {
    const std::string condition = std::string(column) + " = 'x'";
    EXPECT_THAT(database.Plan("SELECT * FROM Members WHERE " + condition),
                HasSubstr(std::string("USING INDEX MembersBy") + column))
        << column;
  }
}

TEST_F(DefaultMembers, NeverGiveANumberTwice) {
  ASSERT_TRUE(database.Run("INSERT INTO Members DEFAULT VALUES"));
  ASSERT_TRUE(database.Run("DELETE FROM Members"));
  ASSERT_TRUE(database.Run("INSERT INTO Members DEFAULT VALUES"));
  EXPECT_THAT(database.Column("SELECT ContactID FROM Members"), ElementsAre("2"));
}

}  // namespace
