#pragma once

#include <cstdint>
#include <string>

/// `value` in `count` bytes, low byte first.
inline std::string Little(std::uint64_t value, int count) {
  std::string bytes;
  for (int i = 0; i < count; ++i) {
    bytes += static_cast<char>(value >> (8 * i) & 0xFF);
  }
  return bytes;
}

/// A chunk with its padding.
inline std::string Chunk(const std::string& name, const std::string& contents) {
  return name + Little(contents.size(), 4) + contents + std::string(contents.size() % 2, '\0');
}

inline std::string Riff(const std::string& chunks) {
  return "RIFF" + Little(chunks.size() + 4, 4) + "WAVE" + chunks;
}

inline std::string FormatChunk(int channels = 1, int rate = 22050, int bits = 8, int tag = 1) {
  const int align = channels * bits / 8;
  return Chunk("fmt ", Little(tag, 2) + Little(channels, 2) + Little(rate, 4) + Little(rate * align, 4) +
                           Little(align, 2) + Little(bits, 2));
}

/// Samples that differ from each other and from silence.
inline std::string Samples(std::size_t count, int start = 1) {
  std::string samples;
  for (std::size_t i = 0; i < count; ++i) {
    samples += static_cast<char>((start + static_cast<int>(i % 100)) & 0xFF);
  }
  return samples;
}

/// A wave file in the chip's format. Its samples begin at byte 44.
inline std::string Wave(const std::string& samples) {
  return Riff(FormatChunk() + Chunk("data", samples));
}
