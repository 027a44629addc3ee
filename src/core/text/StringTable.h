#pragma once

#include <array>
#include <string>
#include <string_view>

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

  /// Text `number`, 101 to 218. Throws RuntimeError 9 for any other number.
  const std::string& Text(int number) const;

  Language TextLanguage() const { return language_; }

 private:
  Language language_;
  std::array<std::string, LastText - FirstText + 1> texts_;
};
