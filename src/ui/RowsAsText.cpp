#include "ui/RowsAsText.h"

#include <QAbstractItemView>
#include <QClipboard>
#include <QGuiApplication>
#include <QStringList>

QString RowsAsText(const QAbstractItemView& list) {
  const QAbstractItemModel& rows = *list.model();
  QStringList cells;
  for (int column = 0; column < rows.columnCount(); ++column) {
    cells.append(rows.headerData(column, Qt::Horizontal).toString());
  }
  QStringList lines = {cells.join(QLatin1Char('\t'))};
  const bool all = !list.selectionModel()->hasSelection();
  for (int row = 0; row < rows.rowCount(); ++row) {
    if (all || list.selectionModel()->isRowSelected(row)) {
      cells.clear();
      for (int column = 0; column < rows.columnCount(); ++column) {
        cells.append(rows.index(row, column).data().toString());
      }
      lines.append(cells.join(QLatin1Char('\t')));
    }
  }
  return lines.join(QLatin1Char('\n')) + QLatin1Char('\n');
}

void CopyRows(const QAbstractItemView& list) {
  QGuiApplication::clipboard()->setText(RowsAsText(list));
}
