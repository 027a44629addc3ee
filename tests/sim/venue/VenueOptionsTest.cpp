#include "sim/venue/VenueOptions.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>

namespace sim {
namespace {

using testing::HasSubstr;

TEST(VenueOptions, StandForAFaultlessGameOfFortyWhenNoneIsGiven) {
  const VenueOptions options = ParseVenueOptions({});
  EXPECT_EQ(options.Players, 40);
  EXPECT_EQ(options.Seed, 1U);
  EXPECT_FALSE(options.Fast);
  EXPECT_EQ(options.Failure, BaseUnitFailure::None);
  EXPECT_EQ(options.FailurePlace, 1U);
  EXPECT_EQ(options.Games, 0);
  EXPECT_EQ(options.LogFile, std::nullopt);
  EXPECT_EQ(options.FramesFile, std::nullopt);
  EXPECT_EQ(options.Link, std::nullopt);
  EXPECT_FALSE(options.OneWire);
  EXPECT_EQ(options.AdapterFailure, OneWireFailure::None);
  EXPECT_EQ(options.AdapterFailurePlace, 1U);
  EXPECT_EQ(options.AdapterLink, std::nullopt);
  EXPECT_FALSE(options.Radio);
  EXPECT_EQ(options.RadioTrouble.Failure, RadioFailure::None);
  EXPECT_EQ(options.RadioTrouble.Gun, 1U);
  EXPECT_EQ(options.RadioTrouble.Times, 0);
  EXPECT_EQ(options.RadioAnswerTime, std::chrono::milliseconds(5));
  EXPECT_EQ(options.RadioFramesFile, std::nullopt);
  EXPECT_EQ(options.RadioLink, std::nullopt);
  EXPECT_FALSE(options.UntilEof);
  EXPECT_FALSE(options.Help);
}

TEST(VenueOptions, TakeEveryOption) {
  const VenueOptions options = ParseVenueOptions(
      {"--players", "224", "--seed", "4294967295", "--fast", "--failure", "wrong-crc", "--at", "7", "--log",
       "wire.log", "--frames", "f.bin", "--link", "port", "--games", "3", "--until-eof", "--help"});
  EXPECT_EQ(options.Players, 224);
  EXPECT_EQ(options.Seed, 4294967295U);
  EXPECT_TRUE(options.Fast);
  EXPECT_EQ(options.Failure, BaseUnitFailure::WrongCrc);
  EXPECT_EQ(options.FailurePlace, 7U);
  EXPECT_EQ(options.Games, 3);
  EXPECT_EQ(options.LogFile, "wire.log");
  EXPECT_EQ(options.FramesFile, "f.bin");
  EXPECT_EQ(options.Link, "port");
  EXPECT_TRUE(options.UntilEof);
  EXPECT_TRUE(options.Help);
}

TEST(VenueOptions, TakeEveryOptionOfTheOneWireAdapter) {
  const VenueOptions options = ParseVenueOptions(
      {"--onewire", "--onewire-failure", "contact-lost", "--onewire-at", "12", "--onewire-link", "reader"});
  EXPECT_TRUE(options.OneWire);
  EXPECT_EQ(options.AdapterFailure, OneWireFailure::ContactLost);
  EXPECT_EQ(options.AdapterFailurePlace, 12U);
  EXPECT_EQ(options.AdapterLink, "reader");
}

TEST(VenueOptions, TakeEveryOptionOfTheRadioModem) {
  const VenueOptions options =
      ParseVenueOptions({"--radio", "--radio-failure", "wrong-crc", "--radio-at", "0", "--radio-times", "2",
                         "--radio-answer-time", "8", "--radio-frames", "guns.bin", "--radio-link", "modem"});
  EXPECT_TRUE(options.Radio);
  EXPECT_EQ(options.RadioTrouble.Failure, RadioFailure::WrongCrc);
  EXPECT_EQ(options.RadioTrouble.Gun, 0U);
  EXPECT_EQ(options.RadioTrouble.Times, 2);
  EXPECT_EQ(options.RadioAnswerTime, std::chrono::milliseconds(8));
  EXPECT_EQ(options.RadioFramesFile, "guns.bin");
  EXPECT_EQ(options.RadioLink, "modem");
  EXPECT_EQ(options.Failure, BaseUnitFailure::None);
}

TEST(VenueOptions, KnowEveryFailureByItsName) {
  for (const RadioFailureInfo& info : RadioFailures) {
    EXPECT_EQ(ParseVenueOptions({"--radio-failure", std::string(info.Name)}).RadioTrouble.Failure,
              info.Failure);
  }
  for (const BaseUnitFailureInfo& info : BaseUnitFailures) {
    EXPECT_EQ(ParseVenueOptions({"--failure", std::string(info.Name)}).Failure, info.Failure);
  }
  for (const OneWireFailureInfo& info : OneWireFailures) {
    EXPECT_EQ(ParseVenueOptions({"--onewire-failure", std::string(info.Name)}).AdapterFailure, info.Failure);
  }
}

TEST(VenueOptions, RefuseWhatTheyDoNotUnderstand) {
  const std::vector<std::vector<std::string>> refused{{"--playrs", "4"},
                                                      {"stray"},
                                                      {""},
                                                      {"--players"},
                                                      {"--players", "225"},
                                                      {"--players", "-1"},
                                                      {"--players", ""},
                                                      {"--players", "4x"},
                                                      {"--players", " 4"},
                                                      {"--seed", "4294967296"},
                                                      {"--seed", "-1"},
                                                      {"--at", "x"},
                                                      {"--games", "-1"},
                                                      {"--failure", "Silence"},
                                                      {"--failure", ""},
                                                      {"--log", ""},
                                                      {"--frames"},
                                                      {"--onewire-failure", "wrong_crc"},
                                                      {"--onewire-failure", "count-zero"},
                                                      {"--onewire-at", "-1"},
                                                      {"--onewire-link", ""},
                                                      {"--radio-failure", "count-zero"},
                                                      {"--radio-at", "225"},
                                                      {"--radio-times", "-1"},
                                                      {"--radio-answer-time", "10001"},
                                                      {"--radio-frames", ""},
                                                      {"--radio-link", ""},
                                                      {"--link", ""}};
  for (const std::vector<std::string>& arguments : refused) {
    EXPECT_THROW(ParseVenueOptions(arguments), std::invalid_argument) << testing::PrintToString(arguments);
  }
}

TEST(VenueOptions, SayWhatIsWrong) {
  try {
    ParseVenueOptions({"--players", "300"});
    FAIL();
  } catch (const std::invalid_argument& failure) {
    EXPECT_STREQ(failure.what(), "--players wants a number from 0 to 224, not \"300\"");
  }
}

TEST(VenueOptions, AreAllToldByTheHelp) {
  const std::string usage = VenueUsage();
  for (const char* option : {"--players",
                             "--seed",
                             "--fast",
                             "--failure",
                             "--at",
                             "--log",
                             "--frames",
                             "--link",
                             "--games",
                             "--onewire ",
                             "--onewire-link",
                             "--onewire-failure",
                             "--onewire-at",
                             "--radio ",
                             "--radio-link",
                             "--radio-frames",
                             "--radio-failure",
                             "--radio-at",
                             "--radio-times",
                             "--radio-answer-time",
                             "--until-eof",
                             "--help",
                             "touch ID",
                             "leave ID"}) {
    EXPECT_THAT(usage, HasSubstr(option));
  }
  for (const BaseUnitFailureInfo& info : BaseUnitFailures) {
    EXPECT_THAT(usage, HasSubstr(std::string(info.Name) + " "));
  }
  for (const RadioFailureInfo& info : RadioFailures) {
    EXPECT_THAT(usage, HasSubstr(std::string(info.Name) + " "));
  }
  for (const OneWireFailureInfo& info : OneWireFailures) {
    EXPECT_THAT(usage, HasSubstr(std::string(info.Name) + " "));
  }
}

}  // namespace
}  // namespace sim
