#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

#include "sound/SoundList.h"

/// At which page of the chip each sound starts, and behind the last sound the page after all of them. Entries
/// that a new list does not reach keep what an earlier one left there.
class PageIndexTable {
 public:
  static constexpr std::size_t EntryCount = 129;
  static constexpr std::size_t SentBytes = 256;

  /// Reckons the table for a list: the first page is 1, and a row without a file takes as many pages as the
  /// file before it. A wave file counts with the size of its samples less their offset in the file, which is
  /// not what is sent for it. `wave` opens the files; one that is refused has its box. Throws RuntimeError 9
  /// beyond 128 rows, 6 beyond page 32,767, 53 or 75 for raw samples that cannot be read.
  void Build(const SoundList& list, const Files& files, WaveFile& wave);

  /// Entries 0 to 127 as they are sent, high byte first.
  std::array<std::uint8_t, SentBytes> Bytes() const;

  std::int16_t Entry(std::size_t index) const { return entries_.at(index); }

 private:
  void Set(std::size_t index, std::int16_t page);

  std::array<std::int16_t, EntryCount> entries_{};
};

constexpr std::uint8_t LoByte(std::int16_t value) {
  return static_cast<std::uint8_t>(static_cast<std::uint16_t>(value) & 0xFFU);
}
constexpr std::uint8_t HiByte(std::int16_t value) {
  return static_cast<std::uint8_t>(static_cast<std::uint16_t>(value) >> 8U);
}

/// `value` in 16 bits. Throws RuntimeError 6 if it does not fit.
std::int16_t ToPage(std::int64_t value);
