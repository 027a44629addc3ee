#include "members/MemberDelegate.h"

#include <QApplication>
#include <QPainter>
#include <QPixmap>
#include <algorithm>

#include "members/MemberListModel.h"
#include "members/Silhouette.h"

namespace {

constexpr int Margin = 5;
constexpr int PhotoWidth = 32;
constexpr int LeastWidthForPhoto = 130;  ///< of a row; a narrower one needs it for the name

QFont NameFont(const QStyleOptionViewItem& option) {
  QFont font = option.font;
  font.setBold(true);
  return font;
}

void PaintPhoto(QPainter& painter, const QRect& place, const QPixmap& photo, QColor ink) {
  if (photo.isNull()) {
    constexpr int faint = 75;
    ink.setAlpha(faint);
    DrawSilhouette(painter, place, ink);
    return;
  }
  QRect inside(QPoint(0, 0), photo.size().scaled(place.size(), Qt::KeepAspectRatio));
  inside.moveCenter(place.center());
  painter.setRenderHint(QPainter::SmoothPixmapTransform);
  painter.drawPixmap(inside, photo);
}

/// An equals sign in a ring.
void PaintSharedMark(QPainter& painter, const QRect& place, const QColor& colour) {
  const double unit = place.width() / 16.0;
  const auto at = [&](double x, double y) {
    return QPointF(place.left() + x * unit, place.top() + y * unit);
  };
  painter.save();
  painter.setRenderHint(QPainter::Antialiasing);
  painter.setPen(QPen(colour, 1.5 * unit, Qt::SolidLine, Qt::RoundCap));
  painter.drawEllipse(QRectF(at(1, 1), at(15, 15)));
  painter.drawLine(at(5, 6.3), at(11, 6.3));
  painter.drawLine(at(5, 9.7), at(11, 9.7));
  painter.restore();
}

void PaintLine(QPainter& painter, const QRect& place, const QFont& font, const QString& text) {
  painter.setFont(font);
  painter.drawText(place, Qt::AlignVCenter | Qt::AlignLeft | Qt::TextSingleLine,
                   QFontMetrics(font).elidedText(text, Qt::ElideRight, place.width()));
}

}  // namespace

QString MemberDelegate::DetailsText(const QModelIndex& index, const QFontMetrics& letters, int width) {
  const QString nickName = index.data(MemberListModel::NickNameRole).toString();
  QString date = index.data(MemberListModel::LastPlayedDateRole).toString();
  const QString separator = nickName.isEmpty() ? QString() : QStringLiteral(" \u00b7 ");
  for (const QString& lastPlayed : {index.data(MemberListModel::LastPlayedRole).toString(), date}) {
    QString text = nickName + separator + lastPlayed;
    if (letters.horizontalAdvance(text) <= width) {
      return text;
    }
  }
  if (nickName.isEmpty()) {
    return date;
  }
  constexpr int least = 4;  // three letters and the dots
  const int room = width - letters.horizontalAdvance(separator + date);
  const QString cut = letters.elidedText(nickName, Qt::ElideRight, room);
  return cut.size() < least ? nickName : cut + separator + date;
}

void MemberDelegate::paint(QPainter* painter, const QStyleOptionViewItem& option,
                           const QModelIndex& index) const {
  QStyleOptionViewItem row = option;
  initStyleOption(&row, index);
  const QWidget* view = row.widget;
  QStyle* style = view != nullptr ? view->style() : QApplication::style();
  style->drawPrimitive(QStyle::PE_PanelItemViewItem, &row, painter, view);
  const bool selected = (row.state & QStyle::State_Selected) != 0;
  const QPalette::ColorGroup group =
      (row.state & QStyle::State_Active) != 0 ? QPalette::Active : QPalette::Inactive;
  const QColor ink = row.palette.color(group, selected ? QPalette::HighlightedText : QPalette::Text);

  painter->save();
  const QRect inside = row.rect.adjusted(Margin, Margin, -Margin, -Margin);
  QRect text = inside;
  if (inside.width() >= LeastWidthForPhoto) {
    PaintPhoto(*painter, {inside.topLeft(), QSize(PhotoWidth, inside.height())},
               index.data(Qt::DecorationRole).value<QPixmap>(), ink);
    text.setLeft(inside.left() + PhotoWidth + Margin);
  }
  painter->setPen(ink);
  QRect name = text;
  name.setHeight(text.height() / 2);
  text.setTop(name.bottom() + 1);
  if (index.data(MemberListModel::SharedNameRole).toBool()) {
    const int size = row.fontMetrics.height();
    const QRect mark(name.right() - size + 1, name.center().y() - size / 2, size, size);
    PaintSharedMark(*painter, mark, ink);
    name.setRight(mark.left() - Margin);
  }
  PaintLine(*painter, name, NameFont(row), index.data(Qt::DisplayRole).toString());
  PaintLine(*painter, text, row.font, DetailsText(index, row.fontMetrics, text.width()));
  painter->restore();

  if ((row.state & QStyle::State_HasFocus) != 0) {
    QStyleOptionFocusRect focus;
    focus.QStyleOption::operator=(row);
    focus.backgroundColor = row.palette.color(group, selected ? QPalette::Highlight : QPalette::Base);
    style->drawPrimitive(QStyle::PE_FrameFocusRect, &focus, painter, view);
  }
}

QSize MemberDelegate::sizeHint(const QStyleOptionViewItem& option, const QModelIndex& /*index*/) const {
  const int lines = QFontMetrics(NameFont(option)).height() + QFontMetrics(option.font).height();
  return {PhotoWidth, std::max(lines, PhotoWidth) + 2 * Margin};
}
