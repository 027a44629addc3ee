#pragma once

#include <QAbstractTableModel>

#include "core/game/BoardTexts.h"
#include "core/game/Session.h"

/// Presents one of a session's lists to the toolkit, each row in its team's colour. Any number of models may
/// show the same list.
class ScoreListModel : public QAbstractTableModel {
  Q_OBJECT

 public:
  /// The text of a cell in two parts.
  enum Role { NameRole = Qt::UserRole, MemberNameRole };

  /// `session` and `strings` must outlive the model's views.
  ScoreListModel(Session& session, BoardList list, const StringTable& strings, QObject* parent);

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

 private:
  void ShowRows();
  QString TextOf(const BoardRow& row, BoardColumn column) const;

  const BoardList kind_;
  const Board& list_;
  BoardTexts texts_;
  int shownRows_ = 0;  ///< rows that the views know of; they hear of others by a reset
  Subscription subscription_;
};
