#include "app/StepSigns.h"

#include <QPainter>
#include <QPainterPath>
#include <QPixmap>

namespace {

constexpr int Side = 48;      ///< pixels, for screens of twice the usual density
constexpr double Unit = 0.5;  ///< pixels; the signs are 96 units wide
constexpr QColor TickGround(0x1d, 0x7a, 0x3e);

void PaintFlag(QPainter& painter) {
  painter.drawLine(24, 12, 24, 84);
  painter.drawPolygon(QPolygon({{24, 14}, {78, 24}, {24, 50}}));
}

void PaintPrinter(QPainter& painter) {
  painter.drawRect(28, 10, 40, 24);
  painter.drawRoundedRect(12, 34, 72, 32, 6, 6);
  painter.drawRect(28, 54, 40, 32);
}

/// A drum with an arrow into it.
void PaintDatabase(QPainter& painter) {
  painter.drawEllipse(16, 44, 64, 18);
  painter.drawLine(16, 53, 16, 76);
  painter.drawLine(80, 53, 80, 76);
  painter.drawArc(16, 67, 64, 18, 180 * 16, 180 * 16);
  painter.drawLine(48, 8, 48, 36);
  painter.drawPolyline(QPolygon({{36, 26}, {48, 38}, {60, 26}}));
}

void PaintDisk(QPainter& painter) {
  painter.drawPolygon(QPolygon({{12, 12}, {70, 12}, {84, 26}, {84, 84}, {12, 84}}));
  painter.drawRect(30, 12, 30, 22);
  painter.drawRect(26, 50, 44, 34);
}

void PaintCross(QPainter& painter) {
  painter.drawRoundedRect(12, 12, 72, 72, 8, 8);
  painter.drawLine(32, 32, 64, 64);
  painter.drawLine(64, 32, 32, 64);
}

void PaintTick(QPainter& painter) {
  painter.setPen(Qt::NoPen);
  painter.setBrush(TickGround);
  painter.drawEllipse(46, 46, 50, 50);
  painter.setBrush(Qt::NoBrush);
  painter.setPen(QPen(Qt::white, 8, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
  painter.drawPolyline(QPolygon({{58, 71}, {68, 81}, {84, 62}}));
}

QPixmap Paint(GameStep step, bool done, const QColor& colour) {
  QPixmap picture(Side, Side);
  picture.fill(Qt::transparent);
  QPainter painter(&picture);
  painter.setRenderHint(QPainter::Antialiasing);
  painter.scale(Unit, Unit);
  painter.setPen(QPen(colour, 7, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
  switch (step) {
    case GameStep::Results:
      PaintFlag(painter);
      break;
    case GameStep::Print:
      PaintPrinter(painter);
      break;
    case GameStep::Commit:
      PaintDatabase(painter);
      break;
    case GameStep::Save:
      PaintDisk(painter);
      break;
    case GameStep::Clear:
      PaintCross(painter);
      break;
  }
  if (done) {
    PaintTick(painter);
  }
  return picture;
}

}  // namespace

QIcon StepSign(GameStep step, bool done, const QColor& colour) {
  return QIcon(Paint(step, done, colour));
}
