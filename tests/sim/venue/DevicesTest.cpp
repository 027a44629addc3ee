#include "sim/venue/Devices.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <set>
#include <stdexcept>

#include "sim/game/GameMaker.h"
#include "sim/venue/CommandLine.h"
#include "sim/venue/VenueUsage.h"
#include "tests/support/RawHost.h"

namespace sim {

// For the messages of failed tests.
static void PrintTo(const DeviceEntry& entry, std::ostream* out) {
  *out << entry.Name;
}

namespace {

using testing::HasSubstr;
using testing::StartsWith;

// What must hold for each entry of the table.
class EveryDevice : public testing::TestWithParam<DeviceEntry> {
 protected:
  static std::string Option(std::string_view option) {
    return "--" + std::string(GetParam().Name) + (option.empty() ? "" : "-" + std::string(option));
  }

  static DeviceOptions Parsed(const std::vector<std::string>& arguments) {
    return ParseVenueOptions(arguments).Of(GetParam().Name);
  }

  // At the places that every failure has.
  static StartedDevice Started(const DeviceOptions& options) {
    const std::vector<GunScores> game = MakeGame(2, 1);
    return GetParam().Start({.Options = options,
                             .Game = game,
                             .NextGame = [] { return std::nullopt; },
                             .LinePace = Pace::Fast,
                             .Log = [] { return nullptr; },
                             .File = [](std::string_view) { return nullptr; },
                             .EndVenue = [] {}});
  }

  static std::string ComplaintOf(const std::vector<std::string>& arguments) {
    try {
      ParseVenueOptions(arguments);
    } catch (const std::invalid_argument& failure) {
      return failure.what();
    }
    return "none";
  }
};

TEST_P(EveryDevice, IsServedWhenItsNameSaysSo) {
  EXPECT_TRUE(Parsed({Option("")}).Served);
  EXPECT_EQ(Parsed({"--base-unit"}).Served, GetParam().ServedUnlessTold);
}

TEST_P(EveryDevice, TakesALinkAndAPlace) {
  EXPECT_EQ(Parsed({Option("link"), "port"}).Link, "port");
  EXPECT_EQ(ComplaintOf({Option("link"), ""}), Option("link") + " wants a file name");
  if (!GetParam().Failures.empty()) {
    const std::string highest = std::to_string(GetParam().HighestPlace);
    EXPECT_EQ(Parsed({Option("at"), highest}).Place, GetParam().HighestPlace);
    const std::string beyond = std::to_string(GetParam().HighestPlace + 1);
    EXPECT_EQ(ComplaintOf({Option("at"), beyond}),
              Option("at") + " wants a number from 0 to " + highest + ", not \"" + beyond + "\"");
  }
}

TEST_P(EveryDevice, KnowsEachOfItsFailuresAndNoOther) {
  const std::vector<FailureRow>& failures = GetParam().Failures;
  for (std::size_t i = 0; i < failures.size(); ++i) {
    EXPECT_EQ(Parsed({Option("failure"), std::string(failures[i].Name)}).Failure, i);
  }
  EXPECT_EQ(ComplaintOf({Option("failure"), "fire"}), std::string(GetParam().NoSuchFailure) + " \"fire\"");
}

TEST_P(EveryDevice, HasFailuresOfDistinctNamesThatBeginWithNone) {
  std::set<std::string_view> names;
  for (const FailureRow& failure : GetParam().Failures) {
    EXPECT_TRUE(names.insert(failure.Name).second) << failure.Name;
    EXPECT_FALSE(failure.Meaning.empty()) << failure.Name;
  }
  ASSERT_FALSE(names.empty());
  EXPECT_EQ(GetParam().Failures.front().Name, "none");
  EXPECT_EQ(GetParam().Failures.front().Place, FailurePlace::None);
}

TEST_P(EveryDevice, IsToldWholeByTheHelp) {
  const std::string usage = VenueUsage();
  for (const CommandLineOption& option : OptionsOf(GetParam())) {
    EXPECT_THAT(usage, HasSubstr("  " + option.Spellings.front() + " " + option.Value));
    EXPECT_THAT(usage, HasSubstr(" " + option.Meaning + "\n"));
  }
  for (const FailureRow& failure : GetParam().Failures) {
    EXPECT_THAT(usage, HasSubstr("  " + std::string(failure.Name) + " "));
    EXPECT_THAT(usage, HasSubstr(" " + std::string(failure.Meaning) + "\n"));
  }
  for (const DeviceCommand& command : GetParam().Commands) {
    EXPECT_THAT(usage, HasSubstr("  " + std::string(command.Usage) + " "));
  }
}

TEST_P(EveryDevice, StartsWithEachOfItsFailures) {
  DeviceOptions options = Parsed({});
  for (options.Failure = 0; options.Failure < GetParam().Failures.size(); ++options.Failure) {
    const StartedDevice started = Started(options);
    EXPECT_THAT(started.Served->DevicePath(), StartsWith("/dev/"));
    EXPECT_EQ(started.Obey != nullptr, !GetParam().Commands.empty());
    EXPECT_TRUE(started.Served->HostFaults().empty());
  }
}

TEST_P(EveryDevice, DoesNotAnswerAHostAtOtherSettings) {
  const StartedDevice started = Started(Parsed({}));
  RawHost host(started.Served->DevicePath());
  const LineSettings own = host.Settings();
  std::size_t faults = 0;
  for (const LineSettings& other :
       {LineSettings{.Baud = 300}, LineSettings{.Baud = own.Baud, .StopBits = 2},
        LineSettings{.Baud = own.Baud, .Parity = 'O'}, LineSettings{.Baud = own.Baud, .Parity = 'M'}}) {
    host.Speak(other);
    host.Write(Bytes(40, 0xC1));
    ++faults;
    ASSERT_TRUE(started.Served->WaitUntilHostFaults(faults, Limit));
    EXPECT_THAT(started.Served->HostFaults().back(),
                StartsWith("the host speaks " + Text(other) + " instead of " + Text(own)));
  }
  EXPECT_TRUE(host.IsSilent());
}

INSTANTIATE_TEST_SUITE_P(OfTheTable, EveryDevice, testing::ValuesIn(Devices()),
                         [](const testing::TestParamInfo<DeviceEntry>& device) {
                           std::string name(device.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

TEST(Devices, HaveOptionsOfDistinctSpellings) {
  std::set<std::string> spellings;
  std::vector<CommandLineOption> all = GeneralOptions();
  for (const DeviceEntry& entry : Devices()) {
    const std::vector<CommandLineOption> own = OptionsOf(entry);
    all.insert(all.end(), own.begin(), own.end());
  }
  for (const CommandLineOption& option : all) {
    for (const std::string& spelling : option.Spellings) {
      EXPECT_TRUE(spellings.insert(spelling).second) << spelling;
    }
  }
}

}  // namespace

}  // namespace sim
