#include "charts/ChartTable.h"

#include <QHeaderView>
#include <QKeyEvent>
#include <QScopedValueRollback>

#include "ui/RowsAsText.h"

ChartTable::ChartTable(QWidget* parent) : QTableView(parent) {
  setEditTriggers(QAbstractItemView::NoEditTriggers);
  setSelectionBehavior(QAbstractItemView::SelectRows);
  setTabKeyNavigation(false);
  setShowGrid(false);
  setWordWrap(false);
  setAlternatingRowColors(true);
  setCornerButtonEnabled(false);
  setHorizontalScrollMode(QAbstractItemView::ScrollPerPixel);
  verticalHeader()->hide();
  verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
  verticalHeader()->setDefaultSectionSize(fontMetrics().height() + 6);
  horizontalHeader()->setHighlightSections(false);
  constexpr int rowsMeasured = 250;
  horizontalHeader()->setResizeContentsPrecision(rowsMeasured);
}

void ChartTable::FitColumns() {
  resizeColumnsToContents();
}

void ChartTable::GoTo(int row) {
  const QScopedValueRollback<bool> follows(following_, true);
  const QModelIndex index = model()->index(row, 0);
  selectionModel()->setCurrentIndex(index, QItemSelectionModel::NoUpdate);
  scrollTo(index);
}

void ChartTable::keyPressEvent(QKeyEvent* event) {
  if (event->matches(QKeySequence::Copy)) {
    CopyRows(*this);
  } else {
    QTableView::keyPressEvent(event);
  }
}

void ChartTable::currentChanged(const QModelIndex& current, const QModelIndex& previous) {
  QTableView::currentChanged(current, previous);
  if (!following_ && current.isValid() && hasFocus()) {
    emit RowReached(current.row());
  }
}
