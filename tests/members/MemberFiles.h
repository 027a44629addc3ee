#pragma once

#include <gmock/gmock.h>

#include <QAbstractItemView>
#include <QComboBox>
#include <QLabel>
#include <QPushButton>
#include <QTest>
#include <memory>

#include "platform/qt/QtEventPump.h"
#include "tests/support/Controls.h"
#include "tests/support/DataSite.h"

/// The surroundings of the windows that export and import members: four members, one of them with a history.
class MemberFiles : public testing::Test {
 protected:
  MemberFiles() {
    venue.PutDefaultFiles();
    venue.ChangeDatabase(
        "members.mdb",
        "INSERT INTO Members (ContactID, FirstName, LastName, Birthdate, City, TotalGamesPlayed) VALUES "
        "(1, 'Rhys', 'Morgan', '1961-04-12 00:00:00', 'Cardiff', 7), (2, 'Alice', 'Belmont', NULL, NULL, 0), "
        "(5, 'Sean', 'O''Brien', NULL, NULL, 0), (9, '小明', '王', NULL, NULL, 0)");
    database = venue.Databases.OpenDatabase(venue.DataFile("members.mdb"));
  }

  std::string Query(const std::string& sql) { return venue.QueryDatabase("members.mdb", sql); }

  static std::string LabelText(const QWidget& window, const char* name) {
    return Find<QLabel>(window, name).text().toStdString();
  }

  static void Choose(const QWidget& window, const std::string& list, int entry) {
    Find<QComboBox>(window, list).setCurrentIndex(entry);
  }

  DataSite venue;
  QtEventPump events;
  std::unique_ptr<Database> database;
};
