#include "platform/sqlite/JetLike.h"

#include <locale.h>
#include <clocale>
#include <cstddef>
#include <cwctype>

#include <algorithm>
#include <utility>

#include "platform/RuntimeError.h"
#include "platform/Utf8.h"

namespace {

// Bytes that are not UTF-8 map to values above all characters, so that each one equals only itself.
constexpr char32_t StrayByte = 0x110000;

char32_t TakeCharacter(std::string_view& text) {
  const std::size_t length = Utf8::LengthOfCharacter(text);
  if (length == 0) {
    const auto stray = static_cast<unsigned char>(text.front());
    text.remove_prefix(1);
    return StrayByte + stray;
  }
  const char32_t character = Utf8::CharacterOf(text.substr(0, length));
  text.remove_prefix(length);
  return character;
}

char32_t Fold(char32_t character) {
  if (character < 0x80) {
    return character >= U'A' && character <= U'Z' ? character + (U'a' - U'A') : character;
  }
  // A separate locale: the program's own may know no letters beyond ASCII.
  static const locale_t unicode = newlocale(LC_CTYPE_MASK, "C.UTF-8", nullptr);
  if (unicode == nullptr || character >= StrayByte) {
    return character;
  }
  // The Kelvin sign and the dotted capital I have an ASCII letter as their lower case. They are not folded to
  // it, since an index that folds ASCII letters only would miss them.
  const auto small = static_cast<char32_t>(towlower_l(static_cast<wint_t>(character), unicode));
  return small < 0x80 ? character : small;
}

// True for scripts without case: the blocks from Hebrew to Tibetan, and Chinese, Japanese and Korean.
bool HasOneForm(char32_t character) {
  return (character >= 0x0590 && character < 0x1000) || (character >= 0x2E80 && character < 0xA000) ||
         (character >= 0xAC00 && character < 0xD7A4);
}

char32_t TakeFolded(std::string_view& text) {
  return Fold(TakeCharacter(text));
}

}  // namespace

JetPattern::JetPattern(std::string_view pattern) {
  while (!pattern.empty()) {
    const char32_t character = TakeFolded(pattern);
    switch (character) {
      case U'*':
        tokens_.push_back({Kind::AnyText, 0, false, {}});
        break;
      case U'?':
        tokens_.push_back({Kind::AnyCharacter, 0, false, {}});
        break;
      case U'#':
        tokens_.push_back({Kind::Digit, 0, false, {}});
        break;
      case U'[':
        AddSet(pattern);
        break;
      default:
        tokens_.push_back({Kind::Character, character, false, {}});
        break;
    }
  }
}

void JetPattern::AddSet(std::string_view& rest) {
  const std::size_t end = rest.find(']');
  if (end == std::string_view::npos) {
    throw RuntimeError(Fault::InvalidPattern, "Invalid pattern string");
  }
  std::string_view list = rest.substr(0, end);
  rest.remove_prefix(end + 1);
  if (list.empty()) {
    return;
  }
  Token set{Kind::Set, 0, false, {}};
  if (list.size() > 1 && list.front() == '!') {
    set.Negated = true;
    list.remove_prefix(1);
  }
  while (!list.empty()) {
    const char32_t first = TakeFolded(list);
    char32_t last = first;
    if (list.size() > 1 && list.front() == '-') {
      list.remove_prefix(1);
      last = TakeFolded(list);
    }
    if (last < first) {
      throw RuntimeError(Fault::InvalidPattern, "Invalid pattern string");
    }
    set.Ranges.push_back({first, last});
  }
  tokens_.push_back(std::move(set));
}

bool JetPattern::Fits(const Token& token, char32_t character) {
  switch (token.What) {
    case Kind::Character:
      return character == token.Character;
    case Kind::Digit:
      return character >= U'0' && character <= U'9';
    case Kind::Set:
      return token.Negated != std::any_of(token.Ranges.begin(), token.Ranges.end(), [&](const Range& range) {
               return character >= range.First && character <= range.Last;
             });
    default:
      return true;
  }
}

bool JetPattern::Matches(std::string_view text) const {
  // On a mismatch only the last `*` needs to take one more character: everything before it was matched as
  // early as possible, so extending an earlier `*` cannot help.
  std::size_t token = 0;
  std::size_t afterStar = tokens_.size() + 1;
  std::string_view starText;
  while (!text.empty()) {
    if (token < tokens_.size() && tokens_[token].What == Kind::AnyText) {
      afterStar = ++token;
      starText = text;
      if (afterStar == tokens_.size()) {
        return true;
      }
      continue;
    }
    std::string_view rest = text;
    if (token < tokens_.size() && Fits(tokens_[token], TakeFolded(rest))) {
      ++token;
      text = rest;
      continue;
    }
    if (afterStar > tokens_.size()) {
      return false;
    }
    TakeCharacter(starText);
    token = afterStar;
    text = starText;
  }
  return std::all_of(tokens_.begin() + static_cast<std::ptrdiff_t>(token), tokens_.end(),
                     [](const Token& rest) { return rest.What == Kind::AnyText; });
}

std::u32string JetPattern::FixedStart() const {
  std::u32string start;
  for (const Token& token : tokens_) {
    if (token.What != Kind::Character || (token.Character >= 0x80 && !HasOneForm(token.Character))) {
      break;
    }
    start += token.Character;
  }
  return start;
}

bool JetLike(std::string_view text, std::string_view pattern) {
  return JetPattern(pattern).Matches(text);
}
