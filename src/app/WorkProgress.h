#pragma once

#include <QElapsedTimer>
#include <QProgressDialog>
#include <chrono>
#include <memory>

#include "core/text/StringTable.h"
#include "platform/EventPump.h"

/// Shows in a window how far long work of the main window is, with a Stop, once that takes more than a
/// moment.
class WorkProgress {
 public:
  struct Parts {
    QWidget& Window;  ///< in front of which it opens
    EventPump& Events;
    const StringTable& Strings;
  };

  /// `text` says what is being done. `moment` is the time until the window appears.
  WorkProgress(const Parts& parts, OwnText text,
               std::chrono::milliseconds moment = std::chrono::milliseconds(80));

  /// To be called often; `done` runs from 0 to 1. Processes events now and then. Returns false if the work is
  /// to stop.
  bool GoOn(double done);

 private:
  void Open();

  const Parts parts_;
  const OwnText text_;
  const std::chrono::milliseconds moment_;
  QElapsedTimer sinceBegun_;
  QElapsedTimer sinceShown_;
  std::unique_ptr<QProgressDialog> window_;  ///< set once it has taken more than a moment
};
