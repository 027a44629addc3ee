#pragma once

#include <gmock/gmock.h>

#include <QApplication>
#include <QClipboard>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QSpinBox>
#include <QTableView>
#include <filesystem>
#include "archive/past/PastGames.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/support/Controls.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/OpenSession.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/TightDisk.h"

inline constexpr int Red0 = 1;
inline constexpr int Blue7 = 40;

class WindowOfPastGames : public testing::Test {
 protected:
  WindowOfPastGames() {
    std::filesystem::create_directories(venue.Folder / "program");
    WriteFile(venue.Folder / "program/games_default.mdb", MadeDatabase("games"));
    ExecuteSql(venue.MembersFile(),
               "INSERT INTO Members (ContactID, NickName) VALUES (5, 'Mole'), (6, 'Fox')");
    EXPECT_TRUE(venue.Open());
    venue.Time.Stamps["20/11/2026"] = "2026-11-20 00:00:00";
    venue.Time.Stamps["21/11/2026"] = "2026-11-21 00:00:00";
  }

  /// A game of Red 0, a guest, and of Blue 7.
  std::int64_t Keep(const std::string& played, const std::string& mission, int points, int member = 5) {
    Game game(venue.Strings);
    for (const int index : {Red0, Blue7}) {
      game.Players(index).Active = true;
      game.Players(index).PrimaryDamage = 10;
      game.Players(index).ShotCount = 4;
    }
    game.Players(Blue7).Soldiering = points;
    game.Players(Blue7).MemberIndex = member;
    game.TeamTotals(2) = points;
    game.GameDate = played;
    return access.Archive().Keep({.Game = game, .Mission = mission, .Played = played});
  }
  /// Three of November, one of October.
  void KeepFour() {
    Keep("2026-10-31 20:00:00", "None", 100);
    Keep("2026-11-20 20:00:00", "Flag", 200);
    Keep("2026-11-21 20:00:00", "Flag", 300, 6);
    Keep("2026-11-22 20:00:00", "None", 400);
    access.Close();
  }

  void Open(Language language = Language::English) {
    strings.emplace(language);
    window = std::make_unique<PastGames>(
        PastGames::Parts{.Archive = access,
                         .Time = venue.Time,
                         .Boxes = venue.Boxes,
                         .CommonDialog1 = dialog,
                         .Disk = venue.Disk,
                         .Events = events,
                         .Strings = *strings,
                         .MembersCalled =
                             [](const std::string& text) {
                               return text == "Mo" ? std::vector<std::int32_t>{5}
                                                   : std::vector<std::int32_t>{};
                             },
                         .BoardIsUnsaved = [this] { return unsaved; },
                         .Busy = [this] { return busy; },
                         .ShowCharts = [this](const PastGame& game) { charted.push_back(game.GameId); },
                         .Export = [this](const std::vector<std::int64_t>& games) { exported = games; },
                         .Import = imports ? std::function<void()>([this] { ++imported; }) : nullptr},
        nullptr);
    Show(*window);
  }

  template <typename Control>
  Control& Get(const char* name) const {
    return Find<Control>(*window, name);
  }
  QTableView& Games() const { return Get<QTableView>("GameTable"); }
  QTableView& Months() const { return Get<QTableView>("MonthTable"); }
  std::vector<std::string> Column(const char* table, int column) const {
    std::vector<std::string> cells;
    const QAbstractItemModel& model = *Get<QTableView>(table).model();
    for (int row = 0; row < model.rowCount(); ++row) {
      cells.push_back(model.index(row, column).data().toString().toStdString());
    }
    return cells;
  }
  /// The best players' points tell the games apart.
  std::vector<std::string> Listed() const { return Column("GameTable", PastGameModel::FirstTeam + 1); }
  std::vector<std::string> Board() const { return Column("BoardTable", 1); }
  std::string Status() const { return Get<QLabel>("Status").text().toStdString(); }
  bool Enabled(const char* button) const { return Get<QPushButton>(button).isEnabled(); }
  void Press(const char* button) const { ::Press(*window, button); }

  void Lock(const std::function<void()>& action) {
    access.Close();
    OtherConnection other(ArchivePath());
    other.Execute("BEGIN EXCLUSIVE");
    action();
    other.Execute("ROLLBACK");
  }
  std::string ArchivePath() const { return venue.Folder / "games.mdb"; }
  std::string Query(const std::string& sql) const { return OtherConnection(ArchivePath()).Query(sql); }

  OpenSession venue;
  TightDisk disk;
  ArchiveAccess access{{.Session = venue.session,
                        .Disk = disk,
                        .Engine = venue.Databases,
                        .Strings = venue.Strings,
                        .UserDataFolder = venue.Folder.Path(),
                        .ProgramFolder = venue.Folder / "program"}};
  FakeFileDialog dialog;
  FakeEventPump events;
  std::optional<StringTable> strings;
  bool unsaved = false;
  std::optional<OwnText> busy;
  bool imports = true;
  int imported = 0;
  std::vector<std::int64_t> charted;
  std::vector<std::int64_t> exported;
  std::unique_ptr<PastGames> window;
};
