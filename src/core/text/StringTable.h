#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "core/text/OwnTexts.h"

/// Languages of the string table.
enum class Language { English = 1033, SimplifiedChinese = 2052 };

/// Language for a locale name such as "zh_CN", "zh-Hans" or "de_DE.UTF-8": Chinese for "zh" in upper or lower
/// case, English for all others.
Language LanguageOf(std::string_view localeName);

/// Captions and messages by number, in one language.
class StringTable {
 public:
  static constexpr int FirstText = 101;
  static constexpr int LastText = 218;

  explicit StringTable(Language language);

  /// Text `number`: 101 to 218, or that of an OwnText. Throws RuntimeError 9 for any other number.
  const std::string& Text(int number) const;
  const std::string& Text(OwnText text) const { return Text(static_cast<int>(text)); }

  Language TextLanguage() const { return language_; }

 private:
  Language language_;
  std::vector<std::string> texts_;  ///< in the order of the table
};
