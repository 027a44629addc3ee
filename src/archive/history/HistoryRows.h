#pragma once

#include <QAbstractTableModel>
#include <QStringList>
#include <functional>
#include <vector>

/// Rows of texts that are made when they are shown.
class HistoryRows : public QAbstractTableModel {
  Q_OBJECT

 public:
  using TextOf = std::function<QString(int row, int column)>;

  /// Columns of texts are aligned left, all others are of numbers.
  HistoryRows(QStringList captions, std::vector<int> textColumns, QObject* parent)
      : QAbstractTableModel(parent), captions_(std::move(captions)), textColumns_(std::move(textColumns)) {}

  /// `textOf` is asked until the next call.
  void Show(int rows, TextOf textOf);

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

 private:
  QVariant SideOf(int column) const;

  const QStringList captions_;
  const std::vector<int> textColumns_;
  int rows_ = 0;
  TextOf textOf_;
};
