#pragma once

#include <QAbstractTableModel>
#include <QPixmap>
#include <QString>
#include <vector>

#include "devices/radio/GunTable.h"

/// The guns that were found, as rows of a list. Updates are made in place, so that the selection survives.
class GunListModel : public QAbstractTableModel {
  Q_OBJECT

 public:
  /// `player` is the header of the first column.
  explicit GunListModel(const QString& player, QObject* parent);

  /// Shows the guns that ListedGuns gives: those in the list and any more. A gun leaves the list by Clear
  /// alone.
  void Show(const GunTable& guns, std::int16_t maxPlayerId);
  void Clear();

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

 private:
  struct Row {
    explicit Row(const GunEntry& gun);

    GunEntry Gun;
    QPixmap Battery;
    QPixmap Status;
  };

  /// The picture in a cell, if it has one.
  static QVariant SignOf(const Row& row, int column);

  QString player_;
  std::vector<Row> rows_;
};
