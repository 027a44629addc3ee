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
  GunPacket packet{.PayloadLength = frame.Data[0],
                   .PlayerId = frame.Data[1],
                   .Byte2 = frame.Data[2],
                   .Byte3 = frame.Data[3],
                   .Type = frame.Data[4]};
  const std::size_t length = packet.PayloadLength + std::size_t{1};
  if (length > packet.Payload.size()) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  std::copy_n(frame.Data.begin() + HeaderLength, length, packet.Payload.begin());
  return packet;
}

std::uint8_t ByteOf(int value) {
  if (value < 0 || value > 255) {
    throw RuntimeError(Fault::Overflow);
  }
  return static_cast<std::uint8_t>(value);
}
