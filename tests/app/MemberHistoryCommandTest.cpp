#include <gmock/gmock.h>

#include <QAbstractItemView>
#include <QComboBox>
#include <QLabel>
#include <filesystem>

#include "archive/history/MemberHistoryWindow.h"
#include "archive/history/RankingWindow.h"
#include "members/Members.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

// What the kept games tell of members, and how long they are kept.

namespace {

using testing::HasSubstr;
using testing::IsEmpty;

class HistoryCommands : public testing::Test {
 protected:
  HistoryCommands() {
    venue.PutDefaultFiles();
    venue.ChangeDatabase("members.mdb",
                         "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES "
                         "(2, 'Rhys', 'Morgan', 'Red'), (4, 'Ada', 'Byron', 'Count')");
  }

  /// Loads a game, which is kept by itself, and gives its first player to Rhys.
  void KeepGameOfRhys() {
    venue.Start();
    venue.LoadGame(SmallGame());
    const WhileModal<Members> choose([](Members& window) { ::Press(window, "OK"); });
    venue.ChooseInPopup(0, "mnuAssignMember");
    ASSERT_EQ(choose.Runs(), 1);
    ASSERT_EQ(venue.QueryDatabase("games.mdb", "SELECT count(*) FROM GamePlayers WHERE MemberID = 2"), "1");
  }

  static int RowsIn(const QWidget& window, const char* table) {
    return ::Find<QAbstractItemView>(window, table).model()->rowCount();
  }
  static std::string LabelIn(const QWidget& window, const char* label) {
    return ::Find<QLabel>(window, label).text().toStdString();
  }

  Venue venue;
};

TEST_F(HistoryCommands, LeaveGamesOfFormerMembersToAQuietMomentWhenMembersIsOpened) {
  KeepGameOfRhys();
  venue.Window.reset();
  venue.ChangeDatabase("members.mdb", "UPDATE Members SET FirstName = 'Ann' WHERE ContactID = 2");
  {
    OtherConnection other(venue.DataFile("games.mdb"));
    other.Execute("BEGIN EXCLUSIVE");
    venue.Start();
    QCoreApplication::processEvents();
  }
  const WhileModal<Members> look([](Members& window) { window.close(); });
  venue.Trigger("mnuManageMembers");
  EXPECT_EQ(look.Runs(), 1);
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT MemberID FROM CutMembers WHERE MemberID > 0"), "2");
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT count(*) FROM GamePlayers WHERE MemberID = 2"), "1");
}

TEST_F(HistoryCommands, ShowTheGamesOfMembers) {
  KeepGameOfRhys();
  const WhileModal<MemberHistoryWindow> look([](MemberHistoryWindow& window) {
    EXPECT_EQ(LabelIn(window, "MemberLabel"), "Rhys Morgan \"Red\" (2)");
    EXPECT_EQ(RowsIn(window, "SessionTable"), 1);
    window.close();
  });
  venue.Trigger("mnuMemberHistory");
  EXPECT_EQ(look.Runs(), 1);
}

TEST_F(HistoryCommands, ShowTheMemberInTheForm) {
  KeepGameOfRhys();
  const WhileModal<Members> members([](Members& form) {
    ::Press(form, "DataLast");
    const WhileModal<MemberHistoryWindow> look([](MemberHistoryWindow& window) {
      EXPECT_EQ(LabelIn(window, "MemberLabel"), "Ada Byron \"Count\" (4)");
      EXPECT_EQ(RowsIn(window, "MemberTable"), 2);
      window.close();
    });
    ::Press(form, "HistoryButton");
    EXPECT_EQ(look.Runs(), 1);
    form.close();
  });
  venue.Trigger("mnuManageMembers");
  EXPECT_EQ(members.Runs(), 1);
}

TEST_F(HistoryCommands, ForgetAMemberButNotOnTheBoard) {
  KeepGameOfRhys();
  const WhileModal<MemberHistoryWindow> forget([](MemberHistoryWindow& window) {
    ::Press(window, "ForgetButton");
    EXPECT_EQ(RowsIn(window, "MemberTable"), 0);
    window.close();
  });
  venue.Trigger("mnuMemberHistory");
  EXPECT_EQ(forget.Runs(), 1);
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT max(MemberID) FROM GamePlayers"), "0");
  EXPECT_THAT(venue.Row("ScoreDisplay", 0)[1], HasSubstr("Red"));
  // And the archive stays without, whatever becomes of the game on the board.
  venue.Trigger("mnuCommitGame");
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT sum(Committed) FROM Games"), "1");
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT max(MemberID) FROM GamePlayers"), "0");
}

TEST_F(HistoryCommands, ShowNothingWithoutAnArchiveAndMakeNone) {
  venue.Start();
  const WhileModal<MemberHistoryWindow> look([](MemberHistoryWindow& window) {
    EXPECT_EQ(LabelIn(window, "TellLabel"), "No past game names a member yet.");
    window.close();
  });
  venue.Trigger("mnuMemberHistory");
  EXPECT_EQ(look.Runs(), 1);
  EXPECT_FALSE(std::filesystem::exists(venue.DataFile("games.mdb")));
}

TEST_F(HistoryCommands, RankTheMembers) {
  KeepGameOfRhys();
  const WhileModal<RankingWindow> look([](RankingWindow& window) {
    EXPECT_EQ(RowsIn(window, "RankingTable"), 1);
    ::Press(window, "PrintButton");
    window.close();
  });
  venue.Trigger("mnuRankings");
  EXPECT_EQ(look.Runs(), 1);
  ASSERT_EQ(venue.Started.Started.size(), 1U);
  EXPECT_EQ(venue.Started.Started[0][1], venue.DataFile("ranking.html"));
  EXPECT_TRUE(std::filesystem::exists(venue.DataFile("ranking.html")));
  venue.Window->close();
  EXPECT_FALSE(std::filesystem::exists(venue.DataFile("ranking.html")));
}

TEST_F(HistoryCommands, FindNoPageOfARankingThatAKilledRunLeft) {
  WriteFile(venue.DataFile("ranking.html"), "Ada Byron");
  venue.Start();
  EXPECT_FALSE(std::filesystem::exists(venue.DataFile("ranking.html")));
}

class YearsOfGames : public testing::Test {
 protected:
  YearsOfGames() {
    venue.PutDefaultFiles();
    std::filesystem::copy_file(TESSARINE_PROGRAM_FOLDER "/games_default.mdb", venue.DataFile("games.mdb"));
    AddGame("2009-05-20 20:00:00");
    AddGame("2010-05-22 20:00:00");
  }

  void AddGame(const std::string& played) const {
    venue.ChangeDatabase(
        "games.mdb",
        "INSERT INTO Games (Played, DateText, Mission, Source, Pulls, Players, Committed, RedTotal, "
        "BlueTotal, YellowTotal, BestPlayer, DamageFactor, DeathFactor, HealFactor, AmmoFactor, "
        "AccuracyFactor, FriendlyFireFactor, InputsHash) VALUES ('" +
            played + "', '', 'None', 'cable', 1, 0, 0, 0, 0, 0, 0, 1, 1, 1, 1, 1, 1, 'x')");
  }

  /// Starts with this line in the settings; today is 2013-05-21.
  void Start(const std::string& line) {
    WriteFile(venue.DataFile("tessarine.ini"), "[archive]\n" + line + "\n");
    venue.Window.reset();
    venue.Start();
    QCoreApplication::processEvents();
  }

  std::string Games() const {
    return venue.QueryDatabase("games.mdb",
                               "SELECT group_concat(Played) FROM (SELECT substr(Played, 1, 4) AS "
                               "Played FROM Games ORDER BY Played)");
  }
  std::size_t Boxes() const { return venue.Boxes.Boxes.size(); }

  Venue venue;
};

TEST_F(YearsOfGames, AreKeptForGoodUnlessTheSettingsSayOtherwise) {
  Start("keep_years=");
  Start("keep_years=many");
  EXPECT_EQ(Games(), "2009,2010");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(YearsOfGames, GoAfterAQuestionThatIsAskedOnce) {
  venue.Boxes.Answers = {BoxAnswer::Yes};
  Start("keep_years=3");
  EXPECT_EQ(Games(), "2010");
  ASSERT_EQ(Boxes(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, HasSubstr("past games stay: 3\nGames that are older: 1\n"));
  EXPECT_EQ(venue.Boxes.Boxes[0].Buttons, BoxButtons::YesNo);
  AddGame("2008-01-01 00:00:00");
  Start("keep_years=3");
  EXPECT_EQ(Games(), "2010");
  EXPECT_EQ(Boxes(), 1U);
}

TEST_F(YearsOfGames, GoInShortSteps) {
  for (int day = 10; day < 20; ++day) {
    AddGame("2001-03-" + std::to_string(day) + " 20:00:00");
  }
  venue.Boxes.Answers = {BoxAnswer::Yes};
  Start("keep_years=3");
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT count(*) FROM Games"), "7");
  Start("keep_years=3");
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT count(*) FROM Games"), "2");
  Start("keep_years=3");
  EXPECT_EQ(Games(), "2010");
}

TEST_F(YearsOfGames, StayAfterANoWithoutAFurtherQuestion) {
  venue.Boxes.Answers = {BoxAnswer::No};
  Start("keep_years=3");
  Start("keep_years=3");
  EXPECT_EQ(Games(), "2009,2010");
  EXPECT_EQ(Boxes(), 1U);
  venue.Boxes.Answers = {BoxAnswer::Yes};
  Start("keep_years=2");
  EXPECT_EQ(Boxes(), 2U);
  EXPECT_EQ(Games(), "NULL");
}

TEST_F(YearsOfGames, AreNotAskedAboutWhereTheAnswerCannotBeKept) {
  std::filesystem::remove(venue.DataFile("state.ini"));
  std::filesystem::create_directory(venue.DataFile("state.ini"));
  Start("keep_years=3");
  Start("keep_years=3");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(Games(), "2009,2010");
  std::filesystem::remove(venue.DataFile("state.ini"));
  venue.Boxes.Answers = {BoxAnswer::Yes};
  Start("keep_years=3");
  EXPECT_EQ(Boxes(), 1U);
  EXPECT_EQ(Games(), "2010");
}

TEST_F(YearsOfGames, AreNotAskedAboutWhileThereIsNothingToDelete) {
  Start("keep_years=30");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(Games(), "2009,2010");
}

}  // namespace
