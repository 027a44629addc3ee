#include "app/ScreenFit.h"

#include <QScreen>
#include <QWidget>

#include "ui/WorkArea.h"

QSize PixelsOf(const QScreen& screen) {
  const double scale = screen.devicePixelRatio();
  if (scale == 1) {
    return screen.size();
  }
  // The toolkit's size is rounded: 683 at scale 1.5 may be 1024 or 1025. Screens have even sizes.
  const auto pixels = [scale](int length) { return 2 * qRound(length * scale / 2); };
  return {pixels(screen.size().width()), pixels(screen.size().height())};
}

void FitToScreen(QWidget& window, MessageBoxes& boxes) {
  const QScreen& screen = *window.screen();
  const QSize pixels = PixelsOf(screen);
  const ScreenFit fit = FitToScreen(pixels.width(), pixels.height());
  if (fit.Warn) {
    boxes.Show("This program works best with a screen resolution of at least 1024 x 768.",
               "Screen Resolution Warning", BoxIcon::Exclamation);
  }
  const double scale = screen.devicePixelRatio();
  if (fit.Width) {
    window.setGeometry(0, window.y(), qRound(*fit.Width / scale), window.height());
  }
  if (fit.Height) {
    window.setGeometry(window.x(), 0, window.width(), qRound(*fit.Height / scale));
  }
  if (fit.Maximised) {
    window.setWindowState(window.windowState() | Qt::WindowMaximized);
  }
}

void MaximiseOnSmallScreen(QWidget& window) {
  const QScreen& screen = *window.screen();
  const QSize pixels = PixelsOf(screen);
  const QSize room(screen.availableSize().width(), RoomOn(screen).height());
  const QSize least = window.size().boundedTo(room);
  const bool isTooLarge = !FitToScreen(pixels.width(), pixels.height()).Height && window.size() != least;
  if (isTooLarge) {
    window.resize(least);  // where it is no longer maximised
  }
  if (isTooLarge || StartsMaximised(pixels.width(), pixels.height())) {
    window.setWindowState(window.windowState() | Qt::WindowMaximized);
  }
}
