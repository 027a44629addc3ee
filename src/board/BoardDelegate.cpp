#include "board/BoardDelegate.h"

#include <QAbstractItemView>
#include <QHelpEvent>
#include <QPainter>
#include <QToolTip>
#include <algorithm>

#include "board/ScoreListModel.h"
#include "ui/TeamColours.h"

namespace {

/// Above and below each cell of a row, and at the row's ends.
void DrawFrame(QPainter& painter, const QStyleOptionViewItem& cell, const QModelIndex& index) {
  constexpr int thickness = 2;
  const QColor colour = cell.palette.color(QPalette::Text);
  const QRect& place = cell.rect;
  painter.fillRect(place.left(), place.top(), place.width(), thickness, colour);
  painter.fillRect(place.left(), place.bottom() - thickness + 1, place.width(), thickness, colour);
  if (index.column() == 0) {
    painter.fillRect(place.left(), place.top(), thickness, place.height(), colour);
  }
  if (index.column() == index.model()->columnCount() - 1) {
    painter.fillRect(place.right() - thickness + 1, place.top(), thickness, place.height(), colour);
  }
}

}  // namespace

int BadgeSize(double capitals) {
  constexpr int least = 16;
  constexpr double ofCapitals = 1.1;
  return std::max(qRound(capitals * ofCapitals), least);
}

void BoardDelegate::initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const {
  QStyledItemDelegate::initStyleOption(option, index);
  if (option->features.testFlag(QStyleOptionViewItem::HasDecoration)) {
    const int side = BadgeSize(QFontMetricsF(option->font).capHeight());
    option->decorationSize = QSize(side, side);
  }
}

void BoardDelegate::paint(QPainter* painter, const QStyleOptionViewItem& option,
                          const QModelIndex& index) const {
  QStyleOptionViewItem cell = option;
  initStyleOption(&cell, index);
  const bool selected = cell.state.testFlag(QStyle::State_Selected);
  if (selected) {
    cell.state &= ~(QStyle::State_Selected | QStyle::State_HasFocus);
    cell.backgroundBrush = TeamTint(index.data(ScoreListModel::TeamRole).toInt(),
                                    cell.palette.color(QPalette::Base), SelectedRowTint);
  }
  PaintCell(*painter, cell, index);
  if (selected) {
    DrawFrame(*painter, cell, index);
  }
}

void BoardDelegate::PaintCell(QPainter& painter, const QStyleOptionViewItem& cell,
                              const QModelIndex& /*index*/) const {
  PaintGround(painter, cell);
  PaintText(painter, cell, cell.text);
}

// The style takes its time for each cell, so it gets only those with more than a colour.
void BoardDelegate::PaintGround(QPainter& painter, const QStyleOptionViewItem& cell) {
  const bool isPlain = !cell.features.testFlag(QStyleOptionViewItem::HasDecoration) &&
                       !cell.state.testFlag(QStyle::State_HasFocus);
  if (isPlain) {
    painter.fillRect(cell.rect, cell.backgroundBrush);
    return;
  }
  QStyleOptionViewItem ground = cell;
  ground.text.clear();
  cell.widget->style()->drawControl(QStyle::CE_ItemViewItem, &ground, &painter, cell.widget);
}

void BoardDelegate::PaintText(QPainter& painter, const QStyleOptionViewItem& cell, const QString& text) {
  const QFontMetrics& metrics = cell.fontMetrics;
  const QRect place = TextPlace(cell);
  const int width = metrics.horizontalAdvance(text);
  const bool isCut = width > place.width();
  const QString shown = isCut ? metrics.elidedText(text, Qt::ElideRight, place.width()) : text;
  const QSize size(isCut ? metrics.horizontalAdvance(shown) : width, metrics.capHeight());
  const QRect ink = QStyle::alignedRect(cell.direction, cell.displayAlignment, size, place);
  painter.setPen(cell.palette.color(QPalette::Text));
  painter.setFont(cell.font);
  painter.drawText(ink.left(), ink.bottom() + 1, shown);
}

bool BoardDelegate::helpEvent(QHelpEvent* event, QAbstractItemView* view, const QStyleOptionViewItem& option,
                              const QModelIndex& index) {
  if (event->type() != QEvent::ToolTip) {
    return QStyledItemDelegate::helpEvent(event, view, option, index);
  }
  QStyleOptionViewItem cell = option;
  if (index.isValid()) {
    initStyleOption(&cell, index);
  }
  if (index.isValid() && IsCut(cell, index)) {
    QToolTip::showText(event->globalPos(), index.data().toString(), view, view->visualRect(index));
  } else {
    QToolTip::hideText();
  }
  return true;
}

bool BoardDelegate::IsCut(const QStyleOptionViewItem& cell, const QModelIndex& /*index*/) const {
  return QFontMetrics(cell.font).horizontalAdvance(cell.text) > TextPlace(cell).width();
}

QRect BoardDelegate::TextPlace(const QStyleOptionViewItem& cell) {
  const QStyle& style = *cell.widget->style();
  const QRect place = cell.features.testFlag(QStyleOptionViewItem::HasDecoration)
                          ? style.subElementRect(QStyle::SE_ItemViewItemText, &cell, cell.widget)
                          : cell.rect;
  const int margin = style.pixelMetric(QStyle::PM_FocusFrameHMargin, &cell, cell.widget) + 1;
  return place.adjusted(margin, 0, -margin, 0);
}
