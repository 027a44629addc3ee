#include "audience/AudienceWindow.h"

#include <QCloseEvent>
#include <QKeyEvent>
#include <QPainter>
#include <QScreen>
#include <cmath>

AudienceWindow::AudienceWindow(AudienceStage& stage, QScreen* wholeScreen) : stage_(stage) {
  setObjectName(QStringLiteral("AudienceBoard"));
  setAttribute(Qt::WA_OpaquePaintEvent);
  setAttribute(Qt::WA_QuitOnClose, false);
  connect(&stage_, &AudienceStage::PictureChanged, this, qOverload<>(&QWidget::update));
  if (wholeScreen == nullptr) {
    constexpr QSize usual(960, 540);
    resize(usual);
    return;
  }
  setWindowFlags(Qt::Window | Qt::FramelessWindowHint | Qt::WindowDoesNotAcceptFocus);
  setAttribute(Qt::WA_ShowWithoutActivating);
  setCursor(Qt::BlankCursor);
  Cover(*wholeScreen);
}

void AudienceWindow::Cover(QScreen& screen) {
  setScreen(&screen);
  setGeometry(screen.geometry());
  setWindowState(windowState() | Qt::WindowFullScreen);
  FitStage();
}

void AudienceWindow::SetDiagonal(double inches) {
  inches_ = inches;
  FitStage();
}

void AudienceWindow::FitStage() {
  const QSize pixels = ScreenPixels(*screen());
  const double inches = inches_ > 0 ? inches_ : DiagonalOf(*screen());
  const QSizeF own = QSizeF(size()) * devicePixelRatioF();
  stage_.SetArea(QSize(qRound(own.width()), qRound(own.height())),
                 MillimetresPerPixel(inches, pixels.width(), pixels.height()));
}

void AudienceWindow::paintEvent(QPaintEvent* /*event*/) {
  FitStage();  // the window may have come to a screen with another scale
  QPainter(this).drawImage(rect(), stage_.Picture());
}

void AudienceWindow::resizeEvent(QResizeEvent* event) {
  QWidget::resizeEvent(event);
  FitStage();
}

void AudienceWindow::closeEvent(QCloseEvent* event) {
  event->accept();
  emit Closed();
}

void AudienceWindow::keyPressEvent(QKeyEvent* event) {
  if (event->key() == Qt::Key_F11 || event->key() == Qt::Key_Escape) {
    close();
  } else {
    QWidget::keyPressEvent(event);
  }
}

double DiagonalOf(const QScreen& screen) {
  return DiagonalOf(screen.physicalSize());
}

double DiagonalOf(const QSizeF& sides) {
  constexpr double millimetresPerInch = 25.4;
  constexpr double least = 10;
  constexpr double most = 300;
  constexpr double usual = 40;
  // Televisions that do not know their size tell the ratio of its sides in centimetres: 16 by 9, 160 by 90.
  constexpr QSizeF ratio(1600, 900);
  if (sides == ratio) {
    return usual;
  }
  const double inches = std::hypot(sides.width(), sides.height()) / millimetresPerInch;
  return inches >= least && inches <= most ? inches : usual;
}

QSize ScreenPixels(const QScreen& screen) {
  const QSizeF size = QSizeF(screen.size()) * screen.devicePixelRatio();
  return {qRound(size.width()), qRound(size.height())};
}
