#include "devices/radio/GunSearch.h"

#include <gmock/gmock.h>

#include <chrono>
#include <numeric>

#include "core/game/PlayerId.h"
#include "core/text/NumberForms.h"
#include "tests/devices/radio/RadioSite.h"

namespace {

using std::chrono::milliseconds;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;

/// Notes how many frames had gone out whenever the search itself, not its link, serves events.
class NotingPump : public EventPump {
 public:
  NotingPump(FakeEventPump& events, const std::vector<Bytes>& frames) : events_(events), frames_(frames) {}

  std::vector<std::size_t> FramesBefore;

  void EndWaits() override { events_.EndWaits(); }
  void DoEvents() override {
    FramesBefore.push_back(frames_.size());
    events_.DoEvents();
  }
  WaitResult WaitFor(const std::function<bool()>& condition, milliseconds limit) override {
    return events_.WaitFor(condition, limit);
  }
  void Sleep(milliseconds time) override { events_.Sleep(time); }

 private:
  FakeEventPump& events_;
  const std::vector<Bytes>& frames_;
};

class Search : public testing::Test, protected RadioSite {
 protected:
  void Run(std::int16_t maxPlayerId) {
    RadioLink link(Port, Line, Events, [this] { return stopped; });
    GunSearch(link, Events, Strings, guns, display).SearchGuns(maxPlayerId);
    fault = [&link] {
      try {
        link.ThrowIfLineLost();
        return 0;
      } catch (const RuntimeError& error) {
        return error.Number();
      }
    }();
  }

  /// The number of the fault that ends the search, 0 for none.
  int FaultOf(std::int16_t maxPlayerId) {
    try {
      Run(maxPlayerId);
    } catch (const RuntimeError& error) {
      return error.Number();
    }
    return 0;
  }

  /// Gun `playerId` answers each call after `delay` ms.
  void PutGun(std::uint8_t playerId, int delay = 5) {
    const auto others = OnPacket;
    OnPacket = [this, others, playerId, delay](const Bytes& packet) {
      others(packet);
      if (packet[1] == playerId) {
        Arrive(delay, Received(playerId, SearchAnswer(playerId)));
      }
    };
  }

  /// These bytes arrive 3 ms after the first call of gun 40.
  void AfterCallOf40(const Bytes& bytes) {
    callsOf40_ = 0;
    OnPacket = [this, bytes](const Bytes& packet) {
      if (packet[1] == 40 && ++callsOf40_ == 1) {
        Arrive(3, bytes);
      }
    };
  }

  const GunEntry& Gun(std::uint8_t playerId) const { return guns[playerId - 32U]; }
  int CountPresent() const {
    int count = 0;
    for (const GunEntry& gun : guns) {
      count += gun.Present ? 1 : 0;
    }
    return count;
  }

  GunTable guns;
  FakeRadioDisplay display;
  bool stopped = false;
  int fault = 0;

 private:
  int callsOf40_ = 0;
};

TEST_F(Search, CallsEachIdInTwoFullPassesByBroadcast) {
  Run(128);
  ASSERT_EQ(Frames.size(), 256U);
  for (std::size_t i = 0; i < Frames.size(); ++i) {
    const auto id = static_cast<std::uint8_t>(32 + i % 128);
    EXPECT_EQ(Packets()[i], (Bytes{0, id, 0, 0, 6}));
    EXPECT_EQ(Bytes(Frames[i].begin() + 3, Frames[i].begin() + 14),
              (Bytes{0, 0, 0, 0, 0, 0, 0, 0, 0xFF, 0xFF, 0}));
  }
}

TEST_F(Search, Of224CallsIds32To255) {
  Run(224);
  ASSERT_EQ(Frames.size(), 448U);
  EXPECT_EQ(Packets()[0][1], 32);
  EXPECT_EQ(Packets()[223][1], 255);
  EXPECT_EQ(Packets()[224][1], 32);
  EXPECT_EQ(Packets()[447][1], 255);
}

TEST_F(Search, WaitsTwelveMillisecondsForEach) {
  Run(128);
  EXPECT_EQ(Events.Now(), milliseconds(256 * 12));
}

TEST_F(Search, ServesEventsBeforeEachCall) {
  NotingPump pump(Events, Frames);
  RadioLink link(Port, Line, Events, [] { return false; });
  GunSearch(link, pump, Strings, guns, display).SearchGuns(128);
  std::vector<std::size_t> eachCall(256);
  std::iota(eachCall.begin(), eachCall.end(), 0U);
  EXPECT_EQ(pump.FramesBefore, eachCall);
}

TEST_F(Search, ListsAGunWithAllThatItSaysOfItself) {
  PutGun(33);
  Run(128);
  const GunEntry& gun = Gun(33);
  EXPECT_TRUE(gun.Present);
  EXPECT_EQ(gun.Firmware, " 2. 5");
  EXPECT_EQ(gun.Battery, 85);
  EXPECT_EQ(gun.WeaponType, 1);
  EXPECT_EQ(gun.PlayerID, 33);
  EXPECT_EQ(gun.PlayerName, "Red  1");
  EXPECT_THAT(gun.Address, ElementsAre(33, 2, 1, 0x40, 0, 0xA2, 0x13, 0));
  EXPECT_EQ(gun.ScoreStatus, ScoreStatus::Pending);
  EXPECT_EQ(CountPresent(), 1);
}

TEST_F(Search, NamesGunsByTeamAndNumber) {
  for (const std::uint8_t id : Bytes{32, 63, 64, 96, 255}) {
    PutGun(id);
  }
  Run(224);
  EXPECT_EQ(Gun(32).PlayerName, "Red  0");
  EXPECT_EQ(Gun(63).PlayerName, "Red  31");
  EXPECT_EQ(Gun(64).PlayerName, "Blue  0");
  EXPECT_EQ(Gun(255).PlayerName,
            TeamNameFromNumber(Strings, TeamFromId(255)) + " " + Str(PlayerNumberFromId(255)));
}

TEST_F(Search, NamesGunsInTheProgramsLanguage) {
  Strings = StringTable(Language::SimplifiedChinese);
  PutGun(33);
  Run(128);
  EXPECT_EQ(Gun(33).PlayerName, "红队  1");
}

TEST_F(Search, ShowsItsCourse) {
  PutGun(33);
  PutGun(40);
  Run(128);
  EXPECT_THAT(display.Log, ElementsAre("Status Searching...", "Clear", "Found 0", "Found 1", "Refresh",
                                       "Found 2", "Refresh", "Status Idle"));
  ASSERT_EQ(display.Progress.size(), 256U);
  EXPECT_EQ(display.Progress.front(), "Pass 1 of 2, ID 32: 0/256");
  EXPECT_EQ(display.Progress.back(), "Pass 2 of 2, ID 159: 255/256");
}

TEST_F(Search, KeepsTheLineOpenOnlyWhileItRuns) {
  display.OnRefresh = [this] { EXPECT_TRUE(Port.PortOpen()); };
  PutGun(33);
  {
    RadioLink link(Port, Line, Events, [] { return false; });
    GunSearch(link, Events, Strings, guns, display).SearchGuns(128);
    EXPECT_FALSE(Port.PortOpen());
  }
  EXPECT_EQ(Port.Log.front(), "Open /dev/ttyS0 57600,N,8,1");
  EXPECT_EQ(Port.Log.back(), "Close");
  EXPECT_THAT(Port.Log, testing::Contains("Close").Times(1));
}

TEST_F(Search, ListsAGunOnceAndKeepsItsFirstAnswer) {
  int calls = 0;
  OnPacket = [&](const Bytes& packet) {
    if (packet[1] == 33) {
      ++calls;
      Arrive(5, Received(static_cast<std::uint8_t>(calls),
                         {4, 33, 0, 0, 7, static_cast<std::uint8_t>(calls), 0, 50, 3}));
    }
  };
  Run(128);
  EXPECT_EQ(calls, 2);
  EXPECT_EQ(Gun(33).Firmware, " 1. 0");
  EXPECT_EQ(Gun(33).Address[0], 1);
  EXPECT_EQ(CountPresent(), 1);
  EXPECT_THAT(display.Log, Not(testing::Contains("Found 2")));
}

TEST_F(Search, FindsAGunThatAnswersTheSecondPassOnly) {
  int calls = 0;
  OnPacket = [&](const Bytes& packet) {
    if (packet[1] == 33 && ++calls == 2) {
      Arrive(5, Received(33, SearchAnswer(33)));
    }
  };
  Run(128);
  EXPECT_TRUE(Gun(33).Present);
}

TEST_F(Search, TakesAnAnswerInALaterGunsSlot) {
  PutGun(33, 30);
  Run(128);
  EXPECT_TRUE(Gun(33).Present);
  EXPECT_EQ(Gun(33).PlayerName, "Red  1");
}

TEST_F(Search, TakesAllAnswersThatComeAtOnceAndKeepsTheSlotsBehind) {
  AfterCallOf40(Joined({Received(1, SearchAnswer(40)), Received(2, SearchAnswer(41)),
                        Received(3, SearchAnswer(42)), ModemStatusFrame(), Received(4, SearchAnswer(43))}));
  Run(128);
  for (const std::uint8_t id : Bytes{40, 41, 42, 43}) {
    EXPECT_TRUE(Gun(id).Present) << int(id);
  }
  EXPECT_EQ(Events.Now(), milliseconds(255 * 12 + 3));
}

TEST_F(Search, ReadsAnAnswerWhateverBeginsBehindIt) {
  const Bytes another = Received(1, SearchAnswer(50));
  for (std::size_t length = 1; length < another.size(); ++length) {
    AfterCallOf40(Joined({Received(40, SearchAnswer(40)),
                          Bytes(another.begin(), another.begin() + static_cast<std::ptrdiff_t>(length))}));
    EXPECT_EQ(FaultOf(128), 0);
    EXPECT_EQ(Gun(40).PlayerID, 40) << length;
    EXPECT_EQ(Gun(40).Address[0], 40) << length;
    EXPECT_EQ(CountPresent(), 1) << length;
    guns = {};
  }
}

TEST_F(Search, ListsAGunThatWasNotCalled) {
  AfterCallOf40(Received(200, SearchAnswer(200)));
  Run(128);
  EXPECT_TRUE(Gun(200).Present);
  EXPECT_THAT(display.Log, testing::Contains("Found 1"));
}

TEST_F(Search, PassesOverFramesAndPacketsOfOtherKinds) {
  for (const Bytes& bytes :
       {ModemStatusFrame(), TransmitStatusFrame(), Framed({0x81, 1, 2, 40, 0, 4, 40, 0, 0, 7, 1, 1, 1, 1}),
        Framed({0x88, 1, 'A', 'P', 0}), Received(40, {4, 40, 0, 0, 5, 1, 1, 1, 1}),
        Received(40, {4, 40, 0, 0, 6, 1, 1, 1, 1})}) {
    Frames.clear();
    AfterCallOf40(bytes);
    Run(128);
    EXPECT_EQ(CountPresent(), 0);
  }
}

TEST_F(Search, PassesOverAnAnswerWithABadCheckByte) {
  Bytes bad = Received(40, SearchAnswer(40));
  bad.back() ^= 1;
  AfterCallOf40(bad);
  Run(128);
  EXPECT_EQ(CountPresent(), 0);
}

TEST_F(Search, StartsAfresh) {
  PutGun(33);
  Run(128);
  guns[1].ScoreStatus = ScoreStatus::Ok;
  Run(128);
  EXPECT_EQ(Gun(33).ScoreStatus, ScoreStatus::Pending);
  OnPacket = [](const Bytes&) {};
  display.Log.clear();
  Run(128);
  EXPECT_EQ(CountPresent(), 0);
  EXPECT_THAT(display.Log, ElementsAre("Status Searching...", "Clear", "Found 0", "Status Idle"));
}

TEST_F(Search, OfAFullSiteFindsEveryGun) {
  for (int id = 32; id <= 255; ++id) {
    PutGun(static_cast<std::uint8_t>(id), 5 + id % 13);
  }
  Run(224);
  EXPECT_EQ(CountPresent(), 224);
  EXPECT_THAT(display.Log, testing::Contains("Found 224"));
}

TEST_F(Search, OverflowsWithAnAnswerOfAnIdBelow32) {
  for (const std::uint8_t id : Bytes{0, 31}) {
    AfterCallOf40(Received(1, SearchAnswer(id)));
    EXPECT_EQ(FaultOf(128), 6);
    EXPECT_FALSE(Port.PortOpen());
    EXPECT_EQ(CountPresent(), 0);
    Frames.clear();
  }
}

TEST_F(Search, FaultsWithDataLongerThanTheBuffer) {
  AfterCallOf40(Received(1, Bytes(102, 0)));
  EXPECT_EQ(FaultOf(128), 9);
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(Search, FaultsWithAPacketLongerThanItsBuffer) {
  AfterCallOf40(Received(1, {95, 40, 0, 0, 7, 1, 1, 1, 1}));
  EXPECT_EQ(FaultOf(128), 9);
}

TEST_F(Search, WithoutALineEndsAtOnce) {
  Port.FailNextOpen(8002);
  Run(128);
  EXPECT_EQ(fault, 8018);
  EXPECT_THAT(Port.Sent, IsEmpty());
  EXPECT_EQ(Events.Now(), milliseconds(0));
  EXPECT_EQ(display.Log.back(), "Status Idle");
}

TEST_F(Search, EndsWhenItsLineIsLostAndKeepsWhoWasFound) {
  PutGun(33);
  const auto guns33 = OnPacket;
  OnPacket = [this, guns33](const Bytes& packet) {
    guns33(packet);
    if (packet[1] == 50) {
      Port.Lose();
    }
  };
  Run(128);
  EXPECT_EQ(fault, 8012);
  EXPECT_TRUE(Gun(33).Present);
  EXPECT_EQ(Frames.size(), 19U);
  EXPECT_EQ(display.Log.back(), "Status Idle");
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(Search, EndsWhenItIsStopped) {
  Events.At(milliseconds(100), [this] { stopped = true; });
  Run(128);
  EXPECT_EQ(Events.Now(), milliseconds(100));
  EXPECT_EQ(fault, 0);
  EXPECT_EQ(display.Log.back(), "Status Idle");
  EXPECT_FALSE(Port.PortOpen());
}

}  // namespace
