#include "core/text/StringTable.h"

#include <cstddef>

#include "core/text/TextEncoding.h"
#include "platform/RuntimeError.h"

namespace {

struct Entry {
  int Number;
  const char* English;
  const char* SimplifiedChinese;
};

constexpr Entry Entries[] = {
#define TEXT(number, english, simplifiedChinese) {number, english, simplifiedChinese},
#include "resources/StringTable.inc"
#undef TEXT
};

constexpr bool IsComplete() {
  int expected = StringTable::FirstText;
  for (const Entry& entry : Entries) {
    if (entry.Number != expected++) {
      return false;
    }
  }
  return expected == StringTable::LastText + 1;
}
static_assert(IsComplete(), "the string table holds each number once, in ascending order");

}  // namespace

Language LanguageOf(std::string_view localeName) {
  const bool chinese =
      localeName.size() >= 2 && LowerAscii(localeName[0]) == 'z' && LowerAscii(localeName[1]) == 'h';
  return chinese ? Language::SimplifiedChinese : Language::English;
}

StringTable::StringTable(Language language) : language_(language) {
  for (std::size_t text = 0; text < texts_.size(); ++text) {
    texts_[text] = language == Language::English ? Entries[text].English : Entries[text].SimplifiedChinese;
  }
}

const std::string& StringTable::Text(int number) const {
  if (number < FirstText || number > LastText) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  return texts_[static_cast<std::size_t>(number - FirstText)];
}
