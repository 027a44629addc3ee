#pragma once

#include <QAbstractTableModel>

/// The table beside a chart: rows of texts and numbers, which are made when they are shown.
class ChartRows : public QAbstractTableModel {
  Q_OBJECT

 public:
  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

 protected:
  explicit ChartRows(QObject* parent) : QAbstractTableModel(parent) {}

 private:
  virtual int Rows() const = 0;
  virtual int Columns() const = 0;
  /// Texts stand to the left of their columns, numbers to the right.
  virtual bool IsText(int column) const = 0;
  virtual QString Caption(int column) const = 0;
  virtual QString Cell(int row, int column) const = 0;

  QVariant SideOf(int column) const;
};
