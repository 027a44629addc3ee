#include "core/game/ScoreAnalysis.h"

#include <array>
#include <cmath>
#include <limits>
#include <utility>
#include <vector>

#include "core/game/SoldieringTerms.h"
#include "core/text/NumberForms.h"

namespace {

void AddTo(std::int32_t& sum, std::int32_t amount) {
  if (__builtin_add_overflow(sum, amount, &sum)) {
    throw RuntimeError(Fault::Overflow);
  }
}

/// Players are in blocks of 32, each of one team.
constexpr int BlockSize = 32;
constexpr int BlockCount = PlayerCount / BlockSize;

std::array<int, BlockCount> TeamsOfBlocks() {
  std::array<int, BlockCount> teams{};
  for (int block = 0; block < BlockCount; ++block) {
    teams[block] = TeamFromId(IdFromIndex(block * BlockSize + 1));
  }
  return teams;
}

/// Damage that each player dealt to foes and to their own team, by record index minus 1.
struct DealtDamage {
  std::array<std::int32_t, PlayerCount> ToFoes{};
  std::array<std::int32_t, PlayerCount> ToOwnTeam{};
};

/// Adds a victim's hits from the shooters of one block. Returns false if a hit is negative or a sum left the
/// 32-bit range. Written so that the compiler vectorizes it.
bool AddHits(std::int32_t* sums, const std::int32_t* hits) {
  std::uint32_t signs = 0;
  for (int i = 0; i < BlockSize; ++i) {
    const std::uint32_t sum = static_cast<std::uint32_t>(sums[i]) + static_cast<std::uint32_t>(hits[i]);
    signs |= sum | static_cast<std::uint32_t>(hits[i]);
    sums[i] = static_cast<std::int32_t>(sum);
  }
  return signs <= std::numeric_limits<std::int32_t>::max();
}

AccuracyKind KindOfAccuracy(const Player& player) {
  if (player.PrimaryDamage == 0) {
    return AccuracyKind::NoPrimaryDamage;
  }
  return player.ShotCount > 0 ? AccuracyKind::Known : AccuracyKind::NoShots;
}

}  // namespace

bool ScoreAnalysis::CalculateScores() {
  players_.Clear();
  teams_.Clear();
  for (std::int32_t& total : game_.TeamTotals) {
    total = 0;
  }
  missionPoints_.reset();
  AddUpDamage();
  // Listed once all are scored, so that nobody sees a part of the rows, whether a box is open or a figure
  // overflows.
  std::vector<BoardRow> rows;
  for (int index = 1; index <= PlayerCount; ++index) {
    if (!game_.Players(index).Active) {
      continue;
    }
    std::optional<BoardRow> row = ScorePlayer(index);
    if (!row) {
      return false;
    }
    rows.push_back(std::move(*row));
  }
  for (BoardRow& row : rows) {
    players_.AddRow(std::move(row));
  }
  ListTeams();
  SortListNumeric(players_, BoardColumn::Soldiering, true, game_);
  SortListNumeric(teams_, BoardColumn::Soldiering, true, game_);
  return true;
}

void ScoreAnalysis::AddUpDamage() {
  if (!AddUpDamageAtOnce()) {
    AddUpDamageHitByHit();
  }
}

bool ScoreAnalysis::AddUpDamageAtOnce() {
  // A whole factor needs no rounding, so the order of the hits does not matter unless an intermediate sum
  // could leave the range.
  const bool isWhole = std::trunc(factors_.FriendlyFire) == factors_.FriendlyFire;
  const bool countsFriendlyFire = missions_.ListIndex() != MissionList::FreeForAll;
  const std::array<int, BlockCount> teams = TeamsOfBlocks();
  DealtDamage dealt;
  bool inRange = isWhole && std::abs(factors_.FriendlyFire) <= std::numeric_limits<std::int32_t>::max();
  for (int victim = 0; victim < PlayerCount && inRange; ++victim) {
    const std::int32_t* hits = &*game_.Players(victim + 1).HitByPlayer.begin();
    const int team = teams[victim / BlockSize];
    for (int block = 0; block < BlockCount; ++block) {
      auto& sums = countsFriendlyFire && teams[block] == team ? dealt.ToOwnTeam : dealt.ToFoes;
      const auto first = static_cast<std::size_t>(block) * BlockSize;
      inRange &= AddHits(&sums[first], hits + first);
    }
  }
  const auto factor = inRange ? static_cast<std::int64_t>(factors_.FriendlyFire) : 0;
  for (int shooter = 0; shooter < PlayerCount && inRange; ++shooter) {
    const std::int64_t toFoes = dealt.ToFoes[shooter];
    const std::int64_t toOwnTeam = dealt.ToOwnTeam[shooter];
    inRange = std::abs(toOwnTeam * factor) + toFoes + toOwnTeam <= std::numeric_limits<std::int32_t>::max();
    Player& player = game_.Players(shooter + 1);
    player.TotalDamage = static_cast<std::int32_t>(toFoes + toOwnTeam * factor);
    player.AbsoluteDamage = static_cast<std::int32_t>(toFoes + toOwnTeam);
  }
  return inRange;
}

void ScoreAnalysis::AddUpDamageHitByHit() {
  for (Player& player : game_.Players) {
    player.TotalDamage = 0;
    player.AbsoluteDamage = 0;
  }
  // Each shooter's hits are added in the order of the victims, which is also their order in memory.
  for (int victim = 1; victim <= PlayerCount; ++victim) {
    for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
      const std::int32_t hit = game_.Players(victim).HitByPlayer(shooter);
      Player& player = game_.Players(shooter);
      if (IsOwnTeamHit(victim, shooter)) {
        // Rounded hit by hit: half a point twice adds nothing.
        player.TotalDamage =
            RoundToInt32(hit * static_cast<long double>(factors_.FriendlyFire) + player.TotalDamage);
      } else {
        AddTo(player.TotalDamage, hit);
      }
      AddTo(player.AbsoluteDamage, hit);
    }
  }
}

bool ScoreAnalysis::IsOwnTeamHit(int victim, int shooter) const {
  return missions_.ListIndex() != MissionList::FreeForAll &&
         TeamFromId(IdFromIndex(victim)) == TeamFromId(IdFromIndex(shooter));
}

std::optional<BoardRow> ScoreAnalysis::ScorePlayer(int index) {
  const auto overtaken = [this, clears = players_.Clears()] { return players_.Clears() != clears; };
  Player& player = game_.Players(index);
  const int team = TeamFromId(IdFromIndex(index));
  std::string memberName = NameOfMember(player);
  if (overtaken()) {
    return std::nullopt;
  }
  CalculateAccuracy(player);
  player.Soldiering = RoundToInt32(SoldieringTermsOf(player, factors_).Sum());
  AddMissionPoints(player, game_.TeamNames(team));
  if (overtaken()) {
    return std::nullopt;
  }
  AddTo(game_.TeamTotals(team), player.Soldiering);
  return BoardRow{.Index = index,
                  .Team = team,
                  .MemberName = std::move(memberName),
                  .Soldiering = player.Soldiering,
                  .HasAccuracy = KindOfAccuracy(player),
                  .Accuracy = player.Accuracy,
                  .Damage = player.TotalDamage,
                  .ShotsFired = player.ShotCount,
                  .Wia = player.HealCount,
                  .Kia = player.DeathCount,
                  .AmmoAdds = player.AmmoAddCount};
}

std::string ScoreAnalysis::NameOfMember(Player& player) {
  if (player.MemberIndex == 0 && player.DallasID != NoDallasId) {
    player.MemberIndex = members_.FindByDallasId(player.DallasID);
  }
  if (player.MemberIndex == 0) {
    return {};
  }
  const std::optional<Member> member = members_.LoadMember(player.MemberIndex);
  return member ? member->GetPlayerName(true) : std::string();
}

void ScoreAnalysis::CalculateAccuracy(Player& player) const {
  if (player.PrimaryDamage == 0) {
    return;
  }
  player.Accuracy = player.ShotCount > 0 ? static_cast<float>(static_cast<double>(player.AbsoluteDamage) /
                                                              player.PrimaryDamage / player.ShotCount)
                                         : 0.0F;
}

void ScoreAnalysis::AddMissionPoints(Player& player, const std::string& teamName) {
  if (!missionPoints_) {
    if (!missions_.ActivateCurrentMissionRecord()) {
      return;
    }
    missionPoints_ = ReadMissionPoints(missions_.Row());
  }
  player.Soldiering = WithObjectivePoints(player.Soldiering, *missionPoints_, game_.ObjectiveTeams, teamName);
  player.Soldiering = WithPenalties(player.Soldiering, *missionPoints_, player);
}

void ScoreAnalysis::ListTeams() {
  for (int team = 1; team <= TeamCount; ++team) {
    teams_.AddRow({.Team = team, .Soldiering = game_.TeamTotals(team)});
  }
}
