#pragma once

#include <QLabel>

/// A label that shows all of its text in as many lines as it takes, and breaks a path where it must. The text
/// never widens the window.
class StatusText : public QLabel {
 public:
  explicit StatusText(QWidget* parent = nullptr);

  QSize sizeHint() const override;
  QSize minimumSizeHint() const override;
  int heightForWidth(int width) const override;

 protected:
  void paintEvent(QPaintEvent* event) override;
};
