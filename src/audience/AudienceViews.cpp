#include "audience/AudienceViews.h"

#include <QPainter>

#include "audience/AudienceColours.h"
#include "audience/AudienceText.h"
#include "ui/QrCode.h"

namespace {

constexpr double WidthShare = 0.9;  ///< of the screen, for texts and pictures

void DrawLarge(QPainter& painter, const QRectF& band, const QString& text, double mostShare) {
  const double capital = CapitalFor(text, band.width(), band.height() * mostShare, true);
  DrawLine(painter, band, text, FontWithCapitals(capital, true), Qt::AlignHCenter);
}

/// A band across the screen, from and to these shares of its height.
QRectF Band(const AudiencePlace& place, double from, double to) {
  return {place.Width * (1 - WidthShare) / 2, place.Height * from, place.Width * WidthShare,
          place.Height * (to - from)};
}

}  // namespace

namespace AudienceViews {

void PaintVenue(QPainter& painter, const AudiencePlace& place, const QString& name, const QImage& picture) {
  constexpr double mostOfBand = 0.5;
  painter.setPen(AudienceColours::Letters());
  if (picture.isNull()) {
    DrawLarge(painter, Band(place, 0.25, 0.75), name, mostOfBand);
    return;
  }
  const QRectF band = name.isEmpty() ? Band(place, 0.05, 0.95) : Band(place, 0.06, 0.68);
  const QSizeF size = QSizeF(picture.size()).scaled(band.size(), Qt::KeepAspectRatio);
  const QRectF area(band.center() - QPointF(size.width(), size.height()) / 2, size);
  painter.setRenderHint(QPainter::SmoothPixmapTransform);
  painter.drawImage(area, picture);
  DrawLarge(painter, Band(place, 0.72, 0.96), name, mostOfBand);
}

void PaintMessage(QPainter& painter, const AudiencePlace& place, const QString& heading,
                  const QString& message) {
  constexpr double mostOfBand = 0.4;
  painter.setPen(AudienceColours::QuietLetters());
  DrawLarge(painter, Band(place, 0.1, 0.4), heading, mostOfBand);
  painter.setPen(AudienceColours::Letters());
  DrawLarge(painter, Band(place, 0.4, 0.9), message, mostOfBand);
}

void PaintCode(QPainter& painter, const AudiencePlace& place, const QString& heading,
               const QString& address) {
  constexpr double mostOfBand = 0.6;
  painter.setPen(AudienceColours::QuietLetters());
  DrawLarge(painter, Band(place, 0.01, 0.11), heading, mostOfBand);
  PaintQrCode(painter, Band(place, 0.12, 0.86), address.toStdString());
  painter.setPen(AudienceColours::Letters());
  DrawLarge(painter, Band(place, 0.87, 0.99), address, mostOfBand);
}

}  // namespace AudienceViews
