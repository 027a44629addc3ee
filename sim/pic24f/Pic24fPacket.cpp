#include "sim/pic24f/Pic24fPacket.h"

#include <numeric>
#include <utility>

namespace sim {
namespace {

constexpr std::uint8_t StartByte = 0x55;
constexpr std::uint8_t EndByte = 0x04;
constexpr std::uint8_t EscapeByte = 0x05;
// Five header bytes, four rows and the checksum: the loader's buffer.
constexpr std::size_t MostBytes = 5 + 4 * 256 + 1;

bool NeedsEscape(std::uint8_t byte) {
  return byte == StartByte || byte == EndByte || byte == EscapeByte;
}

std::uint8_t Sum(std::span<const std::uint8_t> bytes) {
  return static_cast<std::uint8_t>(std::accumulate(bytes.begin(), bytes.end(), 0U));
}

std::uint8_t ChecksumOf(std::span<const std::uint8_t> data) {
  return static_cast<std::uint8_t>(-Sum(data));
}

std::vector<std::uint8_t> Encode(std::span<const std::uint8_t> data, std::uint8_t checksum, bool escapeAll) {
  std::vector<std::uint8_t> plain(data.begin(), data.end());
  plain.push_back(checksum);
  std::vector<std::uint8_t> packet{StartByte, StartByte};
  for (const std::uint8_t byte : plain) {
    if (escapeAll || NeedsEscape(byte)) {
      packet.push_back(EscapeByte);
    }
    packet.push_back(byte);
  }
  packet.push_back(EndByte);
  return packet;
}

}  // namespace

std::vector<std::uint8_t> EncodePic24fPacket(std::span<const std::uint8_t> data, bool escapeAll) {
  return Encode(data, ChecksumOf(data), escapeAll);
}

std::vector<std::uint8_t> EncodeWrongPic24fPacket(std::span<const std::uint8_t> data) {
  return Encode(data, static_cast<std::uint8_t>(ChecksumOf(data) ^ 0x80U), false);
}

std::optional<std::variant<Pic24fPacket, BadPacket>> Pic24fPacketReader::Take(std::uint8_t byte) {
  std::optional<BadPacket> fault;
  switch (state_) {
    case State::Idle:
    case State::Astray:
      bytes_ = {byte};
      fault = Begin(byte, state_ == State::Astray);
      break;
    case State::OneStart:
      bytes_.push_back(byte);
      if (byte == StartByte) {
        data_.clear();
        state_ = State::InPacket;
      } else {
        fault = Begin(byte, false);
      }
      break;
    case State::Escaped:
      bytes_.push_back(byte);
      fault = Append(byte);
      break;
    case State::InPacket:
      if (byte == StartByte && !data_.empty()) {
        bytes_ = {byte};
        state_ = State::OneStart;
        return BadPacket{"a packet cut short"};
      }
      bytes_.push_back(byte);
      if (byte == EndByte) {
        return End();
      }
      if (byte == EscapeByte) {
        state_ = State::Escaped;
      } else if (byte != StartByte) {
        fault = Append(byte);
      }
      break;
  }
  if (fault) {
    return *fault;
  }
  return std::nullopt;
}

std::optional<BadPacket> Pic24fPacketReader::Begin(std::uint8_t byte, bool isWithinRun) {
  state_ = byte == StartByte ? State::OneStart : State::Astray;
  if (byte == StartByte || isWithinRun) {
    return std::nullopt;
  }
  return BadPacket{"a byte outside a packet"};
}

std::optional<BadPacket> Pic24fPacketReader::Append(std::uint8_t byte) {
  data_.push_back(byte);
  state_ = State::InPacket;
  if (data_.size() <= MostBytes) {
    return std::nullopt;
  }
  state_ = State::Astray;
  return BadPacket{"a packet longer than the loader's buffer"};
}

std::variant<Pic24fPacket, BadPacket> Pic24fPacketReader::End() {
  state_ = State::Idle;
  if (data_.size() < 2) {
    return BadPacket{"a packet without data"};
  }
  if (Sum(data_) != 0) {
    return BadPacket{"a wrong checksum"};
  }
  data_.pop_back();
  return Pic24fPacket{data_};
}

}  // namespace sim
