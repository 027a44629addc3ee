#include "demo/BoardText.h"

#include <QStringList>
#include <QVector>
#include <algorithm>

namespace {

QVector<QStringList> LinesOf(const QAbstractItemModel& list) {
  QStringList header;
  for (int column = 0; column < list.columnCount(); ++column) {
    header.append(list.headerData(column, Qt::Horizontal).toString());
  }
  QVector<QStringList> lines = {header};
  for (int row = 0; row < list.rowCount(); ++row) {
    QStringList cells;
    for (int column = 0; column < list.columnCount(); ++column) {
      cells.append(list.index(row, column).data().toString());
    }
    lines.append(cells);
  }
  return lines;
}

bool IsLeftAligned(const QAbstractItemModel& list, int column) {
  const QVariant alignment = list.headerData(column, Qt::Horizontal, Qt::TextAlignmentRole);
  return (alignment.toInt() & Qt::AlignLeft) != 0;
}

}  // namespace

QString TabSeparated(const QAbstractItemModel& list) {
  QString text;
  for (const QStringList& line : LinesOf(list)) {
    text += line.join(u'\t') + u'\n';
  }
  return text;
}

QString Aligned(const QAbstractItemModel& list) {
  const QVector<QStringList> lines = LinesOf(list);
  QVector<qsizetype> widths(list.columnCount(), 0);
  for (const QStringList& line : lines) {
    for (qsizetype column = 0; column < line.size(); ++column) {
      widths[column] = std::max(widths[column], line[column].size());
    }
  }
  QString text;
  for (const QStringList& line : lines) {
    for (qsizetype column = 0; column < line.size(); ++column) {
      const bool isName = IsLeftAligned(list, static_cast<int>(column));
      text +=
          isName ? line[column].leftJustified(widths[column]) : line[column].rightJustified(widths[column]);
      text += column + 1 < line.size() ? QStringLiteral("  ") : QStringLiteral("\n");
    }
  }
  return text;
}
