#include "sim/venue/Venue.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <sstream>
#include <stdexcept>

#include "sim/venue/VenueUsage.h"
#include "tests/sim/line/EchoDevice.h"
#include "tests/support/RawHost.h"

namespace sim {
namespace {

using testing::HasSubstr;
using testing::Not;

enum class HornFailure { None, Hoarse };

constexpr std::array<FailureInfo<HornFailure>, 2> HornFailures{{
    {HornFailure::None, "none", FailurePlace::None, "a faultless horn"},
    {HornFailure::Hoarse, "hoarse", FailurePlace::Byte, "a rough tone from byte K on"},
}};

// A table of two devices that no venue has: a horn with all that an entry can have, and a bell with little.
StartedDevice StartHorn(const DeviceStart& start) {
  if (start.Options.FailureAs<HornFailure>() == HornFailure::Hoarse && start.Options.Place == 0) {
    throw std::invalid_argument("There is no byte 0");
  }
  if (std::ostream* tune = start.File("tune")) {
    *tune << start.Options.Choice("tone") << ' ' << start.Options.Number("volume") << std::flush;
  }
  const auto obey = [end = start.EndVenue](const std::string& line) {
    if (line == "stop") {
      end();
    }
    return "horn: " + line;
  };
  return {std::make_unique<EchoDevice>(std::vector<LineSettings>{{.Baud = 19200}}, start.Log()), obey};
}

StartedDevice StartBell(const DeviceStart& start) {
  return {std::make_unique<EchoDevice>(std::vector<LineSettings>{{.Baud = 9600}}, start.Log()),
          [](const std::string& line) { return "bell: " + line; }};
}

std::vector<DeviceEntry> HornAndBell() {
  return {{.Name = "horn",
           .Title = "big horn",
           .Purpose = "a horn",
           .Failures = FailureRows(HornFailures),
           .NoSuchFailure = "The horn has no failure",
           .PlaceMeaning = "the byte, from 1 (1)",
           .HighestPlace = 9,
           .Options = {{"tone", "TONE", "high or low (high)", ChoiceValue{{"high", "low"}}},
                       {"volume", "N", "decibels (70)", NumberValue{.Highest = 120, .Default = 70}},
                       {"tune", "FILE", "what it played", FileValue{}}},
           .Commands = {{"sound LENGTH", "sound the horn"}, {"stop", "end the program"}},
           .FaultCount = TellFaultCount::Always,
           .Start = StartHorn},
          {.Name = "bell",
           .Title = "little bell",
           .Purpose = "a bell",
           .ServedUnlessTold = true,
           .Commands = {{"sound", "ring the bell"}, {"ring", "the same"}},
           .Start = StartBell}};
}

class VenueOfHornAndBell : public testing::Test {
 protected:
  VenueOfHornAndBell() {
    std::string pattern = (std::filesystem::temp_directory_path() / "tessarine-venue-XXXXXX").string();
    folder_ = ::mkdtemp(pattern.data());
  }
  ~VenueOfHornAndBell() override { std::filesystem::remove_all(folder_); }

  VenueOptions Parsed(const std::vector<std::string>& arguments) const {
    return ParseVenueOptions(arguments, devices_);
  }

  std::unique_ptr<Venue> Serve(const std::vector<std::string>& arguments) {
    return std::make_unique<Venue>(
        Parsed(arguments), [this] { ++ends_; }, devices_);
  }

  std::string File(const std::string& name) const { return (folder_ / name).string(); }

  static std::string Content(const std::string& path) {
    std::ostringstream text;
    text << std::ifstream(path).rdbuf();
    return text.str();
  }

  // The devices of the venue, in order.
  static std::vector<std::string> PathsOf(const Venue& venue) {
    std::ostringstream out;
    venue.TellDevices(out);
    std::istringstream lines(out.str());
    std::vector<std::string> paths;
    for (std::string line; std::getline(lines, line);) {
      paths.push_back(line.substr(line.find(": ") + 2));
    }
    return paths;
  }

  std::vector<DeviceEntry> devices_ = HornAndBell();
  std::filesystem::path folder_;
  int ends_ = 0;
};

TEST_F(VenueOfHornAndBell, HasTheOptionsOfItsTable) {
  const DeviceOptions untold = Parsed({}).Of("horn");
  EXPECT_FALSE(untold.Served);
  EXPECT_EQ(untold.Choice("tone"), 0U);
  EXPECT_EQ(untold.Number("volume"), 70U);
  EXPECT_EQ(untold.File("tune"), std::nullopt);
  const DeviceOptions told = Parsed({"--horn", "--horn-failure", "hoarse", "--horn-at", "4", "--horn-tone",
                                     "low", "--horn-volume", "120", "--horn-tune", "t", "--horn-link", "l"})
                                 .Of("horn");
  EXPECT_TRUE(told.Served);
  EXPECT_EQ(told.FailureAs<HornFailure>(), HornFailure::Hoarse);
  EXPECT_EQ(told.Place, 4U);
  EXPECT_EQ(told.Choice("tone"), 1U);
  EXPECT_EQ(told.Number("volume"), 120U);
  EXPECT_EQ(told.File("tune"), "t");
  EXPECT_EQ(told.Link, "l");
  EXPECT_THROW(told.Number("tune"), std::out_of_range);
  EXPECT_THROW(Parsed({}).Of("base-unit"), std::out_of_range);
}

TEST_F(VenueOfHornAndBell, RefusesWhatItsTableDoesNotHave) {
  const std::vector<std::pair<std::vector<std::string>, std::string>> refused{
      {{"--horn-failure", "fire"}, "The horn has no failure \"fire\""},
      {{"--horn-at", "10"}, "--horn-at wants a number from 0 to 9, not \"10\""},
      {{"--horn-tone", "flat"}, "--horn-tone wants high or low, not \"flat\""},
      {{"--horn-volume", "121"}, "--horn-volume wants a number from 0 to 120, not \"121\""},
      {{"--horn-tune", ""}, "--horn-tune wants a file name"},
      {{"--bell-failure", "none"}, "There is no option \"--bell-failure\""},
      {{"--tone", "low"}, "There is no option \"--tone\""},
      {{"--base-unit"}, "There is no option \"--base-unit\""},
      {{"--no-bell"}, "There is no device to serve"}};
  for (const auto& [arguments, complaint] : refused) {
    try {
      Parsed(arguments);
      ADD_FAILURE() << arguments.front();
    } catch (const std::invalid_argument& failure) {
      EXPECT_EQ(failure.what(), complaint);
    }
  }
}

TEST_F(VenueOfHornAndBell, ExplainsItsTable) {
  const std::string usage = VenueUsage(devices_);
  for (const char* part : {"  --horn  ", "  --horn-failure NAME ", "  --horn-at K ", "  --horn-tone TONE ",
                           "  --horn-tune FILE ", "  --no-bell ", "Failures of the big horn:\n  none ",
                           "  hoarse ", "  sound LENGTH ", "  ring "}) {
    EXPECT_THAT(usage, HasSubstr(part));
  }
  EXPECT_THAT(usage, Not(HasSubstr("Failures of the little bell")));
  EXPECT_THAT(usage, Not(HasSubstr("--no-horn")));
}

TEST_F(VenueOfHornAndBell, ServesTheDevicesThatAreAskedFor) {
  EXPECT_EQ(PathsOf(*Serve({})).size(), 1U);
  const auto venue = Serve({"--horn", "--no-bell"});
  std::ostringstream out;
  venue->TellDevices(out);
  EXPECT_THAT(out.str(), testing::StartsWith("big horn: /dev/"));
  RawHost host(PathsOf(*venue).at(0));
  host.Write({5});
  EXPECT_EQ(host.Read(1), Bytes{5});
}

TEST_F(VenueOfHornAndBell, HandsItsDevicesTheirFilesAndOneLog) {
  {
    const auto venue = Serve({"--horn", "--horn-tune", File("tune"), "--horn-tone", "low", "--horn-link",
                              File("l"), "--log", File("log")});
    const std::vector<std::string> paths = PathsOf(*venue);
    EXPECT_EQ(std::filesystem::read_symlink(File("l")), paths.at(0));
    for (const std::string& path : paths) {
      RawHost host(path);
      host.Write({0x42});
      EXPECT_EQ(host.Read(1), Bytes{0x42});
    }
  }
  EXPECT_EQ(Content(File("tune")), "1 70");
  const std::string log = Content(File("log"));
  EXPECT_EQ(std::count(log.begin(), log.end(), '\n'), 4);
  EXPECT_FALSE(std::filesystem::is_symlink(std::filesystem::symlink_status(File("l"))));
}

TEST_F(VenueOfHornAndBell, LeavesOlderFilesAloneWhenAStartIsRefused) {
  std::ofstream(File("log")) << "older";
  std::ofstream(File("tune")) << "older";
  EXPECT_THROW(Serve({"--no-bell", "--horn", "--horn-failure", "hoarse", "--horn-at", "0", "--horn-tune",
                      File("tune"), "--log", File("log")}),
               std::invalid_argument);
  EXPECT_EQ(Content(File("log")), "older");
  EXPECT_EQ(Content(File("tune")), "older");
}

TEST_F(VenueOfHornAndBell, SaysWhenItCannotWriteAFile) {
  EXPECT_THROW(Serve({"--horn", "--horn-tune", File("missing/tune")}), std::runtime_error);
  EXPECT_THROW(Serve({"--log", File("missing/log")}), std::runtime_error);
}

TEST_F(VenueOfHornAndBell, HandsACommandToTheDeviceThatItNames) {
  const auto both = Serve({"--horn"});
  EXPECT_TRUE(both->TakesCommands());
  EXPECT_EQ(both->Obey("sound 3"), "horn: sound 3");
  EXPECT_EQ(both->Obey("bell sound 3"), "bell: sound 3");
  EXPECT_EQ(both->Obey("horn sound 3"), "horn: sound 3");
  EXPECT_EQ(both->Obey("ring"), "bell: ring");
  EXPECT_EQ(both->Obey(" \t"), "");
  EXPECT_THROW(both->Obey("shout"), std::invalid_argument);
  EXPECT_EQ(Serve({})->Obey("sound 3"), "bell: sound 3");
  EXPECT_THROW(Serve({})->Obey("horn sound 3"), std::invalid_argument);
}

TEST_F(VenueOfHornAndBell, EndsWhenADeviceSaysSo) {
  const auto venue = Serve({"--horn"});
  EXPECT_EQ(ends_, 0);
  venue->Obey("stop");
  EXPECT_EQ(ends_, 1);
}

TEST_F(VenueOfHornAndBell, TellsTheFaultsOfTheHostsOfEachDevice) {
  const auto venue = Serve({"--horn", "--log", File("log")});
  std::ostringstream none;
  venue->TellHostFaults(none);
  EXPECT_EQ(none.str(), "big horn: faults of the host: 0\n");
  RawHost host(PathsOf(*venue).at(1));
  host.Speak({.Baud = 1200});
  host.Write({1});
  const auto end = std::chrono::steady_clock::now() + Limit;
  std::string told;
  while (told.find("bell") == std::string::npos && std::chrono::steady_clock::now() < end) {
    std::ostringstream out;
    venue->TellHostFaults(out);
    told = out.str();
  }
  EXPECT_EQ(told,
            "big horn: faults of the host: 0\n"
            "little bell: the host speaks 1200,8N1 instead of 9600,8N1\n"
            "little bell: faults of the host: 1\n");
}

}  // namespace
}  // namespace sim
