#include "web/PageParts.h"

#include <algorithm>
#include <array>
#include <numeric>

#include "core/game/PlayerId.h"
#include "core/text/Filled.h"
#include "core/text/NumberForms.h"
#include "platform/Utf8.h"
#include "web/Markup.h"

namespace PageParts {

std::string_view Code(Language language) {
  return language == Language::SimplifiedChinese ? "zh" : "en";
}

Language Other(Language language) {
  return language == Language::English ? Language::SimplifiedChinese : Language::English;
}

const StringTable& TextsOf(Language language) {
  static const StringTable english(Language::English);
  static const StringTable chinese(Language::SimplifiedChinese);
  return language == Language::English ? english : chinese;
}

namespace {

std::string LinksOf(const Frame& frame, const StringTable& texts) {
  const Language other = Other(texts.TextLanguage());
  return Filled(
      R"(<nav><a href="/%1/">%2</a><a href="/%1/games">%3</a><a href="/%4/%5" lang="%4">%6</a></nav>)",
      {Code(texts.TextLanguage()), Escaped(texts.Text(OwnText::NewestResults)),
       Escaped(texts.Text(OwnText::LastGames)), Code(other), frame.Path,
       Escaped(TextsOf(other).Text(OwnText::PageLanguage))});
}

}  // namespace

std::string Whole(const Frame& frame, const StringTable& texts) {
  const std::string_view code = Code(texts.TextLanguage());
  std::string page =
      Filled(R"(<!DOCTYPE html><html lang="%1"><head><meta charset="utf-8">)"
             R"(<meta name="viewport" content="width=device-width,initial-scale=1"><title>%2</title>)"
             R"(<link rel="stylesheet" href="/style.css"><script src="/follow.js" defer></script></head>)",
             {code, Escaped(frame.Title)});
  if (frame.Token.empty()) {
    page += Filled(R"(<body><a id="new" href="/%1/" hidden>%2</a>)",
                   {code, Escaped(texts.Text(OwnText::NewResults))});
  } else {
    page += Filled(R"(<body data-now="%1">)", {frame.Token});
  }
  page += LinksOf(frame, texts);
  page += "<main>";
  page += frame.Main;
  page += "</main></body></html>\n";
  return page;
}

std::string Badge(int team, const StringTable& texts) {
  const std::string name = TeamNameFromNumber(texts, static_cast<std::int16_t>(team));
  return Filled("<b class=t%1>%2</b>",
                {std::to_string(team), Escaped(name.substr(0, Utf8::LengthOfCharacter(name)))});
}

std::string Gun(int gun, const StringTable& texts) {
  const std::uint8_t id = IdFromIndex(gun);
  std::string name = TeamNameFromNumber(texts, TeamFromId(id));
  name += ' ';
  name += std::to_string(PlayerNumberFromId(id));
  return name;
}

std::string NameOf(const PublicPlayer& player, const StringTable& texts) {
  return player.Name.empty() ? Escaped(Gun(player.Gun, texts)) : Isolated(player.Name);
}

std::string TitleOf(const PublicGame& game, const StringTable& texts) {
  std::string title = Filled(texts.Text(OwnText::NumberOfGame), {std::to_string(game.Number)});
  if (!game.Time.empty()) {
    title += ", ";
    title += game.Time;
  }
  return title;
}

std::string Teams(const PublicGame& game, const StringTable& texts) {
  std::array<bool, TeamCount> played{};
  for (const PublicPlayer& player : game.Players) {
    played.at(static_cast<std::size_t>(TeamOfGun(player.Gun) - 1)) = true;
  }
  std::array<std::size_t, TeamCount> order{};
  std::iota(order.begin(), order.end(), 0U);
  std::ranges::stable_sort(order, std::greater(), [&game](std::size_t at) { return game.TeamTotals.at(at); });
  std::string row = "<p class=teams>";
  for (const std::size_t at : order) {
    const int team = static_cast<int>(at) + 1;
    if (played.at(at)) {
      row += Filled("<span>%1 %2 <strong>%3</strong></span>",
                    {Badge(team, texts), Escaped(TeamNameFromNumber(texts, static_cast<std::int16_t>(team))),
                     std::to_string(game.TeamTotals.at(at))});
    }
  }
  row += "</p>";
  return row;
}

std::string Percent(const std::optional<float>& fraction) {
  if (!fraction) {
    return "-";
  }
  return FormatFixed(static_cast<double>(*fraction) * 100, 0) + "%";
}

std::string FolderOf(const PublicGame& game) {
  return "g/" + std::to_string(game.Number) + "/";
}

}  // namespace PageParts
