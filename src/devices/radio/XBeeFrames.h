#pragma once

#include <array>
#include <cstdint>
#include <span>
#include <vector>

/// Frames of a radio modem in API mode without escaping:
///
///     0      0x7E
///     1      body length, high byte first
///     3      body, its first byte the API identifier
///     3 + n  check byte: 255 minus the low byte of the sum of the body

inline constexpr std::uint8_t FrameStart = 0x7E;

/// 64-bit address of a modem, least significant byte first (the reverse of its order on the line).
using XBeeAddress = std::array<std::uint8_t, 8>;

/// Every modem in range.
inline constexpr XBeeAddress BroadcastAddress = {0xFF, 0xFF};

/// The two letters of an AT command.
using AtLetters = std::array<std::uint8_t, 2>;

/// API identifiers.
namespace XBeeApi {
inline constexpr std::uint8_t Transmit64 = 0x00;
inline constexpr std::uint8_t AtCommand = 0x08;
inline constexpr std::uint8_t Receive64 = 0x80;
inline constexpr std::uint8_t Receive16 = 0x81;
inline constexpr std::uint8_t AtResponse = 0x88;
inline constexpr std::uint8_t TransmitStatus = 0x89;
inline constexpr std::uint8_t ModemStatus = 0x8A;
}  // namespace XBeeApi

/// Asks the modem to transmit `data`. The frame identifier is 0, so no transmit status comes back.
std::vector<std::uint8_t> TransmitRequest(const XBeeAddress& destination, std::span<const std::uint8_t> data);

/// A command to the modem itself. It answers with the same `frameId`.
std::vector<std::uint8_t> AtCommandFrame(std::uint8_t frameId, const AtLetters& letters,
                                         std::span<const std::uint8_t> value);
