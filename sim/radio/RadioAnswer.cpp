#include "sim/radio/RadioAnswer.h"

#include <numeric>

namespace sim {
namespace {

constexpr std::uint8_t ReceivedFrom64 = 0x80;
constexpr std::uint8_t SignalStrength = 0x28;  // -40 dBm
// A total is split into units of 255, not 256.
constexpr std::size_t TotalFactor = 255;

std::vector<std::uint8_t> Packet(const RadioGun& gun, std::uint8_t type,
                                 const std::vector<std::uint8_t>& payload) {
  std::vector<std::uint8_t> packet{static_cast<std::uint8_t>(payload.size()), gun.PlayerId, 0, 0, type};
  packet.insert(packet.end(), payload.begin(), payload.end());
  return packet;
}

std::vector<std::uint8_t> SizePayload(const RadioGun& gun) {
  const std::size_t total = gun.Frame.size() - 1;
  return {1, static_cast<std::uint8_t>(total % TotalFactor), static_cast<std::uint8_t>(total / TotalFactor),
          gun.Frame.back()};
}

std::vector<std::uint8_t> BlockPayload(const RadioGun& gun, const GunRequest& request) {
  std::vector<std::uint8_t> payload{2, request.Start, static_cast<std::uint8_t>(request.Count - 1)};
  const auto block = std::span(gun.Frame).subspan(request.Start, request.Count);
  payload.insert(payload.end(), block.begin(), block.end());
  return payload;
}

}  // namespace

std::vector<std::uint8_t> AnswerPacket(const RadioGun& gun, const GunRequest& request) {
  constexpr std::uint8_t searchAnswer = 7;
  constexpr std::uint8_t commandAnswer = 5;
  switch (request.Command) {
    case GunCommand::Search:
      return Packet(gun, searchAnswer, {gun.FirmwareMajor, gun.FirmwareMinor, gun.Battery, gun.Weapon});
    case GunCommand::Size:
      return Packet(gun, commandAnswer, SizePayload(gun));
    case GunCommand::Block:
      return Packet(gun, commandAnswer, BlockPayload(gun, request));
    case GunCommand::Close:
      break;
  }
  return Packet(gun, commandAnswer, {3});
}

std::vector<std::uint8_t> EncodeModemFrame(std::span<const std::uint8_t> body) {
  std::vector<std::uint8_t> frame{0x7E, static_cast<std::uint8_t>(body.size() / 256U),
                                  static_cast<std::uint8_t>(body.size() % 256U)};
  frame.insert(frame.end(), body.begin(), body.end());
  const unsigned sum = std::accumulate(body.begin(), body.end(), 0U);
  frame.push_back(static_cast<std::uint8_t>(0xFFU - sum % 256U));
  return frame;
}

std::vector<std::uint8_t> EncodeReceivedFrame(std::uint64_t address, std::span<const std::uint8_t> packet) {
  std::vector<std::uint8_t> body{ReceivedFrom64};
  for (unsigned shift = 64; shift > 0; shift -= 8) {
    body.push_back(static_cast<std::uint8_t>(address >> (shift - 8U) & 0xFFU));
  }
  body.push_back(SignalStrength);
  body.push_back(0);  // options: sent to this modem alone
  body.insert(body.end(), packet.begin(), packet.end());
  return EncodeModemFrame(body);
}

}  // namespace sim
