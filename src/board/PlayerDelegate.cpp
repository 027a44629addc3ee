#include "board/PlayerDelegate.h"

#include <QPainter>
#include <QStyle>
#include <QWidget>
#include <algorithm>

#include "board/ListFonts.h"
#include "board/ScoreListModel.h"
#include "board/ScoreListView.h"

namespace {

constexpr int EdgeMargin = 2;
constexpr int LeastGap = 2;  ///< between gun and name; a single pixel is lost between smooth letters
constexpr double SmallestGun = 0.34;

/// Of letters and of what hangs below their line.
int NameHeight(const QFontMetrics& metrics, const QString& letters) {
  return std::max(metrics.tightBoundingRect(letters).height(), metrics.capHeight() + metrics.descent());
}

QFont GunFont(const QStyleOptionViewItem& cell) {
  // A list of another kind shows its letters as they are.
  const auto* list = qobject_cast<const ScoreListView*>(cell.widget);
  return Grown(cell.font, list != nullptr ? list->SizeOfGuns() : GunSize(1));
}

/// Base line of a name whose letters take `ink` around it, below a gun that reaches down to `gunEnd`. Letters
/// taller than capitals go lower, as far as nothing of them hangs below the line: they would cover the gun.
int NameLine(const QRect& ink, const QFontMetrics& metrics, int gunEnd, const QRect& cell) {
  const int usual = cell.bottom() - EdgeMargin - metrics.descent();
  const int lowest = cell.bottom() - EdgeMargin - std::max(ink.bottom(), 0);
  const int gap = LeastGap + metrics.capHeight() / 16;
  return std::clamp(gunEnd + gap - ink.top(), usual, std::max(lowest, usual));
}

QString MemberNameOf(const QModelIndex& index) {
  return index.data(ScoreListModel::MemberNameRole).toString();
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

double GunSize(double growth) {
  constexpr double ofSmallest = 0.72;
  return std::max(ofSmallest / growth, SmallestGun);
}

double GunSizeIn(int rowHeight, double growth, const QFont& font, const QString& letters) {
  if (growth <= 1) {
    return GunSize(1);
  }
  const QFontMetrics metrics(font);
  const double room = rowHeight - 2 * EdgeMargin - LeastGap - growth * NameHeight(metrics, letters);
  const double inFullSize = growth * metrics.tightBoundingRect(letters).height();
  return std::clamp(room / inFullSize, SmallestGun, GunSize(growth));
}

int LeastRowOfMember(const QFont& font, const QString& letters) {
  const QFontMetrics gun(Grown(font, GunSize(1)));
  return 2 * EdgeMargin + gun.tightBoundingRect(letters).height() + LeastGap +
         NameHeight(QFontMetrics(font), letters);
}

// The gun's name alone decides how wide the column must be.
void PlayerDelegate::initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const {
  BoardDelegate::initStyleOption(option, index);
  option->text = index.data(ScoreListModel::NameRole).toString();
}

QSize PlayerDelegate::sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const {
  QSize size = BoardDelegate::sizeHint(option, index);
  if (!MemberNameOf(index).isEmpty()) {
    QStyleOptionViewItem cell = option;
    initStyleOption(&cell, index);
    size.rwidth() -= QFontMetrics(cell.font).horizontalAdvance(cell.text) -
                     QFontMetrics(GunFont(cell)).horizontalAdvance(cell.text);
  }
  return size;
}

void PlayerDelegate::PaintCell(QPainter& painter, const QStyleOptionViewItem& cell,
                               const QModelIndex& index) const {
  const QString memberName = MemberNameOf(index);
  const QRect place = TextPlace(cell);
  PaintGround(painter, cell);
  if (memberName.isEmpty()) {
    PaintText(painter, cell, FittingGunName(cell.text, cell.fontMetrics, place.width()));
    return;
  }
  painter.save();
  painter.setPen(cell.palette.color(QPalette::Text));
  painter.setFont(GunFont(cell));
  const QFontMetrics gun = painter.fontMetrics();
  const QString gunName = FittingGunName(cell.text, gun, place.width());
  const QRect gunInk = gun.tightBoundingRect(gunName);
  const int gunLine = cell.rect.top() + EdgeMargin - gunInk.top();
  painter.drawText(place.left(), gunLine, gunName);
  painter.setFont(cell.font);
  const QFontMetrics name = painter.fontMetrics();
  const QString text = name.elidedText(memberName, Qt::ElideRight, place.width());
  painter.drawText(place.left(),
                   NameLine(name.tightBoundingRect(text), name, gunLine + gunInk.bottom() + 1, cell.rect),
                   text);
  painter.restore();
}

bool PlayerDelegate::IsCut(const QStyleOptionViewItem& cell, const QModelIndex& index) const {
  const QString memberName = MemberNameOf(index);
  const int width = TextPlace(cell).width();
  if (memberName.isEmpty()) {
    return BoardDelegate::IsCut(cell, index);
  }
  return QFontMetrics(cell.font).horizontalAdvance(memberName) > width ||
         QFontMetrics(GunFont(cell)).horizontalAdvance(cell.text) > width;
}
