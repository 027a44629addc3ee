#pragma once

#include <QAbstractTableModel>
#include <memory>

#include "archive/PastGame.h"
#include "archive/past/PastBoard.h"
#include "core/game/BoardTexts.h"

/// The board of a past game, each row in its team's colour.
class PastBoardModel : public QAbstractTableModel {
 public:
  /// `strings` must outlive the model.
  explicit PastBoardModel(const StringTable& strings);

  /// Shows this game. Throws RuntimeError as ListPastPlayers does; nothing is shown then.
  void Show(PastGame game, const NickNames& nickNames);
  void ShowNothing();
  /// The game shown, null if none.
  const PastGame* Shown() const { return game_.get(); }

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

 private:
  const StringTable& strings_;
  const PastGame none_;  ///< for the captions
  std::unique_ptr<PastGame> game_;
  std::unique_ptr<BoardTexts> texts_;
  Board board_{[] {}};
};
