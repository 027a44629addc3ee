#pragma once

#include <QEvent>
#include <QString>
#include <utility>

/// Sent to the application before the operator's command runs, in any window; an event filter on the
/// application sees all of them.
class CommandEvent : public QEvent {
 public:
  /// `name` is the object name of the menu item or button.
  explicit CommandEvent(QString name) : QEvent(EventType()), name_(std::move(name)) {}

  static QEvent::Type EventType() {
    static const int type = QEvent::registerEventType();
    return static_cast<QEvent::Type>(type);
  }

  const QString& Name() const { return name_; }

 private:
  QString name_;
};

/// Sent to the application when the last of a window's commands has unwound.
class CommandsEndedEvent : public QEvent {
 public:
  CommandsEndedEvent() : QEvent(EventType()) {}

  static QEvent::Type EventType() {
    static const int type = QEvent::registerEventType();
    return static_cast<QEvent::Type>(type);
  }
};
