#pragma once

#include <QAbstractTableModel>
#include <string>
#include <vector>

#include "archive/past/PastSearch.h"
#include "core/text/StringTable.h"

/// What can be listed: all games, those of a month, the latest first, and the deleted ones.
class PastMonthModel : public QAbstractTableModel {
 public:
  enum Column { Month, Games, ColumnCount };

  struct Entry {
    ListedPast Which;
    std::string Month = {};  ///< "2026-11"
    int Games = 0;
  };

  /// `strings` must outlive the model.
  explicit PastMonthModel(const StringTable& strings);

  void Show(const std::vector<MonthOfGames>& months);

  const Entry& At(int row) const { return entries_[static_cast<std::size_t>(row)]; }
  /// The row of the entry of this kind and month, else that of the latest month or, without one, of all
  /// games.
  int RowOf(const Entry& entry) const;

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

 private:
  QString TextOf(const Entry& entry, int column) const;

  const StringTable& strings_;
  std::vector<Entry> entries_;
};
