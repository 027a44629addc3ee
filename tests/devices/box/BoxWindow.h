#pragma once

#include <gtest/gtest.h>

#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <memory>
#include <string>
#include <vector>

#include "devices/box/BoxConfig.h"
#include "tests/devices/box/BoxSite.h"
#include "tests/fakes/FakeSoundPlayer.h"
#include "tests/support/Controls.h"
#include "ui/ResultList.h"

/// The window of utility boxes on a line with a box, in either language.
class BoxWindow : public testing::TestWithParam<Language>, protected BoxSite {
 protected:
  BoxWindow() : BoxSite(GetParam()) { Open(); }

  void Open() {
    window = std::make_unique<BoxConfig>(BoxConfig::Parts{.MSComm1 = Port,
                                                          .Port = Line,
                                                          .Events = Events,
                                                          .Boxes = Boxes,
                                                          .Time = Time,
                                                          .Strings = Strings,
                                                          .Game = game,
                                                          .Programmed = programmed,
                                                          .Signals = {Ini, &sounds, Strings}},
                                         nullptr);
    Show(*window);
  }

  void Press(const char* button) { ::Press(*window, button); }
  QLineEdit& Entry(const char* name) const { return Find<QLineEdit>(*window, name); }
  QComboBox& List(const char* name) const { return Find<QComboBox>(*window, name); }
  ResultList& Results() const { return Find<ResultList>(*window, "Results"); }
  std::string Sign() const { return Find<QLabel>(*window, "Sign").text().toStdString(); }

  /// Pastes over an entry.
  void Enter(const char* name, const std::string& text) const {
    Entry(name).setFocus();
    Entry(name).selectAll();
    QTest::keyClick(&Entry(name), Qt::Key_Delete);
    Entry(name).insert(QString::fromStdString(text));
  }

  /// Goes on to the next control as the Tab key does, and lets the check run.
  void Leave() const {
    Type(*window, Qt::Key_Tab);
    QCoreApplication::processEvents();
  }

  std::vector<std::string> Row(int row) const {
    std::vector<std::string> cells;
    for (int column = 0; column < 5; ++column) {
      cells.push_back(Results().item(row, column)->text().toStdString());
    }
    return cells;
  }

  std::string In(const char* english, const char* chinese) const {
    return GetParam() == Language::English ? english : chinese;
  }

  FakeSoundPlayer sounds{Events};
  Game game{Strings};
  ProgrammedBoxes programmed;
  std::unique_ptr<BoxConfig> window;
};
