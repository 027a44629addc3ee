#include "sim/baseunit/BaseUnitAnswer.h"

#include <gtest/gtest.h>

#include <set>
#include <stdexcept>
#include <string_view>

#include "sim/game/GameMaker.h"
#include "sim/game/ScoreFrame.h"

namespace sim {
namespace {

using Failure = BaseUnitFailure;

TEST(BaseUnitFailures, StandInTheOrderOfTheirEnumerationUnderDistinctNames) {
  std::set<std::string_view> names;
  for (std::size_t i = 0; i < BaseUnitFailures.size(); ++i) {
    EXPECT_EQ(static_cast<std::size_t>(BaseUnitFailures[i].Failure), i);
    EXPECT_TRUE(names.insert(BaseUnitFailures[i].Name).second) << BaseUnitFailures[i].Name;
  }
  EXPECT_EQ(BaseUnitFailures.back().Failure, Failure::HangUp);
}

TEST(BaseUnitAnswer, HasOneFrameForEachGunInTheOrderOfReporting) {
  const std::vector<GunScores> game = MakeGame(3, 1);
  const BaseUnitAnswer answer = MakeBaseUnitAnswer(game);
  EXPECT_EQ(answer.Count, 3);
  ASSERT_EQ(answer.Frames.size(), 3U);
  for (std::size_t i = 0; i < 3; ++i) {
    EXPECT_EQ(answer.Frames[i], EncodeScoreFrame(game[i]));
  }
  EXPECT_TRUE(answer.Noise.empty());
  EXPECT_FALSE(answer.Torn);
  EXPECT_EQ(answer.CutAfter, std::nullopt);
}

TEST(BaseUnitAnswer, ToAGameWithoutPlayersIsACountOfZero) {
  const BaseUnitAnswer answer = MakeBaseUnitAnswer({});
  EXPECT_EQ(answer.Count, 0);
  EXPECT_TRUE(answer.Frames.empty());
}

TEST(BaseUnitAnswer, CountsUpTo255Frames) {
  EXPECT_EQ(MakeBaseUnitAnswer(std::vector<GunScores>(255)).Count, 255);
  EXPECT_THROW(MakeBaseUnitAnswer(std::vector<GunScores>(256)), std::invalid_argument);
  EXPECT_EQ(MakeBaseUnitAnswer(MakeGame(224, 1), Failure::SameGunTwice).Count, 225);
}

TEST(BaseUnitAnswer, RefusesAFailureInAFrameThatDoesNotExist) {
  for (const BaseUnitFailureInfo& info : BaseUnitFailures) {
    if (info.Place == FailurePlace::Frame) {
      EXPECT_THROW(MakeBaseUnitAnswer(MakeGame(3, 1), info.Failure, 0), std::invalid_argument) << info.Name;
      EXPECT_NO_THROW(MakeBaseUnitAnswer(MakeGame(3, 1), info.Failure, 3)) << info.Name;
      EXPECT_THROW(MakeBaseUnitAnswer(MakeGame(3, 1), info.Failure, 4), std::invalid_argument) << info.Name;
      EXPECT_THROW(MakeBaseUnitAnswer({}, info.Failure, 1), std::invalid_argument) << info.Name;
    } else if (info.Place == FailurePlace::None) {
      EXPECT_NO_THROW(MakeBaseUnitAnswer({}, info.Failure, 4)) << info.Name;
    }
  }
}

TEST(BaseUnitAnswer, FallsSilentAtAnyOfItsBytesButNotBehindThem) {
  const std::vector<GunScores> idleGuns(2);  // 47 bytes each, so 95 with the count
  EXPECT_EQ(MakeBaseUnitAnswer(idleGuns, Failure::Silence, 1).CutAfter, 0U);
  EXPECT_EQ(MakeBaseUnitAnswer(idleGuns, Failure::Silence, 95).CutAfter, 94U);
  EXPECT_THROW(MakeBaseUnitAnswer(idleGuns, Failure::Silence, 0), std::invalid_argument);
  EXPECT_THROW(MakeBaseUnitAnswer(idleGuns, Failure::Silence, 96), std::invalid_argument);
}

TEST(BaseUnitAnswer, IsCutInTheMiddleOfTheFrameWhenTheLineIsPulledOut) {
  const BaseUnitAnswer answer = MakeBaseUnitAnswer(std::vector<GunScores>(2), Failure::HangUp, 2);
  EXPECT_EQ(answer.CutAfter, 1U + 47U + 23U);
  EXPECT_EQ(answer.CutBy, BaseUnitAnswer::Cut::HangUp);
}

TEST(BaseUnitAnswer, GivesTheSecondRunOfAGunOtherFigures) {
  std::vector<GunScores> game(3);
  for (std::size_t i = 0; i < game.size(); ++i) {
    game[i].PlayerId = static_cast<std::uint8_t>(40 + i);
    game[i].RemainingHealth = static_cast<std::uint16_t>(i);
  }
  const BaseUnitAnswer answer = MakeBaseUnitAnswer(game, Failure::SameGunTwice, 3);
  GunScores second = game[0];
  second.PlayerId = 42;
  ASSERT_EQ(answer.Frames.size(), 4U);
  EXPECT_EQ(answer.Frames[2], EncodeScoreFrame(game[2]));
  EXPECT_EQ(answer.Frames[3], EncodeScoreFrame(second));
}

TEST(BaseUnitAnswer, TearsOnlyWhenTold) {
  EXPECT_TRUE(MakeBaseUnitAnswer({}, Failure::TornWrites).Torn);
}

}  // namespace
}  // namespace sim
