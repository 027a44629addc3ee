#include "archive/KnownMembers.h"

#include <gmock/gmock.h>

#include "tests/archive/ArchiveVenue.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

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

  /// Numbers and games of those who are cut: "5:1".
  std::vector<std::string> Cut() {
    std::vector<std::string> texts;
    for (const CutMember& member : Archive->CheckMembers()) {
      texts.push_back(std::to_string(member.Number) + ":" + std::to_string(member.Games));
    }
    return texts;
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
  EXPECT_THAT(Cut(), IsEmpty());
  Archive->Keep(State());
  EXPECT_EQ(Mark(5), before);
  EXPECT_EQ(MembersIn(first), "6,5");
}

TEST_F(MembersOfGames, MayChangeTheirNameOrTheirButton) {
  InMembers("UPDATE Members SET FirstName = 'Bob', Birthdate = NULL WHERE ContactID = 5");
  EXPECT_THAT(Cut(), IsEmpty());
  InMembers("UPDATE Members SET DallasID = 'CC00000000000001' WHERE ContactID = 5");
  EXPECT_THAT(Cut(), IsEmpty());
  EXPECT_EQ(Mark(5).substr(0, 16), "CC00000000000001");
  EXPECT_EQ(MembersIn(first), "6,5");
}

TEST_F(MembersOfGames, MayBeWrittenInCapitals) {
  InMembers("UPDATE Members SET FirstName = ' CY', LastName = 'fox ' WHERE ContactID = 6");
  EXPECT_THAT(Cut(), IsEmpty());
}

TEST_F(MembersOfGames, MayChangeBothWhenTheChangesAreNoted) {
  InMembers("UPDATE Members SET FirstName = 'Bob' WHERE ContactID = 5");
  Archive->Known().NoteChanges();
  InMembers("UPDATE Members SET DallasID = 'CC00000000000001' WHERE ContactID = 5");
  Archive->Known().NoteChanges();
  EXPECT_THAT(Cut(), IsEmpty());
  EXPECT_EQ(MembersIn(first), "6,5");
}

TEST_F(MembersOfGames, StayInTheirGamesWhenTheyAreDeleted) {
  const std::string before = Mark(5);
  InMembers("DELETE FROM Members WHERE ContactID = 5");
  EXPECT_THAT(Cut(), IsEmpty());
  ++Game.Players(Red0).BonusPoints;
  Archive->KeepAgain(first, State(), FormerState::Replaced);
  EXPECT_EQ(MembersIn(first), "6,5");
  EXPECT_EQ(Mark(5), before);
}

TEST_F(MembersOfGames, AreCutWhereSomebodyElseHasTheirNumber) {
  Game.Players(Red0).MemberIndex = 0;
  const std::int64_t second = Archive->Keep(State());
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  EXPECT_THAT(Cut(), ElementsAre("5:2"));
  EXPECT_EQ(MembersIn(first), "6,0");
  EXPECT_EQ(MembersIn(second), "0,0");
  EXPECT_EQ(Query("SELECT group_concat(MemberID) FROM KnownMembers"), "6");
  EXPECT_THAT(Cut(), IsEmpty());
}

TEST_F(MembersOfGames, AreCutFromTheFilesOfAllStatesToo) {
  Game.Players(Blue7).MemberIndex = 6;  // only the first state has number 5
  Archive->KeepAgain(first, State(), FormerState::KeptToo);
  const ::Game untouched = Read(Archive->FileOf(first));
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  EXPECT_THAT(Cut(), ElementsAre("5:0"));
  const ::Game former = Read(Archive->FileOf(first, 1));
  EXPECT_EQ(former.Players(Blue7).MemberIndex, 0);
  EXPECT_EQ(former.Players(Red0).MemberIndex, 6);
  EXPECT_EQ(former.Players(Blue7).DallasID, BosButton);
  EXPECT_EQ(WriteGameFile(Read(Archive->FileOf(first)), "x"), WriteGameFile(untouched, "x"));
}

TEST_F(MembersOfGames, LeaveFilesThatAreFoundByTheirInputsAfterTheCut) {
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  EXPECT_THAT(Cut(), ElementsAre("5:1"));
  Game.Players(Blue7).MemberIndex = 0;
  EXPECT_EQ(Archive->Find(Game, State().Mission), first);
  EXPECT_EQ(Query("SELECT count(*) FROM Games JOIN GameFiles USING (GameID, InputsHash)"), "1");
}

TEST_F(MembersOfGames, AreCutFromSoundGamesThoughAFileIsDamaged) {
  ++Game.Players(Red0).BonusPoints;
  const std::int64_t second = Archive->Keep(State());
  InArchive("UPDATE sqlar SET data = x'00' WHERE name LIKE '%000001%'");
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  EXPECT_THAT(Cut(), ElementsAre("5:2"));
  EXPECT_EQ(Read(Archive->FileOf(second)).Players(Blue7).MemberIndex, 0);
}

TEST_F(MembersOfGames, AreCutAllOrNot) {
  InMembers("UPDATE Members SET DallasID = NULL, FirstName = 'Di' WHERE ContactID = 5");
  InArchive("CREATE TRIGGER Refuse BEFORE DELETE ON KnownMembers BEGIN SELECT RAISE(ABORT, 'no'); END");
  EXPECT_EQ(NumberThrownBy([this] { Cut(); }), 3317);
  EXPECT_EQ(MembersIn(first), "6,5");
  EXPECT_EQ(Read(Archive->FileOf(first)).Players(Blue7).MemberIndex, 5);
}

TEST_F(MembersOfGames, WithANumberThatNobodyHadAreCutOnceSomebodyHasIt) {
  Game.Players(Red0).MemberIndex = 70;
  const std::int64_t second = Archive->Keep(State());
  EXPECT_EQ(Mark(70), "|");
  EXPECT_THAT(Cut(), IsEmpty());
  InMembers("INSERT INTO Members (ContactID, FirstName) VALUES (70, 'Zoe')");
  EXPECT_THAT(Cut(), ElementsAre("70:1"));
  EXPECT_EQ(MembersIn(second), "0,5");
}

TEST_F(MembersOfGames, LeaveTheirNumbersToNoNewMember) {
  Game.Players(Red0).MemberIndex = 70;
  Archive->Keep(State());
  EXPECT_THAT(Cut(), IsEmpty());
  EXPECT_EQ(NextMember(), 71);
}

TEST_F(MembersOfGames, LeaveTheirNumbersToNoNewMemberAsSoonAsAGameIsKept) {
  Game.Players(Red0).MemberIndex = 70;
  Archive->Keep(State());
  EXPECT_EQ(NextMember(), 71);
}

TEST_F(MembersOfGames, AreNotThoseWhoGotANumberThatNobodyHad) {
  Game.Players(Red0).MemberIndex = 70;
  const std::int64_t second = Archive->Keep(State());
  InMembers("INSERT INTO Members (ContactID, FirstName) VALUES (70, 'Zoe')");
  Archive->Known().NoteChanges();
  EXPECT_THAT(Cut(), ElementsAre("70:1"));
  EXPECT_EQ(MembersIn(second), "0,5");
}

TEST_F(MembersOfGames, KeepTheirNumbersWhenTheMemberFileIsNew) {
  WriteFile(MembersPath(), MadeDatabase("members"));
  Open();
  EXPECT_THAT(Cut(), IsEmpty());
  EXPECT_EQ(NextMember(), 7);
  EXPECT_EQ(MembersIn(first), "6,5");
}

TEST_F(MembersOfGames, ChangeNothingInAMemberTableThatIsFarEnough) {
  MembersDatabase->BeforeChange([]() -> bool { throw std::runtime_error("a change"); });
  EXPECT_THAT(Cut(), IsEmpty());
}

}  // namespace
