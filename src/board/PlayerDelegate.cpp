#include "board/PlayerDelegate.h"

#include <QPainter>
#include <QStyle>
#include <QWidget>

#include "board/ScoreListModel.h"

namespace {

constexpr double PlayerSize = 0.72;  ///< relative to the cell's font size
constexpr double NameSize = 0.68;

void DrawLine(QPainter& painter, const QRect& place, QFont font, double size, const QString& text,
              Qt::Alignment alignment) {
  font.setPointSizeF(font.pointSizeF() * size);
  const QString fitting = QFontMetrics(font).elidedText(text, Qt::ElideRight, place.width());
  painter.setFont(font);
  painter.drawText(place, static_cast<int>(Qt::AlignLeft | alignment) | Qt::TextSingleLine, fitting);
}

}  // namespace

void PlayerDelegate::paint(QPainter* painter, const QStyleOptionViewItem& option,
                           const QModelIndex& index) const {
  QStyleOptionViewItem cell = option;
  initStyleOption(&cell, index);
  const QString memberName = index.data(ScoreListModel::MemberNameRole).toString();
  if (memberName.isEmpty()) {
    QStyledItemDelegate::paint(painter, option, index);
    return;
  }
  const QStyle& style = *cell.widget->style();
  const QRect place = style.subElementRect(QStyle::SE_ItemViewItemText, &cell, cell.widget);
  cell.text.clear();
  style.drawControl(QStyle::CE_ItemViewItem, &cell, painter, cell.widget);
  const bool selected = cell.state.testFlag(QStyle::State_Selected);
  const int margin = style.pixelMetric(QStyle::PM_FocusFrameHMargin, &cell, cell.widget) + 1;
  const QRect lines(place.left() + margin, cell.rect.top() + 1, place.width() - margin,
                    cell.rect.height() - 2);
  painter->save();
  painter->setPen(cell.palette.color(selected ? QPalette::HighlightedText : QPalette::Text));
  DrawLine(*painter, lines, cell.font, PlayerSize, index.data(ScoreListModel::NameRole).toString(),
           Qt::AlignTop);
  DrawLine(*painter, lines, cell.font, NameSize, memberName, Qt::AlignBottom);
  painter->restore();
}
