#include <fcntl.h>
#include <gmock/gmock.h>

#include <QLabel>
#include <algorithm>
#include <optional>
#include <string>
#include <tuple>
#include <vector>

#include "devices/buttons/SerialOneWire.h"
#include "devices/charging/ChargeiButton.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtSerialPort.h"
#include "sim/line/Crc.h"
#include "sim/line/FileDescriptor.h"
#include "sim/onewire/OneWireAdapter.h"
#include "tests/devices/charging/ChargingSite.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/support/Controls.h"
#include "ui/ResultList.h"

// The charging with its real line and event loop, and a simulated adapter with buttons. What the buttons hold
// afterwards is reckoned here anew.

namespace {

using sim::ButtonContent;
using sim::OneWireFailure;
using testing::AnyOf;
using testing::IsEmpty;

using Block = sim::ChargeBlock;

constexpr sim::RomId Rom{0x06, 0x1C, 0xB8, 0x01, 0x00, 0x00, 0x00, 0x56};

/// `block` with a right check byte.
Block Closed(Block block) {
  block[31] = sim::Crc8(std::span(block).first(31));
  return block;
}

Block FullMag(Block block) {
  block[0] = 0;
  block[1] = 1;
  return Closed(block);
}

Block FullBandage(Block block) {
  block[0] = 1;
  block[1] = 5;
  return Closed(block);
}

/// The real event loop, with waits for an answer of several times their length: on a busy machine the adapter
/// here may be slower than a real one.
class LongWaits : public EventPump {
 public:
  int Factor = 4;

  void EndWaits() override { events_.EndWaits(); }
  void DoEvents() override { events_.DoEvents(); }
  WaitResult WaitFor(const std::function<bool()>& condition, std::chrono::milliseconds limit) override {
    return events_.WaitFor(condition, Factor * limit);
  }
  void Sleep(std::chrono::milliseconds time) override { events_.Sleep(time); }

 private:
  QtEventPump events_;
};

class ButtonsOfTheVenue : public testing::Test {
 protected:
  /// An adapter, with a button that has this content.
  void Connect(const sim::OneWireAdapterSettings& settings, ButtonContent content) {
    if (settings.Failure == OneWireFailure::Silence) {
      events.Factor = 1;
    }
    adapter.emplace(settings);
    held = sim::FileDescriptor(::open(adapter->DevicePath().c_str(), O_RDWR | O_NOCTTY | O_CLOEXEC));
    devices.Ports = {adapter->DevicePath()};
    adapter->Fill(Rom, content);
    before = adapter->BlockOf(Rom);
    adapter->Touch(Rom);
    charger.emplace(ButtonCharger::Parts{
        .Wire = wire, .Events = events, .Boxes = boxes, .Time = clock, .Display = display});
  }

  void Ticks(int count) {
    for (int i = 0; i < count; ++i) {
      charger->Tick();
      EXPECT_FALSE(port.PortOpen());
    }
  }

  Block Held() { return adapter->BlockOf(Rom); }

  std::vector<ChargeResult> Results() const {
    std::vector<ChargeResult> results;
    for (const ChargedButton& note : display.Notes) {
      results.push_back(note.Result);
    }
    return results;
  }

  std::optional<sim::OneWireAdapter> adapter;
  /// Keeps the terminal's name from being given to another test while this one still knows it.
  sim::FileDescriptor held;
  FakeFiles files;
  IniReader ini{files, "/tessarine.ini"};
  FakeSerialDevices devices;
  QtSerialPort port;
  LongWaits events;
  SerialOneWire wire{port, events, ini, devices};
  FakeMessageBoxes boxes;
  FakeClock clock;
  FakeChargingDisplay display;
  std::optional<ButtonCharger> charger;
  Block before{};
};

TEST_F(ButtonsOfTheVenue, AreChargedFromTheWindowOncePerTouch) {
  Connect({}, ButtonContent::AmmoMag);
  const StringTable strings(Language::English);
  ChargedButtons charged;
  ChargeiButton window({wire, events, boxes, clock, strings, charged, {ini, nullptr, strings}}, nullptr);
  Show(window);
  const auto& list = Find<ResultList>(window, "Results");
  const auto& status = Find<QLabel>(window, "StatusLabel");
  constexpr int patience = 20000;
  ASSERT_TRUE(QTest::qWaitFor([&] { return list.rowCount() == 1; }, patience));
  EXPECT_EQ(status.text(), QStringLiteral("Charged Mag OK"));
  EXPECT_EQ(list.item(0, 4)->text(), QStringLiteral("Charged"));
  EXPECT_EQ(list.item(0, 3)->text().toStdString(), sim::RomIdText(Rom));
  EXPECT_EQ(Held(), FullMag(before));
  adapter->LeaveAll();
  EXPECT_TRUE(QTest::qWaitFor([&] { return status.text().isEmpty(); }, patience));
  adapter->Fill(Rom, ButtonContent::Bandage);
  const Block empty = Held();
  adapter->Touch(Rom);
  ASSERT_TRUE(QTest::qWaitFor([&] { return list.rowCount() == 2; }, patience));
  EXPECT_EQ(Held(), FullBandage(empty));
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(ButtonsOfTheVenue, AreJudgedByWhatTheyHold) {
  const auto recoveredMag = [](Block block) {
    block[2] = 0;
    return FullMag(block);
  };
  const auto same = [](Block block) { return block; };
  using Change = std::function<Block(Block)>;
  const std::tuple<ButtonContent, BoxAnswer, std::size_t, Change, std::string> rules[] = {
      {ButtonContent::AmmoMag, BoxAnswer::Yes, 0, FullMag, "Charged Mag OK"},
      {ButtonContent::Bandage, BoxAnswer::Yes, 0, FullBandage, "Charged Bandage OK"},
      {ButtonContent::Blank, BoxAnswer::Yes, 1, recoveredMag, "Charged Mag OK"},
      {ButtonContent::Blank, BoxAnswer::No, 1, FullBandage, "Charged Bandage OK"},
      {ButtonContent::Zeros, BoxAnswer::No, 0, FullMag, "Charged Mag OK"},
      {ButtonContent::WrongCheck, BoxAnswer::Yes, 1, recoveredMag, "Charged Mag OK"},
      {ButtonContent::WrongCheck, BoxAnswer::No, 1, FullBandage, "Charged Bandage OK"},
      {ButtonContent::UnknownKind, BoxAnswer::Yes, 0, same, ""}};
  for (const auto& [content, answer, questions, change, status] : rules) {
    Connect({.LinePace = sim::Pace::Fast}, content);
    boxes.Boxes.clear();
    boxes.Answers = {answer};
    Ticks(1);
    EXPECT_EQ(boxes.Boxes.size(), questions) << static_cast<int>(content);
    EXPECT_EQ(Held(), change(before)) << static_cast<int>(content);
    EXPECT_EQ(display.Status, status) << static_cast<int>(content);
  }
}

/// What a failure is told to lead to.
struct Outcome {
  std::vector<ChargeResult> Results;
  Block Held;
  std::string Status;  ///< behind the first tick
  bool ReaderIsLost = false;
};

class ButtonsInTrouble : public ButtonsOfTheVenue,
                         public testing::WithParamInterface<sim::OneWireFailureInfo> {
 protected:
  /// In the first reading of the memory: a tick has 18 answers before, and 10 for each selection.
  static constexpr std::size_t AnswerByte = 50;
  static constexpr std::size_t MemoryByte = 20;

  void Connect() {
    const auto [failure, name, place, meaning] = GetParam();
    const bool ofAnswers = failure == OneWireFailure::Silence || failure == OneWireFailure::HangUp ||
                           failure == OneWireFailure::NoiseByte;
    ButtonsOfTheVenue::Connect({.Failure = failure,
                                .FailurePlace = ofAnswers ? AnswerByte : MemoryByte,
                                .LinePace = sim::Pace::Fast},
                               ButtonContent::Bandage);
  }

  Outcome Told() const {
    const Block full = FullBandage(before);
    const std::string charged = "Charged Bandage OK";
    switch (GetParam().Failure) {
      case OneWireFailure::None:
      case OneWireFailure::NoDetection:
      case OneWireFailure::TornWrites:
      case OneWireFailure::DisturbedRead:
        return {{ChargeResult::Charged}, full, charged};
      case OneWireFailure::Silence:
      case OneWireFailure::HangUp:
        return {{ChargeResult::NotRead}, before, "", true};
      case OneWireFailure::NoiseByte:
        return {{ChargeResult::NotRead, ChargeResult::Charged}, full, ""};
      case OneWireFailure::ShortCircuit:
      case OneWireFailure::ContactLost:
      case OneWireFailure::WrongCrc:
        return {{}, before, ""};
      case OneWireFailure::TwoButtons:  // the other one is blank, and taken for a Bandage
      case OneWireFailure::NoOwnDevice:
        return {{ChargeResult::Charged, ChargeResult::Charged, ChargeResult::Charged}, full, charged};
      case OneWireFailure::RemovedInRead:
        return {{ChargeResult::NotRead}, before, ""};
      case OneWireFailure::RemovedInWrite:
        return {{ChargeResult::NotReadBack}, before, charged};
      case OneWireFailure::TornCopy: {
        Block torn = before;
        std::copy_n(full.begin(), MemoryByte, torn.begin());
        return {{ChargeResult::NotReadBack}, torn, charged};
      }
      case OneWireFailure::DisturbedWrite: {
        Block disturbed = full;
        disturbed.at(MemoryByte - 4) ^= 0x10U;  // behind a command and two bytes of address
        return {{ChargeResult::Different}, disturbed, charged};
      }
      case OneWireFailure::WriteProtected:
        break;
    }
    return {{ChargeResult::Different}, before, charged};
  }
};

TEST_P(ButtonsInTrouble, HoldWhatTheListSays) {
  Connect();
  boxes.Answers = {BoxAnswer::No};
  const Outcome told = Told();
  Ticks(1);
  EXPECT_EQ(display.Status, told.Status);
  Ticks(4);  // to the second try of the next pass
  EXPECT_EQ(Results(), told.Results);
  EXPECT_EQ(Held(), told.Held);
  EXPECT_EQ(charger->ReaderMissing(), told.ReaderIsLost);
  const bool isAsked = GetParam().Failure == OneWireFailure::TwoButtons;
  EXPECT_EQ(boxes.Boxes.size(), isAsked || told.ReaderIsLost ? 1U : 0U);
}

INSTANTIATE_TEST_SUITE_P(Failures, ButtonsInTrouble, testing::ValuesIn(sim::OneWireFailures),
                         [](const auto& failure) {
                           std::string name(failure.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

/// The adapter fails anywhere in a charge, in each of its ways.
TEST_F(ButtonsOfTheVenue, HoldTheOldBlockOrTheFullOne) {
  for (const auto failure : {OneWireFailure::NoiseByte, OneWireFailure::HangUp, OneWireFailure::Silence}) {
    for (const std::size_t place : {25U, 90U, 121U, 134U, 160U}) {
      display.Notes.clear();
      Connect({.Failure = failure, .FailurePlace = place, .LinePace = sim::Pace::Fast},
              ButtonContent::Bandage);
      Ticks(2);
      EXPECT_THAT(Held(), AnyOf(before, FullBandage(before))) << static_cast<int>(failure) << ' ' << place;
      if (!display.Notes.empty() && display.Notes.back().Result == ChargeResult::Charged) {
        EXPECT_EQ(Held(), FullBandage(before)) << static_cast<int>(failure) << ' ' << place;
      }
    }
  }
}

}  // namespace
