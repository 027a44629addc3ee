#include "archive/Digests.h"

#include <nettle/hmac.h>
#include <nettle/sha2.h>

#include <array>
#include <cstdint>
#include <random>

namespace {

using Digest = std::array<std::uint8_t, SHA256_DIGEST_SIZE>;

const std::uint8_t* BytesOf(std::string_view text) {
  return reinterpret_cast<const std::uint8_t*>(text.data());
}

std::string Hexadecimal(const Digest& digest) {
  constexpr std::string_view digits = "0123456789abcdef";
  std::string text;
  text.reserve(2 * digest.size());
  for (const std::uint8_t byte : digest) {
    text += digits[byte >> 4U];
    text += digits[byte & 0xFU];
  }
  return text;
}

}  // namespace

std::string Sha256(std::string_view bytes) {
  sha256_ctx context;
  sha256_init(&context);
  sha256_update(&context, bytes.size(), BytesOf(bytes));
  Digest digest;
  sha256_digest(&context, digest.size(), digest.data());
  return Hexadecimal(digest);
}

std::string KeyedDigest(std::string_view key, std::string_view bytes) {
  hmac_sha256_ctx context;
  hmac_sha256_set_key(&context, key.size(), BytesOf(key));
  hmac_sha256_update(&context, bytes.size(), BytesOf(bytes));
  Digest digest;
  hmac_sha256_digest(&context, digest.size(), digest.data());
  return Hexadecimal(digest);
}

std::string RandomKey() {
  std::random_device source;
  Digest bytes;
  for (std::uint8_t& byte : bytes) {
    byte = static_cast<std::uint8_t>(source());
  }
  return Hexadecimal(bytes);
}
