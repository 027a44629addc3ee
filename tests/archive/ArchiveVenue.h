#pragma once

#include <memory>
#include <string>
#include <vector>

#include "archive/GameArchive.h"
#include "core/gamefile/GameFile.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/RandomGame.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/TestDatabase.h"

/// An archive and a member table in files of their own. Members: 5 Bo "Mole" Ray with a button, 6 Cy Fox.
class ArchiveVenue {
 public:
  static constexpr int Red0 = 1;
  static constexpr int Blue7 = 40;
  static constexpr int Yellow3 = 68;
  static constexpr const char* BosButton = "BB00000000000001";

  ArchiveVenue() {
    ::WriteFile(ArchivePath(), MadeDatabase("games"));
    ::WriteFile(MembersPath(), MadeDatabase("members"));
    InMembers(
        "INSERT INTO Members (ContactID, DallasID, FirstName, LastName, NickName, Birthdate) VALUES "
        "(5, 'BB00000000000001', 'Bo', 'Ray', 'Mole', '1990-02-03 00:00:00'), "
        "(6, NULL, 'Cy', 'Fox', NULL, NULL)");
    Open();
    FillOrdinary();
  }

  std::string ArchivePath() const { return Folder / "games.mdb"; }
  std::string MembersPath() const { return Folder / "members.mdb"; }
  void InMembers(const std::string& sql) const { OtherConnection(MembersPath()).Execute(sql); }
  void InArchive(const std::string& sql) const { OtherConnection(ArchivePath()).Execute(sql); }
  std::string Query(const std::string& sql) const { return OtherConnection(ArchivePath()).Query(sql); }

  void Open() {
    SqliteEngine engine(std::chrono::milliseconds(30));
    Archive.reset();
    ArchiveDatabase = engine.OpenDatabase(ArchivePath());
    MembersDatabase = engine.OpenDatabase(MembersPath());
    Archive = std::make_unique<GameArchive>(*ArchiveDatabase, *MembersDatabase, Strings);
  }

  GameState State(const std::string& played = "2026-11-21 20:15:30") const {
    return {.Game = Game, .Mission = "Capture <the> Flag", .Played = played};
  }

  /// Two players: Bo, first, on Blue 7, and a guest on Red 0.
  void FillOrdinary() {
    Game.GameDate = "21.11.2026 20:15";
    Game.TeamTotals(1) = -4;
    Game.TeamTotals(2) = 250;
    Player& blue = Game.Players(Blue7);
    blue.Active = true;
    blue.MemberIndex = 5;
    blue.DallasID = BosButton;
    blue.Soldiering = 250;
    blue.PrimaryDamage = 10;
    blue.ShotCount = 40;
    blue.Accuracy = 0.25F;
    blue.TotalDamage = 120;
    blue.Committed = true;
    Player& red = Game.Players(Red0);
    red.Active = true;
    red.Soldiering = -4;
    red.HealCount = 2;
    red.DeathCount = 3;
    red.AmmoAddCount = 1;
    red.HitByPlayer(Blue7) = 120;
  }

  /// The game in a file.
  ::Game Read(const std::string& bytes) const {
    ::Game game(Strings);
    ReadGameFile(bytes, game, [](const std::string&) {});
    return game;
  }

  TemporaryFolder Folder;
  StringTable Strings{Language::English};
  std::unique_ptr<Database> ArchiveDatabase;
  std::unique_ptr<Database> MembersDatabase;
  std::unique_ptr<GameArchive> Archive;
  ::Game Game{Strings};
};
