#pragma once

#include <gtest/gtest.h>

#include <QGuiApplication>
#include <QLabel>
#include <QProgressBar>
#include <QTableView>
#include <algorithm>
#include <chrono>
#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "devices/radio/RemoteManage.h"
#include "tests/devices/radio/HealthyGun.h"
#include "tests/support/Controls.h"

/// The window in front of a site, in both languages.
class RemoteWindow : public testing::TestWithParam<Language>, protected RadioSite {
 protected:
  RemoteWindow() : RadioSite(GetParam()) {
    OnPacket = [this](const Bytes& packet) {
      const bool there = std::find(guns.begin(), guns.end(), packet[1]) != guns.end();
      if (there && (packet[4] == 6 || packet[1] != silent)) {
        Arrive(5, Received(packet[1], AnswerTo(packet)));
      }
    };
    window.show();
  }

  void Press(const char* button) { ::Press(window, button); }
  std::string TextOf(const char* label) const { return Find<QLabel>(window, label).text().toStdString(); }
  const QAbstractItemModel& List() const { return *Find<QTableView>(window, "DataList").model(); }

  std::vector<std::string> Row(int row) const {
    std::vector<std::string> cells;
    for (int column = 0; column < List().columnCount(); ++column) {
      cells.push_back(List().index(row, column).data().toString().toStdString());
    }
    return cells;
  }
  std::vector<std::string> Column(int column) const {
    std::vector<std::string> cells;
    for (int row = 0; row < List().rowCount(); ++row) {
      cells.push_back(Row(row)[static_cast<std::size_t>(column)]);
    }
    return cells;
  }

  std::string Red() const { return Strings.Text(114); }

  /// The operator does this in mid-run.
  void Meanwhile(int delay, std::function<void()> act) {
    Events.At(std::chrono::milliseconds(delay), std::move(act));
  }

  void ExpectUsable() {
    EXPECT_FALSE(Port.PortOpen());
    EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
    EXPECT_TRUE(window.isVisible());
    EXPECT_FALSE(Find<QProgressBar>(window, "Progress").isVisible());
    OnPacket = [](const Bytes&) {};
    const std::size_t before = Port.Log.size();
    Press("SearchGunsButton");
    EXPECT_GT(Port.Log.size(), before + 128);
    EXPECT_EQ(TextOf("StatusLabel"), "Idle");
  }

  Bytes guns;
  int silent = 0;  ///< this gun answers the search alone
  Game game{Strings};
  std::vector<std::pair<int, int>> counts;  ///< what the window told of its fetches
  int fetchesEnded = 0;
  RemoteManage window{
      {.MSComm1 = Port,
       .Port = Line,
       .Events = Events,
       .Boxes = Boxes,
       .Time = Time,
       .Strings = Strings,
       .Game = game,
       .Fetching = [this](int fetched, int present) { counts.emplace_back(fetched, present); },
       .FetchEnded = [this] { ++fetchesEnded; }},
      nullptr};
};
