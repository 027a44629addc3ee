#include "sim/venue/VenueOptions.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>

#include "sim/baseunit/BaseUnitFailure.h"
#include "sim/bootcode/BootFailure.h"
#include "sim/box/BoxFailure.h"
#include "sim/onewire/OneWireFailure.h"
#include "sim/pic24f/Pic24fFailure.h"
#include "sim/radio/RadioFailure.h"
#include "sim/recorder/RecorderFailure.h"
#include "sim/venue/VenueUsage.h"

namespace sim {
namespace {

using testing::HasSubstr;

DeviceOptions BaseUnitIn(const std::vector<std::string>& arguments) {
  return ParseVenueOptions(arguments).Of("base-unit");
}
DeviceOptions OneWireIn(const std::vector<std::string>& arguments) {
  return ParseVenueOptions(arguments).Of("onewire");
}
DeviceOptions RadioIn(const std::vector<std::string>& arguments) {
  return ParseVenueOptions(arguments).Of("radio");
}

TEST(VenueOptions, StandForAFaultlessGameOfFortyWhenNoneIsGiven) {
  const VenueOptions options = ParseVenueOptions({});
  const DeviceOptions& unit = options.Of("base-unit");
  const DeviceOptions& reader = options.Of("onewire");
  const DeviceOptions& modem = options.Of("radio");
  EXPECT_EQ(options.Players, 40);
  EXPECT_EQ(options.Seed, 1U);
  EXPECT_EQ(options.Evening, std::chrono::seconds(0));
  EXPECT_FALSE(options.Fast);
  EXPECT_EQ(unit.FailureAs<BaseUnitFailure>(), BaseUnitFailure::None);
  EXPECT_EQ(unit.Place, 1U);
  EXPECT_EQ(unit.Number("games"), 0U);
  EXPECT_EQ(options.LogFile, std::nullopt);
  EXPECT_EQ(unit.File("frames"), std::nullopt);
  EXPECT_EQ(unit.Link, std::nullopt);
  EXPECT_FALSE(reader.Served);
  EXPECT_EQ(reader.FailureAs<OneWireFailure>(), OneWireFailure::None);
  EXPECT_EQ(reader.Place, 1U);
  EXPECT_EQ(reader.Link, std::nullopt);
  EXPECT_FALSE(modem.Served);
  EXPECT_EQ(modem.FailureAs<RadioFailure>(), RadioFailure::None);
  EXPECT_EQ(modem.Place, 1U);
  EXPECT_EQ(modem.Number("times"), 0U);
  EXPECT_EQ(modem.Number("answer-time"), 5U);
  EXPECT_EQ(modem.File("frames"), std::nullopt);
  EXPECT_EQ(modem.Link, std::nullopt);
  EXPECT_FALSE(options.UntilEof);
  EXPECT_FALSE(options.Help);
}

TEST(VenueOptions, TakeEveryOption) {
  const VenueOptions options = ParseVenueOptions(
      {"--players", "224",       "--seed", "4294967295", "--evening", "90",          "--fast",
       "--failure", "wrong-crc", "--at",   "7",          "--log",     "wire.log",    "--frames",
       "f.bin",     "--link",    "port",   "--games",    "3",         "--until-eof", "--help"});
  const DeviceOptions& unit = options.Of("base-unit");
  EXPECT_EQ(options.Players, 224);
  EXPECT_EQ(options.Seed, 4294967295U);
  EXPECT_EQ(options.Evening, std::chrono::seconds(90));
  EXPECT_TRUE(options.Fast);
  EXPECT_EQ(unit.FailureAs<BaseUnitFailure>(), BaseUnitFailure::WrongCrc);
  EXPECT_EQ(unit.Place, 7U);
  EXPECT_EQ(unit.Number("games"), 3U);
  EXPECT_EQ(options.LogFile, "wire.log");
  EXPECT_EQ(unit.File("frames"), "f.bin");
  EXPECT_EQ(unit.Link, "port");
  EXPECT_TRUE(options.UntilEof);
  EXPECT_TRUE(options.Help);
}

TEST(VenueOptions, TakeEveryOptionOfTheOneWireAdapter) {
  const DeviceOptions reader = OneWireIn(
      {"--onewire", "--onewire-failure", "contact-lost", "--onewire-at", "12", "--onewire-link", "reader"});
  EXPECT_TRUE(reader.Served);
  EXPECT_EQ(reader.FailureAs<OneWireFailure>(), OneWireFailure::ContactLost);
  EXPECT_EQ(reader.Place, 12U);
  EXPECT_EQ(reader.Link, "reader");
}

TEST(VenueOptions, TakeEveryOptionOfTheRadioModem) {
  const VenueOptions options =
      ParseVenueOptions({"--radio", "--radio-failure", "wrong-crc", "--radio-at", "0", "--radio-times", "2",
                         "--radio-answer-time", "8", "--radio-frames", "guns.bin", "--radio-link", "modem"});
  const DeviceOptions& unit = options.Of("base-unit");
  const DeviceOptions& modem = options.Of("radio");
  EXPECT_TRUE(modem.Served);
  EXPECT_EQ(modem.FailureAs<RadioFailure>(), RadioFailure::WrongCrc);
  EXPECT_EQ(modem.Place, 0U);
  EXPECT_EQ(modem.Number("times"), 2U);
  EXPECT_EQ(modem.Number("answer-time"), 8U);
  EXPECT_EQ(modem.File("frames"), "guns.bin");
  EXPECT_EQ(modem.Link, "modem");
  EXPECT_EQ(unit.FailureAs<BaseUnitFailure>(), BaseUnitFailure::None);
}

TEST(VenueOptions, TakeEveryOptionOfTheUtilityBox) {
  const DeviceOptions untold = ParseVenueOptions({}).Of("box");
  EXPECT_FALSE(untold.Served);
  EXPECT_EQ(untold.Number("times"), 0U);
  EXPECT_EQ(untold.Number("late"), 2500U);
  const DeviceOptions box =
      ParseVenueOptions({"--box", "--box-failure", "unplugged", "--box-at", "10", "--box-times", "2",
                         "--box-late", "60000", "--box-link", "cable"})
          .Of("box");
  EXPECT_TRUE(box.Served);
  EXPECT_EQ(box.FailureAs<BoxFailure>(), BoxFailure::Unplugged);
  EXPECT_EQ(box.Place, 10U);
  EXPECT_EQ(box.Number("times"), 2U);
  EXPECT_EQ(box.Number("late"), 60000U);
  EXPECT_EQ(box.Link, "cable");
}

TEST(VenueOptions, TakeEveryOptionOfTheSoundRecorder) {
  const DeviceOptions untold = ParseVenueOptions({}).Of("recorder");
  EXPECT_FALSE(untold.Served);
  EXPECT_EQ(untold.Choice("kind"), 0U);
  EXPECT_EQ(untold.Number("erase-time"), 500U);
  EXPECT_EQ(untold.File("folder"), std::nullopt);
  const DeviceOptions told =
      ParseVenueOptions({"--recorder", "--recorder-kind", "stand-alone", "--recorder-erase-time", "9",
                         "--recorder-folder", "sounds", "--recorder-failure", "lost-byte", "--recorder-at",
                         "7", "--recorder-link", "chip"})
          .Of("recorder");
  EXPECT_TRUE(told.Served);
  EXPECT_EQ(told.Choice("kind"), 2U);
  EXPECT_EQ(told.Number("erase-time"), 9U);
  EXPECT_EQ(told.File("folder"), "sounds");
  EXPECT_EQ(told.FailureAs<RecorderFailure>(), RecorderFailure::LostByte);
  EXPECT_EQ(told.Place, 7U);
  EXPECT_EQ(told.Link, "chip");
}

TEST(VenueOptions, TakeEveryOptionOfThePic24fBootloader) {
  const DeviceOptions untold = ParseVenueOptions({}).Of("pic24f");
  EXPECT_FALSE(untold.Served);
  for (const char* option : {"device", "identity", "pages", "eeprom-words", "user-reset", "boot-delay"}) {
    EXPECT_EQ(untold.Number(option), 0U) << option;
  }
  EXPECT_EQ(untold.Number("row-time"), 2U);
  EXPECT_EQ(untold.Number("page-time"), 20U);
  const DeviceOptions told =
      ParseVenueOptions({"--pic24f", "--pic24f-device",     "small", "--pic24f-identity",
                         "32769",    "--pic24f-pages",      "15872", "--pic24f-eeprom-words",
                         "16382",    "--pic24f-user-reset", "3072",  "--pic24f-boot-delay",
                         "3074",     "--pic24f-row-time",   "0",     "--pic24f-page-time",
                         "1",        "--pic24f-failure",    "noise", "--pic24f-at",
                         "4",        "--pic24f-link",       "port"})
          .Of("pic24f");
  EXPECT_TRUE(told.Served);
  EXPECT_EQ(told.Choice("device"), 2U);
  EXPECT_EQ(told.Number("identity"), 32769U);
  EXPECT_EQ(told.Number("pages"), 15872U);
  EXPECT_EQ(told.Number("eeprom-words"), 16382U);
  EXPECT_EQ(told.Number("user-reset"), 3072U);
  EXPECT_EQ(told.Number("boot-delay"), 3074U);
  EXPECT_EQ(told.Number("row-time"), 0U);
  EXPECT_EQ(told.Number("page-time"), 1U);
  EXPECT_EQ(told.FailureAs<Pic24fFailure>(), Pic24fFailure::Noise);
  EXPECT_EQ(told.Place, 4U);
  EXPECT_EQ(told.Link, "port");
}

TEST(VenueOptions, TakeEveryOptionOfTheBootCode) {
  const DeviceOptions untold = ParseVenueOptions({}).Of("bootcode");
  EXPECT_FALSE(untold.Served);
  EXPECT_EQ(untold.Choice("product"), 0U);
  EXPECT_EQ(untold.File("flash"), std::nullopt);
  EXPECT_EQ(untold.Number("power-on"), 0U);
  EXPECT_EQ(untold.Number("runs"), 0U);
  EXPECT_EQ(untold.Number("times"), 1U);
  EXPECT_EQ(untold.Number("late"), 12000U);
  EXPECT_EQ(untold.Number("gap"), 50U);
  const DeviceOptions device =
      ParseVenueOptions({"--bootcode", "--bootcode-failure", "asks-again", "--bootcode-at",
                         "9",          "--bootcode-times",   "11",         "--bootcode-product",
                         "qvm",        "--bootcode-flash",   "f",          "--bootcode-power-on",
                         "500",        "--bootcode-runs",    "1",          "--bootcode-late",
                         "60000",      "--bootcode-gap",     "200",        "--bootcode-link",
                         "cable"})
          .Of("bootcode");
  EXPECT_TRUE(device.Served);
  EXPECT_EQ(device.FailureAs<BootFailure>(), BootFailure::AsksAgain);
  EXPECT_EQ(device.Place, 9U);
  EXPECT_EQ(device.Number("times"), 11U);
  EXPECT_EQ(device.Choice("product"), 1U);
  EXPECT_EQ(device.File("flash"), "f");
  EXPECT_EQ(device.Number("power-on"), 500U);
  EXPECT_EQ(device.Number("runs"), 1U);
  EXPECT_EQ(device.Number("late"), 60000U);
  EXPECT_EQ(device.Number("gap"), 200U);
  EXPECT_EQ(device.Link, "cable");
}

TEST(VenueOptions, KnowEveryFailureByItsName) {
  for (const RadioFailureInfo& info : RadioFailures) {
    EXPECT_EQ(RadioIn({"--radio-failure", std::string(info.Name)}).FailureAs<RadioFailure>(), info.Failure);
  }
  for (const BaseUnitFailureInfo& info : BaseUnitFailures) {
    EXPECT_EQ(BaseUnitIn({"--failure", std::string(info.Name)}).FailureAs<BaseUnitFailure>(), info.Failure);
  }
  for (const OneWireFailureInfo& info : OneWireFailures) {
    EXPECT_EQ(OneWireIn({"--onewire-failure", std::string(info.Name)}).FailureAs<OneWireFailure>(),
              info.Failure);
  }
}

TEST(VenueOptions, TakeTheOptionsOfTheBaseUnitUnderItsNameToo) {
  const DeviceOptions unit =
      BaseUnitIn({"--base-unit-failure", "silence", "--base-unit-at", "9", "--base-unit-link", "port",
                  "--base-unit-frames", "f.bin", "--base-unit-games", "2"});
  EXPECT_TRUE(unit.Served);
  EXPECT_EQ(unit.FailureAs<BaseUnitFailure>(), BaseUnitFailure::Silence);
  EXPECT_EQ(unit.Place, 9U);
  EXPECT_EQ(unit.Link, "port");
  EXPECT_EQ(unit.File("frames"), "f.bin");
  EXPECT_EQ(unit.Number("games"), 2U);
}

TEST(VenueOptions, ServeTheBaseUnitUnlessTold) {
  EXPECT_TRUE(BaseUnitIn({}).Served);
  EXPECT_TRUE(BaseUnitIn({"--radio", "--onewire"}).Served);
  EXPECT_FALSE(BaseUnitIn({"--radio", "--no-base-unit"}).Served);
  EXPECT_TRUE(BaseUnitIn({"--no-base-unit", "--base-unit"}).Served);
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
                                                      {"--recorder-kind", "gum"},
                                                      {"--pic24f-device", "tiny"},
                                                      {"--pic24f-identity", "65536"},
                                                      {"--recorder-folder", ""},
                                                      {"--link", ""},
                                                      {"--no-base-unit"},
                                                      {"--no-radio"},
                                                      {"--onewire-games", "1"},
                                                      {"--box-at", "11"},
                                                      {"--box-late", "60001"},
                                                      {"--bootcode-product", "qvm3"},
                                                      {"--bootcode-flash", ""},
                                                      {"--bootcode-gap", "10001"}};
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

TEST(VenueOptions, SayWhichFailureIsNotKnown) {
  const std::vector<std::pair<std::vector<std::string>, std::string>> unknown{
      {{"--failure", "fire"}, "There is no failure \"fire\""},
      {{"--base-unit-failure", "fire"}, "There is no failure \"fire\""},
      {{"--onewire-failure", "fire"}, "The 1-wire adapter has no failure \"fire\""},
      {{"--radio-failure", "fire"}, "The radio has no failure \"fire\""}};
  for (const auto& [arguments, complaint] : unknown) {
    try {
      ParseVenueOptions(arguments);
      ADD_FAILURE() << arguments.front();
    } catch (const std::invalid_argument& failure) {
      EXPECT_EQ(failure.what(), complaint);
    }
  }
}

TEST(VenueOptions, AreAllToldByTheHelp) {
  const std::string usage = VenueUsage();
  for (const char* option : {"--players",
                             "--seed",
                             "--evening",
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
