#include "sim/radio/RadioFailure.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

#include "sim/radio/RadioModem.h"
#include "tests/support/RadioLiterals.h"

namespace sim {
namespace {

using namespace wire;

GunCommand CommandUnder(const RadioFailureInfo& info) {
  return info.Failure == RadioFailure::TotalAbove270 ? GunCommand::Size
                                                     : info.Concerned.value_or(GunCommand::Search);
}

struct Exchange {
  Bytes Request;
  Bytes Answer;
};

/// What goes over the line without a failure.
Exchange Faultless(GunCommand command) {
  switch (command) {
    case GunCommand::Search:
      return {SearchRed2, FoundRed2};
    case GunCommand::Size:
      return {SizeRed2, SizedRed2};
    case GunCommand::Block:
      return {BlockRed2, GotRed2};
    case GunCommand::Close:
      break;
  }
  return {CloseRed2, ClosedRed2};
}

Bytes FirstHalf(const Bytes& frame) {
  return {frame.begin(), frame.begin() + static_cast<std::ptrdiff_t>(frame.size() / 2)};
}

const Bytes TransmitStatus{0x7E, 0x00, 0x03, 0x89, 0x00, 0x00, 0x76};
const Bytes ModemStatus{0x7E, 0x00, 0x02, 0x8A, 0x06, 0x6F};

// What red 2, struck by the failure, answers for the first time to the command that the failure concerns.
Bytes StruckAnswer(RadioFailure failure) {
  switch (failure) {
    case RadioFailure::None:
    case RadioFailure::TornFrames:
    case RadioFailure::StaleAnswer:  // there is no earlier one
      return FoundRed2;
    case RadioFailure::SilentGun:
    case RadioFailure::LostSize:
    case RadioFailure::LostBlock:
    case RadioFailure::LostClose:
    case RadioFailure::OtherSlot:
      return {};
    case RadioFailure::BadChecksum:
      return With(FoundRed2, 23, 0x40);
    case RadioFailure::OtherBlock:
      return {0x7E, 0x00, 0x16, 0x80, 0x00, 0x13, 0xA2, 0x00, 0x40, 0x7E, 0x0E, 0x22, 0x28,
              0x00, 0x06, 0x22, 0x00, 0x00, 0x05, 0x02, 0x03, 0x02, 0x01, 0x02, 0x03, 0x7A};
    case RadioFailure::DoubleAnswer:
      return FoundRed2 + FoundRed2;
    case RadioFailure::StatusFrames:
      return TransmitStatus + FoundRed2 + ModemStatus;
    case RadioFailure::CutFrames:
    case RadioFailure::HangUpInSearch:
      return FirstHalf(FoundRed2);
    case RadioFailure::HangUpInBlock:
      return FirstHalf(GotRed2);
    case RadioFailure::StartForChecksum:
      return With(FoundRed2, 23, 0x7E);
    case RadioFailure::LostChecksum:
      return Bytes(FoundRed2.begin(), FoundRed2.end() - 1) + FoundRed2;
    case RadioFailure::WrongCrc:
      return MadeGood(With(GotRed2, 22, 0xFE));
    case RadioFailure::Noise:
      return Bytes{0xFE, 0xF0, 0x7F} + FoundRed2;
    case RadioFailure::FalseStart:
      return Bytes{0xFE, 0x7E, 0x12} + FoundRed2;
    case RadioFailure::TotalZero:
      return {0x7E, 0x00, 0x14, 0x80, 0x00, 0x13, 0xA2, 0x00, 0x40, 0x7E, 0x0E, 0x22,
              0x28, 0x00, 0x04, 0x22, 0x00, 0x00, 0x05, 0x01, 0x00, 0x00, 0xD8, 0xB0};
    case RadioFailure::TotalAbove270:  // 255 bytes more; a real gun has 46 at least
      return {0x7E, 0x00, 0x14, 0x80, 0x00, 0x13, 0xA2, 0x00, 0x40, 0x7E, 0x0E, 0x22,
              0x28, 0x00, 0x04, 0x22, 0x00, 0x00, 0x05, 0x01, 0x03, 0x01, 0x63, 0x21};
    case RadioFailure::LowPlayerId:
      return {0x7E, 0x00, 0x14, 0x80, 0x00, 0x13, 0xA2, 0x00, 0x40, 0x7E, 0x0E, 0x22,
              0x28, 0x00, 0x04, 0x02, 0x00, 0x00, 0x07, 0x02, 0x0A, 0x55, 0x67, 0xDF};
    case RadioFailure::LongData: {
      Bytes frame = FoundRed2;
      frame.insert(frame.end() - 1, 291, 0xEE);
      frame[1] = 0x01;
      frame[2] = 0x37;
      frame.back() = 0x35;
      return frame;
    }
    case RadioFailure::LongPayload:
      return {0x7E, 0x00, 0x14, 0x80, 0x00, 0x13, 0xA2, 0x00, 0x40, 0x7E, 0x0E, 0x22,
              0x28, 0x00, 0xFF, 0x22, 0x00, 0x00, 0x07, 0x02, 0x0A, 0x55, 0x67, 0xC4};
    case RadioFailure::LongAtResponse:
      return Bytes{0x7E, 0x00, 0x23, 0x88, 0x01, 0x4E, 0x44, 0x00} + Bytes(30, 0xEE) + Bytes{0x00} +
             FoundRed2;
    case RadioFailure::NextFrameBegins:
      return FoundRed2 + Bytes{0x7E, 0x00, 0x14, 0x80, 0,    0,    0,    0,    0,    0,    0,
                               0,    0x28, 0x00, 0x04, 0x20, 0x00, 0x00, 0x05, 0x01, 0x00, 0x59};
  }
  return {};
}

class FailureByRadio : public testing::TestWithParam<RadioFailureInfo> {
 protected:
  static RadioModemSettings FieldUnder(RadioTroubleSettings trouble) {
    trouble.Failure = GetParam().Failure;
    return {.Guns = TwoGuns(), .Trouble = trouble, .LinePace = Pace::Fast};
  }

  static bool PullsOut() {
    return GetParam().Failure == RadioFailure::HangUpInSearch ||
           GetParam().Failure == RadioFailure::HangUpInBlock;
  }

  // A line that is pulled out takes bytes with it that the host had not read yet.
  static void ExpectPulledOut(RawHost& host, const Bytes& expected) {
    const Bytes heard = host.ReadUntilHangUp();
    EXPECT_TRUE(host.HungUp());
    EXPECT_LE(heard.size(), expected.size());
    EXPECT_TRUE(std::equal(heard.begin(), heard.end(), expected.begin()));
  }
};

TEST_P(FailureByRadio, ReachesTheHostAsItsNameSays) {
  RadioModem modem(FieldUnder({}));
  RawHost host(modem.DevicePath());
  host.Write(Faultless(CommandUnder(GetParam())).Request);
  const Bytes expected = StruckAnswer(GetParam().Failure);
  if (PullsOut()) {
    ExpectPulledOut(host, expected);
  } else {
    EXPECT_EQ(host.Read(expected.size()), expected);
    EXPECT_TRUE(host.IsSilent());
  }
}

TEST_P(FailureByRadio, StrikesNoMoreAnswersThanTold) {
  RadioModem modem(FieldUnder({.Times = 1}));
  RawHost host(modem.DevicePath());
  const GunCommand command = CommandUnder(GetParam());
  Bytes expected = StruckAnswer(GetParam().Failure);
  host.Write(Faultless(command).Request);
  if (PullsOut()) {
    ExpectPulledOut(host, expected);
    return;
  }
  EXPECT_EQ(host.Read(expected.size()), expected);
  host.Write(Faultless(command).Request);
  if (GetParam().Failure == RadioFailure::OtherSlot) {
    expected = FoundRed2 + FoundRed2;                              // the one kept back and its own
  } else if (GetParam().Failure != RadioFailure::TotalAbove270) {  // long scores do not shrink
    expected = Faultless(command).Answer;
  }
  EXPECT_EQ(host.Read(expected.size()), expected);
  EXPECT_TRUE(host.IsSilent());
}

TEST_P(FailureByRadio, GoesOnWhenNoNumberIsTold) {
  RadioModem modem(FieldUnder({}));
  RawHost host(modem.DevicePath());
  Bytes expected = StruckAnswer(GetParam().Failure);
  host.Write(Faultless(CommandUnder(GetParam())).Request);
  if (PullsOut()) {
    ExpectPulledOut(host, expected);
    return;
  }
  EXPECT_EQ(host.Read(expected.size()), expected);
  if (GetParam().Failure == RadioFailure::OtherSlot) {
    expected = FoundRed2;  // always the one kept back
  }
  for (int time = 2; time <= 3; ++time) {
    host.Write(Faultless(CommandUnder(GetParam())).Request);
    EXPECT_EQ(host.Read(expected.size()), expected);
  }
  EXPECT_TRUE(host.IsSilent());
}

TEST_P(FailureByRadio, SparesTheOtherGuns) {
  RadioModem modem(FieldUnder({.Gun = 2}));
  RawHost host(modem.DevicePath());
  for (const GunCommand command :
       {GunCommand::Search, GunCommand::Size, GunCommand::Block, GunCommand::Close}) {
    host.Write(Faultless(command).Request);
    EXPECT_EQ(host.Read(Faultless(command).Answer.size()), Faultless(command).Answer);
  }
  EXPECT_TRUE(host.IsSilent());
}

TEST_P(FailureByRadio, StrikesEveryGunWhenNoneIsNamed) {
  RadioModem modem(FieldUnder({.Gun = 0}));
  RawHost host(modem.DevicePath());
  host.Write(Faultless(CommandUnder(GetParam())).Request);
  const Bytes expected = StruckAnswer(GetParam().Failure);
  if (PullsOut()) {
    ExpectPulledOut(host, expected);
  } else {
    EXPECT_EQ(host.Read(expected.size()), expected);
    EXPECT_TRUE(host.IsSilent());
  }
}

INSTANTIATE_TEST_SUITE_P(Every, FailureByRadio, testing::ValuesIn(RadioFailures),
                         [](const testing::TestParamInfo<RadioFailureInfo>& failure) {
                           std::string name(failure.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

RadioModemSettings FieldOf(RadioFailure failure, std::size_t gun) {
  return {.Guns = TwoGuns(), .Trouble = {.Failure = failure, .Gun = gun}, .LinePace = Pace::Fast};
}

TEST(RadioFailures, StandInTheOrderOfTheirEnumerationUnderDistinctNames) {
  std::set<std::string_view> names;
  for (std::size_t i = 0; i < RadioFailures.size(); ++i) {
    EXPECT_EQ(static_cast<std::size_t>(RadioFailures[i].Failure), i);
    EXPECT_TRUE(names.insert(RadioFailures[i].Name).second) << RadioFailures[i].Name;
  }
  EXPECT_EQ(RadioFailures.back().Failure, RadioFailure::NextFrameBegins);
}

TEST(RadioFailures, PutAnAnswerIntoTheSlotOfAGunThatIsNotThere) {
  RadioModem modem(FieldOf(RadioFailure::OtherSlot, 1));
  RawHost host(modem.DevicePath());
  host.Write(SearchRed2);
  EXPECT_TRUE(host.IsSilent());
  host.Write(SearchRed3);
  EXPECT_EQ(host.Read(FoundRed2.size()), FoundRed2);
  EXPECT_TRUE(host.IsSilent());
}

TEST(RadioFailures, SwapTheTwoBlocksOfAGun) {
  RadioModem modem(FieldOf(RadioFailure::OtherBlock, 2));
  RawHost host(modem.DevicePath());
  host.Write(BlockBlue0First);
  EXPECT_EQ(host.Read(GotBlue0Last.size()), GotBlue0Last);
  host.Write(MadeGood(With(With(BlockBlue0First, 20, 45), 21, 45)));
  EXPECT_EQ(host.Read(68).at(20), 0);  // start offset of the answer
}

TEST(RadioFailures, RepeatTheAnswerBefore) {
  RadioModem modem(FieldOf(RadioFailure::StaleAnswer, 1));
  RawHost host(modem.DevicePath());
  for (const auto& [request, answer] : {std::pair{SearchRed2, FoundRed2}, std::pair{SizeRed2, FoundRed2},
                                        std::pair{BlockRed2, SizedRed2}, std::pair{CloseRed2, GotRed2}}) {
    host.Write(request);
    EXPECT_EQ(host.Read(answer.size()), answer);
  }
}

TEST(RadioFailures, SpoilTheFirstBlockAlone) {
  RadioModem modem(FieldOf(RadioFailure::WrongCrc, 2));
  RawHost host(modem.DevicePath());
  host.Write(BlockBlue0Last);
  EXPECT_EQ(host.Read(GotBlue0Last.size()), GotBlue0Last);
  host.Write(BlockBlue0First);
  EXPECT_EQ(host.Read(GotBlue0First.size()), MadeGood(With(GotBlue0First, 22, 0xFF)));
}

TEST(RadioFailures, GiveTheBlocksOfScoresThatAreTooLong) {
  RadioModem modem(FieldOf(RadioFailure::TotalAbove270, 1));
  RawHost host(modem.DevicePath());
  host.Write(MadeGood(With(With(BlockRed2, 20, 180), 21, 2)));
  const Bytes block = host.Read(25);
  ASSERT_EQ(block.size(), 25U);
  EXPECT_EQ(Bytes(block.begin() + 19, block.begin() + 24), (Bytes{2, 180, 1, 0xEE, 0xEE}));
}

TEST(RadioFailures, StrikeEachGunAsOftenAsTold) {
  RadioModemSettings settings = FieldOf(RadioFailure::SilentGun, 0);
  settings.Trouble.Times = 1;
  RadioModem modem(settings);
  RawHost host(modem.DevicePath());
  host.Write(SearchRed2 + SearchBlue0);
  EXPECT_TRUE(host.IsSilent());
  host.Write(SearchBlue0 + SearchRed2);
  EXPECT_EQ(host.Read(FoundBlue0.size() + FoundRed2.size()), FoundBlue0 + FoundRed2);
}

}  // namespace
}  // namespace sim
