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
  std::uint8_t Start = 0;  ///< of a block
  std::uint8_t Count = 0;  ///< of a block's bytes

  bool operator==(const GunRequest&) const = default;
};

/// What `transmit` asks of one of `guns`. A fault unless every byte of the packet is as it must be: its
/// length, the two zeros, type and command with their arguments, a search to all and a command to the address
/// of the gun that it names, a block within that gun's scores and a frame. A search may be for a gun that is
/// not there.
std::variant<GunRequest, HostFault> ReadGunRequest(const TransmitRequest& transmit,
                                                   std::span<const RadioGun> guns);

/// For logs: "search 34", "size 34", "block 34 90+22", "close 34".
std::string Describe(const GunRequest& request);

}  // namespace sim
