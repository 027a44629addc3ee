#include "archive/history/ForgetMember.h"

#include <gmock/gmock.h>

#include <filesystem>

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

  Forgotten Forget(std::int32_t number = 5) {
    return ForgetMember({.Engine = engine,
                         .Disk = disk,
                         .DbMembers = *MembersDatabase,
                         .Strings = Strings,
                         .UserDataFolder = Folder.Path()})
        .Forget(number);
  }

  /// Members and buttons of all files of games in a database, those of earlier states included.
  std::string InFiles(const std::string& path) const {
    SqliteEngine reader;
    const auto database = reader.OpenDatabase(path);
    GameArchive archive(*database, *MembersDatabase, Strings);
    std::string texts;
    for (std::int64_t game = 1; game <= 3; ++game) {
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

  SqliteEngine engine{std::chrono::milliseconds(30)};
  LinuxFiles disk;
};

TEST_F(ForgottenMember, StoodInFilesAndRows) {
  EXPECT_EQ(InFiles(ArchivePath()), "member button member button button member button ");
  EXPECT_NE(ReadFile(ArchivePath()).find(BosButton), std::string::npos);
  EXPECT_EQ(GamesNaming(ArchiveSql(), 5), 2);
}

TEST_F(ForgottenMember, IsCountedThroughAnIndex) {
  PlannedSql sql(ArchiveSql());
  GamesNaming(sql, 5);
  EXPECT_THAT(sql.Plan(), HasSubstr("USING COVERING INDEX GamePlayersByMember (MemberID=?)"));
}

TEST_F(ForgottenMember, StandsNowhereAnyMore) {
  const Forgotten forgotten = Forget();
  EXPECT_EQ(forgotten.Games, 2);
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
  EXPECT_EQ(Forget().Games, 4);
  for (const std::string& path : {copy, setAside}) {
    EXPECT_EQ(InFiles(path), "") << path;
    EXPECT_EQ(ReadFile(path).find(BosButton), std::string::npos) << path;
  }
}

TEST_F(ForgottenMember, NeedNotBeAMemberAnyMore) {
  InMembers("DELETE FROM Members WHERE ContactID = 5");
  EXPECT_EQ(Forget().Games, 2);
  EXPECT_EQ(InFiles(ArchivePath()), "");
}

TEST_F(ForgottenMember, IsToldOfAFileThatCannotBeChanged) {
  const std::string copy = CopyOfArchive();
  WriteFile(copy, std::string(4096, 'x'));
  const Forgotten forgotten = Forget();
  EXPECT_EQ(forgotten.Games, 2);
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

}  // namespace
