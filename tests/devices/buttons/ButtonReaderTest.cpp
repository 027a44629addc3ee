#include "devices/buttons/ButtonReader.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeOneWire.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

using Box = FakeMessageBoxes::Box;

const Box DriverError{"Error loading membership driver. Please ensure it has been installed.", "Driver Error",
                      BoxIcon::Exclamation, BoxButtons::Ok};
const Box NoSession{"Error loading Membership button driver", "Memberbership Error", BoxIcon::Exclamation,
                    BoxButtons::Ok};

Box ReadBox(const std::string& code) {
  return {"Membership button read sucessfully, code = " + code, "Membership Button Status",
          BoxIcon::Information, BoxButtons::Ok};
}

class ReadingAButton : public testing::Test {
 protected:
  ReadingAButton() { reader.Activate(); }

  static constexpr FakeOneWire::Rom Button = {0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF};
  static constexpr FakeOneWire::Rom OwnDevice = {0x81, 0x01, 0x02, 0x03, 0x04, 0x05, 0x06, 0x07};

  FakeOneWire wire;
  FakeMessageBoxes boxes;
  ButtonReader reader{wire, boxes};
};

TEST_F(ReadingAButton, TellsItsCodeAndIsDone) {
  wire.Devices = {Button};
  EXPECT_FALSE(reader.Tick());
  EXPECT_EQ(reader.DallasID(), "EFCDAB8967452301");
  EXPECT_THAT(boxes.Boxes, ElementsAre(ReadBox("EFCDAB8967452301")));
}

TEST_F(ReadingAButton, GivesEachByteTwoDigits) {
  wire.Devices = {{0x0A, 0x0A, 0x0F, 0x10, 0x00, 0x01, 0x02, 0x0B}};
  EXPECT_FALSE(reader.Tick());
  EXPECT_EQ(reader.DallasID(), "0B020100100F0A0A");
}

TEST_F(ReadingAButton, TakesOneSessionATick) {
  wire.Devices = {Button};
  reader.Tick();
  EXPECT_THAT(wire.Log, ElementsAre("TMReadDefaultPort", "TMExtendedStartSession 1 5", "TMSetup", "TMNext",
                                    "TMRom", "TMEndSession"));
}

TEST_F(ReadingAButton, UsesTheAdapterOfTheSettings) {
  wire.DefaultPort = {3, 6};
  reader.Tick();
  EXPECT_EQ(wire.Log[1], "TMExtendedStartSession 3 6");
}

TEST_F(ReadingAButton, LooksForTheAdapterAnewInEachTick) {
  wire.DefaultPort = {3, 6};
  reader.Tick();
  wire.DefaultPort.reset();
  wire.Log.clear();
  reader.Tick();
  EXPECT_EQ(wire.Log[1], "TMExtendedStartSession 1 5");
}

TEST_F(ReadingAButton, SetsTheBusUpOnce) {
  EXPECT_TRUE(reader.Tick());
  wire.Log.clear();
  EXPECT_TRUE(reader.Tick());
  EXPECT_THAT(wire.Log,
              ElementsAre("TMReadDefaultPort", "TMExtendedStartSession 1 5", "TMNext", "TMEndSession"));
}

TEST_F(ReadingAButton, SetsTheBusUpInTheFirstSessionThatStarts) {
  wire.Handle = 0;
  reader.Tick();
  reader.Activate();
  wire.Handle = 7;
  wire.Log.clear();
  reader.Tick();
  EXPECT_EQ(wire.Log[2], "TMSetup");
}

TEST_F(ReadingAButton, GoesOnWhileTheReaderIsEmpty) {
  for (int tick = 0; tick < 50; ++tick) {
    ASSERT_TRUE(reader.Tick());
  }
  EXPECT_EQ(reader.DallasID(), NoDallasId);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(ReadingAButton, NeverTakesTheReadersOwnDevice) {
  wire.Devices = {OwnDevice};
  for (int tick = 0; tick < 50; ++tick) {
    ASSERT_TRUE(reader.Tick());
  }
  EXPECT_EQ(reader.DallasID(), NoDallasId);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(ReadingAButton, FindsItBehindTheReadersOwnDevice) {
  wire.Devices = {OwnDevice, Button};
  EXPECT_TRUE(reader.Tick());
  EXPECT_FALSE(reader.Tick());
  EXPECT_EQ(reader.DallasID(), "EFCDAB8967452301");
}

TEST_F(ReadingAButton, LooksAtTheFamilyAloneToKnowTheReader) {
  wire.Devices = {{0x01, 0x81, 0x81, 0x81, 0x81, 0x81, 0x81, 0x81}};
  EXPECT_FALSE(reader.Tick());
  EXPECT_EQ(reader.DallasID(), "8181818181818101");
}

TEST_F(ReadingAButton, TakesTheFirstOfTwo) {
  wire.Devices = {Button, {0x0C, 1, 2, 3, 4, 5, 6, 7}};
  EXPECT_FALSE(reader.Tick());
  EXPECT_EQ(reader.DallasID(), "EFCDAB8967452301");
  EXPECT_EQ(boxes.Boxes.size(), 1U);
}

TEST_F(ReadingAButton, TellsItWithTheSessionOpen) {
  wire.Devices = {Button};
  bool openMeanwhile = false;
  boxes.WhileOpen = [&](const Box&) { openMeanwhile = wire.SessionOpen(); };
  reader.Tick();
  EXPECT_TRUE(openMeanwhile);
  EXPECT_FALSE(wire.SessionOpen());
}

TEST_F(ReadingAButton, EndsAtTheEndOfTheNextTickAfterCancel) {
  ASSERT_TRUE(reader.Tick());
  reader.Cancel();
  EXPECT_FALSE(reader.Tick());
  EXPECT_EQ(reader.DallasID(), NoDallasId);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(ReadingAButton, GoesOnAfterABadRead) {
  wire.Devices = {Button};
  wire.NextResults = {OneWire::BadRead, OneWire::EndOfBus, -27};
  for (int tick = 0; tick < 3; ++tick) {
    EXPECT_TRUE(reader.Tick());
    EXPECT_EQ(wire.Log.back(), "TMEndSession");
  }
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_FALSE(reader.Tick());
  EXPECT_EQ(reader.DallasID(), "EFCDAB8967452301");
}

TEST_F(ReadingAButton, StillTakesAButtonInTheTickAfterCancel) {
  ASSERT_TRUE(reader.Tick());
  wire.Devices = {Button};
  reader.Cancel();
  EXPECT_FALSE(reader.Tick());
  EXPECT_EQ(reader.DallasID(), "EFCDAB8967452301");
}

TEST_F(ReadingAButton, EndsWithTheTickInWhichCancelIsPressed) {
  wire.OnCall = [this](const std::string& operation) {
    if (operation == "TMNext") {
      reader.Cancel();
    }
  };
  EXPECT_FALSE(reader.Tick());
}

TEST_F(ReadingAButton, BeginsAnewWithEachActivation) {
  wire.Devices = {Button};
  ASSERT_FALSE(reader.Tick());
  wire.Devices.clear();
  reader.Activate();
  EXPECT_EQ(reader.DallasID(), NoDallasId);
  EXPECT_TRUE(reader.Tick());
}

TEST_F(ReadingAButton, TellsOfASessionThatDoesNotStartAndIsDone) {
  for (const std::int32_t handle : {0, -201}) {
    wire.Handle = handle;
    wire.Log.clear();
    boxes.Boxes.clear();
    reader.Activate();
    EXPECT_FALSE(reader.Tick());
    EXPECT_EQ(reader.DallasID(), NoDallasId);
    EXPECT_THAT(boxes.Boxes, ElementsAre(NoSession));
    EXPECT_THAT(wire.Log, ElementsAre("TMReadDefaultPort", "TMExtendedStartSession 1 5", "TMEndSession"));
  }
}

TEST_F(ReadingAButton, TellsOfAnyFaultOfTheDriverAndIsDone) {
  wire.Devices = {OwnDevice};
  for (const char* operation :
       {"TMReadDefaultPort", "TMExtendedStartSession", "TMSetup", "TMNext", "TMRom"}) {
    FakeMessageBoxes told;
    ButtonReader other(wire, told);
    wire.Broken = operation;
    wire.Log.clear();
    other.Activate();
    EXPECT_FALSE(other.Tick()) << operation;
    EXPECT_EQ(other.DallasID(), NoDallasId);
    EXPECT_THAT(told.Boxes, ElementsAre(DriverError)) << operation;
    EXPECT_EQ(wire.Log.back(), "TMEndSession");
    EXPECT_FALSE(wire.SessionOpen());
  }
}

TEST_F(ReadingAButton, TellsOfAFaultAtTheEndOfTheSessionToo) {
  wire.Broken = "TMEndSession";
  EXPECT_FALSE(reader.Tick());
  EXPECT_THAT(boxes.Boxes, ElementsAre(DriverError));
}

TEST_F(ReadingAButton, KeepsAButtonThatWasReadBeforeTheFault) {
  wire.Devices = {Button};
  wire.Broken = "TMEndSession";
  EXPECT_FALSE(reader.Tick());
  EXPECT_EQ(reader.DallasID(), "EFCDAB8967452301");
  EXPECT_THAT(boxes.Boxes, ElementsAre(ReadBox("EFCDAB8967452301"), DriverError));
}

}  // namespace
