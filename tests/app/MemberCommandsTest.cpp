#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>

#include "members/Members.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

// The commands of the main window that are about members.

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class MemberCommands : public testing::Test {
 protected:
  MemberCommands() {
    venue.PutDefaultFiles();
    venue.ChangeDatabase(
        "members.mdb",
        "INSERT INTO Members (ContactID, DallasID, FirstName, LastName, NickName) VALUES "
        "(2, NULL, 'Rhys', 'Morgan', NULL), (4, 'AB00000000000001', 'Ada', 'Byron', 'Count'), "
        "(7, 'AB00000000000001', 'Sean', 'O''Brien', 'Sham: rock')");
    venue.ButtonSwipe = [this] { return swiped; };
    venue.Start();
  }

  /// Chooses "Assign Member" for a row of the board and does `act` in the window, which is then closed.
  void Assign(int row, const std::function<void(Members&)>& act) {
    const WhileModal<Members> open([&](Members& window) {
      act(window);
      window.close();
    });
    venue.ChooseInPopup(row, "mnuAssignMember");
    EXPECT_EQ(open.Runs(), 1);
  }

  std::string PlayerText(int row) { return venue.Row("ScoreDisplay", row)[1]; }

  static void Rename(Members& window, const char* entry, const char* text) {
    ::Find<QLineEdit>(window, entry).setText(QString::fromUtf8(text));
  }

  static FakeMessageBoxes::Box Gone() {
    return {"Could not locate specified Member in database!", "Member Error", BoxIcon::Exclamation,
            BoxButtons::Ok};
  }

  Venue venue;
  std::string swiped = NoDallasId;
};

TEST_F(MemberCommands, AssignTheMemberThatIsChosen) {
  venue.LoadGame(SmallGame());
  Assign(1, [](Members& window) {
    EXPECT_EQ(window.ContactToShow, 0);
    ::Press(window, "DataNext");
    ::Press(window, "OK");
  });
  EXPECT_EQ(PlayerText(0), "Blue  7");
  EXPECT_EQ(PlayerText(1), "Red  0: Count");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MemberCommands, ShowFirstAndLastNameOfAMemberWithoutNickname) {
  venue.LoadGame(SmallGame());
  Assign(0, [](Members& window) { ::Press(window, "OK"); });
  EXPECT_EQ(PlayerText(0), "Blue  7: Rhys Morgan");
}

TEST_F(MemberCommands, AssignNobodyWhenTheWindowIsClosed) {
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  Assign(0, [](Members& window) { ::Press(window, "DataLast"); });
  EXPECT_EQ(PlayerText(0), "Red  0: Count");
}

TEST_F(MemberCommands, AssignAnewInPlaceOfAnother) {
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  Assign(0, [](Members& window) {
    ::Press(window, "DataLast");
    ::Press(window, "OK");
  });
  EXPECT_EQ(PlayerText(0), "Red  0: Sham: rock");
  venue.ChooseInPopup(0, "mnuUnassignMember");  // the second colon does no harm
  EXPECT_EQ(PlayerText(0), "Red  0");
}

TEST_F(MemberCommands, ShowOnTheBoardWhatWasEditedMeanwhile) {
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  Assign(0, [](Members& window) {
    ::Press(window, "DataNext");
    Rename(window, "NickNameEntry", "Countess");
  });
  EXPECT_EQ(PlayerText(0), "Red  0: Countess");
}

TEST_F(MemberCommands, DoNotKnowAMemberWhoWasAddedInThisRun) {
  venue.LoadGame(SmallGame());
  Assign(0, [](Members& window) {
    ::Press(window, "NewMember");
    ::Press(window, "OK");
  });
  EXPECT_EQ(PlayerText(0), "Blue  7");
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Gone()));
  venue.Window.reset();
  venue.Boxes.Boxes.clear();
  venue.Start();
  venue.LoadGame(GameFile(PlayerOf(40, "<MemberIndex>8</MemberIndex>")));
  EXPECT_EQ(PlayerText(0), "Blue  7: Enter Name Enter Name");
}

TEST_F(MemberCommands, TellOfAMemberWhoWasDeletedInTheWindow) {
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>2</MemberIndex>")));
  Assign(0, [](Members& window) { ::Press(window, "Delete"); });
  EXPECT_EQ(PlayerText(0), "Red  0");
  ASSERT_EQ(venue.Boxes.Boxes.size(), 2U);
  EXPECT_EQ(venue.Boxes.Boxes[1], Gone());
}

TEST_F(MemberCommands, LookForNobodyWithoutAButton) {
  venue.ChangeDatabase("members.mdb", "UPDATE Members SET DallasID = '0000000000000000'");
  venue.LoadGame(GameFile(PlayerOf(1, "<DallasID>0000000000000000</DallasID>")));
  EXPECT_EQ(PlayerText(0), "Red  0");
}

TEST_F(MemberCommands, ShowTheFirstMemberWithTheButtonThatWasRead) {
  swiped = "AB00000000000001";
  const WhileModal<Members> open([](Members& window) {
    EXPECT_EQ(::Find<QLineEdit>(window, "LastNameEntry").text(), QStringLiteral("Byron"));
    EXPECT_EQ(::Find<QLabel>(window, "DataPlace").text(), QStringLiteral("2 / 3"));
    window.close();
  });
  venue.Trigger("mnuCheckButton");
  EXPECT_EQ(open.Runs(), 1);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MemberCommands, FindTheButtonOfAMemberWhoWasAddedInThisRun) {
  venue.ChangeDatabase("members.mdb",
                       "INSERT INTO Members (DallasID, FirstName, LastName) VALUES ('CC', 'New', 'One')");
  swiped = "CC";
  const WhileModal<Members> open([](Members& window) {
    EXPECT_EQ(::Find<QLineEdit>(window, "LastNameEntry").text(), QStringLiteral("One"));
    window.close();
  });
  venue.Trigger("mnuCheckButton");
  EXPECT_EQ(open.Runs(), 1);
}

TEST_F(MemberCommands, TellOfAButtonThatNobodyHas) {
  swiped = "AB00000000000002";
  venue.Trigger("mnuCheckButton");
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Button is not assigned to a member", "Tessarine",
                                                BoxIcon::Information, BoxButtons::Ok}));
}

TEST_F(MemberCommands, EndWithoutAWordWhenNoButtonWasRead) {
  venue.ChangeDatabase("members.mdb", "UPDATE Members SET DallasID = '0000000000000000'");
  venue.Trigger("mnuCheckButton");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MemberCommands, CommitTheGameOnce) {
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex><BonusPoints>5</BonusPoints>") +
                          PlayerOf(2, "<BonusPoints>9</BonusPoints>")));
  venue.Trigger("mnuCommitGame");
  venue.Trigger("mnuCommitGame");
  EXPECT_THAT(
      venue.Boxes.Boxes,
      ElementsAre(FakeMessageBoxes::Box{"Scores have been committed to the Database", "Update Success",
                                        BoxIcon::Information, BoxButtons::Ok},
                  FakeMessageBoxes::Box{
                      "Some Scores have already been committed to the Database. Uncommited scores are "
                      "now committed.",
                      "Update Success", BoxIcon::Information, BoxButtons::Ok}));
  EXPECT_EQ(
      venue.QueryDatabase("members.mdb",
                          "SELECT TotalGamesPlayed || ' ' || TotalSoldiering || ' ' || LastPlayedDate FROM "
                          "Members WHERE ContactID = 4"),
      "1 5.0 2013-05-21 14:30:05");
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT sum(TotalGamesPlayed) FROM Members"), "1");
}

TEST_F(MemberCommands, CommitAGameWithoutMembersAndChangeNothing) {
  venue.LoadGame(SmallGame());
  venue.Trigger("mnuCommitGame");
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Scores have been committed to the Database",
                                                "Update Success", BoxIcon::Information, BoxButtons::Ok}));
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT sum(TotalGamesPlayed) FROM Members"), "0");
}

TEST_F(MemberCommands, KeepInTheGameFileThatItWasCommitted) {
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  venue.Trigger("mnuCommitGame");
  venue.Dialog.Answers = {venue.Folder / "saved.xml", venue.Folder / "saved.xml"};
  venue.Trigger("mnuSaveScores");
  venue.Trigger("mnuClearScores");
  venue.Trigger("mnuLoadScores");
  venue.Boxes.Boxes.clear();
  venue.Trigger("mnuCommitGame");
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, testing::StartsWith("Some Scores have already"));
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT sum(TotalGamesPlayed) FROM Members"), "1");
}

TEST_F(MemberCommands, TellThatTheCommitFailed) {
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  OtherConnection other(venue.DataFile("members.mdb"));
  other.Execute("BEGIN IMMEDIATE");
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  venue.Trigger("mnuCommitGame");
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{
                                     "Error occured while saving data to Database", "Database Error",
                                     BoxIcon::Exclamation, BoxButtons::OkCancel}));
  EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
}

TEST_F(MemberCommands, ShowInTheWindowWhatWasCommitted) {
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex><BonusPoints>5</BonusPoints>")));
  venue.Trigger("mnuCommitGame");
  const WhileModal<Members> open([](Members& window) {
    ::Press(window, "DataNext");
    EXPECT_EQ(::Find<QLabel>(window, "TotalGamesPlayedDisplay").text(), QStringLiteral("1"));
    EXPECT_EQ(::Find<QLabel>(window, "AverageSoldieringDisplay").text(), QStringLiteral("5"));
    EXPECT_EQ(::Find<QLabel>(window, "LastPlayedDisplay").text(), QStringLiteral("21 May 2013 14:30:05"));
    window.close();
  });
  venue.Trigger("mnuManageMembers");
  EXPECT_EQ(open.Runs(), 1);
}

}  // namespace
