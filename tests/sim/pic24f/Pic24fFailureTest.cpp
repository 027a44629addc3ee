#include "sim/pic24f/Pic24fFailure.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <stdexcept>

#include "sim/pic24f/Pic24fLoader.h"
#include "tests/sim/pic24f/LoaderHost.h"

namespace sim {
namespace {

using std::chrono::milliseconds;
using testing::IsEmpty;

constexpr std::size_t Faulty = 2;  // request, answer or row

// Row 2: 64 instructions 0x030201 at 0x100.
const Bytes WriteRow2 = Bytes{0x55, 0x55, 0x02, 0x01, 0x00, 0x01, 0x00} +
                        Repeated(64, {0x01, 0x02, 0x03, 0x00}) + Bytes{0x7C, 0x04};
const Bytes Header{0x55, 0x55, 0x01, 0x02, 0x80, 0x00, 0x00};

class FailureOfTheLoader : public testing::TestWithParam<Pic24fFailureInfo> {
 protected:
  FailureOfTheLoader()
      : loader_({.Failure = GetParam().Failure,
                 .FailurePlace = Faulty,
                 .LinePace = Pace::Fast,
                 .Lateness = milliseconds(300)}),
        host_(loader_.DevicePath()) {}

  // The second of two requests is one to read; its answer must be `answer`, then silence.
  void ExpectSecondAnswer(const Bytes& answer) {
    EXPECT_EQ(host_.Ask(WriteRow1, Written.size()), Written);
    EXPECT_EQ(host_.Ask(ReadRow1, answer.size()), answer);
    EXPECT_TRUE(host_.IsSilent());
    EXPECT_FALSE(host_.HungUp());
  }

  void ExpectThirdAnswer() { EXPECT_EQ(host_.Ask(ReadRow1, Row1.size()), Row1); }

  // What the device holds in the second row that was written.
  Bytes SecondRow() {
    EXPECT_EQ(host_.Ask(WriteRow1, Written.size()), Written);
    host_.Write(WriteRow2);
    EXPECT_TRUE(loader_.WaitUntilAsked(2, Limit));
    return *loader_.Traffic().Memory.Read(0x100, 64);
  }

  void ExpectSecondRow(const Bytes& row) {
    EXPECT_EQ(SecondRow(), row);
    EXPECT_EQ(host_.Read(Written.size()), Written);
  }

  void ExpectLineToEnd(const Bytes& atMost) {
    const Bytes heard = host_.ReadUntilHangUp();
    EXPECT_TRUE(host_.HungUp());
    // A line that is pulled out takes bytes with it that the host had not read yet.
    EXPECT_LE(heard.size(), atMost.size());
    EXPECT_TRUE(std::equal(heard.begin(), heard.end(), atMost.begin()));
  }

  Pic24fLoader loader_;
  LoaderHost host_;
};

const Bytes Good{0x01, 0x02, 0x03, 0x00};

TEST_P(FailureOfTheLoader, ReachesTheHostAsItsNameSays) {
  switch (GetParam().Failure) {
    case Pic24fFailure::None:
    case Pic24fFailure::TornAnswers:
      ExpectSecondAnswer(Row1);
      ExpectThirdAnswer();
      break;
    case Pic24fFailure::Silence:
      ExpectSecondAnswer({});
      host_.Write(ReadRow1);
      EXPECT_TRUE(host_.IsSilent());
      break;
    case Pic24fFailure::LostAnswer:
      ExpectSecondAnswer({});
      ExpectThirdAnswer();
      EXPECT_EQ(loader_.Traffic().Requests.size(), 3U);
      break;
    case Pic24fFailure::LostRequest:
      ExpectSecondAnswer({});
      ExpectThirdAnswer();
      EXPECT_EQ(loader_.Traffic().Requests.size(), 2U);
      break;
    case Pic24fFailure::WrongChecksum:
      ExpectSecondAnswer(Header + Good + Good + Bytes{0xF1, 0x04});
      ExpectThirdAnswer();
      break;
    case Pic24fFailure::OtherCommand:
      ExpectSecondAnswer(Bytes{0x55, 0x55, 0x09, 0x02, 0x80, 0x00, 0x00} + Good + Good + Bytes{0x69, 0x04});
      ExpectThirdAnswer();
      break;
    case Pic24fFailure::ShortRead:
      ExpectSecondAnswer(Header + Good + Bytes{0x77, 0x04});
      ExpectThirdAnswer();
      break;
    case Pic24fFailure::CutAnswer:
      ExpectSecondAnswer(Header + Bytes{0x01});
      ExpectThirdAnswer();
      break;
    case Pic24fFailure::EscapedAnswers:
      EXPECT_EQ(host_.Ask(WriteRow1, 7), (Bytes{0x55, 0x55, 0x05, 0x02, 0x05, 0xFE, 0x04}));
      break;
    case Pic24fFailure::LateAnswer:
      ExpectSecondAnswer({});
      EXPECT_EQ(host_.Read(Row1.size()), Row1);
      ExpectThirdAnswer();
      break;
    case Pic24fFailure::DoubleAnswer:
      ExpectSecondAnswer(Row1 + Row1);
      ExpectThirdAnswer();
      break;
    case Pic24fFailure::Noise:
      ExpectSecondAnswer(Bytes{0xFE, 0xF0, 0x7F} + Row1);
      ExpectThirdAnswer();
      break;
    case Pic24fFailure::FalseStart:
      ExpectSecondAnswer(Bytes{0xFE, 0x55, 0x55, 0x12} + Row1);
      ExpectThirdAnswer();
      break;
    case Pic24fFailure::BadCells:
      ExpectSecondRow(Repeated(32, Good) + Bytes{0, 0, 0, 0} + Repeated(31, Good));
      break;
    case Pic24fFailure::LostRow:
      ExpectSecondRow(Repeated(64, {0xFF, 0xFF, 0xFF, 0x00}));
      break;
    case Pic24fFailure::RefusedErase:
      ExpectSecondAnswer(Row1);
      host_.Write({0x55, 0x55, 0x03, 0x01, 0x00, 0x00, 0x00, 0xFC, 0x04});
      EXPECT_TRUE(host_.IsSilent());
      ExpectThirdAnswer();
      break;
    case Pic24fFailure::UnknownIdentity:
      EXPECT_EQ(host_.Ask(AskIdentity, 13),
                (Bytes{0x55, 0x55, 0x01, 0x01, 0x00, 0x00, 0xFF, 0xFE, 0x7F, 0x00, 0x00, 0x82, 0x04}));
      break;
    case Pic24fFailure::UnpluggedInAnswer:
      EXPECT_EQ(host_.Ask(WriteRow1, Written.size()), Written);
      host_.Write(ReadRow1);
      ExpectLineToEnd(Header + Bytes{0x01});
      break;
    case Pic24fFailure::UnpluggedInWrite:
      EXPECT_EQ(SecondRow(), Repeated(32, Good) + Repeated(32, {0xFF, 0xFF, 0xFF, 0x00}));
      ExpectLineToEnd({});
      break;
  }
  EXPECT_THAT(loader_.HostFaults(), IsEmpty());
}

INSTANTIATE_TEST_SUITE_P(Every, FailureOfTheLoader, testing::ValuesIn(Pic24fFailures),
                         [](const testing::TestParamInfo<Pic24fFailureInfo>& failure) {
                           std::string name(failure.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

TEST(Pic24fFailures, NeedAPlaceThatExists) {
  for (const Pic24fFailureInfo& info : Pic24fFailures) {
    const Pic24fLoaderSettings settings{.Failure = info.Failure, .FailurePlace = 0};
    if (info.Place == FailurePlace::None) {
      EXPECT_NO_THROW(Pic24fLoader{settings}) << info.Name;
    } else {
      EXPECT_THROW(Pic24fLoader{settings}, std::invalid_argument) << info.Name;
    }
  }
}

}  // namespace
}  // namespace sim
