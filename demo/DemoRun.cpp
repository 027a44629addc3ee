#include "demo/DemoRun.h"

#include <QAction>
#include <QCheckBox>
#include <QComboBox>
#include <QFileInfo>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QSaveFile>
#include <QScreen>
#include <QTest>
#include <cstdio>

#include "board/MissionResultEntry.h"
#include "board/PlayerDetails.h"
#include "demo/BoardText.h"
#include "demo/DemoMission.h"
#include "devices/radio/RemoteManage.h"
#include "members/MemberListView.h"
#include "members/Members.h"
#include "settings/Settings.h"
#include "sheets/PrintOptions.h"

namespace {

// Ports of the simulated venue, as in the settings that the demo starts with.
constexpr int RadioPort = 2;

QTableView& List(const QMainWindow& window, const char* name) {
  return *window.findChild<QTableView*>(QString::fromLatin1(name));
}

}  // namespace

DemoRun::DemoRun(QMainWindow& window, DemoSource source, const QDir& folder)
    : window_(window),
      source_(source),
      folder_(folder),
      board_(List(window, "ScoreDisplay")),
      teams_(List(window, "TeamScores")),
      operator_(folder),
      audience_(window, operator_, folder) {}

QStringList DemoRun::Run() {
  if (!QTest::qWaitForWindowExposed(&window_)) {
    return {QStringLiteral("The main window did not appear.")};
  }
  window_.setGeometry(window_.screen()->availableGeometry());
  audience_.SeeVenue();
  PullGame();
  WriteBoard(Step::Download);
  SaveGame(QStringLiteral("game.xml"));
  AssignMembers();
  PlayMission();
  CommitGame();
  SaveGame(QStringLiteral("game-final.xml"));
  PrintSheets();
  WriteBoard(Step::End);
  audience_.SeeResults();
  ShowBoard();
  ShowDetails();
  ShowMembers();
  if (source_ == DemoSource::BaseUnit) {
    UsePort(RadioPort);
    ManageGuns();
  }
  return operator_.Faults();
}

QAction& DemoRun::Item(const char* name) const {
  return *window_.findChild<QAction*>(QString::fromLatin1(name));
}

std::function<void()> DemoRun::ByMenu(const char* item) const {
  return [&action = Item(item)] { action.trigger(); };
}

// The button's handler waits for the download, so pressing it returns only when that has ended.
void DemoRun::PullGame() {
  if (source_ == DemoSource::Radio) {
    ManageGuns();
  } else {
    Press<QPushButton>(window_, "GetScores");
  }
}

void DemoRun::UsePort(int number) {
  operator_.Within<Settings>(ByMenu("mnuCommPort"), [number](Settings& settings) {
    settings.findChild<QLineEdit*>(QStringLiteral("CommPortNumber"))->setText(QString::number(number));
    Press<QPushButton>(settings, "SaveExit");
  });
}

void DemoRun::ManageGuns() {
  const auto open = [this] { Press<QPushButton>(window_, "RemoteManageButton"); };
  operator_.Within<RemoteManage>(open, [this](RemoteManage& radio) {
    Press<QRadioButton>(radio, "Guns224");
    Press<QPushButton>(radio, "SearchGunsButton");
    if (source_ == DemoSource::Radio) {
      Press<QPushButton>(radio, "GetScoresButton");
    }
    operator_.SavePicture(radio, QStringLiteral("remote.png"));
    Press<QPushButton>(radio, "Close");
  });
}

QString DemoRun::PlayerIn(int row) const {
  return board_.model()->index(row, 1).data().toString();
}

int DemoRun::RowWithoutName() const {
  const int rows = board_.model()->rowCount();
  for (int row = 0; row < rows; ++row) {
    if (!PlayerIn(row).contains(u':')) {
      return row;
    }
  }
  return -1;
}

bool DemoRun::IsOnBoard(const DemoMember& member) const {
  const QString name = QStringLiteral(": ") + QString::fromStdString(member.ShownName());
  const int rows = board_.model()->rowCount();
  for (int row = 0; row < rows; ++row) {
    if (PlayerIn(row).endsWith(name)) {
      return true;
    }
  }
  return false;
}

void DemoRun::AssignMembers() {
  for (const DemoMember& member : DemoMembers()) {
    const int row = RowWithoutName();
    if (row < 0) {
      return;
    }
    if (!IsOnBoard(member)) {
      AssignMember(row, member);
    }
  }
}

void DemoRun::AssignMember(int row, const DemoMember& member) {
  operator_.WithPopup(board_, row, [&](QMenu& menu) {
    const auto open = [&] { Operator::Choose(menu, Item("mnuAssignMember")); };
    operator_.Within<Members>(open, [&](Members& members) {
      auto* search = members.findChild<QLineEdit*>(QStringLiteral("SearchText"));
      search->setText(QString::fromStdString(member.Details.FirstName));
      QTest::keyClick(search, Qt::Key_Return);
      Press<QPushButton>(members, "OK");
    });
  });
  if (!IsOnBoard(member)) {
    operator_.AddFault(QStringLiteral("%1 was not assigned.").arg(QString::fromStdString(member.FullName())));
  }
}

void DemoRun::PlayMission() {
  auto* mission = window_.findChild<QComboBox*>(QStringLiteral("ActiveMission"));
  mission->setCurrentText(QString::fromStdString(DemoMission().Name));
  operator_.Within<MissionResultEntry>(ByMenu("mnuMissionResults"), [](MissionResultEntry& results) {
    for (const char* objective : {"PrimaryCompleted1", "SecondaryCompleted2", "PrimaryCompleted3"}) {
      results.findChild<QCheckBox*>(QString::fromLatin1(objective))->click();
    }
    Press<QPushButton>(results, "OK");
  });
}

void DemoRun::CommitGame() {
  operator_.TakeMessage();
  Item("mnuCommitGame").trigger();
  if (operator_.TakeMessage() != QStringLiteral("Scores have been committed to the Database")) {
    operator_.AddFault(QStringLiteral("The game was not committed."));
  }
}

void DemoRun::SaveGame(const QString& name) {
  const QString file = folder_.absoluteFilePath(name);
  operator_.EnterFile(ByMenu("mnuSaveScores"), file);
  if (QFileInfo(file).size() == 0) {
    operator_.AddFault(QStringLiteral("The game was not saved as %1.").arg(name));
  }
}

void DemoRun::PrintSheets() {
  operator_.TakeMessage();
  operator_.Within<PrintOptions>(ByMenu("mnuPrintScores"), [](PrintOptions& options) {
    options.findChild<QRadioButton*>(QStringLiteral("PrintFile"))->click();
    Press<QPushButton>(options, "OK");
  });
  if (operator_.TakeMessage().isEmpty()) {
    operator_.AddFault(QStringLiteral("The score sheets were not made."));
  }
}

void DemoRun::WriteBoard(Step step) {
  const QAbstractItemModel& board = *board_.model();
  const QAbstractItemModel& teams = *teams_.model();
  const QString suffix = step == Step::End ? QStringLiteral("-final.tsv") : QStringLiteral(".tsv");
  std::printf("%s\n%s\n", qUtf8Printable(Aligned(board)), qUtf8Printable(Aligned(teams)));
  WriteFile(u"board" + suffix, TabSeparated(board));
  WriteFile(u"teams" + suffix, TabSeparated(teams));
}

void DemoRun::WriteFile(const QString& name, const QString& text) {
  QSaveFile file(folder_.absoluteFilePath(name));
  if (!file.open(QIODevice::WriteOnly) || file.write(text.toUtf8()) < 0 || !file.commit()) {
    operator_.AddFault(QStringLiteral("%1: %2").arg(name, file.errorString()));
  }
}

void DemoRun::ShowBoard() {
  board_.clearSelection();
  board_.scrollToTop();
  operator_.SavePicture(window_, QStringLiteral("board.png"));
}

void DemoRun::ShowDetails() {
  if (board_.model()->rowCount() == 0) {
    return;
  }
  operator_.WithPopup(board_, 0, [this](QMenu& menu) {
    const auto open = [&] { Operator::Choose(menu, Item("mnuShowDetailed")); };
    operator_.Within<PlayerDetails>(open, [this](PlayerDetails& details) {
      operator_.SavePicture(details, QStringLiteral("details.png"));
      details.close();
    });
  });
}

void DemoRun::ShowMembers() {
  operator_.Within<Members>(ByMenu("mnuManageMembers"), [this](Members& members) {
    auto* list = members.findChild<MemberListView*>(QStringLiteral("MemberHits"));
    constexpr int lowHeight = 560;  // makes the photograph smaller, and with it the picture's file
    members.resize(members.width(), lowHeight);
    list->grab();  // the list reads the photographs of the rows that it has shown
    while (list->ReadNextDetails()) {
    }
    operator_.SavePicture(members, QStringLiteral("members.png"));
    members.close();
  });
}
