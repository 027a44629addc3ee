#include "sim/box/BoxFailure.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "sim/box/UtilityBox.h"
#include "tests/support/BoxHost.h"

namespace sim {
namespace {

using std::chrono::milliseconds;

const Bytes Ammo{0x42, 0x43, 0x11, 0x05, 0x00, 0x32, 0x00, 0x00, 0x00, 0x00};
const Bytes WrongTeam{0x42, 0x43, 0x41, 0x05, 0x00, 0x32, 0x00, 0x00, 0x00, 0x00};
const Bytes Accepted{0xAA};
constexpr milliseconds LateAnswer{300};

UtilityBoxSettings Under(BoxFailure failure, int times) {
  return {.Failure = failure, .FailurePlace = 4, .Times = times, .Late = LateAnswer, .LinePace = Pace::Fast};
}

class FailureOfTheBox : public testing::TestWithParam<BoxFailureInfo> {};

TEST_P(FailureOfTheBox, ReachesTheHostAsItsNameSays) {
  UtilityBox box(Under(GetParam().Failure, 0));
  BoxHost host(box.DevicePath());
  const auto start = std::chrono::steady_clock::now();
  // The line may be gone before the rest of the frame is written, as it is when a box is pulled out.
  host.Send(GetParam().Failure == BoxFailure::Unplugged ? Bytes{0x42, 0x43, 0x11, 0x05} : Ammo);
  switch (GetParam().Failure) {
    case BoxFailure::None:
      EXPECT_EQ(host.Read(1), Accepted);
      break;
    case BoxFailure::Rejects:
      EXPECT_EQ(host.Read(1), Bytes{0x55});
      EXPECT_EQ(box.Traffic().Accepted, std::nullopt);
      break;
    case BoxFailure::Silent:
      ASSERT_TRUE(box.WaitUntilTold(1, Limit));
      break;
    case BoxFailure::Late:
      EXPECT_EQ(host.Read(1), Accepted);
      EXPECT_GE(std::chrono::steady_clock::now() - start, LateAnswer);
      break;
    case BoxFailure::AnswersTwice:
      EXPECT_EQ(host.Read(2), (Bytes{0xAA, 0x55}));
      host.Send(WrongTeam);
      EXPECT_EQ(host.Read(2), (Bytes{0x55, 0xAA}));
      break;
    case BoxFailure::Noise:
      EXPECT_EQ(host.Read(2), (Bytes{0xF8, 0xAA}));
      break;
    case BoxFailure::Unplugged:
      EXPECT_EQ(host.ReadUntilHangUp(), Bytes{});
      EXPECT_TRUE(host.HungUp());
      EXPECT_TRUE(box.Traffic().Frames.empty());
      return;
  }
  EXPECT_TRUE(host.IsSilent());
}

TEST_P(FailureOfTheBox, StopsAfterItsTimesUnlessTheLineIsGone) {
  UtilityBox box(Under(GetParam().Failure, 2));
  BoxHost host(box.DevicePath());
  if (GetParam().Failure == BoxFailure::Unplugged) {
    host.Send({0x42, 0x43, 0x11, 0x05});
    host.ReadUntilHangUp();
    EXPECT_TRUE(host.HungUp());
    return;
  }
  for (std::size_t frame = 1; frame <= 2; ++frame) {
    host.Send(Ammo);
    ASSERT_TRUE(box.WaitUntilTold(frame, Limit));
    const bool answersTwice =
        GetParam().Failure == BoxFailure::AnswersTwice || GetParam().Failure == BoxFailure::Noise;
    const std::size_t answers = GetParam().Failure == BoxFailure::Silent ? 0 : answersTwice ? 2 : 1;
    EXPECT_EQ(host.Read(answers).size(), answers);
  }
  host.Send(Ammo);
  EXPECT_EQ(host.Read(1), Accepted);
  EXPECT_TRUE(host.IsSilent());
}

INSTANTIATE_TEST_SUITE_P(Every, FailureOfTheBox, testing::ValuesIn(BoxFailures),
                         [](const testing::TestParamInfo<BoxFailureInfo>& failure) {
                           std::string name(failure.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

TEST(BoxPulledOut, IsGoneBehindEachByteOfAFrame) {
  for (std::size_t place = 1; place <= Ammo.size(); ++place) {
    UtilityBox box({.Failure = BoxFailure::Unplugged, .FailurePlace = place, .LinePace = Pace::Fast});
    BoxHost host(box.DevicePath());
    host.Send({Ammo.begin(), Ammo.begin() + static_cast<std::ptrdiff_t>(place)});
    EXPECT_EQ(host.ReadUntilHangUp(), Bytes{}) << place;
    EXPECT_TRUE(host.HungUp()) << place;
  }
}

TEST(BoxThatIsLate, TakesASecondFrameMeanwhile) {
  UtilityBox box(Under(BoxFailure::Late, 1));
  BoxHost host(box.DevicePath());
  host.Send(WrongTeam);
  host.Send(Ammo);
  EXPECT_EQ(host.Read(2), (Bytes{0xAA, 0x55}));
}

}  // namespace
}  // namespace sim
