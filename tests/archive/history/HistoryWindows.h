#pragma once

#include <gmock/gmock.h>

#include <QAbstractItemView>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/linux/LinuxFiles.h"
#include "tests/archive/history/HistoryVenue.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Controls.h"

/// The windows about members in the archive. Bo played five games in two months, Cy in all of them.
class HistoryWindows : public testing::Test, protected HistoryVenue {
 protected:
  HistoryWindows() {
    Keep("2026-09-05 20:00:00", 100);
    Keep("2026-09-06 20:00:00", 300);
    Keep("2026-11-20 20:00:00", -20);
    Keep("2026-11-21 20:00:00", 120);
    Keep("2026-11-22 20:00:00", 500, false);
  }

  Sql& AskedArchive() {
    if (Failure) {
      throw *Failure;
    }
    return ArchiveSql();
  }

  /// Cells of a table's row as shown.
  static std::vector<std::string> CellsOf(const QWidget& window, const std::string& table, int row) {
    const QAbstractItemModel& model = *Find<QAbstractItemView>(window, table).model();
    std::vector<std::string> cells;
    for (int column = 0; column < model.columnCount(); ++column) {
      cells.push_back(model.index(row, column).data().toString().toStdString());
    }
    return cells;
  }
  static int RowsOf(const QWidget& window, const std::string& table) {
    return Find<QAbstractItemView>(window, table).model()->rowCount();
  }

  FakeMessageBoxes boxes;
  FakeFileDialog dialog;
  LinuxFiles disk;
  SqliteEngine engine{std::chrono::milliseconds(30)};
  std::optional<RuntimeError> Failure;
};
