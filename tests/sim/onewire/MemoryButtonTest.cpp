#include "sim/onewire/MemoryButton.h"

#include <gtest/gtest.h>

#include <numeric>

#include "tests/support/Bytes.h"

namespace sim {
namespace {

using Kind = MemoryTroubleSettings::Kind;

// The block 0, 1, 2, ... 31.
Bytes Counting(std::size_t count) {
  Bytes bytes(count);
  std::iota(bytes.begin(), bytes.end(), std::uint8_t{0});
  return bytes;
}

// A button that has the bus to itself, and is selected after each reset pulse.
class Selected {
 public:
  explicit Selected(std::size_t bytes = 512, MemoryTroubleSettings trouble = {})
      : trouble_(trouble),
        button_(bytes, trouble_, [this](const std::string& what) { Told.push_back(what); }) {}

  // A reset pulse, the bytes, and what the button gives in `count` bytes behind them.
  Bytes Ask(const Bytes& bytes, std::size_t count = 0) {
    button_.Reset();
    for (const std::uint8_t byte : bytes) {
      Send(byte, 8);
    }
    Bytes given;
    for (std::size_t i = 0; i < count; ++i) {
      given.push_back(Send(0xFF, 8));
    }
    return given;
  }

  std::uint8_t Send(std::uint8_t byte, unsigned bits) {
    unsigned heard = 0;
    for (unsigned bit = 0; bit < bits; ++bit) {
      const bool level = (byte >> bit & 1U) != 0 && button_.Releases();
      button_.Slot(level);
      heard |= (level ? 1U : 0U) << bit;
    }
    return static_cast<std::uint8_t>(heard);
  }

  void WriteScratchpad(std::uint8_t low, std::uint8_t high, const Bytes& data) {
    Bytes bytes{0x0F, low, high};
    bytes.insert(bytes.end(), data.begin(), data.end());
    Ask(bytes);
  }

  Bytes Registers() { return Ask({0xAA}, 3); }
  Bytes BlockAt32() { return Ask({0xF0, 0x20, 0x00}, 32); }
  MemoryButton& Button() { return button_; }

  std::vector<std::string> Told;

 private:
  MemoryTrouble trouble_;
  MemoryButton button_;
};

const Bytes Ones32(32, 0xFF);

TEST(MemoryButton, GivesItsMemoryFromTheAddressToItsEndAndThenOnes) {
  Selected button(128);
  button.Button().Memory() = Counting(128);
  EXPECT_EQ(button.Ask({0xF0, 0x7E, 0x00}, 4), (Bytes{0x7E, 0x7F, 0xFF, 0xFF}));
  EXPECT_EQ(button.Ask({0xF0, 0x80, 0x00}, 1), Bytes{0xFF});
  Selected larger(512);
  larger.Button().Memory().at(0x1FF) = 0x5A;
  EXPECT_EQ(larger.Ask({0xF0, 0xFF, 0x01}, 2), (Bytes{0x5A, 0xFF}));
}

TEST(MemoryButton, WritesABlockThroughItsScratchpad) {
  Selected button;
  button.WriteScratchpad(0x20, 0x00, Counting(32));
  EXPECT_EQ(button.BlockAt32(), Ones32);
  EXPECT_EQ(button.Registers(), (Bytes{0x20, 0x00, 0x1F}));
  button.Ask({0x55, 0x20, 0x00, 0x1F});
  EXPECT_EQ(button.BlockAt32(), Counting(32));
  EXPECT_EQ(button.Ask({0xF0, 0x1F, 0x00}, 1), Bytes{0xFF});
  EXPECT_EQ(button.Ask({0xF0, 0x40, 0x00}, 1), Bytes{0xFF});
  EXPECT_EQ(button.Told, std::vector<std::string>{"copied 32 bytes to 00 20"});
}

TEST(MemoryButton, PullsTheLineLowBehindACopyUntilTheNextResetPulse) {
  Selected button;
  button.WriteScratchpad(0x20, 0x00, Counting(32));
  EXPECT_EQ(button.Ask({0x55, 0x20, 0x00, 0x1F}, 3), Bytes(3, 0x00));
  EXPECT_EQ(button.Registers(), (Bytes{0x20, 0x00, 0x9F}));
}

TEST(MemoryButton, CopiesNothingForAnyOtherAuthorisation) {
  for (const Bytes& authorisation :
       {Bytes{0x21, 0x00, 0x1F}, Bytes{0x20, 0x01, 0x1F}, Bytes{0x20, 0x00, 0x1E}, Bytes{0x20, 0x00, 0x9F},
        Bytes{0xFF, 0xFF, 0xFF}, Bytes{0x20, 0x00}, Bytes{}}) {
    Selected button;
    button.WriteScratchpad(0x20, 0x00, Counting(32));
    Bytes copy{0x55};
    copy.insert(copy.end(), authorisation.begin(), authorisation.end());
    button.Ask(copy);
    EXPECT_EQ(button.BlockAt32(), Ones32);
    EXPECT_EQ(button.Told.size(), authorisation.size() == 3 ? 1U : 0U);
  }
}

TEST(MemoryButton, AcceptsAnAuthorisationOnceAndWantsItsFlagBackForASecondCopy) {
  Selected button;
  button.WriteScratchpad(0x20, 0x00, Counting(32));
  button.Ask({0x55, 0x20, 0x00, 0x1F});
  EXPECT_EQ(button.Ask({0x55, 0x20, 0x00, 0x1F}, 1), Bytes{0xFF});
  button.WriteScratchpad(0x20, 0x00, Bytes(32, 0x77));
  EXPECT_EQ(button.Registers(), (Bytes{0x20, 0x00, 0x1F}));
}

TEST(MemoryButton, TakesTheTargetOfAReadIntoItsRegisters) {
  Selected button;
  button.WriteScratchpad(0x20, 0x00, Counting(32));
  button.Ask({0xF0, 0x00, 0x01}, 1);
  EXPECT_EQ(button.Registers(), (Bytes{0x00, 0x01, 0x1F}));
  EXPECT_EQ(button.Ask({0x55, 0x20, 0x00, 0x1F}, 1), Bytes{0xFF});
}

TEST(MemoryButton, GivesTheScratchpadBehindItsRegistersAndThenOnes) {
  Selected button;
  button.WriteScratchpad(0x3D, 0x00, {0x11, 0x22, 0x33});
  EXPECT_EQ(button.Ask({0xAA}, 8), (Bytes{0x3D, 0x00, 0x1F, 0x11, 0x22, 0x33, 0xFF, 0xFF}));
}

TEST(MemoryButton, CopiesOnlyWhatWasWritten) {
  Selected button;
  button.WriteScratchpad(0x24, 0x00, {0x11, 0x22, 0x33});
  EXPECT_EQ(button.Registers(), (Bytes{0x24, 0x00, 0x06}));
  button.Ask({0x55, 0x24, 0x00, 0x06});
  EXPECT_EQ(button.Ask({0xF0, 0x23, 0x00}, 5), (Bytes{0xFF, 0x11, 0x22, 0x33, 0xFF}));
}

TEST(MemoryButton, MarksTooMuchDataAndDropsIt) {
  Selected button;
  button.WriteScratchpad(0x20, 0x00, Counting(33));
  EXPECT_EQ(button.Registers(), (Bytes{0x20, 0x00, 0x5F}));
  button.Ask({0x55, 0x20, 0x00, 0x5F});
  EXPECT_EQ(button.BlockAt32(), Counting(32));
}

TEST(MemoryButton, MarksAByteThatBreaksOff) {
  Selected button;
  button.Ask({0x0F, 0x20, 0x00, 0x11});
  button.Send(0x05, 3);
  EXPECT_EQ(button.Ask({0xAA}, 5), (Bytes{0x20, 0x00, 0x21, 0x11, 0x05}));
}

TEST(MemoryButton, KeepsScratchpadAndMemoryOverResetPulses) {
  Selected button;
  button.WriteScratchpad(0x20, 0x00, Counting(32));
  button.Ask({});
  button.Ask({0x55, 0x20});
  EXPECT_EQ(button.Registers(), (Bytes{0x20, 0x00, 0x1F}));
}

TEST(MemoryButton, DoesNotAnswerCommandsThatItDoesNotKnow) {
  Selected button;
  EXPECT_EQ(button.Ask({0x99}, 2), Bytes(2, 0xFF));
  EXPECT_EQ(button.Told, std::vector<std::string>{"does not know the command 99"});
}

TEST(MemoryButtonInTrouble, LeavesBehindTheByteThatIsRead) {
  Selected button(512, {.What = Kind::RemovedInRead, .Place = 34});
  button.Button().Memory() = Bytes(512, 0x00);
  EXPECT_EQ(button.BlockAt32(), Bytes(32, 0x00));
  EXPECT_FALSE(button.Button().TakeRemoval());
  EXPECT_EQ(button.Ask({0xF0, 0x20, 0x00}, 4), (Bytes{0x00, 0x00, 0xFF, 0xFF}));
  EXPECT_TRUE(button.Button().TakeRemoval());
  EXPECT_FALSE(button.Button().TakeRemoval());
  EXPECT_EQ(button.BlockAt32(), Bytes(32, 0x00));
}

// A whole write: 35 bytes into the scratchpad, 4 from it, 4 to copy.
void Write(Selected& button) {
  const auto goesOn = [&] { return !button.Button().TakeRemoval(); };
  button.WriteScratchpad(0x20, 0x00, Counting(32));
  Bytes registers;
  if (goesOn()) {
    registers = button.Registers();
  }
  if (registers.size() == 3 && goesOn()) {
    button.Ask({0x55, registers[0], registers[1], registers[2]});
  }
}

TEST(MemoryButtonInTrouble, TakesTheBlockOnlyIfItLeavesBehindTheLastByteOfAWrite) {
  for (std::size_t place = 1; place <= 43; ++place) {
    Selected button(512, {.What = Kind::RemovedInWrite, .Place = place});
    Write(button);
    EXPECT_EQ(button.Button().Memory().at(0x21), place == 43 ? 0x01 : 0xFF) << place;
    EXPECT_EQ(button.Told.back(), "was taken from the reader") << place;
  }
}

TEST(MemoryButtonInTrouble, TakesAPartOfTheBlockWhenItLeavesInTheMidstOfTheCopy) {
  Selected button(512, {.What = Kind::TornCopy, .Place = 5});
  Write(button);
  EXPECT_TRUE(button.Button().TakeRemoval());
  Bytes torn = Ones32;
  std::iota(torn.begin(), torn.begin() + 5, std::uint8_t{0});
  EXPECT_EQ(button.BlockAt32(), torn);
  Write(button);
  EXPECT_EQ(button.BlockAt32(), Counting(32));
}

TEST(MemoryButtonInTrouble, IsReadWithOneWrongByteOnce) {
  Selected button(512, {.What = Kind::DisturbedRead, .Place = 3});
  button.Button().Memory() = Bytes(512, 0x00);
  EXPECT_EQ(button.Ask({0xF0, 0x20, 0x00}, 4), (Bytes{0x00, 0x00, 0x10, 0x00}));
  EXPECT_EQ(button.Ask({0xF0, 0x20, 0x00}, 4), Bytes(4, 0x00));
}

TEST(MemoryButtonInTrouble, HearsOrGivesOneWrongByteInAWrite) {
  for (std::size_t place = 1; place <= 43; ++place) {
    Selected button(512, {.What = Kind::DisturbedWrite, .Place = place});
    Write(button);
    Bytes expected = Ones32;
    if (place == 2) {
      // The address: the block is copied to 0x30, and its second half is too much.
      std::iota(expected.begin() + 16, expected.end(), std::uint8_t{0});
    } else if (place >= 4 && place <= 35) {
      expected = Counting(32);
      expected.at(place - 4) ^= 0x10U;
    }
    EXPECT_EQ(button.Ask({0xF0, 0x20, 0x00}, 32), expected) << place;
    Write(button);
    EXPECT_EQ(button.BlockAt32(), Counting(32)) << place;
  }
}

TEST(MemoryButtonInTrouble, TakesNothingWhenItIsWriteProtected) {
  Selected button(512, {.What = Kind::WriteProtected});
  Write(button);
  EXPECT_EQ(button.BlockAt32(), Ones32);
  EXPECT_EQ(button.Registers(), (Bytes{0x20, 0x00, 0x1F}));
  EXPECT_EQ(button.Told, std::vector<std::string>{"is write-protected"});
}

}  // namespace
}  // namespace sim
