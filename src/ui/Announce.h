#pragma once

#include <QEvent>

class QWidget;

/// Sent to a control whose text is announced, whether or not a screen reader listens.
class AnnouncedEvent : public QEvent {
 public:
  AnnouncedEvent() : QEvent(EventType()) {}

  static Type EventType() {
    static const int type = registerEventType();
    return static_cast<Type>(type);
  }
};

/// Lets screen readers say the text of a control that has changed without having the keyboard.
void Announce(QWidget& control);
