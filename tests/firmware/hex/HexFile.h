#pragma once

#include <cstdint>
#include <initializer_list>
#include <string>
#include <vector>

/// Records of a HEX file, made without the program's own code.
namespace HexFile {

inline std::string TwoDigits(unsigned int byte) {
  static constexpr char digits[] = "0123456789ABCDEF";
  return {digits[byte / 16 % 16], digits[byte % 16]};
}

inline std::string Record(unsigned int type, unsigned int address, const std::vector<std::uint8_t>& data) {
  std::vector<unsigned int> bytes = {static_cast<unsigned int>(data.size()), address / 256 % 256,
                                     address % 256, type};
  bytes.insert(bytes.end(), data.begin(), data.end());
  unsigned int sum = 0;
  std::string text = ":";
  for (const unsigned int byte : bytes) {
    sum += byte;
    text += TwoDigits(byte);
  }
  return text + TwoDigits((256 - sum % 256) % 256) + "\r\n";
}

inline std::string Data(unsigned int address, const std::vector<std::uint8_t>& data) {
  return Record(0, address, data);
}

inline std::string Upper(unsigned int upper) {
  return Record(4, 0, {static_cast<std::uint8_t>(upper / 256), static_cast<std::uint8_t>(upper % 256)});
}

inline std::string End() {
  return ":00000001FF\r\n";
}

/// `count` bytes from `first` on, each fourth one 0, as instructions have it.
inline std::vector<std::uint8_t> Instructions(std::size_t count, unsigned int first) {
  std::vector<std::uint8_t> bytes(count);
  for (std::size_t i = 0; i < count; ++i) {
    bytes[i] = i % 4 == 3 ? 0 : static_cast<std::uint8_t>(first + i);
  }
  return bytes;
}

}  // namespace HexFile
