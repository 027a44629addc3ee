#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "sim/baseunit/BaseUnitFailure.h"
#include "sim/onewire/OneWireFailure.h"
#include "sim/radio/RadioTrouble.h"

namespace sim {

/// What the command line of the simulated venue asks for.
struct VenueOptions {
  int Players = 40;  ///< 0 to 224
  std::uint32_t Seed = 1;
  bool Fast = false;
  BaseUnitFailure Failure = BaseUnitFailure::None;
  std::size_t FailurePlace = 1;  ///< frame or byte, from 1
  int Games = 0;                 ///< requests to serve; 0: any number
  std::optional<std::string> LogFile;
  std::optional<std::string> FramesFile;
  std::optional<std::string> Link;
  bool OneWire = false;  ///< serve the reader of membership buttons too
  OneWireFailure AdapterFailure = OneWireFailure::None;
  std::size_t AdapterFailurePlace = 1;  ///< byte or bit, from 1
  std::optional<std::string> AdapterLink;
  bool Radio = false;  ///< serve the radio modem and its guns too
  RadioTroubleSettings RadioTrouble;
  std::chrono::milliseconds RadioAnswerTime{5};  ///< of each gun
  std::optional<std::string> RadioFramesFile;
  std::optional<std::string> RadioLink;
  bool UntilEof = false;
  bool Help = false;
};

/// Reads `arguments` (without the program's name). Throws std::invalid_argument with a text for the user.
VenueOptions ParseVenueOptions(const std::vector<std::string>& arguments);

/// The text of `--help`.
std::string VenueUsage();

}  // namespace sim
