#include <gmock/gmock.h>

#include "archive/ArchiveAccess.h"
#include "archive/GuestRows.h"
#include "tests/archive/Forgetting.h"
#include "tests/archive/KeeperVenue.h"
#include "tests/support/OrdinaryUser.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;

class NamesOfGuests : public KeeperVenue {
 protected:
  NamesOfGuests() {
    guestsOnBoard = &guests;
    Start();
  }

  void Name(GuestList::Names names) {
    guests.SetNames(std::move(names));
    keeper->Keep();
  }
  std::string Kept() const {
    return Query(
        "SELECT group_concat(PlayerIndex || ':' || GuestName, ' ') FROM GamePlayers WHERE GuestName IS NOT "
        "NULL");
  }
  /// What tells whether anything but a name was written.
  std::string TheRest() const {
    return Query("SELECT group_concat(InputsHash || Pulls) FROM Games") +
           Query("SELECT group_concat(hex(data) || mtime) FROM sqlar") +
           Query("SELECT group_concat(Soldiering || ' ' || Place) FROM GamePlayers");
  }
  ArchiveAccess Access() {
    return ArchiveAccess({.Session = session,
                          .Disk = venue.Disk,
                          .Engine = venue.Databases,
                          .Strings = venue.Strings,
                          .UserDataFolder = venue.Folder.Path(),
                          .ProgramFolder = venue.Folder / "program"});
  }
  /// An archive as it was before there were names of guests, with a game.
  void MakeOldArchive() {
    Pull();
    session.ClearPlayerData();
    Start();
    OtherConnection(ArchivePath()).Execute("ALTER TABLE GamePlayers DROP COLUMN GuestName");
  }

  GuestList guests;
};

TEST_F(NamesOfGuests, AreKeptWithTheGameAndClean) {
  guests.SetNames({{Red0, " An\tn\xE2\x80\xAE "}});
  Pull();
  EXPECT_EQ(Kept(), "1:Ann");
  ArchiveAccess access = Access();
  EXPECT_THAT(access.Read(1).Guests, ElementsAre(Pair(Red0, "Ann")));
  EXPECT_EQ(access.GuestNameOf(1, Red0), "Ann");
  EXPECT_EQ(access.GuestNameOf(1, Blue7), "");
}

TEST_F(NamesOfGuests, AreWrittenAloneWhenNothingElseHasChanged) {
  Pull();
  const std::string before = TheRest();
  session.Factors().Damage = 99;  // of today, which no kept figure is made anew of
  Name({{Red0, "Ann"}, {Blue7, "Ben"}});
  EXPECT_EQ(Kept(), "1:Ann 40:Ben");
  Name({{Red0, "Eve"}});
  EXPECT_EQ(Kept(), "1:Eve");
  EXPECT_EQ(TheRest(), before);
  const std::string bytes = ReadFile(ArchivePath());
  keeper->Keep();
  EXPECT_EQ(ReadFile(ArchivePath()), bytes);
}

TEST_F(NamesOfGuests, StayWhenTheGameIsKeptAgainAndGoWithTheirGun) {
  guests.SetNames({{Red0, "Ann"}, {Blue7, "Ben"}});
  Pull();
  session.Game().Players(Red0).BonusPoints = 50;
  session.CalculateScores();
  keeper->Keep();
  Pull();
  EXPECT_EQ(Kept(), "1:Ann 40:Ben");
  session.Game().Players(Blue7).Clear();
  session.CalculateScores();
  keeper->Keep();
  EXPECT_EQ(Kept(), "1:Ann");
}

TEST_F(NamesOfGuests, AreNotThoseOfTheNextGame) {
  guests.SetNames({{Red0, "Ann"}});
  Pull();
  session.ClearPlayerData();
  guests.Forget();
  Pull();
  EXPECT_EQ(Games(), "2");
  EXPECT_EQ(Query("SELECT GameID FROM GamePlayers WHERE GuestName = 'Ann'"), "1");
}

TEST_F(NamesOfGuests, OfAReopenedGameChangeWithoutTouchingItsFigures) {
  guests.SetNames({{Red0, "Ann"}});
  Pull();
  session.ClearPlayerData();
  guests.Forget();
  session.Factors().Damage = 99;
  const std::string before = TheRest();
  const std::unique_ptr<Database> file = venue.Databases.OpenDatabase(ArchivePath());
  const std::string bytes = GameArchive(*file, session.DbMembers(), venue.Strings).FileOf(1);
  session.LoadGame([&](Game& game, const Session::MissionChoice& choose) {
    std::string mission;
    const bool done = ReadGameFile(bytes, game, [&](const std::string& name) {
      mission = name;
      choose(name);
    });
    keeper->Open(1, 0, game, mission);
    guests.SetNames(GuestNamesOf(*file, 1));
    return done;
  });
  const std::string untouched = ReadFile(ArchivePath());
  keeper->Keep();
  EXPECT_EQ(ReadFile(ArchivePath()), untouched);
  Name({{Red0, "Eve"}});
  EXPECT_EQ(Kept(), "1:Eve");
  EXPECT_EQ(TheRest(), before);
  Name({});
  EXPECT_EQ(Kept(), "NULL");
}

TEST_F(NamesOfGuests, StayInAGameWhoseFileIsLoaded) {
  guests.SetNames({{Red0, "Ann"}});
  Pull();
  const std::string bytes = WriteGameFile(session.Game(), session.Missions().Text());
  session.ClearPlayerData();
  guests.Forget();
  Load(bytes);
  EXPECT_EQ(Games(), "1");
  Name({{Blue7, "Ben"}});
  EXPECT_EQ(Kept(), "1:Ann 40:Ben");
}

TEST_F(NamesOfGuests, AreToldLaterIfTheArchiveIsLocked) {
  Pull();
  guests.SetNames({{Red0, "Ann"}});
  {
    OtherConnection other(ArchivePath());
    other.Execute("BEGIN EXCLUSIVE");
    keeper->Keep();
    EXPECT_NE(keeper->State().Failure, "");
    other.Execute("ROLLBACK");
  }
  keeper->Keep();
  EXPECT_EQ(keeper->State().Failure, "");
  EXPECT_EQ(Kept(), "1:Ann");
}

TEST_F(NamesOfGuests, GetAColumnInAnArchiveThatHadNone) {
  MakeOldArchive();
  Pull();
  Name({{Red0, "Ann"}});
  EXPECT_EQ(keeper->State().Failure, "");
  EXPECT_EQ(Query("SELECT GameID FROM GamePlayers WHERE GuestName = 'Ann'"), "2");
  EXPECT_THAT(Access().Read(1).Guests, IsEmpty());
}

TEST_F(NamesOfGuests, AreNoneInAnOldArchiveThatCannotBeWritten) {
  MakeOldArchive();
  keeper->End();
  const OrdinaryUser user;
  ArchiveAccess access = Access();
  EXPECT_THAT(access.Read(1).Guests, IsEmpty());
  EXPECT_EQ(access.GuestNameOf(1, Red0), "");
  EXPECT_EQ(access.Queries().Games({}).size(), 1U);
}

TEST_F(NamesOfGuests, GoWithAMemberWhoIsForgotten) {
  guests.SetNames({{Red0, "Ann"}, {Blue7, "Ben"}});
  Pull();
  session.Game().Players(Red0).MemberIndex = 7;
  keeper->Keep();
  const std::unique_ptr<Database> file = venue.Databases.OpenDatabase(ArchivePath());
  ForgetIn(*file, session.DbMembers(), venue.Strings, 7);
  EXPECT_EQ(Kept(), "40:Ben");
}

}  // namespace
