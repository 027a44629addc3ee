#pragma once

#include <array>
#include <cstdint>
#include <span>
#include <vector>

#include "devices/radio/XBeeFrameParser.h"

/// A packet to or from a gun, as it stands in the data of a frame:
///
///     0   N, length of the payload
///     1   player id of the gun that is asked or answers
///     2   0
///     3   0
///     4   type
///     5   payload
struct GunPacket {
  std::uint8_t PayloadLength = 0;
  std::uint8_t PlayerId = 0;
  std::uint8_t Byte2 = 0;
  std::uint8_t Byte3 = 0;
  std::uint8_t Type = 0;
  std::array<std::uint8_t, 95> Payload{};  ///< zeros after the received bytes
};

/// Packet types.
namespace GunPacketType {
inline constexpr std::uint8_t Command = 4;
inline constexpr std::uint8_t CommandAnswer = 5;
inline constexpr std::uint8_t Search = 6;
inline constexpr std::uint8_t SearchAnswer = 7;
}  // namespace GunPacketType

std::vector<std::uint8_t> MakeGunPacket(std::uint8_t playerId, std::uint8_t byte2, std::uint8_t byte3,
                                        std::uint8_t packetType, std::span<const std::uint8_t> payload);

/// The packet in the data of `frame`, its payload including the one byte after it. Throws RuntimeError 9 if
/// it announces a payload of 95 bytes or more.
GunPacket ReadGunPacket(const ReceivedFrame& frame);

/// `value` as a byte of the guns' protocol. Throws RuntimeError 6 if it does not fit.
std::uint8_t ByteOf(int value);
