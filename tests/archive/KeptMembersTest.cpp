#include <gtest/gtest.h>

#include "core/game/DallasId.h"
#include "tests/archive/KeeperVenue.h"

// What the keeper does about members: numbers that changed hands, and members whom the archive forgets.

namespace {

class KeptMembers : public KeeperVenue {
 protected:
  static constexpr const char* MolesButton = "AB00000000000001";

  /// Mole plays on Red 0, and a guest with this button on Blue 7.
  void PullMole(const std::string& guest = {}) {
    Pull();
    Player& mole = session.Game().Players(Red0);
    mole.MemberIndex = 7;
    mole.DallasID = MolesButton;
    if (!guest.empty()) {
      session.Game().Players(Blue7).DallasID = guest;
    }
    keeper->Keep();
    ASSERT_EQ(MemberOfRed(), "7");
  }
  void GiveNumberToAnn() const {
    ExecuteSql(venue.MembersFile(),
               "UPDATE Members SET DallasID = 'CD00000000000002', NickName = 'Owl', FirstName = 'Ann'");
  }
  void ChangeGame() {
    session.Game().Players(Red0).BonusPoints += 10;
    session.CalculateScores();
    keeper->Keep();
  }

  std::string MemberOfRed() const { return Query("SELECT MemberID FROM GamePlayers WHERE PlayerIndex = 1"); }
  /// In the order of the games.
  std::string MembersOfRed() const {
    return Query(
        "SELECT group_concat(MemberID) FROM (SELECT MemberID FROM GamePlayers WHERE PlayerIndex = 1 "
        "ORDER BY GameID)");
  }
  std::string Buttons() const {
    return Query(
        "SELECT group_concat(DallasID) FROM (SELECT DallasID FROM GamePlayers ORDER BY PlayerIndex)");
  }
};

TEST_F(KeptMembers, WithANumberOfSomebodyElseAreCutFromTheBoardToo) {
  PullMole();
  GiveNumberToAnn();
  CheckMembers();
  EXPECT_EQ(session.Game().Players(Red0).MemberIndex, 0);
  EXPECT_EQ(MemberOfRed(), "0");
  ChangeGame();
  EXPECT_EQ(MemberOfRed(), "0");
  EXPECT_EQ(Games(), "1");
}

TEST_F(KeptMembers, WhoHaveTheNumberNowAreKeptOnceTheyAreChosen) {
  PullMole();
  GiveNumberToAnn();
  CheckMembers();
  session.Game().Players(Red0).MemberIndex = 7;
  ChangeGame();
  EXPECT_EQ(MemberOfRed(), "7");
  CheckMembers();
  EXPECT_EQ(MemberOfRed(), "7");
  EXPECT_EQ(keeper->State().CutGames, 1);
}

TEST_F(KeptMembers, AreNotKeptWithTheNumberWhileTheCheckHasStillToBeDone) {
  PullMole();
  GiveNumberToAnn();
  {
    OtherConnection other(ArchivePath());
    other.Execute("BEGIN EXCLUSIVE");
    keeper->CheckMembers();
    ChangeGame();
    EXPECT_NE(keeper->State().Failure, "");
    EXPECT_EQ(session.Game().Players(Red0).MemberIndex, 7);
  }
  keeper->Keep();
  EXPECT_EQ(keeper->State().Failure, "");
  EXPECT_EQ(session.Game().Players(Red0).MemberIndex, 0);
  EXPECT_EQ(MemberOfRed(), "0");
}

TEST_F(KeptMembers, AreCutLaterFromTheGamesThatAStopLeft) {
  PullMole();
  session.ClearPlayerData();
  GiveNumberToAnn();
  keeper->CheckMembers();
  Pull();  // before the first step
  EXPECT_EQ(Query("SELECT max(MemberID) FROM GamePlayers"), "7");
  while (keeper->CutAPart()) {
  }
  EXPECT_EQ(Query("SELECT max(MemberID) FROM GamePlayers"), "0");
  EXPECT_EQ(keeper->State().CutGames, 1);
  EXPECT_FALSE(keeper->CutAPart());
}

TEST_F(KeptMembers, AreCutOnlyWhileTheDiskHasRoom) {
  PullMole();
  GiveNumberToAnn();
  keeper->CheckMembers();
  --disk.Space;
  EXPECT_FALSE(keeper->CutAPart());
  EXPECT_EQ(keeper->State().Failure, venue.Strings.Text(OwnText::KeeperDiskFull));
  EXPECT_EQ(MemberOfRed(), "7");
  ++disk.Space;
  keeper->Keep();
  while (keeper->CutAPart()) {
  }
  EXPECT_EQ(keeper->State().Failure, "");
  EXPECT_EQ(MemberOfRed(), "0");
}

TEST_F(KeptMembers, WhoGotANumberKeepTheirGamesThoughTheCheckIsInterrupted) {
  PullMole();
  session.ClearPlayerData();
  GiveNumberToAnn();
  keeper->CheckMembers();
  --disk.Space;
  EXPECT_FALSE(keeper->CutAPart());
  ++disk.Space;
  Pull();
  session.Game().Players(Red0).MemberIndex = 7;  // Ann
  keeper->Keep();
  EXPECT_EQ(session.Game().Players(Red0).MemberIndex, 7);
  Start();  // the program
  CheckMembers();
  EXPECT_EQ(MembersOfRed(), "0,7");
  EXPECT_EQ(keeper->State().CutGames, 1);
  CheckMembers();
  EXPECT_EQ(MembersOfRed(), "0,7");
  EXPECT_EQ(Query("SELECT count(*) FROM CutMembers WHERE MemberID <> 0"), "0");
}

TEST_F(KeptMembers, WhomTheArchiveForgetsAreNotKeptAgainWithTheGameOnTheBoard) {
  PullMole("EE00000000000005");
  keeper->ForgetPersons({.Numbers = {7}, .GuestButtons = {"EE00000000000005"}, .TakesButtons = true});
  ChangeGame();
  EXPECT_EQ(MemberOfRed(), "0");
  EXPECT_EQ(Buttons(), std::string(NoDallasId) + "," + NoDallasId);
  EXPECT_EQ(Query("SELECT count(*) FROM GamePlayers WHERE MemberID = 7"), "0");
  EXPECT_EQ(session.Game().Players(Red0).MemberIndex, 7);
  EXPECT_EQ(session.Game().Players(Red0).DallasID, MolesButton);
  EXPECT_EQ(Games(), "1");
}

TEST_F(KeptMembers, WhomTheArchiveForgotArePlayersOfTheNextGameAsBefore) {
  PullMole();
  keeper->ForgetPersons({.Numbers = {7}, .GuestButtons = {}, .TakesButtons = true});
  session.ClearPlayerData();
  EXPECT_EQ(MemberOfRed(), "0");
  Pull();
  session.Game().Players(Red0).MemberIndex = 7;
  keeper->Keep();
  EXPECT_EQ(MembersOfRed(), "0,7");
}

TEST_F(KeptMembers, LeaveDeletedGamesToShortSteps) {
  Pull();
  OtherConnection(ArchivePath())
      .Execute(
          "WITH RECURSIVE n(i) AS (SELECT 2 UNION ALL SELECT i + 1 FROM n WHERE i < 16) INSERT INTO "
          "Games SELECT n.i, Played, DateText, Mission, Source, Pulls, Players, Committed, RedTotal, "
          "BlueTotal, YellowTotal, BestPlayer, DamageFactor, DeathFactor, HealFactor, AmmoFactor, "
          "AccuracyFactor, FriendlyFireFactor, InputsHash, '2013-01-01 00:00:00' FROM Games, n");
  EXPECT_TRUE(keeper->RemoveDeleted());
  EXPECT_EQ(Games(), "11");
  EXPECT_TRUE(keeper->RemoveDeleted());
  EXPECT_TRUE(keeper->RemoveDeleted());
  EXPECT_FALSE(keeper->RemoveDeleted());
  EXPECT_EQ(Games(), "1");
}

}  // namespace
