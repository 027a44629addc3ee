#pragma once

#include <QWidget>

#include "audience/AudienceStage.h"

class QScreen;

/// Shows the stage: on the whole of a screen, or in an ordinary window.
class AudienceWindow : public QWidget {
  Q_OBJECT

 public:
  /// Null for an ordinary window. `stage` must outlive the window.
  AudienceWindow(AudienceStage& stage, QScreen* wholeScreen);

  /// Covers the screen as it is now; for a whole screen only.
  void Cover(QScreen& screen);

  /// Diagonal of the screen in inches; 0 for what the screen says of itself.
  void SetDiagonal(double inches);

 signals:
  /// The operator has closed the window.
  void Closed();

 protected:
  void paintEvent(QPaintEvent* event) override;
  void resizeEvent(QResizeEvent* event) override;
  void closeEvent(QCloseEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;

 private:
  void FitStage();

  AudienceStage& stage_;
  double inches_ = 0;
};

/// The diagonal that a screen says of itself, in inches; what is usual where it says nothing sensible.
double DiagonalOf(const QScreen& screen);

/// The same for the sides of a screen in millimetres.
double DiagonalOf(const QSizeF& sides);

/// The size of a screen in its own pixels.
QSize ScreenPixels(const QScreen& screen);
