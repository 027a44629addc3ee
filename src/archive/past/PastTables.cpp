#include "archive/past/PastTables.h"

#include <QFontMetrics>
#include <QHeaderView>
#include <QShortcut>
#include <QTableView>
#include <algorithm>

#include "archive/past/PastGameModel.h"
#include "archive/past/PastMonthModel.h"
#include "core/game/Board.h"
#include "ui/RowsAsText.h"

namespace {

constexpr int CellMargins = 24;

/// Nothing is read of rows that are not in view, so widths come from what cells may hold.
void SetWidths(QTableView& table, int column, const QString& sample) {
  const QFontMetrics metrics(table.font());
  const QString caption = table.model()->headerData(column, Qt::Horizontal).toString();
  table.setColumnWidth(
      column, std::max(metrics.horizontalAdvance(sample), metrics.horizontalAdvance(caption)) + CellMargins);
}

void SetRows(QTableView& table) {
  constexpr int rowMargins = 8;
  table.verticalHeader()->hide();
  table.verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
  table.verticalHeader()->setDefaultSectionSize(QFontMetrics(table.font()).height() + rowMargins);
  table.horizontalHeader()->setHighlightSections(false);
}

}  // namespace

void SetUpMonthTable(QTableView& table) {
  SetRows(table);
  table.horizontalHeader()->setSectionResizeMode(PastMonthModel::Month, QHeaderView::Stretch);
  SetWidths(table, PastMonthModel::Games, QStringLiteral("000000"));
  table.horizontalHeader()->setStretchLastSection(false);
}

void SetUpGameTable(QTableView& table) {
  SetRows(table);
  SetWidths(table, PastGameModel::Time, QStringLiteral("00/00/0000 00:00"));
  for (int column = PastGameModel::Players; column <= PastGameModel::LastTeam; ++column) {
    SetWidths(table, column, QStringLiteral("-00000"));
  }
  SetWidths(table, PastGameModel::Pulls, QStringLiteral("00"));
  SetWidths(table, PastGameModel::Committed, QStringLiteral("000"));
  for (const int column : {PastGameModel::Mission, PastGameModel::Best}) {
    table.horizontalHeader()->setSectionResizeMode(column, QHeaderView::Stretch);
  }
}

void SetUpBoardTable(QTableView& table) {
  SetRows(table);
  table.horizontalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
  table.horizontalHeader()->setSectionResizeMode(static_cast<int>(BoardColumn::Player), QHeaderView::Stretch);
}

void CopiesRows(QAbstractItemView& list) {
  const auto* copy = new QShortcut(QKeySequence::Copy, &list, nullptr, nullptr, Qt::WidgetShortcut);
  QObject::connect(copy, &QShortcut::activated, &list, [&list] { CopyRows(list); });
}
