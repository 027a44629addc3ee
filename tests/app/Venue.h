#pragma once

#include <QAbstractItemModel>
#include <QAction>
#include <QComboBox>
#include <QPushButton>
#include <QTableView>
#include <QTest>
#include <memory>
#include <string>
#include <vector>

#include "app/Composition.h"
#include "app/frmRx.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeFolders.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/platform/linux/TemporaryFolder.h"

/// The main window on a data folder of its own, with real databases and files; all else is faked.
class Venue {
 public:
  explicit Venue(Language language = Language::English) : Strings(language) {
    Places.LocalAppDataPath = Folder.Path();
    Places.ProgramPath = TESSARINE_PROGRAM_FOLDER;
    Devices.Ports = {"/dev/ttyS0"};
  }

  std::string DataFile(const std::string& name) const { return Folder / ("Orvalin/Tessarine/" + name); }

  /// Starts the program; the boxes of the first run are forgotten.
  frmRx& Start() {
    Window = std::make_unique<frmRx>(
        ::Services{Strings, Time, Databases, Events, Dialog, Disk, Places, Boxes, Devices, Port});
    Window->FormLoad();
    Window->show();
    Boxes.Boxes.clear();
    return *Window;
  }

  template <typename Control>
  Control& Find(const char* name) {
    return *Window->findChild<Control*>(QString::fromUtf8(name));
  }

  void Trigger(const char* action) { Find<QAction>(action).trigger(); }
  void Press(const char* button) { QTest::mouseClick(&Find<QPushButton>(button), Qt::LeftButton); }

  /// Cells of a list's row as shown.
  std::vector<std::string> Row(const char* list, int row) {
    const QAbstractItemModel& model = *Find<QTableView>(list).model();
    std::vector<std::string> cells;
    for (int column = 0; column < model.columnCount(); ++column) {
      cells.push_back(model.index(row, column).data().toString().toStdString());
    }
    return cells;
  }

  int RowCount(const char* list) { return Find<QTableView>(list).model()->rowCount(); }

  TemporaryFolder Folder;
  StringTable Strings;
  FakeClock Time;
  SqliteEngine Databases;
  FakeEventPump Events;
  FakeFileDialog Dialog;
  LinuxFiles Disk;
  FakeFolders Places;
  FakeMessageBoxes Boxes;
  FakeSerialDevices Devices;
  FakeSerialPort Port;
  std::unique_ptr<frmRx> Window;
};
