#pragma once

#include <QApplication>
#include <QMouseEvent>
#include <QWidget>

/// Moves the pointer to that place in the control, whether or not its window is on the screen.
inline void MovePointer(QWidget& control, const QPoint& place) {
  QMouseEvent move(QEvent::MouseMove, place, control.mapToGlobal(place), Qt::NoButton, Qt::NoButton, {});
  QApplication::sendEvent(&control, &move);
}
