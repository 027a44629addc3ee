#include "sim/recorder/RecorderFailure.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <stdexcept>

#include "sim/recorder/SoundRecorder.h"
#include "tests/sim/recorder/RecorderHost.h"

namespace sim {
namespace {

using std::chrono::milliseconds;

constexpr std::size_t Faulty = 2;  // page or answer

bool IsOfGun(RecorderFailure failure) {
  return failure == RecorderFailure::NoTableAnswer;
}

// What a host sends in one recording of two pages and a test, step by step.
std::vector<Bytes> StepsOf(RecorderFailure failure) {
  if (IsOfGun(failure)) {
    return {{10, 0},
            {2, 0},
            Bytes{1, 0, 0, 0} + TableOfTwo + Bytes{TableOfTwoCheck},
            Bytes{1, 0, 0, 0} + RisingPage + Bytes{RisingCheck}};
  }
  return {{2, 3},
          {2, 3},
          {1, 0},
          Bytes{2, 0} + RisingPage + Bytes{RisingCheck},
          SilentPage + Bytes{SilentCheck},
          {0, 0},
          {3, 2, 0}};
}

// What comes back, step by step. Silence follows the last.
std::vector<Bytes> AnswersOf(RecorderFailure failure) {
  switch (failure) {
    case RecorderFailure::None:
    case RecorderFailure::MergedEraseAnswers:
      return {{0xAA}, {0xAA, 0xAA}, {0xAA}, {0xAA}, {0xAA}, {0xAA}, {0xAA}};
    case RecorderFailure::NoStartAnswer:
      return {{}};
    case RecorderFailure::NoEraseAnswer:
      return {{0xAA}, {}};
    case RecorderFailure::NoEraseEnd:
    case RecorderFailure::SlowErase:
    case RecorderFailure::UnpluggedInErase:
      return {{0xAA}, {0xAA}};
    case RecorderFailure::NoTableAnswer:
    case RecorderFailure::NoHeaderAnswer:
      return {{0xAA}, {0xAA, 0xAA}, {}};
    case RecorderFailure::NoPageAnswer:
    case RecorderFailure::LostByte:
    case RecorderFailure::UnpluggedInPage:
      return {{0xAA}, {0xAA, 0xAA}, {0xAA}, {0xAA}, {}};
    case RecorderFailure::NoEndAnswer:
      return {{0xAA}, {0xAA, 0xAA}, {0xAA}, {0xAA}, {0xAA}, {}};
    case RecorderFailure::NoPlayAnswer:
      return {{0xAA}, {0xAA, 0xAA}, {0xAA}, {0xAA}, {0xAA}, {0xAA}, {}};
    case RecorderFailure::OtherAnswer:
      return {{0xAA}, {0x55, 0xAA}};
    case RecorderFailure::RefusedPage:
      return {{0xAA}, {0xAA, 0xAA}, {0xAA}, {0xAA}, {0x55}};
    case RecorderFailure::DoubleAnswer:
      return {{0xAA}, {0xAA, 0xAA, 0xAA}, {0xAA}, {0xAA}, {0xAA}, {0xAA}, {0xAA}};
    case RecorderFailure::NoiseBeforeAnswer:
      return {{0xAA}, {0xFE, 0xAA, 0xAA}, {0xAA}, {0xAA}, {0xAA}, {0xAA}, {0xAA}};
  }
  return {};
}

bool EndsTheLine(RecorderFailure failure) {
  return failure == RecorderFailure::UnpluggedInErase || failure == RecorderFailure::UnpluggedInPage;
}

class FailureOfTheRecorder : public testing::TestWithParam<RecorderFailureInfo> {
 protected:
  FailureOfTheRecorder()
      : recorder_({.Failure = GetParam().Failure,
                   .FailurePlace = Faulty,
                   .LinePace = Pace::Fast,
                   .SlowEraseTime = milliseconds(600),
                   .Patience = milliseconds(400)}),
        host_(recorder_.DevicePath(), IsOfGun(GetParam().Failure) ? 19200 : 115200) {}

  void ExpectAnswers() {
    const std::vector<Bytes> steps = StepsOf(GetParam().Failure);
    const std::vector<Bytes> answers = AnswersOf(GetParam().Failure);
    for (std::size_t i = 0; i < answers.size(); ++i) {
      EXPECT_EQ(host_.Ask(steps.at(i), answers[i].size()), answers[i]) << "step " << i;
    }
  }

  void ExpectEndOfLine() {
    const std::vector<Bytes> steps = StepsOf(GetParam().Failure);
    const std::vector<Bytes> answers = AnswersOf(GetParam().Failure);
    const std::size_t last = answers.size() - 1;
    for (std::size_t i = 0; i < last; ++i) {
      EXPECT_EQ(host_.Ask(steps[i], answers[i].size()), answers[i]) << "step " << i;
    }
    host_.Write(steps[last]);
    // A line that is pulled out takes bytes with it that the host had not read yet.
    EXPECT_LE(host_.ReadUntilHangUp().size(), answers[last].size());
    EXPECT_TRUE(host_.HungUp());
  }

  SoundRecorder recorder_;
  RecorderHost host_;
};

TEST_P(FailureOfTheRecorder, ReachesTheHostAsItsNameSays) {
  const RecorderFailure failure = GetParam().Failure;
  if (EndsTheLine(failure)) {
    ExpectEndOfLine();
    return;
  }
  ExpectAnswers();
  EXPECT_TRUE(host_.IsSilent());
  EXPECT_FALSE(host_.HungUp());
  if (failure == RecorderFailure::SlowErase) {
    EXPECT_EQ(host_.Read(1), Ack);
  }
}

TEST_P(FailureOfTheRecorder, LeavesItReadyForANewStartUnlessTheLineIsGone) {
  const RecorderFailure failure = GetParam().Failure;
  if (EndsTheLine(failure)) {
    ExpectEndOfLine();
    return;
  }
  ExpectAnswers();
  if (failure == RecorderFailure::SlowErase) {
    EXPECT_EQ(host_.Read(1), Ack);
  } else if (failure == RecorderFailure::LostByte) {
    // The recorder waits for the rest of the page, and the host in vain for an answer.
    EXPECT_EQ(host_.ReadByte(milliseconds(1000)), std::nullopt);
  }
  host_.Write(StepsOf(failure)[0]);
  if (failure == RecorderFailure::NoStartAnswer) {
    EXPECT_TRUE(host_.IsSilent());
  } else {
    EXPECT_EQ(host_.Read(1), Ack);
  }
  for (const std::string& fault : recorder_.HostFaults()) {
    EXPECT_EQ(fault.find("the host sent"), std::string::npos) << fault;
  }
}

INSTANTIATE_TEST_SUITE_P(Every, FailureOfTheRecorder, testing::ValuesIn(RecorderFailures),
                         [](const testing::TestParamInfo<RecorderFailureInfo>& failure) {
                           std::string name(failure.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

TEST(RecorderFailures, HoldBothAnswersToTheEraseBackUntilItIsDone) {
  SoundRecorder recorder({.Failure = RecorderFailure::MergedEraseAnswers,
                          .LinePace = Pace::Fast,
                          .EraseTime = milliseconds(400)});
  RecorderHost host(recorder.DevicePath(), 19200);
  EXPECT_EQ(host.Ask({10, 0}), Ack);
  host.Write({2, 0});
  EXPECT_TRUE(host.IsSilent());
  EXPECT_EQ(host.Read(2), Ack + Ack);
}

TEST(RecorderFailures, LoseAByteOfOnePageOnly) {
  SoundRecorder recorder(
      {.Failure = RecorderFailure::LostByte, .LinePace = Pace::Fast, .Patience = milliseconds(100)});
  RecorderHost host(recorder.DevicePath(), 19200);
  BeginInProduct(host);
  EXPECT_EQ(host.Ask(Bytes{1, 0, 0, 0} + TableOfTwo + Bytes{TableOfTwoCheck}), Ack);
  // The byte that completes the page is taken for its check byte.
  EXPECT_EQ(host.Ask(Bytes{1, 0, 0, 0} + RisingPage + Bytes{RisingCheck, 0}), Refusal);
  EXPECT_EQ(host.Ask(Bytes{1, 0, 1, 0} + RisingPage + Bytes{0x97}), Ack);
}

TEST(RecorderFailures, NeedAPlaceThatExists) {
  for (const RecorderFailureInfo& info : RecorderFailures) {
    const SoundRecorderSettings settings{.Failure = info.Failure, .FailurePlace = 0};
    if (info.Place == FailurePlace::None) {
      EXPECT_NO_THROW(SoundRecorder{settings}) << info.Name;
    } else {
      EXPECT_THROW(SoundRecorder{settings}, std::invalid_argument) << info.Name;
    }
  }
}

}  // namespace
}  // namespace sim
