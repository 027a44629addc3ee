#pragma once

#include <QWidget>

/// A round lamp, red or green.
class Lamp : public QWidget {
  Q_OBJECT

 public:
  explicit Lamp(QWidget* parent = nullptr);

  void SetGreen(bool green);
  bool IsGreen() const { return green_; }

  QSize sizeHint() const override;

 protected:
  void paintEvent(QPaintEvent* event) override;

 private:
  bool green_ = false;
};
