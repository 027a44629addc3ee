#include "board/ScoreListModel.h"

#include <QFont>
#include <QGuiApplication>
#include <QPalette>
#include <string_view>
#include <utility>

#include "ui/TeamColours.h"

ScoreListModel::ScoreListModel(ScoreList& list, const Game& game, QStringList headers, int teamColumn,
                               QObject* parent)
    : QAbstractTableModel(parent),
      list_(list),
      game_(game),
      headers_(std::move(headers)),
      teamColumn_(teamColumn) {
  list_.Changed = [this] {
    beginResetModel();
    shownRows_ = list_.RowCount();
    endResetModel();
  };
}

ScoreListModel::~ScoreListModel() {
  list_.Changed = nullptr;
}

int ScoreListModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : shownRows_;
}

int ScoreListModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(headers_.size());
}

QVariant ScoreListModel::data(const QModelIndex& index, int role) const {
  if (!index.isValid() || index.row() >= list_.RowCount()) {
    return {};
  }
  const ScoreList::Row& shown = list_.RowAt(index.row());
  const int column = index.column();
  switch (role) {
    case Qt::DisplayRole:
      return QString::fromStdString(shown.Cells[static_cast<std::size_t>(column)]);
    case Qt::ToolTipRole:
      return column == teamColumn_ ? QString::fromStdString(shown.Cells[static_cast<std::size_t>(column)])
                                   : QVariant();
    case Qt::TextAlignmentRole:
      return AlignmentOf(column);
    case Qt::DecorationRole: {
      const int team = TeamOfRow(shown);
      return column == teamColumn_ && team > 0 ? QVariant(TeamBadge(team)) : QVariant();
    }
    case Qt::BackgroundRole: {
      const int team = TeamOfRow(shown);
      return team > 0 ? QVariant(TeamTint(team, QGuiApplication::palette().base().color())) : QVariant();
    }
    default:
      return {};
  }
}

QVariant ScoreListModel::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal || section < 0 || section >= headers_.size()) {
    return {};
  }
  if (role == Qt::DisplayRole) {
    return headers_[section];
  }
  if (role == Qt::TextAlignmentRole) {
    return AlignmentOf(section);
  }
  return {};
}

QVariant ScoreListModel::AlignmentOf(int column) const {
  const auto horizontal = column == 0             ? Qt::AlignHCenter
                          : column == teamColumn_ ? Qt::AlignLeft
                                                  : Qt::AlignRight;
  return QVariant(Qt::AlignVCenter | horizontal);
}

int ScoreListModel::TeamOfRow(const ScoreList::Row& row) const {
  const std::string_view text = row.Cells[static_cast<std::size_t>(teamColumn_)];
  const std::string_view word = text.substr(0, text.find(' '));
  for (int team = 1; team <= TeamCount; ++team) {
    if (word == game_.TeamNames(team)) {
      return team;
    }
  }
  return 0;
}
