#pragma once

#include <cstdint>
#include <span>
#include <vector>

#include "sim/radio/GunRequest.h"
#include "sim/radio/RadioGun.h"

namespace sim {

/// The packet with which `gun` answers `request`, which must be addressed to it.
std::vector<std::uint8_t> AnswerPacket(const RadioGun& gun, const GunRequest& request);

/// A modem's frame around `body`: start byte, length, body, checksum.
std::vector<std::uint8_t> EncodeModemFrame(std::span<const std::uint8_t> body);

/// The modem's frame for `packet`, received from `address`.
std::vector<std::uint8_t> EncodeReceivedFrame(std::uint64_t address, std::span<const std::uint8_t> packet);

}  // namespace sim
