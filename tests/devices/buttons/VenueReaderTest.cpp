#include <fcntl.h>
#include <gmock/gmock.h>

#include <algorithm>

#include "devices/buttons/ButtonReader.h"
#include "devices/buttons/SerialOneWire.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtSerialPort.h"
#include "sim/onewire/OneWireFailure.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/support/VenueProcess.h"

namespace {

using testing::AnyOf;

constexpr const char* Button = "A300CDAB89674501";

/// The reader with all of its real parts, on the simulated adapter of a venue.
class VenueReader {
 public:
  explicit VenueReader(std::vector<std::string> options = {}) : venue_(Arguments(std::move(options))) {
    venue_.ReadDevice("base unit");
    const std::string device = venue_.ReadDevice("1-wire adapter");
    held_ = sim::FileDescriptor(::open(device.c_str(), O_RDWR | O_NOCTTY | O_CLOEXEC));
    files_.Put("/tessarine.ini", "[onewire]\nport=2\n[ports]\ncom2=" + device + "\n");
    Reader.Activate();
  }

  void Command(const std::string& command) {
    venue_.WriteInput(command + '\n');
    venue_.ReadLine();
  }

  void Stop() {
    venue_.Signal(SIGTERM);
    venue_.WaitForExit();
  }

  /// Ticks until the reader has done, at most `most`; how many it took.
  int Poll(int most) {
    int ticks = 1;
    while (Reader.Tick() && ticks < most) {
      ++ticks;
    }
    return ticks;
  }

  FakeMessageBoxes Boxes;

 private:
  static std::vector<std::string> Arguments(std::vector<std::string> options) {
    options.insert(options.end(), {"--onewire", "--players", "0"});
    return options;
  }

  sim::VenueProcess venue_;
  /// Keeps the terminal's name from being given to another test while this one still knows it.
  sim::FileDescriptor held_;
  FakeFiles files_;
  IniReader ini_{files_, "/tessarine.ini"};
  FakeSerialDevices devices_;
  QtSerialPort port_;
  QtEventPump events_;
  SerialOneWire wire_{port_, events_, ini_, devices_};

 public:
  ButtonReader Reader{wire_, Boxes};
};

TEST(ReaderOfTheVenue, ReadsAButtonBesideTheReadersOwnDevice) {
  VenueReader venue;
  EXPECT_EQ(venue.Poll(3), 3);
  venue.Command(std::string("touch ") + Button);
  EXPECT_LE(venue.Poll(3), 3);
  EXPECT_EQ(venue.Reader.DallasID(), Button);
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_EQ(venue.Boxes.Boxes[0].Text, std::string("Membership button read sucessfully, code = ") + Button);
}

TEST(ReaderOfTheVenue, ReadsAButtonWithoutAnOwnDevice) {
  VenueReader venue({"--onewire-failure", "no-own-device"});
  EXPECT_EQ(venue.Poll(3), 3);
  venue.Command(std::string("touch ") + Button);
  EXPECT_LE(venue.Poll(3), 2);
  EXPECT_EQ(venue.Reader.DallasID(), Button);
}

TEST(ReaderOfTheVenue, ForgetsAButtonThatLeft) {
  VenueReader venue;
  venue.Command(std::string("touch ") + Button);
  ASSERT_LE(venue.Poll(3), 3);
  venue.Command("leave");
  venue.Reader.Activate();
  EXPECT_EQ(venue.Poll(6), 6);
  EXPECT_EQ(venue.Reader.DallasID(), NoDallasId);
}

TEST(ReaderOfTheVenue, TellsOfAnAdapterThatIsPulledOut) {
  VenueReader venue;
  ASSERT_EQ(venue.Poll(2), 2);
  venue.Stop();
  EXPECT_EQ(venue.Poll(3), 1);
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_EQ(venue.Boxes.Boxes[0].Title, "Memberbership Error");
}

/// What a failure lets through: the number, or nothing while the window stays, or nothing and the box of a
/// session that does not start.
bool Reads(sim::OneWireFailure failure) {
  using Failure = sim::OneWireFailure;
  return failure == Failure::None || failure == Failure::NoDetection || failure == Failure::NoiseByte ||
         failure == Failure::TornWrites || failure == Failure::NoOwnDevice ||
         failure >= Failure::RemovedInRead;  // from here on they concern memories, not numbers
}

bool EndsTheAdapter(sim::OneWireFailure failure) {
  return failure == sim::OneWireFailure::Silence || failure == sim::OneWireFailure::HangUp;
}

class ReaderInTrouble : public testing::TestWithParam<sim::OneWireFailureInfo> {};

TEST_P(ReaderInTrouble, NeverReadsAWrongNumber) {
  for (const int place : {1, 2, 9, 20, 40}) {
    VenueReader venue({"--fast", "--onewire-failure", std::string(GetParam().Name), "--onewire-at",
                       std::to_string(GetParam().Place == sim::FailurePlace::None ? 1 : place)});
    venue.Command(std::string("touch ") + Button);
    venue.Poll(6);
    const std::string id = venue.Reader.DallasID();
    const auto boxes = venue.Boxes.Boxes.size();
    if (GetParam().Failure == sim::OneWireFailure::TwoButtons) {
      EXPECT_NE(id, NoDallasId);
    } else if (Reads(GetParam().Failure)) {
      EXPECT_EQ(id, Button) << place;
    } else if (!EndsTheAdapter(GetParam().Failure)) {
      EXPECT_EQ(id, NoDallasId) << place;
      EXPECT_EQ(boxes, 0U) << place;
    } else {
      EXPECT_THAT(id, AnyOf(Button, NoDallasId)) << place;
      ASSERT_EQ(boxes, 1U) << place;
      EXPECT_EQ(venue.Boxes.Boxes[0].Title == "Memberbership Error", id == NoDallasId) << place;
    }
  }
}

INSTANTIATE_TEST_SUITE_P(Failures, ReaderInTrouble, testing::ValuesIn(sim::OneWireFailures),
                         [](const auto& failure) {
                           std::string name(failure.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

}  // namespace
