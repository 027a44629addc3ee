#include "archive/history/HistoryRows.h"

#include <algorithm>
#include <utility>

void HistoryRows::Show(int rows, TextOf textOf) {
  beginResetModel();
  rows_ = rows;
  textOf_ = std::move(textOf);
  endResetModel();
}

int HistoryRows::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : rows_;
}

int HistoryRows::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(captions_.size());
}

QVariant HistoryRows::SideOf(int column) const {
  const bool isText = std::ranges::find(textColumns_, column) != textColumns_.end();
  return QVariant(Qt::AlignVCenter | (isText ? Qt::AlignLeft : Qt::AlignRight));
}

QVariant HistoryRows::data(const QModelIndex& index, int role) const {
  if (role == Qt::TextAlignmentRole) {
    return SideOf(index.column());
  }
  return role == Qt::DisplayRole && index.row() < rows_ ? QVariant(textOf_(index.row(), index.column()))
                                                        : QVariant();
}

QVariant HistoryRows::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal) {
    return {};
  }
  if (role == Qt::TextAlignmentRole) {
    return SideOf(section);
  }
  return role == Qt::DisplayRole ? QVariant(captions_.value(section)) : QVariant();
}
