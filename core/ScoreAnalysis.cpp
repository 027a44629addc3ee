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

/// Shooters stand in blocks of 32 that belong to one team each.
constexpr int BlockSize = 32;
constexpr int BlockCount = PlayerCount / BlockSize;

using BlockSums = std::array<std::int32_t, BlockSize>;

/// Written so that the compiler adds several shooters at a time: overflows are gathered, and looked at once a
/// block.
void AddHits(BlockSums& sums, const std::int32_t* hits) {
  std::uint32_t overflows = 0;
  for (int i = 0; i < BlockSize; ++i) {
    const auto before = static_cast<std::uint32_t>(sums[i]);
    const auto hit = static_cast<std::uint32_t>(hits[i]);
    const std::uint32_t after = before + hit;
    overflows |= (after ^ before) & (after ^ hit);
    sums[i] = static_cast<std::int32_t>(after);
  }
  if (overflows >= 0x80000000U) {
    throw RuntimeError(6);
  }
}

/// Own-team hits are weighted and rounded each by itself: half a point twice is nothing.
void AddOwnTeamHits(BlockSums& sums, const std::int32_t* hits, double factor) {
  if (std::abs(factor) <= std::numeric_limits<std::int32_t>::max() && std::trunc(factor) == factor) {
    // The usual case: exact in integers, and many times faster.
    const auto wholeFactor = static_cast<std::int64_t>(factor);
    bool overflow = false;
    for (int i = 0; i < BlockSize; ++i) {
      const std::int64_t sum = hits[i] * wholeFactor + sums[i];
      sums[i] = static_cast<std::int32_t>(sum);
      overflow |= sums[i] != sum;
    }
    if (overflow) {
      throw RuntimeError(6);
    }
    return;
  }
  for (int i = 0; i < BlockSize; ++i) {
    sums[i] = RoundToInt32(hits[i] * static_cast<long double>(factor) + sums[i]);
  }
}

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
  const bool everyoneIsAFoe = missions_.ListIndex() == MissionList::FreeForAll;
  std::array<std::int16_t, BlockCount> teamOfBlock{};
  for (int block = 0; block < BlockCount; ++block) {
    teamOfBlock[block] = TeamFromId(IdFromIndex(block * BlockSize + 1));
  }
  std::array<BlockSums, BlockCount> total{};
  std::array<BlockSums, BlockCount> absolute{};
  // Each shooter's sums grow in the order of the victims, which is how the matrix lies in memory.
  for (int victim = 0; victim < PlayerCount; ++victim) {
    const std::int32_t* hits = &*game_.Players(victim + 1).HitByPlayer.begin();
    const int victimsTeam = teamOfBlock[victim / BlockSize];
    for (int block = 0; block < BlockCount; ++block, hits += BlockSize) {
      if (!everyoneIsAFoe && teamOfBlock[block] == victimsTeam) {
        AddOwnTeamHits(total[block], hits, factors_.FriendlyFire);
      } else {
        AddHits(total[block], hits);
      }
      AddHits(absolute[block], hits);
    }
  }
  for (int shooter = 0; shooter < PlayerCount; ++shooter) {
    Player& player = game_.Players(shooter + 1);
    player.TotalDamage = total[shooter / BlockSize][shooter % BlockSize];
    player.AbsoluteDamage = absolute[shooter / BlockSize][shooter % BlockSize];
  }
}

void ScoreAnalysis::ScorePlayer(int index) {
  Player& player = game_.Players(index);
  const int team = TeamFromId(IdFromIndex(index));
  // What may show a box comes before the row: a command given meanwhile can rebuild the lists.
  std::string playerText = PlayerText(index);
  CalculateAccuracy(player);
  CalculateSoldiering(player);
  AddMissionPoints(player, game_.TeamNames(team));
  ScoreList::Row& row = scoreDisplay_.AddRow();
  row.Cells[1] = std::move(playerText);
  row.Cells[0] = Str(std::int32_t{player.Rank});
  row.Cells[2] = Str(player.Soldiering);
  row.Cells[3] = AccuracyText(player);
  row.Cells[4] = Str(player.TotalDamage);
  row.Cells[5] = Str(player.ShotCount);
  row.Cells[6] = Str(player.HealCount);
  row.Cells[7] = Str(player.DeathCount);
  row.Cells[8] = Str(player.AmmoAddCount);
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
    ScoreList::Row& row = teamScores_.AddRow();
    row.Cells[0] = Str(0);
    row.Cells[1] = game_.TeamNames(team);
    row.Cells[2] = Str(game_.TeamTotals(team));
  }
}
