#pragma once

#include <QObject>
#include <QSocketNotifier>
#include <functional>
#include <memory>
#include <vector>

#include "platform/linux/InstanceCall.h"

/// Takes the calls of later starts of the program while the event loop runs.
class InstanceCalls : public QObject {
 public:
  /// `listener` is a listening socket, or negative for none; it must outlive this object. `mayTake` tells
  /// whether the program still takes requests. `take` may not wait.
  InstanceCalls(int listener, std::function<bool()> mayTake,
                std::function<void(const InstanceRequest& request)> take);
  ~InstanceCalls() override;

 private:
  struct Caller;

  void Accept();
  void Read(Caller& caller);
  void HangUp(const Caller& caller);

  const int listener_;
  const std::function<bool()> mayTake_;
  const std::function<void(const InstanceRequest&)> take_;
  std::unique_ptr<QSocketNotifier> arriving_;
  std::vector<std::unique_ptr<Caller>> callers_;  ///< oldest first
};
