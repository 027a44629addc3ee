#include "demo/Portrait.h"

#include <QBuffer>
#include <QLinearGradient>
#include <QPainter>
#include <QPainterPath>
#include <QRadialGradient>
#include <stdexcept>

#include "demo/PortraitHair.h"
#include "demo/PortraitHead.h"

namespace {

QPen Line(const QColor& colour, qreal width) {
  return {colour, width, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin};
}

void DrawBackdrop(QPainter& painter, const QColor& colour) {
  QLinearGradient light(0, 0, 0, PortraitHeight);
  light.setColorAt(0, colour.lighter(118));
  light.setColorAt(0.4, colour);
  light.setColorAt(1, colour.darker(155));
  painter.fillRect(0, 0, PortraitWidth, PortraitHeight, light);
  // Lamps of the hall, out of focus.
  painter.setPen(Qt::NoPen);
  for (const QRectF& lamp : {QRectF(22, 48, 54, 54), QRectF(284, 26, 70, 70), QRectF(300, 176, 40, 40),
                             QRectF(8, 196, 34, 34), QRectF(76, 8, 30, 30)}) {
    painter.setBrush(QColor(255, 255, 255, 26));
    painter.drawEllipse(lamp);
  }
}

void DrawNeck(QPainter& painter, const QColor& skin) {
  QPainterPath neck;
  neck.moveTo(142, 262);
  neck.lineTo(142, 334);
  neck.quadTo(180, 372, 218, 334);
  neck.lineTo(218, 262);
  neck.closeSubpath();
  painter.fillPath(neck, skin.darker(112));
  QPainterPath shadow;
  shadow.addEllipse(QPointF(180, 276), 46, 36);
  painter.fillPath(shadow.intersected(neck), QColor(60, 20, 10, 60));
}

QPainterPath Shoulders() {
  QPainterPath path;
  path.moveTo(30, PortraitHeight);
  path.cubicTo(34, 372, 62, 348, 140, 326);
  path.quadTo(180, 374, 220, 326);
  path.cubicTo(298, 348, 326, 372, 330, PortraitHeight);
  path.closeSubpath();
  return path;
}

void DrawShirt(QPainter& painter, const QColor& colour) {
  const QPainterPath shoulders = Shoulders();
  QLinearGradient cloth(0, 326, 0, PortraitHeight);
  cloth.setColorAt(0, colour.lighter(112));
  cloth.setColorAt(1, colour.darker(128));
  painter.fillPath(shoulders, cloth);
  painter.save();
  painter.setClipPath(shoulders);
  painter.setBrush(Qt::NoBrush);
  // The vest of the game over the shirt, with its two sensors.
  const QColor vest(38, 44, 58);
  for (const int side : {-1, 1}) {
    const qreal x = 180 + 72 * side;
    painter.setPen(Line(vest, 44));
    painter.drawLine(QPointF(x - 8 * side, 320), QPointF(x + 10 * side, 460));
    painter.setPen(Qt::NoPen);
    painter.setBrush(QColor(255, 255, 255, 60));
    painter.drawEllipse(QPointF(x, 398), 15, 15);
    painter.setBrush(colour.lighter(150));
    painter.drawEllipse(QPointF(x, 398), 10, 10);
    painter.setBrush(QColor(255, 255, 255, 190));
    painter.drawEllipse(QPointF(x - 3, 395), 3.5, 3.5);
  }
  painter.setPen(Line(colour.darker(150), 5));
  painter.setBrush(Qt::NoBrush);
  QPainterPath collar;
  collar.moveTo(140, 327);
  collar.quadTo(180, 375, 220, 327);
  painter.drawPath(collar);
  painter.restore();
}

void DrawFace(QPainter& painter, const QColor& skin) {
  painter.setPen(Qt::NoPen);
  painter.setBrush(skin.darker(108));
  for (const int side : {-1, 1}) {
    painter.drawEllipse(QPointF(180 + 78 * side, 206), 15, 23);
  }
  QRadialGradient light(168, 168, 150);
  light.setColorAt(0, skin.lighter(108));
  light.setColorAt(0.7, skin);
  light.setColorAt(1, skin.darker(112));
  painter.fillPath(HeadOutline(), light);
}

void DrawCheeks(QPainter& painter, bool freckles) {
  painter.setPen(Qt::NoPen);
  for (const int side : {-1, 1}) {
    const QPointF centre(180 + 44 * side, 238);
    QRadialGradient blush(centre, 24);
    blush.setColorAt(0, QColor(226, 84, 74, 80));
    blush.setColorAt(1, QColor(226, 84, 74, 0));
    painter.setBrush(blush);
    painter.drawEllipse(centre, 24, 24);
    if (freckles) {
      painter.setBrush(QColor(150, 82, 40, 120));
      for (const QPointF& spot : {QPointF(-10, -10), QPointF(2, -14), QPointF(-2, -3), QPointF(11, -8),
                                  QPointF(-15, -1), QPointF(8, 2)}) {
        painter.drawEllipse(centre + spot, 2, 2);
      }
    }
  }
}

void DrawEyes(QPainter& painter, const QColor& iris, const QColor& brows) {
  for (const int side : {-1, 1}) {
    const QPointF centre(180 + 33 * side, 206);
    painter.setPen(Qt::NoPen);
    painter.setBrush(QColor(252, 252, 250));
    painter.drawEllipse(centre, 15, 12);
    painter.setBrush(iris);
    painter.drawEllipse(centre + QPointF(0, 1), 9, 9);
    painter.setBrush(QColor(22, 18, 18));
    painter.drawEllipse(centre + QPointF(0, 1), 4.6, 4.6);
    painter.setBrush(Qt::white);
    painter.drawEllipse(centre + QPointF(3, -3), 2.6, 2.6);
    painter.setBrush(Qt::NoBrush);
    painter.setPen(Line(QColor(40, 26, 22), 3.4));
    QPainterPath lid;
    lid.moveTo(centre + QPointF(-16, -1));
    lid.quadTo(centre + QPointF(0, -21), centre + QPointF(16, -1));
    painter.drawPath(lid);
    painter.setPen(Line(brows, 6));
    QPainterPath brow;
    brow.moveTo(centre + QPointF(-17 * side, -23));
    brow.quadTo(centre + QPointF(2 * side, -34), centre + QPointF(20 * side, -24));
    painter.drawPath(brow);
  }
}

void DrawNose(QPainter& painter, const QColor& skin) {
  painter.setBrush(Qt::NoBrush);
  painter.setPen(Line(skin.darker(138), 3.4));
  QPainterPath nose;
  nose.moveTo(178, 216);
  nose.quadTo(166, 244, 172, 246);
  nose.quadTo(181, 251, 190, 245);
  painter.drawPath(nose);
}

void DrawMouth(QPainter& painter, Mouth mouth, const QColor& skin) {
  painter.setBrush(Qt::NoBrush);
  QPainterPath lips;
  if (mouth == Mouth::Smiling) {
    lips.moveTo(151, 270);
    lips.quadTo(180, 295, 209, 270);
    painter.setPen(Line(QColor(128, 40, 44), 4.6));
    painter.drawPath(lips);
    return;
  }
  lips.moveTo(150, 269);
  lips.quadTo(180, 279, 210, 269);
  lips.quadTo(203, 298, 180, 298);
  lips.quadTo(157, 298, 150, 269);
  painter.fillPath(lips, QColor(128, 40, 44));
  QPainterPath teeth;
  teeth.moveTo(155, 272);
  teeth.quadTo(180, 280, 205, 272);
  teeth.quadTo(201, 286, 180, 286);
  teeth.quadTo(159, 286, 155, 272);
  painter.fillPath(teeth, QColor(253, 252, 248));
  painter.setPen(Line(skin.darker(155), 3));
  painter.drawPath(lips);
}

void DrawGlasses(QPainter& painter, Glasses glasses) {
  if (glasses == Glasses::None) {
    return;
  }
  painter.setPen(Line(QColor(34, 36, 46), 5));
  painter.setBrush(QColor(255, 255, 255, 36));
  for (const int side : {-1, 1}) {
    const QRectF rim(180 + 34 * side - 27, 182, 54, 48);
    if (glasses == Glasses::Round) {
      painter.drawEllipse(rim);
    } else {
      painter.drawRoundedRect(rim, 9, 9);
    }
    painter.drawLine(QPointF(180 + 61 * side, 200), QPointF(180 + 78 * side, 196));
  }
  painter.drawLine(QPointF(173, 202), QPointF(187, 202));
}

}  // namespace

QImage DrawPortrait(const PortraitLook& look) {
  QImage portrait(PortraitWidth, PortraitHeight, QImage::Format_RGB32);
  QPainter painter(&portrait);
  painter.setRenderHint(QPainter::Antialiasing);
  const QColor skin(look.Skin);
  const QColor hair(look.HairColour);
  DrawBackdrop(painter, QColor(look.Backdrop));
  DrawHairBehind(painter, look.Hair, hair);
  DrawNeck(painter, skin);
  DrawShirt(painter, QColor(look.Shirt));
  DrawFace(painter, skin);
  DrawCheeks(painter, look.Freckles);
  DrawBeard(painter, look.Beard, hair);
  DrawNose(painter, skin);
  DrawMouth(painter, look.Mouth, skin);
  DrawEyes(painter, QColor(look.Eyes), hair.darker(120));
  DrawHairInFront(painter, look.Hair, hair);
  DrawGlasses(painter, look.Glasses);
  return portrait;
}

QByteArray PortraitFile(const PortraitLook& look) {
  constexpr int dotsPerMetre = 7874;  // 200 in an inch
  constexpr int quality = 90;
  QImage portrait = DrawPortrait(look);
  portrait.setDotsPerMeterX(dotsPerMetre);
  portrait.setDotsPerMeterY(dotsPerMetre);
  QByteArray bytes;
  QBuffer file(&bytes);
  if (!portrait.save(&file, "JPG", quality)) {
    throw std::runtime_error("The toolkit cannot write JPEG files");
  }
  return bytes;
}
