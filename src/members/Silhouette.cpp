#include "members/Silhouette.h"

#include <QPainter>
#include <algorithm>

void DrawSilhouette(QPainter& painter, const QRect& place, const QColor& colour) {
  const double unit = std::min(place.width(), place.height()) / 10.0;
  const QPointF centre = QRectF(place).center();
  painter.save();
  painter.setRenderHint(QPainter::Antialiasing);
  painter.setClipRect(
      QRectF(place.left(), place.top(), place.width(), centre.y() + 3.2 * unit - place.top()));
  painter.setPen(Qt::NoPen);
  painter.setBrush(colour);
  painter.drawEllipse(centre - QPointF(0, 1.2 * unit), 1.5 * unit, 1.7 * unit);
  painter.drawEllipse(centre + QPointF(0, 3.4 * unit), 2.8 * unit, 2.4 * unit);
  painter.restore();
}
