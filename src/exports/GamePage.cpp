#include "exports/GamePage.h"

#include <algorithm>
#include <functional>
#include <utility>
#include <vector>

#include "core/game/Board.h"
#include "core/game/HitLines.h"
#include "core/game/IsButton.h"
#include "core/text/NumberForms.h"
#include "exports/HtmlPage.h"
#include "exports/HtmlText.h"

namespace {

constexpr int FirstBoardHeader = 103;

std::string HtmlOf(const StringTable& strings, int number) {
  return HtmlText(strings.Text(number));
}

std::string HtmlOf(const StringTable& strings, OwnText text) {
  return HtmlText(strings.Text(text));
}

std::string HeaderOf(const StringTable& strings, BoardColumn column) {
  return HtmlOf(strings, FirstBoardHeader + static_cast<int>(column));
}

/// A caption and its figure, both markup.
using Figure = std::pair<std::string, std::string>;

/// The figures of a player that a board shows behind the name.
std::vector<Figure> FiguresOf(const Standing& standing, const StringTable& strings) {
  return {{HeaderOf(strings, BoardColumn::Soldiering), std::to_string(standing.Soldiering)},
          {HeaderOf(strings, BoardColumn::Accuracy),
           standing.Accuracy ? FormatPercent(*standing.Accuracy) : std::string("N/A")},
          {HeaderOf(strings, BoardColumn::Damage), std::to_string(standing.DamageDealt)},
          {HtmlOf(strings, OwnText::PageDamageTaken), std::to_string(standing.DamageTaken)},
          {HeaderOf(strings, BoardColumn::ShotsFired), std::to_string(standing.Shots)},
          {HeaderOf(strings, BoardColumn::Wia), std::to_string(standing.Wia)},
          {HeaderOf(strings, BoardColumn::Kia), std::to_string(standing.Kia)},
          {HeaderOf(strings, BoardColumn::AmmoAdds), std::to_string(standing.AmmoAdds)}};
}

std::string TeamClass(int team) {
  return "t" + std::to_string(team);
}

std::string GameLink(const GamePageParts& parts) {
  return "game" + std::to_string(parts.Number);
}

/// What the links to a player's section call it.
std::string PlayerLink(const GamePageParts& parts, int index) {
  return GameLink(parts) + "-player" + std::to_string(index);
}

/// First and last name where the operator wants them; empty without any.
std::string FullNameHtml(const GamePageParts& parts, int index) {
  if (!parts.Personal.FullNames) {
    return {};
  }
  const FullName name = FullNameIn(parts.Game, index);
  std::string whole = name.First;
  whole.append(name.First.empty() || name.Last.empty() ? "" : " ").append(name.Last);
  return whole.empty() ? std::string() : HtmlName(whole);
}

/// The gun's team and number, with the team's badge.
std::string GunHtml(const GamePageParts& parts, int index) {
  const int team = TeamFromId(IdFromIndex(index));
  return "<span class=\"gun " + TeamClass(team) + "\">" + HtmlText(GunName(parts.Game.Game, index)) +
         "</span>";
}

std::string HeadOfPlayers(const StringTable& strings) {
  std::string html = "<thead><tr>";
  html.append(HtmlNumberHead(HeaderOf(strings, BoardColumn::Rank)));
  html.append(HtmlTextHead(HeaderOf(strings, BoardColumn::Player)));
  html.append(HtmlTextHead(HtmlOf(strings, OwnText::PageGun)));
  for (const auto& [caption, figure] : FiguresOf({}, strings)) {
    html.append(HtmlNumberHead(caption));
  }
  return html.append("</tr></thead>\n");
}

std::string RowOfPlayer(const GamePageParts& parts, const Standing& standing) {
  std::string html = "<tr>";
  html.append(HtmlNumberCell(std::to_string(standing.Place)));
  html.append("<th scope=\"row\"><a href=\"#").append(PlayerLink(parts, standing.Index)).append("\">");
  html.append(HtmlName(standing.PublicName)).append("</a>");
  if (const std::string name = FullNameHtml(parts, standing.Index); !name.empty()) {
    html.append(" <span class=\"quiet\">").append(name).append("</span>");
  }
  html.append("</th>").append(HtmlTextCell(GunHtml(parts, standing.Index)));
  for (const auto& [caption, figure] : FiguresOf(standing, parts.Strings)) {
    html.append(HtmlNumberCell(figure));
  }
  return html.append("</tr>\n");
}

/// The hits of one side, most damage first.
std::string HitsHtml(const GamePageParts& parts, OwnText caption, std::vector<Hit> hits) {
  std::string html = "<table>\n<caption>" + HtmlOf(parts.Strings, caption) + "</caption>\n";
  if (hits.empty()) {
    return html.append("<tbody><tr><td>")
        .append(HtmlOf(parts.Strings, OwnText::PageNobody))
        .append("</td></tr></tbody>\n</table>\n");
  }
  std::ranges::stable_sort(hits, std::greater(), &Hit::Amount);
  html.append("<thead><tr>").append(HtmlTextHead(HeaderOf(parts.Strings, BoardColumn::Player)));
  html.append(HtmlNumberHead(HeaderOf(parts.Strings, BoardColumn::Damage)))
      .append("</tr></thead>\n<tbody>\n");
  for (const Hit& hit : hits) {
    const int team = TeamFromId(IdFromIndex(hit.Index));
    html.append("<tr><td><span class=\"").append(TeamClass(team)).append("\">");
    html.append(HtmlName(NameInGame(parts.Game, hit.Index))).append("</span></td>");
    html.append(HtmlNumberCell(std::to_string(hit.Amount))).append("</tr>\n");
  }
  return html.append("</tbody>\n</table>\n");
}

/// What is known about the player's person, as far as the operator wants it to stand there.
std::vector<Figure> PersonOf(const GamePageParts& parts, int index) {
  const Player& record = parts.Game.Game.Players(index);
  std::vector<Figure> person;
  if (std::string name = FullNameHtml(parts, index); !name.empty()) {
    person.emplace_back(HtmlOf(parts.Strings, OwnText::PageFullName), std::move(name));
  }
  if (parts.Personal.MemberNumbers && record.MemberIndex != 0) {
    person.emplace_back(HtmlOf(parts.Strings, OwnText::PageMemberNumber), std::to_string(record.MemberIndex));
  }
  if (parts.Personal.Buttons && IsButton(record.DallasID)) {
    person.emplace_back(HtmlOf(parts.Strings, OwnText::PageButton), HtmlText(record.DallasID));
  }
  return person;
}

std::vector<Standing> SumsOfTeams(const ExportedGame& game) {
  std::vector<Standing> teams;
  for (int team = 1; team <= TeamCount; ++team) {
    const auto players = std::ranges::count(game.Standings, team, &Standing::Team);
    if (players != 0) {
      teams.push_back(
          {.Team = team, .Number = static_cast<int>(players), .Soldiering = game.Game.TeamTotals(team)});
    }
  }
  std::ranges::stable_sort(teams, std::greater(), &Standing::Soldiering);
  return teams;
}

}  // namespace

std::string TeamsHtml(const GamePageParts& parts) {
  std::string html = "<table class=\"teams\">\n<thead><tr>";
  html.append(HtmlNumberHead(HtmlOf(parts.Strings, 112))).append(HtmlTextHead(HtmlOf(parts.Strings, 113)));
  html.append(HtmlNumberHead(HtmlOf(parts.Strings, OwnText::PagePlayers)));
  html.append(HtmlNumberHead(HtmlOf(parts.Strings, 105))).append("</tr></thead>\n<tbody>\n");
  int place = 0;
  for (const Standing& team : SumsOfTeams(parts.Game)) {
    html.append("<tr>").append(HtmlNumberCell(std::to_string(++place)));
    html.append("<th scope=\"row\"><span class=\"").append(TeamClass(team.Team)).append("\">");
    html.append(HtmlText(parts.Game.Game.TeamNames(team.Team))).append("</span></th>");
    html.append(HtmlNumberCell(std::to_string(team.Number)));
    html.append(HtmlNumberCell(std::to_string(team.Soldiering))).append("</tr>\n");
  }
  return html.append("</tbody>\n</table>\n");
}

std::string BoardHtml(const GamePageParts& parts) {
  // Where it is wider than the screen, it scrolls by keys too.
  std::string html = "<div class=\"wide\" tabindex=\"0\" role=\"region\" aria-label=\"";
  html.append(HtmlOf(parts.Strings, 203)).append("\">\n<table>\n").append(HeadOfPlayers(parts.Strings));
  html.append("<tbody>\n");
  for (const Standing& standing : parts.Game.Standings) {
    html.append(RowOfPlayer(parts, standing));
  }
  return html.append("</tbody>\n</table>\n</div>\n");
}

std::string PlayerHtml(const GamePageParts& parts, const Standing& standing) {
  std::string html = "<section class=\"player\" id=\"" + PlayerLink(parts, standing.Index) + "\">\n";
  html.append("<h4>").append(HtmlName(standing.PublicName)).append(" <span class=\"quiet\">");
  html.append(GunHtml(parts, standing.Index)).append("</span></h4>\n<dl>\n");
  std::vector<Figure> figures = {
      {HeaderOf(parts.Strings, BoardColumn::Rank), std::to_string(standing.Place)}};
  for (const std::vector<Figure>& more :
       {FiguresOf(standing, parts.Strings), PersonOf(parts, standing.Index)}) {
    figures.insert(figures.end(), more.begin(), more.end());
  }
  for (const auto& [caption, figure] : figures) {
    html.append("<div><dt>").append(caption).append("</dt><dd>").append(figure).append("</dd></div>\n");
  }
  html.append("</dl>\n<div class=\"hits\">\n");
  html.append(HitsHtml(parts, OwnText::PageWhomIHit, HitsGivenBy(standing.Index, parts.Game.Game)));
  html.append(HitsHtml(parts, OwnText::PageWhoHitMe, HitsTakenBy(standing.Index, parts.Game.Game)));
  html.append("</div>\n<p class=\"back\"><a href=\"#").append(GameLink(parts)).append("\">");
  return html.append(HtmlOf(parts.Strings, OwnText::PageBackToBoard)).append("</a></p>\n</section>\n");
}

std::string GameHtml(const GamePageParts& parts) {
  const std::string& date = parts.Game.Game.GameDate;
  std::string html =
      "<article id=\"" + GameLink(parts) + "\">\n<h2>" + HtmlName(parts.Game.Mission) + "</h2>\n";
  html.append("<p class=\"quiet\">")
      .append(HtmlName(date.empty() ? parts.Game.Received : date))
      .append("</p>\n");
  if (!parts.Game.Standings.empty()) {
    html.append("<h3>").append(HtmlOf(parts.Strings, 201)).append("</h3>\n").append(TeamsHtml(parts));
  }
  html.append("<h3>").append(HtmlOf(parts.Strings, 203)).append("</h3>\n").append(BoardHtml(parts));
  if (!parts.Game.Standings.empty()) {
    html.append("<h3>").append(HtmlOf(parts.Strings, OwnText::PagePlayers)).append("</h3>\n");
  }
  for (const Standing& standing : parts.Game.Standings) {
    html.append(PlayerHtml(parts, standing));
  }
  return html.append("</article>\n");
}

GamesPage::GamesPage(const PersonalData& personal, const StringTable& strings)
    : personal_(personal), strings_(strings) {
  const std::string& title = strings.Text(OwnText::PageGameResults);
  html_.append(HtmlPageStart(title, strings.TextLanguage()));
  html_.append("<h1>").append(HtmlText(title)).append("</h1>\n");
}

void GamesPage::Add(const ExportedGame& game) {
  html_.append(GameHtml({.Game = game, .Strings = strings_, .Personal = personal_, .Number = ++number_}));
}

void GamesPage::End() {
  html_.append(HtmlPageEnd());
}

std::string GamesPage::Take() {
  return std::exchange(html_, {});
}
