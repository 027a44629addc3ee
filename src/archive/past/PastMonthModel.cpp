#include "archive/past/PastMonthModel.h"

#include <algorithm>

#include "ui/Text.h"

PastMonthModel::PastMonthModel(const StringTable& strings) : strings_(strings) {
  Show({});
}

void PastMonthModel::Show(const std::vector<MonthOfGames>& months) {
  beginResetModel();
  entries_ = {{ListedPast::All}};
  for (const MonthOfGames& month : months) {
    entries_.front().Games += month.Games;
    entries_.push_back({ListedPast::Month, month.Month, month.Games});
  }
  entries_.push_back({ListedPast::Deleted});
  endResetModel();
}

int PastMonthModel::RowOf(const Entry& entry) const {
  const auto found = std::find_if(entries_.begin(), entries_.end(), [&entry](const Entry& other) {
    return other.Which == entry.Which && other.Month == entry.Month;
  });
  if (found != entries_.end()) {
    return static_cast<int>(found - entries_.begin());
  }
  return entries_.size() > 2 ? 1 : 0;
}

int PastMonthModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(entries_.size());
}

int PastMonthModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : ColumnCount;
}

QVariant PastMonthModel::data(const QModelIndex& index, int role) const {
  if (role == Qt::DisplayRole) {
    return TextOf(At(index.row()), index.column());
  }
  if (role == Qt::TextAlignmentRole && index.column() == Games) {
    return QVariant(Qt::AlignRight | Qt::AlignVCenter);
  }
  return {};
}

QVariant PastMonthModel::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation == Qt::Horizontal && role == Qt::DisplayRole) {
    return TextList(strings_, OwnText::PastMonthHeads).value(section);
  }
  if (orientation == Qt::Horizontal && role == Qt::TextAlignmentRole) {
    return QVariant((section == Games ? Qt::AlignRight : Qt::AlignLeft) | Qt::AlignVCenter);
  }
  return QAbstractTableModel::headerData(section, orientation, role);
}

QString PastMonthModel::TextOf(const Entry& entry, int column) const {
  if (column == Games) {
    return entry.Which == ListedPast::Deleted ? QString() : QString::number(entry.Games);
  }
  switch (entry.Which) {
    case ListedPast::All:
      return Text(strings_, OwnText::PastAllGames);
    case ListedPast::Deleted:
      return Text(strings_, OwnText::PastDeleted);
    case ListedPast::Month:
      break;
  }
  return QString::fromStdString(entry.Month);
}
