#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <optional>
#include <string>

#include "archive/GameKeeper.h"
#include "core/gamefile/GameFile.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/OpenSession.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/TightDisk.h"

/// A keeper at work on a session with a real archive. Member 7 is "Mole".
class KeeperVenue : public testing::Test {
 protected:
  static constexpr int Red0 = 1;
  static constexpr int Blue7 = 40;

  KeeperVenue() {
    std::filesystem::create_directories(venue.Folder / "program");
    WriteFile(venue.Folder / "program/games_default.mdb", MadeDatabase("games"));
    ExecuteSql(venue.MembersFile(),
               "INSERT INTO Members (ContactID, DallasID, NickName) VALUES (7, 'AB00000000000001', 'Mole')");
    EXPECT_TRUE(venue.Open());
    progress.emplace(session, venue.Time);
    Start();
  }

  void Start() {
    keeper.reset();
    keeper.emplace(GameKeeper::Parts{session, *progress, venue.Time, disk, venue.Databases, venue.Strings,
                                     venue.Folder.Path(), venue.Folder / "program", guestsOnBoard});
  }

  /// A game comes in by cable: Red 0 and Blue 7, who hit Red 0.
  void Pull() {
    keeper->BeginPull(GameSource::Cable);
    Read();
    session.CalculateScores();
    keeper->Keep();
  }
  /// As guns do: figures add up.
  void Read() {
    venue.Play(Red0, 0).HitByPlayer(Blue7) += 100;
    venue.Play(Blue7, 0).ShotCount += 8;
    session.Game().GameDate = "21/05/2013 14:30";
  }

  /// Checks the members, and cuts to the end what is to be cut.
  void CheckMembers() {
    keeper->CheckMembers();
    while (keeper->CutAPart()) {
    }
  }

  /// The operator loads a file that was last changed at `fileTime`; empty if that is not known.
  void Load(const std::string& bytes, const std::string& fileTime = {}) {
    session.LoadGame([&](Game& game, const Session::MissionChoice& choose) {
      std::string mission;
      const bool isGame = ReadGameFile(bytes, game, [&](const std::string& name) {
        mission = name;
        choose(name);
      });
      if (isGame) {
        keeper->Load(game, mission, fileTime);
      }
      return isGame;
    });
    keeper->Keep();
  }

  bool ArchiveExists() const { return std::filesystem::exists(ArchivePath()); }
  std::string ArchivePath() const { return venue.Folder / "games.mdb"; }
  std::string Query(const std::string& sql) const { return OtherConnection(ArchivePath()).Query(sql); }
  std::string Games() const { return Query("SELECT count(*) FROM Games"); }
  std::string FileNames() const {
    return Query("SELECT group_concat(name, ' ') FROM (SELECT name FROM sqlar ORDER BY name)");
  }

  OpenSession venue;
  Session& session = venue.session;
  TightDisk disk;
  std::optional<GameProgress> progress;
  const GuestList* guestsOnBoard = nullptr;
  std::optional<GameKeeper> keeper;
};
