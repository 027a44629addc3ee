#pragma once

#include <QSocketNotifier>
#include <optional>

#include "platform/linux/Descriptor.h"

/// Ctrl+C and the signal to end, taken as events: the program itself ends when its device allows it. Needs a
/// QCoreApplication, and must be made before the first thread.
class StopSignals {
 public:
  StopSignals();

  /// How many have come.
  int Count() const { return count_; }

 private:
  void Take();

  Descriptor descriptor_;
  std::optional<QSocketNotifier> notifier_;
  int count_ = 0;
};
