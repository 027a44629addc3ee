#include "core/text/StringTable.h"

#include <algorithm>
#include <cstddef>
#include <iterator>

#include "platform/Letters.h"
#include "platform/RuntimeError.h"

namespace {

struct Entry {
  int Number;
  const char* English;
  const char* SimplifiedChinese;
};

constexpr Entry Entries[] = {
#define TEXT(number, english, simplifiedChinese) {number, english, simplifiedChinese},
#define OWN_TEXT(number, name, english, simplifiedChinese) {number, english, simplifiedChinese},
#include "resources/StringTable.inc"
};

constexpr std::size_t NumberedTexts = StringTable::LastText - StringTable::FirstText + 1;
constexpr int FirstOwnText = 301;

constexpr bool IsInOrder() {
  for (std::size_t at = 0; at < std::size(Entries); ++at) {
    const int number = Entries[at].Number;
    const bool inOrder = at < NumberedTexts ? number == StringTable::FirstText + static_cast<int>(at)
                                            : number >= FirstOwnText && number > Entries[at - 1].Number;
    if (!inOrder) {
      return false;
    }
  }
  return std::size(Entries) >= NumberedTexts;
}
static_assert(IsInOrder(),
              "the string table holds each number once, in ascending order, 101 to 218 without a gap");

}  // namespace

Language LanguageOf(std::string_view localeName) {
  const bool chinese =
      localeName.size() >= 2 && LowerAscii(localeName[0]) == 'z' && LowerAscii(localeName[1]) == 'h';
  return chinese ? Language::SimplifiedChinese : Language::English;
}

StringTable::StringTable(Language language) : language_(language) {
  texts_.reserve(std::size(Entries));
  for (const Entry& entry : Entries) {
    texts_.emplace_back(language == Language::English ? entry.English : entry.SimplifiedChinese);
  }
}

const std::string& StringTable::Text(int number) const {
  const Entry* const found =
      std::lower_bound(std::begin(Entries), std::end(Entries), number,
                       [](const Entry& entry, int wanted) { return entry.Number < wanted; });
  if (found == std::end(Entries) || found->Number != number) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  return texts_[static_cast<std::size_t>(found - std::begin(Entries))];
}
