#pragma once

#include <cstdint>
#include <vector>

#include "charts/ChartGame.h"

/// Who hit whom among the players of a chart. They stand by team, then by number; places count from 0.
class HitMatrix {
 public:
  /// The players of one team, who stand side by side.
  struct Group {
    int Team;
    int First;  ///< place
    int Count;
  };

  /// A matrix without players.
  HitMatrix() = default;
  explicit HitMatrix(const ChartGame& game);

  int Size() const { return static_cast<int>(players_.size()); }
  const ChartPlayer& PlayerAt(int place) const { return players_.at(static_cast<std::size_t>(place)); }
  int TeamAt(int place) const;
  const std::vector<Group>& Groups() const { return groups_; }

  /// Damage that the shooter did to the victim, never below 0.
  std::int32_t Damage(int shooter, int victim) const {
    return damage_[static_cast<std::size_t>(shooter) * players_.size() + static_cast<std::size_t>(victim)];
  }
  /// False in a free-for-all: whoever is hit is a foe there, whatever the colour of the gun.
  bool HasTeams() const { return hasTeams_; }
  /// True if both are on one team; also for a player and themselves.
  bool IsOwnTeam(int shooter, int victim) const { return hasTeams_ && TeamAt(shooter) == TeamAt(victim); }
  /// The highest damage of all; 0 if there was none.
  std::int32_t Most() const { return most_; }

 private:
  std::vector<ChartPlayer> players_;
  std::vector<int> teams_;
  std::vector<Group> groups_;
  std::vector<std::int32_t> damage_;  ///< a row for each shooter
  std::int32_t most_ = 0;
  bool hasTeams_ = true;
};
