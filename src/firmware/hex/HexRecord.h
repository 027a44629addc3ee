#pragma once

#include <cstdint>
#include <string_view>

#include "firmware/hex/HexText.h"

/// Types of records in an INHEX32 file.
namespace HexRecordType {
inline constexpr std::uint8_t Data = 0;
inline constexpr std::uint8_t End = 1;
inline constexpr std::uint8_t SegmentAddress = 2;  ///< not read here, as many tool chains still write it
inline constexpr std::uint8_t LinearAddress = 4;
}  // namespace HexRecordType

/// One record of a checked file. Columns are counted from 0.
class HexRecord {
 public:
  static constexpr char Start = ':';
  static constexpr std::size_t DataColumn = 9;

  /// `line` begins with Start and has passed the check; it must outlive the record.
  explicit HexRecord(std::string_view line) : line_(line) {}

  std::uint8_t Count() const { return HexByteAt(line_, 1); }
  std::uint16_t Address() const {
    return static_cast<std::uint16_t>(HexByteAt(line_, 3) * 256 + HexByteAt(line_, 5));
  }
  std::uint8_t Type() const { return HexByteAt(line_, 7); }
  std::uint8_t DataAt(std::size_t index) const { return HexByteAt(line_, DataColumn + 2 * index); }

  /// The word in a record that sets the upper part of the addresses. Of a record that is too short for it,
  /// the digits of its checksum are part of the word, below a "1". Throws RuntimeError 13 for other
  /// characters.
  std::uint16_t UpperAddress() const {
    return static_cast<std::uint16_t>(HexNumber("1" + std::string(Middle(line_, DataColumn, 4))));
  }

 private:
  std::string_view line_;
};
