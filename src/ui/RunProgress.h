#pragma once

#include <QElapsedTimer>

#include "platform/EventPump.h"

class QAbstractButton;
class QProgressBar;

/// A long run of a window, which keeps being painted and takes presses meanwhile. While this exists, the bar
/// shows how far the run is and the Stop button is enabled.
class RunProgress {
 public:
  /// All of them must outlive this object. `stopped` becomes false, and ends the run once it is true.
  RunProgress(QProgressBar& bar, QAbstractButton& stop, EventPump& events, bool& stopped);
  ~RunProgress();
  RunProgress(const RunProgress&) = delete;
  RunProgress& operator=(const RunProgress&) = delete;

  /// To be called often; `done` runs from 0 to 1. Returns false if the run is to stop.
  bool GoOn(double done);

 private:
  QProgressBar& bar_;
  QAbstractButton& stop_;
  EventPump& events_;
  bool& stopped_;
  QElapsedTimer sinceEvents_;
};
