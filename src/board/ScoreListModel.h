#pragma once

#include <QAbstractTableModel>

#include "core/game/BoardTexts.h"
#include "core/game/Session.h"

/// Presents one of a session's lists to the toolkit, each row in its team's colour. Any number of models may
/// show the same list.
class ScoreListModel : public QAbstractTableModel {
  Q_OBJECT

 public:
  enum Role {
    NameRole = Qt::UserRole,  ///< the text of a cell in two parts
    MemberNameRole,
    KeyRole,   ///< int: the same for a player or team in each order of the rows and each calculation
    TeamRole,  ///< int: 1 to 3
    SortRole   ///< of a header: the Qt::SortOrder in which its column orders the rows, nothing if it does not
  };

  /// `session` and `strings` must outlive the model's views.
  ScoreListModel(Session& session, BoardList list, const StringTable& strings, QObject* parent);

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

 private:
  void ShowRows();
  QVariant SortOf(BoardColumn column) const;
  /// The sign that is painted in the header, as text; empty where there is none.
  QString SignOf(BoardColumn column) const;
  QString TextOf(const BoardRow& row, BoardColumn column) const;

  const BoardList kind_;
  const Board& list_;
  BoardTexts texts_;
  int shownRows_ = 0;  ///< rows that the views know of; they hear of others by a reset
  Subscription subscription_;
};
