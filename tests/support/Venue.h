#pragma once

#include <QAbstractItemModel>
#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QContextMenuEvent>
#include <QMenu>
#include <QTableView>
#include <QTimer>
#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "app/frmRx.h"
#include "platform/jet/JetConverter.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtEventPump.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeFolders.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/fakes/FakeWordProcessor.h"
#include "tests/support/Controls.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/TestDatabase.h"

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
    OtherConnection(DataFile(file)).Execute(sql);
  }

  /// What another program reads of one of the databases: the first column of the first row, "NULL" or "none".
  std::string QueryDatabase(const std::string& file, const std::string& sql) const {
    return OtherConnection(DataFile(file)).Query(sql);
  }

  frmRx& MakeWindow() {
    EventPump* events = &Events;
    if (waits_ == Waits::Real) {
      events = &RealEvents;
    }
    Window = std::make_unique<frmRx>(::Services{.Strings = Strings,
                                                .Time = Time,
                                                .Databases = Databases,
                                                .Old = Old,
                                                .Events = *events,
                                                .CommonDialog1 = Dialog,
                                                .Disk = Disk,
                                                .Places = Places,
                                                .Boxes = Boxes,
                                                .Devices = Devices,
                                                .MSComm1 = Port,
                                                .WordProcessor = Word,
                                                .ButtonSwipe = ButtonSwipe});
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

  /// Selects a row of the board and opens the context menu there by the keyboard; `choose` is done with the
  /// menu open.
  void OpenPopup(int row, const std::function<void(QMenu&)>& choose) const {
    QTableView& board = Find<QTableView>("ScoreDisplay");
    if (row >= 0) {
      board.selectRow(row);
    }
    auto& menu = Find<QMenu>("mnuPopup");
    QTimer timer;
    QObject::connect(&timer, &QTimer::timeout, &timer, [&] {
      if (menu.isVisible()) {
        timer.stop();
        choose(menu);
        menu.close();
      }
    });
    timer.start(0);
    QContextMenuEvent event(QContextMenuEvent::Keyboard, QPoint(20, 20), board.mapToGlobal(QPoint(20, 20)));
    QApplication::sendEvent(&board, &event);
  }

  /// Chooses an item of the context menu of a row as the operator does: by keys.
  void ChooseInPopup(int row, const std::string& item) const {
    OpenPopup(row, [&](QMenu& menu) {
      menu.setActiveAction(&Find<QAction>(item));
      QTest::keyClick(&menu, Qt::Key_Return);
    });
  }

  TemporaryFolder Folder;
  StringTable Strings;
  FakeClock Time;
  SqliteEngine Databases{std::chrono::milliseconds(50)};
  FakeEventPump Events;
  JetConverter Old{JetReaderPath(), std::chrono::milliseconds(5000)};
  QtEventPump RealEvents;
  FakeFileDialog Dialog;
  LinuxFiles Disk;
  FakeFolders Places;
  FakeMessageBoxes Boxes;
  FakeSerialDevices Devices;
  FakeSerialPort Port;
  FakeWordProcessor Word;
  /// The reader of membership buttons; none as long as it is empty.
  std::function<std::string()> ButtonSwipe;
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

/// Red 0 and eight others who hit each other, with members' names missing.
inline std::string GameOfManyHits() {
  std::string players;
  for (int index = 1; index <= 9; ++index) {
    std::string hits;
    for (int shooter = 1; shooter <= 9; ++shooter) {
      hits += "<HitByPlayer><Index>" + std::to_string(shooter * 20) + "</Index><Amount>" +
              std::to_string(7 + index * shooter * 13 % 90) + "</Amount></HitByPlayer>";
    }
    players +=
        PlayerOf(index * 20, "<HitData>" + hits +
                                 "</HitData><ShotCount>250</ShotCount><PrimaryDamage>10</PrimaryDamage>"
                                 "<RunCounter>125</RunCounter><ExplosiveDamage>12</ExplosiveDamage>");
  }
  return GameFile(players);
}
