#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "core/game/PublicName.h"
#include "platform/Utf8.h"
#include "web/Markup.h"
#include "web/Pages.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

std::size_t CountOf(std::string_view text, char letter) {
  std::size_t count = 0;
  for (const char each : text) {
    count += each == letter ? 1 : 0;
  }
  return count;
}

PublicGame GameWith(const std::string& name) {
  PublicGame game{.Number = 1, .Time = name};
  game.Players.push_back({.Place = 1, .Gun = 1, .Name = name, .HitsGiven = {{.Gun = 40, .Amount = 5}}});
  game.Players.push_back({.Place = 2, .Gun = 40, .Name = name, .HitsTaken = {{.Gun = 1, .Amount = 5}}});
  return game;
}

/// The name stands in it as it comes, though nobody takes uncleaned ones.
Page RankingWith(const std::string& name, Language language) {
  return RankingPage("2026-11", {{.Place = 1, .Name = name, .Games = 2, .Soldiering = 700}}, language);
}

/// Nothing that begins an element, ends an attribute or turns the direction may come from the name: a page
/// has as many of those as one with a plain name.
void CheckPage(std::string_view body, std::string_view plain) {
  for (const char mark : {'<', '>', '"', '\''}) {
    Require(CountOf(body, mark) == CountOf(plain, mark));
  }
  while (!body.empty()) {
    const std::size_t length = Utf8::LengthOfCharacter(body);
    Require(length > 0);
    const char32_t character = Utf8::CharacterOf(body.substr(0, length));
    Require(character == '\n' || (character >= 0x20 && character != 0x7F));
    Require(character < 0x202A || character > 0x202E);
    Require(character < 0x2066 || character > 0x2069);
    body.remove_prefix(length);
  }
}

}  // namespace

/// Names on pages.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string name(reinterpret_cast<const char*>(data), size);
  if (name.empty()) {
    return 0;
  }
  const PublicGame game = GameWith(name);
  const PublicGame plain = GameWith("x");
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const auto pages = GamePages(game, language);
    const auto plainPages = GamePages(plain, language);
    for (std::size_t at = 0; at < pages.size(); ++at) {
      CheckPage(pages[at].Body, plainPages[at].Body);
    }
    CheckPage(FrontPage(&game, "1", language).Body, FrontPage(&plain, "1", language).Body);
    CheckPage(RankingWith(name, language).Body, RankingWith("x", language).Body);
    CheckPage(GamesPage({&game}, language).Body, GamesPage({&plain}, language).Body);
  }
  Require(CleanName(Escaped(name)).size() <= LongestPublicName * 4);
  return 0;
}
