#pragma once

#include <QObject>

class QWidget;

/// Shows the tool tips of a window's controls when the keyboard comes to them too, not only when the mouse
/// rests on them.
class FocusTips : public QObject {
 public:
  explicit FocusTips(QObject& window) : QObject(&window) {}

  void Add(QWidget& control);

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;
};
