#include "sim/onewire/Ds2480b.h"

#include <gtest/gtest.h>

#include <vector>

#include "tests/support/Bytes.h"

namespace sim {
namespace {

constexpr RomId Button{0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF};
constexpr RomId Sister{0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCC, 0xEF};
constexpr RomId Reader{0x81, 0x10, 0x32, 0x54, 0x76, 0x98, 0xBA, 0xDC};

// What the search accelerator tells of each when there is no choice on the way.
const Bytes ButtonPath{0x02, 0x00, 0x0A, 0x08, 0x22, 0x20, 0x2A, 0x28,
                       0x82, 0x80, 0x8A, 0x88, 0xA2, 0xA0, 0xAA, 0xA8};
const Bytes ReaderPath{0x02, 0x80, 0x00, 0x02, 0x08, 0x0A, 0x20, 0x22,
                       0x28, 0x2A, 0x80, 0x82, 0x88, 0x8A, 0xA0, 0xA2};

class Ds2480bTest : public testing::Test {
 protected:
  Ds2480bTest() { EXPECT_EQ(Answers({0xC1}), Bytes{}); }

  Bytes Answers(const Bytes& bytes) {
    Bytes answers;
    for (const std::uint8_t byte : bytes) {
      if (const std::optional<std::uint8_t> answer = chip_.Receive(byte)) {
        answers.push_back(*answer);
      }
    }
    return answers;
  }

  // One pass of a search; the command mode stands before and after.
  Bytes Search(const Bytes& directions) {
    EXPECT_EQ(Answers({0xC1}), Bytes{0xCD});
    EXPECT_EQ(Answers({0xE1, 0xF0, 0xE3, 0xB1, 0xE1}), Bytes{0xF0});
    const Bytes path = Answers(directions);
    EXPECT_EQ(Answers({0xE3, 0xA1}), Bytes{});
    return path;
  }

  OneWireBus bus_;
  Ds2480b chip_{bus_};
};

const Bytes LowestFirst(16, 0x00);

Bytes With(Bytes bytes, std::size_t index, std::uint8_t value) {
  bytes.at(index) = value;
  return bytes;
}

TEST(Ds2480bPowerUp, TakesTheFirstByteForItsTimingAndAnswersFromTheSecondOn) {
  OneWireBus bus;
  Ds2480b chip(bus);
  EXPECT_EQ(chip.Receive(0xC1), std::nullopt);
  EXPECT_EQ(chip.Receive(0xC1), 0xCF);
}

TEST_F(Ds2480bTest, AnswersTheUsualDetection) {
  EXPECT_EQ(Answers({0x17, 0x45, 0x5B, 0x0F, 0x91}), (Bytes{0x16, 0x44, 0x5A, 0x00, 0x93}));
}

TEST_F(Ds2480bTest, HasTheParametersOfTheDataSheetAtPowerUp) {
  EXPECT_EQ(Answers({0x03, 0x05, 0x07, 0x09, 0x0B, 0x0D, 0x0F}),
            (Bytes{0x00, 0x08, 0x08, 0x00, 0x00, 0x08, 0x00}));
}

TEST_F(Ds2480bTest, EchoesAndKeepsEachValueOfEachParameter) {
  for (unsigned parameter = 1; parameter <= 7; ++parameter) {
    for (unsigned value = 0; value <= 7; ++value) {
      const auto write = static_cast<std::uint8_t>(parameter * 16 + value * 2 + 1);
      const auto read = static_cast<std::uint8_t>(parameter * 2 + 1);
      EXPECT_EQ(Answers({write, read}),
                (Bytes{static_cast<std::uint8_t>(write - 1), static_cast<std::uint8_t>(value * 2)}));
    }
  }
}

TEST_F(Ds2480bTest, ChangesItsBaudRateWithTheParameter) {
  EXPECT_EQ(chip_.Baud(), 9600);
  const std::vector<std::pair<std::uint8_t, int>> rates{
      {0x73, 19200}, {0x75, 57600}, {0x77, 115200}, {0x71, 9600}, {0x7B, 19200}};
  for (const auto& [command, baud] : rates) {
    EXPECT_EQ(Answers({command}), Bytes{static_cast<std::uint8_t>(command - 1)});
    EXPECT_EQ(chip_.Baud(), baud);
  }
}

TEST_F(Ds2480bTest, TellsPresenceAndItsVersionAfterAReset) {
  EXPECT_EQ(Answers({0xC1}), Bytes{0xCF});
  bus_.Touch(Button);
  EXPECT_EQ(Answers({0xC1, 0xC5, 0xC9}), (Bytes{0xCD, 0xCD, 0xCD}));
}

TEST(Ds2480bOnAShortedBus, TellsTheShortAndHearsOnlyZeros) {
  OneWireBus bus({.Shorted = true});
  Ds2480b chip(bus);
  chip.Receive(0xC1);
  EXPECT_EQ(chip.Receive(0xC1), 0xCC);
  EXPECT_EQ(chip.Receive(0x91), 0x90);
  EXPECT_EQ(chip.Receive(0xE1), std::nullopt);
  EXPECT_EQ(chip.Receive(0x33), 0x00);
}

TEST_F(Ds2480bTest, ReadsBackSingleBitsInBothLowBits) {
  EXPECT_EQ(Answers({0x81, 0x91, 0x85, 0x99}), (Bytes{0x80, 0x93, 0x84, 0x9B}));
}

TEST_F(Ds2480bTest, CarriesACommandToTheBusBitByBit) {
  bus_.Touch(Button);
  EXPECT_EQ(Answers({0xC1}), Bytes{0xCD});
  EXPECT_EQ(Answers({0x91, 0x91, 0x81, 0x81, 0x91, 0x91, 0x81, 0x81}),
            (Bytes{0x93, 0x93, 0x80, 0x80, 0x93, 0x93, 0x80, 0x80}));
  EXPECT_EQ(Answers(Bytes(8, 0x91)), (Bytes{0x93, 0x90, 0x90, 0x90, 0x90, 0x90, 0x90, 0x90}));
}

TEST_F(Ds2480bTest, EchoesDataWithWhatTheBusGave) {
  EXPECT_EQ(Answers({0xE1, 0x00, 0x5A, 0xC1, 0x17, 0xE1, 0xF1, 0xFF}),
            (Bytes{0x00, 0x5A, 0xC1, 0x17, 0xE1, 0xF1, 0xFF}));
}

TEST_F(Ds2480bTest, ReadsARomInDataMode) {
  bus_.Touch(Button);
  EXPECT_EQ(Answers({0xC1, 0xE1, 0x33, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xE3, 0xC1}),
            (Bytes{0xCD, 0x33, 0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF, 0xCD}));
}

TEST_F(Ds2480bTest, TakesTheModeByteForDataOnlyWhenItComesTwice) {
  EXPECT_EQ(Answers({0xE1, 0xE3, 0xE3, 0x11, 0xE3, 0xE3, 0xE3, 0xE3}), (Bytes{0xE3, 0x11, 0xE3, 0xE3}));
  EXPECT_EQ(Answers({0xE3, 0xC1}), Bytes{0xCF});
  EXPECT_TRUE(chip_.ExpectsCommand());
}

TEST_F(Ds2480bTest, ReturnsToDataModeRightAfterLeavingIt) {
  EXPECT_EQ(Answers({0xE1, 0xE3, 0xE1, 0xC1}), Bytes{0xC1});
  EXPECT_FALSE(chip_.ExpectsCommand());
}

TEST_F(Ds2480bTest, AnswersNoModeByteInCommandModeAndNoByteThatIsNoCommand) {
  EXPECT_EQ(Answers({0xE3, 0xE3, 0xF1, 0x00, 0x16, 0x80, 0xC0, 0xE0, 0xFE}), Bytes{});
  EXPECT_EQ(Answers({0xC1}), Bytes{0xCF});
}

TEST_F(Ds2480bTest, FindsASingleDevice) {
  bus_.Touch(Button);
  EXPECT_EQ(Search(LowestFirst), ButtonPath);
  EXPECT_EQ(Search(Bytes(16, 0xAA)), ButtonPath);
}

TEST_F(Ds2480bTest, FindsTwoDevicesByTheDirectionAtTheirOnlyConflict) {
  bus_.Touch(Button);
  bus_.Touch(Reader);
  EXPECT_EQ(Search(LowestFirst), With(ButtonPath, 1, 0x40));
  EXPECT_EQ(Search(With(LowestFirst, 1, 0x80)), With(ReaderPath, 1, 0xC0));
}

TEST_F(Ds2480bTest, FindsThreeDevicesAndTellsEachConflictOnTheWay) {
  bus_.Touch(Button);
  bus_.Touch(Reader);
  bus_.Touch(Sister);
  const Bytes toButtons = With(ButtonPath, 1, 0x40);
  EXPECT_EQ(Search(LowestFirst), With(toButtons, 12, 0xA1));
  EXPECT_EQ(Search(With(LowestFirst, 12, 0x02)), With(toButtons, 12, 0xA3));
  EXPECT_EQ(Search(With(LowestFirst, 1, 0x80)), With(ReaderPath, 1, 0xC0));
}

TEST_F(Ds2480bTest, IgnoresTheEvenBitsOfDirections) {
  bus_.Touch(Button);
  bus_.Touch(Reader);
  EXPECT_EQ(Search(Bytes(16, 0x55)), With(ButtonPath, 1, 0x40));
}

TEST_F(Ds2480bTest, TellsOnlyOnesFromTheFirstBitThatNobodyAnswers) {
  EXPECT_EQ(Answers({0xC1, 0xE1, 0xF0, 0xE3, 0xB1, 0xE1}), (Bytes{0xCF, 0xF0}));
  EXPECT_EQ(Answers(LowestFirst), Bytes(16, 0xFF));
}

TEST_F(Ds2480bTest, ForgetsAFailedSearchWhenTheAcceleratorIsSwitchedOff) {
  Answers({0xE1, 0xF0, 0xE3, 0xB1, 0xE1, 0x00, 0xE3, 0xA1});
  bus_.Touch(Button);
  EXPECT_EQ(Search(LowestFirst), ButtonPath);
}

TEST_F(Ds2480bTest, RemembersAFailedSearchWhileTheAcceleratorIsOn) {
  Answers({0xE1, 0xF0, 0xE3, 0xB1, 0xE1, 0x00, 0xE3});
  bus_.Touch(Button);
  // Reset and search command past the accelerator, as single bits.
  Answers({0xC1, 0x81, 0x81, 0x81, 0x81, 0x91, 0x91, 0x91, 0x91, 0xE1});
  EXPECT_EQ(Answers(LowestFirst), Bytes(16, 0xFF));
}

TEST_F(Ds2480bTest, TellsAButtonThatLeavesInTheMiddleOfASearch) {
  bus_.Touch(Button);
  EXPECT_EQ(Answers({0xC1, 0xE1, 0xF0, 0xE3, 0xB1, 0xE1, 0x00, 0x00, 0x00}),
            (Bytes{0xCD, 0xF0, 0x02, 0x00, 0x0A}));
  bus_.LeaveAll();
  EXPECT_EQ(Answers(Bytes(13, 0x00)), Bytes(13, 0xFF));
}

TEST_F(Ds2480bTest, TellsAConflictAtEachBitOfASearchOnAShortedBus) {
  OneWireBus shorted({.Shorted = true});
  Ds2480b chip(shorted);
  for (const int byte : {0xC1, 0xC1, 0xE1, 0xF0, 0xE3, 0xB1, 0xE1}) {
    chip.Receive(static_cast<std::uint8_t>(byte));
  }
  EXPECT_EQ(chip.Receive(0x00), 0x55);
  EXPECT_EQ(chip.Receive(0x88), 0xDD);
}

TEST_F(Ds2480bTest, MatchesARomWithEchoesOnly) {
  bus_.Touch(Button);
  bus_.Touch(Reader);
  EXPECT_EQ(Answers({0xC1, 0xE1, 0x55, 0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF, 0xFF}),
            (Bytes{0xCD, 0x55, 0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF, 0xFF}));
}

TEST_F(Ds2480bTest, AnswersAPulseOfStatedLengthAtItsEnd) {
  EXPECT_EQ(Answers({0xED, 0xFD, 0xEF, 0xED}), (Bytes{0xEC, 0xFC, 0xEC, 0xEC}));
}

TEST_F(Ds2480bTest, AnswersAnEndlessPulseWhenTheHostEndsIt) {
  EXPECT_EQ(Answers({0x3F, 0xED}), Bytes{0x3E});
  EXPECT_EQ(Answers({0xC1, 0x0F, 0xE1}), Bytes{});
  EXPECT_EQ(Answers({0xF1}), Bytes{0xEC});
  EXPECT_EQ(Answers({0xF1, 0xC1}), Bytes{0xCF});
  EXPECT_EQ(Answers({0x2F, 0xFD, 0xF1}), (Bytes{0x2E, 0xFC}));
}

TEST_F(Ds2480bTest, PullsUpBehindABitThatAsksForIt) {
  EXPECT_EQ(Answers({0x93}), Bytes{0x93});
  EXPECT_EQ(Answers({0x3F, 0x93, 0xF1, 0x91}), (Bytes{0x3E, 0x93, 0xEC, 0x93}));
}

TEST_F(Ds2480bTest, PullsUpBehindDataOnlyWhileThatIsArmed) {
  EXPECT_EQ(Answers({0x3F, 0xEF, 0xF1}), (Bytes{0x3E, 0xEC}));
  EXPECT_EQ(Answers({0xE1, 0x44, 0xF1, 0x45, 0xF1, 0xE3}), (Bytes{0x44, 0xEC, 0x45, 0xEC}));
  EXPECT_EQ(Answers({0xED, 0xF1, 0xE1, 0x44, 0xF1}), (Bytes{0xEC, 0x44, 0xF1}));
}

}  // namespace
}  // namespace sim
