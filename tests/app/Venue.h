#pragma once

#include <sqlite3.h>

#include <QAbstractItemModel>
#include <QAction>
#include <QComboBox>
#include <QTableView>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

#include "app/frmRx.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtEventPump.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/app/Controls.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeFolders.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/platform/linux/TemporaryFolder.h"

/// What passes the time in a wait: a script, or the toolkit's events as in the program itself.
enum class Waits { Scripted, Real };

/// The main window on a data folder of its own, with real databases and files; all else is faked.
class Venue {
 public:
  explicit Venue(Language language = Language::English, Waits waits = Waits::Scripted)
      : Strings(language), waits_(waits) {
    Places.LocalAppDataPath = Folder.Path();
    Places.ProgramPath = TESSARINE_PROGRAM_FOLDER;
    Devices.Ports = {"/dev/ttyS0"};
  }

  std::string DataFolder() const { return Folder / "Orvalin/Tessarine"; }
  std::string DataFile(const std::string& name) const { return DataFolder() + '/' + name; }

  /// Fills the data folder as the first start does.
  void PutDefaultFiles() const {
    std::filesystem::create_directories(DataFolder());
    for (const auto& [file, source] : {std::pair{"scenarios.mdb", "scenarios_default.mdb"},
                                       {"members.mdb", "members_default.mdb"},
                                       {"score_card.doc", "score_card_default.doc"},
                                       {"tessarine.ini", "tessarine.ini"}}) {
      std::filesystem::copy_file(TESSARINE_PROGRAM_FOLDER + std::string("/") + source, DataFile(file),
                                 std::filesystem::copy_options::skip_existing);
    }
  }

  /// Another program changes one of the databases.
  void ChangeDatabase(const std::string& file, const std::string& sql) const {
    sqlite3* database = nullptr;
    sqlite3_open(DataFile(file).c_str(), &database);
    const bool done = sqlite3_exec(database, sql.c_str(), nullptr, nullptr, nullptr) == SQLITE_OK;
    const std::string fault = sqlite3_errmsg(database);
    sqlite3_close(database);
    if (!done) {
      throw std::logic_error(fault);
    }
  }

  frmRx& MakeWindow() {
    EventPump* events = &Events;
    if (waits_ == Waits::Real) {
      events = &RealEvents;
    }
    Window = std::make_unique<frmRx>(
        ::Services{Strings, Time, Databases, *events, Dialog, Disk, Places, Boxes, Devices, Port});
    return *Window;
  }

  /// Starts the program, not for the first time.
  frmRx& Start() {
    PutDefaultFiles();
    MakeWindow().FormLoad();
    Show(*Window);
    return *Window;
  }

  template <typename Control>
  Control& Find(const std::string& name) const {
    return ::Find<Control>(*Window, name);
  }

  void Trigger(const std::string& menuItem) const { Find<QAction>(menuItem).trigger(); }
  void Press(const std::string& button) const { ::Press(*Window, button); }
  QComboBox& ActiveMission() const { return Find<QComboBox>("ActiveMission"); }

  /// Loads a game file with these contents through the menu.
  void LoadGame(const std::string& contents) {
    WriteFile(Folder / "game.xml", contents);
    Dialog.Answers = {Folder / "game.xml"};
    Trigger("mnuLoadScores");
  }

  /// Cells of a list's row as shown.
  std::vector<std::string> Row(const std::string& list, int row) const {
    const QAbstractItemModel& model = *Find<QTableView>(list).model();
    std::vector<std::string> cells;
    for (int column = 0; column < model.columnCount(); ++column) {
      cells.push_back(model.index(row, column).data().toString().toStdString());
    }
    return cells;
  }

  /// Cells of a list's column as shown, from the top.
  std::vector<std::string> Column(const std::string& list, int column) const {
    std::vector<std::string> cells;
    for (int row = 0; row < RowCount(list); ++row) {
      cells.push_back(Row(list, row)[static_cast<std::size_t>(column)]);
    }
    return cells;
  }

  int RowCount(const std::string& list) const { return Find<QTableView>(list).model()->rowCount(); }

  TemporaryFolder Folder;
  StringTable Strings;
  FakeClock Time;
  SqliteEngine Databases;
  FakeEventPump Events;
  QtEventPump RealEvents;
  FakeFileDialog Dialog;
  LinuxFiles Disk;
  FakeFolders Places;
  FakeMessageBoxes Boxes;
  FakeSerialDevices Devices;
  FakeSerialPort Port;
  std::unique_ptr<frmRx> Window;

 private:
  Waits waits_;
};

/// A game file of these players for the named mission.
inline std::string GameFile(const std::string& players, const std::string& mission = "None") {
  return "<GameData><GameHeader><MissionName>" + mission +
         "</MissionName><GameDate>today</GameDate></GameHeader><PlayerData>" + players +
         "</PlayerData></GameData>";
}

/// An active player of a game file with these further fields.
inline std::string PlayerOf(int index, const std::string& fields = {}) {
  return "<Player><Index>" + std::to_string(index) + "</Index><Active>1</Active>" + fields + "</Player>";
}

/// Red 0 with 5 points and Blue 7 with 9.
inline std::string SmallGame() {
  return GameFile(PlayerOf(1, "<BonusPoints>5</BonusPoints>") + PlayerOf(40, "<BonusPoints>9</BonusPoints>"));
}
