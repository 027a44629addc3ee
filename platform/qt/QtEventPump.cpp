#include "platform/qt/QtEventPump.h"

#include <QCoreApplication>
#include <QEventLoop>
#include <algorithm>
#include <limits>
#include <thread>

using std::chrono::milliseconds;

class QtEventPump::OnStack {
 public:
  explicit OnStack(QtEventPump& pump) : pump_(pump) { ++pump_.depth_; }
  ~OnStack() {
    if (--pump_.depth_ == 0 && pump_.OnIdle) {
      pump_.idle_.start();
    }
  }
  OnStack(const OnStack&) = delete;
  OnStack& operator=(const OnStack&) = delete;

 private:
  QtEventPump& pump_;
};

QtEventPump::QtEventPump() {
  idle_.setSingleShot(true);
  idle_.setInterval(0);
  QObject::connect(&idle_, &QTimer::timeout, &idle_, [this] {
    if (depth_ == 0 && OnIdle) {
      OnIdle();
    }
  });
}

void QtEventPump::DoEvents() {
  const OnStack onStack(*this);
  QCoreApplication::processEvents();
}

WaitResult QtEventPump::WaitFor(const std::function<bool()>& condition, milliseconds limit) {
  if (condition()) {
    return WaitResult::Met;
  }
  const OnStack onStack(*this);
  const bool endless = limit > milliseconds(std::numeric_limits<int>::max());
  QTimer timer;
  timer.setTimerType(Qt::PreciseTimer);
  timer.setSingleShot(true);
  if (!endless) {
    timer.start(std::max(limit, milliseconds(0)));
  }
  while (true) {
    if (ended_) {
      return WaitResult::Ended;
    }
    if (!endless && !timer.isActive()) {
      return WaitResult::TimedOut;
    }
    QCoreApplication::processEvents(QEventLoop::AllEvents | QEventLoop::WaitForMoreEvents);
    if (condition()) {
      return WaitResult::Met;
    }
  }
}

void QtEventPump::Sleep(milliseconds time) {
  constexpr milliseconds longestBlock(50);
  if (time <= longestBlock) {
    std::this_thread::sleep_for(time);
  } else {
    WaitFor([] { return false; }, time);
  }
}
