#include "board/ScoreListModel.h"

#include <QGuiApplication>
#include <QPalette>

#include "ui/TeamColours.h"

namespace {

QVariant AlignmentOf(BoardColumn column) {
  const auto horizontal = column == BoardColumn::Rank     ? Qt::AlignHCenter
                          : column == BoardColumn::Player ? Qt::AlignLeft
                                                          : Qt::AlignRight;
  return QVariant(Qt::AlignVCenter | horizontal);
}

}  // namespace

ScoreListModel::ScoreListModel(Session& session, BoardList list, const StringTable& strings, QObject* parent)
    : QAbstractTableModel(parent),
      kind_(list),
      list_(session.List(list)),
      texts_(session.Game(), strings),
      shownRows_(list_.RowCount()) {
  const auto ownChange = list == BoardList::Players ? SessionChange::PlayerRows : SessionChange::TeamRows;
  subscription_ = session.Listen([this, ownChange](SessionChange change) {
    if (change == ownChange) {
      ShowRows();
    }
  });
}

void ScoreListModel::ShowRows() {
  beginResetModel();
  shownRows_ = list_.RowCount();
  endResetModel();
}

int ScoreListModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : shownRows_;
}

int ScoreListModel::columnCount(const QModelIndex& parent) const {
  if (parent.isValid()) {
    return 0;
  }
  return kind_ == BoardList::Players ? BoardColumnCount : TeamColumnCount;
}

QVariant ScoreListModel::data(const QModelIndex& index, int role) const {
  if (!index.isValid() || index.row() >= list_.RowCount()) {
    return {};
  }
  const BoardRow& row = list_.RowAt(index.row());
  const auto column = static_cast<BoardColumn>(index.column());
  const bool isName = column == BoardColumn::Player;
  switch (role) {
    case Qt::DisplayRole:
      return TextOf(row, column);
    case Qt::ToolTipRole:
      return isName ? TextOf(row, column) : QVariant();
    case NameRole:
      return isName ? QString::fromStdString(texts_.Name(row)) : QVariant();
    case MemberNameRole:
      return isName ? QString::fromStdString(row.MemberName) : QVariant();
    case KeyRole:
      return row.Index != 0 ? row.Index : -row.Team;
    case TeamRole:
      return row.Team;
    case Qt::TextAlignmentRole:
      return AlignmentOf(column);
    case Qt::DecorationRole:
      return isName ? QVariant(TeamBadge(row.Team)) : QVariant();
    case Qt::BackgroundRole:
      return TeamTint(row.Team, QGuiApplication::palette().base().color());
    default:
      return {};
  }
}

QVariant ScoreListModel::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal || section < 0 || section >= columnCount()) {
    return {};
  }
  const auto column = static_cast<BoardColumn>(section);
  switch (role) {
    case Qt::DisplayRole:
      return QString::fromStdString(texts_.Header(kind_, column));
    case Qt::ToolTipRole:
      return QString::fromStdString(texts_.HeaderTip(kind_, column));
    case Qt::AccessibleDescriptionRole:  // what is painted and pointed at, for screen readers
      return QString(QString::fromStdString(texts_.HeaderTip(kind_, column)) + SignOf(column));
    case Qt::TextAlignmentRole:
      return AlignmentOf(column);
    case SortRole:
      return SortOf(column);
    default:
      return {};
  }
}

QVariant ScoreListModel::SortOf(BoardColumn column) const {
  if (list_.RowCount() == 0 || list_.SortedBy() != column) {
    return {};
  }
  return QVariant::fromValue(list_.SortOrder == SortOrder::Ascending ? Qt::AscendingOrder
                                                                     : Qt::DescendingOrder);
}

QString ScoreListModel::SignOf(BoardColumn column) const {
  const QVariant order = SortOf(column);
  if (!order.isValid()) {
    return {};
  }
  return order.value<Qt::SortOrder>() == Qt::AscendingOrder ? QStringLiteral(" \u25b2")
                                                            : QStringLiteral(" \u25bc");
}

QString ScoreListModel::TextOf(const BoardRow& row, BoardColumn column) const {
  return QString::fromStdString(texts_.Cell(row, column));
}
