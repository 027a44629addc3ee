#pragma once

#include <chrono>
#include <cstdint>
#include <ostream>
#include <span>
#include <string>
#include <string_view>

namespace sim {

/// The traffic of a device's line, row by row: seconds since the log began, the device, "->" for bytes to the
/// host or "<-" for bytes from it ("--" without bytes), the bytes in hexadecimal, and a note if there is one.
/// The time is that of the last byte.
class WireLog {
 public:
  /// Without a stream nothing is written. `out` must outlive the log; logs of several devices may share it.
  WireLog(std::ostream* out, std::string device);

  void ToHost(std::span<const std::uint8_t> bytes);
  void FromHost(std::uint8_t byte, std::string_view note = {});
  void FromHost(std::span<const std::uint8_t> bytes, std::string_view note);
  /// A row without bytes, for what the device does to the line itself.
  void Note(std::string_view note);

 private:
  void Row(std::string_view direction, std::span<const std::uint8_t> bytes, std::string_view note);

  std::ostream* out_;
  std::string device_;
  std::chrono::steady_clock::time_point start_;
};

}  // namespace sim
