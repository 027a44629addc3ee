#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <variant>
#include <vector>

namespace sim {

/// Something that a host must not send.
struct HostFault {
  std::string_view What;
};

/// What the modem is to send over the air.
struct TransmitRequest {
  std::uint64_t Destination = 0;
  std::vector<std::uint8_t> Data;
};

/// The destination that reaches every gun.
constexpr std::uint64_t Broadcast = 0xFFFF;

/// Finds transmit requests (64-bit address, no escaping) in what the host sends. Accepts only those that are
/// correct throughout: the length is that of a radio frame of 1 to 100 data bytes, frame identifier and
/// options are 0, the checksum matches.
class TransmitRequestReader {
 public:
  /// Takes the next byte. Returns a request if the byte completes one, a fault if it reveals one; a run of
  /// stray bytes is one fault.
  std::optional<std::variant<TransmitRequest, HostFault>> Take(std::uint8_t byte);

  /// The bytes of the frame in progress or just ended, or the latest stray byte.
  const std::vector<std::uint8_t>& Bytes() const { return bytes_; }

 private:
  enum class State { Idle, InFrame, Astray };

  std::variant<TransmitRequest, HostFault> ReadFrame() const;

  State state_ = State::Idle;
  std::vector<std::uint8_t> bytes_;
};

}  // namespace sim
