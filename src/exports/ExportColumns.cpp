#include "exports/ExportColumns.h"

#include <array>
#include <charconv>
#include <cmath>

#include "core/game/IsButton.h"
#include "core/text/TextEncoding.h"

namespace {

ExportValue Whole(std::int64_t value) {
  return value;
}

/// The decimal number that the fewest digits of `value` stand for: 0.1 and not 0.10000000149.
ExportValue Fraction(float value) {
  if (!std::isfinite(value)) {
    return std::monostate();
  }
  std::array<char, 32> digits{};
  const char* end = std::to_chars(digits.data(), digits.data() + digits.size(), value).ptr;
  double decimal = 0;
  std::from_chars(digits.data(), end, decimal);
  return decimal;
}

/// In UTF-8, whatever an old file or table holds.
ExportValue WrittenText(const std::string& text) {
  return IsUtf8(text) ? text : Windows1252ToUtf8(text);
}

/// A text that may be missing.
ExportValue TextOrNone(const std::string& text) {
  return text.empty() ? ExportValue() : WrittenText(text);
}

void AddPersonal(NamedValues& values, const ExportedGame& game, int index, const PersonalData& personal) {
  const Player& record = game.Game.Players(index);
  if (personal.FullNames) {
    const FullName name = FullNameIn(game, index);
    values.push_back({"first_name", TextOrNone(name.First)});
    values.push_back({"last_name", TextOrNone(name.Last)});
  }
  if (personal.MemberNumbers) {
    values.push_back({"member", record.MemberIndex != 0 ? Whole(record.MemberIndex) : ExportValue()});
  }
  if (personal.Buttons) {
    values.push_back({"button", IsButton(record.DallasID) ? TextOrNone(record.DallasID) : ExportValue()});
  }
}

void AddRecord(NamedValues& values, const Player& record) {
  const NamedValue fields[] = {{"soldiering", Whole(record.Soldiering)},
                               {"bonus_points", Whole(record.BonusPoints)},
                               {"accuracy", Fraction(record.Accuracy)},
                               {"damage", Whole(record.TotalDamage)},
                               {"damage_unweighted", Whole(record.AbsoluteDamage)},
                               {"shots", Whole(record.ShotCount)},
                               {"heals", Whole(record.HealCount)},
                               {"deaths", Whole(record.DeathCount)},
                               {"ammo_adds", Whole(record.AmmoAddCount)},
                               {"respawns", Whole(record.RespawnCount)},
                               {"admin_kills", Whole(record.AdminKillCount)},
                               {"explosive_damage", Whole(record.ExplosiveDamage)},
                               {"radiation_damage", Whole(record.RadiationDamage)},
                               {"stuns", Whole(record.StunCount)},
                               {"primary_damage", Whole(record.PrimaryDamage)},
                               {"secondary_damage", Whole(record.SecondaryDamage)},
                               {"remaining_health", Whole(record.RemainingHealth)},
                               {"remaining_clips", Whole(record.RemainingClips)},
                               {"remaining_ammo", Whole(record.RemainingAmmo)},
                               {"run_minutes", Whole(record.RunCounter)},
                               {"power_cheat", Whole(record.PowerCheatFlag)},
                               {"committed", record.Committed}};
  values.insert(values.end(), std::begin(fields), std::end(fields));
}

/// Names of the columns about a team and about an objective set.
struct TeamColumns {
  const char* Name;
  const char* Total;
  const char* ObjectiveTeam;
  const char* Primary;
  const char* Secondary;
};

constexpr TeamColumns ColumnsOfTeams[TeamCount] = {
    {"team_1", "team_1_total", "objective_a_team", "objective_a_primary", "objective_a_secondary"},
    {"team_2", "team_2_total", "objective_b_team", "objective_b_primary", "objective_b_secondary"},
    {"team_3", "team_3_total", "objective_c_team", "objective_c_primary", "objective_c_secondary"}};

}  // namespace

NamedValues HeadOf(const ExportedGame& game, int number) {
  return {{"game", Whole(number)},
          {"received", TextOrNone(game.Received)},
          {"game_date", TextOrNone(game.Game.GameDate)},
          {"mission", WrittenText(game.Mission)}};
}

NamedValues RestOf(const ExportedGame& game) {
  NamedValues values;
  for (int team = 1; team <= TeamCount; ++team) {
    values.push_back({ColumnsOfTeams[team - 1].Name, WrittenText(game.Game.TeamNames(team))});
    values.push_back({ColumnsOfTeams[team - 1].Total, Whole(game.Game.TeamTotals(team))});
  }
  for (int set = 1; set <= TeamCount; ++set) {
    const ObjectiveTeam& objective = game.Game.ObjectiveTeams(set);
    values.push_back({ColumnsOfTeams[set - 1].ObjectiveTeam, WrittenText(objective.Name)});
    values.push_back({ColumnsOfTeams[set - 1].Primary, objective.PrimaryAchieved});
    values.push_back({ColumnsOfTeams[set - 1].Secondary, objective.SecondaryAchieved});
  }
  return values;
}

NamedValues PlayerOf(const ExportedGame& game, const Standing& standing, const PersonalData& personal) {
  const Player& record = game.Game.Players(standing.Index);
  NamedValues values = {{"place", Whole(standing.Place)},
                        {"rank", Whole(record.Rank)},
                        {"player", Whole(standing.Index)},
                        {"team", Whole(standing.Team)},
                        {"team_name", WrittenText(game.Game.TeamName(standing.Index))},
                        {"number", Whole(standing.Number)},
                        {"name", standing.PublicName}};
  AddPersonal(values, game, standing.Index, personal);
  AddRecord(values, record);
  values.push_back({"damage_taken", Whole(standing.DamageTaken)});
  return values;
}

NamedValues HitOf(const ExportedGame& game, const ExportedHit& hit) {
  return {{"shooter", Whole(hit.Shooter)},
          {"shooter_name", NameInGame(game, hit.Shooter)},
          {"victim", Whole(hit.Victim)},
          {"victim_name", NameInGame(game, hit.Victim)},
          {"damage", Whole(hit.Damage)}};
}

PlayerFigures FiguresOf(const ExportedGame& game, const Standing& standing, std::int64_t gameId,
                        bool fullNames) {
  const Player& record = game.Game.Players(standing.Index);
  return {.GameId = gameId,
          .Received = game.Received,
          .GameDate = game.Game.GameDate,
          .Mission = game.Mission,
          .Place = standing.Place,
          .Index = standing.Index,
          .Name = standing.PublicName,
          .Person = fullNames ? FullNameIn(game, standing.Index) : FullName(),
          .Member = record.MemberIndex,
          .Button = record.DallasID,
          .Soldiering = standing.Soldiering,
          .Accuracy = standing.Accuracy,
          .Damage = standing.DamageDealt,
          .Shots = standing.Shots,
          .Heals = standing.Wia,
          .Deaths = standing.Kia,
          .AmmoAdds = standing.AmmoAdds,
          .Committed = record.Committed,
          .DamageTaken = standing.DamageTaken};
}

std::vector<std::string_view> FigureColumns(const PersonalData& personal) {
  std::vector<std::string_view> names = {"game",   "received", "game_date", "mission", "place",
                                         "player", "team",     "number",    "name"};
  if (personal.FullNames) {
    names.insert(names.end(), {"first_name", "last_name"});
  }
  if (personal.MemberNumbers) {
    names.emplace_back("member");
  }
  if (personal.Buttons) {
    names.emplace_back("button");
  }
  names.insert(names.end(), {"soldiering", "accuracy", "damage", "shots", "heals", "deaths", "ammo_adds",
                             "committed", "damage_taken"});
  return names;
}

// Cell by cell and without a list of them: there may be millions of rows.
void WriteFigures(CsvWriter& writer, const PlayerFigures& figures, int number, const PersonalData& personal) {
  const auto textOrNone = [&writer](std::string_view text) {
    text.empty() ? writer.Empty() : writer.Text(text);
  };
  writer.Number(std::int64_t{number});
  textOrNone(figures.Received);
  textOrNone(figures.GameDate);
  writer.Text(figures.Mission);
  writer.Number(std::int64_t{figures.Place});
  writer.Number(std::int64_t{figures.Index});
  const std::uint8_t id = IdFromIndex(figures.Index);
  writer.Number(std::int64_t{TeamFromId(id)});
  writer.Number(std::int64_t{PlayerNumberFromId(id)});
  writer.Text(figures.Name);
  if (personal.FullNames) {
    textOrNone(figures.Person.First);
    textOrNone(figures.Person.Last);
  }
  if (personal.MemberNumbers) {
    figures.Member != 0 ? writer.Number(figures.Member) : writer.Empty();
  }
  if (personal.Buttons) {
    textOrNone(IsButton(figures.Button) ? figures.Button : std::string_view());
  }
  writer.Number(figures.Soldiering);
  figures.Accuracy ? writer.Number(*figures.Accuracy) : writer.Empty();
  for (const std::int64_t count :
       {figures.Damage, figures.Shots, figures.Heals, figures.Deaths, figures.AmmoAdds}) {
    writer.Number(count);
  }
  writer.Text(figures.Committed ? "true" : "false");
  writer.Number(figures.DamageTaken);
}
