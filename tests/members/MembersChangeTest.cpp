#include "tests/members/MembersWindow.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST_F(MembersWindow, WritesBackEveryEntryWhenItLeavesTheRow) {
  Open([this] {
    for (const char* entry : {"FirstNameEntry", "LastNameEntry", "NickNameEntry", "ClanEntry", "AddressEntry",
                              "CityEntry", "PostCodeEntry", "EmailEntry", "PhoneNumberEntry"}) {
      Enter(entry, entry);
    }
    Enter("DOBPicker", "1958-02-28");
    EXPECT_EQ(Stored("FirstName", 1), "Rhys");  // not written yet
    Press("DataNext");
  });
  for (const auto& [column, text] : {std::pair{"FirstName", "FirstNameEntry"},
                                     {"LastName", "LastNameEntry"},
                                     {"NickName", "NickNameEntry"},
                                     {"Clan", "ClanEntry"},
                                     {"Address", "AddressEntry"},
                                     {"City", "CityEntry"},
                                     {"PostalCode", "PostCodeEntry"},
                                     {"EmailName", "EmailEntry"},
                                     {"PhoneNumber", "PhoneNumberEntry"},
                                     {"Birthdate", "1958-02-28 00:00:00"}}) {
    EXPECT_EQ(Stored(column, 1), text);
  }
}

TEST_F(MembersWindow, WritesBackWhenItIsClosed) {
  Open([this] {
    Enter("CityEntry", "Swansea");
    window->close();
  });
  Open([this] {
    Enter("ClanEntry", "Moles");
    Type(*window, Qt::Key_Escape);
  });
  EXPECT_EQ(Stored("City || Clan", 1), "SwanseaMoles");
}

TEST_F(MembersWindow, EmptiesABirthdate) {
  Open([this] {
    Enter("DOBPicker", "");
    Press("DataNext");
    EXPECT_EQ(Text("DOBPicker"), "");
    Press("DataPrevious");
    EXPECT_EQ(Text("DOBPicker"), "");
  });
  EXPECT_EQ(Stored("Birthdate", 1), "NULL");
  EXPECT_EQ(Stored("Birthdate", 2), "NULL");
}

TEST_F(MembersWindow, TakesNamesOf255CharactersInAnyScript) {
  const std::string chinese = [] {
    std::string text;
    for (int i = 0; i < 255; ++i) {
      text += "明";
    }
    return text;
  }();
  Open([&] {
    Line("FirstNameEntry").setText(QString::fromStdString(chinese));
    Enter("LastNameEntry", std::string(300, 'x'));
    Enter("NickNameEntry", "عبد: الرحمن");
    Press("DataNext");
    Press("DataPrevious");
    EXPECT_EQ(Text("FirstNameEntry"), chinese);
  });
  EXPECT_EQ(Stored("FirstName", 1), chinese);
  EXPECT_EQ(Stored("length(LastName)", 1), "255");
  EXPECT_EQ(Stored("NickName", 1), "عبد: الرحمن");
}

TEST_F(MembersWindow, AddsAMemberAndShowsIt) {
  Open([this] {
    Press("NewMember");
    EXPECT_EQ(Text("FirstNameEntry"), "Enter Name");
    EXPECT_EQ(Text("LastNameEntry"), "Enter Name");
    EXPECT_EQ(Shown("DateJoinedDisplay"), "21 May 2013 14:30:05");
    EXPECT_EQ(Shown("TotalGamesPlayedDisplay"), "0");
    EXPECT_EQ(Shown("PrimaryAccuracyDisplay"), "N/A");
    EXPECT_EQ(Shown("DataPlace"), "5 / 5");
    QTest::keyClicks(window->focusWidget(), QStringLiteral("Ada"));
    Press("DataFirst");
  });
  EXPECT_EQ(Stored("FirstName || LastName || DateJoined || TotalGamesPlayed || PhotographLength", 10),
            "AdaEnter Name2013-05-21 14:30:0500");
  EXPECT_EQ(Stored("Birthdate", 10), "NULL");
}

TEST_F(MembersWindow, AddsTwoMembersOfTheSameName) {
  Open([this] {
    Press("NewMember");
    Press("NewMember");
  });
  EXPECT_EQ(Query("SELECT count(*) FROM Members WHERE FirstName = 'Enter Name' AND LastName = 'Enter Name'"),
            "2");
}

TEST_F(MembersWindow, DeletesTheMemberInViewAndShowsTheFirst) {
  Open([this] {
    Press("DataNext");
    Press("Delete");
    EXPECT_EQ(Text("LastNameEntry"), "Morgan");
    EXPECT_EQ(Shown("DataPlace"), "1 / 3");
  });
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"This will delete the Member. Are you Sure?", "Confirm Clear",
                                                BoxIcon::Question, BoxButtons::OkCancel}));
  EXPECT_EQ(Query("SELECT group_concat(ContactID) FROM (SELECT * FROM Members ORDER BY ContactID)"), "1,5,9");
}

TEST_F(MembersWindow, DeletesNobodyOnCancelAndKeepsWhatWasTyped) {
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  Open([this] {
    Press("DataNext");
    Enter("CityEntry", "Swansea");
    Press("Delete");
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
    EXPECT_EQ(Text("CityEntry"), "Swansea");
  });
  EXPECT_EQ(Query("SELECT count(*) FROM Members"), "4");
  EXPECT_EQ(Stored("City", 2), "Swansea");
}

TEST_F(MembersWindow, DeletesDownToTheLast) {
  Open([this] {
    for (int member = 0; member < 4; ++member) {
      Press("Delete");
    }
    EXPECT_EQ(Text("LastNameEntry"), "");
    EXPECT_FALSE(Line("LastNameEntry").isEnabled());
  });
  EXPECT_EQ(Query("SELECT count(*) FROM Members"), "0");
}

TEST_F(MembersWindow, TellsInChineseWhatTheQuestionIsAbout) {
  DataSite chinese(Language::SimplifiedChinese);
  chinese.PutDefaultFiles();
  chinese.ChangeDatabase("members.mdb", "INSERT INTO Members (FirstName, LastName) VALUES ('小明', '王')");
  const std::unique_ptr<Database> members = chinese.Databases.OpenDatabase(chinese.DataFile("members.mdb"));
  chinese.Boxes.Answers = {BoxAnswer::Cancel};
  const WhileModal<Members> open([](Members& opened) {
    ::Press(opened, "Delete");
    opened.close();
  });
  ShowMembers(chinese, *members);
  ASSERT_EQ(chinese.Boxes.Boxes.size(), 1U);
  EXPECT_EQ(chinese.Boxes.Boxes[0].Text, "This will delete the Member. Are you Sure?");
  EXPECT_EQ(chinese.Boxes.Boxes[0].Title, chinese.Strings.Text(124));
}

TEST_F(MembersWindow, GivesTheMemberInViewTheButtonThatWasRead) {
  swiped = "EFCDAB8967452301";
  Open([this] {
    Press("DataNext");
    Enter("CityEntry", "Swansea");
    Press("ChangeID");
    EXPECT_EQ(Shown("MemberIDDisplay"), "EFCDAB8967452301");
    EXPECT_EQ(Text("CityEntry"), "Swansea");
    EXPECT_EQ(Stored("DallasID", 2), "EFCDAB8967452301");
    Press("DataNext");
    EXPECT_EQ(Shown("MemberIDDisplay"), "");
    Press("ChangeID");  // duplicates are not checked
  });
  EXPECT_EQ(Stored("DallasID", 5), "EFCDAB8967452301");
  EXPECT_EQ(Stored("City", 2), "Swansea");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MembersWindow, LeavesTheButtonAloneWhenNoneWasRead) {
  Sql("UPDATE Members SET DallasID = 'AB00000000000001' WHERE ContactID = 1");
  Open([this] {
    Press("ChangeID");
    EXPECT_EQ(Shown("MemberIDDisplay"), "AB00000000000001");
  });
  EXPECT_EQ(Stored("DallasID", 1), "AB00000000000001");
}

TEST_F(MembersWindow, KeepsWhatWasTypedWhileAnotherProgramHoldsTheFile) {
  Open([this] {
    Enter("CityEntry", "Swansea");
    {
      OtherConnection other(venue.DataFile("members.mdb"));
      other.Execute("BEGIN IMMEDIATE");
      Press("DataNext");
      Press("NewMember");
      Press("OK");
      EXPECT_TRUE(window->isVisible());
      EXPECT_EQ(Text("LastNameEntry"), "Morgan");
      EXPECT_EQ(Text("CityEntry"), "Swansea");
    }
    Press("DataNext");
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
  });
  ASSERT_EQ(venue.Boxes.Boxes.size(), 3U);
  for (const auto& box : venue.Boxes.Boxes) {
    EXPECT_THAT(box.Text, testing::StartsWith("Run-time error '3050': "));
  }
  EXPECT_EQ(Stored("City", 1), "Swansea");
  EXPECT_EQ(Query("SELECT count(*) FROM Members"), "4");
}

TEST_F(MembersWindow, TellsOfALockedFileOnceWhenItIsClosed) {
  OtherConnection other(venue.DataFile("members.mdb"));
  Open([&] {
    Enter("CityEntry", "Swansea");
    other.Execute("BEGIN IMMEDIATE");
    window->close();
    EXPECT_FALSE(window->isVisible());
  });
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, testing::StartsWith("Run-time error '3050': "));
}

TEST_F(MembersWindow, SaysThatAMemberWasDeletedMeanwhile) {
  Open([this] {
    Line("CityEntry").setFocus();
    Sql("DELETE FROM Members WHERE ContactID = 2");
    Press("DataNext");
    EXPECT_EQ(Text("LastNameEntry"), "");
    Press("DataNext");
    EXPECT_EQ(Text("LastNameEntry"), "O'Brien");
  });
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, testing::StartsWith("Run-time error '3167': "));
}

}  // namespace
