#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "archive/ArchiveQueries.h"

/// What a member did in the games of one month.
struct MonthOfMember {
  std::string Month;  ///< "2026-11"
  int Games = 0;
  std::int64_t SoldieringSum = 0;
  std::int64_t SoldieringBest = 0;
  std::int64_t Damage = 0;
  double AccuracySum = 0;  ///< of the games with an accuracy above 0
  int AccuracyGames = 0;   ///< how many these are

  double Mean() const { return static_cast<double>(SoldieringSum) / Games; }
  /// Fraction, the mean of the games with an accuracy above 0; none without such a game.
  std::optional<double> Accuracy() const {
    return AccuracyGames > 0 ? std::optional(AccuracySum / AccuracyGames) : std::nullopt;
  }
};

/// All that the kept games tell of a member.
struct MemberSessions {
  std::vector<MemberGame> Games;      ///< the latest first
  std::vector<double> MeansSoFar;     ///< for each of them the mean soldiering of it and all before
  std::vector<MonthOfMember> Months;  ///< the latest first; only those with games

  /// Places of the bests in Games, the earlier of equal ones; none without games or without an accuracy.
  std::optional<std::size_t> BestSoldiering;
  std::optional<std::size_t> BestAccuracy;
  std::optional<std::size_t> MostDamage;
};

/// `games` are those of one member, the latest first.
MemberSessions SessionsFrom(std::vector<MemberGame> games);
