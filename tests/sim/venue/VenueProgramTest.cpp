#include "tests/sim/venue/VenueProgram.h"

#include <gmock/gmock.h>
#include <signal.h>

#include <span>

#include "sim/game/Evening.h"
#include "sim/game/GameMaker.h"
#include "sim/line/Crc.h"
#include "tests/support/AdapterHost.h"

namespace sim {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;

// Pulls a game, whichever it is.
std::vector<Bytes> Pull(const std::string& device) {
  std::vector<Bytes> frames;
  RawHost host(device);
  host.Write({1, 0});
  for (int left = host.Read(1).at(0); left > 0; --left) {
    Bytes frame = host.Read(2);
    const Bytes rest = host.Read(frame.at(0) + 256U * frame.at(1) - 1U);
    frame.insert(frame.end(), rest.begin(), rest.end());
    frames.push_back(frame);
    host.Write({170});
  }
  return frames;
}

TEST_F(VenueProgram, ServesTheGameOfItsSeedAndExitsAfterItsGames) {
  const BaseUnitAnswer answer = MakeBaseUnitAnswer(MakeGame(12, 77));
  VenueProcess venue({"--players", "12", "--seed", "77", "--fast", "--games", "2"});
  const std::string device = venue.ReadDevice();
  Download(device, answer);
  Download(device, answer);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_EQ(venue.RestOfErrors(), "");
}

TEST_F(VenueProgram, ServesFortyPlayersAtTheSpeedOfTheLineUnlessTold) {
  VenueProcess venue({});
  RawHost host(venue.ReadDevice());
  const auto start = std::chrono::steady_clock::now();
  host.Write({1, 0});
  EXPECT_EQ(host.Read(1), Bytes{40});
  const Bytes frame = MakeBaseUnitAnswer(MakeGame(40, 1)).Frames[0];
  EXPECT_EQ(host.Read(frame.size()), frame);
  const double bytes = static_cast<double>(3 + frame.size());
  EXPECT_GE(std::chrono::steady_clock::now() - start, std::chrono::duration<double>(bytes * 10.0 / 19200.0));
}

TEST_F(VenueProgram, CopiesFramesAndLogsTheLine) {
  const BaseUnitAnswer answer = MakeBaseUnitAnswer(MakeGame(3, 1), BaseUnitFailure::WrongCrc, 2);
  VenueProcess venue({"--players", "3", "--fast", "--games", "1", "--failure", "wrong-crc", "--at", "2",
                      "--frames", File("frames"), "--log", File("log")});
  Download(venue.ReadDevice(), answer);
  EXPECT_EQ(venue.WaitForExit(), 0);
  std::string expected;
  for (const Bytes& frame : answer.Frames) {
    expected.append(frame.begin(), frame.end());
  }
  EXPECT_EQ(Content(File("frames")), expected);
  EXPECT_THAT(Content(File("log")), HasSubstr("base-unit <- 01\n"));
  EXPECT_THAT(Content(File("log")), HasSubstr("base-unit -> 03\n"));
  EXPECT_THAT(Content(File("log")), HasSubstr("base-unit <- AA accepted\n"));
}

TEST_F(VenueProgram, LinksTheDeviceUntilItsEnd) {
  VenueProcess venue({"--fast", "--players", "0", "--link", File("port")});
  const std::string device = venue.ReadDevice();
  EXPECT_EQ(fs::read_symlink(File("port")), device);
  Download(File("port"), MakeBaseUnitAnswer({}));
  venue.Signal(SIGTERM);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_FALSE(fs::is_symlink(fs::symlink_status(File("port"))));
}

TEST_F(VenueProgram, ExitsCleanlyOnSignalsEvenInTheMiddleOfAnAnswer) {
  for (const int signal : {SIGTERM, SIGINT, SIGHUP}) {
    VenueProcess venue({"--players", "224"});
    RawHost host(venue.ReadDevice());
    host.Write({1, 0});
    EXPECT_EQ(host.Read(2).size(), 2U);
    venue.Signal(signal);
    EXPECT_EQ(venue.WaitForExit(), 0) << "signal " << signal;
  }
}

TEST_F(VenueProgram, ExitsAtTheEndOfItsInputWhenTold) {
  VenueProcess venue({"--fast", "--until-eof"});
  venue.ReadDevice();
  EXPECT_TRUE(venue.IsRunning());
  venue.CloseInput();
  EXPECT_EQ(venue.WaitForExit(), 0);
}

TEST_F(VenueProgram, DoesNotCareForItsInputUnlessTold) {
  VenueProcess venue({"--fast", "--players", "2"});
  venue.CloseInput();
  Download(venue.ReadDevice(), MakeBaseUnitAnswer(MakeGame(2, 1)));
  EXPECT_TRUE(venue.IsRunning());
}

TEST_F(VenueProgram, ExitsWhenItsLineHasBeenPulledOut) {
  VenueProcess venue({"--fast", "--failure", "hang-up", "--at", "1", "--link", File("port")});
  RawHost host(venue.ReadDevice());
  host.Write({1, 0});
  host.ReadUntilHangUp();
  EXPECT_TRUE(host.HungUp());
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_FALSE(fs::is_symlink(fs::symlink_status(File("port"))));
}

TEST_F(VenueProgram, DoesNotAnswerAHostAtOtherSettingsAndTellsSo) {
  const BaseUnitAnswer answer = MakeBaseUnitAnswer(MakeGame(2, 1));
  for (const std::vector<std::string>& pace : {std::vector<std::string>{}, {"--fast"}}) {
    std::vector<std::string> arguments{"--players", "2", "--log", File("log")};
    arguments.insert(arguments.end(), pace.begin(), pace.end());
    VenueProcess venue(arguments);
    const std::string device = venue.ReadDevice();
    RawHost host(device);
    host.Speak({.Baud = 9600, .DataBits = 7, .Parity = 'E', .StopBits = 2});
    const std::string heard = Text(host.Settings());
    host.Write({1, 0});
    EXPECT_TRUE(AwaitContent(File("log"), "fault: the host speaks " + heard));
    EXPECT_TRUE(host.IsSilent());
    host.Speak({.Baud = 19200});
    Download(device, answer);
    venue.Signal(SIGTERM);
    EXPECT_EQ(venue.WaitForExit(), 0);
    EXPECT_EQ(venue.RestOfErrors(), "base unit: the host speaks " + heard +
                                        " instead of 19200,8N1\nbase unit: faults of the host: 1\n");
  }
}

TEST_F(VenueProgram, ServesOthersWithoutTheBaseUnitWhenTold) {
  VenueProcess venue({"--fast", "--no-base-unit", "--onewire"});
  AdapterHost host(venue.ReadDevice("1-wire adapter"));
  EXPECT_EQ(host.Ask({0x17}, 1), Bytes{0x16});
  venue.Signal(SIGTERM);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_EQ(venue.RestOfOutput(), "");
}

TEST_F(VenueProgram, RefusesBadOptionsWithAMessage) {
  const std::vector<std::vector<std::string>> refused{
      {"--players", "225"},
      {"--failure", "fire"},
      {"--nonsense"},
      {"--evening", "86401"},
      {"--failure", "wrong-crc", "--at", "41"},
      {"--failure", "wrong-crc", "--at", "0"},
      {"--onewire", "--onewire-failure", "contact-lost", "--onewire-at", "65"},
      {"--failure", "hang-up", "--players", "0"},
      {"--failure", "silence", "--players", "0", "--at", "2"},
      {"--radio", "--radio-failure", "silent-gun", "--radio-at", "41"},
      {"--box", "--box-failure", "unplugged", "--box-at", "0"},
      {"--bootcode", "--bootcode-failure", "silence", "--bootcode-at", "0"},
      {"--no-base-unit"}};
  for (const std::vector<std::string>& arguments : refused) {
    VenueProcess venue(arguments);
    EXPECT_EQ(venue.WaitForExit(), 2) << testing::PrintToString(arguments);
    EXPECT_EQ(venue.RestOfOutput(), "");
    EXPECT_THAT(venue.RestOfErrors(), testing::StartsWith("tessarine-venue: "));
  }
}

TEST_F(VenueProgram, SaysWhenItCannotWriteAFile) {
  VenueProcess venue({"--log", File("missing/log")});
  EXPECT_EQ(venue.WaitForExit(), 1);
  EXPECT_THAT(venue.RestOfErrors(), HasSubstr("missing/log"));
}

TEST_F(VenueProgram, PlaysAnEveningOfGames) {
  const Evening evening(5, 77, std::chrono::seconds(1));
  VenueProcess venue({"--players", "5", "--seed", "77", "--fast", "--evening", "1"});
  const std::string device = venue.ReadDevice();
  for (int pull = 1; pull <= 3; ++pull) {
    const std::string told = venue.ReadLine();
    ASSERT_THAT(told, testing::StartsWith("game "));
    // On a busy machine another one has ended since that line.
    const std::vector<Bytes> pulled = Pull(device);
    int number = std::stoi(told.substr(5));
    const int first = number;
    while (number < first + 60 && MakeBaseUnitAnswer(evening.Game(number)).Frames != pulled) {
      ++number;
    }
    EXPECT_LT(number, first + 60) << "after \"" << told << '"';
    EXPECT_GT(first, pull);
  }
}

TEST_F(VenueProgram, PlaysAnEveningWithAFailureInEachOfItsGames) {
  const Evening evening(3, 1, std::chrono::seconds(1));
  VenueProcess venue({"--players", "3", "--fast", "--evening", "1", "--failure", "wrong-crc", "--at", "2"});
  const std::string device = venue.ReadDevice();
  EXPECT_THAT(venue.ReadLine(), testing::StartsWith("game "));
  const std::vector<Bytes> pulled = Pull(device);
  ASSERT_EQ(pulled.size(), 3U);
  const auto hasGoodCheck = [](const Bytes& frame) {
    return Crc8(std::span(frame).first(frame.size() - 1)) == frame.back();
  };
  EXPECT_TRUE(hasGoodCheck(pulled[0]));
  EXPECT_FALSE(hasGoodCheck(pulled[1]));
  EXPECT_TRUE(hasGoodCheck(pulled[2]));
}

TEST_F(VenueProgram, ExplainsItself) {
  VenueProcess venue({"--help"});
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_THAT(venue.RestOfOutput(), HasSubstr("--failure NAME"));
}

}  // namespace
}  // namespace sim
