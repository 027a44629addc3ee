#include "charts/HitMatrix.h"

#include <algorithm>
#include <utility>

namespace {

int TeamOfRecord(int index) {
  return TeamFromId(IdFromIndex(index));
}

/// Order of the players in the matrix.
std::pair<int, int> TeamAndNumber(const ChartPlayer& player) {
  return {TeamOfRecord(player.Index), PlayerNumberFromId(IdFromIndex(player.Index))};
}

}  // namespace

HitMatrix::HitMatrix(const ChartGame& game) : players_(game.Players), hasTeams_(!game.FreeForAll) {
  std::sort(players_.begin(), players_.end(), [](const ChartPlayer& left, const ChartPlayer& right) {
    return TeamAndNumber(left) < TeamAndNumber(right);
  });
  for (const ChartPlayer& player : players_) {
    const int team = TeamOfRecord(player.Index);
    if (groups_.empty() || groups_.back().Team != team) {
      groups_.push_back({team, static_cast<int>(teams_.size()), 0});
    }
    ++groups_.back().Count;
    teams_.push_back(team);
  }
  damage_.reserve(players_.size() * players_.size());
  for (const ChartPlayer& shooter : players_) {
    for (const ChartPlayer& victim : players_) {
      const std::int32_t hit = game.Game.Players(victim.Index).HitByPlayer(shooter.Index);
      damage_.push_back(std::max(hit, 0));
      most_ = std::max(most_, hit);
    }
  }
}

int HitMatrix::TeamAt(int place) const {
  return teams_[static_cast<std::size_t>(place)];
}
