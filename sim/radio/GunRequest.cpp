#include "sim/radio/GunRequest.h"

#include <algorithm>

namespace sim {
namespace {

constexpr std::size_t HeaderBytes = 5;
constexpr std::uint8_t SearchType = 6;
constexpr std::uint8_t CommandType = 4;
constexpr std::uint8_t LowestPlayerId = 32;
// A radio frame holds 100 data bytes, 8 of them ahead of the block.
constexpr std::uint8_t LongestBlock = 92;

std::uint64_t Reversed(std::uint64_t address) {
  std::uint64_t reversed = 0;
  for (int byte = 0; byte < 8; ++byte) {
    reversed = reversed << 8U | (address & 0xFFU);
    address >>= 8U;
  }
  return reversed;
}

const RadioGun* FindByAddress(std::span<const RadioGun> guns, std::uint64_t address) {
  const auto gun = std::find_if(guns.begin(), guns.end(),
                                [&](const RadioGun& candidate) { return candidate.Address == address; });
  return gun == guns.end() ? nullptr : &*gun;
}

std::variant<GunRequest, HostFault> ReadSearch(const TransmitRequest& transmit) {
  if (transmit.Destination != Broadcast) {
    return HostFault{transmit.Destination == Reversed(Broadcast) ? "an address in the wrong byte order"
                                                                 : "a search to a single address"};
  }
  if (transmit.Data.size() != HeaderBytes) {
    return HostFault{"a search with a payload"};
  }
  if (transmit.Data[1] < LowestPlayerId) {
    return HostFault{"a search for a player id below 32"};
  }
  return GunRequest{.Command = GunCommand::Search, .PlayerId = transmit.Data[1]};
}

std::variant<GunRequest, HostFault> ReadBlock(std::span<const std::uint8_t> payload, const RadioGun& gun) {
  if (payload.size() != 3) {
    return HostFault{"a wrong number of arguments"};
  }
  if (payload[2] == 0 || payload[2] > LongestBlock) {
    return HostFault{"a block that fits no frame"};
  }
  if (payload[1] + payload[2] >= static_cast<int>(gun.Frame.size())) {
    return HostFault{"a block beyond the scores"};
  }
  return GunRequest{GunCommand::Block, gun.PlayerId, payload[1], payload[2]};
}

std::variant<GunRequest, HostFault> ReadCommand(const TransmitRequest& transmit,
                                                std::span<const RadioGun> guns) {
  const RadioGun* gun = FindByAddress(guns, transmit.Destination);
  if (gun == nullptr) {
    return HostFault{FindByAddress(guns, Reversed(transmit.Destination)) != nullptr
                         ? "an address in the wrong byte order"
                         : "an address that no gun has"};
  }
  if (transmit.Data[1] != gun->PlayerId) {
    return HostFault{"another gun's player id"};
  }
  const auto payload = std::span(transmit.Data).subspan(HeaderBytes);
  const std::uint8_t command = payload.empty() ? std::uint8_t{0} : payload[0];
  switch (command) {
    case 1:
    case 3:
      if (payload.size() != 1) {
        return HostFault{"a wrong number of arguments"};
      }
      return GunRequest{.Command = command == 1 ? GunCommand::Size : GunCommand::Close,
                        .PlayerId = gun->PlayerId};
    case 2:
      return ReadBlock(payload, *gun);
    default:
      return HostFault{"an unknown command"};
  }
}

}  // namespace

std::variant<GunRequest, HostFault> ReadGunRequest(const TransmitRequest& transmit,
                                                   std::span<const RadioGun> guns) {
  const std::vector<std::uint8_t>& data = transmit.Data;
  if (data.size() < HeaderBytes || data[0] + HeaderBytes != data.size()) {
    return HostFault{"a packet of another length than it says"};
  }
  if (data[2] != 0 || data[3] != 0) {
    return HostFault{"a packet without its zeros"};
  }
  switch (data[4]) {
    case SearchType:
      return ReadSearch(transmit);
    case CommandType:
      return ReadCommand(transmit, guns);
    default:
      return HostFault{"an unknown packet type"};
  }
}

std::string Describe(const GunRequest& request) {
  const std::string id = std::to_string(request.PlayerId);
  switch (request.Command) {
    case GunCommand::Search:
      return "search " + id;
    case GunCommand::Size:
      return "size " + id;
    case GunCommand::Block:
      return "block " + id + ' ' + std::to_string(request.Start) + '+' + std::to_string(request.Count);
    case GunCommand::Close:
      break;
  }
  return "close " + id;
}

}  // namespace sim
