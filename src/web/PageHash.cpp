#include "web/PageHash.h"

#include <cstdint>

std::string PageHash(std::string_view text) {
  std::uint64_t hash = 0xcbf29ce484222325U;
  for (const char letter : text) {
    hash ^= static_cast<unsigned char>(letter);
    hash *= 0x100000001b3U;
  }
  std::string digits;
  for (unsigned shift = 64; shift > 0; shift -= 4) {
    digits += "0123456789abcdef"[(hash >> (shift - 4)) & 0xFU];
  }
  return digits;
}
