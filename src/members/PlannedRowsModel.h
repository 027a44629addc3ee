#pragma once

#include <QAbstractTableModel>
#include <optional>
#include <vector>

#include "core/text/StringTable.h"
#include "members/MemberImport.h"

/// The lines of a file and what an import does with each of them. Texts are made when they come into view.
class PlannedRowsModel : public QAbstractTableModel {
  Q_OBJECT

 public:
  enum Columns { LineColumn, NameColumn, FateColumn, ColumnCount };

  PlannedRowsModel(const StringTable& strings, QObject* parent);

  /// Lists the rows of `plan`, which stays as it is until the next call; null for none. With `fate` only
  /// those that it becomes of.
  void Show(const ImportPlan* plan, std::optional<RowFate> fate);

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

 private:
  const StringTable& strings_;
  const ImportPlan* plan_ = nullptr;
  std::vector<std::size_t> listed_;  // places in the plan
};
