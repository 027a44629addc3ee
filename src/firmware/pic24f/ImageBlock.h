#pragma once

#include <array>
#include <cstdint>
#include <span>
#include <string_view>

#include "platform/PicBoot.h"

/// What one operation of a write takes from an image: one line, or for program memory as many lines as fill a
/// block of the device.
class ImageBlock {
 public:
  static constexpr std::size_t MostBytes = 256;

  /// `common` holds what all operations have in common: command, block size, bytes per address, retries.
  explicit ImageBlock(const PicRecord& common) : record_(common) {}

  /// Adds a line, the first one after another's end with its address; true if the block is complete. Throws
  /// RuntimeError 13 for a line without address and 16 bytes, 9 beyond 256 bytes, 11 if a size is 0.
  bool Add(std::string_view line);

  const PicRecord& Record() const { return record_; }
  std::span<const std::uint8_t> Bytes() const { return {bytes_.data(), size_}; }

 private:
  PicRecord record_;
  std::array<std::uint8_t, MostBytes> bytes_{};
  std::size_t size_ = 0;
  bool complete_ = false;
};
