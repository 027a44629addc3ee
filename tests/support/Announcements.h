#pragma once

#include <QCoreApplication>
#include <QString>
#include <vector>

#include "ui/Announce.h"

/// Hears what is announced to screen readers as long as it lives.
class Announcements : public QObject {
 public:
  Announcements() { qApp->installEventFilter(this); }

  /// Names of the controls that were announced, in this order.
  const std::vector<QString>& Heard() const { return heard_; }

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override {
    if (event->type() == AnnouncedEvent::EventType()) {
      heard_.push_back(watched->objectName());
    }
    return false;
  }

 private:
  std::vector<QString> heard_;
};
