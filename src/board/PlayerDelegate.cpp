#include "board/PlayerDelegate.h"

#include <QPainter>
#include <QStyle>
#include <QWidget>
#include <algorithm>

#include "board/ScoreListModel.h"

namespace {

constexpr double PlayerSize = 0.72;  ///< relative to the cell's font size
constexpr double NameSize = 0.68;

QFont Smaller(QFont font, double size) {
  font.setPointSizeF(font.pointSizeF() * size);
  return font;
}

void DrawLine(QPainter& painter, const QRect& place, Qt::Alignment alignment, const QString& text) {
  painter.drawText(place, static_cast<int>(Qt::AlignLeft | alignment) | Qt::TextSingleLine, text);
}

}  // namespace

QString FittingGunName(const QString& name, const QFontMetrics& metrics, int width) {
  const auto blank = name.lastIndexOf(QLatin1Char(' '));
  if (blank < 0 || metrics.horizontalAdvance(name) <= width) {
    return name;
  }
  const QString number = name.mid(blank);
  return metrics.elidedText(name.left(blank).trimmed(), Qt::ElideRight,
                            std::max(width - metrics.horizontalAdvance(number), 0)) +
         number;
}

// The gun's name alone decides how wide the column must be.
void PlayerDelegate::initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const {
  QStyledItemDelegate::initStyleOption(option, index);
  option->text = index.data(ScoreListModel::NameRole).toString();
}

void PlayerDelegate::paint(QPainter* painter, const QStyleOptionViewItem& option,
                           const QModelIndex& index) const {
  QStyleOptionViewItem cell = option;
  initStyleOption(&cell, index);
  const QString gun = cell.text;
  const QString memberName = index.data(ScoreListModel::MemberNameRole).toString();
  const QStyle& style = *cell.widget->style();
  const QRect place = style.subElementRect(QStyle::SE_ItemViewItemText, &cell, cell.widget);
  const int margin = style.pixelMetric(QStyle::PM_FocusFrameHMargin, &cell, cell.widget) + 1;
  if (memberName.isEmpty()) {
    cell.text = FittingGunName(gun, QFontMetrics(cell.font), place.width() - 2 * margin);
    style.drawControl(QStyle::CE_ItemViewItem, &cell, painter, cell.widget);
    return;
  }
  cell.text.clear();
  style.drawControl(QStyle::CE_ItemViewItem, &cell, painter, cell.widget);
  const QRect lines(place.left() + margin, cell.rect.top() + 1, place.width() - margin,
                    cell.rect.height() - 2);
  const bool selected = cell.state.testFlag(QStyle::State_Selected);
  painter->save();
  painter->setPen(cell.palette.color(selected ? QPalette::HighlightedText : QPalette::Text));
  painter->setFont(Smaller(cell.font, PlayerSize));
  DrawLine(*painter, lines, Qt::AlignTop, FittingGunName(gun, painter->fontMetrics(), lines.width()));
  painter->setFont(Smaller(cell.font, NameSize));
  DrawLine(*painter, lines, Qt::AlignBottom,
           painter->fontMetrics().elidedText(memberName, Qt::ElideRight, lines.width()));
  painter->restore();
}
