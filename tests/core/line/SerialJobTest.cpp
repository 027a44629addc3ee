#include "core/line/SerialJob.h"

#include <gmock/gmock.h>

#include <vector>

#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/support/FailureOf.h"

using namespace std::chrono_literals;

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr const char* Device = "/dev/ttyS0";
constexpr const char* Settings = "19200,N,8,1";

class Job : public testing::Test {
 protected:
  void Open() { job.Open(Device, Settings); }

  /// Lets these bytes arrive after `delay`.
  void Arrive(std::chrono::milliseconds delay, const std::vector<std::uint8_t>& bytes) {
    events.At(delay, [this, bytes] { port.Receive(bytes); });
  }

  FakeSerialPort port;
  FakeEventPump events;
  bool stopped = false;
  SerialJob job{port, events, "box", [this] { return stopped; }};
};

TEST_F(Job, OpensTheLineAndClosesItAtItsEnd) {
  {
    SerialJob other(port, events, "box", [] { return false; });
    other.Open(Device, Settings);
    EXPECT_TRUE(port.PortOpen());
  }
  EXPECT_THAT(port.Log, ElementsAre("Open /dev/ttyS0 19200,N,8,1", "Close"));
}

TEST_F(Job, ClosesALineThatIsOpenBeforeItOpensIt) {
  port.Open("/dev/ttyUSB0", "9600,N,8,1");
  Open();
  EXPECT_THAT(port.Log, ElementsAre("Open /dev/ttyUSB0 9600,N,8,1", "Close", "Open /dev/ttyS0 19200,N,8,1"));
}

TEST_F(Job, TellsTheLineItsInstrument) {
  EXPECT_EQ(port.Instrument, "box");
  port.SetInstrument("another");
  Open();
  EXPECT_EQ(port.Instrument, "box");
}

TEST_F(Job, PassesAFailureToOpenOnAndIsNotOverByIt) {
  port.FailNextOpen(8005);
  EXPECT_EQ(FailureOf([&] { Open(); }), 8005);
  EXPECT_FALSE(job.Fault());
  Open();
  EXPECT_TRUE(job.Send(1));
}

TEST_F(Job, SendsAgainOnALineThatIsStillOpen) {
  Open();
  job.Send(1);
  job.WaitForByte(2000ms);
  EXPECT_TRUE(job.Send(2));
  EXPECT_THAT(port.Log, ElementsAre("Open /dev/ttyS0 19200,N,8,1", "Output 1", "Output 2"));
}

TEST_F(Job, WorksOnALineThatAnotherOneLeftOpen) {
  {
    SerialJob first(port, events, "box", [] { return false; });
    first.Open(Device, Settings);
    EXPECT_EQ(first.WaitForByte(10ms).Wait, LineWait::TimedOut);
    first.LeaveOpen();
  }
  ASSERT_TRUE(port.PortOpen());
  EXPECT_TRUE(job.Send(7));
  EXPECT_THAT(port.Sent, ElementsAre(7));
}

TEST_F(Job, ChangesTheSettingsOfTheOpenLine) {
  Open();
  EXPECT_TRUE(job.SetSettings("115200,N,8,1"));
  EXPECT_EQ(port.Settings, "115200,N,8,1");
  EXPECT_TRUE(job.Send(1));
}

TEST_F(Job, TakesBytesOneByOne) {
  Open();
  port.Receive({5, 6});
  EXPECT_EQ(job.Take(), 5);
  EXPECT_EQ(job.Take(), 6);
  EXPECT_EQ(job.Take(), std::nullopt);
  EXPECT_FALSE(job.Fault());
}

TEST_F(Job, DropsWhatWasReceivedWhenToldTo) {
  Open();
  port.Receive({5, 6});
  job.ClearInput();
  EXPECT_EQ(job.Take(), std::nullopt);
}

TEST_F(Job, WaitsForAByteUntilItComes) {
  Open();
  Arrive(30ms, {9});
  const auto [wait, byte] = job.WaitForByte(2000ms);
  EXPECT_EQ(wait, LineWait::Met);
  EXPECT_EQ(byte, 9);
  EXPECT_EQ(events.Now(), 30ms);
}

TEST_F(Job, WaitsForAByteNoLongerThanTheLimit) {
  Open();
  EXPECT_EQ(job.WaitForByte(2000ms).Wait, LineWait::TimedOut);
  EXPECT_EQ(events.Now(), 2000ms);
  EXPECT_FALSE(job.Over());
}

TEST_F(Job, WaitsForAConditionThatMayTakeBytes) {
  Open();
  int sum = 0;
  Arrive(10ms, {1, 2});
  Arrive(20ms, {3});
  const auto reached = [&] {
    while (const auto byte = job.Take()) {
      sum += *byte;
    }
    return sum >= 6;
  };
  EXPECT_EQ(job.WaitUntil(reached, 1000ms), LineWait::Met);
  EXPECT_EQ(events.Now(), 20ms);
  EXPECT_EQ(job.WaitUntil([&] { return sum > 6; }, 100ms), LineWait::TimedOut);
}

TEST_F(Job, MeetsAConditionThatHoldsAlreadyBeforeItTakesAnything) {
  Open();
  port.Receive({1});
  EXPECT_EQ(job.WaitUntil([] { return true; }, 1000ms), LineWait::Met);
  EXPECT_EQ(job.Take(), 1);
}

TEST_F(Job, PassesOnWhatAConditionThrows) {
  Open();
  EXPECT_EQ(FailureOf([&] { job.WaitUntil([]() -> bool { throw RuntimeError(9); }, 1000ms); }), 9);
  EXPECT_FALSE(job.Fault());
}

TEST_F(Job, StoppedFromOutsideEndsItsWaitsAndSendsNothingMore) {
  Open();
  events.At(300ms, [this] { stopped = true; });
  EXPECT_EQ(job.WaitForByte(2000ms).Wait, LineWait::Stopped);
  EXPECT_EQ(events.Now(), 300ms);
  port.Receive({1});
  EXPECT_FALSE(job.Send(1));
  EXPECT_FALSE(job.SetSettings("9600,N,8,1"));
  EXPECT_EQ(job.Take(), std::nullopt);
  EXPECT_EQ(job.WaitForByte(2000ms).Wait, LineWait::Stopped);
  EXPECT_EQ(events.Now(), 300ms);
  EXPECT_THAT(port.Sent, IsEmpty());
  EXPECT_TRUE(job.Over());
  EXPECT_FALSE(job.FaultToTell());
}

TEST_F(Job, GoesOnWhenTheStopFlagIsTakenBack) {
  Open();
  stopped = true;
  EXPECT_FALSE(job.Send(1));
  stopped = false;
  EXPECT_TRUE(job.Send(2));
}

TEST_F(Job, IsStoppedForGoodWhenTheProgramCloses) {
  Open();
  events.At(300ms, [this] { events.EndWaits(); });
  EXPECT_EQ(job.WaitForByte(2000ms).Wait, LineWait::Stopped);
  EXPECT_TRUE(job.Stopped());
  EXPECT_FALSE(job.Send(1));
}

TEST_F(Job, RemembersAFaultOfTheLineAndTellsItOnce) {
  Open();
  events.At(300ms, [this] { port.Lose(); });
  EXPECT_EQ(job.WaitForByte(2000ms).Wait, LineWait::Fault);
  EXPECT_EQ(events.Now(), 300ms);
  const auto fault = job.FaultToTell();
  ASSERT_TRUE(fault);
  EXPECT_EQ(fault->Error.Number(), 8012);
  EXPECT_FALSE(fault->Sending);
  EXPECT_FALSE(job.FaultToTell());
  EXPECT_TRUE(job.Fault());
  EXPECT_EQ(job.WaitForByte(2000ms).Wait, LineWait::Fault);
  EXPECT_EQ(events.Now(), 300ms);
}

TEST_F(Job, HasOneFaultForAllBytesOfALostLine) {
  Open();
  job.Send(1);
  port.Lose();
  for (int byte = 0; byte < 100; ++byte) {
    EXPECT_FALSE(job.Send(2));
    job.Pause(10ms);
  }
  EXPECT_THAT(port.Log, ElementsAre("Open /dev/ttyS0 19200,N,8,1", "Output 1", "Output 2 failed 8012"));
  EXPECT_TRUE(job.Fault()->Sending);
  EXPECT_EQ(events.Now(), 0ms);
}

TEST_F(Job, TellsNoFaultOnceItWasStopped) {
  Open();
  port.Lose();
  job.Send(1);
  stopped = true;
  EXPECT_FALSE(job.FaultToTell());
  EXPECT_EQ(job.WaitForByte(10ms).Wait, LineWait::Stopped);
}

TEST_F(Job, FindsAFaultOnALineThatIsClosed) {
  EXPECT_FALSE(job.Send(1));
  EXPECT_EQ(job.FaultToTell()->Error.Number(), 8018);
}

TEST_F(Job, FindsAFaultWhenItsLineIsClosedInAWait) {
  Open();
  events.At(100ms, [this] { port.Close(); });
  Arrive(200ms, {1});
  EXPECT_EQ(job.WaitForByte(2000ms).Wait, LineWait::Fault);
  EXPECT_EQ(job.FaultToTell()->Error.Number(), 8018);
}

TEST_F(Job, BeginsAnewWithTheNextOpen) {
  Open();
  port.Lose();
  job.Send(1);
  ASSERT_TRUE(job.FaultToTell());
  Open();
  EXPECT_FALSE(job.Over());
  EXPECT_TRUE(job.Send(2));
  port.Lose();
  job.Send(3);
  EXPECT_TRUE(job.FaultToTell());
}

TEST_F(Job, ClosesALineThatFailedAlsoWhenItWasToLeaveItOpen) {
  {
    SerialJob other(port, events, "box", [] { return false; });
    other.Open(Device, Settings);
    other.LeaveOpen();
    port.FailOutput(8012);
    other.Send(1);
  }
  EXPECT_FALSE(port.PortOpen());
}

/// The fake line has the baud rate of its settings.
class JobsPause : public Job {
 protected:
  JobsPause() {
    port.Pump = &events;
    Open();
  }
};

TEST_F(JobsPause, OfTenMillisecondsBeginsWhenAllIsOnTheLine) {
  for (int byte = 0; byte < 96; ++byte) {
    job.Send(1);  // 50 ms at 19200 baud
  }
  job.Pause(10ms);
  EXPECT_EQ(events.Now(), 59ms);
  ASSERT_EQ(port.Drains.size(), 1U);
  EXPECT_EQ(port.Drains[0].BytesSent, 96U);
  EXPECT_GE(port.Drains[0].Time, 49ms);
  EXPECT_THAT(events.Sleeps, ElementsAre(10ms));
}

TEST_F(JobsPause, OfOneMillisecondBeginsWhenTheByteWasHandedOver) {
  job.Send(1);
  job.Pause(1ms);
  job.Send(2);
  job.Pause(9ms);
  EXPECT_EQ(events.Elapsed(), 10ms);
  EXPECT_THAT(port.Drains, IsEmpty());
}

TEST_F(JobsPause, BlocksUpToFiftyMilliseconds) {
  bool served = false;
  events.At(1ms, [&] { served = true; });
  job.Pause(50ms);
  EXPECT_FALSE(served);
  job.Pause(51ms);
  EXPECT_TRUE(served);
  EXPECT_EQ(events.Now(), 101ms);
}

TEST_F(JobsPause, EndsWithTheJob) {
  events.At(300ms, [this] { stopped = true; });
  job.Pause(1000ms);
  EXPECT_EQ(events.Now(), 300ms);
  job.Pause(20ms);
  EXPECT_EQ(events.Now(), 300ms);
}

TEST_F(JobsPause, FindsALineThatWasLost) {
  job.Send(1);
  port.Lose();
  job.Pause(20ms);
  EXPECT_EQ(job.FaultToTell()->Error.Number(), 8012);
  EXPECT_THAT(events.Sleeps, IsEmpty());
}

}  // namespace
