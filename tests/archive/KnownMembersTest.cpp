#include "archive/KnownMembers.h"

#include <gtest/gtest.h>

#include <limits>

#include "archive/MemberCheck.h"
#include "core/game/MemberNumbers.h"
#include "tests/archive/ArchiveVenue.h"
#include "tests/support/Thrown.h"

namespace {

TEST(MemberMarks, AreOfOneMemberByButtonOrByPerson) {
  EXPECT_TRUE(IsSameMember({"AA", "bo"}, {"AA", "other"}));
  EXPECT_TRUE(IsSameMember({"AA", "bo"}, {"BB", "bo"}));
  EXPECT_FALSE(IsSameMember({"AA", "bo"}, {"BB", "other"}));
  EXPECT_FALSE(IsSameMember({"", "bo"}, {"", "other"}));
  EXPECT_FALSE(IsSameMember({"", ""}, {"", ""}));
}

class MembersOfGames : public testing::Test, protected ArchiveVenue {
 protected:
  MembersOfGames() {
    Game.Players(Red0).MemberIndex = 6;
    first = Archive->Keep(State());
  }

  std::string Mark(int number) const {
    return Query("SELECT DallasID || '|' || Digest FROM KnownMembers WHERE MemberID = " +
                 std::to_string(number));
  }

  std::string MembersIn(std::int64_t game) const {
    return Query("SELECT group_concat(MemberID) FROM GamePlayers WHERE GameID = " + std::to_string(game));
  }

  /// The numbers that are cut, and in how many games: "5 in 1".
  std::string Cut() {
    const MemberCheck::Parts parts{*ArchiveDatabase, *MembersDatabase, Strings};
    MemberCheck check(parts);
    while (check.Step(parts)) {
    }
    std::string text;
    for (const std::int32_t number : check.Strangers()) {
      text.append(std::to_string(number)).append(" ");
    }
    return text.empty() ? text : text + "in " + std::to_string(check.Games());
  }

  /// The numbers that a check finds that is interrupted before its first step, and that none before it found.
  std::string Found() {
    const MemberCheck check({*ArchiveDatabase, *MembersDatabase, Strings});
    std::string text;
    for (const std::int32_t number : check.NewStrangers()) {
      text.append(text.empty() ? "" : " ").append(std::to_string(number));
    }
    return text;
  }

  std::int64_t NextMember() {
    return MembersDatabase->Statements().Insert(
        "INSERT INTO Members (FirstName) VALUES ('New') RETURNING ContactID", {});
  }

  std::int64_t first = 0;
};

TEST_F(MembersOfGames, AreKnownByButtonAndDigestWithoutTheirNames) {
  EXPECT_EQ(Query("SELECT group_concat(MemberID) FROM KnownMembers"), "5,6");
  EXPECT_EQ(Mark(5).size(), 16U + 1 + 64);
  EXPECT_EQ(Mark(5).substr(0, 17), "BB00000000000001|");
  EXPECT_EQ(Mark(6).substr(0, 1), "|");
  const std::string bytes = ReadFile(ArchivePath());
  for (const char* name : {"Ray", "Mole", "1990"}) {
    EXPECT_EQ(bytes.find(name), std::string::npos) << name;
  }
}

TEST_F(MembersOfGames, HaveADigestThatDependsOnTheArchive) {
  ArchiveVenue other;
  other.Archive->Keep(other.State());
  EXPECT_NE(other.Query("SELECT Digest FROM KnownMembers WHERE MemberID = 5"),
            Query("SELECT Digest FROM KnownMembers WHERE MemberID = 5"));
  EXPECT_EQ(Query("SELECT count(*) FROM ArchiveKey"), "1");
}

TEST_F(MembersOfGames, StayTheSameInTheNextRun) {
  const std::string before = Mark(5);
  Open();
  EXPECT_EQ(Cut(), "");
  Archive->Keep(State());
  EXPECT_EQ(Mark(5), before);
  EXPECT_EQ(MembersIn(first), "6,5");
}

TEST_F(MembersOfGames, MayChangeTheirNameOrTheirButton) {
  InMembers("UPDATE Members SET FirstName = 'Bob', Birthdate = NULL WHERE ContactID = 5");
  EXPECT_EQ(Cut(), "");
  InMembers("UPDATE Members SET DallasID = 'CC00000000000001' WHERE ContactID = 5");
  EXPECT_EQ(Cut(), "");
  EXPECT_EQ(Mark(5).substr(0, 16), "CC00000000000001");
  EXPECT_EQ(MembersIn(first), "6,5");
}

TEST_F(MembersOfGames, MayBeWrittenInCapitals) {
  InMembers("UPDATE Members SET FirstName = ' CY', LastName = 'fox ' WHERE ContactID = 6");
  EXPECT_EQ(Cut(), "");
}

TEST_F(MembersOfGames, MayChangeBothWhenTheChangesAreNoted) {
  InMembers("UPDATE Members SET FirstName = 'Bob' WHERE ContactID = 5");
  Archive->Known().NoteChanges();
  InMembers("UPDATE Members SET DallasID = 'CC00000000000001' WHERE ContactID = 5");
  Archive->Known().NoteChanges();
  EXPECT_EQ(Cut(), "");
  EXPECT_EQ(MembersIn(first), "6,5");
}

TEST_F(MembersOfGames, StayInTheirGamesWhenTheyAreDeleted) {
  const std::string before = Mark(5);
  InMembers("DELETE FROM Members WHERE ContactID = 5");
  EXPECT_EQ(Cut(), "");
  ++Game.Players(Red0).BonusPoints;
  Archive->KeepAgain(first, State(), FormerState::Replaced);
  EXPECT_EQ(MembersIn(first), "6,5");
  EXPECT_EQ(Mark(5), before);
}

TEST_F(MembersOfGames, AreCutWhereSomebodyElseHasTheirNumber) {
  Game.Players(Red0).MemberIndex = 0;
  const std::int64_t second = Archive->Keep(State());
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  EXPECT_EQ(Cut(), "5 in 2");
  EXPECT_EQ(MembersIn(first), "6,0");
  EXPECT_EQ(MembersIn(second), "0,0");
  EXPECT_EQ(Query("SELECT group_concat(MemberID) FROM KnownMembers"), "6");
  EXPECT_EQ(Cut(), "");
}

TEST_F(MembersOfGames, AreCutFromTheFilesOfAllStatesToo) {
  Game.Players(Blue7).MemberIndex = 6;  // only the first state has number 5
  Archive->KeepAgain(first, State(), FormerState::KeptToo);
  const ::Game untouched = Read(Archive->FileOf(first));
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  EXPECT_EQ(Cut(), "5 in 1");
  const ::Game former = Read(Archive->FileOf(first, 1));
  EXPECT_EQ(former.Players(Blue7).MemberIndex, 0);
  EXPECT_EQ(former.Players(Red0).MemberIndex, 6);
  EXPECT_EQ(former.Players(Blue7).DallasID, BosButton);
  EXPECT_EQ(WriteGameFile(Read(Archive->FileOf(first)), "x"), WriteGameFile(untouched, "x"));
}

TEST_F(MembersOfGames, LeaveFilesThatAreFoundByTheirInputsAfterTheCut) {
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  EXPECT_EQ(Cut(), "5 in 1");
  Game.Players(Blue7).MemberIndex = 0;
  EXPECT_EQ(Archive->Find(Game, State().Mission), first);
  EXPECT_EQ(Query("SELECT count(*) FROM Games JOIN GameFiles USING (GameID, InputsHash)"), "1");
}

TEST_F(MembersOfGames, AreCutFromSoundGamesThoughAFileIsDamaged) {
  ++Game.Players(Red0).BonusPoints;
  const std::int64_t second = Archive->Keep(State());
  InArchive("UPDATE sqlar SET data = x'00' WHERE name LIKE '%000001%'");
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  EXPECT_EQ(Cut(), "5 in 2");
  EXPECT_EQ(Read(Archive->FileOf(second)).Players(Blue7).MemberIndex, 0);
}

TEST_F(MembersOfGames, AreStrangersUntilAllOfTheirGamesAreCut) {
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  InArchive("CREATE TRIGGER Refuse BEFORE UPDATE ON sqlar BEGIN SELECT RAISE(ABORT, 'no'); END");
  EXPECT_EQ(NumberThrownBy([this] { Cut(); }), 3317);
  EXPECT_EQ(MembersIn(first), "6,5");
  EXPECT_EQ(Read(Archive->FileOf(first)).Players(Blue7).MemberIndex, 5);
  InArchive(
      "DROP TRIGGER Refuse; CREATE TRIGGER Keep BEFORE DELETE ON KnownMembers BEGIN SELECT "
      "RAISE(ABORT, 'no'); END");
  EXPECT_EQ(NumberThrownBy([this] { Cut(); }), 3317);
  EXPECT_EQ(MembersIn(first), "6,0");
  InArchive("DROP TRIGGER Keep");
  EXPECT_EQ(Cut(), "5 in 0");
  EXPECT_EQ(Cut(), "");
}

TEST_F(MembersOfGames, AreCutAllInOneLookAtEachGame) {
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di'");
  EXPECT_EQ(Cut(), "5 6 in 1");
  EXPECT_EQ(MembersIn(first), "0,0");
  EXPECT_EQ(Query("SELECT count(*) FROM KnownMembers"), "0");
}

TEST_F(MembersOfGames, AreCutInShortSteps) {
  for (int i = 0; i < 40; ++i) {
    Archive->Keep(State());
  }
  InArchive("UPDATE sqlar SET data = randomblob(20000)");
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  const MemberCheck::Parts parts{*ArchiveDatabase, *MembersDatabase, Strings};
  MemberCheck check(parts);
  EXPECT_EQ(check.Done(), 0);
  std::vector<int> games;
  while (check.Step(parts)) {
    games.push_back(check.Games());
  }
  EXPECT_GE(games.size(), 20U);
  for (std::size_t step = 1; step < games.size(); ++step) {
    EXPECT_LE(games[step] - games[step - 1], 2);
  }
  EXPECT_EQ(check.Games(), 41);
  EXPECT_EQ(check.Done(), 1);
}

TEST_F(MembersOfGames, ThatAreKeptDuringACheckNameWhoHasTheNumberNow) {
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  const MemberCheck::Parts parts{*ArchiveDatabase, *MembersDatabase, Strings};
  MemberCheck check(parts);
  const std::string before = Mark(5);
  const std::int64_t second = Archive->Keep(State());
  EXPECT_EQ(Mark(5), before);  // or nobody would know any more that it changed hands
  Archive->Known().NoteChanges(check.Strangers());
  EXPECT_EQ(Mark(5), before);
  while (check.Step(parts)) {
  }
  EXPECT_EQ(MembersIn(first), "6,0");
  EXPECT_EQ(MembersIn(second), "6,5");
  EXPECT_NE(Mark(5), before);
  EXPECT_EQ(Cut(), "");
}

TEST_F(MembersOfGames, ThatAreKeptAfterACheckWasInterruptedNameWhoHasTheNumberNow) {
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  EXPECT_EQ(Found(), "5");
  const std::int64_t second = Archive->Keep(State());
  EXPECT_EQ(Found(), "");
  EXPECT_EQ(Cut(), "5 in 1");
  EXPECT_EQ(MembersIn(first), "6,0");
  EXPECT_EQ(MembersIn(second), "6,5");
  EXPECT_EQ(Read(Archive->FileOf(second)).Players(Blue7).MemberIndex, 5);
  EXPECT_EQ(Cut(), "");
  InMembers("UPDATE Members SET FirstName = 'Eve' WHERE ContactID = 5");
  EXPECT_EQ(Cut(), "5 in 1");
  EXPECT_EQ(MembersIn(second), "6,0");
}

TEST_F(MembersOfGames, AreCutToTheLastWhenTheNumberChangesHandsAgainInAnInterruptedCheck) {
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  EXPECT_EQ(Found(), "5");
  const std::int64_t second = Archive->Keep(State());
  InMembers("UPDATE Members SET FirstName = 'Eve' WHERE ContactID = 5");
  EXPECT_EQ(Found(), "5");
  const std::int64_t third = Archive->Keep(State());
  EXPECT_EQ(Cut(), "5 in 2");
  EXPECT_EQ(MembersIn(first), "6,0");
  EXPECT_EQ(MembersIn(second), "6,0");
  EXPECT_EQ(MembersIn(third), "6,5");
}

TEST_F(MembersOfGames, StayInTheGamesBeforeAnInterruptedCheckWhenTheyGetTheirNumberBack) {
  const std::string before = Mark(5);
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  EXPECT_EQ(Found(), "5");
  const std::int64_t second = Archive->Keep(State());
  InMembers("UPDATE Members SET DallasID = 'BB00000000000001', FirstName = 'Bo' WHERE ContactID = 5");
  EXPECT_EQ(Found(), "5");
  const std::int64_t third = Archive->Keep(State());
  EXPECT_EQ(Cut(), "5 in 1");
  EXPECT_EQ(MembersIn(first), "6,5");
  EXPECT_EQ(MembersIn(second), "6,0");
  EXPECT_EQ(MembersIn(third), "6,5");
  EXPECT_EQ(Mark(5), before);
  EXPECT_EQ(Cut(), "");
}

TEST_F(MembersOfGames, AreLookedForOnlyWhereAnInterruptedCheckHadNotBeen) {
  for (int i = 0; i < 10; ++i) {
    Archive->Keep(State());
  }
  InArchive("UPDATE sqlar SET data = randomblob(20000)");
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  {
    const MemberCheck::Parts parts{*ArchiveDatabase, *MembersDatabase, Strings};
    MemberCheck check(parts);
    EXPECT_TRUE(check.Step(parts));  // finds the games
    EXPECT_TRUE(check.Step(parts));
    EXPECT_EQ(check.Games(), 2);
  }
  // The operator chooses the new member in a game that is on the board again.
  InArchive("UPDATE GamePlayers SET MemberID = 5 WHERE GameID = 11 AND PlayerIndex = 40");
  EXPECT_EQ(Cut(), "5 in 9");
  EXPECT_EQ(MembersIn(10), "6,0");
  EXPECT_EQ(MembersIn(11), "6,5");
  EXPECT_EQ(Cut(), "");
}

TEST_F(MembersOfGames, WithANumberThatNobodyHadAreCutOnceSomebodyHasIt) {
  Game.Players(Red0).MemberIndex = 70;
  const std::int64_t second = Archive->Keep(State());
  EXPECT_EQ(Mark(70), "|");
  EXPECT_EQ(Cut(), "");
  InMembers("INSERT INTO Members (ContactID, FirstName) VALUES (70, 'Zoe')");
  EXPECT_EQ(Cut(), "70 in 1");
  EXPECT_EQ(MembersIn(second), "0,5");
}

TEST_F(MembersOfGames, LeaveTheirNumbersToNoNewMember) {
  Game.Players(Red0).MemberIndex = 70;
  Archive->Keep(State());
  EXPECT_EQ(Cut(), "");
  EXPECT_EQ(NextMember(), 71);
}

TEST_F(MembersOfGames, LeaveTheirNumbersToNoNewMemberAsSoonAsAGameIsKept) {
  Game.Players(Red0).MemberIndex = 70;
  Archive->Keep(State());
  EXPECT_EQ(NextMember(), 71);
}

TEST_F(MembersOfGames, HaveNoSayInTheNextNumberWhereTheirsIsImpossible) {
  const std::string before = std::to_string(NextMember());
  for (const std::int32_t number : {std::numeric_limits<std::int32_t>::max(), HighestMemberNumber + 1, -1,
                                    std::numeric_limits<std::int32_t>::min()}) {
    Game.Players(Red0).MemberIndex = number;
    Archive->Keep(State());
    EXPECT_EQ(Cut(), "");
  }
  EXPECT_EQ(std::to_string(NextMember() - 1), before);
  Game.Players(Red0).MemberIndex = HighestMemberNumber;
  Archive->Keep(State());
  EXPECT_EQ(NextMember(), HighestMemberNumber + 1);
}

TEST_F(MembersOfGames, AreNotThoseWhoGotANumberThatNobodyHad) {
  Game.Players(Red0).MemberIndex = 70;
  const std::int64_t second = Archive->Keep(State());
  InMembers("INSERT INTO Members (ContactID, FirstName) VALUES (70, 'Zoe')");
  Archive->Known().NoteChanges();
  EXPECT_EQ(Cut(), "70 in 1");
  EXPECT_EQ(MembersIn(second), "0,5");
}

TEST_F(MembersOfGames, KeepTheirNumbersWhenTheMemberFileIsNew) {
  WriteFile(MembersPath(), MadeDatabase("members"));
  Open();
  EXPECT_EQ(Cut(), "");
  EXPECT_EQ(NextMember(), 7);
  EXPECT_EQ(MembersIn(first), "6,5");
}

TEST_F(MembersOfGames, ChangeNothingInAMemberTableThatIsFarEnough) {
  MembersDatabase->BeforeChange([]() -> bool { throw std::runtime_error("a change"); });
  EXPECT_EQ(Cut(), "");
}

}  // namespace
