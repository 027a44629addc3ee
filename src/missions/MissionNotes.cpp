#include "missions/MissionNotes.h"

#include <algorithm>

#include "core/text/NumberForms.h"
#include "core/text/TextEncoding.h"

namespace {

/// Positions between the columns of a description, counted from 1.
constexpr std::size_t Gaps[] = {510, 766};

std::string WithArrows(const std::string& text) {
  std::string shown;
  for (std::size_t i = 0; i < text.size(); ++i) {
    const bool isBreak = text[i] == '\r' || text[i] == '\n';
    const bool isSecondHalf = text[i] == '\n' && i > 0 && text[i - 1] == '\r';
    if (!isBreak) {
      shown += text[i];
    } else if (!isSecondHalf) {
      shown += "\u21b5";
    }
  }
  return shown;
}

}  // namespace

std::vector<LostCharacter> LostCharacters(const std::string& description) {
  constexpr std::size_t neighbours = 8;
  const std::size_t length = CharacterCount(description);
  std::vector<LostCharacter> lost;
  for (const std::size_t gap : Gaps) {
    if (length >= gap) {
      const std::size_t at = gap - 1;
      const std::size_t before = std::min(neighbours, at);
      lost.push_back({gap, Characters(description, at, 1), Characters(description, at - before, before),
                      Characters(description, at + 1, neighbours)});
    }
  }
  return lost;
}

std::string InItsPlace(const LostCharacter& lost) {
  return WithArrows(lost.Before) + "[" + WithArrows(lost.Character) + "]" + WithArrows(lost.Behind);
}

std::optional<double> PenaltySavedAs(const std::string& text) {
  return NumberIn(text) ? std::nullopt : std::optional(Val(text));
}
