#pragma once

#include "archive/copies/BackupCopies.h"

#include <gmock/gmock.h>

#include <QApplication>
#include <QLabel>
#include <QProgressBar>
#include <QTableView>
#include <fstream>

#include "platform/qt/QtEventPump.h"
#include "tests/archive/copies/CopySite.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Controls.h"

inline constexpr const char* EarlyFile = "members-2013-05-01-200000.mdb";
inline constexpr const char* LateFile = "members-2013-05-02-200000-kept.mdb";

/// Backup Copies over a database of members that has two copies.
class BackupCopiesWindow : public testing::Test {
 protected:
  BackupCopiesWindow() {
    site.PutCopy(EarlyFile, CopySite::WithMembers("'Old'"));
    site.PutCopy(LateFile, CopySite::WithMembers("'Ann', 'Bob', 'Cid', 'Dee'"));
  }

  void Make(Language language) {
    strings.emplace(language);
    std::vector<CopiedDatabase> databases = {site.Members};
    databases.insert(databases.end(), more.begin(), more.end());
    window = std::make_unique<BackupCopies>(BackupCopies::Parts{.Databases = std::move(databases),
                                                                .Work = {.Engine = site.Databases,
                                                                         .Disk = site.Disk,
                                                                         .Time = site.Time,
                                                                         .Strings = *strings,
                                                                         .Folder = site.CopyFolder()},
                                                                .Events = events,
                                                                .Boxes = boxes,
                                                                .FileDialog = dialog,
                                                                .Busy = [this] { return busy; },
                                                                .Reopen =
                                                                    [this] {
                                                                      site.Open();
                                                                      ++reopened;
                                                                    }},
                                            nullptr);
  }

  void Open(Language language = Language::English) {
    Make(language);
    Show(*window);
    WaitForCounts();
  }

  QTableView& Table() const { return Find<QTableView>(*window, "CopyTable"); }
  QString Status() const { return Find<QLabel>(*window, "Status").text(); }
  bool Enabled(const char* button) const { return Find<QPushButton>(*window, button).isEnabled(); }

  int Uncounted() const {
    int rows = 0;
    for (int row = 0; row < Table().model()->rowCount(); ++row) {
      rows += Cells(row)[CopyListModel::Rows] == "..." ? 1 : 0;
    }
    return rows;
  }

  void WaitForCounts() const {
    ASSERT_TRUE(QTest::qWaitFor([this] { return Uncounted() == 0; }));
  }

  std::vector<std::string> Cells(int row) const {
    std::vector<std::string> cells;
    for (int column = 0; column < CopyListModel::Size; ++column) {
      cells.push_back(Table().model()->index(row, column).data().toString().toStdString());
    }
    return cells;
  }

  static FakeMessageBoxes::Box InDataFolder(const std::string& file) {
    return {file + " lies in the folder of the data in use, or is in use itself. Choose another folder.",
            "Backup Copies", BoxIcon::Exclamation, BoxButtons::Ok};
  }

  CopySite site;
  std::vector<CopiedDatabase> more;  ///< beside the members
  std::optional<StringTable> strings;
  FakeMessageBoxes boxes;
  FakeFileDialog dialog;
  QtEventPump events;
  std::optional<OwnText> busy;
  int reopened = 0;
  std::unique_ptr<BackupCopies> window;
};
