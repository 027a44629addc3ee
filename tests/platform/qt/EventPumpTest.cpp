#include <gtest/gtest.h>

#include <QTimer>
#include <string>

#include "platform/qt/QtEventPump.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/support/FailureOf.h"

using namespace std::chrono_literals;

namespace {

class TimedQtEventPump : public QtEventPump {
 public:
  static void At(std::chrono::milliseconds delay, const std::function<void()>& event) {
    QTimer::singleShot(delay, Qt::PreciseTimer, event);
  }
};

/// Behaviour shared by the real pump and its fake.
template <typename Pump>
class EventPumpTest : public testing::Test {
 protected:
  Pump Pump_;
};

using Pumps = testing::Types<TimedQtEventPump, FakeEventPump>;
TYPED_TEST_SUITE(EventPumpTest, Pumps);

TYPED_TEST(EventPumpTest, MeetsAConditionThatAlreadyHoldsWithoutServingEvents) {
  bool served = false;
  this->Pump_.At(0ms, [&] { served = true; });
  EXPECT_EQ(this->Pump_.WaitFor([] { return true; }, 1000ms), WaitResult::Met);
  EXPECT_FALSE(served);
  this->Pump_.DoEvents();
}

TYPED_TEST(EventPumpTest, ReturnsAsSoonAsAnEventHasMetTheCondition) {
  bool arrived = false;
  bool later = false;
  this->Pump_.At(10ms, [&] { arrived = true; });
  this->Pump_.At(200ms, [&] { later = true; });
  EXPECT_EQ(this->Pump_.WaitFor([&] { return arrived; }, 60s), WaitResult::Met);
  EXPECT_FALSE(later);
  EXPECT_EQ(this->Pump_.WaitFor([&] { return later; }, 60s), WaitResult::Met);
}

TYPED_TEST(EventPumpTest, TimesOutWhenTheLimitPassesFirst) {
  bool before = false;
  bool after = false;
  this->Pump_.At(10ms, [&] { before = true; });
  this->Pump_.At(500ms, [&] { after = true; });
  EXPECT_EQ(this->Pump_.WaitFor([&] { return after; }, 60ms), WaitResult::TimedOut);
  EXPECT_TRUE(before);
  EXPECT_FALSE(after);
  EXPECT_EQ(this->Pump_.WaitFor([&] { return after; }, 60s), WaitResult::Met);
}

TYPED_TEST(EventPumpTest, TimesOutAtOnceWhenThereIsNoTime) {
  EXPECT_EQ(this->Pump_.WaitFor([] { return false; }, 0ms), WaitResult::TimedOut);
  EXPECT_EQ(this->Pump_.WaitFor([] { return false; }, -5ms), WaitResult::TimedOut);
}

TYPED_TEST(EventPumpTest, WaitsForAnEventWithoutAnyLimit) {
  bool arrived = false;
  this->Pump_.At(10ms, [&] { arrived = true; });
  EXPECT_EQ(this->Pump_.WaitFor([&] { return arrived; }, std::chrono::milliseconds::max()), WaitResult::Met);
}

TYPED_TEST(EventPumpTest, AnOuterWaitGoesOnAfterTheInnerOne) {
  std::string order;
  bool inner = false;
  bool outer = false;
  this->Pump_.At(10ms, [&] {
    order += "inner starts, ";
    EXPECT_EQ(this->Pump_.WaitFor([&] { return inner; }, 60s), WaitResult::Met);
    order += "inner ends, ";
  });
  this->Pump_.At(40ms, [&] { inner = true; });
  this->Pump_.At(70ms, [&] { outer = true; });
  EXPECT_EQ(this->Pump_.WaitFor([&] { return outer; }, 60s), WaitResult::Met);
  EXPECT_EQ(order + "outer ends", "inner starts, inner ends, outer ends");
}

TYPED_TEST(EventPumpTest, AnOuterWaitWhoseConditionWasMetInAnInnerOneReturnsAfterIt) {
  bool outer = false;
  this->Pump_.At(10ms, [&] {
    EXPECT_EQ(this->Pump_.WaitFor([] { return false; }, 60ms), WaitResult::TimedOut);
    EXPECT_TRUE(outer);
  });
  this->Pump_.At(20ms, [&] { outer = true; });
  EXPECT_EQ(this->Pump_.WaitFor([&] { return outer; }, 60s), WaitResult::Met);
}

TYPED_TEST(EventPumpTest, AnOuterLimitThatPassedInAnInnerWaitTimesOutAfterIt) {
  bool innerEnded = false;
  this->Pump_.At(10ms, [&] {
    EXPECT_EQ(this->Pump_.WaitFor([] { return false; }, 120ms), WaitResult::TimedOut);
    innerEnded = true;
  });
  EXPECT_EQ(this->Pump_.WaitFor([] { return false; }, 60ms), WaitResult::TimedOut);
  EXPECT_TRUE(innerEnded);
}

TYPED_TEST(EventPumpTest, EndsAllWaitsWhenTheProgramCloses) {
  WaitResult inner = WaitResult::Met;
  this->Pump_.At(10ms, [&] { inner = this->Pump_.WaitFor([] { return false; }, 60s); });
  this->Pump_.At(30ms, [&] { this->Pump_.EndWaits(); });
  EXPECT_EQ(this->Pump_.WaitFor([] { return false; }, 60s), WaitResult::Ended);
  EXPECT_EQ(inner, WaitResult::Ended);
  EXPECT_EQ(this->Pump_.WaitFor([] { return false; }, 60s), WaitResult::Ended);
  EXPECT_EQ(this->Pump_.WaitFor([] { return true; }, 60s), WaitResult::Ended);
}

TYPED_TEST(EventPumpTest, ALongPauseServesEventsAndAShortOneDoesNot) {
  bool served = false;
  this->Pump_.At(0ms, [&] { served = true; });
  this->Pump_.Sleep(50ms);
  EXPECT_FALSE(served);
  this->Pump_.Sleep(51ms);
  EXPECT_TRUE(served);
}

TYPED_TEST(EventPumpTest, DoEventsServesWhatIsPending) {
  int served = 0;
  this->Pump_.At(0ms, [&] { ++served; });
  this->Pump_.At(1ms, [&] { ++served; });
  this->Pump_.Sleep(5ms);
  this->Pump_.DoEvents();
  EXPECT_EQ(served, 2);
}

TYPED_TEST(EventPumpTest, AFailureInTheConditionEndsTheWait) {
  bool lost = false;
  this->Pump_.At(10ms, [&] { lost = true; });
  const auto condition = [&] {
    if (lost) {
      throw RuntimeError(8012);
    }
    return false;
  };
  EXPECT_EQ(FailureOf([&] { this->Pump_.WaitFor(condition, 60s); }), 8012);
  EXPECT_EQ(this->Pump_.WaitFor([] { return false; }, 1ms), WaitResult::TimedOut);
}

TYPED_TEST(EventPumpTest, TellsTheTimeThatPassesInWaitsAndPauses) {
  const auto start = this->Pump_.Elapsed();
  EXPECT_GE(start, 0us);
  this->Pump_.Sleep(20ms);
  const auto afterPause = this->Pump_.Elapsed();
  EXPECT_GE(afterPause - start, 20ms);
  this->Pump_.WaitFor([] { return false; }, 30ms);
  EXPECT_GE(this->Pump_.Elapsed() - afterPause, 29ms);
  EXPECT_LT(this->Pump_.Elapsed() - start, 20s);
}

TEST(FakeEventPump, TimeThatPassesInABlockingCallServesNoEvent) {
  FakeEventPump pump;
  bool served = false;
  pump.At(1ms, [&] { served = true; });
  pump.Pass(1500us);
  EXPECT_FALSE(served);
  EXPECT_EQ(pump.Elapsed(), 1500us);
  EXPECT_EQ(pump.Now(), 1ms);
  pump.DoEvents();
  EXPECT_TRUE(served);
}

TEST(FakeEventPump, AMinuteTakesNoTimeAndCanBeReadFromItsClock) {
  FakeEventPump pump;
  const auto start = std::chrono::steady_clock::now();
  pump.Sleep(20ms);
  pump.Sleep(60s);
  EXPECT_EQ(pump.WaitFor([] { return false; }, 5s), WaitResult::TimedOut);
  EXPECT_EQ(pump.Now(), 65020ms);
  EXPECT_EQ(pump.Sleeps, (std::vector<std::chrono::milliseconds>{20ms, 60s}));
  EXPECT_LT(std::chrono::steady_clock::now() - start, 30s);
}

TEST(FakeEventPump, RunsEventsOfOneInstantInTheOrderOfScheduling) {
  FakeEventPump pump;
  std::string order;
  pump.At(5ms, [&] { order += 'b'; });
  pump.At(5ms, [&] { order += 'c'; });
  pump.At(1ms, [&] {
    order += 'a';
    pump.At(4ms, [&] { order += 'd'; });
  });
  pump.WaitFor([] { return false; }, 10ms);
  EXPECT_EQ(order, "abcd");
}

TEST(FakeEventPump, AnEndlessWaitThatNothingCanEndIsAMistakeOfTheTest) {
  FakeEventPump pump;
  EXPECT_THROW(pump.WaitFor([] { return false; }, std::chrono::milliseconds::max()), std::logic_error);
}

}  // namespace
