#include "core/text/AltLetters.h"

#include <algorithm>
#include <optional>
#include <set>

#include "platform/Letters.h"
#include "platform/Utf8.h"

namespace {

bool IsLatin(char character) {
  const char lower = LowerAscii(character);
  return (lower >= 'a' && lower <= 'z') || (lower >= '0' && lower <= '9');
}

/// Place of the marked letter; two marks in a row stand for a plain "&".
std::optional<std::size_t> MarkedLetter(const std::string& caption) {
  for (std::size_t at = 0; at + 1 < caption.size(); ++at) {
    if (caption[at] == '&' && caption[at + 1] != '&') {
      return at + 1;
    }
    at += caption[at] == '&' ? 1 : 0;
  }
  return std::nullopt;
}

class Letters {
 public:
  void Take(char letter) { taken_.insert(LowerAscii(letter)); }
  bool IsFree(char letter) const { return IsLatin(letter) && !taken_.contains(LowerAscii(letter)); }

  /// Place of the best free letter of a caption.
  std::optional<std::size_t> BestIn(const std::string& caption) const {
    for (const bool anywhere : {false, true}) {
      for (std::size_t at = 0; at < caption.size(); ++at) {
        const bool beginsWord = at == 0 || caption[at - 1] == ' ';
        if ((anywhere || beginsWord) && IsFree(caption[at])) {
          return at;
        }
      }
    }
    return std::nullopt;
  }

  std::optional<char> AnyFree() const {
    for (char letter = 'A'; letter <= 'Z'; ++letter) {
      if (IsFree(letter)) {
        return letter;
      }
    }
    return std::nullopt;
  }

 private:
  std::set<char> taken_;
};

/// Where something is added behind the words of a caption: before its colon or dots.
std::size_t EndOfWords(const std::string& caption) {
  for (const std::string_view tail : {"...", "……", "…", ":", "："}) {
    if (caption.ends_with(tail)) {
      return caption.size() - tail.size();
    }
  }
  return caption.size();
}

bool HasLatin(const std::string& caption) {
  return std::any_of(caption.begin(), caption.end(), IsLatin);
}

/// True for words of another script, not for arrows and other signs.
bool HasOtherLetters(const std::string& caption) {
  constexpr char32_t firstSign = 0x2000;
  constexpr char32_t behindSigns = 0x2C00;
  for (std::size_t at = 0; at < caption.size();) {
    const std::string_view rest = std::string_view(caption).substr(at);
    const std::size_t length = std::max<std::size_t>(Utf8::LengthOfCharacter(rest), 1);
    const char32_t character = Utf8::CharacterOf(rest.substr(0, length));
    if (character > 0x7F && (character < firstSign || character >= behindSigns)) {
      return true;
    }
    at += length;
  }
  return false;
}

/// Marks the best free letter of a caption, or adds one behind a caption without Latin letters.
void Mark(std::string& caption, Letters& letters) {
  if (const auto at = letters.BestIn(caption)) {
    letters.Take(caption[*at]);
    caption.insert(*at, "&");
    return;
  }
  if (const auto letter = letters.AnyFree(); letter && HasOtherLetters(caption) && !HasLatin(caption)) {
    letters.Take(*letter);
    caption.insert(EndOfWords(caption), std::string("(&") + *letter + ")");
  }
}

}  // namespace

std::vector<std::string> WithAltLetters(std::vector<std::string> captions, std::string_view taken) {
  Letters letters;
  for (const char letter : taken) {
    letters.Take(letter);
  }
  for (const std::string& caption : captions) {
    if (const auto at = MarkedLetter(caption)) {
      letters.Take(caption[*at]);
    }
  }
  for (const bool latin : {true, false}) {  // added letters are any, so they come last
    for (std::string& caption : captions) {
      if (HasLatin(caption) == latin && caption.find('&') == std::string::npos) {
        Mark(caption, letters);
      }
    }
  }
  return captions;
}
