#pragma once

#include <array>
#include <string>

#include "core/game/Game.h"
#include "platform/Database.h"

/// The objectives of one set. Points are kept as typed.
struct MissionObjectives {
  std::string PrimaryDescription;
  std::string SecondaryDescription;
  std::string PrimaryPoints = "0";
  std::string SecondaryPoints = "0";
};

/// A mission as its editor shows it. Line breaks in texts are CR LF.
struct MissionRecord {
  std::string Name;
  std::string Description;
  std::string RespawnPenalty = "0";  ///< as typed
  std::string HealPenalty = "0";     ///< as typed
  std::string GameDuration;
  std::string TeamRatio;
  std::array<MissionObjectives, TeamCount> Objectives;  ///< A, B, C
};

/// Number of the message that says why `mission` cannot be saved; 0 if it can.
int FaultOf(const MissionRecord& mission);

/// Reads the mission in the current row. Its description is joined from four columns.
MissionRecord ReadMission(Recordset& row);

/// Writes `mission` to the pending row. The description is split over four columns at fixed positions:
/// characters 1 to 254, 255 to 509, 511 to 765 and 767 to 1021, so that characters 510 and 766 are lost. A
/// column beyond the end of the description is not written and keeps its old text. The penalties are the
/// leading numeric parts of their texts.
void WriteMission(Recordset& row, const MissionRecord& mission);
