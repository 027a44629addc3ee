#pragma once

#include <QTableView>

/// The figures of a chart in rows, read only. Ctrl+C copies the selected rows, or all of them, as text.
class ChartTable : public QTableView {
  Q_OBJECT

 public:
  explicit ChartTable(QWidget* parent = nullptr);

  /// Gives each column the width that its caption and the first rows need.
  void FitColumns();

  /// Makes this row the current one and brings it into view, without selecting it.
  void GoTo(int row);

 signals:
  /// The operator went to a row of the table.
  void RowReached(int row);

 protected:
  void keyPressEvent(QKeyEvent* event) override;
  void currentChanged(const QModelIndex& current, const QModelIndex& previous) override;

 private:
  bool following_ = false;  ///< goes where it is told to, not where the operator goes
};
