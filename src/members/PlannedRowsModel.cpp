#include "members/PlannedRowsModel.h"

#include <QApplication>
#include <QFont>

#include "core/text/Pieces.h"
#include "members/ImportTexts.h"

PlannedRowsModel::PlannedRowsModel(const StringTable& strings, QObject* parent)
    : QAbstractTableModel(parent), strings_(strings) {}

void PlannedRowsModel::Show(const ImportPlan* plan, std::optional<RowFate> fate) {
  beginResetModel();
  plan_ = plan;
  listed_.clear();
  for (std::size_t place = 0; plan_ != nullptr && place < plan_->Rows.size(); ++place) {
    if (!fate || plan_->Rows[place].Fate == *fate) {
      listed_.push_back(place);
    }
  }
  endResetModel();
}

int PlannedRowsModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(listed_.size());
}

int PlannedRowsModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : ColumnCount;
}

QVariant PlannedRowsModel::data(const QModelIndex& index, int role) const {
  const PlannedRow& row = plan_->Rows[listed_[static_cast<std::size_t>(index.row())]];
  if (role == Qt::TextAlignmentRole && index.column() == LineColumn) {
    return int{Qt::AlignRight | Qt::AlignVCenter};
  }
  if (role == Qt::FontRole && row.Fate == RowFate::Refused) {
    QFont font = QApplication::font("QAbstractItemView");
    font.setBold(true);
    return font;
  }
  if (role != Qt::DisplayRole && role != Qt::ToolTipRole) {
    return {};
  }
  switch (index.column()) {
    case LineColumn:
      return QString::number(row.Line);
    case NameColumn:
      return QString::fromStdString(row.Name);
    default:
      return QString::fromStdString(TextOfRow(row, strings_));
  }
}

QVariant PlannedRowsModel::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal || role != Qt::DisplayRole) {
    return {};
  }
  return QString::fromStdString(
      PartsOf(strings_.Text(OwnText::PlannedRowHeadings), '|').at(static_cast<std::size_t>(section)));
}
