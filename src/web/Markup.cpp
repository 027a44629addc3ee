#include "web/Markup.h"

#include <cstddef>

#include "platform/Utf8.h"

namespace {

/// Controls, marks that turn the direction, line and paragraph ends, what is no character.
bool IsUnseen(char32_t character) {
  return character < 0x20 || (character >= 0x7F && character <= 0x9F) || character == 0x061C ||
         character == 0x200E || character == 0x200F || (character >= 0x2028 && character <= 0x202E) ||
         (character >= 0x2066 && character <= 0x2069) || character == 0xFEFF ||
         (character >= 0xFDD0 && character <= 0xFDEF) || (character & 0xFFFEU) == 0xFFFEU;
}

std::string_view ReferenceFor(char character) {
  switch (character) {
    case '&':
      return "&amp;";
    case '<':
      return "&lt;";
    case '>':
      return "&gt;";
    case '"':
      return "&quot;";
    case '\'':
      return "&#39;";
    case '\t':
    case '\n':
    case '\r':
      return " ";
    default:
      return {};
  }
}

}  // namespace

std::string Escaped(std::string_view text) {
  std::string escaped;
  escaped.reserve(text.size());
  while (!text.empty()) {
    const std::size_t length = Utf8::LengthOfCharacter(text);
    if (length == 0) {
      text.remove_prefix(1);
      continue;
    }
    const std::string_view character = text.substr(0, length);
    const std::string_view reference = ReferenceFor(character.front());
    if (!reference.empty()) {
      escaped += reference;
    } else if (!IsUnseen(Utf8::CharacterOf(character))) {
      escaped += character;
    }
    text.remove_prefix(length);
  }
  return escaped;
}

std::string Isolated(std::string_view text) {
  std::string element = "<bdi>";
  element += Escaped(text);
  element += "</bdi>";
  return element;
}
