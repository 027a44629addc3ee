#pragma once

#include <QAbstractTableModel>
#include <set>
#include <string>
#include <vector>

#include "core/text/StringTable.h"
#include "takeover/TakeOverWork.h"

/// What the operator calls a kind of data.
const std::string& TitleOf(OldItem item, const StringTable& strings);

/// What an old installation has, beside what is in use. What is usable has a tick, which can be taken away.
class FoundModel : public QAbstractTableModel {
  Q_OBJECT

 public:
  enum Column { Data, Found, InUse, Remarks, ColumnCount };

  /// `strings` must outlive the model.
  explicit FoundModel(const StringTable& strings) : strings_(strings) {}

  /// Lists these, with a tick for each that is usable.
  void Show(std::vector<FoundItem> items);

  /// The kinds with a tick.
  const std::set<OldItem>& Ticked() const { return ticked_; }

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
  bool setData(const QModelIndex& index, const QVariant& value, int role = Qt::EditRole) override;
  Qt::ItemFlags flags(const QModelIndex& index) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

 private:
  const FoundItem& At(const QModelIndex& index) const {
    return items_[static_cast<std::size_t>(index.row())];
  }
  QString TextOf(const FoundItem& item, int column) const;
  std::string FoundText(const FoundItem& item) const;
  std::string InUseText(const FoundItem& item) const;

  const StringTable& strings_;
  std::vector<FoundItem> items_;
  std::set<OldItem> ticked_;
};
