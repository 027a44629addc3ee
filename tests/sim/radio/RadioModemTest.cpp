#include "sim/radio/RadioModem.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <future>
#include <optional>
#include <sstream>

#include "sim/game/GameMaker.h"
#include "sim/game/ScoreFrame.h"
#include "sim/radio/RadioAnswer.h"
#include "tests/support/RadioLiterals.h"

namespace sim {
namespace {

using namespace wire;
using SteadyClock = std::chrono::steady_clock;

RadioModemSettings Field() {
  return {.Guns = TwoGuns(), .LinePace = Pace::Fast};
}

std::chrono::duration<double> WireTime(std::size_t bytes) {
  return std::chrono::duration<double>(static_cast<double>(bytes) * 10.0 / 57600.0);
}

// A client's four requests, byte for byte.
Bytes RequestTo(const RadioGun& gun, const Bytes& payload) {
  Bytes frame{0x7E, 0, 0, 0, 0};
  for (int byte = 7; byte >= 0; --byte) {
    frame.push_back(static_cast<std::uint8_t>(gun.Address >> (8 * byte) & 0xFF));
  }
  frame.push_back(0);
  frame =
      frame + Bytes{static_cast<std::uint8_t>(payload.size()), gun.PlayerId, 0, 0, 4} + payload + Bytes{0};
  return MadeGood(frame);
}

TEST(RadioModem, AnswersASearchForAGunThatIsThere) {
  RadioModem modem(Field());
  RawHost host(modem.DevicePath());
  host.Write(SearchRed2);
  EXPECT_EQ(host.Read(FoundRed2.size()), FoundRed2);
  host.Write(SearchBlue0);
  EXPECT_EQ(host.Read(FoundBlue0.size()), FoundBlue0);
  EXPECT_TRUE(host.IsSilent());
}

TEST(RadioModem, LeavesASearchForAnAbsentGunUnanswered) {
  RadioModem modem(Field());
  RawHost host(modem.DevicePath());
  host.Write(SearchRed3);
  EXPECT_TRUE(host.IsSilent());
  ASSERT_TRUE(modem.WaitUntilAsked(1, Limit));
  EXPECT_EQ(modem.Traffic().Requests,
            std::vector<GunRequest>{(GunRequest{.Command = GunCommand::Search, .PlayerId = 0x23})});
  EXPECT_TRUE(modem.Traffic().Faults.empty());
}

TEST(RadioModem, AnswersTheThreeCommands) {
  RadioModem modem(Field());
  RawHost host(modem.DevicePath());
  host.Write(SizeRed2);
  EXPECT_EQ(host.Read(SizedRed2.size()), SizedRed2);
  host.Write(BlockRed2);
  EXPECT_EQ(host.Read(GotRed2.size()), GotRed2);
  host.Write(CloseRed2);
  EXPECT_EQ(host.Read(ClosedRed2.size()), ClosedRed2);
}

TEST(RadioModem, GivesAnyBlockOfTheScoresAnyTime) {
  RadioModem modem(Field());
  RawHost host(modem.DevicePath());
  for (int round = 1; round <= 2; ++round) {
    host.Write(BlockBlue0Last);
    EXPECT_EQ(host.Read(GotBlue0Last.size()), GotBlue0Last);
    host.Write(BlockBlue0First);
    EXPECT_EQ(host.Read(GotBlue0First.size()), GotBlue0First);
    host.Write(CloseBlue0);
    EXPECT_EQ(host.Read(ClosedBlue0.size()), ClosedBlue0);
  }
}

TEST(RadioModem, CountsWhatTheHostMustNotSendAndDoesNotAnswerIt) {
  const std::vector<std::pair<Bytes, std::string>> bad{
      {With(SearchRed2, 19, 0), "a wrong checksum"},
      {MadeGood(With(SearchRed2, 3, 0x10)), "an API identifier other than 0"},
      {MadeGood(With(SearchRed2, 4, 1)), "a frame identifier other than 0"},
      {MadeGood(With(SearchRed2, 13, 8)), "options other than 0"},
      {{0x7D}, "a byte outside a frame"},
      {{0x7E, 0x10, 0x00}, "a length that no transmit request has"},
      {MadeGood(With(With(SearchRed2, 11, 0), 12, 0)), "a search to a single address"},
      {MadeGood(With(SizeRed2, 12, 0x23)), "an address that no gun has"},
      {MadeGood(With(SizeRed2, 15, 0x40)), "another gun's player id"},
      {MadeGood(With(BlockRed2, 21, 4)), "a block beyond the scores"},
  };
  std::vector<std::string> expected;
  RadioModem modem(Field());
  RawHost host(modem.DevicePath());
  for (const auto& [bytes, fault] : bad) {
    expected.push_back(fault);
    host.Write(bytes);
    ASSERT_TRUE(modem.WaitUntilAsked(expected.size(), Limit)) << fault;
  }
  EXPECT_TRUE(host.IsSilent());
  EXPECT_EQ(modem.Traffic().Faults, expected);
  EXPECT_TRUE(modem.Traffic().Requests.empty());
  host.Write(SearchRed2);
  EXPECT_EQ(host.Read(FoundRed2.size()), FoundRed2);
}

TEST(RadioModem, CountsTheBytesOfBothDirections) {
  RadioModem modem(Field());
  RawHost host(modem.DevicePath());
  host.Write(SearchRed3 + SearchRed2 + BlockRed2);
  host.Read(FoundRed2.size() + GotRed2.size());
  ASSERT_TRUE(modem.WaitUntilAsked(3, Limit));
  EXPECT_EQ(modem.Traffic().BytesFromHost, 20U + 20U + 23U);
  EXPECT_TRUE(host.IsSilent());
  EXPECT_EQ(modem.Traffic().BytesToHost, 24U + 26U);
}

TEST(RadioModem, HandsOverEveryScoreFrameOfAFullField) {
  const std::vector<GunScores> game = MakeGame(224, 9);
  const std::vector<RadioGun> guns = MakeRadioGuns(game, std::chrono::microseconds(0));
  RadioModem modem({.Guns = guns, .LinePace = Pace::Fast});
  RawHost host(modem.DevicePath());
  for (const RadioGun& gun : guns) {
    host.Write(RequestTo(gun, {1}));
    const Bytes size = host.Read(24);
    ASSERT_EQ(size.size(), 24U);
    const std::size_t total = size[20] + size[21] * 255U;
    Bytes frame;
    while (frame.size() < total) {
      const std::size_t count = std::min<std::size_t>(90, total - frame.size());
      host.Write(
          RequestTo(gun, {2, static_cast<std::uint8_t>(frame.size()), static_cast<std::uint8_t>(count)}));
      const Bytes block = host.Read(count + 23);
      ASSERT_EQ(block.size(), count + 23);
      frame.insert(frame.end(), block.begin() + 22, block.end() - 1);
    }
    frame.push_back(size[22]);
    EXPECT_EQ(frame, gun.Frame);
  }
  EXPECT_TRUE(modem.Traffic().Faults.empty());
}

TEST(RadioModem, AnswersNoFasterThanWireAndGunAllow) {
  RadioModemSettings settings{.Guns = TwoGuns()};
  settings.Guns[0].AnswerTime = std::chrono::milliseconds(30);
  RadioModem modem(settings);
  RawHost host(modem.DevicePath());
  const SteadyClock::time_point start = SteadyClock::now();
  host.Write(SearchRed2);
  EXPECT_EQ(host.Read(FoundRed2.size()), FoundRed2);
  EXPECT_GE(SteadyClock::now() - start,
            std::chrono::milliseconds(30) + WireTime(SearchRed2.size() + FoundRed2.size()));
}

TEST(RadioModem, HearsRequestsWhileAnAnswerIsDue) {
  RadioModemSettings settings = Field();
  settings.Guns[0].AnswerTime = std::chrono::milliseconds(300);
  RadioModem modem(settings);
  RawHost host(modem.DevicePath());
  host.Write(SearchRed2);
  host.Write(SearchBlue0);
  EXPECT_EQ(host.Read(FoundBlue0.size() + FoundRed2.size()), FoundBlue0 + FoundRed2);
}

TEST(RadioModem, ServesAHostThatComesBack) {
  RadioModem modem(Field());
  for (int visit = 1; visit <= 3; ++visit) {
    RawHost host(modem.DevicePath());
    host.Write(SearchRed2);
    EXPECT_EQ(host.Read(FoundRed2.size()), FoundRed2);
  }
}

TEST(RadioModem, StopsInTheMiddleOfAnAnswerWhenItIsDestroyed) {
  std::optional<RadioModem> modem(std::in_place, RadioModemSettings{.Guns = TwoGuns()});
  RawHost host(modem->DevicePath());
  host.Write(BlockBlue0First);
  EXPECT_EQ(host.Read(1), Bytes{0x7E});
  modem.reset();
  EXPECT_LT(host.ReadUntilHangUp().size(), GotBlue0First.size() - 1);
  EXPECT_TRUE(host.HungUp());
}

TEST(RadioModem, WaitsNoLongerThanToldForRequests) {
  const RadioModem modem(Field());
  EXPECT_FALSE(modem.WaitUntilAsked(1, std::chrono::milliseconds(10)));
}

TEST(RadioModem, LogsBothDirections) {
  std::ostringstream log;
  {
    RadioModemSettings settings = Field();
    settings.Log = &log;
    RadioModem modem(settings);
    RawHost host(modem.DevicePath());
    host.Write(Bytes{0x41} + SearchRed2);
    host.Read(FoundRed2.size());
  }
  std::vector<std::string> rows;
  std::istringstream lines(log.str());
  for (std::string line; std::getline(lines, line);) {
    rows.push_back(line.substr(line.find("radio-modem")));
  }
  EXPECT_EQ(rows, (std::vector<std::string>{
                      "radio-modem <- 41 fault: a byte outside a frame",
                      "radio-modem <- 7E 00 10 00 00 00 00 00 00 00 00 FF FF 00 00 22 00 00 06 D9 search 34",
                      "radio-modem -> 7E 00 14 80 00 13 A2 00 40 7E 0E 22 28 00 04 22 00 00 07 02 0A 55 67 "
                      "BF"}));
}

TEST(RadioModem, CopiesTheScoresOfEachGunOnceWhenTheyAreClosed) {
  std::ostringstream frames;
  RadioModemSettings settings = Field();
  settings.Frames = &frames;
  {
    RadioModem modem(settings);
    RawHost host(modem.DevicePath());
    host.Write(BlockRed2 + CloseBlue0 + CloseRed2 + CloseBlue0);
    ASSERT_TRUE(modem.WaitUntilAsked(4, Limit));
  }
  const Bytes expected = TwoGuns()[1].Frame + TwoGuns()[0].Frame;
  EXPECT_EQ(frames.str(), std::string(expected.begin(), expected.end()));
}

// A field whose next game is played with Red 2 alone, once it has ended.
RadioModemSettings FieldOfTwoGames(std::atomic_bool& hasEnded) {
  RadioModemSettings settings = Field();
  settings.NextGuns = [&hasEnded]() -> std::optional<std::vector<RadioGun>> {
    std::vector<RadioGun> next = TwoGuns();
    std::erase_if(next, [](const RadioGun& gun) { return gun.PlayerId != 0x22; });
    return hasEnded.exchange(false) ? std::optional(next) : std::nullopt;
  };
  return settings;
}

TEST(RadioModem, HandsOverTheNextGameFromTheNextSearchOn) {
  std::atomic_bool hasEnded = true;
  RadioModem modem(FieldOfTwoGames(hasEnded));
  RawHost host(modem.DevicePath());
  host.Write(CloseBlue0);
  EXPECT_EQ(host.Read(ClosedBlue0.size()), ClosedBlue0);
  host.Write(SearchRed2);
  EXPECT_EQ(host.Read(FoundRed2.size()), FoundRed2);
  host.Write(SearchBlue0);
  EXPECT_TRUE(host.IsSilent());
}

TEST(RadioModem, HandsOverNoOtherGameInTheMiddleOfASearch) {
  std::atomic_bool hasEnded = false;
  RadioModem modem(FieldOfTwoGames(hasEnded));
  RawHost host(modem.DevicePath());
  host.Write(SearchRed2);
  EXPECT_EQ(host.Read(FoundRed2.size()), FoundRed2);
  hasEnded = true;
  host.Write(SearchBlue0 + CloseBlue0);
  EXPECT_EQ(host.Read(FoundBlue0.size()), FoundBlue0);
  EXPECT_EQ(host.Read(ClosedBlue0.size()), ClosedBlue0);
  host.Write(SearchBlue0);
  EXPECT_TRUE(host.IsSilent());
}

TEST(RadioModem, RefusesTroubleForAGunThatIsNotThere) {
  RadioModemSettings settings = Field();
  settings.Trouble = {.Failure = RadioFailure::SilentGun, .Gun = 3};
  EXPECT_THROW(RadioModem modem(settings), std::invalid_argument);
  settings.Trouble = {.Failure = RadioFailure::None, .Gun = 3};
  EXPECT_NO_THROW(RadioModem modem(settings));
}

}  // namespace
}  // namespace sim
