#pragma once

#include <QDialog>
#include <memory>

#include "core/game/BoardTexts.h"
#include "core/game/Game.h"
#include "core/game/HitLines.h"
#include "core/game/MemberLookup.h"

class HitBars;
class QListWidget;

namespace Ui {
class PlayerDetails;
}

/// Every figure of one player, and who hit whom. Page Up and Page Down go to the previous and the next player
/// of the board.
class PlayerDetails : public QDialog {
  Q_OBJECT

 public:
  struct Parts {
    const ::Game& Game;
    const Board& Players;  ///< the rows whose order Page Up and Page Down follow
    MemberLookup& Members;
    const StringTable& Strings;
  };

  /// `playerIndex` is a record index, 1 to 224.
  PlayerDetails(int playerIndex, const Parts& parts, QWidget* parent);
  ~PlayerDetails() override;

 signals:
  /// The window now shows the player of this record.
  void PlayerShown(int playerIndex);

 private:
  void ShowPlayer(int playerIndex);
  /// Shows the player that many rows below; nothing where there is none.
  void Walk(int rows);
  void ShowFigures(const Player& player);
  void ShowHits(const std::vector<Hit>& hits, QListWidget& list, HitBars& bars) const;

  const Parts parts_;
  std::unique_ptr<Ui::PlayerDetails> ui_;
  int playerIndex_ = 0;
};
