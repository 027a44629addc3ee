#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "core/text/StringTable.h"
#include "web/PublicGame.h"

/// What the pages have in common.
namespace PageParts {

/// "en" or "zh", which is also the first folder of the pages' paths.
std::string_view Code(Language language);

Language Other(Language language);

/// The string table of a language, made once.
const StringTable& TextsOf(Language language);

/// What a whole page is made of; markup, except for the title.
struct Frame {
  std::string Title;
  std::string Path;        ///< of the same page, behind the folder of its language
  std::string_view Token;  ///< of the newest board; empty on other pages, which offer a link to it instead
  std::string_view Main;
};

/// A whole page.
std::string Whole(const Frame& frame, const StringTable& texts);

/// Team of a gun as a coloured letter.
std::string Badge(int team, const StringTable& texts);

/// "Blue 7" in the language of `texts`; not escaped.
std::string Gun(int gun, const StringTable& texts);

/// The name, or the gun where there is none, isolated.
std::string NameOf(const PublicPlayer& player, const StringTable& texts);

/// "Game 3, 20:15"; not escaped.
std::string TitleOf(const PublicGame& game, const StringTable& texts);

/// Teams that played, highest total first.
std::string Teams(const PublicGame& game, const StringTable& texts);

/// Whole percents, "45%"; "-" for none.
std::string Percent(const std::optional<float>& fraction);

/// Path of a game's pages behind the folder of the language: "g/3/".
std::string FolderOf(const PublicGame& game);

}  // namespace PageParts
