#pragma once

#include <array>
#include <optional>

#include "core/game/Game.h"
#include "core/game/MemberLookup.h"
#include "core/game/MissionList.h"
#include "core/game/ScoreList.h"
#include "core/game/SoldieringFactors.h"

/// Columns of the score board; those behind `Player` hold numbers.
enum class BoardColumn { Rank, Player, Soldiering, Accuracy, Damage, ShotsFired, Wia, Kia, AmmoAdds };
inline constexpr int TeamColumnCount = 3;

/// Turns the raw counters and the hit matrix into damage, accuracy, soldiering, team totals and ranks, and
/// rebuilds both lists. Reads only raw figures and inputs, so that running it again changes nothing.
class ScoreAnalysis {
 public:
  ScoreAnalysis(Game& game, const SoldieringFactors& factors, MissionList& missions, MemberLookup& members,
                const StringTable& strings, ScoreList& scoreDisplay, ScoreList& teamScores)
      : game_(game),
        factors_(factors),
        missions_(missions),
        members_(members),
        strings_(strings),
        scoreDisplay_(scoreDisplay),
        teamScores_(teamScores) {}

  /// Throws RuntimeError 6 when a figure leaves the 32-bit range; the lists are then incomplete.
  void CalculateScores();

 private:
  /// What the active mission pays and takes.
  struct MissionPoints {
    std::array<double, TeamCount> Primary;    ///< by objective set
    std::array<double, TeamCount> Secondary;  ///< by objective set
    double RespawnPenalty;
    double HealPenalty;
  };

  void AddUpDamage();
  /// The fast way for the usual game. Returns false, with nothing worth keeping, where only the other way
  /// gives the right figures or the right failure.
  bool AddUpDamageAtOnce();
  void AddUpDamageHitByHit();
  /// True when friendly fire counts: the mode is not a free-for-all, and both are of one team.
  bool IsOwnTeamHit(int victim, int shooter) const;
  void ScorePlayer(int index);
  std::string PlayerText(int index);
  void CalculateAccuracy(Player& player) const;
  void CalculateSoldiering(Player& player) const;
  void AddMissionPoints(Player& player, const std::string& teamName);
  MissionPoints ReadMissionPoints();
  std::string AccuracyText(const Player& player) const;
  void ListTeams();

  Game& game_;
  const SoldieringFactors& factors_;
  MissionList& missions_;
  MemberLookup& members_;
  const StringTable& strings_;
  ScoreList& scoreDisplay_;
  ScoreList& teamScores_;
  std::optional<MissionPoints> missionPoints_;  ///< read once a calculation
};
