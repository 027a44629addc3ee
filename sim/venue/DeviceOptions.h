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
  std::size_t Place = 1;    ///< what the failure concerns, by its kind of place
  std::optional<std::string> Link;
  /// Of the device's own options that are numbers or choices, by name; all of them are there.
  std::map<std::string, std::uint64_t, std::less<>> Numbers;
  /// Of those that are files, where one was given.
  std::map<std::string, std::string, std::less<>> Files;

  /// `Kind`: the enumeration of the device's failures.
  template <class Kind>
  Kind FailureAs() const {
    return static_cast<Kind>(Failure);
  }

  /// Throws std::out_of_range when the device has no such option.
  std::uint64_t Number(std::string_view option) const;
  /// The place of the name that was chosen; throws like Number.
  std::size_t Choice(std::string_view option) const { return static_cast<std::size_t>(Number(option)); }
  std::optional<std::string> File(std::string_view option) const;
};

}  // namespace sim
