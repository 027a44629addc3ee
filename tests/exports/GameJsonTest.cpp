#include "exports/GameJson.h"

#include <gmock/gmock.h>

#include <nlohmann/json.hpp>

#include "exports/GameCsv.h"
#include "tests/exports/CsvRows.h"
#include "tests/exports/SampleGame.h"
#include "tests/support/RandomGame.h"

namespace {

using nlohmann::ordered_json;
using testing::HasSubstr;
using testing::Not;

/// A value as a table has it.
std::string CellOf(const ordered_json& value) {
  if (value.is_null()) {
    return NoValue;
  }
  if (value.is_string()) {
    return value.get<std::string>();
  }
  const std::string text = value.dump();
  return text.ends_with(".0") ? text.substr(0, text.size() - 2) : text;
}

/// A game's own values and those of one entry of its lists, as a table has them.
CsvRecord RecordOf(const ordered_json& game, const ordered_json& entry, bool withTeams) {
  CsvRecord record;
  for (const auto& [key, value] : game.items()) {
    const bool isAboutTeams = key.starts_with("team_") || key.starts_with("objective_");
    if (!value.is_array() && (withTeams || !isAboutTeams)) {
      record[key] = CellOf(value);
    }
  }
  for (const auto& [key, value] : entry.items()) {
    record[key] = CellOf(value);
  }
  return record;
}

std::vector<CsvRecord> RecordsOf(const ordered_json& document, const char* list, bool withTeams) {
  std::vector<CsvRecord> records;
  for (const ordered_json& game : document.at("games")) {
    for (const ordered_json& entry : game.at(list)) {
      records.push_back(RecordOf(game, entry, withTeams));
    }
  }
  return records;
}

TEST(GameAsJson, IsAnObjectWithFormatAndVersion) {
  const SampleGame sample;
  EXPECT_EQ(JsonText(sample.Games(0), {}),
            "{\"format\": \"tessarine-games\", \"version\": 1, \"games\": []}\n");
}

TEST(GameAsJson, HasEachPlayerAndHitInALineOfItsOwn) {
  const SampleGame sample;
  EXPECT_EQ(
      JsonText(sample.Games(), {}),
      "{\"format\": \"tessarine-games\", \"version\": 1, \"games\": [\n"
      R"({"game":1,"received":"2026-11-21 20:15:09","game_date":"21/11/2026 20:15",)"
      R"("mission":"The Night Courier","team_1":"Red","team_1_total":70,"team_2":"Blue","team_2_total":290,)"
      R"("team_3":"Yellow","team_3_total":-4,)"
      R"("objective_a_team":"Red","objective_a_primary":false,"objective_a_secondary":false,)"
      R"("objective_b_team":"Blue","objective_b_primary":true,"objective_b_secondary":false,)"
      R"("objective_c_team":"Yellow","objective_c_primary":false,"objective_c_secondary":false,)"
      "\n\"players\": [\n"
      R"({"place":1,"rank":11,"player":40,"team":2,"team_name":"Blue","number":7,"name":"Mole",)"
      R"("soldiering":290,"bonus_points":0,"accuracy":0.1,"damage":100,"damage_unweighted":100,"shots":60,)"
      R"("heals":0,"deaths":0,"ammo_adds":0,"respawns":0,"admin_kills":0,"explosive_damage":0,)"
      R"("radiation_damage":0,"stuns":0,"primary_damage":10,"secondary_damage":0,"remaining_health":0,)"
      R"("remaining_clips":0,"remaining_ammo":0,"run_minutes":0,"power_cheat":255,"committed":true,)"
      "\"damage_taken\":30},\n"
      R"({"place":2,"rank":2,"player":1,"team":1,"team_name":"Red","number":0,"name":"Red 0",)"
      R"("soldiering":70,"bonus_points":0,"accuracy":0.375,"damage":30,"damage_unweighted":30,"shots":8,)"
      R"("heals":0,"deaths":0,"ammo_adds":0,"respawns":0,"admin_kills":0,"explosive_damage":0,)"
      R"("radiation_damage":0,"stuns":0,"primary_damage":10,"secondary_damage":0,"remaining_health":0,)"
      R"("remaining_clips":0,"remaining_ammo":0,"run_minutes":0,"power_cheat":0,"committed":false,)"
      "\"damage_taken\":40},\n"
      R"({"place":3,"rank":3,"player":68,"team":3,"team_name":"Yellow","number":3,"name":"Yellow 3",)"
      R"("soldiering":-4,"bonus_points":0,"accuracy":0.0,"damage":0,"damage_unweighted":0,"shots":0,)"
      R"("heals":0,"deaths":0,"ammo_adds":0,"respawns":0,"admin_kills":0,"explosive_damage":0,)"
      R"("radiation_damage":0,"stuns":0,"primary_damage":10,"secondary_damage":0,"remaining_health":0,)"
      R"("remaining_clips":0,"remaining_ammo":0,"run_minutes":0,"power_cheat":0,"committed":false,)"
      "\"damage_taken\":50}\n],\n"
      "\"hits\": [\n"
      R"({"shooter":1,"shooter_name":"Red 0","victim":40,"victim_name":"Mole","damage":30},)"
      "\n"
      R"({"shooter":40,"shooter_name":"Mole","victim":1,"victim_name":"Red 0","damage":40},)"
      "\n"
      R"({"shooter":40,"shooter_name":"Mole","victim":10,"victim_name":"Red 9","damage":10},)"
      "\n"
      R"({"shooter":40,"shooter_name":"Mole","victim":68,"victim_name":"Yellow 3","damage":50})"
      "\n]}\n]}\n");
}

TEST(GameAsJson, HoldsWhatTheTablesHoldAndNothingElse) {
  for (const PersonalData& personal : {PersonalData(), EverythingPersonal}) {
    SampleGame sample;
    sample.Game.Clear();
    FillRandomly(sample.Game, 40, 7);
    for (int index = 1; index <= PlayerCount; index += 3) {
      sample.Game.Players(index).MemberIndex = SampleGame::Mole;
    }
    const auto document = ordered_json::parse(JsonText(sample.Games(2), personal));
    const auto players = CsvRecords(PlayersTable(sample.Games(2), {}, personal));
    ASSERT_EQ(players.size(), 80U);
    EXPECT_EQ(RecordsOf(document, "players", true), players);
    const auto hits = CsvRecords(HitsTable(sample.Games(2), {}));
    ASSERT_GT(hits.size(), 100U);
    EXPECT_EQ(RecordsOf(document, "hits", false), hits);
  }
}

TEST(GameAsJson, HoldsAGameWithoutPlayersToo) {
  SampleGame sample;
  sample.Game.Clear();
  sample.Mission = "None";
  const auto document = ordered_json::parse(JsonText(sample.Games(), {}));
  EXPECT_EQ(document.at("games").size(), 1U);
  EXPECT_EQ(document.at("games")[0].at("mission"), "None");
  EXPECT_TRUE(document.at("games")[0].at("game_date").is_null());
  EXPECT_TRUE(document.at("games")[0].at("players").empty());
}

TEST(GameAsJson, TellsOfPersonsOnlyWhatWasTicked) {
  const SampleGame sample;
  const std::string discreet = JsonText(sample.Games(), {});
  for (const char* part : {"Ada", "Byron", "first_name", "member", "button", "0123456789ABCDEF"}) {
    EXPECT_THAT(discreet, Not(HasSubstr(part)));
  }
  const auto document = ordered_json::parse(JsonText(sample.Games(), EverythingPersonal));
  const ordered_json& players = document.at("games")[0].at("players");
  EXPECT_EQ(players[0].at("first_name"), "Ada");
  EXPECT_EQ(players[0].at("last_name"), "Byron");
  EXPECT_EQ(players[0].at("member"), 5);
  EXPECT_EQ(players[0].at("button"), "0123456789ABCDEF");
  EXPECT_TRUE(players[1].at("first_name").is_null());
  EXPECT_TRUE(players[1].at("member").is_null());
  EXPECT_TRUE(players[1].at("button").is_null());
}

TEST(GameAsJson, ReadsBackOddNamesAsTheyAre) {
  for (const std::string& name : OddNames) {
    SampleGame sample;
    sample.Mission = name;
    sample.FullNames[SampleGame::Mole] = {name, name};
    const auto document = ordered_json::parse(JsonText(sample.Games(), EverythingPersonal));
    EXPECT_EQ(document.at("games")[0].at("mission"), name);
    EXPECT_EQ(document.at("games")[0].at("players")[0].at("last_name"), name);
  }
}

TEST(GameAsJson, TakesTextsOfOldFilesForWindows1252) {
  SampleGame sample;
  sample.Mission = "Caf\xE9";
  const auto document = ordered_json::parse(JsonText(sample.Games(), {}));
  EXPECT_EQ(document.at("games")[0].at("mission"), "Caf\xC3\xA9");
}

}  // namespace
