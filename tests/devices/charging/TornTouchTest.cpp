#include <gmock/gmock.h>

#include <random>

#include "tests/devices/charging/ChargingSite.h"

// Buttons that leave, come back or are disturbed while they are read and written.

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

constexpr std::size_t ReadBytes = 35;
constexpr std::size_t ChargeBytes = 35 + 35 + 4 + 4;

class TornTouch : public ChargingSite {
 protected:
  void TakeAwayBefore(std::size_t place, MemoryButton& button) {
    bus.BeforeByte = [this, place, &button](std::size_t byte) {
      if (byte == place) {
        bus.TakeAway(button);
      }
    };
  }

  /// Disturbs the bytes of the first `count` readings that come at the same place.
  void DisturbReadings(int count, std::size_t place) {
    bus.Disturbance = [count, place](std::size_t byte) {
      const bool hit = byte < static_cast<std::size_t>(count) * ReadBytes && byte % ReadBytes == place;
      return hit ? std::uint8_t{0x08} : std::uint8_t{0};
    };
  }
};

TEST_F(TornTouch, ReadsAgainUpToTwiceBeforeItJudges) {
  for (const int disturbed : {1, 2}) {
    MemoryButton& bandage = TouchedButton({1, 0});
    bus.Bytes = 0;
    DisturbReadings(disturbed, 12);
    Ticks(1);
    EXPECT_EQ(BlockOf(bandage)[1], 5) << disturbed;
    EXPECT_EQ(display.Notes.back().Result, ChargeResult::Charged) << disturbed;
    Leave(bandage);
  }
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(TornTouch, JudgesTheThirdReadingEvenIfItIsWrong) {
  TouchedButton({1, 0});
  DisturbReadings(3, 12);
  Ticks(1);
  EXPECT_THAT(boxes.Boxes, ElementsAre(RecoveryQuestion()));
  EXPECT_THAT(Results(), ElementsAre(ChargeResult::Charged));
}

TEST_F(TornTouch, ReadsAgainWhenTheCommandWasDisturbed) {
  for (const std::size_t place : {0U, 1U, 2U}) {
    MemoryButton& bandage = TouchedButton({1, 0});
    bus.Bytes = 0;
    DisturbReadings(1, place);
    Ticks(1);
    EXPECT_EQ(bandage.Copies, 1U);
    EXPECT_EQ(BlockOf(bandage)[1], 5);
    Leave(bandage);
  }
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

/// Zeros have the right check byte: a Bandage would become an Ammo Mag.
TEST_F(TornTouch, DoesNotTakeWhatLiesElsewhereForTheBlock) {
  MemoryButton& bandage = TouchedButton({1, 0});
  std::fill_n(bandage.Memory.begin(), 32, std::uint8_t{0});
  const auto onByte = bus.OnByte;
  bus.OnByte = [&](std::uint8_t byte) {
    constexpr std::size_t lowByteOfTheAddress = 1;
    return onByte(static_cast<std::uint8_t>(bus.Bytes == lowByteOfTheAddress ? byte ^ 0x20U : byte));
  };
  Ticks(1);
  EXPECT_EQ(BlockOf(bandage)[0], 1);
  EXPECT_EQ(display.Status, "Charged Bandage OK");
}

TEST_F(TornTouch, WritesNothingWhenTheButtonDoesNotAnswer) {
  MemoryButton& bandage = TouchedButton({1, 0});
  const auto before = bandage.Memory;
  bus.FailingAccesses = 3;
  Ticks(1);
  EXPECT_EQ(bandage.Memory, before);
  EXPECT_EQ(display.Status, "");
  EXPECT_THAT(Results(), ElementsAre(ChargeResult::NotRead));
  EXPECT_FALSE(display.Notes[0].Kind);
  EXPECT_EQ(Count("TMAccess"), 3);
}

TEST_F(TornTouch, TriesAnUnreadButtonAgainInTheNextPass) {
  MemoryButton& bandage = TouchedButton({1, 0});
  bus.FailingAccesses = 3;
  Pass();
  Pass();
  EXPECT_EQ(BlockOf(bandage)[1], 5);
  EXPECT_THAT(Results(), ElementsAre(ChargeResult::NotRead, ChargeResult::Charged));
}

TEST_F(TornTouch, ReadsOnAfterOneSelectionFailed) {
  MemoryButton& bandage = TouchedButton({1, 0});
  bus.FailingAccesses = 1;
  Ticks(1);
  EXPECT_EQ(BlockOf(bandage)[1], 5);
  EXPECT_THAT(Results(), ElementsAre(ChargeResult::Charged));
}

TEST_F(TornTouch, InMidReadWritesAndAsksNothing) {
  for (std::size_t place = 0; place < ReadBytes; ++place) {
    MemoryButton& bandage = TouchedButton({1, 0});
    const auto before = bandage.Memory;
    bus.Bytes = 0;
    TakeAwayBefore(place, bandage);
    Ticks(1);
    EXPECT_EQ(bandage.Memory, before) << place;
    EXPECT_THAT(boxes.Boxes, IsEmpty()) << place;
    EXPECT_EQ(display.Notes.back().Result, ChargeResult::NotRead) << place;
    Leave(bandage);
  }
  EXPECT_THAT(display.Notes, SizeIs(ReadBytes));
}

/// The block whose torn reading has the right check byte: its bytes from `cut` on are lost, and ones come.
TEST_F(TornTouch, IsNotTakenForAGoodBlockWhenTheCheckByteHappensToFit) {
  MemoryButton& bandage = TouchedButton({1, 0});
  constexpr std::size_t cut = 20;
  ChargeBlock torn{};
  for (int guess = 0; guess < 65536; ++guess) {
    Fill(bandage, {1, 0, static_cast<std::uint8_t>(guess % 256), static_cast<std::uint8_t>(guess / 256)});
    torn = BlockOf(bandage);
    std::fill(torn.begin() + cut, torn.end(), std::uint8_t{0xFF});
    if (CheckHolds(torn)) {
      break;
    }
  }
  ASSERT_TRUE(CheckHolds(torn));
  const ChargeBlock before = BlockOf(bandage);
  // It bounces: gone for the rest of the first reading, and back for the next.
  bus.BeforeByte = [&](std::size_t byte) { bandage.Present = byte < 3 + cut || byte >= ReadBytes - 1; };
  Ticks(1);
  ChargeBlock full = before;
  ASSERT_TRUE(Charge(full));
  EXPECT_EQ(BlockOf(bandage), full);
}

TEST_F(TornTouch, OfAGoodBlockThatEndsInOnesIsNoTrouble) {
  MemoryButton& bandage = TouchedButton({1, 0});
  for (int guess = 0; guess < 256 && bandage.Memory[63] != 0xFF; ++guess) {
    Fill(bandage, {1, 0, static_cast<std::uint8_t>(guess)});
  }
  ASSERT_EQ(bandage.Memory[63], 0xFF);
  Ticks(1);
  EXPECT_EQ(BlockOf(bandage)[1], 5);
  EXPECT_THAT(Results(), ElementsAre(ChargeResult::Charged));
}

TEST_F(TornTouch, InMidWriteIsToldAsDoneButNotedAsNotReadBack) {
  for (std::size_t place = ReadBytes; place < ChargeBytes; ++place) {
    MemoryButton& bandage = TouchedButton({1, 0});
    const ChargeBlock before = BlockOf(bandage);
    bus.Bytes = 0;
    TakeAwayBefore(place, bandage);
    Ticks(1);
    EXPECT_EQ(BlockOf(bandage), before) << place;
    EXPECT_EQ(display.Status, "Charged Bandage OK") << place;
    EXPECT_EQ(display.Notes.back().Result, ChargeResult::NotReadBack) << place;
    Leave(bandage);
  }
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(TornTouch, AfterTheCopyIsNotReadBackEither) {
  for (std::size_t place = ChargeBytes; place < ChargeBytes + ReadBytes; ++place) {
    MemoryButton& bandage = TouchedButton({1, 0});
    bus.Bytes = 0;
    TakeAwayBefore(place, bandage);
    Ticks(1);
    EXPECT_EQ(BlockOf(bandage)[1], 5) << place;
    EXPECT_EQ(display.Notes.back().Result, ChargeResult::NotReadBack) << place;
    Leave(bandage);
  }
}

TEST_F(TornTouch, ReadsBackAgainWhenOneReadingIsDisturbed) {
  TouchedButton({1, 0});
  bus.Disturbance = [](std::size_t byte) {
    return byte == ChargeBytes + 20 ? std::uint8_t{1} : std::uint8_t{0};
  };
  Ticks(1);
  EXPECT_THAT(Results(), ElementsAre(ChargeResult::Charged));
}

TEST_F(TornTouch, NotesAButtonThatRefusedTheData) {
  MemoryButton& bandage = TouchedButton({1, 0});
  bandage.Protected = true;
  Pass();
  EXPECT_EQ(display.Status, "Charged Bandage OK");
  EXPECT_THAT(Results(), ElementsAre(ChargeResult::Different));
  Pass();
  EXPECT_THAT(Results(), SizeIs(1));
}

TEST_F(TornTouch, NotesAnAuthorisationThatWasDisturbed) {
  MemoryButton& bandage = TouchedButton({1, 0});
  bus.Disturbance = [](std::size_t byte) {
    return byte == 35 + 35 + 2 ? std::uint8_t{0x40} : std::uint8_t{0};
  };
  Ticks(1);
  EXPECT_EQ(bandage.Copies, 0U);
  EXPECT_EQ(display.Status, "Charged Bandage OK");
  EXPECT_THAT(Results(), ElementsAre(ChargeResult::Different));
}

TEST_F(TornTouch, OfTheReaderAtAnyByteWritesNothingThatWasNotReadWhole) {
  for (std::size_t place = 0; place < ChargeBytes + ReadBytes - 1; ++place) {
    MemoryButton& bandage = TouchedButton({1, 0});
    const ChargeBlock before = BlockOf(bandage);
    boxes.Boxes.clear();
    bus.Bytes = 0;
    bus.BeforeByte = [this, place](std::size_t byte) { bus.Lost = bus.Lost || byte == place; };
    Ticks(2);
    const bool wasRead = place >= ReadBytes - 1;
    EXPECT_EQ(display.Notes.back().Result, wasRead ? ChargeResult::NotReadBack : ChargeResult::NotRead)
        << place;
    if (place < ChargeBytes - 1) {
      EXPECT_EQ(BlockOf(bandage), before) << place;
    }
    EXPECT_THAT(boxes.Boxes, ElementsAre(DriverError())) << place;
    bus.BeforeByte = [](std::size_t) {};
    bus.Lost = false;
    Leave(bandage);
  }
}

TEST_F(TornTouch, WritesNothingWhenTheWindowCloses) {
  MemoryButton& bandage = TouchedButton({1, 0});
  bus.BeforeByte = [this](std::size_t byte) { display.IsClosing = byte == 5 || display.IsClosing; };
  Ticks(1);
  EXPECT_EQ(bandage.Copies, 0U);
  EXPECT_THAT(display.Notes, IsEmpty());
}

TEST_F(TornTouch, AsksNothingWhenTheWindowCloses) {
  MemoryButton& torn = TouchedButton({7, 0});
  torn.Memory[63] ^= 1;
  display.IsClosing = true;
  Ticks(1);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_EQ(torn.Copies, 0U);
}

TEST_F(TornTouch, WritesNothingWhenTheWindowClosesWhileItAsks) {
  MemoryButton& torn = TouchedButton({7, 0});
  torn.Memory[63] ^= 1;
  boxes.WhileOpen = [this](const FakeMessageBoxes::Box&) { display.IsClosing = true; };
  Ticks(1);
  EXPECT_EQ(torn.Copies, 0U);
  EXPECT_THAT(display.Notes, IsEmpty());
}

/// The button bounces while it is read, or leaves for good at any time.
TEST_F(TornTouch, LeavesTheOldBlockOrTheFullOneInHundredsOfTouches) {
  std::mt19937 random(11);
  std::size_t full = 0;
  for (int touch = 0; touch < 500; ++touch) {
    MemoryButton& button =
        TouchedButton({static_cast<std::uint8_t>(random() % 2), static_cast<std::uint8_t>(random() % 6)});
    const ChargeBlock before = BlockOf(button);
    ChargeBlock charged = before;
    ASSERT_TRUE(Charge(charged));
    bus.Bytes = 0;
    const bool bounces = random() % 2 == 0;
    const std::size_t gone = random() % (bounces ? ReadBytes : ChargeBytes + ReadBytes);
    const std::size_t back = gone + random() % ReadBytes;
    bus.BeforeByte = [&](std::size_t byte) {
      if (bounces) {
        button.Present = byte < gone || byte >= back;
      } else if (byte == gone) {
        bus.TakeAway(button);
      }
    };
    Ticks(1);
    const ChargeBlock after = BlockOf(button);
    ASSERT_TRUE(after == before || after == charged) << touch << ' ' << gone << ' ' << back;
    if (display.Notes.back().Result == ChargeResult::Charged) {
      ASSERT_EQ(after, charged) << touch;
      ++full;
    }
    bus.BeforeByte = [](std::size_t) {};
    Leave(button);
  }
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_GT(full, 200U);
}

}  // namespace
