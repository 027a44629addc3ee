#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <ostream>
#include <string>
#include <vector>

#include "sim/line/FileDescriptor.h"
#include "sim/line/LineSettings.h"
#include "tests/support/Bytes.h"

namespace sim {

/// Longest wait for something that must come; long enough for a busy machine.
constexpr std::chrono::seconds Limit{20};

/// For the messages of failed tests.
inline void PrintTo(const LineSettings& settings, std::ostream* out) {
  *out << Text(settings);
}

/// The host's end of a line, byte by byte and without a protocol.
class RawHost {
 public:
  /// Fails the running test if `path` cannot be opened.
  explicit RawHost(const std::string& path);

  /// Sets the host's end of the line; until then it has the device's initial settings.
  void Speak(const LineSettings& settings) { SetRawLine(line_.Get(), settings); }
  LineSettings Settings() const { return ReadLineSettings(line_.Get()); }
  void Write(const Bytes& bytes);
  /// None if `longestWait` passes first or the line hangs up.
  std::optional<std::uint8_t> ReadByte(std::chrono::milliseconds longestWait = Limit);
  /// `count` bytes, or fewer if one does not come within the limit.
  Bytes Read(std::size_t count);
  /// All bytes until the line hangs up.
  Bytes ReadUntilHangUp();
  /// True if no byte is waiting and none comes for far longer than the line's own delays.
  bool IsSilent() { return !ReadByte(std::chrono::milliseconds(60)); }
  bool HungUp() const { return hungUp_; }

 private:
  FileDescriptor line_;
  bool hungUp_ = false;
};

}  // namespace sim
