#include <unistd.h>

#include <QApplication>
#include <QElapsedTimer>
#include <QSocketNotifier>
#include <QTimer>
#include <algorithm>
#include <cstdio>
#include <functional>

#include "app/Program.h"
#include "web/ResultsHost.h"

namespace {

/// The longest time between two events of a timer that is due each millisecond: how long an operator's key
/// may have to wait.
class LongestDelay {
 public:
  LongestDelay() {
    timer_.setTimerType(Qt::PreciseTimer);
    QObject::connect(&timer_, &QTimer::timeout, &timer_, [this] {
      longest_ = std::max(longest_, since_.nsecsElapsed());
      since_.start();
    });
    since_.start();
    timer_.start(1);
  }

  /// In milliseconds, since the last call.
  double Take() {
    const double milliseconds = static_cast<double>(std::max(longest_, since_.nsecsElapsed())) / 1e6;
    longest_ = 0;
    return milliseconds;
  }

 private:
  QTimer timer_;
  QElapsedTimer since_;
  qint64 longest_ = 0;
};

void Tell(double number) {
  std::printf("%.3f\n", number);
  std::fflush(stdout);
}

/// Calls `then` once with the port at which the pages are answered.
void AwaitPages(const ResultsHost& host, const std::function<void(int)>& then) {
  auto* look = new QTimer(qApp);
  QObject::connect(look, &QTimer::timeout, look, [&host, look, then] {
    if (!host.Url().empty() && !host.IsReading()) {
      look->deleteLater();
      look->stop();
      then(host.Serving().Port);
    }
  });
  look->start(50);
}

}  // namespace

/// bench-watched-window: starts the program with the data below XDG_DATA_HOME, in which the results page is
/// on. Tells the port once the pages are there, then, for each byte at standard input, the longest delay of
/// its events in milliseconds since the byte before. Ends with standard input.
int main(int argc, char** argv) {
  QApplication application(argc, argv);
  Program program;
  if (!program.Start()) {
    return 1;
  }
  QSocketNotifier orders(STDIN_FILENO, QSocketNotifier::Read);
  LongestDelay delay;
  QObject::connect(&orders, &QSocketNotifier::activated, &orders, [&delay, &orders, &program] {
    char order = 0;
    if (read(STDIN_FILENO, &order, 1) == 1) {
      Tell(delay.Take());
    } else {
      orders.setEnabled(false);
      program.Window().close();
    }
  });
  AwaitPages(*program.Window().findChild<ResultsHost*>(), [](int port) { Tell(port); });
  return QApplication::exec();
}
