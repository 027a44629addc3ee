#include <gmock/gmock.h>

#include <map>

#include "devices/buttons/SerialOneWire.h"
#include "tests/devices/buttons/ModelAdapter.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSerialDevices.h"

namespace {

using Rom = ModelAdapter::Rom;

constexpr Rom Button = {0x01, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0x00, 0xA3};
constexpr Rom OtherButton = {0x0C, 0x01, 0x02, 0x03, 0x04, 0x05, 0x0A, 0x26};
constexpr Rom OwnDevice = {0x81, 0xE3, 0x10, 0x20, 0x30, 0x00, 0x00, 0x08};

/// Whoever does something once for each touch counts devices: a pass over the whole bus that met one device
/// only, the reader's own, means that the button has gone.
class Watch {
 public:
  Watch() {
    devices_.Ports = {"/dev/ttyS0"};
    Adapter.Devices = {Button, OwnDevice};
  }

  void Tick() {
    const std::int32_t handle = wire_.TMExtendedStartSession(1, 5, 0);
    if (handle <= 0) {
      return;
    }
    Count(wire_.TMNext(handle, state_));
    wire_.TMEndSession(handle);
  }

  void Tick(int times) {
    for (int tick = 0; tick < times; ++tick) {
      Tick();
    }
  }

 private:
  FakeSerialPort port_;

 public:
  ModelAdapter Adapter{port_};
  std::map<Rom, int> Touches;
  int Passes = 0;

 private:
  void Count(std::int16_t result) {
    if (result != OneWire::DeviceFound) {
      if (result == OneWire::EndOfBus) {
        ++Passes;
        last_ = met_ == 1 ? Rom{} : last_;
      }
      met_ = 0;
      return;
    }
    ++met_;
    if (state_.Rom != OwnDevice && state_.Rom != last_) {
      ++Touches[state_.Rom];
      last_ = state_.Rom;
    }
  }

  FakeFiles files_;
  IniReader ini_{files_, "/tessarine.ini"};
  FakeSerialDevices devices_;
  FakeEventPump events_;
  SerialOneWire wire_{port_, events_, ini_, devices_};
  OneWireState state_;
  Rom last_{};
  int met_ = 0;
};

constexpr int TicksOfAPass = 3;

TEST(WalkOfTwoDevices, MeetsARestingButtonOnceAndAgainAfterItLeft) {
  Watch watch;
  watch.Tick(4 * TicksOfAPass);
  EXPECT_EQ(watch.Passes, 4);
  EXPECT_EQ(watch.Touches[Button], 1);
  watch.Adapter.Devices = {OwnDevice};
  watch.Tick(2 * TicksOfAPass);
  watch.Adapter.Devices = {Button, OwnDevice};
  watch.Tick(2 * TicksOfAPass);
  EXPECT_EQ(watch.Touches[Button], 2);
}

TEST(WalkOfTwoDevices, MeetsAButtonThatTookTheOthersPlace) {
  Watch watch;
  watch.Tick(TicksOfAPass);
  watch.Adapter.Devices = {OtherButton, OwnDevice};
  watch.Tick(2 * TicksOfAPass);
  EXPECT_EQ(watch.Touches[OtherButton], 1);
}

/// Any byte of three passes, to the adapter or from it, with one bit changed or with all of them.
TEST(DisturbedWalk, NeverTakesARestingButtonForGone) {
  constexpr int ticks = 3 * TicksOfAPass;
  Watch undisturbed;
  undisturbed.Tick(ticks);
  int disturbed = 0;
  for (const bool sent : {true, false}) {
    const std::size_t places = sent ? undisturbed.Adapter.Sent() : undisturbed.Adapter.Answered();
    for (std::size_t place = 0; place < places; ++place) {
      for (const int change : {1, 2, 4, 8, 16, 32, 64, 128, 255}) {
        Watch watch;
        (sent ? watch.Adapter.DisturbSent : watch.Adapter.DisturbAnswered) = place;
        watch.Adapter.Disturbance = static_cast<std::uint8_t>(change);
        watch.Tick(ticks + TicksOfAPass);
        EXPECT_EQ(watch.Touches[Button], 1) << (sent ? "sent " : "answered ") << place << " ^ " << change;
        EXPECT_EQ(watch.Touches.size(), 1U);
        EXPECT_GE(watch.Passes, 2);
        ++disturbed;
      }
    }
  }
  EXPECT_GT(disturbed, 2000);
}

}  // namespace
