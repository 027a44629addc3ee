#include <gmock/gmock.h>

#include <algorithm>
#include <string>

#include "devices/radio/GunSearch.h"
#include "devices/radio/ScoreFetch.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtSerialPort.h"
#include "sim/radio/RadioModem.h"
#include "tests/devices/radio/RadioSite.h"

// The radio link with its real line and event loop, and three guns behind the simulated modem. Whatever goes
// wrong there, each job ends, and the line is closed.

namespace {

using sim::RadioFailure;
using testing::AnyOf;
using testing::IsEmpty;

constexpr std::uint8_t Ids[] = {32, 34, 37};
constexpr std::uint8_t StrickenId = 34;

std::vector<sim::RadioGun> ThreeGuns() {
  std::vector<sim::GunScores> game;
  for (const std::uint8_t id : Ids) {
    sim::GunScores scores;
    scores.PlayerId = id;
    scores.ShotCount = static_cast<std::uint16_t>(100 + id);
    scores.PrimaryDamage = 10;
    for (const std::uint8_t shooter : Ids) {
      scores.Hits.push_back({shooter, static_cast<std::uint16_t>(id + shooter)});
    }
    game.push_back(scores);
  }
  return sim::MakeRadioGuns(game);
}

/// The real event loop, with waits for an answer of a quarter of their length: the guns here answer at once
/// or never.
class ShortWaits : public EventPump {
 public:
  void EndWaits() override { events_.EndWaits(); }
  void DoEvents() override { events_.DoEvents(); }
  WaitResult WaitFor(const std::function<bool()>& condition, std::chrono::milliseconds limit) override {
    constexpr std::chrono::milliseconds longest(500);
    return events_.WaitFor(condition, std::min(limit, longest));
  }
  void Sleep(std::chrono::milliseconds time) override { events_.Sleep(time); }

 private:
  QtEventPump events_;
};

class RadioVenue : public testing::TestWithParam<sim::RadioFailureInfo> {
 protected:
  /// The failure strikes the gun StrickenId this often, 0: always.
  void Open(int times) {
    modem_.emplace(sim::RadioModemSettings{.Guns = ThreeGuns(), .Trouble = {GetParam().Failure, 2, times}});
    devices_.Ports = {modem_->DevicePath()};
  }

  void Search() {
    Run([this](RadioLink& link) { GunSearch(link, events_, strings_, guns_, display_).SearchGuns(8); });
  }

  void GetScores() {
    Run([this](RadioLink& link) {
      ScoreFetch(link, events_, time_, strings_, game_, guns_, display_).GetScores();
    });
  }

  int CountOf(ScoreStatus status) const {
    return static_cast<int>(std::count_if(guns_.begin(), guns_.end(), [status](const GunEntry& gun) {
      return gun.Present && gun.ScoreStatus == status;
    }));
  }

  const Player& PlayerOf(std::uint8_t id) const { return game_.Players(IndexFromId(id)); }
  std::vector<std::string> HostFaults() const { return modem_->Traffic().Faults; }

  int fault = 0;  ///< number of what ended the last job, 0 for none

 private:
  template <typename Job>
  void Run(const Job& job) {
    fault = 0;
    try {
      RadioLink link(port_, line_, events_, [] { return false; });
      job(link);
      link.ThrowIfLineLost();
    } catch (const RuntimeError& error) {
      fault = error.Number();
    }
    EXPECT_FALSE(port_.PortOpen());
  }

  std::optional<sim::RadioModem> modem_;
  FakeFiles files_;
  FakeSerialDevices devices_;
  FakeMessageBoxes boxes_;
  FakeClock time_;
  StringTable strings_{Language::English};
  IniReader ini_{files_, "/tessarine.ini"};
  QtSerialPort port_;
  ShortWaits events_;
  CommPort line_{port_, ini_, devices_, boxes_, strings_, [] {}};
  Game game_{strings_};
  GunTable guns_;
  FakeRadioDisplay display_;
};

/// The number of the fault that this failure is told to be, 0 for none.
int FaultInSearch(RadioFailure failure) {
  switch (failure) {
    case RadioFailure::HangUpInSearch:
      return 8012;
    case RadioFailure::LowPlayerId:
      return 6;
    case RadioFailure::LongData:
    case RadioFailure::LongPayload:
    case RadioFailure::LongAtResponse:
      return 9;
    default:
      return 0;
  }
}

int FaultInFetch(RadioFailure failure) {
  switch (failure) {
    case RadioFailure::HangUpInSearch:
      return 8018;  // the device is gone, so the line does not open
    case RadioFailure::HangUpInBlock:
      return 8012;
    case RadioFailure::TotalZero:
    case RadioFailure::TotalAbove270:
      return 6;
    default:
      return 0;
  }
}

TEST_P(RadioVenue, GetsOverAFailureThatComesOnce) {
  const RadioFailure failure = GetParam().Failure;
  Open(1);
  Search();
  EXPECT_EQ(fault, FaultInSearch(failure));
  if (failure == RadioFailure::HangUpInSearch) {
    return;
  }
  if (fault != 0) {
    Search();
    EXPECT_EQ(fault, 0);
  }
  EXPECT_EQ(CountOf(ScoreStatus::Pending), 3);
  GetScores();
  EXPECT_EQ(fault, FaultInFetch(failure));
  if (failure == RadioFailure::HangUpInBlock) {
    EXPECT_EQ(CountOf(ScoreStatus::Failed), 1);
    return;
  }
  if (fault != 0) {
    GetScores();
    EXPECT_EQ(CountOf(ScoreStatus::Ok), 2);
    EXPECT_EQ(CountOf(ScoreStatus::InProgress), 1);
    return;
  }
  EXPECT_EQ(CountOf(ScoreStatus::Ok), 3);
  for (const std::uint8_t id : Ids) {
    const int times = failure == RadioFailure::LostClose && id == StrickenId ? 2 : 1;
    EXPECT_EQ(PlayerOf(id).ShotCount, times * (100 + id));
    EXPECT_EQ(PlayerOf(id).HitByPlayer(IndexFromId(37)), times * (id + 37));
  }
  EXPECT_THAT(HostFaults(), IsEmpty());
}

TEST_P(RadioVenue, EndsEachJobWithAFailureThatStays) {
  Open(0);
  Search();
  EXPECT_EQ(fault, FaultInSearch(GetParam().Failure));
  GetScores();
  // Answers that are one behind make the figures of a block pass for a size.
  EXPECT_THAT(fault, AnyOf(0, 6, FaultInFetch(GetParam().Failure)));
  EXPECT_LE(CountOf(ScoreStatus::InProgress), fault == 6 ? 1 : 0);
}

std::string NameOf(const testing::TestParamInfo<sim::RadioFailureInfo>& failure) {
  std::string name(failure.param.Name);
  std::replace(name.begin(), name.end(), '-', '_');
  return name;
}

INSTANTIATE_TEST_SUITE_P(Failures, RadioVenue, testing::ValuesIn(sim::RadioFailures), NameOf);

}  // namespace
