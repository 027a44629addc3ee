#pragma once

#include <QStringList>
#include <functional>
#include <vector>

#include "charts/ChartRows.h"

/// Rows of texts that are made when they are shown.
class HistoryRows : public ChartRows {
  Q_OBJECT

 public:
  using TextOf = std::function<QString(int row, int column)>;

  /// Columns of texts are aligned left, all others are of numbers.
  HistoryRows(QStringList captions, std::vector<int> textColumns, QObject* parent)
      : ChartRows(parent), captions_(std::move(captions)), textColumns_(std::move(textColumns)) {}

  /// `textOf` is asked until the next call.
  void Show(int rows, TextOf textOf);

 private:
  int Rows() const override { return rows_; }
  int Columns() const override { return static_cast<int>(captions_.size()); }
  bool IsText(int column) const override;
  QString Caption(int column) const override { return captions_.value(column); }
  QString Cell(int row, int column) const override { return textOf_(row, column); }

  const QStringList captions_;
  const std::vector<int> textColumns_;
  int rows_ = 0;
  TextOf textOf_;
};
