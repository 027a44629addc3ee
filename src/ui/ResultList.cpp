#include "ui/ResultList.h"

#include <QHeaderView>

ResultList::ResultList(QWidget* parent) : QTableWidget(parent) {
  setEditTriggers(QAbstractItemView::NoEditTriggers);
  setSelectionBehavior(QAbstractItemView::SelectRows);
  setSelectionMode(QAbstractItemView::SingleSelection);
  setTabKeyNavigation(false);
  setShowGrid(false);
  setWordWrap(false);
  setCornerButtonEnabled(false);
  verticalHeader()->hide();
  horizontalHeader()->setHighlightSections(false);
}

void ResultList::SetCaptions(const QStringList& captions, int widest) {
  setColumnCount(static_cast<int>(captions.size()));
  setHorizontalHeaderLabels(captions);
  horizontalHeader()->setDefaultAlignment(Qt::AlignVCenter | Qt::AlignLeft);
  horizontalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
  horizontalHeader()->setSectionResizeMode(widest, QHeaderView::Stretch);
}

void ResultList::AddRow(const QStringList& cells, bool success, int most) {
  constexpr QColor failure(179, 38, 30, 60);
  insertRow(0);
  for (int column = 0; column < cells.size(); ++column) {
    auto* item = new QTableWidgetItem(cells[column]);
    if (!success) {
      item->setBackground(failure);
    }
    setItem(0, column, item);
  }
  if (rowCount() > most) {
    removeRow(rowCount() - 1);
  }
  // Current for the keyboard, but not selected: that would cover the tint.
  setCurrentCell(0, 0, QItemSelectionModel::NoUpdate);
  clearSelection();
  scrollToTop();
}
