#include <fcntl.h>
#include <gmock/gmock.h>

#include <QComboBox>
#include <QLineEdit>
#include <QTimer>
#include <algorithm>
#include <optional>
#include <string>

#include "devices/box/BoxConfig.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtSerialPort.h"
#include "sim/box/UtilityBox.h"
#include "sim/line/FileDescriptor.h"
#include "tests/devices/box/BoxSite.h"
#include "tests/support/Controls.h"
#include "tests/support/Thrown.h"
#include "ui/ResultList.h"

// The programming of boxes with its real line and event loop, and the simulated box at the far end.

namespace {

using sim::BoxFailure;
using std::chrono::milliseconds;
using testing::AllOf;
using testing::Each;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

/// For what must come, and for an answer that comes too late.
constexpr milliseconds Patience{20000};

class BoxOfTheVenue : public testing::Test, protected BoxSite {
 protected:
  BoxOfTheVenue() {
    entries.BoxType = 8;
    entries.TeamList = 3;
    entries.PointsPerAct = "20";
    entries.RechargePoints = "5";
    entries.ActivationAmount = "100";
    entries.AutoModeTime = "2";
    entries.Destroyable = true;
  }

  void Connect(const sim::UtilityBoxSettings& wanted) {
    box.emplace(wanted);
    Devices.Ports = {box->DevicePath()};
    held = sim::FileDescriptor(::open(box->DevicePath().c_str(), O_RDWR | O_NOCTTY | O_CLOEXEC));
  }

  /// What ends the press is in `fault`, `Boxes` and `results`.
  void Program() {
    fault = NumberThrownBy([this] { programmer.Program(entries); });
    EXPECT_FALSE(port.PortOpen());
  }

  static constexpr sim::BoxFrame Frame{0x42, 0x43, 0x38, 0x14, 0x05, 0x64, 0x02, 0x01, 0x00, 0x00};

  std::optional<sim::UtilityBox> box;
  /// Keeps the terminal's name from being given to another test while this one still knows it.
  sim::FileDescriptor held;
  QtSerialPort port;
  QtEventPump events;
  CommPort settings{port, Ini, Devices, Boxes, Strings, [] {}};
  std::vector<BoxResult> results;
  BoxProgrammer programmer{
      {.MSComm1 = port,
       .Port = settings,
       .Events = events,
       .Boxes = Boxes,
       .Stopped = [] { return false; },
       .OnResult = [this](const BoxEntries&, BoxResult result) { results.push_back(result); }}};
  BoxEntries entries;
  int fault = 0;
};

TEST_F(BoxOfTheVenue, WorksWithWhateverItIsTold) {
  Connect({.LinePace = sim::Pace::Fast});
  for (int team = 0; team <= 3; ++team) {
    for (int type = 0; type <= 8; ++type) {
      entries.TeamList = team;
      entries.BoxType = type;
      entries.PointsPerAct = std::to_string(10 * team + type);
      entries.Destroyable = type % 2 == 1;
      Program();
      sim::BoxFrame told = Frame;
      told[2] = static_cast<std::uint8_t>(team << 4 | type);
      told[3] = static_cast<std::uint8_t>(10 * team + type);
      told[7] = static_cast<std::uint8_t>(type % 2);
      EXPECT_EQ(box->Traffic().Accepted, told);
    }
  }
  EXPECT_THAT(results, AllOf(SizeIs(36), Each(BoxResult::Accepted)));
  EXPECT_THAT(Boxes.Boxes, Each(Successful()));
}

TEST_F(BoxOfTheVenue, HearsTheFrameAgainAtASecondPress) {
  Connect({.Failure = BoxFailure::Late, .Times = 1, .Late = milliseconds(800)});
  QTimer::singleShot(100, [this] {
    entries.PointsPerAct = "7";
    programmer.Program(entries);
  });
  Program();
  ASSERT_TRUE(box->WaitUntilTold(2, Patience));
  EXPECT_EQ(box->Traffic().Frames[1][3], 7);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(Successful()));
  EXPECT_THAT(results, ElementsAre(BoxResult::Accepted));
}

TEST_F(BoxOfTheVenue, PulledOutBehindAnyByteIsToldOnce) {
  for (std::size_t place = 1; place <= 10; ++place) {
    Boxes.Boxes.clear();
    results.clear();
    Connect({.Failure = BoxFailure::Unplugged, .FailurePlace = place, .LinePace = sim::Pace::Fast});
    Program();
    // A busy machine may hear of it only when the rest of the frame is out.
    const bool inTheWait = fault == Fault::PortLost;
    if (inTheWait) {
      EXPECT_THAT(Boxes.Boxes, IsEmpty()) << place;
    } else {
      EXPECT_THAT(Boxes.Boxes, ElementsAre(PortError())) << place;
    }
    EXPECT_THAT(results, ElementsAre(inTheWait ? BoxResult::Unconfirmed : BoxResult::NotSent)) << place;
    EXPECT_THAT(box->Traffic().Frames, IsEmpty()) << place;
    Boxes.Boxes.clear();
    Program();
    EXPECT_THAT(Boxes.Boxes, ElementsAre(PortError())) << place;
  }
}

TEST_F(BoxOfTheVenue, IsNotDisturbedWhileAnotherProgramHasItsLine) {
  Connect({});
  QtSerialPort other;
  other.Open(box->DevicePath(), "19200,N,8,1");
  Program();
  EXPECT_THAT(Boxes.Boxes, ElementsAre(PortTaken()));
  other.Close();
  Program();
  EXPECT_EQ(Boxes.Boxes.back(), Successful());
  EXPECT_THAT(box->Traffic().Frames, ElementsAre(Frame));
}

TEST_F(BoxOfTheVenue, IsProgrammedFromTheWindow) {
  Connect({});
  const Game game(Strings);
  ProgrammedBoxes programmed;
  BoxConfig window({port, settings, events, Boxes, Time, Strings, game, programmed, {Ini, nullptr, Strings}},
                   nullptr);
  Show(window);
  Find<QComboBox>(window, "BoxType").setCurrentIndex(1);
  Find<QLineEdit>(window, "ActivationAmount").setText(QStringLiteral("30"));
  Press(window, "ProgramButton");
  EXPECT_THAT(Boxes.Boxes, ElementsAre(Successful()));
  EXPECT_EQ(box->Traffic().Accepted, (sim::BoxFrame{0x42, 0x43, 0x01, 0, 0, 30, 0, 0, 0, 0}));
  EXPECT_EQ(Find<ResultList>(window, "Results").item(0, 4)->text(), QStringLiteral("Accepted"));
}

class BoxInTrouble : public BoxOfTheVenue, public testing::WithParamInterface<sim::BoxFailureInfo> {};

/// What a press is told to lead to; the box is none where a fault is thrown instead.
std::pair<BoxResult, std::optional<FakeMessageBoxes::Box>> OutcomeOf(BoxFailure failure) {
  switch (failure) {
    case BoxFailure::None:
    case BoxFailure::AnswersTwice:
      return {BoxResult::Accepted, BoxSite::Successful()};
    case BoxFailure::Rejects:
    case BoxFailure::Noise:
      return {BoxResult::Rejected, BoxSite::RejectedByBox()};
    case BoxFailure::Silent:
    case BoxFailure::Late:
      return {BoxResult::NoResponse, BoxSite::NoResponse()};
    case BoxFailure::Unplugged:
      break;
  }
  return {BoxResult::Unconfirmed, std::nullopt};
}

TEST_P(BoxInTrouble, EndsThePressAsItIsTold) {
  const BoxFailure failure = GetParam().Failure;
  constexpr std::size_t insteadOfTheAnswer = 10;
  Connect({.Failure = failure, .FailurePlace = insteadOfTheAnswer, .Late = Patience});
  Program();
  const auto [result, told] = OutcomeOf(failure);
  EXPECT_THAT(results, ElementsAre(result));
  if (told) {
    EXPECT_THAT(Boxes.Boxes, ElementsAre(*told));
    EXPECT_EQ(fault, 0);
    EXPECT_THAT(box->Traffic().Frames, ElementsAre(Frame));
  } else {
    EXPECT_THAT(Boxes.Boxes, IsEmpty());
    EXPECT_EQ(fault, Fault::PortLost);
  }
  const bool works = failure != BoxFailure::Rejects && failure != BoxFailure::Unplugged;
  EXPECT_EQ(box->Traffic().Accepted, works ? std::optional(Frame) : std::nullopt);
  EXPECT_THAT(box->HostFaults(), IsEmpty());
}

INSTANTIATE_TEST_SUITE_P(Failures, BoxInTrouble, testing::ValuesIn(sim::BoxFailures),
                         [](const auto& failure) {
                           std::string name(failure.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

}  // namespace
