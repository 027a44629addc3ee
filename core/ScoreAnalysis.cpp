#include "core/ScoreAnalysis.h"

#include <cmath>
#include <limits>
#include <utility>

#include "core/FieldValue.h"
#include "core/NumberForms.h"

namespace {

void AddTo(std::int32_t& sum, std::int32_t amount) {
  if (__builtin_add_overflow(sum, amount, &sum)) {
    throw RuntimeError(6);
  }
}

/// Adds own-team hits, weighted, each rounded by itself: half a point twice is nothing.
class FriendlyFire {
 public:
  explicit FriendlyFire(double factor)
      : factor_(factor),
        isWhole_(std::abs(factor) <= std::numeric_limits<std::int32_t>::max() &&
                 std::trunc(factor) == factor),
        wholeFactor_(isWhole_ ? static_cast<std::int64_t>(factor) : 0) {}

  void AddTo(std::int32_t& sum, std::int32_t amount) const {
    if (isWhole_) {  // the usual case: exact in integers, and many times faster
      const std::int64_t exact = amount * wholeFactor_ + sum;
      sum = static_cast<std::int32_t>(exact);
      if (sum != exact) {
        throw RuntimeError(6);
      }
    } else {
      sum = RoundToInt32(amount * static_cast<long double>(factor_) + sum);
    }
  }

 private:
  double factor_;
  bool isWhole_;
  std::int64_t wholeFactor_;
};

}  // namespace

void ScoreAnalysis::CalculateScores() {
  scoreDisplay_.Clear();
  teamScores_.Clear();
  for (std::int32_t& total : game_.TeamTotals) {
    total = 0;
  }
  missionPoints_.reset();
  AddUpDamage();
  for (int index = 1; index <= PlayerCount; ++index) {
    if (game_.Players(index).Active) {
      ScorePlayer(index);
    }
  }
  ListTeams();
  SortListNumeric(scoreDisplay_, static_cast<int>(BoardColumn::Soldiering), true, game_);
  SortListNumeric(teamScores_, static_cast<int>(BoardColumn::Soldiering), true, game_);
}

void ScoreAnalysis::AddUpDamage() {
  const FriendlyFire friendlyFire(factors_.FriendlyFire);
  const bool everyoneIsAFoe = missions_.ListIndex() == MissionList::FreeForAll;
  std::array<std::int32_t, PlayerCount> total{};
  std::array<std::int32_t, PlayerCount> absolute{};
  std::array<std::int16_t, PlayerCount> team{};
  for (int shooter = 0; shooter < PlayerCount; ++shooter) {
    team[shooter] = TeamFromId(IdFromIndex(shooter + 1));
  }
  // Each shooter's sums must grow in the order of the victims; the matrix lies in memory victim by victim.
  for (int victim = 0; victim < PlayerCount; ++victim) {
    const auto hits = game_.Players(victim + 1).HitByPlayer.begin();
    for (int shooter = 0; shooter < PlayerCount; ++shooter) {
      const std::int32_t hit = hits[shooter];
      if (!everyoneIsAFoe && team[shooter] == team[victim]) {
        friendlyFire.AddTo(total[shooter], hit);
      } else {
        AddTo(total[shooter], hit);
      }
      AddTo(absolute[shooter], hit);
    }
  }
  for (int shooter = 0; shooter < PlayerCount; ++shooter) {
    game_.Players(shooter + 1).TotalDamage = total[shooter];
    game_.Players(shooter + 1).AbsoluteDamage = absolute[shooter];
  }
}

void ScoreAnalysis::ScorePlayer(int index) {
  Player& player = game_.Players(index);
  const int team = TeamFromId(IdFromIndex(index));
  std::string playerText = PlayerText(index);
  CalculateAccuracy(player);
  CalculateSoldiering(player);
  AddMissionPoints(player, game_.TeamNames(team));
  scoreDisplay_.AddRow({Str(std::int32_t{player.Rank}), std::move(playerText), Str(player.Soldiering),
                        AccuracyText(player), Str(player.TotalDamage), Str(player.ShotCount),
                        Str(player.HealCount), Str(player.DeathCount), Str(player.AmmoAddCount)});
  AddTo(game_.TeamTotals(team), player.Soldiering);
}

std::string ScoreAnalysis::PlayerText(int index) {
  Player& player = game_.Players(index);
  if (player.MemberIndex == 0 && player.DallasID != NoDallasId) {
    player.MemberIndex = members_.FindByDallasId(player.DallasID);
  }
  std::string text = game_.DisplayName(index);
  if (player.MemberIndex != 0 && members_.LoadMember(player.MemberIndex)) {
    text += ": " + members_.GetPlayerName(true);
  }
  return text;
}

void ScoreAnalysis::CalculateAccuracy(Player& player) const {
  if (player.PrimaryDamage == 0) {
    return;
  }
  player.Accuracy = player.ShotCount > 0 ? static_cast<float>(static_cast<double>(player.AbsoluteDamage) /
                                                              player.PrimaryDamage / player.ShotCount)
                                         : 0.0F;
}

void ScoreAnalysis::CalculateSoldiering(Player& player) const {
  using Wide = long double;
  const Wide sum = player.HealCount * Wide{factors_.Heal} + player.TotalDamage * Wide{factors_.Damage} +
                   player.DeathCount * Wide{factors_.Death} + player.AmmoAddCount * Wide{factors_.Ammo} +
                   player.Accuracy * Wide{100} * Wide{factors_.Accuracy} + player.BonusPoints;
  player.Soldiering = RoundToInt32(sum);
}

void ScoreAnalysis::AddMissionPoints(Player& player, const std::string& teamName) {
  if (missions_.ListIndex() <= MissionList::FreeForAll) {
    return;
  }
  if (!missionPoints_) {
    if (!missions_.ActivateCurrentMissionRecord()) {
      return;
    }
    missionPoints_ = ReadMissionPoints();
  }
  const auto add = [&player](long double points) {
    player.Soldiering = RoundToInt32(player.Soldiering + points);
  };
  for (int set = 0; set < TeamCount; ++set) {
    const ObjectiveTeam& objective = game_.ObjectiveTeams(set + 1);
    if (objective.Name != teamName) {
      continue;
    }
    if (objective.PrimaryAchieved) {
      add(missionPoints_->Primary[set]);
    }
    if (objective.SecondaryAchieved) {
      add(missionPoints_->Secondary[set]);
    }
  }
  add(-static_cast<long double>(missionPoints_->RespawnPenalty) * player.RespawnCount);
  add(-static_cast<long double>(missionPoints_->HealPenalty) * player.HealCount);
}

ScoreAnalysis::MissionPoints ScoreAnalysis::ReadMissionPoints() {
  const auto number = [this](const std::string& column) { return NumberOf(missions_.Row().Fields(column)); };
  MissionPoints points{};
  for (int set = 0; set < TeamCount; ++set) {
    const char letter = static_cast<char>('A' + set);
    points.Primary[set] = number(std::string("PrimaryObjectivePoints") + letter);
    points.Secondary[set] = number(std::string("SecondaryObjectivePoints") + letter);
  }
  points.RespawnPenalty = number("RespawnPenalty");
  points.HealPenalty = number("HealPenalty");
  return points;
}

std::string ScoreAnalysis::AccuracyText(const Player& player) const {
  if (player.PrimaryDamage == 0) {
    return strings_.Text(126);
  }
  return player.ShotCount > 0 ? FormatPercent(player.Accuracy) : strings_.Text(129);
}

void ScoreAnalysis::ListTeams() {
  for (int team = 1; team <= TeamCount; ++team) {
    teamScores_.AddRow({Str(0), game_.TeamNames(team), Str(game_.TeamTotals(team))});
  }
}
