#pragma once

#include <functional>
#include <memory>

#include "platform/WakeLock.h"

class QDBusConnection;

/// Asks the services of the desktop that can hold off its sleep. Their answers arrive while events are
/// processed. Should the program die, they forget it by themselves.
class DBusWakeLock final : public WakeLock {
 public:
  /// On the message bus of the operator's session.
  DBusWakeLock();
  /// `bus` is called for each use.
  explicit DBusWakeLock(std::function<QDBusConnection()> bus);
  ~DBusWakeLock() override;

  void Hold(const std::string& reason) override;
  void Release() override;

 private:
  class Requests;
  std::unique_ptr<Requests> requests_;
  int holds_ = 0;
};
