#include "firmware/download/FirmwarePackets.h"

#include <algorithm>
#include <numeric>

namespace {

void PutHeader(std::span<std::uint8_t> packet, char command, std::uint32_t address, std::uint8_t length) {
  packet[0] = static_cast<std::uint8_t>(command);
  packet[1] = static_cast<std::uint8_t>(address >> 16U);
  packet[2] = static_cast<std::uint8_t>(address >> 8U);
  packet[3] = static_cast<std::uint8_t>(address);
  packet[4] = length;
}

void PutChecksum(std::span<std::uint8_t> packet) {
  const unsigned int sum = std::accumulate(packet.begin(), packet.end() - 1, 0U);
  packet.back() = static_cast<std::uint8_t>(0U - sum);
}

}  // namespace

std::array<std::uint8_t, ErasePacketSize> ErasePacket(int page) {
  constexpr std::uint8_t onlyTheChecksum = 1;
  std::array<std::uint8_t, ErasePacketSize> packet{};
  PutHeader(packet, 'E', static_cast<std::uint32_t>(page) * FirmwareImage::AddressesOfAPage, onlyTheChecksum);
  PutChecksum(packet);
  return packet;
}

std::array<std::uint8_t, WritePacketSize> WritePacket(
    int row, std::span<const std::uint8_t, FirmwareImage::RowBytes> bytes) {
  constexpr std::size_t header = 5;
  std::array<std::uint8_t, WritePacketSize> packet{};
  PutHeader(packet, 'Z', static_cast<std::uint32_t>(row) * FirmwareImage::AddressesOfARow, bytes.size() + 1);
  std::copy(bytes.begin(), bytes.end(), packet.begin() + header);
  PutChecksum(packet);
  return packet;
}
