#include "members/MemberDetails.h"

#include <gtest/gtest.h>

#include "tests/members/MemberFile.h"

namespace {

class Details : public testing::Test {
 protected:
  void Change(const MemberDetails& shown, const MemberDetails& entered) {
    rows->Edit();
    SetChanges(*rows, shown, entered);
    rows->Update();
  }

  MemberFile file;
  std::unique_ptr<Database> database = file.Open();
  std::unique_ptr<Recordset> rows = database->OpenRecordset("Members");
};

TEST_F(Details, AreReadFromTheirColumns) {
  file.Execute(
      "UPDATE Members SET NickName = 'n', Address = 'a', City = 'c', PostalCode = 'p', EmailName = 'e', "
      "PhoneNumber = '+61 2' WHERE ContactID = 1");
  const MemberDetails expected{"Rhys", "Morgan", "n", "Red Dragons", "1961-04-12 00:00:00",
                               "a",    "c",      "p", "e",           "+61 2"};
  EXPECT_TRUE(ReadDetails(*rows) == expected);
}

TEST_F(Details, OfNullAreEmpty) {
  rows->MoveLast();
  const MemberDetails details = ReadDetails(*rows);
  EXPECT_EQ(details.LastName, "王");
  EXPECT_EQ(details.Clan, "");
  EXPECT_EQ(details.Birthdate, "");
}

TEST_F(Details, AreWrittenWhereTheyDiffer) {
  const MemberDetails shown = ReadDetails(*rows);
  const MemberDetails entered{"1", "2", "3", "4", "1950-01-02 00:00:00", "6", "7", "8", "9", "10"};
  Change(shown, entered);
  EXPECT_TRUE(ReadDetails(*rows) == entered);
}

TEST_F(Details, StayAsTheyAreWhereTheyDoNotDiffer) {
  const std::string longText(400, 'x');
  file.Execute("UPDATE Members SET Address = '" + longText + "', NickName = NULL");
  rows->MoveFirst();
  MemberDetails shown = ReadDetails(*rows);
  shown.Address.resize(255);  // the most that the entry holds
  MemberDetails entered = shown;
  entered.City = "Cardiff";
  Change(shown, entered);
  EXPECT_EQ(file.Stored("Address", 1), longText);
  EXPECT_EQ(file.Stored("NickName", 1), "NULL");
  EXPECT_EQ(file.Stored("City", 1), "Cardiff");
}

TEST_F(Details, AnEmptiedBirthdateIsNullAndAnEmptiedTextIsEmpty) {
  const MemberDetails shown = ReadDetails(*rows);
  MemberDetails entered = shown;
  entered.Birthdate.clear();
  entered.Clan.clear();
  Change(shown, entered);
  EXPECT_EQ(file.Stored("Birthdate", 1), "NULL");
  EXPECT_EQ(file.Stored("Clan", 1), "");
}

}  // namespace
