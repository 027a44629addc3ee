#include "archive/history/ForgetMember.h"

#include <gmock/gmock.h>

#include <filesystem>

#include "archive/ArchiveFile.h"
#include "archive/MemberCheck.h"
#include "platform/linux/LinuxFiles.h"
#include "tests/archive/history/HistoryVenue.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class ForgottenMember : public testing::Test, protected HistoryVenue {
 protected:
  ForgottenMember() {
    Keep("2026-10-01 20:00:00", 100);
    Keep("2026-10-02 20:00:00", 50);
    Delete(2);
    // An earlier state with Bo, whose place a guest has in the last one.
    const std::int64_t third = Keep("2026-10-03 20:00:00", 70);
    Game.Players(Blue7).MemberIndex = 0;
    ++Game.Players(Red0).HitByPlayer(Blue7);
    Archive->KeepAgain(third, State(), FormerState::KeptToo);
    std::filesystem::create_directory(Folder / "backups");
  }

  ForgetMember Forgetting(std::int32_t number) {
    return {{.Engine = engine,
             .Disk = disk,
             .DbMembers = *MembersDatabase,
             .Strings = Strings,
             .UserDataFolder = Folder.Path()},
            number};
  }

  /// How many games name the member, in any state.
  int Count(std::int32_t number = 5) {
    return Forgetting(number).CountGames([](const ForgetMember::State&) { return true; }).value_or(-1);
  }

  /// Counts and forgets; stops at the step `stopAt` of forgetting.
  Forgotten Forget(std::int32_t number = 5, int stopAt = -1) {
    ForgetMember forgetting = Forgetting(number);
    forgetting.CountGames([](const ForgetMember::State&) { return true; });
    int step = 0;
    return forgetting.Forget([&](const ForgetMember::State& state) {
      steps.push_back(state);
      return stopAt < 0 || ++step < stopAt;
    });
  }

  /// Members and buttons of all files of games in a database, those of earlier states included.
  std::string InFiles(const std::string& path) const {
    SqliteEngine reader;
    const auto database = reader.OpenDatabase(path);
    GameArchive archive(*database, *MembersDatabase, Strings);
    std::string texts;
    const std::int64_t games = WholeNumber(database->Statements(), "SELECT max(GameID) FROM Games");
    for (std::int64_t game = 1; game <= games; ++game) {
      for (std::int64_t state = 0; state <= archive.EarlierStates(game); ++state) {
        const ::Game read = Read(archive.FileOf(game, state));
        for (const Player& player : read.Players) {
          texts += player.MemberIndex == 5 ? "member " : "";
          texts += player.DallasID == BosButton ? "button " : "";
        }
      }
    }
    return texts;
  }

  std::string CopyOfArchive() const {
    std::string path = Folder / "backups/games-2026-10-05-200000.mdb";
    std::filesystem::copy_file(ArchivePath(), path);
    return path;
  }
  static std::string In(const std::string& path, const std::string& query) {
    return OtherConnection(path).Query(query);
  }
  std::vector<std::string> FilesInData() const { return disk.FileNames(Folder.Path()); }

  SqliteEngine engine{std::chrono::milliseconds(30)};
  LinuxFiles disk;
  std::vector<ForgetMember::State> steps;
};

TEST_F(ForgottenMember, StoodInFilesAndRows) {
  EXPECT_EQ(InFiles(ArchivePath()), "member button member button button member button ");
  EXPECT_NE(ReadFile(ArchivePath()).find(BosButton), std::string::npos);
}

TEST_F(ForgottenMember, IsCountedInGamesOfWhichAnyStateNamesHim) {
  EXPECT_EQ(Count(), 3);
  Game.Players(Blue7).DallasID = NoDallasId;
  Archive->Keep(State());
  EXPECT_EQ(Count(), 3);
  Game.Players(Blue7).DallasID = BosButton;  // a guest with his button
  Archive->Keep(State());
  EXPECT_EQ(Count(), 4);
  EXPECT_EQ(Count(6), 5);
}

TEST_F(ForgottenMember, IsCountedUntilItIsStopped) {
  std::vector<std::string> files;
  EXPECT_EQ(Forgetting(5).CountGames([&files](const ForgetMember::State& state) {
    EXPECT_TRUE(state.Counting);
    files.push_back(state.File);
    return false;
  }),
            std::nullopt);
  EXPECT_THAT(files, ElementsAre("games.mdb"));
  EXPECT_EQ(Query("SELECT count(*) FROM GamePlayers WHERE MemberID = 5"), "2");
}

TEST_F(ForgottenMember, StandsNowhereAnyMore) {
  const Forgotten forgotten = Forget();
  EXPECT_EQ(forgotten.Games, 3);
  EXPECT_FALSE(forgotten.Stopped);
  EXPECT_THAT(forgotten.Failures, IsEmpty());
  EXPECT_EQ(InFiles(ArchivePath()), "");
  EXPECT_EQ(Query("SELECT group_concat(DISTINCT MemberID) FROM GamePlayers"), "0,6");
  EXPECT_EQ(Query("SELECT group_concat(MemberID) FROM KnownMembers"), "6");
  EXPECT_EQ(ReadFile(ArchivePath()).find(BosButton), std::string::npos);
  EXPECT_FALSE(std::filesystem::exists(ArchivePath() + "-journal"));
}

TEST_F(ForgottenMember, LeavesTheFiguresAndTheOthers) {
  Forget();
  EXPECT_EQ(Query("SELECT Soldiering FROM GamePlayers WHERE GameID = 1 AND PlayerIndex = 40"), "100");
  EXPECT_EQ(Query("SELECT count(*) FROM GamePlayers WHERE MemberID = 6 AND DallasID = 'CC00000000000001'"),
            "3");
  const ::Game read = Read(Archive->FileOf(1));
  EXPECT_EQ(read.Players(Yellow3).MemberIndex, 6);
  EXPECT_EQ(read.Players(Yellow3).DallasID, CysButton);
  EXPECT_EQ(read.Players(Blue7).Soldiering, 100);
}

TEST_F(ForgottenMember, LeavesTheButtonWhereItIsAnotherMembers) {
  Game.Players(Blue7).MemberIndex = 6;
  const std::int64_t game = Archive->Keep(State());
  Forget();
  EXPECT_EQ(
      Query("SELECT DallasID FROM GamePlayers WHERE PlayerIndex = 40 AND GameID = " + std::to_string(game)),
      BosButton);
  EXPECT_EQ(Read(Archive->FileOf(game)).Players(Blue7).DallasID, BosButton);
}

TEST_F(ForgottenMember, IsFoundAgainByNoHash) {
  const ::Game before = Read(Archive->FileOf(1));
  ASSERT_EQ(Archive->Find(before, State().Mission), 1);
  Forget();
  EXPECT_EQ(Archive->Find(before, State().Mission), std::nullopt);
  EXPECT_EQ(Archive->Find(Read(Archive->FileOf(1)), State().Mission), 1);
}

TEST_F(ForgottenMember, GoesFromAllCopiesAndArchives) {
  const std::string copy = CopyOfArchive();
  const std::string setAside = Folder / "games-new.mdb";
  std::filesystem::copy_file(copy, setAside);
  EXPECT_EQ(Forget().Games, 6);
  for (const std::string& path : {copy, setAside}) {
    EXPECT_EQ(InFiles(path), "") << path;
    EXPECT_EQ(ReadFile(path).find(BosButton), std::string::npos) << path;
  }
}

TEST_F(ForgottenMember, NeedNotBeAMemberAnyMore) {
  InMembers("DELETE FROM Members WHERE ContactID = 5");
  EXPECT_EQ(Forget().Games, 3);
  EXPECT_EQ(InFiles(ArchivePath()), "");
}

TEST_F(ForgottenMember, IsToldOfAFileThatCannotBeChanged) {
  const std::string copy = CopyOfArchive();
  WriteFile(copy, std::string(4096, 'x'));
  const Forgotten forgotten = Forget();
  EXPECT_EQ(forgotten.Games, 3);
  EXPECT_THAT(forgotten.Failures,
              ElementsAre(HasSubstr("games-2026-10-05-200000.mdb still names the member: ")));
  EXPECT_EQ(InFiles(ArchivePath()), "");
}

TEST_F(ForgottenMember, StaysWholeInALockedFile) {
  OtherConnection other(ArchivePath());
  other.Execute("BEGIN IMMEDIATE");
  const Forgotten forgotten = Forget();
  other.Execute("COMMIT");
  EXPECT_THAT(forgotten.Failures, ElementsAre(HasSubstr("games.mdb still names the member: ")));
  EXPECT_EQ(Query("SELECT count(*) FROM GamePlayers WHERE MemberID = 5"), "2");
  EXPECT_NE(InFiles(ArchivePath()), "");
}

TEST_F(ForgottenMember, OfNoArchiveIsNothing) {
  std::filesystem::remove(ArchivePath());
  const Forgotten forgotten = Forget();
  EXPECT_EQ(forgotten.Games, 0);
  EXPECT_THAT(forgotten.Failures, IsEmpty());
}

TEST_F(ForgottenMember, GoesFromGamesThatKnowOnlyTheButtonOfToday) {
  InMembers("UPDATE Members SET DallasID = 'DD00000000000001' WHERE ContactID = 5");
  Archive->Known().NoteChanges();
  Game.Players(Blue7).DallasID = "DD00000000000001";  // nobody's number, as he was entered later
  const std::int64_t game = Archive->Keep(State());
  const std::string copy = CopyOfArchive();
  EXPECT_EQ(Forget().Games, 4);
  for (const std::string& path : {ArchivePath(), copy}) {
    EXPECT_EQ(In(path, "SELECT DallasID FROM GamePlayers WHERE PlayerIndex = 40 AND GameID = " +
                           std::to_string(game)),
              NoDallasId)
        << path;
    EXPECT_EQ(ReadFile(path).find("DD00000000000001"), std::string::npos) << path;
  }
}

TEST_F(ForgottenMember, GoesUnderTheNumberThatHeHadInAnOldCopy) {
  const std::string copy = CopyOfArchive();
  OtherConnection(copy).Execute(
      "UPDATE GamePlayers SET MemberID = 50 WHERE MemberID = 5; UPDATE KnownMembers SET MemberID = 50, "
      "DallasID = 'EE00000000000001' WHERE MemberID = 5");
  InArchive("UPDATE GamePlayers SET DallasID = 'EE00000000000001' WHERE GameID = 3 AND PlayerIndex = 40");
  Forget();
  EXPECT_EQ(In(copy, "SELECT count(*) FROM GamePlayers WHERE MemberID = 50"), "0");
  EXPECT_EQ(In(copy, "SELECT group_concat(MemberID) FROM KnownMembers"), "6");
  // What the copy told of his button is used in the archive too.
  EXPECT_EQ(Query("SELECT DallasID FROM GamePlayers WHERE GameID = 3 AND PlayerIndex = 40"), NoDallasId);
  EXPECT_EQ(Query("SELECT count(*) FROM GamePlayers WHERE MemberID = 6"), "3");
}

TEST_F(ForgottenMember, IsNotHeWhoHadTheButtonBefore) {
  InMembers("UPDATE Members SET DallasID = 'AA00000000000009' WHERE ContactID = 6");
  const std::string copy = CopyOfArchive();
  OtherConnection(copy).Execute(
      "UPDATE KnownMembers SET DallasID = 'BB00000000000001' WHERE MemberID = 6;"
      "UPDATE KnownMembers SET DallasID = '' WHERE MemberID = 5");
  Forget();
  EXPECT_EQ(In(copy, "SELECT count(*) FROM GamePlayers WHERE MemberID = 6"), "3");
  EXPECT_EQ(In(copy, "SELECT group_concat(MemberID) FROM KnownMembers"), "6");
}

TEST_F(ForgottenMember, LeavesGuestsTheButtonThatIsAnotherMembersToday) {
  Game.Players(Blue7).MemberIndex = 5;  // played with the button that is Cy's
  Game.Players(Blue7).DallasID = CysButton;
  Archive->Keep(State());
  Game.Players(Blue7).MemberIndex = 0;
  const std::int64_t guests = Archive->Keep(State());
  InMembers(std::string("UPDATE Members SET DallasID = '") + CysButton + "' WHERE ContactID = 6");
  Forget();
  EXPECT_EQ(
      Query("SELECT DallasID FROM GamePlayers WHERE PlayerIndex = 40 AND GameID = " + std::to_string(guests)),
      CysButton);
}

TEST_F(ForgottenMember, LeavesADamagedArchiveSetAside) {
  std::filesystem::copy_file(ArchivePath(), Folder / "games-new.mdb");
  ASSERT_TRUE(SetArchiveAside(disk, ArchivePath()));
  EXPECT_THAT(Forget().Failures, IsEmpty());
  EXPECT_EQ(InFiles(ArchivePath()), "");
  EXPECT_TRUE(IsArchiveSetAside(disk, ArchivePath()));
}

TEST_F(ForgottenMember, IsToldOfADamagedArchiveThatCannotBeChanged) {
  std::filesystem::copy_file(ArchivePath(), Folder / "games-new.mdb");
  WriteFile(ArchivePath(), std::string(8192, 'x'));
  const Forgotten forgotten = Forget();
  EXPECT_EQ(forgotten.Games, 3);
  EXPECT_THAT(forgotten.Failures, ElementsAre(HasSubstr("games.mdb still names the member: ")));
  EXPECT_EQ(InFiles(Folder / "games-new.mdb"), "");
}

TEST_F(ForgottenMember, IsToldOfAnArchiveThatIsDamagedInside) {
  std::filesystem::copy_file(ArchivePath(), Folder / "games-new.mdb");
  const int page = std::stoi(Query("SELECT rootpage FROM sqlite_master WHERE name = 'GamePlayersByMember'"));
  constexpr int pageSize = 4096;
  std::string bytes = ReadFile(ArchivePath());
  bytes.replace(static_cast<std::size_t>((page - 1) * pageSize), pageSize, pageSize, 'x');
  WriteFile(ArchivePath(), bytes);
  ASSERT_TRUE(SetArchiveAside(disk, ArchivePath()));
  const Forgotten forgotten = Forget();
  EXPECT_EQ(forgotten.Games, 3);
  EXPECT_THAT(forgotten.Failures, ElementsAre(HasSubstr("games.mdb still names the member: ")));
  EXPECT_EQ(InFiles(Folder / "games-new.mdb"), "");
  EXPECT_TRUE(IsArchiveSetAside(disk, ArchivePath()));
}

TEST_F(ForgottenMember, GoesFromWhatKilledCommandsLeft) {
  for (const char* left : {"games.mdb.restored", "games-new.mdb.restored", "games.mdb.rewritten",
                           "ranking.html", "backups/games.part"}) {
    WriteFile(Folder / left, BosButton);
  }
  EXPECT_THAT(Forget().Failures, IsEmpty());
  EXPECT_THAT(FilesInData(), ElementsAre("games.mdb", "members.mdb"));
  EXPECT_THAT(disk.FileNames(Folder / "backups"), IsEmpty());
}

TEST_F(ForgottenMember, IsForgottenInStepsThatTellHowFarItIs) {
  CopyOfArchive();
  Forget();
  ASSERT_GE(steps.size(), 4U);
  EXPECT_EQ(steps.front().File, "games-2026-10-05-200000.mdb");
  EXPECT_EQ(steps.back().File, "games.mdb");
  for (std::size_t i = 1; i < steps.size(); ++i) {
    EXPECT_GE(steps[i].Done, steps[i - 1].Done);
  }
  EXPECT_GT(steps.back().Done, 0.8);
  EXPECT_LE(steps.back().Done, 1);
}

TEST_F(ForgottenMember, IsForgottenTheNextTimeWhereverItWasStopped) {
  InMembers("DELETE FROM Members WHERE ContactID = 5");
  Game.Players(Blue7).MemberIndex = 5;
  for (int i = 0; i < 40; ++i) {
    Archive->Keep(State());
  }
  const std::string copy = CopyOfArchive();
  const std::string whole = ReadFile(copy);
  bool isStopped = true;
  int stops = 0;
  for (; isStopped; ++stops) {
    WriteFile(copy, whole);
    WriteFile(ArchivePath(), whole);
    const Forgotten forgotten = Forget(5, stops + 1);
    isStopped = forgotten.Stopped;
    EXPECT_EQ(isStopped, !forgotten.Failures.empty());
    if (isStopped) {
      EXPECT_THAT(forgotten.Failures.back(), HasSubstr("games.mdb may still name the member"));
      EXPECT_EQ(Query("SELECT count(*) FROM KnownMembers WHERE MemberID = 5"), "1");
      EXPECT_THAT(Forget().Failures, IsEmpty());
    }
    for (const std::string& path : {copy, ArchivePath()}) {
      EXPECT_EQ(InFiles(path), "") << stops;
      EXPECT_EQ(ReadFile(path).find(BosButton), std::string::npos) << stops;
      EXPECT_EQ(In(path, "SELECT group_concat(MemberID) FROM KnownMembers"), "6") << stops;
    }
    EXPECT_THAT(FilesInData(), ElementsAre("games.mdb", "members.mdb"));
  }
  EXPECT_GE(stops, 6);
}

TEST_F(ForgottenMember, WhoPlaysAgainAfterAStopStaysInTheNewGames) {
  Game.Players(Blue7).MemberIndex = 5;
  for (int i = 0; i < 40; ++i) {
    Archive->Keep(State());
  }
  int stopAt = 1;
  for (; Query("SELECT count(*) FROM GamePlayers WHERE MemberID = 5") != "0"; ++stopAt) {
    Forget(5, stopAt);
  }
  Open();
  const std::int64_t game = Archive->Keep(State());
  const MemberCheck::Parts parts{*ArchiveDatabase, *MembersDatabase, Strings};
  EXPECT_TRUE(MemberCheck(parts).Strangers().empty());
  EXPECT_EQ(Query("SELECT max(MemberID) FROM GamePlayers WHERE PlayerIndex = 40 AND GameID = " +
                  std::to_string(game)),
            "5");
}

TEST_F(ForgottenMember, IsNotEveryGuestWhoseFileToldNoButton) {
  Game.Players(Blue7).MemberIndex = 5;
  Game.Players(Blue7).DallasID = "0";
  Archive->Keep(State());
  Game.Players(Blue7).MemberIndex = 0;
  const std::int64_t guests = Archive->Keep(State());
  InArchive("UPDATE GamePlayers SET GuestName = 'Ann' WHERE PlayerIndex = 40 AND GameID = " +
            std::to_string(guests));
  EXPECT_EQ(Count(), 4);
  EXPECT_EQ(Forget().Games, 4);
  EXPECT_EQ(Query("SELECT GuestName FROM GamePlayers WHERE PlayerIndex = 40 AND GameID = " +
                  std::to_string(guests)),
            "Ann");
}

TEST_F(ForgottenMember, NeedsRoomOnTheDisk) {
  class FullDisk : public LinuxFiles {
   public:
    std::uint64_t FreeSpace(const std::string& /*path*/) const override { return 1000; }
  } full;
  ForgetMember forgetting({.Engine = engine,
                           .Disk = full,
                           .DbMembers = *MembersDatabase,
                           .Strings = Strings,
                           .UserDataFolder = Folder.Path()},
                          5);
  forgetting.CountGames([](const ForgetMember::State&) { return true; });
  const Forgotten forgotten = forgetting.Forget([](const ForgetMember::State&) { return true; });
  EXPECT_THAT(forgotten.Failures, ElementsAre(HasSubstr(Strings.Text(OwnText::KeeperDiskFull))));
  EXPECT_NE(InFiles(ArchivePath()), "");
}

}  // namespace
