#include "exports/HtmlText.h"

#include "platform/Utf8.h"

namespace {

constexpr std::string_view ReplacementCharacter = "\xEF\xBF\xBD";

/// Control characters, and those that are set aside for programs, are faults in a page.
bool MayStandInHtml(char32_t character) {
  const bool isControl = character < 0x20 || (character >= 0x7F && character <= 0x9F);
  const bool isNoCharacter = (character >= 0xFDD0 && character <= 0xFDEF) || (character & 0xFFFEU) == 0xFFFEU;
  return !isControl && !isNoCharacter;
}

/// Marks that turn the direction of writing, line and paragraph ends, and the byte-order mark.
bool IsUnseenMark(char32_t character) {
  return character == 0x061C || character == 0x200E || character == 0x200F ||
         (character >= 0x2028 && character <= 0x202E) || (character >= 0x2066 && character <= 0x2069) ||
         character == 0xFEFF;
}

std::string_view EscapeOf(char byte) {
  switch (byte) {
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

std::string Element(std::string_view start, std::string_view html, std::string_view end) {
  std::string element;
  element.reserve(start.size() + html.size() + end.size());
  return element.append(start).append(html).append(end);
}

}  // namespace

std::string HtmlText(std::string_view text, HtmlUnseen unseen) {
  std::string html;
  html.reserve(text.size());
  while (!text.empty()) {
    const std::size_t length = Utf8::LengthOfCharacter(text);
    const std::string_view character = text.substr(0, length == 0 ? 1 : length);
    text.remove_prefix(character.size());
    if (const std::string_view escape = EscapeOf(character.front()); !escape.empty()) {
      html.append(escape);
      continue;
    }
    const char32_t code = length == 0 ? U'\0' : Utf8::CharacterOf(character);
    const bool isFit = length != 0 && MayStandInHtml(code);
    if (unseen == HtmlUnseen::Kept) {
      html.append(isFit ? character : ReplacementCharacter);
    } else if (isFit && !IsUnseenMark(code)) {
      html.append(character);
    }
  }
  return html;
}

std::string HtmlName(std::string_view text, HtmlUnseen unseen) {
  return Element("<bdi>", HtmlText(text, unseen), "</bdi>");
}

std::string HtmlNumberHead(std::string_view html) {
  return Element("<th scope=\"col\" class=\"n\">", html, "</th>");
}

std::string HtmlTextHead(std::string_view html) {
  return Element("<th scope=\"col\">", html, "</th>");
}

std::string HtmlNumberCell(std::string_view html) {
  return Element("<td class=\"n\">", html, "</td>");
}

std::string HtmlTextCell(std::string_view html) {
  return Element("<td>", html, "</td>");
}
