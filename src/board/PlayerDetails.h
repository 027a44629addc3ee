#pragma once

#include <QDialog>
#include <memory>

#include "core/game/Game.h"
#include "core/game/HitLines.h"
#include "core/game/MemberLookup.h"

class HitBars;
class QListWidget;

namespace Ui {
class PlayerDetails;
}

/// Every figure of one player, and who hit whom.
class PlayerDetails : public QDialog {
  Q_OBJECT

 public:
  /// `playerIndex` is a record index, 1 to 224.
  PlayerDetails(int playerIndex, const Game& game, MemberLookup& members, QWidget* parent);
  ~PlayerDetails() override;

 private:
  void ShowFigures(const Player& player);
  static void ShowHits(const std::vector<Hit>& hits, const Game& game, MemberLookup& members,
                       QListWidget& list, HitBars& bars);

  std::unique_ptr<Ui::PlayerDetails> ui_;
};
