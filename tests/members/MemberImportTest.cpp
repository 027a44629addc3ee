#include "members/MemberImport.h"

#include <gmock/gmock.h>

#include "core/data/Rows.h"
#include "members/ImportTexts.h"
#include "tests/members/MemberFile.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;

bool ToTheEnd(double /*done*/) {
  return true;
}

class Import : public testing::Test {
 protected:
  /// The rows that an import of `csv` plans, each with its line; the columns go where their headings say.
  std::vector<std::string> Planned(const std::string& csv) {
    import = std::make_unique<MemberImport>(csv, *database, "2026-11-23 10:00:00");
    choices.Use.Columns = MemberImport::Match(import->Columns());
    plan = *import->Plan(choices, ToTheEnd);
    std::vector<std::string> rows;
    for (const PlannedRow& row : plan.Rows) {
      rows.push_back(std::to_string(row.Line) + " " + row.Name + ": " + TextOfRow(row, strings));
    }
    return rows;
  }

  /// Plans and does it.
  void Do(const std::string& csv) {
    Planned(csv);
    EXPECT_TRUE(import->Write(choices, plan, ToTheEnd));
  }

  std::string Count() const { return file.Query("SELECT count(*) FROM Members"); }

  const StringTable strings{Language::English};
  MemberFile file;
  std::unique_ptr<Database> database = file.Open();
  std::unique_ptr<MemberImport> import;
  ImportChoices choices;
  ImportPlan plan;
};

TEST_F(Import, AddsNewMembersWithTodayAsJoiningDate) {
  EXPECT_THAT(Planned("First name;Surname;DOB;City\r\nAda;Byron;1990-12-10;\"London\r\nW1\"\r\nBo;Li;;\r\n"),
              ElementsAre("2 Ada Byron: New", "4 Bo Li: New"));
  EXPECT_EQ(Count(), "4");  // a dry run
  EXPECT_TRUE(import->Write(choices, plan, ToTheEnd));
  EXPECT_EQ(Count(), "6");
  EXPECT_EQ(file.Stored("FirstName || LastName || Birthdate || DateJoined || City", 10),
            "AdaByron1990-12-10 00:00:002026-11-23 10:00:00London\r\nW1");
  EXPECT_EQ(file.Stored("TotalGamesPlayed || ',' || PhotographLength", 10), "0,0");
  EXPECT_EQ(file.Stored("Birthdate", 11), "NULL");
}

TEST_F(Import, LeavesThoseWhoAreThereUnlessAskedOtherwise) {
  const std::string csv =
      "FirstName,LastName,Birthdate,City\nrhys,Morgan,1961-04-12,Bath\nSean,O'Brien,,Cork\n";
  EXPECT_THAT(Planned(csv), ElementsAre("2 rhys Morgan: Skipped, is there already",
                                        "3 Sean O'Brien: Skipped, is there already"));
  EXPECT_FALSE(plan.ChangesAnything());
}

TEST_F(Import, ChangesWhatDiffersAndNotByEmptyCells) {
  choices.Same = SameMember::Update;
  file.Execute("UPDATE Members SET Clan = 'Old', City = 'Cork' WHERE ContactID = 5");
  const std::string csv =
      "FirstName,LastName,Birthdate,City,Clan,NickName\nRhys,Morgan,1961-04-12,Bath,Red Dragons,\n"
      "Sean,O'Brien,,Cork,,Shamrock\nAlice,Belmont,,Bath,,\"\"\n";
  EXPECT_THAT(Planned(csv), ElementsAre("2 Rhys Morgan: Changed: City", "3 Sean O'Brien: Unchanged",
                                        "4 Alice Belmont: Changed: Nickname, City"));
  Do(csv);
  EXPECT_EQ(Count(), "4");
  EXPECT_EQ(file.Stored("City || Clan", 1), "BathRed Dragons");
  EXPECT_EQ(file.Stored("Clan", 5), "Old");
  EXPECT_EQ(file.Stored("NickName", 2), "");
}

TEST_F(Import, AddsOnceMoreWhereAsked) {
  choices.Same = SameMember::Add;
  Do("FirstName,LastName\nSean,O'Brien\nSean,O'Brien\n");
  EXPECT_EQ(Count(), "6");
}

TEST_F(Import, FindsAMemberByTheButtonFirst) {
  choices.Same = SameMember::Update;
  file.Execute("UPDATE Members SET DallasID = 'AB00000000000001' WHERE ContactID = 5");
  EXPECT_THAT(Planned("Button,FirstName,LastName\nab00000000000001,John,O'Brien\n"),
              ElementsAre("2 John O'Brien: Changed: First name"));
}

TEST_F(Import, RefusesWithLineAndReason) {
  file.Execute("INSERT INTO Members (FirstName, LastName) VALUES ('Sean', 'O''Brien')");
  EXPECT_THAT(
      Planned("FirstName,LastName,Birthdate,Button\nA,B,1.13.2001,\nC,D,,XY\n,,,\nRhys,Morgan,,\n"
              "Sean,O'Brien,,\nE,F,,\nE,F,,\nG,H,,,,x\n"),
      ElementsAre("2 A B: Refused: Date of birth is no date, or not in this order of day and month",
                  "3 C D: Refused: the button has not got 16 hexadecimal digits",
                  "4 : Refused: there is neither a name nor a nickname nor a button",
                  "5 Rhys Morgan: Refused: a member of this name is there, and the date of birth is missing "
                  "on one side",
                  "6 Sean O'Brien: Refused: several members of the table are the same as this one",
                  "7 E F: New", "8 E F: Refused: the same member as in line 7",
                  "9 : Refused: more cells than headings"));
  EXPECT_EQ(TextOfPlan(plan, strings), "1 new, 0 changed, 0 unchanged, 0 skipped, 7 refused");
}

TEST_F(Import, RefusesTheSecondLineAboutOneMember) {
  choices.Same = SameMember::Update;
  EXPECT_THAT(
      Planned("FirstName,LastName,City\nSean,O'Brien,Cork\nsean,O'Brien,Bath\n"),
      ElementsAre("2 Sean O'Brien: Changed: City", "3 sean O'Brien: Refused: the same member as in line 2"));
}

TEST_F(Import, TakesTheHistoryOnlyWhereAsked) {
  const std::string csv = "FirstName,LastName,TotalGamesPlayed\nAda,Byron,7\n";
  Do(csv);
  EXPECT_EQ(file.Stored("TotalGamesPlayed", 10), "0");
  choices.Use.History = true;
  choices.Same = SameMember::Update;
  EXPECT_THAT(Planned(csv), ElementsAre("2 Ada Byron: Changed: Games played"));
  Do(csv);
  EXPECT_EQ(file.Stored("TotalGamesPlayed", 10), "7");
}

TEST_F(Import, GivesNewNumbersWhereThereAreMembers) {
  Do("ContactID,FirstName,LastName\n1,Ada,Byron\n");
  EXPECT_EQ(Count(), "5");
  EXPECT_EQ(file.Stored("FirstName", 1), "Rhys");
  EXPECT_EQ(file.Stored("FirstName", 10), "Ada");
}

TEST_F(Import, KeepsTheNumbersInAnEmptyTable) {
  file.Execute("DELETE FROM Members");
  EXPECT_THAT(Planned("ContactID,FirstName,LastName\n7,Ada,Byron\n3,Ada,Byron\n7,Bo,Li\n,Cy,Young\n"),
              ElementsAre("2 Ada Byron: New", "3 Ada Byron: New",
                          "4 Bo Li: Refused: the same member as in line 2", "5 Cy Young: New"));
  EXPECT_THAT(TextOfPlan(plan, strings), testing::HasSubstr("keep their numbers"));
  EXPECT_TRUE(import->Write(choices, plan, ToTheEnd));
  EXPECT_EQ(file.Query("SELECT group_concat(ContactID || FirstName) FROM (SELECT * FROM Members ORDER BY "
                       "ContactID)"),
            "3Ada,7Ada,10Cy");
}

TEST_F(Import, TellsWhereAFileCannotBeRead) {
  Planned("FirstName,LastName\nAda,Byron\nBo,\"Li\nCy,Young\n");
  EXPECT_FALSE(plan.ChangesAnything());
  EXPECT_EQ(TextOfPlan(plan, strings), "Line 3: a quotation mark is opened and never closed.");
  Planned(
      "\xFF\xFE"
      "A");
  EXPECT_EQ(TextOfPlan(plan, strings), "The file is in UTF-16. Save it as CSV in UTF-8.");
  Planned("");
  EXPECT_EQ(TextOfPlan(plan, strings), "There are no members below the headings.");
}

TEST_F(Import, ReadsWindows1252) {
  Do("FirstName,LastName\nRen\xE9,M\xFCller\n");
  EXPECT_EQ(file.Stored("FirstName || LastName", 10), "RenéMüller");
}

TEST_F(Import, DoesNothingWhenItIsStopped) {
  std::string csv = "FirstName,LastName\n";
  for (int member = 0; member < 300; ++member) {
    csv.append("A").append(std::to_string(member)).append(",B\n");
  }
  Planned(csv);
  int calls = 0;
  EXPECT_FALSE(import->Write(choices, plan, [&calls](double) { return ++calls < 3; }));
  EXPECT_EQ(Count(), "4");
  Do(csv);
  EXPECT_EQ(Count(), "304");
  EXPECT_FALSE(import->Plan(choices, [](double) { return false; }));
}

TEST_F(Import, DoesNothingWhenAMemberHasGoneSince) {
  choices.Same = SameMember::Update;
  Planned("FirstName,LastName,City\nAda,Byron,Bath\nSean,O'Brien,Cork\n");
  file.Execute("DELETE FROM Members WHERE ContactID = 5");
  EXPECT_EQ(NumberThrownBy([this] { import->Write(choices, plan, ToTheEnd); }), 3167);
  EXPECT_EQ(Count(), "3");
}

TEST_F(Import, TellsHowFarItIs) {
  std::string csv = "FirstName,LastName\n";
  for (int member = 0; member < 1000; ++member) {
    csv.append("A").append(std::to_string(member)).append(",B\n");
  }
  Planned(csv);
  std::vector<double> told;
  import->Plan(choices, [&told](double done) {
    told.push_back(done);
  return true;
});
EXPECT_TRUE(std::is_sorted(told.begin(), told.end()));
EXPECT_GE(told.front(), 0);
EXPECT_LE(told.back(), 1);
EXPECT_GT(told.size(), 10U);
}  // namespace

TEST_F(Import, MatchesEachColumnOnce) {
  const MemberImport twice("Name,Email,E-mail,Mail\n", *database, "");
  EXPECT_THAT(MemberImport::Match(twice.Columns()),
              ElementsAre(std::nullopt, std::optional<std::size_t>(10), std::nullopt, std::nullopt));
}

TEST_F(Import, ShowsTheFirstCellsOfEachColumn) {
  const MemberImport three("A;B\n1;2\n3\n5;6\n7;8\n", *database, "");
  const std::vector<MemberImport::FileColumn> columns = three.Columns();
  ASSERT_EQ(columns.size(), 2U);
  EXPECT_EQ(columns[1].Heading, "B");
  EXPECT_THAT(columns[0].Cells, ElementsAre("1", "3", "5"));
  EXPECT_THAT(columns[1].Cells, ElementsAre("2", "6"));
}

TEST_F(Import, SettlesTheOrderOfDatesByTheFile) {
  const auto find = [this](const std::string& csv) {
    Planned(csv);
    return TextOfDates(*import->FindDateOrder(choices.Use, ToTheEnd), strings);
  };
  const std::string heading = "FirstName,Birthdate,DateJoined,LastPlayedDate\n";
  EXPECT_EQ(find(heading + "A,2001-05-03,,\n"), "The dates of the file are clear.");
  EXPECT_EQ(find(heading + "A,3/5/2001,,\nB,,23/5/2001,\n"), "The date in line 3 settles the order.");
  EXPECT_EQ(find(heading + "A,3/5/2001,,\n"), "The file does not settle the order. Please choose.");
  EXPECT_EQ(find(heading + "A,3/5/2001,,\nB,,,23/5/2001\n"),
            "The file does not settle the order. Please choose.");  // the history is not read
  EXPECT_EQ(find(heading + "A,5/23/2001,,\nB,23/5/2001,,\n"),
            "The file does not settle the order. Please choose.");
}

}  // namespace
