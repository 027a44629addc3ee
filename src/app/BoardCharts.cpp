#include "app/BoardCharts.h"

#include <QScreen>
#include <string_view>
#include <utility>

#include "core/gamefile/SuggestedName.h"
#include "ui/WorkArea.h"

BoardCharts::BoardCharts(Session& session, const GameCharts::Parts& parts, const QWidget& mainWindow,
                         std::function<std::string()> received, std::function<ChartPlayer(int index)> player)
    : session_(session),
      parts_(parts),
      mainWindow_(mainWindow),
      received_(std::move(received)),
      player_(std::move(player)),
      subscription_(session.Listen([this](SessionChange change) {
        const bool isNews = change == SessionChange::Scores || change == SessionChange::Cleared;
        if (isNews) {
          ShowOtherNames();
        }
      })) {}

void BoardCharts::MakeWindow() {
  window_ = std::make_unique<GameCharts>(parts_);
  QScreen* screen = mainWindow_.screen();
  window_->setScreen(screen);
  const QRect area = screen->availableGeometry();
  const QSize room = RoomOn(*screen);
  QRect place(QPoint(), window_->size().boundedTo(room) + area.size() - room);  // with its frame
  place.moveCenter(area.center());
  window_->move(place.topLeft());
}

void BoardCharts::Open() {
  if (!window_) {
    MakeWindow();
  }
  ShowBoard();
  window_->show();
  window_->raise();
  window_->activateWindow();
}

void BoardCharts::Close() {
  if (window_) {
    window_->close();
  }
}

void BoardCharts::ShowOtherNames() {
  if (window_ && window_->isVisible()) {
    ShowBoard();
  }
}

void BoardCharts::ShowBoard() {
  const Game& game = session_.Game();
  const std::string& mission = session_.Missions().Text();
  ChartGame chart{.Game = game,
                  .Players = {},
                  .Factors = session_.Factors(),
                  .FreeForAll = session_.Missions().ListIndex() == MissionList::FreeForAll,
                  .PointsOfMission = session_.PointsOfMission(),
                  .Title = game.GameDate.empty() ? mission : mission + ", " + game.GameDate};
  const Board& board = session_.List(BoardList::Players);
  for (int place = 0; place < board.RowCount(); ++place) {
    chart.Players.push_back(player_(board.RowAt(place).Index));
  }
  if (!chart.Players.empty()) {
    constexpr std::string_view ending = ".game.xml";
    const std::string file = SuggestedGameName(received_(), mission);
    chart.FileName = file.substr(0, file.size() - ending.size());
  }
  window_->ShowGame(chart);
}
