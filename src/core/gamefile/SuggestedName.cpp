#include "core/gamefile/SuggestedName.h"

#include <algorithm>

#include "core/text/Pieces.h"
#include "platform/Utf8.h"

namespace {

constexpr std::string_view Suffix = ".game.xml";
constexpr std::size_t MostBytes = 200;

bool CannotBeHeld(char character) {
  const auto code = static_cast<unsigned char>(character);
  return code < 0x20 || code == 0x7F ||
         std::string_view("\\/:*?\"<>|").find(character) != std::string_view::npos;
}

/// The beginning of `text` that has at most `bytes` bytes and whole characters.
std::string_view Beginning(std::string_view text, std::size_t bytes) {
  if (text.size() <= bytes) {
    return text;
  }
  while (bytes > 0 && !Utf8::StartsCharacter(text[bytes])) {
    --bytes;
  }
  return text.substr(0, bytes);
}

}  // namespace

std::string SuggestedGameName(std::string_view received, std::string_view missionName) {
  return SuggestedFileName(received, missionName, Suffix);
}

std::string SuggestedFileName(std::string_view received, std::string_view missionName,
                              std::string_view ending) {
  constexpr std::size_t dateLength = 10;
  constexpr std::size_t hour = 11;
  constexpr std::size_t minute = 14;
  std::string name(received.substr(0, dateLength));
  if (received.size() >= minute + 2) {
    name.append(" ").append(received.substr(hour, 2)).append(received.substr(minute, 2));
  }
  name.append(" ").append(missionName);
  std::replace_if(name.begin(), name.end(), CannotBeHeld, '-');
  const std::string_view whole = Beginning(name, MostBytes - ending.size());
  return std::string(Trimmed(whole, [](char character) { return character == ' '; })).append(ending);
}
