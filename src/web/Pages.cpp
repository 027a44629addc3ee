#include "web/Pages.h"

#include <algorithm>
#include <array>
#include <span>
#include <utility>

#include "core/game/PlayerId.h"
#include "core/text/Filled.h"
#include "web/Markup.h"
#include "web/PageAssets.h"
#include "web/PageHash.h"
#include "web/PageParts.h"

using PageParts::Code;

namespace {

/// More would make the pages of the fullest game too large together.
constexpr std::size_t MostGunsOnPage = 60;

/// The players of a game by their guns; null where nobody played with one.
using PlayersByGun = std::array<const PublicPlayer*, PlayerCount + 1>;

PlayersByGun ByGun(const PublicGame& game) {
  PlayersByGun players{};
  for (const PublicPlayer& player : game.Players) {
    players.at(static_cast<std::size_t>(player.Gun)) = &player;
  }
  return players;
}

constexpr const char* RankingName = "month";

std::string InFolder(Language language, std::string_view path) {
  std::string whole = "/";
  whole += Code(language);
  whole += '/';
  whole += path;
  return whole;
}

std::string Column(std::string_view caption) {
  return Filled("<th scope=col>%1", {Escaped(caption)});
}

/// The column that takes all the width that the others leave.
std::string WhoColumn(const StringTable& texts) {
  return Filled("<th scope=col class=who>%1", {Escaped(texts.Text(104))});
}

std::string BoardHead(const StringTable& texts) {
  std::string head = "<table class=board><thead><tr>";
  head += Column(texts.Text(103));
  head += WhoColumn(texts);
  for (const int number : {105, 106, 110}) {
    head += Column(texts.Text(number));
  }
  head += "</thead><tbody>";
  return head;
}

/// `folder` is where the pages of the guns are, from the page that the board is on.
std::string Board(const PublicGame& game, std::string_view folder, const StringTable& texts) {
  std::string board = Filled("<h1>%1</h1>", {Escaped(PageParts::TitleOf(game, texts))});
  board += PageParts::Teams(game, texts);
  board += Filled("<p><a class=wide href=\"%1guns\">%2</a></p>",
                  {folder, Escaped(texts.Text(OwnText::FindYourGun))});
  board += BoardHead(texts);
  for (const PublicPlayer& player : game.Players) {
    board += Filled(
        "<tr><td>%1<td>%2 <a href=\"%3%4\">%5</a><td>%6<td>%7<td>%8\n",
        {std::to_string(player.Place), PageParts::Badge(TeamOfGun(player.Gun), texts), folder,
         std::to_string(player.Gun), PageParts::NameOf(player, texts), std::to_string(player.Soldiering),
         PageParts::Percent(player.Accuracy), std::to_string(player.Kia)});
  }
  board += "</tbody></table>";
  return board;
}

std::string Guns(const PublicGame& game, const StringTable& texts) {
  std::string guns =
      Filled("<h1>%1</h1><p class=lead>%2</p><ul class=guns>",
             {Escaped(texts.Text(OwnText::FindYourGun)), Escaped(PageParts::TitleOf(game, texts))});
  for (const PublicPlayer* player : ByGun(game)) {
    if (player != nullptr) {
      const std::string gun = PageParts::Gun(player->Gun, texts);
      guns += Filled("<li><a href=%1>%2 %3", {std::to_string(player->Gun),
                                              PageParts::Badge(TeamOfGun(player->Gun), texts), Escaped(gun)});
      if (!player->Name.empty()) {
        guns += Filled("<small>%1</small>", {Isolated(player->Name)});
      }
      guns += "</a>\n";
    }
  }
  guns += "</ul>";
  return guns;
}

/// What passed between a player and another gun.
struct Duel {
  int Gun;
  std::int64_t Given;
  std::int64_t Taken;
};

/// Those whom the player hit, most damage first, then those who only hit the player.
std::vector<Duel> DuelsOf(const PublicPlayer& player) {
  std::vector<Duel> duels;
  std::array<std::int32_t, PlayerCount + 1> taken{};
  for (const PublicHit& hit : player.HitsTaken) {
    taken.at(static_cast<std::size_t>(hit.Gun)) = hit.Amount;
  }
  for (const PublicHit& hit : player.HitsGiven) {
    duels.push_back({.Gun = hit.Gun,
                     .Given = hit.Amount,
                     .Taken = std::exchange(taken.at(static_cast<std::size_t>(hit.Gun)), 0)});
  }
  for (const PublicHit& hit : player.HitsTaken) {
    if (taken.at(static_cast<std::size_t>(hit.Gun)) != 0) {
      duels.push_back({.Gun = hit.Gun, .Given = 0, .Taken = hit.Amount});
    }
  }
  return duels;
}

std::string Amounts(std::int64_t given, std::int64_t taken) {
  const auto text = [](std::int64_t amount) { return amount != 0 ? std::to_string(amount) : "-"; };
  return Filled("<td>%1<td>%2\n", {text(given), text(taken)});
}

/// One row for the guns that the list does not tell one by one.
std::string OtherDuels(std::span<const Duel> duels, const StringTable& texts) {
  std::int64_t given = 0;
  std::int64_t taken = 0;
  for (const Duel& duel : duels) {
    given += duel.Given;
    taken += duel.Taken;
  }
  std::string row =
      Filled("<tr><td>%1", {Escaped(Filled(texts.Text(OwnText::OtherGuns), {std::to_string(duels.size())}))});
  row += Amounts(given, taken);
  return row;
}

std::string DuelRow(const Duel& duel, const PlayersByGun& players, const StringTable& texts) {
  const PublicPlayer* player = players.at(static_cast<std::size_t>(duel.Gun));
  std::string row = Filled("<tr><td>%1 ", {PageParts::Badge(TeamOfGun(duel.Gun), texts)});
  if (player != nullptr) {
    row += Filled("<a href=%1>%2</a>", {std::to_string(duel.Gun), PageParts::NameOf(*player, texts)});
  } else {
    row += Escaped(PageParts::Gun(duel.Gun, texts));
  }
  row += Amounts(duel.Given, duel.Taken);
  return row;
}

/// Whom the player hit, and who hit the player.
std::string Duels(const PublicPlayer& player, const PlayersByGun& players, const StringTable& texts) {
  const std::vector<Duel> duels = DuelsOf(player);
  std::string list = "<table class=hits><thead><tr>";
  list += WhoColumn(texts);
  list += Column(texts.Text(OwnText::WhomIHit));
  list += Column(texts.Text(OwnText::WhoHitMe));
  list += "</thead><tbody>";
  if (duels.empty()) {
    list += Filled("<tr><td>%1<td>-<td>-", {Escaped(texts.Text(OwnText::NobodyHit))});
  }
  const auto told = std::span(duels).first(std::min(duels.size(), MostGunsOnPage));
  for (const Duel& duel : told) {
    list += DuelRow(duel, players, texts);
  }
  if (told.size() < duels.size()) {
    list += OtherDuels(std::span(duels).subspan(told.size()), texts);
  }
  list += "</tbody></table>";
  return list;
}

std::string Figure(std::string_view caption, std::string_view value) {
  return Filled("<tr><th scope=row>%1<td>%2\n", {Escaped(caption), Escaped(value)});
}

std::string Figures(const PublicPlayer& player, const StringTable& texts) {
  std::string table = "<table class=figures><tbody>";
  table += Figure(texts.Text(105), std::to_string(player.Soldiering));
  table += Figure(texts.Text(106), PageParts::Percent(player.Accuracy));
  table += Figure(texts.Text(OwnText::DamageDealtOnPage), std::to_string(player.DamageDealt));
  table += Figure(texts.Text(OwnText::DamageTakenOnPage), std::to_string(player.DamageTaken));
  table += Figure(texts.Text(108), std::to_string(player.Shots));
  table += Figure(texts.Text(109), std::to_string(player.Wia));
  table += Figure(texts.Text(110), std::to_string(player.Kia));
  table += Figure(texts.Text(111), std::to_string(player.AmmoAdds));
  table += "</tbody></table>";
  return table;
}

/// A gun's own page, without its frame.
std::string OwnResults(const PublicPlayer& player, const PublicGame& game, const PlayersByGun& players,
                       const StringTable& texts) {
  std::string page = Filled(
      "<h1>%1 %2</h1>", {PageParts::Badge(TeamOfGun(player.Gun), texts), PageParts::NameOf(player, texts)});
  const std::string place = Filled(texts.Text(OwnText::PlaceOfAll),
                                   {std::to_string(player.Place), std::to_string(game.Players.size())});
  if (!player.Name.empty()) {
    page += Filled("<p class=lead>%1</p>", {Escaped(PageParts::Gun(player.Gun, texts))});
  }
  page += Filled("<p class=lead>%1</p><p><a href=\"./\">%2</a></p>",
                 {Escaped(place), Escaped(PageParts::TitleOf(game, texts))});
  page += Figures(player, texts);
  page += Duels(player, players, texts);
  return page;
}

std::string RankingLink(Language language, const StringTable& texts) {
  return Filled("<p><a class=wide href=\"%1\">%2</a></p>",
                {InFolder(language, RankingName), Escaped(texts.Text(OwnText::RankingLink))});
}

}  // namespace

std::string FrontPath(Language language) {
  return InFolder(language, {});
}

Page FrontPage(const PublicGame* newest, std::string_view token, Language language, bool hasRanking) {
  const StringTable& texts = PageParts::TextsOf(language);
  std::string main = newest != nullptr
                         ? Board(*newest, InFolder(language, PageParts::FolderOf(*newest)), texts)
                         : Filled("<h1>%1</h1><p>%2</p>", {Escaped(texts.Text(OwnText::ResultsTitle)),
                                                           Escaped(texts.Text(OwnText::NoGameYet))});
  main += hasRanking ? RankingLink(language, texts) : "";
  return {.Path = FrontPath(language),
          .Body = PageParts::Whole(
              {.Title = texts.Text(OwnText::ResultsTitle), .Path = {}, .Token = token, .Main = main}, texts)};
}

std::vector<Page> GamePages(const PublicGame& game, Language language) {
  const StringTable& texts = PageParts::TextsOf(language);
  const std::string folder = PageParts::FolderOf(game);
  const std::string title = PageParts::TitleOf(game, texts);
  const PlayersByGun players = ByGun(game);
  std::vector<Page> pages;
  pages.reserve(game.Players.size() + 2);
  const auto add = [&](const std::string& name, const std::string& pageTitle, const std::string& main) {
    const std::string path = folder + name;
    pages.push_back(
        {.Path = InFolder(language, path),
         .Body = PageParts::Whole({.Title = pageTitle, .Path = path, .Token = {}, .Main = main}, texts)});
  };
  add({}, title, Board(game, {}, texts));
  add("guns", title, Guns(game, texts));
  for (const PublicPlayer& player : game.Players) {
    add(std::to_string(player.Gun), PageParts::Gun(player.Gun, texts),
        OwnResults(player, game, players, texts));
  }
  return pages;
}

Page GamesPage(const std::vector<const PublicGame*>& games, Language language, bool hasRanking) {
  const StringTable& texts = PageParts::TextsOf(language);
  const std::string& title = texts.Text(OwnText::LastGames);
  std::string main = Filled("<h1>%1</h1>", {Escaped(title)});
  main += games.empty() ? Filled("<p>%1</p>", {Escaped(texts.Text(OwnText::NoGameYet))}) : "<ul class=games>";
  for (const PublicGame* game : games) {
    main += Filled("<li><a class=wide href=\"%1\">%2</a>\n",
                   {PageParts::FolderOf(*game), Escaped(PageParts::TitleOf(*game, texts))});
  }
  main += games.empty() ? "" : "</ul>";
  main += hasRanking ? RankingLink(language, texts) : "";
  return {.Path = InFolder(language, "games"),
          .Body = PageParts::Whole({.Title = title, .Path = "games", .Token = {}, .Main = main}, texts)};
}

Page RankingPage(const std::string& month, const std::vector<RankedLine>& lines, Language language) {
  const StringTable& texts = PageParts::TextsOf(language);
  const std::string title = Filled(texts.Text(OwnText::RankingOfMonth), {month});
  std::string main = Filled("<h1>%1</h1>", {Escaped(title)});
  if (lines.empty()) {
    main += Filled("<p>%1</p>", {Escaped(texts.Text(OwnText::NobodyRanked))});
  } else {
    main += "<table class=ranks><thead><tr>";
    main += Column(texts.Text(103));
    main += WhoColumn(texts);
    for (const std::string& caption : {texts.Text(OwnText::GamesPlayed), texts.Text(105),
                                       texts.Text(OwnText::BestGame), texts.Text(106)}) {
      main += Column(caption);
    }
    main += "</thead><tbody>";
    for (const RankedLine& line : lines) {
      const auto accuracy =
          line.Accuracy ? std::optional(static_cast<float>(*line.Accuracy)) : std::optional<float>();
      main +=
          Filled("<tr><td>%1<td>%2<td>%3<td>%4<td>%5<td>%6\n",
                 {std::to_string(line.Place), Isolated(line.Name), std::to_string(line.Games),
                  std::to_string(line.Soldiering), std::to_string(line.Best), PageParts::Percent(accuracy)});
    }
    main += "</tbody></table>";
  }
  return {.Path = InFolder(language, RankingName),
          .Body = PageParts::Whole({.Title = title, .Path = RankingName, .Token = {}, .Main = main}, texts)};
}

Page MissingPage(Language language) {
  const StringTable& here = PageParts::TextsOf(language);
  const StringTable& other = PageParts::TextsOf(PageParts::Other(language));
  const std::string main = Filled("<h1>%1</h1><p lang=\"%2\">%3</p>",
                                  {Escaped(here.Text(OwnText::PageIsGone)), Code(other.TextLanguage()),
                                   Escaped(other.Text(OwnText::PageIsGone))});
  return {.Path = "/missing",
          .Body = PageParts::Whole(
              {.Title = here.Text(OwnText::PageIsGone), .Path = {}, .Token = {}, .Main = main}, here)};
}

Page TokenPage(const PublicGame* newest) {
  const StringTable& texts = PageParts::TextsOf(Language::English);
  return {.Path = "/now", .Body = PageHash(newest != nullptr ? Board(*newest, {}, texts) : "")};
}

std::vector<Page> FixedPages() {
  return {{.Path = "/style.css", .Body = PageStyle()}, {.Path = "/follow.js", .Body = PageScript()}};
}
