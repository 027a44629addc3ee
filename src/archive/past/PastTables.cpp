#include "archive/past/PastTables.h"

#include <QEvent>
#include <QFontMetrics>
#include <QHeaderView>
#include <QScrollBar>
#include <QShortcut>
#include <QTableView>
#include <algorithm>
#include <functional>
#include <utility>

#include "archive/past/PastGameModel.h"
#include "archive/past/PastMonthModel.h"
#include "core/game/Board.h"

namespace {

constexpr int CellMargins = 14;

/// Width of a cell with this text, or of the column's caption if that is wider.
int WidthOf(const QTableView& table, int column, const QString& sample) {
  return std::max(QFontMetrics(table.font()).horizontalAdvance(sample) + CellMargins,
                  table.horizontalHeader()->sectionSizeHint(column));
}

/// Nothing is read of rows that are not in view, so widths come from what cells may hold.
void SetWidth(QTableView& table, int column, const QString& sample) {
  table.setColumnWidth(column, WidthOf(table, column, sample));
}

/// Gives a column what the others leave of the list's width, and never less than it needs. The list owns it.
class RestOfWidth : public QObject {
 public:
  RestOfWidth(QTableView& table, int column, std::function<int()> least)
      : QObject(&table), table_(table), column_(column), least_(std::move(least)) {
    table.viewport()->installEventFilter(this);
    connect(table.model(), &QAbstractItemModel::modelReset, this, &RestOfWidth::Fill);
    Fill();
  }

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override {
    if (event->type() == QEvent::Resize) {
      Fill();
    }
    return QObject::eventFilter(watched, event);
  }

 private:
  void Fill() {
    QHeaderView& header = *table_.horizontalHeader();
    const int others = header.length() - header.sectionSize(column_);
    header.resizeSection(column_, std::max(least_(), table_.viewport()->width() - others));
  }

  QTableView& table_;
  const int column_;
  const std::function<int()> least_;
};

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
  SetWidth(table, PastMonthModel::Games, QStringLiteral("000000"));
  int month = WidthOf(table, PastMonthModel::Month, QStringLiteral("0000-00"));
  for (int row = 0; row < table.model()->rowCount(); ++row) {
    month = std::max(month, WidthOf(table, PastMonthModel::Month,
                                    table.model()->index(row, PastMonthModel::Month).data().toString()));
  }
  table.setColumnWidth(PastMonthModel::Month, month);
  table.setFixedWidth(month + table.columnWidth(PastMonthModel::Games) + 2 * table.frameWidth() +
                      table.verticalScrollBar()->sizeHint().width());
}

void SetUpGameTable(QTableView& table) {
  SetRows(table);
  SetWidth(table, PastGameModel::Time, PastGameModel::TimeText("2026-12-20 20:48:48"));
  for (int column = PastGameModel::Players; column <= PastGameModel::LastTeam; ++column) {
    SetWidth(table, column, QStringLiteral("-00000"));
  }
  SetWidth(table, PastGameModel::Best, QStringLiteral("Mmmmmmm, 00000"));
  SetWidth(table, PastGameModel::Pulls, QStringLiteral("00"));
  SetWidth(table, PastGameModel::Committed, QStringLiteral("000"));
  const int least = WidthOf(table, PastGameModel::Mission, QStringLiteral("Mmmmmmm"));
  new RestOfWidth(table, PastGameModel::Mission, [least] { return least; });
}

void SetUpBoardTable(QTableView& table) {
  constexpr auto player = static_cast<int>(BoardColumn::Player);
  SetRows(table);
  for (int column = 0; column < BoardColumnCount; ++column) {
    if (column != player) {
      SetWidth(table, column, QStringLiteral("-00000"));
    }
  }
  new RestOfWidth(table, player, [&table] {
    return std::max(table.horizontalHeader()->sectionSizeHint(player),
                    static_cast<const QAbstractItemView&>(table).sizeHintForColumn(player));
  });
}

void OnCopyKey(QAbstractItemView& list, std::function<void()> copy) {
  const auto* key = new QShortcut(QKeySequence::Copy, &list, nullptr, nullptr, Qt::WidgetShortcut);
  QObject::connect(key, &QShortcut::activated, &list, std::move(copy));
}
