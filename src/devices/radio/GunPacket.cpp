#include "devices/radio/GunPacket.h"

#include <algorithm>
#include <cstddef>
#include <iterator>

#include "platform/RuntimeError.h"

namespace {

constexpr std::size_t HeaderLength = 5;

}  // namespace

std::vector<std::uint8_t> MakeGunPacket(std::uint8_t playerId, std::uint8_t byte2, std::uint8_t byte3,
                                        std::uint8_t packetType, std::span<const std::uint8_t> payload) {
  std::vector<std::uint8_t> packet = {static_cast<std::uint8_t>(payload.size()), playerId, byte2, byte3,
                                      packetType};
  std::copy(payload.begin(), payload.end(), std::back_inserter(packet));
  return packet;
}

GunPacket ReadGunPacket(const ReceivedFrame& frame) {
  GunPacket packet{};
  const std::size_t length = HeaderLength + frame.Data[0] + 1;
  if (length > packet.size()) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  std::copy_n(frame.Data.begin(), length, packet.begin());
  return packet;
}

std::uint8_t ByteOf(int value) {
  if (value < 0 || value > 255) {
    throw RuntimeError(Fault::Overflow);
  }
  return static_cast<std::uint8_t>(value);
}
