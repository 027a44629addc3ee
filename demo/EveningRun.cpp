#include "demo/EveningRun.h"

#include <unistd.h>

#include <QAction>
#include <QPushButton>
#include <QRegularExpression>
#include <QStandardPaths>
#include <QTest>
#include <cstdio>
#include <map>

#include "demo/PageReader.h"
#include "platform/sqlite/SqliteDatabase.h"

namespace {

constexpr int AnswerLimit = 20'000;  // ms; far longer than anything takes
constexpr int GameLimit = 600'000;   // ms that a game of the evening may last
constexpr int FirstId = 32;          // of the gun with record 1

QByteArray TextOfFile(const QString& path) {
  QFile file(path);
  return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

/// Of a process, in kB; 0 if it is gone.
int ResidentMemory(const QString& process) {
  static const QRegularExpression line(QStringLiteral("VmRSS:\\s*(\\d+)"));
  return line.match(QString::fromLatin1(TextOfFile(QStringLiteral("/proc/%1/status").arg(process))))
      .captured(1)
      .toInt();
}

/// The child process that serves the pages; empty if there is none.
QString ServingProcess() {
  const QByteArray children = TextOfFile(QStringLiteral("/proc/self/task/%1/children").arg(getpid()));
  for (const QByteArray& child : children.split(' ')) {
    QString process = QString::fromLatin1(child);
    const QByteArray words = TextOfFile(QStringLiteral("/proc/%1/cmdline").arg(process));
    if (words.contains("tessarine-results") && !words.contains("--ask")) {
      return process;
    }
  }
  return {};
}

}  // namespace

EveningRun::EveningRun(QMainWindow& window, const VenuesEvening& evening, const QDir& folder)
    : window_(window),
      audience_(*window.findChild<AudienceBoard*>()),
      results_(*window.findChild<ResultsHost*>()),
      evening_(evening),
      played_(evening.Players, evening.Seed, std::chrono::seconds(1)),
      folder_(folder),
      operator_(folder),
      memory_(QStringLiteral("Game\tProgram, kB\tServing program, kB\n")) {}

QStringList EveningRun::Run(int games) {
  if (!QTest::qWaitForWindowExposed(&window_) ||
      !QTest::qWaitFor([this] { return !results_.Url().empty(); }, AnswerLimit)) {
    return {QStringLiteral("The main window did not appear, or the results page is not answered.")};
  }
  int told = 0;
  for (int game = 1; game <= games; ++game) {
    told = AwaitGame(told);
    PullGame();
    TakeBoard(game, told);
    NoteMemory(game);
  }
  Require(RowsOfPages(games), QStringLiteral("pages"));
  Require(RowsOfArchive(), QStringLiteral("archive"));
  QFile file(folder_.absoluteFilePath(QStringLiteral("evening.tsv")));
  if (!file.open(QIODevice::WriteOnly) || file.write(memory_.toUtf8()) < 0) {
    operator_.AddFault(file.errorString());
  }
  std::printf("%s", qUtf8Printable(memory_));
  return operator_.Faults();
}

int EveningRun::AwaitGame(int later) {
  int latest = later;
  const bool came = QTest::qWaitFor(
      [&] {
        static const QRegularExpression line(QStringLiteral("^game (\\d+)$"),
                                             QRegularExpression::MultilineOption);
        for (auto match = line.globalMatch(QString::fromUtf8(TextOfFile(evening_.Told))); match.hasNext();) {
          latest = match.next().captured(1).toInt();
        }
        return latest > later;
      },
      GameLimit);
  if (!came) {
    operator_.AddFault(QStringLiteral("No game came after game %1.").arg(later));
  }
  return latest;
}

void EveningRun::PullGame() {
  if (!shown_.empty()) {
    operator_.ExpectQuestion();
    Item("mnuClearScores").trigger();
  }
  Press<QPushButton>(window_, "GetScores");
}

QAction& EveningRun::Item(const char* name) const {
  return *window_.findChild<QAction*>(QString::fromLatin1(name));
}

void EveningRun::TakeBoard(int game, int told) {
  constexpr int mostMeanwhile = 100;  // games that end between the venue's word and the pull
  int number = told;
  while (number < told + mostMeanwhile && !IsPlayed(number)) {
    ++number;
  }
  if (number == told + mostMeanwhile) {
    operator_.AddFault(QStringLiteral("The board of game %1 is none that the venue played.").arg(game));
  }
  for (const Standing& player : audience_.State().Results().Players) {
    shown_.emplace(game, player.Place, player.Index, player.Soldiering);
  }
}

bool EveningRun::IsPlayed(int number) const {
  std::map<int, int> shots;
  for (const sim::GunScores& gun : played_.Game(number)) {
    shots[gun.PlayerId - FirstId + 1] = gun.ShotCount;
  }
  std::map<int, int> shown;
  for (const Standing& player : audience_.State().Results().Players) {
    shown[player.Index] = player.Shots;
  }
  return shots == shown;
}

void EveningRun::NoteMemory(int game) {
  memory_ += QStringLiteral("%1\t%2\t%3\n")
                 .arg(game)
                 .arg(ResidentMemory(QStringLiteral("self")))
                 .arg(ResidentMemory(ServingProcess()));
}

EveningRun::Rows EveningRun::RowsOfPages(int games) {
  PageReader reader;
  const auto pages = reader.ReadFrom(QUrl(QString::fromStdString(results_.Url())));
  for (const QString& path : reader.Missing()) {
    operator_.AddFault(QStringLiteral("A link leads to %1, which is not served.").arg(path));
  }
  Rows rows;
  for (int game = 1; game <= games; ++game) {
    const QString path = QStringLiteral("/en/g/%1/").arg(game);
    const auto page = pages.find(path);
    const QRegularExpression row(
        QStringLiteral("<tr><td[^>]*>(\\d+)<.*?<a href=\"(?:%1)?(\\d+)\".*?</a><td[^>]*>(-?\\d+)").arg(path));
    for (auto match = row.globalMatch(page != pages.end() ? QString::fromUtf8(page->second) : QString());
         match.hasNext();) {
      const QRegularExpressionMatch found = match.next();
      rows.emplace(game, found.captured(1).toInt(), found.captured(2).toInt(),
                   found.captured(3).toLongLong());
    }
  }
  return rows;
}

EveningRun::Rows EveningRun::RowsOfArchive() const {
  const QString path = QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation) +
                       QStringLiteral("/Orvalin/Tessarine/games.mdb");
  SqliteEngine databases;
  const auto archive = databases.OpenDatabase(path.toStdString());
  Rows rows;
  archive->Statements().Query(
      "SELECT GameID, Place, PlayerIndex, Soldiering FROM GamePlayers", {}, [&rows](const SqlRow& row) {
        rows.emplace(static_cast<int>(row.Integer(0)), static_cast<int>(row.Integer(1)),
                     static_cast<int>(row.Integer(2)), row.Integer(3));
      });
  return rows;
}

void EveningRun::Require(const Rows& rows, const QString& where) {
  std::printf("%s: %zu players of all games, %zu on the boards\n", qUtf8Printable(where), rows.size(),
              shown_.size());
  if (rows != shown_) {
    operator_.AddFault(QStringLiteral("The %1 differ from the boards that were shown.").arg(where));
  }
}
