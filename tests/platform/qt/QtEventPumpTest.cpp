#include "platform/qt/QtEventPump.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <QSocketNotifier>
#include <QTimer>
#include <string>

#include "tests/support/FailureOf.h"
#include "tests/support/ProcessorTime.h"

using namespace std::chrono_literals;

namespace {

TEST(QtEventPump, AnIdleWaitBurnsNoProcessorTime) {
  QtEventPump pump;
  const auto start = ProcessorTime();
  EXPECT_EQ(pump.WaitFor([] { return false; }, 1000ms), WaitResult::TimedOut);
  EXPECT_LT(ProcessorTime() - start, 20ms);
}

TEST(QtEventPump, DoEventsServesPendingEventsOfAllKinds) {
  QtEventPump pump;
  int ends[2] = {};
  ASSERT_EQ(::pipe(ends), 0);
  ASSERT_EQ(::write(ends[1], "x", 1), 1);
  std::string served;
  QSocketNotifier input(ends[0], QSocketNotifier::Read);
  QObject::connect(&input, &QSocketNotifier::activated, &input, [&] {
    served += "input ";
    input.setEnabled(false);
  });
  QTimer idle;
  idle.setSingleShot(true);
  QObject::connect(&idle, &QTimer::timeout, &idle, [&] { served += "timer "; });
  idle.start(0);
  QMetaObject::invokeMethod(
      &idle, [&] { served += "queued "; }, Qt::QueuedConnection);
  pump.DoEvents();
  EXPECT_NE(served.find("input"), std::string::npos) << served;
  EXPECT_NE(served.find("timer"), std::string::npos) << served;
  EXPECT_NE(served.find("queued"), std::string::npos) << served;
  ::close(ends[0]);
  ::close(ends[1]);
}

TEST(QtEventPump, DoEventsReturnsThoughEventsKeepMakingNewOnes) {
  QtEventPump pump;
  QTimer restless;
  int ticks = 0;
  QObject::connect(&restless, &QTimer::timeout, &restless, [&] { ++ticks; });
  restless.start(0);
  pump.DoEvents();
  EXPECT_GT(ticks, 0);
}

TEST(QtEventPump, ALimitNeverPassesEarly) {
  QtEventPump pump;
  const auto start = std::chrono::steady_clock::now();
  EXPECT_EQ(pump.WaitFor([] { return false; }, 30ms), WaitResult::TimedOut);
  EXPECT_GE(std::chrono::steady_clock::now() - start, 30ms);
}

TEST(QtEventPump, WaitsAgainAfterAConditionFailed) {
  QtEventPump pump;
  int tests = 0;
  QTimer::singleShot(0, [] {});
  const auto condition = [&]() -> bool {
    if (++tests > 1) {
      throw RuntimeError(8012);
    }
    return false;
  };
  EXPECT_EQ(FailureOf([&] { pump.WaitFor(condition, 10s); }), 8012);
  EXPECT_EQ(pump.WaitFor([] { return true; }, 10s), WaitResult::Met);
}

}  // namespace
