#include "firmware/download/Lamp.h"

#include <QPainter>

Lamp::Lamp(QWidget* parent) : QWidget(parent) {
  setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Fixed);
}

void Lamp::SetGreen(bool green) {
  green_ = green;
  update();
}

QSize Lamp::sizeHint() const {
  const int side = fontMetrics().height() * 3 / 2;
  return {side, side};
}

void Lamp::paintEvent(QPaintEvent* /*event*/) {
  QPainter painter(this);
  painter.setRenderHint(QPainter::Antialiasing);
  const QColor colour = green_ ? QColor(0, 255, 0) : QColor(255, 0, 0);
  painter.setPen(QPen(colour.darker(200), 2));
  painter.setBrush(colour);
  painter.drawEllipse(rect().adjusted(1, 1, -2, -2));
}
