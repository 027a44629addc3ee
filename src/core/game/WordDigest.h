#pragma once

#include <cstdint>
#include <string_view>

/// FNV-1a, a word at a time: it only has to tell two states of one game apart.
class WordDigest {
 public:
  void Add(std::uint64_t value) {
    constexpr std::uint64_t prime = 0x100000001b3U;
    digest_ = (digest_ ^ value) * prime;
    digest_ ^= digest_ >> 32U;
  }
  void Add(std::int32_t value) { Add(std::uint64_t{static_cast<std::uint32_t>(value)}); }
  void Add(std::string_view text) {
    Add(std::uint64_t{text.size()});
    for (const char character : text) {
      Add(std::uint64_t{static_cast<unsigned char>(character)});
    }
  }

  std::uint64_t Value() const { return digest_; }

 private:
  std::uint64_t digest_ = 0xcbf29ce484222325U;
};
