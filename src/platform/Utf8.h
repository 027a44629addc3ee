#pragma once

#include <cstddef>
#include <string>
#include <string_view>

/// The one place that decodes and encodes UTF-8 characters. In platform/ because the databases use it to
/// match texts; for callers above, there is core/text/TextEncoding.h.
namespace Utf8 {

/// False for a continuation byte.
constexpr bool StartsCharacter(char byte) {
  return (static_cast<unsigned char>(byte) & 0xC0U) != 0x80U;
}

/// Length of the well-formed character, 1 to 4 bytes, at the start of `text`; 0 if there is none. Overlong
/// forms, surrogates and values above U+10FFFF are not well-formed.
constexpr std::size_t LengthOfCharacter(std::string_view text) {
  const auto byte = [text](std::size_t at) { return static_cast<unsigned char>(text[at]); };
  if (text.empty()) {
    return 0;
  }
  const unsigned char lead = byte(0);
  if (lead < 0x80) {
    return 1;
  }
  const std::size_t length = lead >= 0xC2 && lead <= 0xDF   ? 2
                             : lead >= 0xE0 && lead <= 0xEF ? 3
                             : lead >= 0xF0 && lead <= 0xF4 ? 4
                                                            : 0;
  if (length == 0 || text.size() < length) {
    return 0;
  }
  // The range of the second byte rules out overlong forms, surrogates and code points above U+10FFFF.
  const unsigned char lowest = lead == 0xE0 ? 0xA0 : lead == 0xF0 ? 0x90 : 0x80;
  const unsigned char highest = lead == 0xED ? 0x9F : lead == 0xF4 ? 0x8F : 0xBF;
  if (byte(1) < lowest || byte(1) > highest) {
    return 0;
  }
  for (std::size_t at = 2; at < length; ++at) {
    if (StartsCharacter(text[at])) {
      return 0;
    }
  }
  return length;
}

/// Decodes `bytes`, which must be exactly one well-formed character.
constexpr char32_t CharacterOf(std::string_view bytes) {
  const auto lead = static_cast<unsigned char>(bytes.front());
  char32_t character = bytes.size() == 1 ? lead : lead & (0x7FU >> bytes.size());
  for (const char byte : bytes.substr(1)) {
    character = (character << 6U) | (static_cast<unsigned char>(byte) & 0x3FU);
  }
  return character;
}

/// Appends a character, at most U+10FFFF and not a surrogate, to `text`.
inline void Append(std::string& text, char32_t character) {
  const auto following = [&text, character](unsigned int shift) {
    text += static_cast<char>(0x80U | ((character >> shift) & 0x3FU));
  };
  if (character < 0x80) {
    text += static_cast<char>(character);
  } else if (character < 0x800) {
    text += static_cast<char>(0xC0U | (character >> 6U));
    following(0);
  } else if (character < 0x10000) {
    text += static_cast<char>(0xE0U | (character >> 12U));
    following(6);
    following(0);
  } else {
    text += static_cast<char>(0xF0U | (character >> 18U));
    following(12);
    following(6);
    following(0);
  }
}

}  // namespace Utf8
