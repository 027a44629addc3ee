#include "exports/GameCsv.h"

#include <gmock/gmock.h>

#include "tests/exports/CsvRows.h"
#include "tests/exports/SampleGame.h"

namespace {

using testing::HasSubstr;
using testing::Not;

constexpr CsvForm Plain{.Separator = CsvSeparator::Comma, .ByteOrderMark = false};

constexpr const char* TeamHeaders =
    "team_1,team_1_total,team_2,team_2_total,team_3,team_3_total,"
    "objective_a_team,objective_a_primary,objective_a_secondary,"
    "objective_b_team,objective_b_primary,objective_b_secondary,"
    "objective_c_team,objective_c_primary,objective_c_secondary\r\n";

TEST(GameAsCsv, HasARowForEachPlayerWithBothPlaces) {
  const SampleGame sample;
  const std::string head = "1,2026-11-21 20:15:09,21/11/2026 20:15,The Night Courier,";
  const std::string rest = "Red,70,Blue,290,Yellow,-4,Red,false,false,Blue,true,false,Yellow,false,false\r\n";
  EXPECT_EQ(
      PlayersTable(sample.Games(), Plain, {}),
      std::string("game,received,game_date,mission,"
                  "place,rank,player,team,team_name,number,name,"
                  "soldiering,bonus_points,accuracy,damage,damage_unweighted,shots,heals,deaths,"
                  "ammo_adds,respawns,admin_kills,explosive_damage,radiation_damage,stuns,"
                  "primary_damage,secondary_damage,remaining_health,remaining_clips,remaining_ammo,"
                  "run_minutes,power_cheat,committed,damage_taken,") +
          TeamHeaders +  //
          head + "1,11,40,2,Blue,7,Mole,290,0,0.1,100,100,60,0,0,0,0,0,0,0,0,10,0,0,0,0,0,255,true,30," +
          rest +  //
          head + "2,2,1,1,Red,0,Red 0,70,0,0.375,30,30,8,0,0,0,0,0,0,0,0,10,0,0,0,0,0,0,false,40," +
          rest +  //
          head + "3,3,68,3,Yellow,3,Yellow 3,-4,0,0,0,0,0,0,0,0,0,0,0,0,0,10,0,0,0,0,0,0,false,50," + rest);
}

TEST(GameAsCsv, HasARowForEachHitAlsoOnThoseWhoTookNoPart) {
  const SampleGame sample;
  const std::string head = "1,2026-11-21 20:15:09,21/11/2026 20:15,The Night Courier,";
  EXPECT_EQ(HitsTable(sample.Games(), Plain),
            "game,received,game_date,mission,shooter,shooter_name,victim,victim_name,damage\r\n" +  //
                head + "1,Red 0,40,Mole,30\r\n" +                                                   //
                head + "40,Mole,1,Red 0,40\r\n" +                                                   //
                head + "40,Mole,10,Red 9,10\r\n" +                                                  //
                head + "40,Mole,68,Yellow 3,50\r\n");
}

TEST(GameAsCsv, HasTheSeparatorAndMarkThatWereChosen) {
  const SampleGame sample;
  const std::string semicolons = HitsTable(sample.Games(), {CsvSeparator::Semicolon, false});
  EXPECT_TRUE(semicolons.starts_with("game;received;game_date;mission;shooter;")) << semicolons;
  const std::string tabs = PlayersTable(sample.Games(), {CsvSeparator::Tab, true}, {});
  EXPECT_TRUE(tabs.starts_with("\xEF\xBB\xBFgame\treceived\tgame_date\tmission\tplace\t")) << tabs;
}

TEST(GameAsCsv, NumbersItsGames) {
  const SampleGame sample;
  std::vector<std::string> numbers;
  for (const CsvRecord& row : CsvRecords(HitsTable(sample.Games(3), Plain))) {
    numbers.push_back(row.at("game"));
  }
  EXPECT_THAT(numbers, testing::ElementsAre("1", "1", "1", "1", "2", "2", "2", "2", "3", "3", "3", "3"));
}

TEST(GameAsCsv, HasItsHeadersWithoutAnyGame) {
  const SampleGame sample;
  const std::string players = PlayersTable(sample.Games(0), Plain, EverythingPersonal);
  EXPECT_TRUE(players.starts_with("game,received,")) << players;
  EXPECT_EQ(players.find('\n'), players.size() - 1);
  EXPECT_EQ(HitsTable(sample.Games(0), Plain),
            "game,received,game_date,mission,shooter,shooter_name,victim,victim_name,damage\r\n");
}

TEST(GameAsCsv, TellsOfPersonsOnlyWhatWasTicked) {
  const SampleGame sample;
  const std::string discreet = PlayersTable(sample.Games(), Plain, {});
  for (const char* part :
       {"Ada", "Byron", "first_name", "last_name", "member", "button", "0123456789ABCDEF"}) {
    EXPECT_THAT(discreet, Not(HasSubstr(part)));
  }
  const auto all = CsvRecords(PlayersTable(sample.Games(), Plain, EverythingPersonal));
  ASSERT_EQ(all.size(), 3U);
  EXPECT_EQ(all[0].at("first_name"), "Ada");
  EXPECT_EQ(all[0].at("last_name"), "Byron");
  EXPECT_EQ(all[0].at("member"), "5");
  EXPECT_EQ(all[0].at("button"), "0123456789ABCDEF");
  for (const char* column : {"first_name", "last_name", "member", "button"}) {
    EXPECT_EQ(all[1].at(column), NoValue) << column;
  }
  const auto numbers = CsvRecords(PlayersTable(sample.Games(), Plain, {.MemberNumbers = true}));
  EXPECT_EQ(numbers[0].at("member"), "5");
  EXPECT_EQ(numbers[0].count("first_name") + numbers[0].count("last_name") + numbers[0].count("button"), 0U);
}

TEST(GameAsCsv, HasNoButtonForAPlayerWhoseFileToldNone) {
  SampleGame sample;
  sample.Game.Players(SampleGame::Red0).DallasID = "0";
  const auto all = CsvRecords(PlayersTable(sample.Games(), Plain, EverythingPersonal));
  ASSERT_EQ(all.size(), 3U);
  EXPECT_EQ(all[0].at("button"), "0123456789ABCDEF");
  EXPECT_EQ(all[1].at("button"), NoValue);
}

TEST(GameAsCsv, ReadsBackOddNamesAsTheyAre) {
  for (const std::string& name : OddNames) {
    SampleGame sample;
    sample.Mission = name;
    sample.Game.GameDate = name;
    sample.FullNames[SampleGame::Mole] = {name, name};
    for (const CsvSeparator separator : {CsvSeparator::Comma, CsvSeparator::Semicolon, CsvSeparator::Tab}) {
      const auto rows = CsvRecords(PlayersTable(sample.Games(), {separator, true}, EverythingPersonal));
      ASSERT_EQ(rows.size(), 3U) << name;
      for (const char* column : {"mission", "game_date", "first_name", "last_name"}) {
        EXPECT_EQ(rows[0].at(column), name) << column;
      }
      EXPECT_EQ(rows[0].at("damage_taken"), "30") << name;
    }
  }
}

TEST(GameAsCsv, HasNoCellThatASpreadsheetWouldRun) {
  SampleGame sample;
  sample.Mission = "=1+1";
  sample.NickNames[SampleGame::Mole] = "@SUM(A1)";
  const std::string players = PlayersTable(sample.Games(), Plain, {});
  EXPECT_THAT(players, HasSubstr(",'=1+1,"));
  EXPECT_THAT(players, HasSubstr(",'@SUM(A1),"));
  EXPECT_THAT(players, HasSubstr(",-4,"));  // numbers stay numbers
}

std::string FiguresTable(const SampleGame& sample, const PersonalData& personal, int games = 1) {
  FiguresCsv writer(Plain, personal);
  return Written(sample.Games(games), writer);
}

TEST(FiguresAsCsv, HaveARowForEachPlayer) {
  const SampleGame sample;
  const std::string head = "1,2026-11-21 20:15:09,21/11/2026 20:15,The Night Courier,";
  EXPECT_EQ(FiguresTable(sample, {}),
            "game,received,game_date,mission,place,player,team,number,name,soldiering,accuracy,damage,shots,"
            "heals,deaths,ammo_adds,committed,damage_taken\r\n" +  //
                head +
                "1,40,2,7,Mole,290,0.1,100,60,0,0,0,true,30\r\n" + head +
                "2,1,1,0,Red 0,70,0.375,30,8,0,0,0,false,40\r\n" + head +
                "3,68,3,3,Yellow 3,-4,,0,0,0,0,0,false,50\r\n");
}

TEST(FiguresAsCsv, SayWhatTheWholeTableSays) {
  SampleGame sample;
  sample.Game.Players(SampleGame::Red0).HealCount = 3;
  sample.Game.Players(SampleGame::Red0).DeathCount = 4;
  sample.Game.Players(SampleGame::Red0).AmmoAddCount = 5;
  const auto whole = CsvRecords(PlayersTable(sample.Games(2), Plain, EverythingPersonal));
  const auto figures = CsvRecords(FiguresTable(sample, EverythingPersonal, 2));
  ASSERT_EQ(figures.size(), whole.size());
  for (std::size_t row = 0; row < figures.size(); ++row) {
    EXPECT_EQ(figures[row].size(), 22U);
    for (const auto& [column, cell] : figures[row]) {
      const bool saysNothing = column == "accuracy" && whole[row].at("shots") == "0";
      EXPECT_EQ(cell, saysNothing ? NoValue : whole[row].at(column)) << column;
    }
  }
}

TEST(FiguresAsCsv, TellOfPersonsOnlyWhatWasTicked) {
  const SampleGame sample;
  const std::string discreet = FiguresTable(sample, {});
  for (const char* part :
       {"Ada", "Byron", "first_name", "last_name", "member", "button", "0123456789ABCDEF"}) {
    EXPECT_THAT(discreet, Not(HasSubstr(part)));
  }
  const auto names = CsvRecords(FiguresTable(sample, {.FullNames = true}));
  EXPECT_EQ(names[0].at("first_name") + names[0].at("last_name"), "AdaByron");
  EXPECT_EQ(names[1].at("first_name"), NoValue);
  EXPECT_EQ(CsvRecords(FiguresTable(sample, {.MemberNumbers = true}))[0].at("member"), "5");
  EXPECT_EQ(CsvRecords(FiguresTable(sample, {.Buttons = true}))[0].at("button"), "0123456789ABCDEF");
}

TEST(FiguresAsCsv, ReadBackOddNamesAsTheyAre) {
  for (const std::string& name : OddNames) {
    SampleGame sample;
    sample.Mission = name;
    sample.Game.GameDate = name;
    sample.FullNames[SampleGame::Mole] = {name, name};
    const auto whole = CsvRecords(PlayersTable(sample.Games(), Plain, EverythingPersonal));
    const auto rows = CsvRecords(FiguresTable(sample, EverythingPersonal));
    for (const char* column : {"mission", "game_date", "first_name", "last_name", "name"}) {
      EXPECT_EQ(rows[0].at(column), whole[0].at(column)) << column;
    }
  }
}

}  // namespace
