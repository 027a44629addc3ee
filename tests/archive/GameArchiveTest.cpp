#include <gmock/gmock.h>

#include "archive/Entries.h"
#include "tests/archive/ArchiveVenue.h"
#include "tests/support/FileSizeLimit.h"
#include "tests/support/Thrown.h"

namespace {

using testing::HasSubstr;

class Keeping : public testing::Test, protected ArchiveVenue {
 protected:
  /// Everything in the archive, as one text.
  std::string Everything() const {
    return Query(
        "SELECT (SELECT group_concat(quote(name) || sz) FROM sqlar) || "
        "(SELECT group_concat(GameID || InputsHash) FROM Games) || "
        "(SELECT group_concat(GameID || '/' || PlayerIndex) FROM GamePlayers) || "
        "(SELECT group_concat(Name || InputsHash) FROM GameFiles)");
  }

  /// The game again with other inputs.
  void ChangeInputs() { ++Game.Players(Red0).BonusPoints; }
};

TEST_F(Keeping, WritesTheGamesRow) {
  GameState state = State();
  state.Source = GameSource::Radio;
  state.Pulls = 2;
  state.Factors = {1.5, -2, -3, 0.5, 4, -0.25};
  EXPECT_EQ(Archive->Keep(state), 1);
  EXPECT_EQ(Query("SELECT Played || '|' || DateText || '|' || Mission || '|' || Source FROM Games"),
            "2026-11-21 20:15:30|21.11.2026 20:15|Capture <the> Flag|radio");
  EXPECT_EQ(
      Query("SELECT Pulls || '|' || Players || '|' || Committed || '|' || RedTotal || '|' || BlueTotal || "
            "'|' || YellowTotal || '|' || BestPlayer || '|' || quote(Deleted) FROM Games"),
      "2|2|1|-4|250|0|40|NULL");
  EXPECT_EQ(
      Query("SELECT DamageFactor || '|' || DeathFactor || '|' || HealFactor || '|' || AmmoFactor || '|' || "
            "AccuracyFactor || '|' || FriendlyFireFactor FROM Games"),
      "1.5|-2.0|-3.0|0.5|4.0|-0.25");
}

TEST_F(Keeping, WritesARowForEachPlayer) {
  Archive->Keep(State());
  EXPECT_EQ(Query("SELECT count(*) FROM GamePlayers"), "2");
  const std::string row =
      "SELECT MemberID || '|' || DallasID || '|' || Place || '|' || Soldiering || '|' || ifnull(Accuracy, "
      "'-') "
      "|| '|' || DamageDealt || '|' || DamageTaken || '|' || Shots || '|' || Wia || '|' || Kia || '|' || "
      "AmmoAdds || '|' || Committed FROM GamePlayers WHERE GameID = 1 AND PlayerIndex = ";
  EXPECT_EQ(Query(row + "40"), "5|BB00000000000001|1|250|0.25|120|0|40|0|0|0|1");
  EXPECT_EQ(Query(row + "1"), "0|0000000000000000|2|-4|-|0|120|0|2|3|1|0");
}

TEST_F(Keeping, StoresTheGameFileAsItWouldBeSaved) {
  const std::int64_t game = Archive->Keep(State());
  const std::string bytes = WriteGameFile(Game, "Capture <the> Flag");
  EXPECT_EQ(Archive->FileOf(game), bytes);
  EXPECT_EQ(Query("SELECT name || '|' || mode || '|' || sz FROM sqlar"),
            "2026-11-21/2015-000001.game.xml|33188|" + std::to_string(bytes.size()));
  EXPECT_EQ(Query("SELECT mtime FROM sqlar"), std::to_string(SecondsOf("2026-11-21 20:15:30")));
}

TEST_F(Keeping, GivesEachGameANumberOfItsOwn) {
  EXPECT_EQ(Archive->Keep(State()), 1);
  ChangeInputs();
  EXPECT_EQ(Archive->Keep(State()), 2);
  InArchive("DELETE FROM Games");
  EXPECT_EQ(Archive->Keep(State("2026-11-22 09:00:00")), 3);
  EXPECT_EQ(Query("SELECT count(*) FROM sqlar"), "3");
}

TEST_F(Keeping, TakesAnEmptyGameAndAFullOne) {
  for (Player& player : Game.Players) {
    player.Clear();
  }
  Archive->Keep(State());
  EXPECT_EQ(Query("SELECT Players || '|' || BestPlayer FROM Games WHERE GameID = 1"), "0|0");
  FillRandomly(Game, PlayerCount, 3);
  const std::int64_t full = Archive->Keep(State());
  EXPECT_EQ(Query("SELECT count(*) FROM GamePlayers WHERE GameID = 2"), "224");
  EXPECT_EQ(Archive->FileOf(full), WriteGameFile(Game, "Capture <the> Flag"));
}

TEST_F(Keeping, AgainReplacesRowsAndFile) {
  const std::int64_t game = Archive->Keep(State());
  Game.Players(Red0).Active = false;
  Game.Players(Yellow3).Active = true;
  Game.Players(Yellow3).Soldiering = 900;
  GameState later = State("2030-01-01 00:00:00");
  later.Source = GameSource::Radio;
  later.Mission = "None";
  EXPECT_TRUE(Archive->KeepAgain(game, later, FormerState::Replaced));
  EXPECT_EQ(Query("SELECT count(*) || '|' || Played || '|' || Source || '|' || Mission || '|' || BestPlayer "
                  "FROM Games"),
            "1|2026-11-21 20:15:30|cable|None|68");
  EXPECT_EQ(Query("SELECT group_concat(PlayerIndex) FROM GamePlayers"), "40,68");
  EXPECT_EQ(Query("SELECT group_concat(name) FROM sqlar"), "2026-11-21/2015-000001.game.xml");
  EXPECT_EQ(Archive->FileOf(game), WriteGameFile(Game, "None"));
  EXPECT_EQ(Archive->EarlierStates(game), 0);
}

TEST_F(Keeping, AgainCanLeaveTheFormerStatesAsFurtherFilesOfTheGame) {
  std::vector<std::string> files;
  const std::int64_t game = Archive->Keep(State());
  for (int pull = 2; pull <= 4; ++pull) {
    files.push_back(WriteGameFile(Game, State().Mission));
    ChangeInputs();
    GameState state = State();
    state.Pulls = pull;
    EXPECT_TRUE(Archive->KeepAgain(game, state, FormerState::KeptToo));
  }
  EXPECT_EQ(Query("SELECT count(*) || '|' || Pulls FROM Games"), "1|4");
  EXPECT_EQ(Archive->EarlierStates(game), 3);
  EXPECT_EQ(Query("SELECT group_concat(name) FROM (SELECT name FROM sqlar ORDER BY name)"),
            "2026-11-21/2015-000001-1.game.xml,2026-11-21/2015-000001-2.game.xml,"
            "2026-11-21/2015-000001-3.game.xml,2026-11-21/2015-000001.game.xml");
  for (int state = 1; state <= 3; ++state) {
    EXPECT_EQ(Archive->FileOf(game, state), files[static_cast<std::size_t>(state - 1)]) << state;
  }
  EXPECT_EQ(Archive->FileOf(game), WriteGameFile(Game, State().Mission));
}

TEST_F(Keeping, AgainWithEqualInputsLeavesNoFurtherFile) {
  const std::int64_t game = Archive->Keep(State());
  Game.Players(Blue7).Rank = 2;
  EXPECT_TRUE(Archive->KeepAgain(game, State(), FormerState::KeptToo));
  EXPECT_EQ(Archive->EarlierStates(game), 0);
  EXPECT_EQ(Archive->FileOf(game), WriteGameFile(Game, State().Mission));
}

TEST_F(Keeping, AgainWhatIsGoneChangesNothing) {
  Archive->Keep(State());
  const std::string before = Everything();
  ChangeInputs();
  EXPECT_FALSE(Archive->KeepAgain(7, State(), FormerState::KeptToo));
  EXPECT_EQ(Everything(), before);
}

TEST_F(Keeping, IsDoneWholeOrNotAtAll) {
  const std::int64_t game = Archive->Keep(State());
  const std::string before = Everything();
  FillRandomly(Game, PlayerCount, 5);
  {
    const FileSizeLimit full(std::filesystem::file_size(ArchivePath()));
    EXPECT_EQ(NumberThrownBy([&] { Archive->Keep(State()); }), 3026);
    EXPECT_EQ(NumberThrownBy([&] { Archive->KeepAgain(game, State(), FormerState::KeptToo); }), 3026);
  }
  EXPECT_EQ(Everything(), before);
  EXPECT_EQ(Archive->Keep(State()), 2);
}

TEST_F(Keeping, FailsWithTheDatabasesNumbersAndGoesOnAfterwards) {
  {
    OtherConnection other(ArchivePath());
    other.Execute("BEGIN IMMEDIATE");
    EXPECT_EQ(NumberThrownBy([&] { Archive->Keep(State()); }), 3050);
    other.Execute("COMMIT");
  }
  InArchive("CREATE TRIGGER Refuse BEFORE INSERT ON sqlar BEGIN SELECT RAISE(ABORT, 'no'); END");
  EXPECT_EQ(NumberThrownBy([&] { Archive->Keep(State()); }), 3317);
  EXPECT_EQ(Query("SELECT count(*) FROM Games"), "0");
  EXPECT_EQ(Query("SELECT count(*) FROM KnownMembers"), "0");
  InArchive("DROP TRIGGER Refuse");
  EXPECT_EQ(Archive->Keep(State()), 1);
}

class Finding : public Keeping {};

TEST_F(Finding, KnowsAGameByItsInputs) {
  EXPECT_EQ(Archive->Find(Game, State().Mission), std::nullopt);
  const std::int64_t game = Archive->Keep(State());
  const ::Game loaded = Read(Archive->FileOf(game));
  EXPECT_EQ(Archive->Find(loaded, State().Mission), game);
  EXPECT_EQ(Archive->Find(loaded, "None"), std::nullopt);
  Game.Players(Blue7).Rank = 9;
  Game.Players(Blue7).Soldiering = 9;
  EXPECT_EQ(Archive->Find(Game, State().Mission), game);
  ChangeInputs();
  EXPECT_EQ(Archive->Find(Game, State().Mission), std::nullopt);
}

TEST_F(Finding, KnowsAnEarlierStateAsThatGame) {
  const ::Game first = Game;
  const std::int64_t game = Archive->Keep(State());
  ChangeInputs();
  Archive->KeepAgain(game, State(), FormerState::KeptToo);
  EXPECT_EQ(Archive->Find(first, State().Mission), game);
  EXPECT_EQ(Archive->Find(Game, State().Mission), game);
}

TEST_F(Finding, ForgetsAStateThatWasReplaced) {
  const ::Game first = Game;
  const std::int64_t game = Archive->Keep(State());
  ChangeInputs();
  Archive->KeepAgain(game, State(), FormerState::Replaced);
  EXPECT_EQ(Archive->Find(first, State().Mission), std::nullopt);
}

TEST_F(Finding, DoesNotTrustTheHashAlone) {
  const std::int64_t first = Archive->Keep(State());
  ChangeInputs();
  const std::int64_t second = Archive->Keep(State());
  InArchive("UPDATE GameFiles SET InputsHash = (SELECT InputsHash FROM GameFiles WHERE GameID = 2)");
  EXPECT_EQ(Archive->Find(Game, State().Mission), second);
  EXPECT_NE(first, second);
}

TEST_F(Finding, TakesAGameWithOtherFiguresForTheSame) {
  const std::int64_t first = Archive->Keep(State());
  EXPECT_EQ(Archive->Find(Game, State().Mission), first);
  Game.Players(Blue7).Soldiering += 1;  // calculated
  EXPECT_EQ(Archive->Find(Game, State().Mission), first);
}

TEST_F(Finding, PassesDeletedGamesAndDamagedFiles) {
  Archive->Keep(State());
  InArchive("UPDATE Games SET Deleted = '2026-12-01 00:00:00'");
  EXPECT_EQ(Archive->Find(Game, State().Mission), std::nullopt);
  InArchive("UPDATE Games SET Deleted = NULL; UPDATE sqlar SET data = x'00'");
  EXPECT_EQ(Archive->Find(Game, State().Mission), std::nullopt);
}

class FindingAlike : public Finding {
 protected:
  /// The game has two states; the earlier one has that date text and is given back.
  ::Game KeepTwoStates(const std::string& date) {
    Game.GameDate = date;
    const ::Game earlier = Game;
    const std::int64_t game = Archive->Keep(State());
    Game.GameDate = "21.11.2026 20:40";
    ChangeInputs();
    Archive->KeepAgain(game, State(), FormerState::KeptToo);
    return earlier;
  }
  /// The number of the state; -1 if none is found. `Compared` tells how many files were read for that.
  std::int64_t StateLike(const ::Game& game) {
    Compared = 0;
    const auto found = Archive->FindAlike(game, State().Mission, State().Played, GameArchive::Among::Listed,
                                          [this] { ++Compared; });
    return found ? found->State : -1;
  }

  int Compared = 0;
};

TEST_F(FindingAlike, KnowsAnEarlierStateWhoeverPlayed) {
  ::Game sought = KeepTwoStates("21.11.2026 20:15");
  sought.Players(Blue7).MemberIndex = 99;
  EXPECT_EQ(StateLike(sought), 1);
  EXPECT_EQ(Compared, 1);
  ++sought.Players(Blue7).BonusPoints;
  EXPECT_EQ(StateLike(sought), -1);
  EXPECT_EQ(Compared, 1);
}

TEST_F(FindingAlike, DoesNotReadEarlierStatesOfAnotherDate) {
  ::Game sought = KeepTwoStates("21.11.2026 20:15");
  sought.GameDate = "21.11.2026 20:16";
  EXPECT_EQ(StateLike(sought), -1);
  EXPECT_EQ(Compared, 0);
}

TEST_F(FindingAlike, ReadsEarlierStatesWhoseDateIsWrittenOtherwise) {
  ::Game sought = KeepTwoStates("<21> & 11");
  sought.Players(Blue7).MemberIndex = 99;
  EXPECT_EQ(StateLike(sought), 1);
}

TEST_F(FindingAlike, ReadsEarlierStatesWhoseDateStandsFarBehind) {
  ::Game sought = KeepTwoStates(std::string(5000, 'x'));
  sought.Players(Blue7).MemberIndex = 99;
  EXPECT_EQ(StateLike(sought), 1);
}

class ReadingBack : public Keeping {
 protected:
  Thrown Failure() {
    return ThrownBy([this] { Archive->FileOf(1); });
  }
};

TEST_F(ReadingBack, SaysThatThereIsNoSuchFile) {
  EXPECT_EQ(Failure().Number, 53);
  EXPECT_EQ(Failure().Text, "Past games hold no file of game 1.");
}

TEST_F(ReadingBack, SaysThatAFileIsDamaged) {
  Archive->Keep(State());
  for (const char* damage : {"data = x'789c00'", "data = NULL", "data = zeroblob(50)", "sz = sz + 1",
                             "sz = -1", "sz = NULL", "name = 'x'"}) {
    OtherConnection other(ArchivePath());
    InArchive("CREATE TABLE IF NOT EXISTS Sound AS SELECT * FROM sqlar");
    other.Execute(std::string("UPDATE sqlar SET ") + damage);
    EXPECT_EQ(Failure().Number, 321) << damage;
    EXPECT_EQ(Failure().Text, "The file 2026-11-21/2015-000001.game.xml among the past games is damaged.");
    other.Execute("DELETE FROM sqlar; INSERT INTO sqlar SELECT * FROM Sound");
  }
  EXPECT_EQ(Failure().Number, 0);
}

TEST_F(ReadingBack, RefusesWhatIsTooLarge) {
  Archive->Keep(State());
  InArchive("UPDATE sqlar SET sz = 1073741824");
  EXPECT_EQ(Failure().Number, 321);
  EXPECT_EQ(Failure().Text,
            "The file 2026-11-21/2015-000001.game.xml among the past games is larger than 32 MB.");
  InArchive("UPDATE sqlar SET sz = 10, data = zeroblob(33554433)");
  EXPECT_THAT(Failure().Text, HasSubstr("larger than 32 MB"));
}

TEST_F(ReadingBack, TakesAFileThatIsNotDeflated) {
  Archive->Keep(State());
  InArchive("UPDATE sqlar SET data = CAST('<GameData/>' AS BLOB), sz = 11");
  EXPECT_EQ(Archive->FileOf(1), "<GameData/>");
}

}  // namespace
