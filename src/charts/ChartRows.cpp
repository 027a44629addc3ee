#include "charts/ChartRows.h"

int ChartRows::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : Rows();
}

int ChartRows::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : Columns();
}

QVariant ChartRows::SideOf(int column) const {
  return QVariant(Qt::AlignVCenter | (IsText(column) ? Qt::AlignLeft : Qt::AlignRight));
}

QVariant ChartRows::data(const QModelIndex& index, int role) const {
  if (role == Qt::TextAlignmentRole) {
    return SideOf(index.column());
  }
  return role == Qt::DisplayRole && index.row() < Rows() ? QVariant(Cell(index.row(), index.column()))
                                                         : QVariant();
}

QVariant ChartRows::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal || section >= Columns()) {
    return {};
  }
  if (role == Qt::TextAlignmentRole) {
    return SideOf(section);
  }
  return role == Qt::DisplayRole ? QVariant(Caption(section)) : QVariant();
}
