#include "exports/GamePage.h"

#include <gmock/gmock.h>

#include <pugixml.hpp>
#include <set>

#include "core/text/Filled.h"
#include "tests/exports/SampleGame.h"
#include "tests/support/RandomGame.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

/// All text below a node, as a reader sees it.
std::string TextIn(const pugi::xml_node& node) {
  std::string text = node.value();
  for (const pugi::xml_node child : node.children()) {
    text.append(TextIn(child));
  }
  return text;
}

/// A page that was parsed: the markup is written so that a parser of XML takes it too and finds each fault.
class Page {
 public:
  explicit Page(std::string html) : Html(std::move(html)) {
    const auto result = document_.load_string(
        Html.c_str(), pugi::parse_default | pugi::parse_doctype | pugi::parse_ws_pcdata);
    EXPECT_TRUE(result) << result.description() << " at " << Html.substr(result.offset, 40);
  }

  std::vector<std::string> Texts(const std::string& path) const {
    std::vector<std::string> texts;
    for (const pugi::xpath_node& found : document_.select_nodes(path.c_str())) {
      texts.push_back(found.attribute() ? found.attribute().value() : TextIn(found.node()));
    }
    return texts;
  }

  /// Cells of each row of the table at `path`.
  std::vector<std::vector<std::string>> Rows(const std::string& path) const {
    std::vector<std::vector<std::string>> rows;
    for (const pugi::xpath_node& found : document_.select_nodes((path + "//tr").c_str())) {
      std::vector<std::string>& cells = rows.emplace_back();
      for (const pugi::xml_node cell : found.node().children()) {
        cells.push_back(TextIn(cell));
      }
    }
    return rows;
  }

  const std::string Html;

 private:
  pugi::xml_document document_;
};

Page PageOf(const SampleGame& sample, const PersonalData& personal = {}, int games = 1) {
  return Page(PageText(sample.Games(games), personal, sample.Strings));
}

constexpr const char* Board = "//div[@class='wide']/table";
constexpr const char* Mole = "//section[@id='game1-player40']";

TEST(PageOfAGame, HasTheBoardInTheOrderOfTheStandings) {
  const Page page = PageOf(SampleGame());
  EXPECT_THAT(
      page.Rows(Board),
      ElementsAre(ElementsAre("Rank", "Player", "Gun", "Soldiering", "Accuracy", "Damage", "Damage Taken",
                              "Shots Fired", "W.I.A.", "K.I.A.", "Ammo Adds"),
                  ElementsAre("1", "Mole", "Blue 7", "290", "10.00%", "100", "30", "60", "0", "0", "0"),
                  ElementsAre("2", "Red 0", "Red 0", "70", "37.50%", "30", "40", "8", "0", "0", "0"),
                  ElementsAre("3", "Yellow 3", "Yellow 3", "-4", "N/A", "0", "50", "0", "0", "0", "0")));
}

TEST(PageOfAGame, ShowsNothingOfTheBoardsRanks) {
  SampleGame sample;
  const std::string before = PageOf(sample).Html;
  for (const int index : {SampleGame::Red0, SampleGame::Blue7, SampleGame::Yellow3}) {
    sample.Game.Players(index).Rank = 77;
  }
  EXPECT_EQ(PageOf(sample).Html, before);
}

TEST(PageOfAGame, HasMissionDateAndTeams) {
  const Page page = PageOf(SampleGame());
  EXPECT_THAT(page.Texts("//title"), ElementsAre("Game results"));
  EXPECT_THAT(page.Texts("//h2"), ElementsAre("The Night Courier"));
  EXPECT_THAT(page.Texts("//article/p"), ElementsAre("21/11/2026 20:15"));
  EXPECT_THAT(
      page.Rows("//table[@class='teams']"),
      ElementsAre(ElementsAre("Rank", "Team", "Players", "Soldiering"), ElementsAre("1", "Blue", "1", "290"),
                  ElementsAre("2", "Red", "1", "70"), ElementsAre("3", "Yellow", "1", "-4")));
}

TEST(PageOfAGame, LeavesOutTeamsThatTookNoPart) {
  SampleGame sample;
  sample.Game.Players(SampleGame::Red0).Active = false;
  EXPECT_THAT(PageOf(sample).Rows("//table[@class='teams']/tbody"),
              ElementsAre(ElementsAre("1", "Blue", "1", "290"), ElementsAre("2", "Yellow", "1", "-4")));
}

TEST(PageOfAGame, HasWhenItCameInWhereItHasNoDate) {
  SampleGame sample;
  sample.Game.GameDate.clear();
  EXPECT_THAT(PageOf(sample).Texts("//article/p"), ElementsAre("2026-11-21 20:15:09"));
}

TEST(PageOfAGame, TellsEachPlayerWhomTheyHitAndWhoHitThem) {
  const Page page = PageOf(SampleGame());
  EXPECT_EQ(page.Texts("//section").size(), 3U);
  EXPECT_THAT(page.Texts(std::string(Mole) + "//h4"), ElementsAre("Mole Blue 7"));
  EXPECT_THAT(page.Texts(std::string(Mole) + "//caption"), ElementsAre("Whom I hit", "Who hit me"));
  EXPECT_THAT(
      page.Rows(std::string(Mole) + "//table[1]/tbody"),
      ElementsAre(ElementsAre("Yellow 3", "50"), ElementsAre("Red 0", "40"), ElementsAre("Red 9", "10")));
  EXPECT_THAT(page.Rows(std::string(Mole) + "//table[2]/tbody"), ElementsAre(ElementsAre("Red 0", "30")));
  EXPECT_THAT(page.Rows("//section[@id='game1-player68']//table[1]"), ElementsAre(ElementsAre("Nobody")));
  EXPECT_THAT(page.Texts(std::string(Mole) + "//dd"),
              ElementsAre("1", "290", "10.00%", "100", "30", "60", "0", "0", "0"));
}

TEST(PageOfAGame, HasLinksThatLeadToItsOwnParts) {
  const Page page = PageOf(SampleGame(), {}, 2);
  const std::vector<std::string> ids = page.Texts("//@id");
  EXPECT_EQ(ids.size(), 8U);
  const std::set<std::string> known(ids.begin(), ids.end());
  EXPECT_EQ(known.size(), ids.size());
  const std::vector<std::string> links = page.Texts("//@href");
  EXPECT_EQ(links.size(), 12U);
  for (const std::string& link : links) {
    EXPECT_TRUE(link.starts_with('#') && known.contains(link.substr(1))) << link;
  }
}

TEST(PageOfAGame, IsOneFileWithoutOutsideParts) {
  const std::string html = PageOf(SampleGame()).Html;
  EXPECT_TRUE(html.starts_with("<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\"/>\n"));
  for (const char* outside :
       {"http:", "https:", "//", "src=", "url(", "@import", "<script", "<link", "<img"}) {
    EXPECT_THAT(html, Not(HasSubstr(outside)));
  }
  EXPECT_THAT(html, HasSubstr("default-src 'none'"));
}

TEST(PageOfAGame, ShowsOddNamesAsTheyAre) {
  for (const std::string& name : OddNames) {
    SampleGame sample;
    sample.Mission = name;
    sample.Game.GameDate = name;
    sample.Game.TeamNames(2) = name;
    sample.NickNames[SampleGame::Mole] = name;
    sample.FullNames[SampleGame::Mole] = {name, name};
    const Page page = PageOf(sample, EverythingPersonal);
    EXPECT_EQ(page.Rows(Board).size(), 4U) << name;
    EXPECT_EQ(page.Texts("//section").size(), 3U) << name;
    EXPECT_THAT(page.Texts("//script"), IsEmpty()) << name;
    EXPECT_EQ(page.Texts("//h2/bdi").size(), 1U) << name;
  }
  SampleGame sample;
  sample.Mission = OddNames[0];
  sample.FullNames[SampleGame::Mole] = {OddNames[1], std::string(10000, 'x')};
  const Page page = PageOf(sample, EverythingPersonal);
  EXPECT_THAT(page.Texts("//h2"), ElementsAre(OddNames[0]));
  EXPECT_THAT(page.Texts("//th/span/bdi"), ElementsAre(OddNames[1] + " " + std::string(10000, 'x')));
}

TEST(PageOfAGame, TellsOfPersonsOnlyWhatWasTicked) {
  SampleGame sample;
  sample.Game.Players(SampleGame::Red0).DallasID = "0";  // its file told no button
  const std::string discreet = PageOf(sample).Html;
  for (const char* part : {"Ada", "Byron", "Member No.", "Button", "0123456789ABCDEF"}) {
    EXPECT_THAT(discreet, Not(HasSubstr(part)));
  }
  const std::string captions = std::string(Mole) + "//div[dt='%1']/dd";
  const auto figure = [&](const Page& page, const char* caption) {
    return page.Texts(Filled(captions, {caption}));
  };
  const Page all = PageOf(sample, EverythingPersonal);
  EXPECT_THAT(figure(all, "Name"), ElementsAre("Ada Byron"));
  EXPECT_THAT(figure(all, "Member No."), ElementsAre("5"));
  EXPECT_THAT(figure(all, "Button"), ElementsAre("0123456789ABCDEF"));
  EXPECT_EQ(all.Texts("//dt[.='Button']").size(), 1U);  // the two others have none
  const Page named = PageOf(sample, {.FullNames = true});
  EXPECT_THAT(figure(named, "Name"), ElementsAre("Ada Byron"));
  EXPECT_THAT(named.Html, Not(HasSubstr("0123456789ABCDEF")));
  EXPECT_THAT(figure(named, "Member No."), IsEmpty());
}

TEST(PageOfAGame, IsInTheProgramsLanguage) {
  const Page page = PageOf(SampleGame(Language::SimplifiedChinese), EverythingPersonal);
  EXPECT_THAT(page.Texts("/html/@lang"), ElementsAre("zh-Hans"));
  EXPECT_THAT(page.Texts("//title"), ElementsAre("比赛结果"));
  EXPECT_THAT(page.Rows(Board)[0], ElementsAre("名次", "玩家", "枪号", "战功", "命中率", "伤害", "承受伤害",
                                               "射击次数", "负伤", "阵亡", "补弹"));
  EXPECT_EQ(page.Rows(Board)[2][2], "红队 0");
  EXPECT_THAT(page.Texts(std::string(Mole) + "//caption"), ElementsAre("我击中了谁", "谁击中了我"));
  EXPECT_THAT(page.Texts(std::string(Mole) + "//p"), ElementsAre("返回计分板"));
}

TEST(PageOfAGame, HoldsAGameWithoutPlayers) {
  SampleGame sample;
  sample.Game.Clear();
  const Page page = PageOf(sample);
  EXPECT_EQ(page.Rows(Board).size(), 1U);
  EXPECT_THAT(page.Texts("//section"), IsEmpty());
  EXPECT_THAT(page.Texts("//h3"), ElementsAre("Player Rank"));
}

TEST(PageOfAGame, HoldsTheFullestGame) {
  SampleGame sample;
  sample.Game.Clear();
  FillRandomly(sample.Game, PlayerCount, 11);
  const Page page = PageOf(sample);
  EXPECT_EQ(page.Rows(Board).size(), 1U + PlayerCount);
  EXPECT_EQ(page.Texts("//section").size(), std::size_t{PlayerCount});
}

}  // namespace
