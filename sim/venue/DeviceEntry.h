#pragma once

#include <cstdint>
#include <functional>
#include <memory>
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
/// ... or one of some names, the first of which holds when none is given.
struct ChoiceValue {
  std::vector<std::string_view> Names;
};

/// An option of one device alone.
struct DeviceOption {
  std::string_view Name;     ///< "times" of the device "radio": --radio-times
  std::string_view Value;    ///< of its value in the help: "N", "FILE", ...
  std::string_view Meaning;  ///< for the help
  std::variant<NumberValue, FileValue, ChoiceValue> Kind;
};

/// What a device does when a line on the standard input asks for it.
struct DeviceCommand {
  std::string_view Usage;  ///< the command's word and its arguments: "touch ID"
  std::string_view Meaning;
};

/// What a device is started with. It lasts for the start alone; streams last as long as the device, and
/// EndVenue may be kept.
struct DeviceStart {
  const DeviceOptions& Options;
  const std::vector<GunScores>& Game;  ///< the one that was played at the venue
  Pace LinePace = Pace::AsWired;
  /// The log that all devices share, or nullptr. It is opened by the first call, so that a start that is
  /// refused before leaves an older file alone. Throws std::runtime_error when it cannot be written.
  std::function<std::ostream*()> Log;
  /// The file of the option of this name, opened, or nullptr when none was given; like Log.
  std::function<std::ostream*(std::string_view option)> File;
  std::function<void()> EndVenue;  ///< may be called on any thread; the program ends then
};

struct StartedDevice {
  std::unique_ptr<Device> Served;
  /// For a device that has commands: does what a line says and returns what is to be printed of it. Throws
  /// std::invalid_argument with a text for the user.
  std::function<std::string(const std::string& line)> Obey = {};
};

/// When the count of the host's faults is told at the end. The faults themselves always are.
enum class TellFaultCount { WhenAny, Always };

/// A device of the venue, as the program knows it: its options, the help, its commands and its line of output
/// all follow from this. A new device has a room of its own (its class, see sim/line/Device.h, and its table
/// of failures, see sim/line/DeviceFailure.h) and an entry in this folder, a file NAMEEntry.cpp with one
/// function, which Devices.cpp lists.
///
/// From the name follow --NAME, or --no-NAME for a device that is served unless told; --NAME-link; with a
/// table of failures --NAME-failure and --NAME-at; and --NAME-OPTION for each of `Options`.
struct DeviceEntry {
  std::string_view Name;     ///< "radio"
  std::string_view Title;    ///< in outputs: "radio modem"
  std::string_view Purpose;  ///< for the help, behind "serve"
  bool ServedUnlessTold = false;
  bool PlainOptions = false;  ///< its options may be spelled without its name too: one device at most
  std::vector<FailureRow> Failures = {};  ///< FailureRows of its table
  std::string_view NoSuchFailure =
      {};  ///< begins the complaint about an unknown one: "The radio has no failure"
  std::string_view PlaceMeaning = {};  ///< of --NAME-at, for the help
  std::uint64_t HighestPlace = 1'000'000;
  std::vector<DeviceOption> Options = {};
  std::vector<DeviceCommand> Commands = {};
  TellFaultCount FaultCount = TellFaultCount::WhenAny;
  /// Throws std::invalid_argument, with a text for the user, when the options ask for what cannot be, and
  /// std::system_error or std::runtime_error when the system does not grant what the device needs.
  StartedDevice (*Start)(const DeviceStart& start) = nullptr;
};

}  // namespace sim
