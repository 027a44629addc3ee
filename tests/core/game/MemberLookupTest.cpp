#include "core/game/MemberLookup.h"

#include <gmock/gmock.h>

#include "core/data/FieldValue.h"
#include "core/game/HitLines.h"
#include "tests/support/ScoredGame.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class Looking : public testing::Test {
 protected:
  Looking() {
    ExecuteSql(venue.MembersFile(),
               "INSERT INTO Members (ContactID, DallasID, FirstName, LastName, NickName) VALUES "
               "(2, 'AA', 'Ann', 'Lee', ''), (5, 'BB', 'Bo', 'Ray', 'Mole'), (6, 'BB', 'Cy', 'Fox', NULL)");
    venue.Open();
  }

  ScoredGame venue;
};

TEST_F(Looking, FindsTheMember) {
  const auto member = venue.Members->LoadMember(5);
  ASSERT_TRUE(member);
  EXPECT_EQ(member->ContactId, 5);
  EXPECT_EQ(member->GetPlayerName(true), "Mole");
  EXPECT_EQ(member->GetPlayerName(false), "Bo Ray");
}

TEST_F(Looking, TakesTheFullNameWithoutANickname) {
  const auto ann = venue.Members->LoadMember(2);
  ASSERT_TRUE(ann);
  EXPECT_EQ(ann->GetPlayerName(true), "Ann Lee");
  const auto cy = venue.Members->LoadMember(6);
  ASSERT_TRUE(cy);
  EXPECT_EQ(cy->GetPlayerName(true), "Cy Fox");
}

TEST_F(Looking, TellsNicknamesWithoutABox) {
  EXPECT_EQ(venue.Members->NickNameOf(5), "Mole");
  EXPECT_EQ(venue.Members->NickNameOf(2), "");
  EXPECT_EQ(venue.Members->NickNameOf(6), "");
  EXPECT_EQ(venue.Members->NickNameOf(3), "");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Looking, KeepsItsAnswerWhereverTheCursorGoes) {
  const auto bo = venue.Members->LoadMember(5);
  venue.Members->LoadMember(2);
  venue.Members->LoadMember(3);
  ASSERT_TRUE(bo);
  EXPECT_EQ(bo->GetPlayerName(true), "Mole");
}

TEST_F(Looking, LeavesTheCursorOnTheMember) {
  ASSERT_TRUE(venue.Members->LoadMember(5));
  EXPECT_EQ(TextOf(venue.RsMembers->Fields("ContactID")), "5");
}

TEST_F(Looking, ReadsTheHistoryOfTheMemberWhereverTheCursorStands) {
  ExecuteSql(venue.MembersFile(),
             "UPDATE Members SET Clan = 'Owls', TotalGamesPlayed = 12, AveragePrimAccuracy = 0.5, "
             "AverageDamage = 12.25, AverageSoldiering = -3 WHERE ContactID = 5");
  venue.Members->LoadMember(2);
  const MemberHistory history = venue.Members->LoadHistory(5);
  EXPECT_EQ(history.Clan, "Owls");
  EXPECT_EQ(history.TotalGamesPlayed, 12);
  EXPECT_EQ(history.AveragePrimAccuracy, 0.5);
  EXPECT_EQ(history.AverageDamage, 12.25);
  EXPECT_EQ(history.AverageSoldiering, -3);
  EXPECT_EQ(NumberThrownBy([this] { venue.Members->LoadHistory(3); }), 3021);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Looking, EndsPastTheLastRowWhenThereIsNone) {
  EXPECT_FALSE(venue.Members->LoadMember(3));
  EXPECT_TRUE(venue.RsMembers->Eof());
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Could not locate specified Member in database!",
                                                "Member Error", BoxIcon::Exclamation, BoxButtons::Ok}));
}

TEST_F(Looking, FindsTheFirstHolderOfAButtonAndStandsBehind) {
  EXPECT_EQ(venue.Members->FindByDallasId("BB"), 5);
  EXPECT_EQ(TextOf(venue.RsMembers->Fields("ContactID")), "6");
  EXPECT_EQ(venue.Members->FindByDallasId("CC"), 0);
}

TEST_F(Looking, ForANameWithoutValuesGivesTheBlank) {
  ExecuteSql(venue.MembersFile(), "UPDATE Members SET FirstName = NULL, LastName = NULL");
  const auto member = venue.Members->LoadMember(2);
  ASSERT_TRUE(member);
  EXPECT_EQ(member->GetPlayerName(true), " ");
}

TEST_F(Looking, DoesNotSeeMembersAddedLater) {
  ExecuteSql(venue.MembersFile(), "INSERT INTO Members (ContactID, DallasID) VALUES (9, 'DD')");
  EXPECT_EQ(venue.Members->FindByDallasId("DD"), 0);
  EXPECT_FALSE(venue.Members->LoadMember(9));
}

TEST_F(Looking, SeesNamesChangedLater) {
  ExecuteSql(venue.MembersFile(), "UPDATE Members SET NickName = 'Owl' WHERE ContactID = 5");
  const auto member = venue.Members->LoadMember(5);
  ASSERT_TRUE(member);
  EXPECT_EQ(member->GetPlayerName(true), "Owl");
}

TEST_F(Looking, DoesNotFindAMemberDeletedLater) {
  ExecuteSql(venue.MembersFile(), "DELETE FROM Members WHERE ContactID = 5");
  EXPECT_FALSE(venue.Members->LoadMember(5));
}

class MemberNames : public testing::Test {
 protected:
  static constexpr int Red0 = 1;
  static constexpr int Red32 = 97;
  static constexpr int Blue7 = 40;

  MemberNames() {
    ExecuteSql(
        venue.MembersFile(),
        "INSERT INTO Members (ContactID, DallasID, FirstName, LastName, NickName) VALUES "
        "(4, 'AA00000000000001', 'Ann', 'Lee: 9', NULL), (7, 'BB00000000000001', 'Bo', 'Ray', 'Mole'), "
        "(9, 'BB00000000000001', 'Other', 'One', '')");
  }

  ScoredGame venue;
};

TEST_F(MemberNames, AreFoundByButtonAndStayAssigned) {
  venue.Activate(Red0).DallasID = "BB00000000000001";
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).MemberIndex, 7);
  EXPECT_EQ(venue.Cell(0, BoardColumn::Player), "Red  0: Mole");
}

TEST_F(MemberNames, ComeBackThroughTheButtonAfterUnassigning) {
  venue.Activate(Red0).DallasID = "AA00000000000001";
  venue.CalculateScores();
  venue.game.Players(Red0).MemberIndex = 0;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).MemberIndex, 4);
}

TEST_F(MemberNames, OfAnAssignedMemberWinOverTheButton) {
  Player& player = venue.Activate(Red0);
  player.DallasID = "BB00000000000001";
  player.MemberIndex = 4;
  venue.CalculateScores();
  EXPECT_EQ(player.MemberIndex, 4);
  EXPECT_EQ(venue.Cell(0, BoardColumn::Player), "Red  0: Ann Lee: 9");
}

TEST_F(MemberNames, AreFirstAndLastNameWithoutANickname) {
  venue.Activate(Red0).MemberIndex = 4;
  venue.Activate(Red32).MemberIndex = 9;
  venue.CalculateScores();
  EXPECT_THAT(venue.Column(BoardColumn::Player), ElementsAre("Red  0: Ann Lee: 9", "Red  32: Other One"));
}

TEST_F(MemberNames, WithAColonAndFiguresLeaveTheRankInItsRecord) {
  venue.Activate(Red0).MemberIndex = 4;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).Rank, 1);
  EXPECT_EQ(venue.game.Players(10).Rank, 0);
}

TEST_F(MemberNames, AreNotLookedUpWithoutAButton) {
  ExecuteSql(venue.MembersFile(), "UPDATE Members SET DallasID = '0000000000000000'");
  venue.Activate(Red0);
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).MemberIndex, 0);
  EXPECT_EQ(venue.Cell(0, BoardColumn::Player), "Red  0");
}

TEST_F(MemberNames, AreLookedUpForActivePlayersOnly) {
  venue.game.Players(Red0).DallasID = "BB00000000000001";
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).MemberIndex, 0);
}

TEST_F(MemberNames, OfAnUnknownButtonStayEmptyWithoutABox) {
  venue.Activate(Red0).DallasID = "bb00000000000001";
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).MemberIndex, 0);
  EXPECT_EQ(venue.Cell(0, BoardColumn::Player), "Red  0");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MemberNames, OfMembersWhoAreGoneAreMissedInABoxForEachPlayer) {
  const FakeMessageBoxes::Box box{"Could not locate specified Member in database!", "Member Error",
                                  BoxIcon::Exclamation, BoxButtons::Ok};
  venue.Activate(Red0).MemberIndex = 5;
  venue.Activate(Red32).MemberIndex = -1;
  venue.Activate(Blue7).MemberIndex = 7;
  venue.CalculateScores();
  EXPECT_THAT(venue.Column(BoardColumn::Player), ElementsAre("Red  0", "Blue  7: Mole", "Red  32"));
  EXPECT_EQ(venue.game.Players(Red0).MemberIndex, 5);
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(box, box));
  venue.CalculateScores();
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(box, box, box, box));
}

TEST_F(MemberNames, StandBehindAHitAndAreMissedThereInABoxToo) {
  venue.Open();
  const auto lineOf = [this](std::int32_t member, bool useNickName) {
    venue.game.Players(Blue7).MemberIndex = member;
    return HitText("Blue  7", {Blue7, 30}, venue.game, *venue.Members, useNickName);
  };
  EXPECT_EQ(lineOf(7, true), "Blue  7:  30  (Mole)");
  EXPECT_EQ(lineOf(0, true), "Blue  7:  30");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(lineOf(-1, true), "Blue  7:  30");
  EXPECT_EQ(lineOf(5, false), "Blue  7:  30");
  EXPECT_EQ(venue.Boxes.Boxes.size(), 2U);
}

TEST_F(MemberNames, AppearInChineseBehindTheTeam) {
  ScoredGame chinese(Language::SimplifiedChinese);
  ExecuteSql(chinese.MembersFile(), "INSERT INTO Members (ContactID, NickName) VALUES (1, '小龙')");
  chinese.Activate(Blue7).MemberIndex = 1;
  chinese.CalculateScores();
  EXPECT_EQ(chinese.Cell(0, BoardColumn::Player), "蓝队  7: 小龙");
  EXPECT_EQ(chinese.game.Players(Blue7).Rank, 1);
}

}  // namespace
