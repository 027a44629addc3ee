#pragma once

#include <QAbstractTableModel>
#include <QStringList>
#include <vector>

#include "core/game/ScoreList.h"

/// Shows a ScoreList to the toolkit, with each row in its team's colour.
class ScoreListModel : public QAbstractTableModel {
  Q_OBJECT

 public:
  /// `teamColumn` is the column whose text begins with the team's name. Takes over `list.Changed`.
  ScoreListModel(ScoreList& list, const Game& game, QStringList headers, int teamColumn, QObject* parent);
  ~ScoreListModel() override;

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

 private:
  /// Team (1 to 3) of a row, 0 when its text names none.
  int TeamOfRow(const ScoreList::Row& row) const;
  QVariant AlignmentOf(int column) const;

  ScoreList& list_;
  const Game& game_;
  QStringList headers_;
  int teamColumn_;
  int shownRows_ = 0;  ///< rows that the views know of; the list may be half rebuilt when they ask
};
