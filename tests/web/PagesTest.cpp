#include "web/Pages.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <set>

#include "platform/Utf8.h"
#include "tests/web/Games.h"
#include "web/PageStream.h"

namespace {

using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;

std::string BodyOf(const std::vector<Page>& pages, const std::string& path) {
  const auto found = std::ranges::find(pages, path, &Page::Path);
  EXPECT_NE(found, pages.end()) << path;
  return found != pages.end() ? found->Body : "";
}

std::string BodyOf(const PublicGame& game, const std::string& path, Language language = Language::English) {
  return BodyOf(GamePages(game, language), path);
}

/// Every path that a page links to, made whole.
std::set<std::string> LinksOf(const Page& page) {
  std::set<std::string> links;
  const std::string& body = page.Body;
  for (std::size_t at = body.find("href="); at != std::string::npos; at = body.find("href=", at + 1)) {
    std::size_t start = at + 5;
    const bool quoted = body[start] == '"';
    start += quoted ? 1 : 0;
    std::string link = body.substr(start, body.find(quoted ? '"' : '>', start) - start);
    if (!link.starts_with('/')) {
      link = link == "./" ? "" : link;
      link.insert(0, page.Path.substr(0, page.Path.rfind('/') + 1));
    }
    links.insert(link);
  }
  return links;
}

TEST(PagesOfAGame, AreTheBoardTheGunsAndOneForEachPlayer) {
  std::vector<std::string> paths;
  for (const Page& page : GamePages(SmallGame(3), Language::English)) {
    paths.push_back(page.Path);
  }
  EXPECT_THAT(paths, ElementsAre("/en/g/3/", "/en/g/3/guns", "/en/g/3/40", "/en/g/3/1", "/en/g/3/68"));
}

TEST(PagesOfAGame, LinkOnlyToPagesThatThereAre) {
  const PublicGame game = SmallGame(3);
  std::vector<Page> pages = FixedPages();
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    for (const Page& page : GamePages(game, language)) {
      pages.push_back(page);
    }
    pages.push_back(FrontPage(&game, "1", language));
    pages.push_back(GamesPage({&game}, language));
  }
  pages.push_back(MissingPage(Language::English));
  std::set<std::string> paths;
  for (const Page& page : pages) {
    EXPECT_TRUE(IsPagePath(page.Path)) << page.Path;
    paths.insert(page.Path);
  }
  for (const Page& page : pages) {
    for (const std::string& link : LinksOf(page)) {
      EXPECT_TRUE(paths.contains(link)) << link << " on " << page.Path;
    }
  }
}

TEST(PagesOfAGame, AreInBothLanguages) {
  const PublicGame game = SmallGame();
  EXPECT_THAT(BodyOf(game, "/en/g/1/40"),
              AllOf(HasSubstr("<html lang=\"en\">"), HasSubstr("Whom I hit"), HasSubstr("Who hit me"),
                    HasSubstr("Place 1 of 3"), HasSubstr("Game 1, 20:15"), HasSubstr(">中文<")));
  EXPECT_THAT(BodyOf(game, "/zh/g/1/40", Language::SimplifiedChinese),
              AllOf(HasSubstr("<html lang=\"zh\">"), HasSubstr("我击中的玩家"), HasSubstr("击中我的玩家"),
                    HasSubstr("第 1 名，共 3 名"), HasSubstr("第 1 场, 20:15"), HasSubstr(">English<")));
}

TEST(PageOfAGun, HasItsFiguresAndHits) {
  const std::string page = BodyOf(SmallGame(), "/en/g/1/40");
  for (const char* figure : {"<th scope=row>Soldiering<td>120", "<th scope=row>Accuracy<td>46%",
                             "<th scope=row>Damage dealt<td>300", "<th scope=row>Damage taken<td>50",
                             "<th scope=row>Shots Fired<td>77", "<th scope=row>W.I.A.<td>2",
                             "<th scope=row>K.I.A.<td>1", "<th scope=row>Ammo Adds<td>4"}) {
    EXPECT_THAT(page, HasSubstr(figure));
  }
  EXPECT_THAT(page, HasSubstr("<b class=t1>R</b> <a href=1>Red 0</a><td>200<td>50\n"));
  EXPECT_THAT(page, HasSubstr("<b class=t3>Y</b> <a href=68>Yellow 3</a><td>100<td>-\n"));
}

TEST(PageOfAGun, SaysWhenItHitNobodyAndHasNoAccuracy) {
  EXPECT_THAT(BodyOf(SmallGame(), "/en/g/1/68"),
              AllOf(HasSubstr("<td>Nobody<td>-<td>-"), HasSubstr("<th scope=row>Accuracy<td>-")));
}

TEST(PageOfAGun, NamesAGunThatTookNoPartWithoutALink) {
  PublicGame game = SmallGame();
  game.Players[0].HitsTaken = {{.Gun = 2, .Amount = 9}};
  EXPECT_THAT(BodyOf(game, "/en/g/1/40"), HasSubstr("</b> Red 1<td>-<td>9\n"));
}

TEST(PageOfAGun, AddsUpTheHitsBeyondSixty) {
  const std::string page = BodyOf(FullGameOf(62), "/en/g/1/1");
  EXPECT_THAT(page, AllOf(HasSubstr("<tr><td>2 more<td>2123<td>2123"), Not(HasSubstr("<a href=61>"))));
}

TEST(PageOfABoard, HasTheRowsInTheirPlaces) {
  const std::string page = BodyOf(SmallGame(), "/en/g/1/");
  const std::size_t blue = page.find("<tr><td>1<td><b class=t2>B</b> <a href=\"40\"><bdi>Mole</bdi></a>");
  const std::size_t red = page.find("<tr><td>2<td><b class=t1>R</b> <a href=\"1\">Red 0</a>");
  EXPECT_NE(blue, std::string::npos);
  EXPECT_NE(red, std::string::npos);
  EXPECT_LT(blue, red);
}

TEST(PageOfABoard, HasTheTotalsOfTheTeamsThatPlayedHighestFirst) {
  PublicGame game = SmallGame();
  game.Players.pop_back();
  const std::string page = BodyOf(game, "/en/g/1/");
  const std::size_t blue = page.find("<span><b class=t2>B</b> Blue <strong>120</strong>");
  const std::size_t red = page.find("<span><b class=t1>R</b> Red <strong>30</strong>");
  EXPECT_LT(blue, red);
  EXPECT_NE(red, std::string::npos);
  EXPECT_THAT(page, Not(HasSubstr("Yellow")));
}

TEST(PageOfABoard, OfFortyPlayersIsSmallWithStyleAndScript) {
  std::size_t size = FrontPage(nullptr, "1", Language::English).Body.size();
  const PublicGame game = FullGameOf(40);
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    size = FrontPage(&game, "1", language).Body.size();
    for (const Page& page : FixedPages()) {
      size += page.Body.size();
    }
    EXPECT_LE(size, 30U * 1024);
    EXPECT_GE(size, 5000U);
  }
}

TEST(PageOfAllGuns, HasALinkForEachInTheOrderOfTheGuns) {
  const std::string page = BodyOf(SmallGame(), "/en/g/1/guns");
  const std::size_t red = page.find("<li><a href=1><b class=t1>R</b> Red 0</a>");
  const std::size_t blue = page.find("<li><a href=40><b class=t2>B</b> Blue 7<small><bdi>Mole</bdi></small>");
  EXPECT_LT(red, blue);
  EXPECT_NE(blue, std::string::npos);
}

TEST(AllPages, EscapeNames) {
  PublicGame game = SmallGame();
  game.Players[1].Name = R"("><script>x</script>)";
  game.Time = "<i>&";
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    std::vector<Page> pages = GamePages(game, language);
    pages.push_back(FrontPage(&game, "1", language));
    pages.push_back(GamesPage({&game}, language));
    for (const Page& page : pages) {
      EXPECT_THAT(page.Body, AllOf(Not(HasSubstr("<script>")), Not(HasSubstr("<i>")))) << page.Path;
    }
  }
  EXPECT_THAT(BodyOf(game, "/en/g/1/40"), HasSubstr("&quot;&gt;&lt;script&gt;x&lt;/script&gt;"));
}

TEST(AllPages, AreForAPhoneHeldUprightInTheLight) {
  EXPECT_THAT(FrontPage(nullptr, "1", Language::English).Body,
              HasSubstr(R"(<meta name="viewport" content="width=device-width,initial-scale=1">)"));
  EXPECT_THAT(BodyOf(FixedPages(), "/style.css"), HasSubstr("prefers-color-scheme:dark"));
}

/// How wide a caption is in letters of its size, in bold ones of a wide face.
double WidthOf(const std::string& caption) {
  double width = 0;
  for (std::size_t at = 0; at < caption.size(); at += Utf8::LengthOfCharacter(caption.substr(at))) {
    width += Utf8::LengthOfCharacter(caption.substr(at)) > 1 ? 1.0 : 0.65;
  }
  return width;
}

/// The figure behind `name` in the style, from the rules for narrow screens on.
double OnNarrowScreens(const std::string& name) {
  const std::string style = BodyOf(FixedPages(), "/style.css");
  const std::size_t narrow = style.find("@media(max-width:25rem)");
  const std::size_t at = style.find(name, narrow);
  EXPECT_NE(at, std::string::npos) << name;
  return at != std::string::npos ? std::stod(style.substr(at + name.size())) : 1000;
}

TEST(AllPages, LeaveNamesTheirWidthOnAScreenOf360Points) {
  constexpr double screen = 360.0 / 16;  // in rem
  constexpr double name = 7;
  EXPECT_THAT(BodyOf(FixedPages(), "/style.css"), HasSubstr(".who{width:99%;min-width:7rem}"));
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable texts(language);
    const std::vector<std::string> board{texts.Text(103), texts.Text(105), texts.Text(106), texts.Text(110)};
    const std::vector<std::string> ranking{texts.Text(103), texts.Text(OwnText::GamesPlayed), texts.Text(105),
                                           texts.Text(OwnText::BestGame)};
    for (const std::vector<std::string>& captions : {board, ranking}) {
      double width = 2 * OnNarrowScreens("padding:0 ") + name + 2 * OnNarrowScreens("td,th{padding:.4rem ");
      for (const std::string& caption : captions) {
        width +=
            WidthOf(caption) * OnNarrowScreens("th{font-size:") + 2 * OnNarrowScreens("td,th{padding:.4rem ");
      }
      EXPECT_LE(width, screen) << captions[1];
    }
  }
}

TEST(AllPages, BreakNeitherPlacesNorCaptions) {
  const std::string style = BodyOf(FixedPages(), "/style.css");
  EXPECT_THAT(style, HasSubstr(".board td:first-child,.ranks td:first-child{overflow-wrap:normal}"));
  EXPECT_THAT(style, HasSubstr("overflow-wrap:normal;word-break:keep-all}"));
  const PublicGame game = SmallGame();
  EXPECT_THAT(FrontPage(&game, "1", Language::SimplifiedChinese).Body,
              AllOf(HasSubstr("<table class=board>"), HasSubstr("<tr><td>1<td>")));
}

TEST(AllPages, HaveACaptionOverEachColumnAndOneHeadline) {
  const PublicGame game = SmallGame();
  std::vector<Page> pages = GamePages(game, Language::English);
  pages.push_back(FrontPage(&game, "1", Language::English));
  pages.push_back(GamesPage({&game}, Language::English));
  pages.push_back(MissingPage(Language::English));
  for (const Page& page : pages) {
    EXPECT_THAT(page.Body, AllOf(Not(HasSubstr("<th><")), Not(HasSubstr("<th>")))) << page.Path;
    const std::size_t headline = page.Body.find("<h1>");
    EXPECT_NE(headline, std::string::npos) << page.Path;
    EXPECT_EQ(page.Body.find("<h1>", headline + 1), std::string::npos) << page.Path;
  }
}

TEST(PageOfAGun, TellsTheGunBesideTheName) {
  EXPECT_THAT(BodyOf(SmallGame(), "/en/g/1/40"), HasSubstr("<bdi>Mole</bdi></h1><p class=lead>Blue 7</p>"));
  EXPECT_THAT(BodyOf(SmallGame(), "/en/g/1/1"), Not(HasSubstr("<p class=lead>Red 0</p>")));
}

TEST(FrontOfThePages, SaysThatThereIsNoGameYet) {
  EXPECT_THAT(FrontPage(nullptr, "1", Language::English).Body, HasSubstr("No game has been scored yet."));
  EXPECT_THAT(FrontPage(nullptr, "1", Language::SimplifiedChinese).Body, HasSubstr("还没有比赛成绩"));
}

TEST(FrontOfThePages, CarriesTheTokenThatItsScriptAsksFor) {
  const PublicGame game = SmallGame();
  const std::string token = TokenPage(&game).Body;
  EXPECT_THAT(FrontPage(&game, token, Language::English).Body, HasSubstr("data-now=\"" + token + "\""));
  EXPECT_THAT(BodyOf(game, "/en/g/1/"), AllOf(Not(HasSubstr("data-now")), HasSubstr("id=\"new\"")));
  EXPECT_THAT(BodyOf(FixedPages(), "/follow.js"),
              AllOf(HasSubstr("fetch(\"/now\","), HasSubstr("3000"), HasSubstr("AbortController")));
}

TEST(TokenOfTheNewestBoard, ChangesWithTheBoardAlone) {
  PublicGame game = SmallGame();
  const std::string before = TokenPage(&game).Body;
  EXPECT_EQ(TokenPage(&game).Body, before);
  EXPECT_NE(TokenPage(nullptr).Body, before);
  game.Players[0].Name.clear();
  EXPECT_NE(TokenPage(&game).Body, before);
}

TEST(ListOfGames, LinksToTheirBoards) {
  const PublicGame first = SmallGame(1);
  const PublicGame second = SmallGame(2);
  const std::string page = GamesPage({&second, &first}, Language::English).Body;
  EXPECT_LT(page.find("<a class=wide href=\"g/2/\">Game 2, 20:15</a>"),
            page.find("<a class=wide href=\"g/1/\">Game 1, 20:15</a>"));
  EXPECT_THAT(page, HasSubstr("href=\"g/1/\""));
}

}  // namespace
