#include "core/text/TextEncoding.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstring>

namespace {

/// Code points of the bytes 0x80 to 0x9F.
constexpr std::array<std::uint16_t, 32> Windows1252High = {
    0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0x008D, 0x017D, 0x008F, 0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178};

bool StartsCharacter(char letter) {
  return (static_cast<unsigned char>(letter) & 0xC0U) != 0x80U;
}

std::size_t LengthOfAsciiRun(std::string_view text, std::size_t from) {
  constexpr std::uint64_t highBits = 0x8080808080808080U;
  std::size_t at = from;
  for (std::uint64_t eight = 0; at + sizeof eight <= text.size(); at += sizeof eight) {
    std::memcpy(&eight, text.data() + at, sizeof eight);
    if ((eight & highBits) != 0) {
      break;
    }
  }
  while (at < text.size() && static_cast<unsigned char>(text[at]) < 0x80) {
    ++at;
  }
  return at - from;
}

/// Length of the well-formed sequence of 2 to 4 bytes at the start of `text`, 0 if there is none.
std::size_t LengthOfSequence(std::string_view text) {
  const auto byte = [text](std::size_t at) { return static_cast<unsigned char>(text[at]); };
  const unsigned char lead = byte(0);
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
    if ((byte(at) & 0xC0) != 0x80) {
      return 0;
    }
  }
  return length;
}

}  // namespace

bool IsUtf8(std::string_view text) {
  std::size_t at = 0;
  while (true) {
    at += LengthOfAsciiRun(text, at);
    if (at == text.size()) {
      return true;
    }
    const std::size_t length = LengthOfSequence(text.substr(at));
    if (length == 0) {
      return false;
    }
    at += length;
  }
}

std::string Windows1252ToUtf8(std::string_view text) {
  std::string utf8;
  utf8.reserve(text.size() + text.size() / 2);
  for (const char letter : text) {
    const auto byte = static_cast<unsigned char>(letter);
    const unsigned int code = byte >= 0x80 && byte <= 0x9F ? Windows1252High[byte - 0x80U] : byte;
    if (code < 0x80) {
      utf8 += letter;
    } else if (code < 0x800) {
      utf8 += static_cast<char>(0xC0U | (code >> 6U));
      utf8 += static_cast<char>(0x80U | (code & 0x3FU));
    } else {
      utf8 += static_cast<char>(0xE0U | (code >> 12U));
      utf8 += static_cast<char>(0x80U | ((code >> 6U) & 0x3FU));
      utf8 += static_cast<char>(0x80U | (code & 0x3FU));
    }
  }
  return utf8;
}

std::size_t CharacterCount(std::string_view text) {
  return static_cast<std::size_t>(std::count_if(text.begin(), text.end(), StartsCharacter));
}

std::string Characters(std::string_view text, std::size_t first, std::size_t count) {
  std::string characters;
  std::size_t seen = 0;
  for (const char letter : text) {
    seen += StartsCharacter(letter) ? 1 : 0;
    if (seen > first && seen - first <= count) {
      characters += letter;
    }
  }
  return characters;
}
