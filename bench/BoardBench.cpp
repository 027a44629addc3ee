#include <QApplication>
#include <QLabel>
#include <QVBoxLayout>
#include <algorithm>
#include <chrono>
#include <ctime>
#include <filesystem>
#include <memory>
#include <vector>

#include "bench/FormerBoard.h"
#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "board/BoardPane.h"
#include "board/PlayerDelegate.h"
#include "board/ScoreListModel.h"
#include "board/ScoreListView.h"
#include "tests/support/OpenSession.h"
#include "ui/Look.h"

namespace {

using Clock = std::chrono::steady_clock;

constexpr QSize FullScreen(1920, 960);  ///< of 1920 x 1080, without menu and banner

double MicrosecondsSince(Clock::time_point start) {
  return std::chrono::duration<double, std::micro>(Clock::now() - start).count();
}

/// Of this process, so that nothing else on the machine counts.
double ProcessorMicroseconds() {
  return 1e6 * static_cast<double>(std::clock()) / CLOCKS_PER_SEC;
}

/// Both lists in a window of their own, arranged as in the program.
template <typename Pane, typename List, typename Delegate>
class Board {
 public:
  Board(Session& session, const StringTable& strings)
      : playerModel_(session, BoardList::Players, strings, nullptr),
        teamModel_(session, BoardList::Teams, strings, nullptr) {
    auto* parts = new QVBoxLayout(&Window);
    for (List* list : {players_, teams_}) {
      auto* part = new QVBoxLayout;
      part->addWidget(new QLabel(QStringLiteral("Rank"), &Window));
      part->addWidget(list);
      parts->addLayout(part, list == players_ ? 1 : 0);
    }
    players_->setModel(&playerModel_);
    players_->setItemDelegateForColumn(1, new Delegate(players_));
    players_->SetColumnShares(std::vector<double>(BoardColumnCount, 1.0 / BoardColumnCount));
    teams_->setModel(&teamModel_);
    teams_->SetColumnShares(std::vector<double>(TeamColumnCount, 1.0 / TeamColumnCount));
    teams_->ShowWholeRows(TeamCount);
    if constexpr (std::is_same_v<Pane, BoardPane>) {
      Window.SetLists(*players_, *teams_, *parts);
    } else {
      players_->setObjectName(QStringLiteral("DataList"));  // which has the same style sheet
    }
    Window.resize(FullScreen);
    Window.show();
    Paint();
  }

  /// Lets layouts follow and paints what has changed.
  void Paint() {
    QApplication::processEvents();
    Window.repaint();
    QApplication::processEvents();
  }

  Pane Window;

 private:
  ScoreListModel playerModel_;
  ScoreListModel teamModel_;
  List* const players_ = new List(&Window);
  List* const teams_ = new List(&Window);
};

using NewBoard = Board<BoardPane, ScoreListView, PlayerDelegate>;
using FormerBoard = Board<QWidget, FormerView, FormerDelegate>;

/// A session in which each of that many players is a member with a name.
class NamedGame {
 public:
  explicit NamedGame(int players) {
    std::filesystem::remove(Venue.MembersFile());
    MakeMembers(Venue.MembersFile(), PlayerCount);
    Venue.Open();
    FillCompletely(Venue.session.Game());
    for (int index = 1; index <= PlayerCount; ++index) {
      Venue.session.Game().Players(index).Active = index <= players;
      Venue.session.Game().Players(index).MemberIndex = index;
    }
    Venue.session.CalculateScores();
  }

  OpenSession Venue;
};

/// Time from the command to the painted board.
template <typename Shown>
double RecalculationTime(Session& session, Shown& board) {
  const auto start = Clock::now();
  session.CalculateScores();
  board.Paint();
  return MicrosecondsSince(start);
}

bool ReportRecalculation() {
  NamedGame game(PlayerCount);
  Session& session = game.Venue.session;
  std::vector<double> now;
  std::vector<double> former;
  constexpr int runs = 25;
  for (int run = 0; run < runs; ++run) {  // by turns, so that a busy machine slows both down
    {
      NewBoard board(session, game.Venue.Strings);
      RecalculationTime(session, board);
      now.push_back(RecalculationTime(session, board));
    }
    FormerBoard board(session, game.Venue.Strings);
    RecalculationTime(session, board);
    former.push_back(RecalculationTime(session, board));
  }
  return ReportGoal("recalculation of 224 members to the painted board / before",
                    Median(now) / Median(former), 1.2, TimesText(Median(now), Median(former)));
}

bool ReportResizing() {
  constexpr double picture = 1e6 / 60;
  NamedGame game(40);
  NewBoard board(game.Venue.session, game.Venue.Strings);
  std::vector<double> times;
  constexpr int pictures = 120;
  for (int i = 0; i < pictures; ++i) {
    const double start = ProcessorMicroseconds();
    board.Window.resize(FullScreen.width() - 5 * i, FullScreen.height() - 3 * i);
    QApplication::processEvents();  // paints at once
    times.push_back(ProcessorMicroseconds() - start);
  }
  const auto slow = times.begin() + pictures * 19 / 20;
  std::nth_element(times.begin(), slow, times.end());
  return ReportGoal("resizing with 40 players, slow pictures / 60 a second", *slow / picture, 1,
                    TimesText(*slow, picture));
}

}  // namespace

/// bench-board: the board must not pay for its large letters.
int main(int argc, char** argv) {
  QApplication application(argc, argv);
  PrepareLook();
  bool met = ReportRecalculation();
  met &= ReportResizing();
  return met ? 0 : 1;
}
