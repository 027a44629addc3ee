#pragma once

#include <QObject>

/// Gives the buttons and labelled entries of each window of the application a letter for the Alt key before
/// it is first shown, once installed as the application's event filter. What screen readers call a control
/// stays the caption alone.
class AltLetters : public QObject {
 public:
  using QObject::QObject;

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;
};
