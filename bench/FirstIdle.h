#pragma once

#include <QApplication>
#include <QTimer>
#include <QWidget>
#include <QWindow>

/// Ends the program at the first idle moment after `window` has been shown and painted.
inline void QuitWhenUsable(QWidget& window) {
  auto* look = new QTimer(&window);
  QObject::connect(look, &QTimer::timeout, look, [&window] {
    if (window.windowHandle() != nullptr && window.windowHandle()->isExposed()) {
      QApplication::quit();
    }
  });
  look->start(0);
}
