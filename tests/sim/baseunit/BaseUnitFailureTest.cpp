#include "sim/baseunit/BaseUnitFailure.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "sim/baseunit/BaseUnit.h"
#include "sim/game/GameMaker.h"
#include "sim/line/Crc.h"
#include "tests/support/RawHost.h"

namespace sim {
namespace {

constexpr int Players = 5;
// The second frame, or a byte within it.
constexpr std::size_t FaultyFrame = 2;
constexpr std::size_t Index = FaultyFrame - 1;
constexpr std::size_t BytesIntoFrame = 10;

struct Conversation {
  Bytes Lead;                 // up to and with the count byte
  std::vector<Bytes> Frames;  // with CRC; the last may be incomplete
};

// Plays the host's part, believing every length word.
class FailureOfTheBaseUnit : public testing::TestWithParam<BaseUnitFailureInfo> {
 protected:
  FailureOfTheBaseUnit()
      : faultless_(MakeBaseUnitAnswer(MakeGame(Players, 2)).Frames),
        unit_({.Answer = MakeBaseUnitAnswer(MakeGame(Players, 2), GetParam().Failure, Place()),
               .LinePace = Pace::Fast}),
        host_(unit_.DevicePath()) {}

  std::size_t Place() const {
    return GetParam().Place == FailurePlace::Byte ? 1 + faultless_[0].size() + BytesIntoFrame : FaultyFrame;
  }

  Bytes Receive(std::size_t count) {
    // Where silence is what must come, there is no reason to wait for long.
    const auto patience =
        GetParam().Failure == BaseUnitFailure::Silence ? std::chrono::milliseconds(500) : Limit;
    Bytes bytes;
    while (bytes.size() < count) {
      const std::optional<std::uint8_t> byte = host_.ReadByte(patience);
      if (!byte) {
        broken_ = true;
        break;
      }
      bytes.push_back(*byte);
    }
    return bytes;
  }

  Conversation Download(std::size_t leadBytes) {
    Conversation heard;
    host_.Write({1, 0});
    heard.Lead = Receive(leadBytes);
    const std::size_t count = heard.Lead.empty() ? 0 : heard.Lead.back();
    for (std::size_t i = 0; i < count && !broken_; ++i) {
      Bytes frame = Receive(2);
      if (!broken_) {
        const std::size_t length = frame[0] + 256U * frame[1];
        const Bytes rest = Receive(length + 1 - 2);
        frame.insert(frame.end(), rest.begin(), rest.end());
      }
      if (!broken_) {
        host_.Write({Crc8(frame) == 0 ? std::uint8_t{170} : std::uint8_t{0}});
      }
      heard.Frames.push_back(frame);
    }
    EXPECT_TRUE(unit_.WaitUntilServed(1, Limit));
    return heard;
  }

  Bytes Replies() const { return unit_.LatestExchange().Replies; }

  std::vector<Bytes> faultless_;
  BaseUnit unit_;
  RawHost host_;
  bool broken_ = false;
};

const Bytes CountOfAll{Players};
const Bytes AllAccepted(Players, 170);

void ExpectOthersFaultless(const std::vector<Bytes>& frames, const std::vector<Bytes>& faultless) {
  ASSERT_GE(frames.size(), faultless.size());
  for (std::size_t i = 0; i < faultless.size(); ++i) {
    if (i != Index) {
      EXPECT_EQ(frames[i], faultless[i]) << "frame " << i + 1;
    }
  }
}

Bytes Part(const Bytes& bytes, std::size_t from, std::size_t to) {
  return {bytes.begin() + static_cast<std::ptrdiff_t>(from), bytes.begin() + static_cast<std::ptrdiff_t>(to)};
}

// Counters set beyond a signed word; the check byte follows from the rest.
void ExpectHighCounters(const Bytes& frame, Bytes faultless) {
  for (std::size_t counter = 0; counter < 9; ++counter) {
    faultless[6 + 2 * counter] = static_cast<std::uint8_t>(faultless[6 + 2 * counter] + 128);
  }
  EXPECT_EQ(Part(frame, 0, frame.size() - 1), Part(faultless, 0, faultless.size() - 1));
}

void ExpectLongerStatistics(const Bytes& frame, const Bytes& faultless) {
  const std::size_t extra = frame[5] - 18U;
  EXPECT_GT(frame[5], 18);
  EXPECT_EQ(frame.size(), faultless.size() + extra);
  EXPECT_EQ(frame[2] + 256U * frame[3], 41 + extra);
  EXPECT_EQ(Part(frame, 6, 24), Part(faultless, 6, 24));
  EXPECT_EQ(Part(frame, 24 + extra, frame.size() - 1), Part(faultless, 24, faultless.size() - 1));
}

void ExpectWrongCrc(const std::vector<Bytes>& frames, const std::vector<Bytes>& faultless) {
  ExpectOthersFaultless(frames, faultless);
  const std::size_t length = faultless[Index].size() - 1;
  EXPECT_EQ(Part(frames.at(Index), 0, length), Part(faultless[Index], 0, length));
  EXPECT_NE(frames.at(Index).back(), faultless[Index].back());
}

void ExpectSecondRun(const std::vector<Bytes>& frames, const std::vector<Bytes>& faultless) {
  ASSERT_EQ(frames.size(), faultless.size() + 1);
  EXPECT_EQ(frames.at(Index), faultless[Index]);
  ExpectOthersFaultless(frames, faultless);
  EXPECT_EQ(frames.back()[4], faultless[Index][4]);
  EXPECT_NE(Part(frames.back(), 6, 45), Part(faultless[Index], 6, 45));
}

// A line that is pulled out takes bytes with it that the host had not read yet.
void ExpectHalfAFrameAtMost(const std::vector<Bytes>& frames, const std::vector<Bytes>& faultless) {
  ASSERT_EQ(frames.size(), FaultyFrame);
  EXPECT_EQ(frames[0], faultless[0]);
  const Bytes& rest = frames.at(Index);
  EXPECT_LE(rest.size(), faultless[Index].size() / 2);
  EXPECT_TRUE(std::equal(rest.begin(), rest.end(), faultless[Index].begin()));
}

TEST_P(FailureOfTheBaseUnit, ReachesTheHostAsItsNameSays) {
  const BaseUnitFailure failure = GetParam().Failure;
  const Conversation heard = Download(failure == BaseUnitFailure::NoiseBeforeCount ? 4 : 1);
  switch (failure) {
    case BaseUnitFailure::None:
    case BaseUnitFailure::TornWrites:
      EXPECT_EQ(heard.Lead, CountOfAll);
      EXPECT_EQ(heard.Frames, faultless_);
      EXPECT_EQ(Replies(), AllAccepted);
      break;
    case BaseUnitFailure::WrongCrc:
      ExpectWrongCrc(heard.Frames, faultless_);
      EXPECT_EQ(Replies(), (Bytes{170, 0, 170, 170, 170}));
      break;
    case BaseUnitFailure::Silence:
      EXPECT_EQ(heard.Frames,
                (std::vector<Bytes>{faultless_[0], Part(faultless_[1], 0, BytesIntoFrame - 1)}));
      EXPECT_FALSE(host_.HungUp());
      break;
    case BaseUnitFailure::CountZero:
      EXPECT_EQ(heard.Lead, Bytes{0});
      EXPECT_TRUE(host_.IsSilent());
      break;
    case BaseUnitFailure::NoiseBeforeCount:
      EXPECT_EQ(heard.Lead, (Bytes{0xFE, 0xF0, 0x7F, Players}));
      EXPECT_EQ(heard.Frames, faultless_);
      break;
    case BaseUnitFailure::LongerStatisticsBlock:
      ASSERT_EQ(heard.Frames.size(), faultless_.size());
      for (std::size_t i = 0; i < faultless_.size(); ++i) {
        ExpectLongerStatistics(heard.Frames[i], faultless_[i]);
      }
      EXPECT_EQ(Replies(), AllAccepted);
      break;
    case BaseUnitFailure::LengthAbove1001:
      ExpectOthersFaultless(heard.Frames, faultless_);
      EXPECT_GT(heard.Frames.at(Index).size(), 1001U + 1U);
      EXPECT_EQ(Part(heard.Frames.at(Index), 4, 45), Part(faultless_[Index], 4, 45));
      EXPECT_EQ(Replies(), AllAccepted);
      break;
    case BaseUnitFailure::HighBitWords:
      ExpectOthersFaultless(heard.Frames, faultless_);
      ExpectHighCounters(heard.Frames.at(Index), faultless_[Index]);
      EXPECT_EQ(Replies(), AllAccepted);
      break;
    case BaseUnitFailure::SameGunTwice:
      EXPECT_EQ(heard.Lead, Bytes{Players + 1});
      ExpectSecondRun(heard.Frames, faultless_);
      break;
    case BaseUnitFailure::HangUp:
      EXPECT_TRUE(host_.HungUp());
      ExpectHalfAFrameAtMost(heard.Frames, faultless_);
      EXPECT_EQ(unit_.LatestExchange().Frames.at(Index),
                Part(faultless_[Index], 0, faultless_[Index].size() / 2));
      break;
  }
}

TEST_P(FailureOfTheBaseUnit, LeavesTheUnitReadyForTheNextRequestUnlessTheLineIsGone) {
  const Conversation heard = Download(GetParam().Failure == BaseUnitFailure::NoiseBeforeCount ? 4 : 1);
  if (GetParam().Failure == BaseUnitFailure::HangUp) {
    EXPECT_TRUE(host_.HungUp());
  } else {
    host_.Write({1, 0});
    EXPECT_EQ(Receive(1), Part(heard.Lead, 0, 1));
  }
}

INSTANTIATE_TEST_SUITE_P(Every, FailureOfTheBaseUnit, testing::ValuesIn(BaseUnitFailures),
                         [](const testing::TestParamInfo<BaseUnitFailureInfo>& failure) {
                           std::string name(failure.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

}  // namespace
}  // namespace sim
