#include "devices/charging/ButtonCharger.h"

#include <gmock/gmock.h>

#include "tests/devices/charging/ChargingSite.h"
#include "tests/support/Thrown.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

class Charging : public ChargingSite {};

TEST_F(Charging, FillsAnAmmoMag) {
  MemoryButton& mag = TouchedButton({0, 0, 9});
  const ChargeBlock before = BlockOf(mag);
  Ticks(1);
  const ChargeBlock after = BlockOf(mag);
  EXPECT_EQ(after[0], 0);
  EXPECT_EQ(after[1], 1);
  EXPECT_TRUE(std::equal(before.begin() + 2, before.begin() + 31, after.begin() + 2));
  EXPECT_TRUE(CheckHolds(after));
  EXPECT_EQ(display.Status, "Charged Mag OK");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(Charging, FillsABandage) {
  MemoryButton& bandage = TouchedButton({1, 0, 9});
  const ChargeBlock before = BlockOf(bandage);
  Ticks(1);
  const ChargeBlock after = BlockOf(bandage);
  EXPECT_EQ(after[0], 1);
  EXPECT_EQ(after[1], 5);
  EXPECT_TRUE(std::equal(before.begin() + 2, before.begin() + 31, after.begin() + 2));
  EXPECT_TRUE(CheckHolds(after));
  EXPECT_EQ(display.Status, "Charged Bandage OK");
}

TEST_F(Charging, LeavesTheMemoryBelowTheBlockAlone) {
  MemoryButton& mag = TouchedButton({0, 0});
  std::fill_n(mag.Memory.begin(), 32, std::uint8_t{0x3C});
  Ticks(1);
  EXPECT_EQ(mag.Copies, 1U);
  EXPECT_TRUE(
      std::all_of(mag.Memory.begin(), mag.Memory.begin() + 32, [](auto byte) { return byte == 0x3C; }));
}

TEST_F(Charging, FillsABlankButtonAsAnAmmoMag) {
  MemoryButton& blank = TouchedButton({});
  blank.Memory.fill(0);
  Ticks(1);
  EXPECT_EQ(blank.Memory[33], 1);
  EXPECT_EQ(display.Status, "Charged Mag OK");
}

TEST_F(Charging, AsksWhatAnInvalidButtonWas) {
  MemoryButton& torn = TouchedButton({7, 3, 9});
  torn.Memory[63] ^= 0xFF;
  const ChargeBlock before = BlockOf(torn);
  boxes.Answers = {BoxAnswer::Yes};
  bool sessionOpen = false;
  boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) { sessionOpen = bus.SessionOpen(); };
  Ticks(1);
  EXPECT_THAT(boxes.Boxes, ElementsAre(RecoveryQuestion()));
  EXPECT_TRUE(sessionOpen);
  const ChargeBlock after = BlockOf(torn);
  EXPECT_THAT(std::vector(after.begin(), after.begin() + 3), ElementsAre(0, 1, 0));
  EXPECT_TRUE(std::equal(before.begin() + 3, before.begin() + 31, after.begin() + 3));
  EXPECT_TRUE(CheckHolds(after));
  EXPECT_EQ(display.Status, "Charged Mag OK");
}

TEST_F(Charging, RecoversABandageWithItsThirdByteKept) {
  MemoryButton& torn = TouchedButton({7, 3, 9});
  torn.Memory[63] ^= 0xFF;
  const ChargeBlock before = BlockOf(torn);
  boxes.Answers = {BoxAnswer::No};
  Ticks(1);
  const ChargeBlock after = BlockOf(torn);
  EXPECT_THAT(std::vector(after.begin(), after.begin() + 3), ElementsAre(1, 5, 9));
  EXPECT_TRUE(std::equal(before.begin() + 2, before.begin() + 31, after.begin() + 2));
  EXPECT_TRUE(CheckHolds(after));
  EXPECT_EQ(display.Status, "Charged Bandage OK");
}

TEST_F(Charging, LeavesAButtonOfAnUnknownKindAsItIs) {
  MemoryButton& other = TouchedButton({2, 3, 9});
  const auto before = other.Memory;
  Pass();
  Pass();
  EXPECT_EQ(other.Memory, before);
  EXPECT_EQ(display.Status, "");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  ASSERT_THAT(Results(), ElementsAre(ChargeResult::Unknown));
  EXPECT_EQ(display.Notes[0].Kind, 2);
}

TEST_F(Charging, ChargesARestingButtonOnceAndKeepsTheStatus) {
  MemoryButton& mag = TouchedButton({0, 0});
  for (int i = 0; i < 5; ++i) {
    Pass();
    EXPECT_EQ(display.Status, "Charged Mag OK");
  }
  EXPECT_EQ(mag.Copies, 1U);
  EXPECT_THAT(display.Notes, SizeIs(1));
}

TEST_F(Charging, ClearsTheStatusOnceTheButtonHasLeftForAPass) {
  MemoryButton& mag = TouchedButton({0, 0});
  Pass();
  bus.TakeAway(mag);
  Pass();
  EXPECT_EQ(display.Status, "");
}

TEST_F(Charging, ChargesAButtonAgainAfterItLeftForAPass) {
  MemoryButton& mag = TouchedButton({0, 0});
  Pass();
  bus.TakeAway(mag);
  Pass();
  mag.Memory[33] = 0;
  mag.Memory[63] = CheckByteOf(BlockOf(mag));
  bus.Put(mag);
  Pass();
  EXPECT_EQ(mag.Copies, 2U);
  EXPECT_EQ(mag.Memory[33], 1);
}

class ButtonThatLeaves : public Charging {
 protected:
  void ExpectTold() {
    MemoryButton& mag = TouchedButton({0, 0});
    Pass();
    Pass();
    EXPECT_EQ(display.Left, 0);
    bus.TakeAway(mag);
    Pass();
    EXPECT_EQ(display.Left, 1);
  }
};

TEST_F(ButtonThatLeaves, IsToldAfterAPassThatMetNone) {
  ExpectTold();
}

TEST_F(ButtonThatLeaves, IsToldAlsoWithoutTheReadersDevice) {
  bus.Devices.clear();
  ExpectTold();
}

TEST_F(Charging, TellsItAfterAPassThatWasSpoiled) {
  MemoryButton& mag = TouchedButton({0, 0});
  Ticks(1);
  bus.TakeAway(mag);
  bus.NextResults = {OneWire::BadRead};
  Ticks(3);
  EXPECT_EQ(display.Left, 1);
}

TEST_F(Charging, DoesNotTellItOfASpoiledPass) {
  bus.NextResults = {OneWire::BadRead};
  Ticks(1);
  EXPECT_EQ(display.Left, 0);
}

TEST_F(Charging, DoesNotChargeAgainAButtonThatLeftForLessThanAPass) {
  MemoryButton& mag = TouchedButton({0, 0});
  Ticks(1);
  bus.TakeAway(mag);
  bus.Put(mag);
  Pass();
  EXPECT_EQ(mag.Copies, 1U);
}

TEST_F(Charging, ChargesASecondButtonTouchedStraightAfterTheFirst) {
  MemoryButton& first = TouchedButton({0, 0});
  Ticks(1);
  bus.TakeAway(first);
  MemoryButton& second = TouchedButton({1, 0});
  Pass();
  EXPECT_EQ(second.Copies, 1U);
  EXPECT_EQ(display.Status, "Charged Bandage OK");
}

TEST_F(Charging, ChargesTwoButtonsAtOnceByTurns) {
  MemoryButton& first = TouchedButton({0, 0});
  MemoryButton& second = TouchedButton({1, 0});
  for (int i = 0; i < 3; ++i) {
    Pass();
  }
  EXPECT_EQ(first.Copies, 3U);
  EXPECT_EQ(second.Copies, 3U);
}

TEST_F(Charging, WithoutTheReadersDeviceChargesARestingButtonInEachPass) {
  bus.Devices.clear();
  MemoryButton& mag = TouchedButton({0, 0});
  for (int i = 0; i < 3; ++i) {
    Pass();
  }
  EXPECT_EQ(mag.Copies, 3U);
}

TEST_F(Charging, IgnoresTheReadersDevice) {
  Pass();
  Pass();
  EXPECT_EQ(Count("TMAccess"), 0);
  EXPECT_EQ(display.Begun, 0);
}

TEST_F(Charging, KeepsASessionForOneTickAndSetsUpOnce) {
  Ticks(3);
  EXPECT_THAT(bus.Log, ElementsAre("TMReadDefaultPort", "TMExtendedStartSession 1 5", "TMSetup", "TMNext",
                                   "TMRom", "TMEndSession", "TMReadDefaultPort", "TMExtendedStartSession 1 5",
                                   "TMNext", "TMEndSession", "TMReadDefaultPort",
                                   "TMExtendedStartSession 1 5", "TMNext", "TMRom", "TMEndSession"));
}

TEST_F(Charging, UsesTheAdapterOfTheSettings) {
  bus.DefaultPort = {3, 6};
  Ticks(1);
  EXPECT_EQ(Count("TMExtendedStartSession 3 6"), 1);
}

TEST_F(Charging, ChargesNothingInASpoiledPassAndBeginsAtTheFirstDevice) {
  MemoryButton& mag = TouchedButton({0, 0});
  Ticks(1);
  ASSERT_EQ(display.Status, "Charged Mag OK");
  for (const int result : {-1, 2, -200}) {
    bus.NextResults = {static_cast<std::int16_t>(result)};
    Ticks(1);
    EXPECT_EQ(display.Status, "Charged Mag OK");
    Ticks(1);
  }
  EXPECT_EQ(mag.Copies, 1U);
  bus.TakeAway(mag);
  bus.NextResults = {-1};
  Ticks(2);
  bus.NextResults = {-1};
  Ticks(1);
  bus.NextResults = {0};
  Ticks(1);
  EXPECT_EQ(display.Status, "Charged Mag OK");
  Pass();
  EXPECT_EQ(display.Status, "");
}

TEST_F(Charging, CountsFromTheStartAfterASpoiledPass) {
  MemoryButton& mag = TouchedButton({0, 0});
  Pass();
  bus.TakeAway(mag);
  Ticks(1);
  bus.NextResults = {OneWire::BadRead};
  Ticks(3);
  EXPECT_EQ(display.Status, "");
}

TEST_F(Charging, ClearsTheStatusBeforeItJudgesTheNextButton) {
  MemoryButton& mag = TouchedButton({0, 0});
  Ticks(1);
  bus.TakeAway(mag);
  MemoryButton& torn = TouchedButton({1, 0});
  torn.Memory[63] ^= 1;
  std::string statusAtBox = "none";
  boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) { statusAtBox = display.Status; };
  Pass();
  EXPECT_EQ(statusAtBox, "");
}

TEST_F(Charging, WritesThroughTheScratchpad) {
  MemoryButton& mag = TouchedButton({0, 0});
  std::vector<std::uint8_t> sent;
  const auto onByte = bus.OnByte;
  bus.OnByte = [&](std::uint8_t byte) {
    sent.push_back(byte);
    return onByte(byte);
  };
  Ticks(1);
  std::vector<std::uint8_t> told = {0xF0, 0x20, 0x00};
  told.insert(told.end(), 32, 0xFF);
  const auto after = BlockOf(mag);
  told.insert(told.end(), {0x0F, 0x20, 0x00});
  told.insert(told.end(), after.begin(), after.end());
  told.insert(told.end(), {0xAA, 0xFF, 0xFF, 0xFF, 0x55, 0x20, 0x00, 0x1F, 0xF0, 0x20, 0x00});
  told.insert(told.end(), 32, 0xFF);
  EXPECT_EQ(sent, told);
  EXPECT_EQ(Count("TMAccess"), 5);
  EXPECT_THAT(events.Sleeps, ElementsAre(1ms));
}

TEST_F(Charging, NotesTheButtonWithTimeKindAndNumber) {
  TouchedButton({1, 0});
  Ticks(1);
  ASSERT_THAT(display.Notes, SizeIs(1));
  EXPECT_EQ(display.Notes[0].Time, "14:30:05");
  EXPECT_EQ(display.Notes[0].Kind, 1);
  EXPECT_EQ(display.Notes[0].DallasID, "A10000000000010C");
  EXPECT_EQ(display.Notes[0].Result, ChargeResult::Charged);
}

class MissingReader : public ChargingSite {};

TEST_F(MissingReader, IsToldOnce) {
  bus.Handle = 0;
  Ticks(3);
  EXPECT_THAT(boxes.Boxes, ElementsAre(DriverError()));
  EXPECT_TRUE(charger.ReaderMissing());
  EXPECT_FALSE(display.Reader);
  EXPECT_EQ(Count("TMEndSession"), 3);
}

TEST_F(MissingReader, IsShownBeforeItIsTold) {
  bus.Handle = -1;
  bool shown = true;
  boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) { shown = display.Reader; };
  Ticks(1);
  EXPECT_FALSE(shown);
}

TEST_F(MissingReader, IsToldAgainWhenItIsLostAgain) {
  Ticks(1);
  bus.Lost = true;
  Ticks(2);
  EXPECT_THAT(boxes.Boxes, SizeIs(1));
  bus.Lost = false;
  Ticks(1);
  EXPECT_TRUE(display.Reader);
  EXPECT_FALSE(charger.ReaderMissing());
  bus.Lost = true;
  Ticks(2);
  EXPECT_THAT(boxes.Boxes, ElementsAre(DriverError(), DriverError()));
}

TEST_F(MissingReader, IsNotToldInAWindowThatCloses) {
  display.IsClosing = true;
  bus.Handle = 0;
  Ticks(1);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(MissingReader, OfADriverThatThrowsIsReportedOnce) {
  for (const char* operation : {"TMReadDefaultPort", "TMExtendedStartSession", "TMNext", "TMEndSession"}) {
    bus.Broken = operation;
    EXPECT_EQ(NumberThrownBy([this] { Ticks(1); }), Fault::FileNotFound) << operation;
    EXPECT_TRUE(charger.ReaderMissing()) << operation;
    EXPECT_EQ(bus.Log.back(), "TMEndSession") << operation;
    EXPECT_EQ(NumberThrownBy([this] { Ticks(3); }), 0) << operation;
    EXPECT_FALSE(display.Reader) << operation;
    bus.Broken = "";
    Ticks(1);
    EXPECT_FALSE(charger.ReaderMissing()) << operation;
  }
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(MissingReader, IsNoReasonToForgetTheButtonThatRests) {
  MemoryButton& mag = TouchedButton({0, 0});
  Pass();
  bus.Lost = true;
  Ticks(2);
  EXPECT_EQ(display.Status, "Charged Mag OK");
  bus.Lost = false;
  Pass();
  Pass();
  EXPECT_EQ(mag.Copies, 1U);
}

}  // namespace
