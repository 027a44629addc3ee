#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QListWidget>
#include <QProgressBar>
#include <QPushButton>
#include <QRadioButton>
#include <QTabBar>
#include <QTableView>

#include "board/ScoreListModel.h"
#include "demo/pictures/Pictures.h"
#include "members/MemberListView.h"

namespace {

/// Chooses the mission that has been added last: the demo's own.
void ChooseMission(Studio& studio) {
  auto& missions = In<QComboBox>(studio.Window(), "ActiveMission");
  missions.setCurrentIndex(missions.count() - 1);
}

bool HasReached(QWidget& window, int value) {
  return In<QProgressBar>(window, "Progress").value() >= value;
}

void PullGame(Studio& studio) {
  constexpr int guns = 7;
  studio.TakeWhen("UploadProgress", "download", [](QWidget& window) { return HasReached(window, guns); });
  Press<QPushButton>(studio.Window(), "GetScores");
}

void EnterResults(Studio& studio) {
  studio.Open("mnuMissionResults", [&](QWidget& window) {
    In<QComboBox>(window, "TeamA").setCurrentIndex(0);
    In<QComboBox>(window, "TeamB").setCurrentIndex(1);
    In<QComboBox>(window, "TeamC").setCurrentIndex(2);
    for (const char* done :
         {"PrimaryCompleted1", "SecondaryCompleted2", "PrimaryCompleted3", "SecondaryCompleted3"}) {
      In<QCheckBox>(window, done).setChecked(true);
    }
    studio.Take(window, "mission-results");
    Press<QPushButton>(window, "OK");
  });
}

/// Row of the best player who is a member.
int FirstMember(const QAbstractItemModel& board) {
  for (int row = 0; row < board.rowCount(); ++row) {
    if (!board.index(row, 1).data(ScoreListModel::MemberNameRole).toString().isEmpty()) {
      return row;
    }
  }
  return 0;
}

void TakePlayer(Studio& studio) {
  auto& board = In<QTableView>(studio.Window(), "ScoreDisplay");
  board.selectRow(FirstMember(*board.model()));
  board.setFocus();
  studio.Open([&board] { QTest::keyClick(&board, Qt::Key_Return); },
              [&](QWidget& window) { studio.Take(window, "player-details"); });
  studio.Open("mnuBonusPoints", [&](QWidget& window) {
    In<QLineEdit>(window, "BonusPointsEntry").setText(QStringLiteral("250"));
    studio.Take(window, "bonus-points");
    Press<QPushButton>(window, "Cancel");
  });
  studio.Open("mnuAdminData", [&](QWidget& window) { studio.Take(window, "admin-data"); });
}

void TakeMissions(Studio& studio) {
  studio.Open("mnuSetupMissions", [&](QWidget& window) {
    studio.Open([&window] { Press<QPushButton>(window, "NewButton"); },
                [&](QWidget& name) {
                  In<QLineEdit>(name, "MissionEntry").setText(QStringLiteral("Lanterns of the Old Mill"));
                  studio.Take(name, "mission-name");
                  Press<QPushButton>(name, "Cancel");
                });
    auto& missions = In<QListWidget>(window, "MissionSelection1");
    missions.setCurrentRow(missions.count() - 1);
    studio.Take(window, "missions");
  });
}

void TakeMembers(Studio& studio) {
  studio.Open("mnuManageMembers", [&](QWidget& window) {
    auto& list = In<MemberListView>(window, "MemberHits");
    list.grab();  // the list reads the photographs of the rows that it has shown
    while (list.ReadNextDetails()) {
    }
    studio.Take(window, "members");
  });
}

void TakeSheets(Studio& studio) {
  constexpr int sheets = 4;
  studio.TakeWhen(
      "SheetProgressWindow", "sheets-progress", [](QWidget& window) { return HasReached(window, sheets); },
      [](QWidget& window) { Press<QPushButton>(window, "Stop"); });
  studio.Open("mnuPrintScores", [&](QWidget& window) {
    In<QRadioButton>(window, "PrintFile").setChecked(true);
    studio.Take(window, "print-options");
    Press<QPushButton>(window, "OK");
  });
}

}  // namespace

void ChoosePort(Studio& studio, VenuePort port, const char* picture) {
  studio.Open("mnuCommPort", [&](QWidget& window) {
    In<QLineEdit>(window, "CommPortNumber").setText(QString::number(static_cast<int>(port)));
    if (picture != nullptr) {
      studio.Take(window, picture);
    }
    Press<QPushButton>(window, "SaveExit");
  });
}

void TakeDesk(Studio& studio) {
  ChoosePort(studio, VenuePort::BaseUnit, "settings");
  PullGame(studio);
  TakeMissions(studio);
  ChooseMission(studio);
  EnterResults(studio);
  studio.Take(studio.Window(), "main-window");
  studio.Open("mnuSoldieringCalc", [&](QWidget& window) { studio.Take(window, "soldiering"); });
  TakeSheets(studio);
  TakePlayer(studio);
  TakeMembers(studio);
  studio.Open("mnuAbout", [&](QWidget& window) { studio.Take(window, "about"); });
}
