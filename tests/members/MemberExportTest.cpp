#include "members/MemberExport.h"

#include <gmock/gmock.h>

#include "members/MemberImport.h"
#include "platform/Utf8.h"
#include "tests/members/MemberFile.h"

namespace {

bool GoOnAlways(double /*done*/) {
  return true;
}

/// All columns but the photo of all rows, each with its type.
std::string ContentsOf(const MemberFile& file) {
  std::string columns;
  for (const MemberColumn& column : MemberColumns) {
    columns.append(columns.empty() ? "" : " || ',' || ").append("quote(").append(column.Name).append(")");
  }
  return file.Query("SELECT group_concat(r, char(10)) FROM (SELECT " + columns +
                    " AS r FROM Members ORDER BY ContactID)");
}

class ExportOfMembers : public testing::Test {
 protected:
  std::string Csv() {
    const auto database = file.Open();
    return MembersAsCsv(*database->OpenRecordset("Members"), form, GoOnAlways)->Csv;
  }

  /// Imports `csv` into the empty table of another file.
  static void ImportInto(const MemberFile& other, const std::string& csv) {
    other.Execute("DELETE FROM Members; DELETE FROM sqlite_sequence");
    const auto database = other.Open();
    MemberImport import(csv, *database, "2026-11-23 10:00:00");
    ImportChoices choices;
    choices.Use.Columns = MemberImport::Match(import.Columns());
    choices.Use.History = true;
    const std::optional<ImportPlan> plan = import.Plan(choices, GoOnAlways);
    ASSERT_EQ(plan->Count(RowFate::Refused), 0U);
    ASSERT_FALSE(plan->Fault);
    ASSERT_TRUE(import.Write(choices, *plan, GoOnAlways));
  }

  MemberFile file;
  MemberExportForm form{.ByteOrderMark = false};
};

TEST_F(ExportOfMembers, HoldsAllColumnsButThePhotoAndTheHistory) {
  file.Execute(
      "DELETE FROM Members WHERE ContactID <> 1; UPDATE Members SET DateJoined = '2010-03-01 09:05:00', "
      "TotalGamesPlayed = 7, PhoneNumber = '+44 29', Address = '', PhotographLength = 3, Photograph = "
      "x'010203'");
  EXPECT_EQ(Csv(),
            "ContactID,DallasID,FirstName,LastName,NickName,Clan,Birthdate,Address,City,PostalCode,EmailName,"
            "PhoneNumber,DateJoined\r\n"
            "1,,Rhys,Morgan,,Red Dragons,1961-04-12,\"\",,,,'+44 29,2010-03-01 09:05:00\r\n");
}

TEST_F(ExportOfMembers, HoldsTheHistoryWhereAsked) {
  form.History = true;
  form.Separator = CsvSeparator::Semicolon;
  form.ByteOrderMark = true;
  file.Execute(
      "DELETE FROM Members WHERE ContactID <> 1; UPDATE Members SET TotalGamesPlayed = 7, TotalDamage = "
      "12.5, "
      "TotalSoldiering = -3, LastPlayedDate = '2026-11-20 20:15:00'");
  EXPECT_EQ(
      Csv(),
      "\xEF\xBB\xBF"
      "ContactID;DallasID;FirstName;LastName;NickName;Clan;Birthdate;Address;City;PostalCode;EmailName;"
      "PhoneNumber;DateJoined;LastPlayedDate;TotalGamesPlayed;TotalDamage;TotalSoldiering;AverageDamage;"
      "AverageSoldiering;TotalPrimaryAccuracy;PriZeroAccuracyCount;AveragePrimAccuracy;AverageSecAccuracy"
      "\r\n1;;Rhys;Morgan;;Red Dragons;1961-04-12;;;;;;;2026-11-20 20:15:00;7;12.5;-3;0;0;0;0;0;0\r\n");
}

TEST_F(ExportOfMembers, ImportedIntoAnEmptyTableGivesEqualRows) {
  form.History = true;
  file.Execute(
      "INSERT INTO Members DEFAULT VALUES;"
      "INSERT INTO Members (FirstName, LastName) VALUES ('Enter Name', 'Enter Name'), ('Enter Name', 'Enter "
      "Name');"
      "INSERT INTO Members (DallasID, FirstName, LastName, NickName, Clan, Birthdate, Address, City, "
      "PostalCode, "
      "EmailName, PhoneNumber, DateJoined, LastPlayedDate, TotalGamesPlayed, TotalDamage, TotalSoldiering, "
      "AverageDamage, AverageSoldiering, TotalPrimaryAccuracy, PriZeroAccuracyCount, AveragePrimAccuracy, "
      "AverageSecAccuracy) VALUES ('AB00000000000001', '=1+1', '''t Hart', '''=1', ' ', '1961-04-12 "
      "00:00:00', "
      "'a' || char(13) || char(10) || 'b', '\"', '0123', '', '-', '2010-03-01 09:05:00', '', 12, 1e300, "
      "-0.1, "
      "1e-300, 0.30000000000000004, 12.5, 3, 0.1, 7), ('0000000000000000', 'a,b;c', char(9) || 'x', 'NULL', "
      "'1e5', NULL, char(65279) || 'x', ' x ', '@', '＝1', char(10), NULL, NULL, 0, 0, 0, 0, 0, 0, 0, 0, 0)");
  for (const CsvSeparator separator : {CsvSeparator::Comma, CsvSeparator::Semicolon, CsvSeparator::Tab}) {
    for (const bool mark : {false, true}) {
      form.Separator = separator;
      form.ByteOrderMark = mark;
      const MemberFile other;
      ImportInto(other, Csv());
      EXPECT_EQ(ContentsOf(other), ContentsOf(file));
    }
  }
}

TEST_F(ExportOfMembers, ImportedGivesEveryCodePointBack) {
  form.History = true;
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  WriteScope scope(*database);
  std::string text;
  for (char32_t character = 1; character <= 0x10FFFF; ++character) {
    if (character < 0xD800 || character > 0xDFFF) {
      Utf8::Append(text, character);
    }
    if (character % 4096 == 0 || character == 0x10FFFF) {
      rows->AddNew();
      rows->SetField("FirstName", text);
      rows->SetField("Address", text);
      rows->Update();
      text.clear();
    }
  }
  scope.Commit();
  const MemberFile other;
  ImportInto(other, Csv());
  EXPECT_EQ(ContentsOf(other), ContentsOf(file));
}

TEST_F(ExportOfMembers, TellsOfWhomAnImportWouldNotMakeTheSame) {
  file.Execute(
      "DELETE FROM Members; INSERT INTO Members (ContactID, LastName, DallasID, Birthdate, TotalGamesPlayed, "
      "AverageDamage) VALUES (1, 'A', '00000000000000A1', '1961-04-12 00:00:00', 3, 1.1), "
      "(2, 'B', '00000000000000a2', NULL, 0, 0), (3, 'C', '12', NULL, 0, 0), "
      "(4, 'D', '', '12/04/1961', 0, 0), (5, 'E', NULL, 'unknown', 0, 0), "
      "(6, 'F', NULL, '1961-04-12 09:05:00', 2, 0), (7, 'G', NULL, '', -1, 0.3)");
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  EXPECT_THAT(MembersAsCsv(*rows, form, GoOnAlways)->NotReadBack, testing::ElementsAre("2", "3", "4", "5"));
  form.History = true;
  EXPECT_THAT(MembersAsCsv(*rows, form, GoOnAlways)->NotReadBack,
              testing::ElementsAre("2", "3", "4", "5", "7"));
}

TEST_F(ExportOfMembers, StopsWhereAsked) {
  const auto database = file.Open();
  EXPECT_FALSE(MembersAsCsv(*database->OpenRecordset("Members"), form, [](double) { return false; }));
}

TEST_F(ExportOfMembers, LeavesOutAMemberWhoWasDeletedMeanwhile) {
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  file.Execute("DELETE FROM Members WHERE ContactID = 2");
  const std::string csv = MembersAsCsv(*rows, form, GoOnAlways)->Csv;
  EXPECT_EQ(csv.find("Belmont"), std::string::npos);
  EXPECT_NE(csv.find("O'Brien"), std::string::npos);
}

}  // namespace
