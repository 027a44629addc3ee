#include "sim/baseunit/BaseUnit.h"

#include <gtest/gtest.h>

#include <atomic>
#include <future>
#include <optional>
#include <sstream>
#include <utility>

#include "sim/game/GameMaker.h"
#include "tests/support/RawHost.h"

namespace sim {
namespace {

using SteadyClock = std::chrono::steady_clock;

const Bytes Request{1, 0};
const Bytes Accept{170};
const Bytes Reject{0};

// Written by hand: red 0 who did nothing, and blue 2 with two hits.
const Bytes Red0{0x2E, 0, 0x29, 0, 0x20, 0x12, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0,   0,
                 0,    0, 0,    0, 0,    0,    0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0x6C};
const Bytes Blue2{0x34, 0x00, 0x29, 0x00, 0x42, 0x12, 0x01, 0x23, 0x00, 0x04, 0x00, 0x05, 0x00, 0x06,
                  0x00, 0x07, 0x00, 0x08, 0x01, 0x02, 0x00, 0x0A, 0x00, 0x0B, 0x01, 0x23, 0x45, 0x67,
                  0x89, 0xAB, 0xCD, 0xEF, 0x00, 0x64, 0x00, 0x03, 0x00, 0x1E, 0x00, 0x32, 0x00, 0x19,
                  0x01, 0x10, 0x80, 0x02, 0x21, 0x2C, 0x01, 0xFF, 0xFF, 0x7F, 0xE1};

BaseUnitSettings TwoFrames() {
  return {.Answer = {.Count = 2, .Frames = {Blue2, Red0}}, .LinePace = Pace::Fast};
}

TEST(BaseUnit, SendsTheCountAndThenAFrameForEachReply) {
  BaseUnit unit(TwoFrames());
  RawHost host(unit.DevicePath());
  host.Write(Request);
  EXPECT_EQ(host.Read(1), Bytes{2});
  EXPECT_EQ(host.Read(Blue2.size()), Blue2);
  EXPECT_TRUE(host.IsSilent());
  host.Write(Accept);
  EXPECT_EQ(host.Read(Red0.size()), Red0);
  EXPECT_TRUE(host.IsSilent());
  host.Write(Accept);
  EXPECT_TRUE(unit.WaitUntilServed(1, Limit));
  EXPECT_TRUE(host.IsSilent());
}

TEST(BaseUnit, GoesOnWithTheNextFrameAfterARejection) {
  BaseUnit unit(TwoFrames());
  RawHost host(unit.DevicePath());
  host.Write(Request);
  EXPECT_EQ(host.Read(1 + Blue2.size()).size(), 1 + Blue2.size());
  host.Write(Reject);
  EXPECT_EQ(host.Read(Red0.size()), Red0);
  host.Write(Reject);
  EXPECT_TRUE(unit.WaitUntilServed(1, Limit));
  EXPECT_EQ(unit.LatestExchange().Replies, (Bytes{0, 0}));
}

TEST(BaseUnit, TellsWhatHasPassedTheLine) {
  BaseUnit unit(TwoFrames());
  RawHost host(unit.DevicePath());
  host.Write(Request);
  host.Read(1 + Blue2.size());
  host.Write(Accept);
  host.Read(Red0.size());
  host.Write(Reject);
  ASSERT_TRUE(unit.WaitUntilServed(1, Limit));
  const BaseUnitExchange exchange = unit.LatestExchange();
  Bytes sent{2};
  sent.insert(sent.end(), Blue2.begin(), Blue2.end());
  sent.insert(sent.end(), Red0.begin(), Red0.end());
  EXPECT_EQ(exchange.Sent, sent);
  EXPECT_EQ(exchange.Frames, (std::vector<Bytes>{Blue2, Red0}));
  EXPECT_EQ(exchange.Replies, (Bytes{170, 0}));
}

TEST(BaseUnit, AnswersNothingButTheTwoBytesOfARequestInOrder) {
  BaseUnit unit(TwoFrames());
  RawHost host(unit.DevicePath());
  host.Write({0, 170, 1, 5, 0, 255, 0, 1});
  EXPECT_TRUE(host.IsSilent());
  host.Write({1, 0});
  EXPECT_EQ(host.Read(1), Bytes{2});
}

TEST(BaseUnit, TakesNoOtherByteForAReply) {
  BaseUnit unit(TwoFrames());
  RawHost host(unit.DevicePath());
  host.Write(Request);
  host.Read(1 + Blue2.size());
  host.Write({7, 0xAB, 0xFF, 1});
  EXPECT_TRUE(host.IsSilent());
  host.Write(Accept);
  EXPECT_EQ(host.Read(Red0.size()), Red0);
}

TEST(BaseUnit, BeginsAgainWhenTheHostAsksAnewInsteadOfReplying) {
  BaseUnit unit(TwoFrames());
  RawHost host(unit.DevicePath());
  host.Write(Request);
  host.Read(1 + Blue2.size());
  host.Write(Request);
  EXPECT_EQ(host.Read(1), Bytes{2});
  EXPECT_EQ(host.Read(Blue2.size()), Blue2);
  host.Write(Accept);
  EXPECT_EQ(host.Read(Red0.size()), Red0);
  host.Write(Accept);
  EXPECT_TRUE(unit.WaitUntilServed(2, Limit));
  EXPECT_EQ(unit.LatestExchange().Replies, (Bytes{170, 170}));
}

TEST(BaseUnit, GivesTheSameScoresAgainToAHostThatComesBack) {
  BaseUnit unit(TwoFrames());
  for (int download = 1; download <= 3; ++download) {
    RawHost host(unit.DevicePath());
    host.Write(Request);
    EXPECT_EQ(host.Read(1), Bytes{2});
    EXPECT_EQ(host.Read(Blue2.size()), Blue2);
    host.Write(Accept);
    EXPECT_EQ(host.Read(Red0.size()), Red0);
    host.Write(Accept);
    EXPECT_TRUE(unit.WaitUntilServed(download, Limit));
  }
}

TEST(BaseUnit, HandsOverTheNextGameOnceItHasEnded) {
  std::atomic_bool hasEnded = false;
  BaseUnitSettings settings = TwoFrames();
  settings.NextAnswer = [&hasEnded]() -> std::optional<BaseUnitAnswer> {
    return hasEnded.exchange(false) ? std::optional(BaseUnitAnswer{.Count = 1, .Frames = {Red0}})
                                    : std::nullopt;
  };
  BaseUnit unit(std::move(settings));
  RawHost host(unit.DevicePath());
  host.Write(Request);
  EXPECT_EQ(host.Read(1 + Blue2.size()).front(), 2);
  hasEnded = true;  // in the middle of a pull
  host.Write(Accept);
  EXPECT_EQ(host.Read(Red0.size()), Red0);
  host.Write(Accept);
  ASSERT_TRUE(unit.WaitUntilServed(1, Limit));
  for (int download = 2; download <= 3; ++download) {
    host.Write(Request);
    EXPECT_EQ(host.Read(1), Bytes{1});
    EXPECT_EQ(host.Read(Red0.size()), Red0);
    host.Write(Accept);
    ASSERT_TRUE(unit.WaitUntilServed(download, Limit));
  }
}

TEST(BaseUnit, SaysZeroWhenThereAreNoScores) {
  BaseUnit unit({.Answer = MakeBaseUnitAnswer({}), .LinePace = Pace::Fast});
  RawHost host(unit.DevicePath());
  host.Write(Request);
  EXPECT_EQ(host.Read(1), Bytes{0});
  EXPECT_TRUE(unit.WaitUntilServed(1, Limit));
  EXPECT_TRUE(host.IsSilent());
}

TEST(BaseUnit, HandsOverAFullField) {
  const BaseUnitAnswer answer = MakeBaseUnitAnswer(MakeGame(224, 9));
  BaseUnit unit({.Answer = answer, .LinePace = Pace::Fast});
  RawHost host(unit.DevicePath());
  host.Write(Request);
  EXPECT_EQ(host.Read(1), Bytes{224});
  for (const Bytes& frame : answer.Frames) {
    ASSERT_EQ(host.Read(frame.size()), frame);
    host.Write(Accept);
  }
  EXPECT_TRUE(unit.WaitUntilServed(1, Limit));
  EXPECT_EQ(unit.LatestExchange().Frames, answer.Frames);
}

TEST(BaseUnit, SendsNoFasterThanItsBaudRate) {
  BaseUnitSettings settings = TwoFrames();
  settings.LinePace = Pace::AsWired;
  BaseUnit unit(settings);
  RawHost host(unit.DevicePath());
  const SteadyClock::time_point start = SteadyClock::now();
  host.Write(Request);
  host.Read(1 + Blue2.size());
  host.Write(Accept);
  host.Read(Red0.size());
  // Request, count, two frames and a reply at 19200 bits a second, ten bits each.
  const double bytes = static_cast<double>(2 + 1 + Blue2.size() + Red0.size() + 1);
  EXPECT_GE(SteadyClock::now() - start, std::chrono::duration<double>(bytes * 10.0 / 19200.0));
}

TEST(BaseUnit, PausesBetweenThePiecesOfATornAnswer) {
  BaseUnitSettings settings = TwoFrames();
  settings.Answer.Torn = true;
  BaseUnit unit(settings);
  RawHost host(unit.DevicePath());
  const SteadyClock::time_point start = SteadyClock::now();
  host.Write(Request);
  EXPECT_EQ(host.Read(1), Bytes{2});
  EXPECT_EQ(host.Read(Blue2.size()), Blue2);
  // At most three bytes between two pauses of 3 ms.
  EXPECT_GE(SteadyClock::now() - start, std::chrono::milliseconds(Blue2.size() / 3 * 3));
}

TEST(BaseUnit, EndsTheLineAfterTheRequestsItWasToServe) {
  std::promise<void> finished;
  BaseUnitSettings settings = TwoFrames();
  settings.Answer = MakeBaseUnitAnswer({});
  settings.Requests = 2;
  settings.OnFinished = [&] { finished.set_value(); };
  BaseUnit unit(settings);
  std::future<void> end = finished.get_future();
  std::optional<RawHost> host(unit.DevicePath());
  host->Write(Request);
  EXPECT_EQ(host->Read(1), Bytes{0});
  EXPECT_TRUE(unit.WaitUntilServed(1, Limit));
  EXPECT_EQ(end.wait_for(std::chrono::milliseconds(50)), std::future_status::timeout);
  host->Write(Request);
  EXPECT_EQ(host->Read(1), Bytes{0});
  EXPECT_EQ(end.wait_for(std::chrono::milliseconds(50)), std::future_status::timeout);
  EXPECT_FALSE(host->HungUp());
  host.reset();
  EXPECT_EQ(end.wait_for(Limit), std::future_status::ready);
}

TEST(BaseUnit, StopsInTheMiddleOfAnAnswerWhenItIsDestroyed) {
  std::optional<BaseUnit> unit(std::in_place,
                               BaseUnitSettings{.Answer = MakeBaseUnitAnswer(MakeGame(224, 1))});
  RawHost host(unit->DevicePath());
  host.Write(Request);
  EXPECT_EQ(host.Read(3).size(), 3U);
  unit.reset();
  EXPECT_LT(host.ReadUntilHangUp().size(), MakeBaseUnitAnswer(MakeGame(224, 1)).Frames[0].size());
  EXPECT_TRUE(host.HungUp());
}

TEST(BaseUnit, WaitsNoLongerThanToldForARequestToBeServed) {
  const BaseUnit unit(TwoFrames());
  EXPECT_FALSE(unit.WaitUntilServed(1, std::chrono::milliseconds(10)));
}

TEST(BaseUnit, LogsBothDirections) {
  std::ostringstream log;
  {
    BaseUnitSettings settings = TwoFrames();
    settings.Answer = {.Count = 1, .Frames = {Red0}};
    settings.Log = &log;
    BaseUnit unit(settings);
    RawHost host(unit.DevicePath());
    host.Write({9, 1, 0});
    host.Read(1 + Red0.size());
    host.Write({8, 170});
    EXPECT_TRUE(unit.WaitUntilServed(1, Limit));
  }
  std::string frame = "2E 00 29 00 20 12";
  for (int i = 0; i < 40; ++i) {
    frame += " 00";
  }
  std::vector<std::string> rows;
  std::istringstream lines(log.str());
  for (std::string line; std::getline(lines, line);) {
    rows.push_back(line.substr(line.find("base-unit")));
  }
  EXPECT_EQ(rows,
            (std::vector<std::string>{"base-unit <- 09 ignored", "base-unit <- 01", "base-unit <- 00 request",
                                      "base-unit -> 01", "base-unit -> " + frame + " 6C",
                                      "base-unit <- 08 ignored", "base-unit <- AA accepted"}));
}

TEST(BaseUnit, CopiesTheFramesAsTheyWentOut) {
  std::ostringstream frames;
  {
    BaseUnitSettings settings = TwoFrames();
    settings.Frames = &frames;
    settings.Answer.CutAfter = 1 + Blue2.size() + 5;
    BaseUnit unit(settings);
    RawHost host(unit.DevicePath());
    host.Write(Request);
    host.Read(1 + Blue2.size());
    host.Write(Accept);
    EXPECT_EQ(host.Read(5).size(), 5U);
    EXPECT_TRUE(unit.WaitUntilServed(1, Limit));
  }
  std::string expected(Blue2.begin(), Blue2.end());
  expected.append(Red0.begin(), Red0.begin() + 5);
  EXPECT_EQ(frames.str(), expected);
}

}  // namespace
}  // namespace sim
