#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <vector>

/// A boot loader made from the description of its packets alone: it takes bytes of the line and gives back
/// what the device sends. Memory is by device address, an instruction at each even one.
class LoaderModel {
 public:
  using Bytes = std::vector<std::uint8_t>;

  std::map<std::uint32_t, Bytes> Flash;           ///< four bytes each; what is not there is erased
  std::map<std::uint32_t, std::uint16_t> Eeprom;  ///< words by byte address, shown in program memory too
  std::uint16_t Identity = 1095;
  bool Running = false;
  int Confirmed = 0;

  /// Called with each packet; false swallows it.
  std::function<bool(const Bytes&)> OnPacket;

  /// The bytes that the device sends after this one.
  Bytes Take(std::uint8_t byte) {
    if (escaped_) {
      escaped_ = false;
      data_.push_back(byte);
    } else if (byte == 0x05) {
      escaped_ = true;
    } else if (byte == 0x55) {
      data_.clear();
    } else if (byte == 0x04) {
      return Answer();
    } else {
      data_.push_back(byte);
    }
    return {};
  }

  Bytes Instruction(std::uint32_t address) const {
    if (address == 0xFF0000) {
      return {static_cast<std::uint8_t>(Identity % 256), static_cast<std::uint8_t>(Identity / 256), 0, 0};
    }
    const auto found = Flash.find(address);
    return found == Flash.end() ? Bytes{0xFF, 0xFF, 0xFF, 0} : found->second;
  }

 private:
  Bytes Answer() {
    unsigned int sum = 0;
    for (const std::uint8_t byte : data_) {
      sum += byte;
    }
    if (data_.size() < 2 || sum % 256 != 0) {
      return {};
    }
    Bytes packet(data_.begin(), data_.end() - 1);
    data_.clear();
    return OnPacket && !OnPacket(packet) ? Bytes() : Framed(Obey(packet));
  }

  Bytes Obey(const Bytes& packet) {
    const std::uint32_t address = packet.size() < 5 ? 0 : packet[2] + packet[3] * 256U + packet[4] * 65536U;
    switch (packet[0]) {
      case 0:
        Running = packet[1] == 0;
        return Running ? Bytes() : Bytes{0, 2, 5, 1};
      case 1:
        return Read(packet, address);
      case 2:
        for (std::uint32_t i = 0; i < packet[1] * 64U; ++i) {
          const auto at = packet.begin() + 5 + 4 * i;
          Flash[address + 2 * i] = Bytes(at, at + 4);
        }
        return {2};
      case 3:
        for (std::uint32_t i = 0; i < packet[1] * 512U; ++i) {
          Flash.erase(address + 2 * i);
        }
        return {3};
      case 5:
        for (std::uint32_t i = 0; i < packet[1]; ++i) {
          Eeprom[address + 2 * i] = static_cast<std::uint16_t>(packet[5 + 2 * i] + packet[6 + 2 * i] * 256);
        }
        return {5};
      case 8:
        ++Confirmed;
        return {8};
      default:
        return {};
    }
  }

  Bytes Read(const Bytes& packet, std::uint32_t address) const {
    Bytes answer(packet.begin(), packet.begin() + 5);
    const bool isEeprom = Eeprom.count(address) != 0;
    for (std::uint32_t i = 0; i < packet[1]; ++i) {
      const Bytes bytes = isEeprom ? Words(address + 4 * i) : Instruction(address + 2 * i);
      answer.insert(answer.end(), bytes.begin(), bytes.end());
    }
    return answer;
  }

  Bytes Words(std::uint32_t address) const {
    Bytes bytes;
    for (const std::uint32_t at : {address, address + 2}) {
      const auto found = Eeprom.find(at);
      const std::uint16_t word = found == Eeprom.end() ? 0xFFFF : found->second;
      bytes.push_back(static_cast<std::uint8_t>(word % 256));
      bytes.push_back(static_cast<std::uint8_t>(word / 256));
    }
    return bytes;
  }

  static Bytes Framed(Bytes data) {
    if (data.empty()) {
      return {};
    }
    unsigned int sum = 0;
    for (const std::uint8_t byte : data) {
      sum += byte;
    }
    data.push_back(static_cast<std::uint8_t>(256 - sum % 256));
    Bytes line = {0x55, 0x55};
    for (const std::uint8_t byte : data) {
      if (byte == 0x55 || byte == 0x04 || byte == 0x05) {
        line.push_back(0x05);
      }
      line.push_back(byte);
    }
    line.push_back(0x04);
    return line;
  }

  Bytes data_;
  bool escaped_ = false;
};
