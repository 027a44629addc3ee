#include "demo/PortraitHair.h"

#include <QLinearGradient>
#include <QPainterPath>

#include "demo/PortraitHead.h"

namespace {

/// Lighter where the lamp from above falls on it.
QBrush Sheen(const QColor& colour) {
  QLinearGradient sheen(150, 80, 200, 330);
  sheen.setColorAt(0, colour.lighter(132));
  sheen.setColorAt(0.35, colour);
  sheen.setColorAt(1, colour.darker(130));
  return sheen;
}

/// Hair that lies on the skull, down to the ears; `forehead` is the height of its edge in the middle.
QPainterPath Cap(qreal forehead) {
  QPainterPath path;
  path.moveTo(94, 202);
  path.cubicTo(84, 130, 122, 88, 180, 88);
  path.cubicTo(238, 88, 276, 130, 266, 202);
  path.cubicTo(258, 176, 250, 164, 240, 152);
  path.quadTo(180, forehead, 120, 152);
  path.cubicTo(110, 164, 102, 176, 94, 202);
  path.closeSubpath();
  return path;
}

QPainterPath SideParting() {
  QPainterPath path;
  path.moveTo(94, 206);
  path.cubicTo(82, 130, 118, 82, 186, 84);
  path.cubicTo(246, 84, 276, 130, 266, 206);
  path.cubicTo(262, 184, 256, 170, 246, 158);
  path.cubicTo(210, 156, 160, 148, 140, 122);
  path.cubicTo(132, 150, 108, 160, 94, 206);
  path.closeSubpath();
  return path;
}

QPainterPath Spikes() {
  QPainterPath path;
  path.moveTo(94, 200);
  for (const QPointF& point :
       {QPointF(84, 150),  QPointF(100, 142), QPointF(96, 104),  QPointF(124, 110), QPointF(130, 72),
        QPointF(158, 92),  QPointF(178, 60),  QPointF(198, 90),  QPointF(228, 72),  QPointF(236, 108),
        QPointF(264, 106), QPointF(260, 142), QPointF(276, 152), QPointF(266, 200), QPointF(250, 162),
        QPointF(226, 142), QPointF(206, 156), QPointF(184, 138), QPointF(158, 156), QPointF(136, 142),
        QPointF(110, 162)}) {
    path.lineTo(point);
  }
  path.closeSubpath();
  return path;
}

QPainterPath Curls() {
  QPainterPath path;
  path.setFillRule(Qt::WindingFill);
  for (const QRectF& curl :
       {QRectF(72, 150, 52, 60), QRectF(76, 106, 62, 62), QRectF(102, 72, 68, 68), QRectF(146, 60, 70, 70),
        QRectF(192, 72, 68, 68), QRectF(224, 106, 62, 62), QRectF(238, 150, 52, 60), QRectF(124, 104, 54, 50),
        QRectF(164, 100, 54, 50), QRectF(204, 110, 50, 48)}) {
    path.addEllipse(curl);
  }
  return path;
}

/// Hair that parts in the middle and covers the ears, down to `end`.
QPainterPath Curtains(qreal end) {
  QPainterPath path;
  path.moveTo(180, 86);
  path.cubicTo(262, 82, 286, 140, 280, end);
  path.cubicTo(262, end + 12, 250, end + 2, 246, end - 8);
  path.cubicTo(256, 200, 244, 160, 184, 112);
  path.cubicTo(116, 160, 104, 200, 114, end - 8);
  path.cubicTo(110, end + 2, 98, end + 12, 80, end);
  path.cubicTo(74, 140, 98, 82, 180, 86);
  path.closeSubpath();
  return path;
}

}  // namespace

void DrawHairBehind(QPainter& painter, Hair hair, const QColor& colour) {
  const QColor shaded = colour.darker(125);
  painter.setPen(Qt::NoPen);
  painter.setBrush(shaded);
  switch (hair) {
    case Hair::Bob:
      painter.drawRoundedRect(QRectF(78, 110, 204, 196), 80, 80);
      break;
    case Hair::Long:
      painter.drawRoundedRect(QRectF(70, 96, 220, 300), 96, 90);
      break;
    case Hair::Bun:
      painter.drawEllipse(QPointF(180, 78), 46, 42);
      break;
    case Hair::Ponytail: {
      QPainterPath tail;
      tail.moveTo(224, 108);
      tail.cubicTo(330, 90, 340, 220, 292, 330);
      tail.cubicTo(292, 260, 288, 190, 236, 168);
      tail.closeSubpath();
      painter.drawPath(tail);
      break;
    }
    case Hair::Curly:
      painter.drawEllipse(QPointF(180, 168), 112, 104);
      break;
    default:
      break;
  }
}

void DrawHairInFront(QPainter& painter, Hair hair, const QColor& colour) {
  const QBrush sheen = Sheen(colour);
  switch (hair) {
    case Hair::Shaved: {
      QColor shadow = colour;
      shadow.setAlpha(70);
      painter.fillPath(Cap(112).intersected(HeadOutline()), shadow);
      break;
    }
    case Hair::Short:
      painter.fillPath(Cap(128), sheen);
      break;
    case Hair::SideParting:
      painter.fillPath(SideParting(), sheen);
      break;
    case Hair::Spiky:
      painter.fillPath(Spikes(), sheen);
      break;
    case Hair::Curly:
      painter.fillPath(Curls(), sheen);
      break;
    case Hair::Bob:
      painter.fillPath(Curtains(288), sheen);
      break;
    case Hair::Long:
      painter.fillPath(Curtains(364), sheen);
      break;
    case Hair::Bun:
    case Hair::Ponytail:
      painter.fillPath(Cap(104), sheen);
      break;
  }
}

void DrawBeard(QPainter& painter, Beard beard, const QColor& colour) {
  if (beard == Beard::None) {
    return;
  }
  QPainterPath cheeks;
  cheeks.moveTo(92, 214);
  cheeks.cubicTo(116, 250, 140, 258, 180, 254);
  cheeks.cubicTo(220, 258, 244, 250, 268, 214);
  cheeks.lineTo(280, 330);
  cheeks.lineTo(80, 330);
  cheeks.closeSubpath();
  QColor shade = colour;
  if (beard == Beard::Stubble) {
    shade.setAlpha(64);
  }
  painter.fillPath(cheeks.intersected(HeadOutline()), shade);
}
