#include "core/game/PublicName.h"

#include <algorithm>
#include <array>

#include "core/game/PlayerId.h"
#include "platform/Utf8.h"

namespace {

struct CharacterRange {
  char32_t First;
  char32_t Last;
};

template <std::size_t Count>
bool IsIn(const std::array<CharacterRange, Count>& ranges, char32_t character) {
  return std::ranges::any_of(ranges, [character](const CharacterRange& range) {
    return character >= range.First && character <= range.Last;
  });
}

/// Controls, line and paragraph ends, everything that turns the direction of writing, invisible operators,
/// the byte-order mark, annotations, tags, and what is no character.
constexpr std::array Unwanted{
    CharacterRange{0x0000, 0x001F},  CharacterRange{0x007F, 0x009F}, CharacterRange{0x00AD, 0x00AD},
    CharacterRange{0x061C, 0x061C},  CharacterRange{0x180E, 0x180E}, CharacterRange{0x200B, 0x200B},
    CharacterRange{0x200E, 0x200F},  CharacterRange{0x2028, 0x202E}, CharacterRange{0x2060, 0x206F},
    CharacterRange{0xFEFF, 0xFEFF},  CharacterRange{0xFFF0, 0xFFFC}, CharacterRange{0xFFFE, 0xFFFF},
    CharacterRange{0xE0000, 0xE007F}};

constexpr std::array Blanks{
    CharacterRange{0x0020, 0x0020}, CharacterRange{0x00A0, 0x00A0}, CharacterRange{0x115F, 0x1160},
    CharacterRange{0x1680, 0x1680}, CharacterRange{0x2000, 0x200A}, CharacterRange{0x202F, 0x202F},
    CharacterRange{0x205F, 0x205F}, CharacterRange{0x2800, 0x2800}, CharacterRange{0x3000, 0x3000},
    CharacterRange{0x3164, 0x3164}, CharacterRange{0xFFA0, 0xFFA0}};

/// Marks that are drawn on the character before them, and joiners, which need one on their left too.
constexpr std::array Marks{
    CharacterRange{0x0300, 0x036F},  CharacterRange{0x0483, 0x0489}, CharacterRange{0x0591, 0x05BD},
    CharacterRange{0x05BF, 0x05BF},  CharacterRange{0x05C1, 0x05C2}, CharacterRange{0x05C4, 0x05C5},
    CharacterRange{0x05C7, 0x05C7},  CharacterRange{0x0610, 0x061A}, CharacterRange{0x064B, 0x065F},
    CharacterRange{0x0670, 0x0670},  CharacterRange{0x06D6, 0x06DC}, CharacterRange{0x06DF, 0x06E4},
    CharacterRange{0x06E7, 0x06E8},  CharacterRange{0x06EA, 0x06ED}, CharacterRange{0x0711, 0x0711},
    CharacterRange{0x0730, 0x074A},  CharacterRange{0x07A6, 0x07B0}, CharacterRange{0x07EB, 0x07F3},
    CharacterRange{0x08D3, 0x08E1},  CharacterRange{0x08E3, 0x08FF}, CharacterRange{0x0E31, 0x0E31},
    CharacterRange{0x0E34, 0x0E3A},  CharacterRange{0x0E47, 0x0E4E}, CharacterRange{0x0EB1, 0x0EB1},
    CharacterRange{0x0EB4, 0x0EBC},  CharacterRange{0x0EC8, 0x0ECE}, CharacterRange{0x0F71, 0x0F84},
    CharacterRange{0x102B, 0x103E},  CharacterRange{0x135D, 0x135F}, CharacterRange{0x17B4, 0x17D3},
    CharacterRange{0x1AB0, 0x1AFF},  CharacterRange{0x1DC0, 0x1DFF}, CharacterRange{0x200C, 0x200D},
    CharacterRange{0x20D0, 0x20FF},  CharacterRange{0x2DE0, 0x2DFF}, CharacterRange{0x302A, 0x302F},
    CharacterRange{0x3099, 0x309A},  CharacterRange{0xA66F, 0xA672}, CharacterRange{0xA674, 0xA67D},
    CharacterRange{0xFE00, 0xFE0F},  CharacterRange{0xFE20, 0xFE2F}, CharacterRange{0x1F3FB, 0x1F3FF},
    CharacterRange{0xE0100, 0xE01EF}};

constexpr char32_t Joiner = 0x200D;

/// The scripts of India, from U+0900 to U+0DFF, keep their marks at the same places of their blocks of 128.
bool IsIndianMark(char32_t character) {
  if (character < 0x0900 || character > 0x0DFF) {
    return false;
  }
  constexpr std::array places{CharacterRange{0x00, 0x03}, CharacterRange{0x3C, 0x3C},
                              CharacterRange{0x3E, 0x4D}, CharacterRange{0x51, 0x57},
                              CharacterRange{0x62, 0x63}};
  return IsIn(places, character % 0x80);
}

bool IsMark(char32_t character) {
  return IsIn(Marks, character) || IsIndianMark(character);
}

bool IsBlank(char32_t character) {
  return IsIn(Blanks, character);
}

bool IsNoCharacter(char32_t character) {
  return IsIn(Unwanted, character) || (character & 0xFFFEU) == 0xFFFEU;
}

/// The characters of `name` that a line may hold, from the first one that is neither blank nor a mark.
std::u32string Wanted(std::string_view name) {
  std::u32string wanted;
  while (!name.empty()) {
    const std::size_t length = Utf8::LengthOfCharacter(name);
    if (length == 0) {
      name.remove_prefix(1);
      continue;
    }
    const char32_t character = Utf8::CharacterOf(name.substr(0, length));
    name.remove_prefix(length);
    const bool mayBegin = !IsBlank(character) && !IsMark(character);
    if (!IsNoCharacter(character) && (mayBegin || !wanted.empty())) {
      wanted += character;
    }
  }
  return wanted;
}

/// Where `text` may be cut so that at most `most` characters stay and what belongs together is not parted; at
/// `most` if the first letter has more marks than that.
std::size_t EndWithin(const std::u32string& text, std::size_t most) {
  if (text.size() <= most) {
    return text.size();
  }
  std::size_t end = most;
  while (end > 0 && (IsMark(text[end]) || text[end - 1] == Joiner)) {
    --end;
  }
  return end > 0 ? end : most;
}

}  // namespace

std::string CleanName(std::string_view name) {
  std::u32string text = Wanted(name);
  text.resize(EndWithin(text, LongestPublicName));
  while (!text.empty() && (IsBlank(text.back()) || text.back() == Joiner)) {
    text.pop_back();
  }
  std::string clean;
  for (const char32_t character : text) {
    Utf8::Append(clean, character);
  }
  return clean;
}

std::string GunName(const Game& game, int index) {
  return game.TeamName(index) + " " + std::to_string(PlayerNumberFromId(IdFromIndex(index)));
}

std::string PublicName(const Game& game, int index, const NickNames& nickNames,
                       const GuestNames& guestNames) {
  const std::int32_t contactId = game.Players(index).MemberIndex;
  std::string name = contactId != 0 ? CleanName(nickNames(contactId)) : std::string();
  if (name.empty() && guestNames) {
    name = CleanName(guestNames(index));
  }
  return name.empty() ? GunName(game, index) : name;
}
