#pragma once

#include <array>
#include <cmath>
#include <memory>
#include <vector>

#include "core/game/Board.h"
#include "core/game/Game.h"
#include "core/game/SoldieringFactors.h"
#include "core/text/NumberForms.h"
#include "tests/support/Described.h"
#include "tests/support/ScoredGame.h"

// The scores of a game the long way: plain loops, every rounding written out, nothing shared with the
// analysis.

/// Nearest integer, ties to even.
inline long long HalfEven(long double value) {
  const long double below = std::floor(value);
  const long double rest = value - below;
  const auto low = static_cast<long long>(below);
  return rest > 0.5L || (rest == 0.5L && low % 2 != 0) ? low + 1 : low;
}

/// The rewards of a mission, by objective set, and its penalties.
struct MissionPay {
  std::array<double, TeamCount> Primary{};
  std::array<double, TeamCount> Secondary{};
  double RespawnPenalty = 0;
  double HealPenalty = 0;
};

struct Reckoning {
  SoldieringFactors Factors;
  bool FreeForAll = false;
  const MissionPay* Mission = nullptr;
  ::SortOrder SortOrder = ::SortOrder::Descending;

  /// First index, team and first number of each block of the table.
  struct Block {
    int First;
    int Team;
    int Number;
  };
  static constexpr std::array<Block, 7> Blocks = {
      {{1, 1, 0}, {33, 2, 0}, {65, 3, 0}, {97, 1, 32}, {129, 1, 64}, {161, 2, 32}, {193, 2, 64}}};

  static const Block& BlockOf(int index) { return Blocks[static_cast<std::size_t>((index - 1) / 32)]; }
  static int TeamOf(int index) { return BlockOf(index).Team; }
  static int NumberOf(int index) { return BlockOf(index).Number + index - BlockOf(index).First; }

  /// Rewrites all calculated fields. Returns the indexes of the active players in the order of the board.
  std::vector<int> Score(Game& game) const {
    game.TeamTotals = {};
    for (int p = 1; p <= PlayerCount; ++p) {
      AddUpDamage(game, p);
      if (game.Players(p).Active) {
        ScoreOne(game, p);
        game.TeamTotals(TeamOf(p)) += game.Players(p).Soldiering;
      }
    }
    return Place(game);
  }

 private:
  void AddUpDamage(Game& game, int p) const {
    long long total = 0;
    long long absolute = 0;
    for (int q = 1; q <= PlayerCount; ++q) {
      const long long hit = game.Players(q).HitByPlayer(p);
      if (!FreeForAll && TeamOf(q) == TeamOf(p)) {
        total = HalfEven(static_cast<long double>(hit) * Factors.FriendlyFire + total);
      } else {
        total += hit;
      }
      absolute += hit;
    }
    game.Players(p).TotalDamage = static_cast<std::int32_t>(total);
    game.Players(p).AbsoluteDamage = static_cast<std::int32_t>(absolute);
  }

  void ScoreOne(Game& game, int p) const {
    Player& player = game.Players(p);
    if (player.PrimaryDamage != 0) {
      double accuracy = 0;
      if (player.ShotCount > 0) {
        accuracy = static_cast<double>(player.AbsoluteDamage) / player.PrimaryDamage;
        accuracy /= player.ShotCount;
      }
      player.Accuracy = static_cast<float>(accuracy);
    }
    long double sum = player.HealCount * static_cast<long double>(Factors.Heal);
    sum += player.TotalDamage * static_cast<long double>(Factors.Damage);
    sum += player.DeathCount * static_cast<long double>(Factors.Death);
    sum += player.AmmoAddCount * static_cast<long double>(Factors.Ammo);
    sum += player.Accuracy * 100.0L * Factors.Accuracy;
    sum += player.BonusPoints;
    long long score = HalfEven(sum);
    if (Mission != nullptr) {
      for (int set = 1; set <= TeamCount; ++set) {
        const auto at = static_cast<std::size_t>(set - 1);
        const ObjectiveTeam& objective = game.ObjectiveTeams(set);
        if (objective.Name == game.TeamNames(TeamOf(p))) {
          score = objective.PrimaryAchieved ? HalfEven(score + static_cast<long double>(Mission->Primary[at]))
                                            : score;
          score = objective.SecondaryAchieved
                      ? HalfEven(score + static_cast<long double>(Mission->Secondary[at]))
                      : score;
        }
      }
      score = HalfEven(score - static_cast<long double>(Mission->RespawnPenalty) * player.RespawnCount);
      score = HalfEven(score - static_cast<long double>(Mission->HealPenalty) * player.HealCount);
    }
    player.Soldiering = static_cast<std::int32_t>(score);
  }

  /// Repeatedly picks the best of those left, the first among equals.
  std::vector<int> Place(Game& game) const {
    std::vector<int> left;
    for (int p = 1; p <= PlayerCount; ++p) {
      if (game.Players(p).Active) {
        left.push_back(p);
      }
    }
    std::vector<int> board;
    while (!left.empty()) {
      std::size_t best = 0;
      for (std::size_t i = 1; i < left.size(); ++i) {
        const std::int32_t score = game.Players(left[i]).Soldiering;
        const std::int32_t bestScore = game.Players(left[best]).Soldiering;
        if (SortOrder == ::SortOrder::Descending ? score > bestScore : score < bestScore) {
          best = i;
        }
      }
      const int p = left[best];
      left.erase(left.begin() + static_cast<std::ptrdiff_t>(best));
      board.push_back(p);
      // Places are written by team and number as if each team had one block of the table.
      const int record = 32 * (TeamOf(p) - 1) + 1 + NumberOf(p);
      game.Players(record).Rank = static_cast<std::int16_t>(board.size());
    }
    return board;
  }
};

/// Scores the game both ways and compares every field, the teams' sums and the order of the board.
inline void ExpectReckonedScores(ScoredGame& venue, const Reckoning& reckoning) {
  const auto reckoned = std::make_unique<Game>(venue.game);
  const std::vector<int> board = reckoning.Score(*reckoned);
  venue.CalculateScores();
  ExpectSameGame(venue.game, *reckoned);
  ASSERT_EQ(venue.Board.RowCount(), static_cast<int>(board.size()));
  for (std::size_t row = 0; row < board.size(); ++row) {
    const Player& player = reckoned->Players(board[row]);
    ASSERT_EQ(venue.Cell(row, BoardColumn::Rank), std::to_string(row + 1));
    ASSERT_EQ(venue.Cell(row, BoardColumn::Player), reckoned->DisplayName(board[row]));
    ASSERT_EQ(venue.Cell(row, BoardColumn::Soldiering), Str(player.Soldiering));
    ASSERT_EQ(venue.Cell(row, BoardColumn::Damage), Str(player.TotalDamage));
  }
}
