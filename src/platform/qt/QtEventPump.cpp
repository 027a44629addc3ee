#include "platform/qt/QtEventPump.h"

#include <QCoreApplication>
#include <QEventLoop>
#include <QTimer>
#include <algorithm>
#include <limits>
#include <thread>

using std::chrono::milliseconds;

void QtEventPump::DoEvents() {
  QCoreApplication::processEvents();
}

WaitResult QtEventPump::WaitFor(const std::function<bool()>& condition, milliseconds limit) {
  const bool endless = limit > milliseconds(std::numeric_limits<int>::max());
  QTimer timer;
  timer.setTimerType(Qt::PreciseTimer);
  timer.setSingleShot(true);
  if (!endless) {
    timer.start(std::max(limit, milliseconds(0)));
  }
  while (!ended_) {
    if (condition()) {
      return WaitResult::Met;
    }
    if (!endless && !timer.isActive()) {
      return WaitResult::TimedOut;
    }
    QCoreApplication::processEvents(QEventLoop::AllEvents | QEventLoop::WaitForMoreEvents);
  }
  return WaitResult::Ended;
}

void QtEventPump::Sleep(milliseconds time) {
  constexpr milliseconds longestBlock(50);
  if (time <= longestBlock) {
    std::this_thread::sleep_for(time);
  } else {
    WaitFor([] { return false; }, time);
  }
}
