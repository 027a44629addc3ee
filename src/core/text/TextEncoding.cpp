#include "core/text/TextEncoding.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstring>

#include "platform/Utf8.h"

namespace {

/// Code points of the bytes 0x80 to 0x9F.
constexpr std::array<std::uint16_t, 32> Windows1252High = {
    0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0x008D, 0x017D, 0x008F, 0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178};

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

}  // namespace

bool IsUtf8(std::string_view text) {
  std::size_t at = 0;
  while (true) {
    at += LengthOfAsciiRun(text, at);
    if (at == text.size()) {
      return true;
    }
    const std::size_t length = Utf8::LengthOfCharacter(text.substr(at));
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
    Utf8::Append(utf8, byte >= 0x80 && byte <= 0x9F ? Windows1252High[byte - 0x80U] : byte);
  }
  return utf8;
}

std::size_t CharacterCount(std::string_view text) {
  return static_cast<std::size_t>(std::count_if(text.begin(), text.end(), Utf8::StartsCharacter));
}

std::string Characters(std::string_view text, std::size_t first, std::size_t count) {
  std::string characters;
  std::size_t seen = 0;
  for (const char letter : text) {
    seen += Utf8::StartsCharacter(letter) ? 1 : 0;
    if (seen > first && seen - first <= count) {
      characters += letter;
    }
  }
  return characters;
}

std::string_view FirstBytes(std::string_view text, std::size_t most) {
  if (text.size() <= most) {
    return text;
  }
  std::size_t end = most;
  while (end > 0 && !Utf8::StartsCharacter(text[end])) {
    --end;
  }
  return text.substr(0, end);
}
