#pragma once

#include <QAbstractItemModel>
#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QContextMenuEvent>
#include <QMenu>
#include <QTableView>
#include <QTimer>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "app/frmRx.h"
#include "check/FailureBoxes.h"
#include "platform/jet/JetConverter.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/UprightPicture.h"
#include "tests/fakes/FakeComputer.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFolders.h"
#include "tests/fakes/FakeLocalAddresses.h"
#include "tests/fakes/FakeOneWire.h"
#include "tests/fakes/FakePipedProgram.h"
#include "tests/fakes/FakePrograms.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/fakes/FakeSoundConverter.h"
#include "tests/fakes/FakeSoundPlayer.h"
#include "tests/fakes/FakeWakeLock.h"
#include "tests/fakes/FakeWordProcessor.h"
#include "tests/support/Controls.h"
#include "tests/support/DataSite.h"
#include "tests/support/GameFiles.h"
#include "tests/support/TimeOfChange.h"

/// What drives a wait: a script, or the toolkit's events as in the program itself.
enum class Waits { Scripted, Real };

/// The main window on a temporary data folder, with real databases and files; everything else is faked.
class Venue : public DataSite {
 public:
  explicit Venue(Language language = Language::English, Waits waits = Waits::Scripted)
      : DataSite(language), waits_(waits) {
    Places.LocalAppDataPath = Folder.Path();
    Places.ProgramPath = TESSARINE_PROGRAM_FOLDER;
    Devices.Ports = {"/dev/ttyS0"};
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
                                                .Elapsed = Events,
                                                .CommonDialog1 = Dialog,
                                                .Disk = Disk,
                                                .Places = Places,
                                                .Boxes = Watched,
                                                .OtherPrograms = Started,
                                                .Devices = Devices,
                                                .MSComm1 = Port,
                                                .WordProcessor = Word,
                                                .UprightPicture = UprightPicture,
                                                .Awake = Awake,
                                                .SoundPort = SoundPort,
                                                .SoundPlayer = Player,
                                                .SoundConverter = Converter,
                                                .Addresses = Addresses,
                                                .MakePipedProgram = MakePiped,
                                                .ResultsProgram = ResultsProgram,
                                                .ButtonSwipe = ButtonSwipe,
                                                .Wire = HasReader ? &Wire : nullptr,
                                                .Computer = &Computer,
                                                .Release = Release});
    return *Window;
  }

  /// Starts the program, but not for the first time.
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
    SetTimeOfChange(Folder / "game.xml", Time.DateAndTime);
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

  /// Selects a row of the board and opens the context menu there by the keyboard; calls `choose` while the
  /// menu is open.
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

  FailureBoxes Watched{Boxes, Strings, [this] {
                         if (Window) {
                           Window->PointToSystemCheck();
                         }
                       }};
  FakeEventPump Events;
  JetConverter Old{Disk, JetReaderPath(), std::chrono::milliseconds(5000)};
  QtEventPump RealEvents;
  FakeFolders Places;
  FakeSerialDevices Devices;
  FakeSerialPort Port;
  FakeOneWire Wire;
  bool HasReader = true;
  FakeComputer Computer;
  std::string Release;  ///< of the program; empty for none
  FakeWakeLock Awake;
  FakeSerialPort SoundPort;
  FakeSoundPlayer Player{Events};
  FakeSoundConverter Converter;
  FakeWordProcessor Word;
  FakeLocalAddresses Addresses;
  FakePipedPrograms Piped;
  std::function<std::unique_ptr<PipedProgram>()> MakePiped = [this] { return Piped.Make(); };
  std::string ResultsProgram = "/bin/results";
  FakePrograms Started;
  std::unique_ptr<frmRx> Window;

 private:
  Waits waits_;
};
