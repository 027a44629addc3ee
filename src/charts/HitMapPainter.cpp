#include "charts/HitMapPainter.h"

#include <QFontMetricsF>
#include <QImage>
#include <algorithm>
#include <cmath>
#include <utility>

#include "charts/HeatImage.h"
#include "core/game/PlayerId.h"
#include "ui/TeamColours.h"
#include "ui/Text.h"

namespace {

constexpr double TeamStripe = 5;
constexpr double NameGap = 4;
constexpr double LeastNamedCell = 12;
constexpr double LargestCell = 72;
constexpr double KeyBar = 140;

/// Draws text upwards in `room`, as if `room` were turned to the right.
void DrawUpwards(QPainter& painter, const QRectF& room, int flags, const QString& text) {
  painter.save();
  painter.translate(room.bottomLeft());
  painter.rotate(-90);
  painter.drawText(QRectF(0, 0, room.height(), room.width()), flags, text);
  painter.restore();
}

}  // namespace

HitMapPainter::HitMapPainter(const HitMatrix& matrix, const StringTable& strings, const QFont& font,
                             QColor ink)
    : matrix_(matrix), strings_(strings), font_(font), ink_(ink) {
  for (int place = 0; place < matrix.Size(); ++place) {
    names_.append(QString::fromStdString(matrix.PlayerAt(place).Name));
  }
}

double HitMapPainter::LineHeight() const {
  return std::ceil(QFontMetricsF(font_).height());
}

QFont HitMapPainter::NameFont(double cell) const {
  QFont font = font_;
  const double usual = QFontMetricsF(font_).height();
  font.setPixelSize(std::max(static_cast<int>(std::min(usual, cell) * 0.76), 9));
  return font;
}

double HitMapPainter::LongestName(double cell) const {
  const QFontMetricsF metrics(NameFont(cell));
  double longest = 0;
  for (const QString& name : names_) {
    longest = std::max(longest, metrics.horizontalAdvance(name));
  }
  return std::ceil(longest) + 2 * NameGap;
}

HitMapLayout HitMapPainter::Layout(int cellPixels, double pixelRatio, double labels) const {
  const double corner =
      std::round((2 * LineHeight() + TeamStripe + 2 + std::ceil(labels)) * pixelRatio) / pixelRatio;
  HitMapLayout layout;
  layout.CellPixels = cellPixels;
  layout.Cell = cellPixels / pixelRatio;
  layout.Labels = labels;
  const double side = layout.Cell * matrix_.Size();
  layout.Cells = {corner, corner, side, side};
  layout.Whole = {std::max(layout.Cells.right(), KeyWidth()) + 1,
                  layout.Cells.bottom() + 1.7 * LineHeight() + 1};
  return layout;
}

HitMapLayout HitMapPainter::LayoutFor(QSizeF room, double pixelRatio) const {
  const double headings = 2 * LineHeight() + TeamStripe + 3;
  const double free = std::min(room.width() - headings, room.height() - headings - 1.7 * LineHeight() - 2);
  const auto pixelsWith = [&](double labels) {
    const double cell = std::min((free - labels) / std::max(matrix_.Size(), 1), LargestCell);
    return std::max(static_cast<int>(cell * pixelRatio), 2);
  };
  constexpr double mostForNames = 0.25;
  const double labels = std::min(LongestName(free / std::max(matrix_.Size(), 1)), mostForNames * free);
  const int named = pixelsWith(labels);
  return named / pixelRatio >= LeastNamedCell ? Layout(named, pixelRatio, labels)
                                              : Layout(pixelsWith(0), pixelRatio, 0);
}

HitMapLayout HitMapPainter::LayoutWith(double cell, double pixelRatio) const {
  return Layout(static_cast<int>(cell * pixelRatio), pixelRatio, LongestName(cell));
}

void HitMapPainter::Draw(QPainter& painter, const HitMapLayout& layout) const {
  painter.setFont(font_);
  painter.setPen(ink_);
  DrawHeadings(painter, layout);
  if (layout.Labels > 0) {
    DrawNames(painter, layout);
  }
  QImage heat = HeatImage(matrix_, layout.CellPixels);
  heat.setDevicePixelRatio(layout.CellPixels / layout.Cell);
  painter.drawImage(layout.Cells.topLeft(), heat);
  DrawNumbers(painter, layout);
  DrawLines(painter, layout);
  DrawKey(painter, layout);
}

void HitMapPainter::DrawHeadings(QPainter& painter, const HitMapLayout& layout) const {
  const QRectF& cells = layout.Cells;
  const double line = LineHeight();
  QFont bold = font_;
  bold.setBold(true);
  painter.setFont(bold);
  const QString who = Text(strings_, OwnText::WhoHit) + QStringLiteral(" \u2193");
  const QString whom = Text(strings_, OwnText::WhoWasHit) + QStringLiteral(" \u2192");
  painter.drawText(QRectF(cells.left(), 0, cells.width() + cells.left(), line), Qt::AlignLeft, whom);
  painter.drawText(QRectF(0, cells.top() - line - NameGap, cells.left() - NameGap, line),
                   Qt::AlignRight | Qt::TextDontClip, layout.Labels > 0 ? who : QString());
  if (layout.Labels <= 0) {
    DrawUpwards(painter, QRectF(0, cells.top(), line, cells.height()), Qt::AlignRight,
                Text(strings_, OwnText::WhoHit));
  }
  painter.setFont(font_);
  const QFontMetricsF metrics(font_);
  for (const HitMatrix::Group& group : matrix_.Groups()) {
    const double from = group.First * layout.Cell;
    const double length = group.Count * layout.Cell;
    const QString name = metrics.elidedText(
        QString::fromStdString(TeamNameFromNumber(strings_, static_cast<std::int16_t>(group.Team))),
        Qt::ElideRight, length);
    painter.drawText(QRectF(cells.left() + from, line, length, line), Qt::AlignCenter, name);
    DrawUpwards(painter, QRectF(line, cells.top() + from, line, length), Qt::AlignCenter, name);
    const QColor colour = TeamColour(group.Team);
    painter.fillRect(QRectF(cells.left() + from + 1, 2 * line, length - 2, TeamStripe), colour);
    painter.fillRect(QRectF(2 * line, cells.top() + from + 1, TeamStripe, length - 2), colour);
  }
}

void HitMapPainter::DrawNames(QPainter& painter, const HitMapLayout& layout) const {
  painter.setFont(NameFont(layout.Cell));
  const QFontMetricsF metrics(painter.font());
  const double room = layout.Labels - 2 * NameGap;
  for (int place = 0; place < matrix_.Size(); ++place) {
    const QString name = metrics.elidedText(names_[place], Qt::ElideRight, room + 1);
    const double along = place * layout.Cell;
    painter.drawText(QRectF(layout.Cells.left() - layout.Labels, layout.Cells.top() + along,
                            layout.Labels - NameGap, layout.Cell),
                     Qt::AlignRight | Qt::AlignVCenter | Qt::TextDontClip, name);
    DrawUpwards(painter,
                QRectF(layout.Cells.left() + along, layout.Cells.top() - layout.Labels, layout.Cell,
                       layout.Labels - NameGap),
                Qt::AlignLeft | Qt::AlignVCenter | Qt::TextDontClip, name);
  }
  painter.setFont(font_);
}

void HitMapPainter::DrawNumbers(QPainter& painter, const HitMapLayout& layout) const {
  QFont font = font_;
  const double usual = QFontMetricsF(font_).height() * 0.8;
  font.setPixelSize(std::max(static_cast<int>(std::min(layout.Cell * 0.42, usual)), 8));
  const QFontMetricsF metrics(font);
  if (metrics.height() > layout.Cell) {
    return;
  }
  const auto fits = [&](const QString& number) {
    constexpr double gap = 3;
    return metrics.horizontalAdvance(number) + gap <= layout.Cell;
  };
  painter.setFont(font);
  for (int shooter = 0; shooter < matrix_.Size(); ++shooter) {
    for (int victim = 0; victim < matrix_.Size(); ++victim) {
      const std::int32_t damage = matrix_.Damage(shooter, victim);
      if (const QString number = QString::number(damage); damage > 0 && fits(number)) {
        painter.setPen(InkOn(HeatOf(damage, matrix_.Most())));
        painter.drawText(layout.Place({shooter, victim}), Qt::AlignCenter, number);
      }
    }
  }
  painter.setFont(font_);
  painter.setPen(ink_);
}

void HitMapPainter::DrawLines(QPainter& painter, const HitMapLayout& layout) const {
  const QRectF& cells = layout.Cells;
  painter.setPen(QPen(QColor(70, 70, 70), 1));
  painter.drawRect(cells);
  for (const HitMatrix::Group& group : matrix_.Groups()) {
    const double at = group.First * layout.Cell;
    painter.drawLine(QPointF(cells.left() + at, cells.top()), QPointF(cells.left() + at, cells.bottom()));
    painter.drawLine(QPointF(cells.left(), cells.top() + at), QPointF(cells.right(), cells.top() + at));
  }
  painter.setPen(ink_);
}

double HitMapPainter::KeyWidth() const {
  const QFontMetricsF metrics(font_);
  const double texts = metrics.horizontalAdvance(Text(strings_, 107)) +
                       metrics.horizontalAdvance(QStringLiteral("1")) +
                       metrics.horizontalAdvance(QString::number(matrix_.Most()));
  const double ownTeam = matrix_.HasTeams() ? metrics.horizontalAdvance(Text(strings_, OwnText::OwnTeam)) +
                                                  LineHeight() + 4 * NameGap
                                            : 0;
  return texts + KeyBar + ownTeam + 4 * NameGap;
}

void HitMapPainter::DrawKey(QPainter& painter, const HitMapLayout& layout) const {
  if (matrix_.Most() == 0) {
    return;
  }
  const double line = LineHeight();
  const double top = layout.Cells.bottom() + 0.6 * line;
  double x = 0;
  const auto write = [&](const QString& text) {
    const double width = QFontMetricsF(font_).horizontalAdvance(text);
    painter.drawText(QRectF(x, top, width + 1, line), Qt::AlignLeft | Qt::AlignVCenter, text);
    x += width + NameGap;
  };
  write(Text(strings_, 107));
  x += NameGap;
  write(QStringLiteral("1"));
  for (int step = 0; step < static_cast<int>(KeyBar); ++step) {
    const auto amount = static_cast<std::int32_t>(step / (KeyBar - 1) * 10000);
    painter.fillRect(QRectF(x + step, top + 1, 1.5, line - 2), QColor(HeatOf(amount, 10000)));
  }
  painter.drawRect(QRectF(x, top + 1, KeyBar, line - 2));
  x += KeyBar + NameGap;
  write(QString::number(matrix_.Most()));
  if (!matrix_.HasTeams()) {
    return;
  }
  x += 3 * NameGap;
  const QRectF sample(x, top + 1, line - 2, line - 2);
  DrawOwnTeamSample(painter, sample, layout);
  x += sample.width() + NameGap;
  write(Text(strings_, OwnText::OwnTeam));
}

void HitMapPainter::DrawOwnTeamSample(QPainter& painter, const QRectF& sample,
                                      const HitMapLayout& layout) const {
  const QRgb heat = HeatOf(1, 2);
  painter.fillRect(sample, QColor(heat));
  if (layout.CellPixels >= 12) {
    const double side = sample.width() / 2;
    painter.setBrush(InkOn(heat));
    painter.drawPolygon(QPolygonF(
        {sample.topRight(), sample.topRight() - QPointF(side, 0), sample.topRight() + QPointF(0, side)}));
    painter.setBrush(Qt::NoBrush);
  } else {
    painter.setPen(QPen(InkOn(heat), 2));
    painter.drawLine(sample.topRight(), sample.bottomLeft());
    painter.setPen(ink_);
  }
  painter.drawRect(sample);
}
