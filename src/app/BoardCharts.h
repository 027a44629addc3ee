#pragma once

#include <functional>
#include <memory>
#include <string>

#include "charts/GameCharts.h"
#include "core/game/Session.h"

/// The charts of the game on the board. Their window follows the board as long as it is open.
class BoardCharts {
 public:
  /// `session`, which must be open when Open is called, `parts` and `mainWindow` must outlive this.
  /// `received` tells since when the game is on the board, "YYYY-MM-DD HH:MM:SS"; `player` names a player.
  BoardCharts(Session& session, const GameCharts::Parts& parts, const QWidget& mainWindow,
              std::function<std::string()> received, std::function<ChartPlayer(int index)> player);

  /// Opens the window, or brings it to the front.
  void Open();
  void Close();

  /// Names them anew in the window if it is open.
  void ShowOtherNames();

 private:
  void MakeWindow();
  void ShowBoard();

  Session& session_;
  const GameCharts::Parts parts_;
  const QWidget& mainWindow_;
  const std::function<std::string()> received_;
  const std::function<ChartPlayer(int index)> player_;
  std::unique_ptr<GameCharts> window_;  ///< once opened
  Subscription subscription_;
};
