#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <variant>

#include "sim/radio/RadioGun.h"
#include "sim/radio/TransmitRequest.h"

namespace sim {

/// What a host asks of a gun: the search (packet type 6), or one of the commands of type 4.
enum class GunCommand { Search, Size, Block, Close };

struct GunRequest {
  GunCommand Command = GunCommand::Search;
  std::uint8_t PlayerId = 0;
  std::uint8_t Start = 0;  ///< of a block, offset in the scores
  std::uint8_t Count = 0;  ///< of a block, in bytes

  bool operator==(const GunRequest&) const = default;
};

/// What `transmit` asks of one of `guns`, or a fault if any part of the packet is wrong: its length, the two
/// zeros, type and command with their arguments, the destination (everyone for a search, the address of the
/// gun it names for a command), or a block that exceeds that gun's scores or a frame. A search may be for a
/// gun that is not there.
std::variant<GunRequest, HostFault> ReadGunRequest(const TransmitRequest& transmit,
                                                   std::span<const RadioGun> guns);

/// For logs: "search 34", "size 34", "block 34 90+22", "close 34".
std::string Describe(const GunRequest& request);

}  // namespace sim
