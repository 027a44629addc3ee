#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>

namespace sim {

/// What the command line says about one device of the table.
struct DeviceOptions {
  bool Served = false;
  std::size_t Failure = 0;  ///< row of the device's table of failures
  std::size_t Place = 1;    ///< frame, byte, bit or gun that the failure concerns
  std::optional<std::string> Link;
  /// Values of the device's own number and choice options, by name; complete.
  std::map<std::string, std::uint64_t, std::less<>> Numbers;
  /// Values of its file options, if given.
  std::map<std::string, std::string, std::less<>> Files;

  /// `Kind`: the enumeration of the device's failures.
  template <class Kind>
  Kind FailureAs() const {
    return static_cast<Kind>(Failure);
  }

  /// Throws std::out_of_range if the device has no such option.
  std::uint64_t Number(std::string_view option) const;
  /// Index of the chosen name; throws like Number.
  std::size_t Choice(std::string_view option) const { return static_cast<std::size_t>(Number(option)); }
  std::optional<std::string> File(std::string_view option) const;
};

}  // namespace sim
