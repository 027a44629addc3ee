#pragma once

#include <optional>
#include <string>

#include "core/game/Board.h"
#include "core/game/Game.h"
#include "core/game/MemberLookup.h"
#include "core/game/MissionList.h"
#include "core/game/MissionPoints.h"
#include "core/game/SoldieringFactors.h"

/// Turns the raw counters and the hit matrix into damage, accuracy, soldiering, team totals and ranks, and
/// rebuilds both lists. Reads only raw figures and inputs, so that running it again changes nothing.
class ScoreAnalysis {
 public:
  ScoreAnalysis(Game& game, const SoldieringFactors& factors, MissionList& missions, MemberLookup& members,
                Board& players, Board& teams)
      : game_(game),
        factors_(factors),
        missions_(missions),
        members_(members),
        players_(players),
        teams_(teams) {}

  /// Throws RuntimeError 6 when a figure leaves the 32-bit range; both lists are then empty. Returns false if
  /// a command given in one of its boxes cleared the lists, usually to calculate anew: whatever that command
  /// left stays.
  bool CalculateScores();

  /// The points of the mission that the last calculation used; none if it was without a mission or a player.
  const std::optional<MissionPoints>& PointsOfMission() const { return missionPoints_; }

 private:
  void AddUpDamage();
  /// The fast way, for ordinary games. Returns false, with useless figures, if only the other way gives the
  /// right figures or the right error.
  bool AddUpDamageAtOnce();
  void AddUpDamageHitByHit();
  /// True if this counts as friendly fire: both are on one team, and the mode is not Free For All.
  bool IsOwnTeamHit(int victim, int shooter) const;
  /// Calculates a player's score and row. Returns nullopt if the lists were cleared in a box meanwhile.
  std::optional<BoardRow> ScorePlayer(int index);
  /// Name of the player's member, empty if there is none. A player without an assigned member first gets the
  /// owner of the membership button that was used.
  std::string NameOfMember(Player& player);
  void CalculateAccuracy(Player& player) const;
  void AddMissionPoints(Player& player, const std::string& teamName);
  void ListTeams();

  Game& game_;
  const SoldieringFactors& factors_;
  MissionList& missions_;
  MemberLookup& members_;
  Board& players_;
  Board& teams_;
  std::optional<MissionPoints> missionPoints_;  ///< read once per calculation
};
