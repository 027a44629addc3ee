#include "archive/import/GameImport.h"

#include <fcntl.h>
#include <gmock/gmock.h>
#include <sys/stat.h>

#include <filesystem>
#include <fstream>
#include <map>

#include "archive/GameKeeper.h"
#include "platform/linux/LinuxFiles.h"
#include "tests/archive/ArchiveVenue.h"
#include "tests/archive/Forgetting.h"
#include "tests/fakes/FakeClock.h"
#include "tests/support/OrdinaryUser.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

/// A disk that gets narrow after so many games.
class NarrowingDisk : public LinuxFiles {
 public:
  int Games = 1000;
  std::uint64_t FreeSpace(const std::string& /*path*/) const override {
    return GameKeeper::LeastFreeSpace - (asked_++ < Games ? 0 : 1);
  }

 private:
  mutable int asked_ = 0;
};

class Importing : public testing::Test {
 protected:
  Importing() {
    std::filesystem::create_directories(Path("deep/er"));
    clock.Stamps["21.11.2026 20:15"] = "2026-11-21 20:15:00";
  }

  std::string Path(const std::string& name) const { return venue.Folder / "files/" + name; }

  std::function<bool(const std::string& path)> wanted;

  /// A file with the venue's game as it is now.
  void Put(const std::string& name) const {
    WriteFile(Path(name), WriteGameFile(venue.Game, "Capture <the> Flag"));
  }

  GameImport Make(FilesOf table = FilesOf::OtherTable) {
    return GameImport({.Archive = *venue.ArchiveDatabase,
                       .Members = *venue.MembersDatabase,
                       .Disk = disk,
                       .Time = clock,
                       .Strings = venue.Strings,
                       .Factors = {},
                       .UserDataFolder = venue.Folder.Path(),
                       .IsWanted = wanted},
                      table);
  }

  /// "imported, known, refused" of an import to the end.
  std::string Run(FilesOf table = FilesOf::OtherTable) {
    GameImport import = Make(table);
    EXPECT_TRUE(import.Run(Path("."), [](const GameImport::State&) { return true; }));
    refused.clear();
    for (const RefusedGameFile& file : import.Refused()) {
      refused.push_back(std::filesystem::path(file.Path).filename().string() + ":" +
                        std::to_string(file.Trouble.Line) + " " + TextOf(file.Trouble, venue.Strings));
    }
    return std::to_string(import.Imported()) + ", " + std::to_string(import.Known()) + ", " +
           std::to_string(import.Refused().size());
  }

  /// The members of the players of the only game, by record.
  std::string Members() const {
    return venue.Query(
        "SELECT group_concat(MemberID, ' ') FROM (SELECT MemberID FROM GamePlayers ORDER BY PlayerIndex)");
  }

  ArchiveVenue venue;
  NarrowingDisk disk;
  FakeClock clock;
  std::vector<std::string> refused;
};

TEST_F(Importing, TakesAllGameFilesOfAFolderAndBelowIt) {
  Put("a.xml");
  venue.Game.Players(ArchiveVenue::Red0).DeathCount = 4;
  Put("deep/b.XML");
  venue.Game.Players(ArchiveVenue::Red0).DeathCount = 5;
  Put("deep/er/c.game.xml");
  WriteFile(Path("notes.txt"), "no game");
  WriteFile(Path("deep/xml"), "no game");
  EXPECT_EQ(Run(), "3, 0, 0");
  EXPECT_EQ(venue.Query("SELECT group_concat(Source || Played, ' ') FROM Games"),
            "import2026-11-21 20:15:00 import2026-11-21 20:15:00 import2026-11-21 20:15:00");
}

TEST_F(Importing, KeepsTheFiguresOfTheFile) {
  Put("a.xml");
  EXPECT_EQ(Run(), "1, 0, 0");
  EXPECT_EQ(venue.Query("SELECT Mission || '|' || DateText || '|' || Players || '|' || Committed || '|' || "
                        "RedTotal || '|' || BlueTotal || '|' || BestPlayer FROM Games"),
            "Capture <the> Flag|21.11.2026 20:15|2|1|-4|250|40");
  EXPECT_EQ(venue.Query("SELECT Soldiering || '|' || DamageDealt || '|' || Shots FROM GamePlayers WHERE "
                        "PlayerIndex = 40"),
            "250|120|40");
  const ::Game kept = venue.Read(venue.Archive->FileOf(1));
  EXPECT_EQ(kept.Players(ArchiveVenue::Red0).HitByPlayer(ArchiveVenue::Blue7), 120);
}

TEST_F(Importing, TakesTheTimeOfTheFileWhereTheGameHasNone) {
  venue.Game.GameDate = "N/A";
  Put("a.xml");
  const timespec times[] = {{1'700'000'000, 0}, {1'700'000'000, 0}};
  ASSERT_EQ(utimensat(AT_FDCWD, Path("a.xml").c_str(), times, 0), 0);
  EXPECT_EQ(Run(), "1, 0, 0");
  EXPECT_EQ(venue.Query("SELECT Played FROM Games"), disk.TimeOfChange(Path("a.xml")));
  EXPECT_THAT(disk.TimeOfChange(Path("a.xml")), testing::StartsWith("2023-11-1"));
}

TEST_F(Importing, AddsAGameOnce) {
  Put("a.xml");
  Put("deep/copy.xml");
  EXPECT_EQ(Run(), "1, 1, 0");
  EXPECT_EQ(Run(), "0, 2, 0");
  EXPECT_EQ(venue.Query("SELECT count(*) FROM Games"), "1");
}

TEST_F(Importing, TellsForWhichGameItTookEachFile) {
  venue.Game.Players(ArchiveVenue::Blue7).Committed = false;
  Put("alike.xml");
  venue.Game.Players(ArchiveVenue::Blue7).Committed = true;
  Put("same.xml");
  venue.Archive->Keep(venue.State());
  venue.Game.Players(ArchiveVenue::Red0).DeathCount += 1;
  Put("z-deleted.xml");
  venue.Archive->Delete({venue.Archive->Keep(venue.State())}, "2026-11-22 10:00:00");
  venue.Game.Players(ArchiveVenue::Red0).DeathCount += 1;
  Put("new.xml");
  GameImport import = Make(FilesOf::OtherTable);
  EXPECT_TRUE(import.Run(Path("."), [](const GameImport::State&) { return true; }));
  std::map<std::string, KnownGameFile> files;
  for (const KnownGameFile& file : import.KnownFiles()) {
    files[std::filesystem::path(file.Path).filename().string()] = file;
  }
  ASSERT_EQ(files.size(), 3U);
  EXPECT_EQ(files["same.xml"].As, KnownAs::Same);
  EXPECT_EQ(files["alike.xml"].As, KnownAs::Alike);
  EXPECT_EQ(files["z-deleted.xml"].As, KnownAs::Deleted);
  EXPECT_EQ(files["alike.xml"].Mission, "Capture <the> Flag");
  EXPECT_EQ(files["alike.xml"].Played, venue.Query("SELECT Played FROM Games WHERE GameID = 1"));
  EXPECT_EQ(import.Known(), 2U);
  EXPECT_EQ(import.BroughtBack(), 1U);
}

TEST_F(Importing, KnowsAGameThatWasKeptHereThoughItsMembersAreNotTaken) {
  venue.Game.Players(ArchiveVenue::Red0).MemberIndex = 6;  // by hand: without a button
  venue.Archive->Keep(venue.State());
  Put("a.xml");
  EXPECT_EQ(Run(), "0, 1, 0");
  EXPECT_EQ(Members(), "6 5");
}

TEST_F(Importing, KnowsAGameWhoseMembersWereTakenForOthersThen) {
  venue.Game.Players(ArchiveVenue::Red0).MemberIndex = 6;
  Put("a.xml");
  EXPECT_EQ(Run(), "1, 0, 0");
  EXPECT_EQ(Members(), "0 5");
  venue.InMembers("UPDATE Members SET DallasID = NULL");
  EXPECT_EQ(Run(), "0, 1, 0");
  EXPECT_EQ(Run(FilesOf::ThisTable), "0, 1, 0");
  venue.Game.Players(ArchiveVenue::Red0).DeathCount += 1;
  Put("b.xml");
  EXPECT_EQ(Run(), "1, 1, 0");
}

TEST_F(Importing, KnowsAGameThatWasCommittedSinceItWasSaved) {
  venue.Game.Players(ArchiveVenue::Blue7).Committed = false;
  Put("a.xml");
  venue.Game.Players(ArchiveVenue::Blue7).Committed = true;
  venue.Archive->Keep(venue.State());
  EXPECT_EQ(Run(), "0, 1, 0");
  EXPECT_EQ(venue.Query("SELECT Committed FROM Games"), "1");
}

TEST_F(Importing, KnowsAGameFromWhoseEarlierStateAMemberWasCut) {
  venue.Game.Players(ArchiveVenue::Red0).MemberIndex = 6;
  Put("a.xml");
  const std::int64_t game = venue.Archive->Keep(venue.State());
  venue.Game.Players(ArchiveVenue::Red0).DeathCount += 1;
  venue.Archive->KeepAgain(game, venue.State(), FormerState::KeptToo);
  EXPECT_EQ(ForgetIn(*venue.ArchiveDatabase, *venue.MembersDatabase, venue.Strings, 6), 1);
  EXPECT_EQ(Run(), "0, 1, 0");
}

TEST_F(Importing, PassesByFilesThatAreNotWanted) {
  Put("a.xml");
  WriteFile(Path("notes.xml"), "<notes/>");
  EXPECT_EQ(Run(), "1, 0, 1");
  wanted = [](const std::string& path) { return !path.ends_with("/notes.xml"); };
  EXPECT_EQ(Run(), "0, 1, 0");
}

TEST_F(Importing, BringsADeletedGameBackAsItWas) {
  Put("a.xml");
  venue.Game.Players(ArchiveVenue::Red0).MemberIndex = 6;
  const std::int64_t game = venue.Archive->Keep(venue.State());
  venue.Archive->Delete({game}, "2026-11-22 10:00:00");
  GameImport import = Make();
  EXPECT_TRUE(import.Run(Path("."), [](const GameImport::State&) { return true; }));
  EXPECT_EQ(import.BroughtBack(), 1U);
  EXPECT_EQ(import.Imported() + import.Known(), 0U);
  EXPECT_EQ(venue.Query("SELECT count(*) FROM Games WHERE Deleted IS NULL"), "1");
  EXPECT_EQ(Members(), "6 5");
  EXPECT_EQ(Run(), "0, 1, 0");
}

TEST_F(Importing, LeavesADeletedGameWhereTheSameOneIsThere) {
  Put("a.xml");
  const std::int64_t game = venue.Archive->Keep(venue.State());
  venue.Archive->Delete({game}, "2026-11-22 10:00:00");
  venue.Archive->Keep(venue.State());
  EXPECT_EQ(Run(), "0, 1, 0");
  EXPECT_EQ(venue.Query("SELECT count(*) FROM Games WHERE Deleted IS NULL"), "1");
}

TEST_F(Importing, GivesNewMembersNumbersAboveAllImportedOnesThoughItFailsMidway) {
  venue.Game.Players(ArchiveVenue::Red0).MemberIndex = 4711;
  Put("a.xml");
  venue.Game.Players(ArchiveVenue::Red0).DeathCount += 1;
  Put("b.xml");
  disk.Games = 1;
  const GameImport::OnStep lowerCounter = [this](const GameImport::State& state) {
    if (state.Done == 1) {  // as a program may that puts an older member table in place
      venue.InMembers("UPDATE sqlite_sequence SET seq = 6 WHERE name = 'Members'");
    }
    return true;
  };
  GameImport import = Make(FilesOf::ThisTable);
  EXPECT_EQ(ThrownBy([&] { import.Run(Path("."), lowerCounter); }).Number, 61);
  EXPECT_EQ(import.Imported(), 1U);
  venue.InMembers("INSERT INTO Members (FirstName) VALUES ('New')");
  EXPECT_EQ(OtherConnection(venue.MembersPath()).Query("SELECT max(ContactID) FROM Members"), "4712");
}

TEST_F(Importing, TakesANumberOnlyWithItsButtonElseTheOwnerOfTheButtonElseNobody) {
  const auto players = [this](std::int32_t red, const std::string& redButton, std::int32_t blue) {
    venue.Game.Players(ArchiveVenue::Red0).MemberIndex = red;
    venue.Game.Players(ArchiveVenue::Red0).DallasID = redButton;
    venue.Game.Players(ArchiveVenue::Blue7).MemberIndex = blue;
    venue.Game.Players(ArchiveVenue::Red0).DeathCount += 1;
    Put("a.xml");
    venue.InArchive("DELETE FROM Games; DELETE FROM GamePlayers; DELETE FROM GameFiles; DELETE FROM sqlar");
    EXPECT_EQ(Run(), "1, 0, 0");
    return Members();
  };
  EXPECT_EQ(players(6, NoDallasId, 5), "0 5");
  EXPECT_EQ(players(6, "CC00000000000009", 6), "0 5");
  EXPECT_EQ(players(0, ArchiveVenue::BosButton, 0), "5 5");
  EXPECT_EQ(players(0, NoDallasId, 4711), "0 5");
}

TEST_F(Importing, TakesTheNumbersAsTheyStandIfTheFilesAreOfThisTable) {
  venue.Game.Players(ArchiveVenue::Red0).MemberIndex = 4711;
  Put("a.xml");
  EXPECT_EQ(Run(FilesOf::ThisTable), "1, 0, 0");
  EXPECT_EQ(Members(), "4711 5");
  venue.InMembers("INSERT INTO Members (FirstName) VALUES ('New')");
  EXPECT_EQ(OtherConnection(venue.MembersPath()).Query("SELECT max(ContactID) FROM Members"), "4712");
}

TEST_F(Importing, RefusesWhatIsNoGameAndGoesOn) {
  WriteFile(Path("a.xml"), "<GameData>\n<oops");
  WriteFile(Path("b.xml"), "<html/>");
  WriteFile(Path("d.xml"), "");
  std::ofstream(Path("e.xml")).seekp(40 << 20).put('x');
  Put("f.xml");
  EXPECT_EQ(Run(), "1, 0, 4");
  EXPECT_THAT(refused,
              ElementsAre("a.xml:2 It is damaged, or no XML at all.",
                          "b.xml:1 It is XML, but no game: it begins with html.",
                          "d.xml:1 It is damaged, or no XML at all.", "e.xml:0 It is larger than 32 MB."));
}

TEST_F(Importing, RefusesWhatItMayNotRead) {
  Put("a.xml");
  Put("deep/b.xml");
  std::filesystem::permissions(Path("a.xml"), std::filesystem::perms::none);
  std::filesystem::permissions(Path("deep/er"), std::filesystem::perms::none);
  std::filesystem::permissions(venue.Folder.Path(), std::filesystem::perms::all);
  for (const std::string& file : {venue.ArchivePath(), venue.MembersPath()}) {
    std::filesystem::permissions(file, std::filesystem::perms::all);
  }
  {
    const OrdinaryUser user;
    venue.Open();
    EXPECT_EQ(Run(), "1, 0, 2");
  }
  EXPECT_THAT(refused,
              ElementsAre(HasSubstr("er:0 It cannot be read: "), HasSubstr("a.xml:0 It cannot be read: ")));
  std::filesystem::permissions(Path("deep/er"), std::filesystem::perms::all);
}

TEST_F(Importing, DoesNotFollowLinksToFolders) {
  Put("deep/a.xml");
  std::filesystem::create_directory_symlink(Path("."), Path("deep/round"));
  EXPECT_EQ(Run(), "1, 0, 0");
}

TEST_F(Importing, KeepsWhatWasImportedWhenItIsStopped) {
  for (int game = 0; game < 4; ++game) {
    venue.Game.Players(ArchiveVenue::Red0).DeathCount = game;
    Put(std::to_string(game) + ".xml");
  }
  GameImport import = Make();
  EXPECT_FALSE(import.Run(Path("."), [&](const GameImport::State& state) {
    EXPECT_TRUE(state.Files == 0 || state.Files == 4);
    return import.Imported() < 2;
  }));
  EXPECT_EQ(import.Imported(), 2U);
  EXPECT_EQ(venue.Query("SELECT count(*) FROM Games"), "2");
  EXPECT_EQ(Run(), "2, 2, 0");
}

TEST_F(Importing, StopsWhenTheDiskGetsNarrow) {
  for (int game = 0; game < 4; ++game) {
    venue.Game.Players(ArchiveVenue::Red0).DeathCount = game;
    Put(std::to_string(game) + ".xml");
  }
  disk.Games = 3;
  GameImport import = Make();
  EXPECT_EQ(ThrownBy([&] { import.Run(Path("."), [](const GameImport::State&) { return true; });
}).Number, 61);
EXPECT_EQ(import.Imported(), 3U);
EXPECT_THAT(import.Refused(), IsEmpty());
EXPECT_EQ(venue.Query("SELECT count(*) FROM Games"), "3");
}

TEST_F(Importing, EndsWhenAnotherProgramHoldsTheArchive) {
  Put("a.xml");
  OtherConnection other(venue.ArchivePath());
  other.Execute("BEGIN IMMEDIATE");
  GameImport import = Make();
  EXPECT_EQ(ThrownBy([&] { import.Run(Path("."), [](const GameImport::State&) { return true; });
}).Number, 3050);
other.Execute("ROLLBACK");
EXPECT_EQ(Run(), "1, 0, 0");
}

TEST_F(Importing, AsksBetweenAllFilesGoodAndBad) {
  for (int file = 0; file < 30; ++file) {
    WriteFile(Path(std::to_string(file) + ".xml"), "bad");
  }
  int steps = 0;
  std::size_t last = 0;
  GameImport import = Make();
  EXPECT_TRUE(import.Run(Path("."), [&](const GameImport::State& state) {
    steps += state.Files != 0 ? 1 : 0;
    EXPECT_LE(state.Done, last + 1 + (state.Files == 0 ? 30 : 0));
    last = state.Done;
    return true;
  }));
  EXPECT_GE(steps, 30);
  EXPECT_EQ(import.Refused().size(), 30U);
}

}  // namespace
