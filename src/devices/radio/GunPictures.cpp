#include "devices/radio/GunPictures.h"

#include <QPainter>
#include <QPainterPath>
#include <algorithm>

namespace {

constexpr int Scale = 4;  // painted larger than shown, to stay sharp on dense screens

const QColor Green(0x2e, 0x9e, 0x4f);
const QColor Amber(0xe0, 0x9a, 0x12);
const QColor Red(0xcc, 0x2f, 0x2f);
const QColor Blue(0x2f, 0x6f, 0xd6);
const QColor Grey(0x8a, 0x93, 0xa6);

QPixmap EmptyPicture(int width, int height) {
  QPixmap picture(width * Scale, height * Scale);
  picture.setDevicePixelRatio(Scale);
  picture.fill(Qt::transparent);
  return picture;
}

QColor ColourOf(ScoreStatus status) {
  switch (status) {
    case ScoreStatus::InProgress:
      return Blue;
    case ScoreStatus::Failed:
      return Red;
    case ScoreStatus::Ok:
      return Green;
    default:
      return Grey;
  }
}

/// The symbol inside the mark, in a 16 by 16 square.
QPainterPath FormOf(ScoreStatus status) {
  QPainterPath form;
  switch (status) {
    case ScoreStatus::InProgress:
      form.moveTo(8, 4);
      form.lineTo(8, 12);
      form.moveTo(4.7, 8.7);
      form.lineTo(8, 12);
      form.lineTo(11.3, 8.7);
      break;
    case ScoreStatus::Failed:
      form.moveTo(5, 5);
      form.lineTo(11, 11);
      form.moveTo(11, 5);
      form.lineTo(5, 11);
      break;
    case ScoreStatus::Ok:
      form.moveTo(4.2, 8.4);
      form.lineTo(7, 11.2);
      form.lineTo(11.8, 5.2);
      break;
    default:
      break;
  }
  return form;
}

}  // namespace

QPixmap BatteryPicture(std::uint8_t percent) {
  constexpr int fullPercent = 100;
  constexpr int lowPercent = 40;
  constexpr int emptyPercent = 20;
  constexpr double room = 22;
  QPixmap picture = EmptyPicture(30, 16);
  QPainter painter(&picture);
  painter.setRenderHint(QPainter::Antialiasing);
  painter.setPen(QPen(Grey.darker(130), 1.5));
  painter.drawRoundedRect(QRectF(1, 2, 25, 12), 2.5, 2.5);
  painter.setPen(Qt::NoPen);
  painter.setBrush(Grey.darker(130));
  painter.drawRoundedRect(QRectF(26.5, 5.5, 2.5, 5), 1, 1);
  painter.setBrush(percent <= emptyPercent ? Red : percent <= lowPercent ? Amber : Green);
  painter.drawRect(QRectF(2.5, 3.5, room * std::min<int>(percent, fullPercent) / fullPercent, 9));
  return picture;
}

QPixmap StatusPicture(ScoreStatus status) {
  QPixmap picture = EmptyPicture(16, 16);
  QPainter painter(&picture);
  painter.setRenderHint(QPainter::Antialiasing);
  if (status == ScoreStatus::Pending) {
    painter.setPen(QPen(Grey, 2));
    painter.drawEllipse(QRectF(2.5, 2.5, 11, 11));
    return picture;
  }
  painter.setPen(Qt::NoPen);
  painter.setBrush(ColourOf(status));
  painter.drawEllipse(QRectF(0.5, 0.5, 15, 15));
  painter.setBrush(Qt::NoBrush);
  painter.setPen(QPen(Qt::white, 1.9, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
  painter.drawPath(FormOf(status));
  return picture;
}

QColor StatusTint(ScoreStatus status, const QColor& base) {
  if (status == ScoreStatus::Pending) {
    return base;
  }
  constexpr double share = 0.14;
  const QColor colour = ColourOf(status);
  const auto mix = [](int over, int under) { return static_cast<int>(over * share + under * (1 - share)); };
  return {mix(colour.red(), base.red()), mix(colour.green(), base.green()), mix(colour.blue(), base.blue())};
}
