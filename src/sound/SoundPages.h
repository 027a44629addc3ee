#pragma once

#include <cstdint>

/// The sound chip's format: unsigned 8-bit mono samples, in pages.
namespace SoundChip {

inline constexpr int SamplesPerSecond = 22050;
inline constexpr int PageBytes = 256;
inline constexpr double CapacitySeconds = 90;
/// What a sample at rest is.
inline constexpr std::uint8_t Silence = 128;
/// What the table of pages has room for.
inline constexpr int MostSounds = 128;

/// Whole pages nearest to `size` bytes, half a page to the even neighbour; `size` may be negative. Throws
/// RuntimeError 6 beyond 32 bits.
std::int32_t PagesOf(std::int64_t size);

/// Playing time of `pages`.
constexpr double SecondsOf(std::int64_t pages) {
  return static_cast<double>(pages * PageBytes) / SamplesPerSecond;
}

}  // namespace SoundChip
