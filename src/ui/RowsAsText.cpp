#include "ui/RowsAsText.h"

#include <QAbstractItemView>
#include <QClipboard>
#include <QGuiApplication>
#include <QStringList>
#include <optional>

namespace {

/// Nothing if `goOn` ended it.
std::optional<QString> TextOfRows(const QAbstractItemView& list,
                                  const std::function<bool(double done)>& goOn) {
  const QAbstractItemModel& rows = *list.model();
  QStringList cells;
  for (int column = 0; column < rows.columnCount(); ++column) {
    cells.append(rows.headerData(column, Qt::Horizontal).toString());
  }
  QString text = cells.join(QLatin1Char('\t')) + QLatin1Char('\n');
  const bool all = !list.selectionModel()->hasSelection();
  const int count = rows.rowCount();
  for (int row = 0; row < count; ++row) {
    if (!goOn(static_cast<double>(row) / count)) {
      return std::nullopt;
    }
    if (all || list.selectionModel()->isRowSelected(row)) {
      cells.clear();
      for (int column = 0; column < rows.columnCount(); ++column) {
        cells.append(rows.index(row, column).data().toString());
      }
      text.append(cells.join(QLatin1Char('\t'))).append(QLatin1Char('\n'));
    }
  }
  return text;
}

}  // namespace

QString RowsAsText(const QAbstractItemView& list) {
  return *TextOfRows(list, [](double) { return true; });
}

void CopyRows(const QAbstractItemView& list) {
  QGuiApplication::clipboard()->setText(RowsAsText(list));
}

bool CopyRowsInSteps(const QAbstractItemView& list, const std::function<bool(double done)>& goOn) {
  const std::optional<QString> text = TextOfRows(list, goOn);
  if (text) {
    QGuiApplication::clipboard()->setText(*text);
  }
  return text.has_value();
}
