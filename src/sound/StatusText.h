#pragma once

#include <QLabel>

/// A label that shows its text in as many lines as it takes, and breaks a path where it must. A long text is
/// shown in the window's own font. The text never widens the window, nor pushes its buttons together.
class StatusText : public QLabel {
 public:
  explicit StatusText(QWidget* parent = nullptr);

  QSize sizeHint() const override;
  QSize minimumSizeHint() const override;
  int heightForWidth(int width) const override;

 protected:
  void paintEvent(QPaintEvent* event) override;

 private:
  int NeededHeight(const QFont& font, int width) const;
  QFont FontFor(int width) const;
};
