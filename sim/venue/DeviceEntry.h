#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <ostream>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "sim/game/GunScores.h"
#include "sim/line/Device.h"
#include "sim/line/DeviceFailure.h"
#include "sim/venue/DeviceOptions.h"

namespace sim {

/// An option's value: a whole number from 0 to Highest, ...
struct NumberValue {
  std::uint64_t Highest;
  std::uint64_t Default = 0;
};
/// ... a file that the device writes, ...
struct FileValue {};
/// ... or one of several names, the first of which is the default.
struct ChoiceValue {
  std::vector<std::string_view> Names;
};

/// An option specific to one device.
struct DeviceOption {
  std::string_view Name;     ///< "times" gives --radio-times for the device "radio"
  std::string_view Value;    ///< how the help names its value: "N", "FILE", ...
  std::string_view Meaning;  ///< for the help
  std::variant<NumberValue, FileValue, ChoiceValue> Kind;
};

/// A command that a device obeys when it comes as a line on the standard input.
struct DeviceCommand {
  std::string_view Usage;  ///< the command's word and its arguments: "touch ID"
  std::string_view Meaning;
};

/// What a device is started with. Valid only during the start, except that the streams last as long as the
/// device and EndVenue may be kept.
struct DeviceStart {
  const DeviceOptions& Options;
  const std::vector<GunScores>& Game;  ///< the game played at the venue, the first one of an evening
  /// The game that has ended last, if it is another one than at the call before; the device asks whenever a
  /// host begins to pull. May be kept, and called on one thread at a time.
  std::function<std::optional<std::vector<GunScores>>()> NextGame;
  Pace LinePace = Pace::AsWired;
  /// The log shared by all devices, or nullptr. The first call opens it, so a start that is refused before
  /// then leaves an older file untouched. Throws std::runtime_error if it cannot be written.
  std::function<std::ostream*()> Log;
  /// The opened file of the option with this name, or nullptr if none was given; otherwise like Log.
  std::function<std::ostream*(std::string_view option)> File;
  std::function<void()> EndVenue;  ///< ends the program; may be called on any thread
};

struct StartedDevice {
  std::unique_ptr<Device> Served;
  /// For a device that has commands: carries out a line and returns what to print. Throws
  /// std::invalid_argument with a text for the user.
  std::function<std::string(const std::string& line)> Obey = {};
};

/// When the number of host faults is reported at the end. The faults themselves always are.
enum class TellFaultCount { WhenAny, Always };

/// A device of the venue, as the program knows it: its options, its help, its commands and its line of output
/// all derive from this. A new device needs a folder of its own (for its class, see sim/line/Device.h, and
/// its table of failures, see sim/line/DeviceFailure.h) and an entry in this folder: a file NAMEEntry.cpp
/// with one function, declared in Devices.h and listed in Devices.cpp.
///
/// The name gives --NAME, and --no-NAME for a device that is served by default; --NAME-link; --NAME-failure
/// and --NAME-at if there is a table of failures; and --NAME-OPTION for each of `Options`.
struct DeviceEntry {
  std::string_view Name;     ///< "radio"
  std::string_view Title;    ///< in the output: "radio modem"
  std::string_view Purpose;  ///< for the help, after "serve"
  bool ServedUnlessTold = false;
  bool PlainOptions = false;              ///< its options also work without its name; one device at most
  std::vector<FailureRow> Failures = {};  ///< FailureRows of its table
  std::string_view NoSuchFailure =
      {};  ///< begins the complaint about an unknown failure: "The radio has no failure"
  std::string_view PlaceMeaning = {};  ///< what --NAME-at means, for the help
  std::uint64_t HighestPlace = 1'000'000;
  std::vector<DeviceOption> Options = {};
  std::vector<DeviceCommand> Commands = {};
  TellFaultCount FaultCount = TellFaultCount::WhenAny;
  /// Throws std::invalid_argument, with a text for the user, if the options ask for the impossible, and
  /// std::system_error or std::runtime_error if the system cannot provide what the device needs.
  StartedDevice (*Start)(const DeviceStart& start) = nullptr;
};

}  // namespace sim
