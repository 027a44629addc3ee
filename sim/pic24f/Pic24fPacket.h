#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>
#include <variant>
#include <vector>

namespace sim {

/// Something on the line that is no good packet or request.
struct BadPacket {
  std::string_view What;
};

/// The bytes between start and checksum, without escapes.
struct Pic24fPacket {
  std::vector<std::uint8_t> Data;
};

/// Start (0x55) twice, data, checksum, end (0x04). An escape (0x05) stands before each of the three values in
/// data and checksum, or before any other byte if `escapeAll`. The checksum is the two's complement of the
/// sum of the data.
std::vector<std::uint8_t> EncodePic24fPacket(std::span<const std::uint8_t> data, bool escapeAll = false);

/// The same with a checksum that is wrong.
std::vector<std::uint8_t> EncodeWrongPic24fPacket(std::span<const std::uint8_t> data);

/// Finds packets in what the host sends.
class Pic24fPacketReader {
 public:
  /// Takes the next byte. Returns a packet if the byte completes one, a fault if it reveals one; a run of
  /// stray bytes is one fault. An unescaped start in the middle begins anew.
  std::optional<std::variant<Pic24fPacket, BadPacket>> Take(std::uint8_t byte);

  /// True if a packet has begun and is not complete.
  bool IsWithinPacket() const { return state_ == State::InPacket || state_ == State::Escaped; }
  /// Forgets what has begun.
  void Reset() { state_ = State::Idle; }

  /// The bytes of the packet in progress or just ended as they came, or the latest stray byte.
  const std::vector<std::uint8_t>& Bytes() const { return bytes_; }

 private:
  enum class State { Idle, Astray, OneStart, InPacket, Escaped };

  std::optional<BadPacket> Begin(std::uint8_t byte, bool isWithinRun);
  std::optional<BadPacket> Append(std::uint8_t byte);
  std::variant<Pic24fPacket, BadPacket> End();

  State state_ = State::Idle;
  std::vector<std::uint8_t> bytes_;
  std::vector<std::uint8_t> data_;  // with the checksum
};

}  // namespace sim
