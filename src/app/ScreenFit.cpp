#include "app/ScreenFit.h"

#include <QScreen>
#include <QWidget>

void FitToScreen(QWidget& window, MessageBoxes& boxes) {
  const QSize pixels = window.screen()->size();
  const ScreenFit fit = FitToScreen(pixels.width(), pixels.height());
  if (fit.Warn) {
    boxes.Show("This program works best with a screen resolution of at least 1024 x 768.",
               "Screen Resolution Warning", BoxIcon::Exclamation);
  }
  if (fit.Width) {
    window.setGeometry(0, window.y(), *fit.Width, window.height());
  }
  if (fit.Height) {
    window.setGeometry(window.x(), 0, window.width(), *fit.Height);
  }
  if (fit.Maximised) {
    window.setWindowState(window.windowState() | Qt::WindowMaximized);
  }
}
