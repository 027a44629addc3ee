#include <gmock/gmock.h>

#include <fstream>

#include "archive/KeepingFailure.h"
#include "tests/archive/KeeperVenue.h"
#include "tests/support/FileSizeLimit.h"
#include "tests/support/OrdinaryUser.h"

namespace {

using testing::HasSubstr;
using testing::IsEmpty;

/// What becomes of the archive's file while it is in use.
class ArchiveInUse : public KeeperVenue {
 protected:
  std::string FreshPath() const { return venue.Folder / "games-new.mdb"; }
  static std::string GamesIn(const std::string& path) {
    return OtherConnection(path).Query("SELECT count(*) FROM Games");
  }

  /// The operator changes the game on the board.
  void Change() {
    ++session.Game().Players(Red0).BonusPoints;
    session.CalculateScores();
    keeper->Keep();
  }

  /// Leaves the header and the schema, so that it still opens.
  void Damage() const {
    constexpr std::streamoff changeCounter = 24;
    constexpr std::streamoff page = 4096;
    std::fstream file(ArchivePath(), std::ios::in | std::ios::out | std::ios::binary);
    file.seekp(changeCounter);
    file.put('\x7f');  // or what is in memory would be taken for what is in the file
    const auto size = static_cast<std::streamoff>(std::filesystem::file_size(ArchivePath()));
    file.seekp(page);
    file << std::string(static_cast<std::size_t>(size - page), 'x');
  }

  void ExpectKept() const {
    EXPECT_EQ(keeper->State().Failure, "");
    EXPECT_EQ(keeper->State().KeptAt, "14:30");
    EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  }
  void ExpectFailure(const std::string& part) const {
    EXPECT_THAT(keeper->State().Failure, HasSubstr(part));
    EXPECT_THAT(keeper->State().Failure, HasSubstr(ArchivePath()));
    EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  }
};

TEST_F(ArchiveInUse, ThatTurnsOutDamagedStaysAsItIsAndAnotherOneIsBegun) {
  Pull();
  Damage();
  const std::string damaged = ReadFile(ArchivePath());
  Change();
  ExpectKept();
  EXPECT_EQ(keeper->State().Unusable, ArchivePath());
  EXPECT_EQ(ReadFile(ArchivePath()), damaged);
  EXPECT_EQ(GamesIn(FreshPath()), "1");
  Change();
  ExpectKept();
  EXPECT_EQ(GamesIn(FreshPath()), "1");
}

TEST_F(ArchiveInUse, ThatTurnedOutDamagedIsLeftAloneInLaterRunsToo) {
  Pull();
  Damage();
  const std::string damaged = ReadFile(ArchivePath());
  Change();
  session.ClearPlayerData();
  Start();
  keeper->CheckMembers();
  EXPECT_EQ(keeper->State().Unusable, ArchivePath());
  Pull();
  ExpectKept();
  EXPECT_EQ(ReadFile(ArchivePath()), damaged);
  EXPECT_EQ(GamesIn(FreshPath()), "2");
}

TEST_F(ArchiveInUse, ThatTurnedOutDamagedIsUsedAgainOnceItIsSound) {
  Pull();
  const std::string sound = ReadFile(ArchivePath());
  Damage();
  Change();
  session.ClearPlayerData();
  WriteFile(ArchivePath(), sound);
  Start();
  Pull();
  ExpectKept();
  EXPECT_EQ(keeper->State().Unusable, "");
  EXPECT_EQ(Games(), "2");
}

TEST_F(ArchiveInUse, BesideADamagedOneIsGoneOnWithWhenThatIsTakenAway) {
  WriteFile(ArchivePath(), "damaged");
  Pull();
  std::filesystem::remove(ArchivePath());
  session.ClearPlayerData();
  Start();
  Pull();
  ExpectKept();
  EXPECT_EQ(keeper->State().Unusable, "");
  EXPECT_EQ(GamesIn(FreshPath()), "2");
  EXPECT_FALSE(ArchiveExists());
}

TEST_F(ArchiveInUse, ThatIsDamagedLikeTheOneBesideItIsNamedWithWhatToDo) {
  WriteFile(ArchivePath(), "damaged");
  WriteFile(FreshPath(), "damaged");
  Pull();
  EXPECT_THAT(keeper->State().Failure, HasSubstr(FreshPath() + " is damaged too. Move it"));
  std::filesystem::remove(FreshPath());
  keeper->Keep();
  ExpectKept();
}

TEST_F(ArchiveInUse, ThatWasDeletedIsBegunAnewWithTheGameOnTheBoard) {
  Pull();
  std::filesystem::remove(ArchivePath());
  Change();
  ExpectKept();
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(Query("SELECT count(*) FROM sqlar"), "1");
}

TEST_F(ArchiveInUse, ThatWasReplacedByACopyOfItselfHasTheGameOnce) {
  Pull();
  const std::string copy = ReadFile(ArchivePath());
  Change();
  WriteFile(venue.Folder / "other.mdb", copy);
  std::filesystem::rename(venue.Folder / "other.mdb", ArchivePath());
  Change();
  ExpectKept();
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(Query("SELECT Soldiering FROM GamePlayers WHERE PlayerIndex = 1"),
            std::to_string(session.Game().Players(Red0).Soldiering));
}

TEST_F(ArchiveInUse, ThatWasReplacedByAnOlderCopyGetsTheGameOnTheBoardAgain) {
  Pull();
  session.ClearPlayerData();
  const std::string copy = ReadFile(ArchivePath());
  Pull();
  Change();  // or it would be the first game
  EXPECT_EQ(Games(), "2");
  WriteFile(venue.Folder / "other.mdb", copy);
  std::filesystem::rename(venue.Folder / "other.mdb", ArchivePath());
  keeper->Keep();
  ExpectKept();
  EXPECT_EQ(Games(), "2");
  EXPECT_EQ(Query("SELECT Pulls FROM Games WHERE GameID = 2"), "1");
}

TEST_F(ArchiveInUse, ThatWasReplacedLeavesTheFiguresOfALoadedGame) {
  Pull();
  const std::string file = WriteGameFile(session.Game(), session.Missions().Text());
  const std::string soldiering = Query("SELECT Soldiering FROM GamePlayers WHERE PlayerIndex = 40");
  session.ClearPlayerData();
  session.Factors().Damage *= 3;
  Load(file);
  std::filesystem::copy_file(ArchivePath(), venue.Folder / "other.mdb");
  std::filesystem::rename(venue.Folder / "other.mdb", ArchivePath());
  keeper->Keep();
  ExpectKept();
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(Query("SELECT Soldiering FROM GamePlayers WHERE PlayerIndex = 40"), soldiering);
}

TEST_F(ArchiveInUse, ThatWasReplacedByAnotherVenuesKeepsTheGamesOfThat) {
  Pull();
  const std::string empty = MadeDatabase(
      "games",
      "INSERT INTO Games SELECT 1, '2012-01-01 10:00:00', '', 'Theirs', 'cable', 1, 0, 0, 0, 0, 0, 0, 1, 1, "
      "1, 1, 1, 1, 'hash', NULL");
  for (const bool inPlace : {true, false}) {
    if (inPlace) {
      WriteFile(ArchivePath(), empty);
    } else {
      WriteFile(venue.Folder / "other.mdb", empty);
      std::filesystem::rename(venue.Folder / "other.mdb", ArchivePath());
    }
    Change();
    ExpectKept();
    EXPECT_EQ(Games(), "2") << inPlace;
    EXPECT_EQ(Query("SELECT Mission FROM Games WHERE GameID = 1"), "Theirs") << inPlace;
    Change();
    EXPECT_EQ(Games(), "2") << inPlace;
  }
}

TEST_F(ArchiveInUse, WhoseFolderBecomesReadOnlyIsToldUntilItIsNot) {
  Pull();
  {
    const OrdinaryUser user;
    Change();
    ExpectFailure("cannot be written. Give yourself the right");
  }
  keeper->Keep();
  ExpectKept();
  EXPECT_EQ(Games(), "1");
}

TEST_F(ArchiveInUse, ThatIsReadOnlyIsToldUntilItIsNot) {
  Pull();
  session.ClearPlayerData();
  Start();
  {
    const OrdinaryUser user;
    Pull();
    ExpectFailure("cannot be written. Give yourself the right");
    EXPECT_EQ(keeper->State().KeptAt, "");
  }
  keeper->Keep();
  ExpectKept();
  EXPECT_EQ(Games(), "2");
}

TEST_F(ArchiveInUse, ThatIsReadOnlyIsToldUntilItIsNotEvenWithoutAGame) {
  Pull();
  {
    const OrdinaryUser user;
    Change();
    session.ClearPlayerData();
    keeper->Keep();
    ExpectFailure("cannot be written. Give yourself the right");
  }
  keeper->Keep();
  EXPECT_EQ(keeper->State(), KeptState());
  EXPECT_EQ(Query("SELECT count(*) FROM ArchiveKey"), "1");
}

TEST_F(ArchiveInUse, ThatIsReadOnlyIsToldThoughItCanBeRead) {
  Pull();
  session.ClearPlayerData();
  Start();
  {
    const OrdinaryUser user;
    Pull();
    keeper->CheckMembers();
    keeper->NoteMembers();
    EXPECT_FALSE(keeper->RemoveDeleted());
    ExpectFailure("cannot be written. Give yourself the right");
  }
  EXPECT_FALSE(keeper->RemoveDeleted());
  EXPECT_EQ(keeper->State().Failure, "");
}

TEST_F(ArchiveInUse, ThatIsLockedIsToldUntilItIsNotEvenWithoutAGame) {
  Pull();
  OtherConnection other(ArchivePath());
  other.Execute("BEGIN EXCLUSIVE");
  Change();
  ExpectFailure("Another program is using");
  session.ClearPlayerData();
  keeper->Keep();
  ExpectFailure("Another program is using");
  other.Execute("ROLLBACK");
  keeper->Keep();
  EXPECT_EQ(keeper->State(), KeptState());
}

TEST_F(ArchiveInUse, WhoseDiskIsFullKeepsTheFormerStateAndTellsIt) {
  Pull();
  const std::string before = Query("SELECT InputsHash FROM Games");
  {
    const FileSizeLimit limit(4096);
    Change();
    ExpectFailure("The disk has no room for");
  }
  EXPECT_EQ(Query("SELECT InputsHash FROM Games"), before);
  EXPECT_EQ(Query("PRAGMA integrity_check"), "ok");
  keeper->Keep();
  ExpectKept();
  EXPECT_NE(Query("SELECT InputsHash FROM Games"), before);
}

TEST_F(ArchiveInUse, CountsAPullOnceThatCouldNotBeKeptAtFirst) {
  disk.Space = 0;
  Pull();
  keeper->Keep();
  disk.Space = GameKeeper::LeastFreeSpace;
  keeper->Keep();
  ExpectKept();
  EXPECT_EQ(Query("SELECT Pulls FROM Games"), "1");
}

TEST_F(ArchiveInUse, KeepsADeletedGameAnewWhenItIsChanged) {
  Pull();
  ExecuteSql(ArchivePath(), "UPDATE Games SET Deleted = '2013-05-21 14:40:00'");
  keeper->Keep();
  EXPECT_EQ(Games(), "1");
  Change();
  EXPECT_EQ(Query("SELECT count(*) FROM Games WHERE Deleted IS NULL"), "1");
}

TEST(KeepingFailure, SaysWhatToDoInBothLanguages) {
  const std::string path = "/data/games.mdb";
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable strings(language);
    for (const int number : {3050, 3027, 3051, 70, 75, 3026, 61, 3343, 3043}) {
      const std::string text = KeepingFailureText(RuntimeError(number, "Fault: " + path), path, strings);
      EXPECT_THAT(text, HasSubstr(path)) << number;
      EXPECT_THAT(text, testing::Not(HasSubstr("Fault"))) << number;
    }
  }
}

TEST(KeepingFailure, OfAnotherFileIsToldAsItIs) {
  const StringTable strings(Language::English);
  EXPECT_EQ(KeepingFailureText(RuntimeError(3050, "Locked: /data/members.mdb"), "/data/games.mdb", strings),
            "Locked: /data/members.mdb");
  EXPECT_EQ(KeepingFailureText(RuntimeError(3000, "Odd: /data/games.mdb"), "/data/games.mdb", strings),
            "Odd: /data/games.mdb");
}

}  // namespace
