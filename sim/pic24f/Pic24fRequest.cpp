#include "sim/pic24f/Pic24fRequest.h"

#include <array>
#include <iomanip>
#include <sstream>
#include <string_view>

namespace sim {
namespace {

constexpr std::size_t HeaderBytes = 5;

struct CommandInfo {
  std::string_view Name;
  bool HasAddress;
  std::size_t BytesPerCount;  // to write
};

// In the order of the enumeration.
constexpr std::array<CommandInfo, 9> Commands{{{"version", false, 0},
                                               {"read", true, 0},
                                               {"write", true, RowBytes},
                                               {"erase", true, 0},
                                               {"read EEPROM", true, 0},
                                               {"write EEPROM", true, WordBytes},
                                               {"read configuration", true, 0},
                                               {"write configuration", true, WordBytes},
                                               {"verify OK", false, 0}}};

const CommandInfo& InfoOf(Pic24fCommand command) {
  return Commands.at(static_cast<std::size_t>(command));
}

}  // namespace

std::variant<Pic24fRequest, BadPacket> ReadPic24fRequest(std::span<const std::uint8_t> data) {
  constexpr BadPacket badLength{"a length that the command does not have"};
  if (data.empty() || data[0] >= Commands.size()) {
    return BadPacket{"an unknown command"};
  }
  Pic24fRequest request{.Command = static_cast<Pic24fCommand>(data[0])};
  if (request.Command == Pic24fCommand::VerifyOk) {
    return data.size() == 1 ? std::variant<Pic24fRequest, BadPacket>(request) : badLength;
  }
  const CommandInfo& info = InfoOf(request.Command);
  if (data.size() < 2 || (info.HasAddress && data.size() < HeaderBytes)) {
    return badLength;
  }
  request.Count = data[1];
  if (!info.HasAddress) {
    return data.size() == 2 ? std::variant<Pic24fRequest, BadPacket>(request) : badLength;
  }
  if (request.Count == 0) {
    return BadPacket{"a count of 0"};
  }
  request.Address = data[2] + 0x100U * data[3] + 0x10000U * data[4];
  request.Data.assign(data.begin() + HeaderBytes, data.end());
  if (request.Data.size() != request.Count * info.BytesPerCount) {
    return badLength;
  }
  return request;
}

std::vector<std::uint8_t> HeaderOf(const Pic24fRequest& request) {
  return {static_cast<std::uint8_t>(request.Command), request.Count,
          static_cast<std::uint8_t>(request.Address), static_cast<std::uint8_t>(request.Address >> 8U),
          static_cast<std::uint8_t>(request.Address >> 16U)};
}

std::string Describe(const Pic24fRequest& request) {
  const CommandInfo& info = InfoOf(request.Command);
  if (!info.HasAddress) {
    const bool runs = request.Command == Pic24fCommand::Version && request.Count == 0;
    return std::string(runs ? "run" : info.Name);
  }
  std::ostringstream text;
  text << info.Name << ' ' << static_cast<int>(request.Count) << " at " << std::hex << std::uppercase
       << std::setw(6) << std::setfill('0') << request.Address;
  return text.str();
}

}  // namespace sim
