#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

/// The most characters that a description may have.
inline constexpr std::size_t MostOfDescription = 1000;

/// A character of a description that is lost on saving, because it lies between two columns of the table.
struct LostCharacter {
  std::size_t Position;   ///< counted from 1; a line break is two characters
  std::string Character;  ///< "\r" or "\n" for half of a line break
  std::string Before;     ///< up to eight characters before it
  std::string Behind;     ///< up to eight characters behind it
};

/// What a save of this description loses. Line breaks are CR LF.
std::vector<LostCharacter> LostCharacters(const std::string& description);

/// The character in brackets, among its neighbours. A line break or half of one is shown as an arrow.
std::string InItsPlace(const LostCharacter& lost);

/// The number that is saved for a penalty typed as `text`, if that is not what the text says: 0 for an empty
/// text or a word, 12 for "12 points". Otherwise nullopt.
std::optional<double> PenaltySavedAs(const std::string& text);
