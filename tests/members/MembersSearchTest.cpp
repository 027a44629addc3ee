#include "tests/members/MembersWindow.h"

namespace {

using testing::IsEmpty;

TEST_F(MembersWindow, FindsTheStartOfAnyOfTheThreeNames) {
  Open([this] {
    SearchFor("mo");
    EXPECT_EQ(Found(), "Morgan Belmont ");  // by the last name Morgan and the nickname Mole
    SearchFor("MOR");
    EXPECT_EQ(Found(), "Morgan ");
    SearchFor("ali");
    EXPECT_EQ(Found(), "Belmont ");
    SearchFor("bel");
    EXPECT_EQ(Found(), "Belmont ");
    SearchFor("小");
    EXPECT_EQ(Found(), "王 ");
  });
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MembersWindow, FindsNoNameByItsMiddle) {
  Open([this] {
    SearchFor("elmont");
    EXPECT_EQ(Text("LastNameEntry"), "");
    EXPECT_EQ(Shown("DataPlace"), "0 / 0");
  });
}

TEST_F(MembersWindow, SearchesByItsButton) {
  Open([this] {
    Line("SearchText").setText(QStringLiteral("sh"));
    Press("Search");
    EXPECT_EQ(Found(), "O'Brien ");
  });
}

TEST_F(MembersWindow, SearchesByReturnAndDoesNotChoose) {
  Open([this] {
    Enter("SearchText", "sh");
    Type(*window, Qt::Key_Return);
    EXPECT_TRUE(window->isVisible());
    EXPECT_EQ(Text("LastNameEntry"), "O'Brien");
    EXPECT_EQ(Shown("DataPlace"), "1 / 1");
  });
}

TEST_F(MembersWindow, SearchesWhenTheMouseLeavesTheBox) {
  Open([this] {
    Enter("SearchText", "sh");
    QTest::mouseClick(&Line("FirstNameEntry"), Qt::LeftButton);
    Line("FirstNameEntry").setFocus();
    EXPECT_EQ(Text("LastNameEntry"), "O'Brien");
  });
}

TEST_F(MembersWindow, SearchesNothingWhileAMenuOrAnotherWindowHasTheKeyboard) {
  Open([this] {
    Enter("SearchText", "sh");
    for (const Qt::FocusReason reason : {Qt::PopupFocusReason, Qt::ActiveWindowFocusReason}) {
      QFocusEvent away(QEvent::FocusOut, reason);
      QApplication::sendEvent(&Line("SearchText"), &away);
      EXPECT_EQ(Shown("DataPlace"), "1 / 4");
    }
  });
}

TEST_F(MembersWindow, SearchesBeforeTheCommandOfAButtonThatIsPressedFromTheBox) {
  Open([this] {
    Enter("SearchText", "mo");
    ::Find<QPushButton>(*window, "DataNext").click();  // as assistive programs do
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
    EXPECT_EQ(Shown("DataPlace"), "2 / 2");
    Line("CityEntry").setFocus();
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
  });
}

TEST_F(MembersWindow, ShowsAllRowsForAnEmptyBox) {
  Open([this] {
    SearchFor("mole");
    EXPECT_EQ(Shown("DataPlace"), "1 / 1");
    SearchFor("");
    EXPECT_EQ(Shown("DataPlace"), "1 / 4");
  });
}

TEST_F(MembersWindow, ClearsTheSearch) {
  Open([this] {
    SearchFor("mole");
    Press("ClearSearch");
    EXPECT_EQ(Text("SearchText"), "");
    EXPECT_EQ(Shown("DataPlace"), "1 / 4");
    EXPECT_EQ(Text("LastNameEntry"), "Morgan");
  });
}

TEST_F(MembersWindow, TakesTheDatabasesWildcards) {
  Open([this] {
    SearchFor("*mont");
    EXPECT_EQ(Found(), "Belmont ");
    SearchFor("?o");
    EXPECT_EQ(Found(), "Morgan Belmont ");
    SearchFor("[rs]");
    EXPECT_EQ(Found(), "Morgan O'Brien ");
    SearchFor("[!a-z]");
    EXPECT_EQ(Found(), "王 ");
    SearchFor("#");
    EXPECT_EQ(Shown("DataPlace"), "0 / 0");
    SearchFor("%");  // not a wildcard in Jet
    EXPECT_EQ(Shown("DataPlace"), "0 / 0");
    SearchFor("_");
    EXPECT_EQ(Shown("DataPlace"), "0 / 0");
  });
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MembersWindow, ReportsASearchWithAnApostropheAsMalformedAndKeepsTheRows) {
  Open([this] {
    Press("DataNext");
    SearchFor("O'B");
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
    EXPECT_EQ(Shown("DataPlace"), "2 / 4");
    SearchFor("O''B");  // the text is not escaped
    EXPECT_EQ(Text("LastNameEntry"), "O'Brien");
  });
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, testing::StartsWith("Run-time error '3075': "));
  EXPECT_EQ(venue.Boxes.Boxes[0].Icon, BoxIcon::Critical);
}

TEST_F(MembersWindow, ReportsAMalformedSearchOnceWhenTheSearchButtonIsPressed) {
  Open([this] {
    Enter("SearchText", "O'B");
    ::Find<QPushButton>(*window, "Search").click();  // as assistive programs do
    QApplication::processEvents();
    EXPECT_EQ(venue.Boxes.Boxes.size(), 1U);
    Enter("SearchText", "O'B");
    Press("Search");
    QApplication::processEvents();
    EXPECT_EQ(venue.Boxes.Boxes.size(), 2U);
  });
}

TEST_F(MembersWindow, ReportsAnUnclosedBracketAsMalformed) {
  Open([this] {
    SearchFor("[a");
    EXPECT_TRUE(window->isVisible());
  });
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, testing::StartsWith("Run-time error '93': "));
}

TEST_F(MembersWindow, RunsNoOtherStatementThatIsTypedIntoTheSearch) {
  Open([this] { SearchFor("x'); DELETE FROM Members; --"); });
  EXPECT_EQ(Query("SELECT count(*) FROM Members"), "4");
}

TEST_F(MembersWindow, WritesTheRowBackBeforeItSearches) {
  Open([this] {
    Enter("CityEntry", "Swansea");
    SearchFor("mole");
  });
  EXPECT_EQ(Stored("City", 1), "Swansea");
}

TEST_F(MembersWindow, ClosesWhileTheSearchBoxHoldsNoQuery) {
  Open([this] {
    Enter("SearchText", "O'B");
    Type(*window, Qt::Key_Escape);
    EXPECT_FALSE(window->isVisible());
  });
  QApplication::processEvents();
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MembersWindow, SearchesAnewAfterAMemberWasAdded) {
  Open([this] {
    SearchFor("mole");
    Press("NewMember");
    EXPECT_EQ(Shown("DataPlace"), "2 / 2");  // the new row joins the search result
    SearchFor("enter");
    EXPECT_EQ(Shown("DataPlace"), "1 / 1");
  });
}

TEST_F(MembersWindow, EmptiesItsEntriesWithoutAHit) {
  Open([this] {
    const auto entries = {"FirstNameEntry", "LastNameEntry", "ClanEntry", "DOBPicker", "CityEntry"};
    for (const char* entry : entries) {
      EXPECT_NE(Text(entry), "") << entry;
    }
    SearchFor("nobody");
    for (const char* entry : entries) {
      EXPECT_EQ(Text(entry), "") << entry;
    }
  });
}

TEST_F(MembersWindow, ShowsNoFiguresWithoutAHit) {
  Sql("UPDATE Members SET DallasID = 'EFCDAB8967452301', LastPlayedDate = '2026-11-20 20:15:00', "
      "TotalGamesPlayed = 12, TotalDamage = 3450, AverageDamage = 287.5, TotalSoldiering = -7, "
      "AverageSoldiering = -0.58 WHERE ContactID = 1");
  Open([this] {
    const auto displays = {"MemberIDDisplay",        "DateJoinedDisplay",        "LastPlayedDisplay",
                           "TotalDamageDisplay",     "TotalGamesPlayedDisplay",  "AverageDamageDisplay",
                           "TotalSoldieringDisplay", "AverageSoldieringDisplay", "Dummy"};
    for (const char* display : displays) {
      EXPECT_NE(Shown(display), "") << display;
    }
    SearchFor("nobody");
    for (const char* display : displays) {
      EXPECT_EQ(Shown(display), "") << display;
    }
  });
}

}  // namespace
