#pragma once

#include <QDir>
#include <QMainWindow>
#include <QStringList>
#include <set>
#include <tuple>

#include "audience/AudienceBoard.h"
#include "demo/Operator.h"
#include "sim/game/Evening.h"
#include "web/ResultsHost.h"

/// The evening that the simulated venue plays, as its operator is told of it.
struct VenuesEvening {
  int Players = 0;
  std::uint32_t Seed = 1;
  QString Told;  ///< file with what the venue prints
};

/// An evening of games, each pulled once it has ended, with board and page on. In the end the audience board,
/// the pages and the archive must agree on all games, and the boards with what the venue played. Leaves the
/// memory of the program, and of the one that serves the pages, behind each game.
class EveningRun {
 public:
  EveningRun(QMainWindow& window, const VenuesEvening& evening, const QDir& folder);

  /// Returns one line for each thing that went wrong; empty on success.
  QStringList Run(int games);

 private:
  /// Number of the game as the pages count, place, gun and points.
  using Row = std::tuple<int, int, int, qlonglong>;
  using Rows = std::set<Row>;

  int AwaitGame(int later);
  void PullGame();
  /// Takes the board as that of the game, if it is one that the venue has played by now.
  void TakeBoard(int game, int told);
  bool IsPlayed(int number) const;
  void NoteMemory(int game);
  Rows RowsOfPages(int games);
  Rows RowsOfArchive() const;
  void Require(const Rows& rows, const QString& where);
  QAction& Item(const char* name) const;

  QMainWindow& window_;
  AudienceBoard& audience_;
  const ResultsHost& results_;
  const VenuesEvening evening_;
  const sim::Evening played_;
  QDir folder_;
  Operator operator_;
  Rows shown_;
  QString memory_;
};
