#pragma once

#include <array>
#include <string>

#include "core/game/Game.h"
#include "platform/Database.h"

/// The objectives of one set. Points are as typed.
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

/// Number of the text that tells why `mission` cannot be saved; 0 when it can.
int FaultOf(const MissionRecord& mission);

/// The mission of the current row. Its description is joined from four columns.
MissionRecord ReadMission(Recordset& row);

/// Puts `mission` into the pending row. The description goes into four columns by fixed positions: characters
/// 1 to 254, 255 to 509, 511 to 765 and 767 to 1021, so its characters 510 and 766 are lost. A column beyond
/// the description's end is not written and keeps what it held. Penalties are the leading numeric parts of
/// their texts.
void WriteMission(Recordset& row, const MissionRecord& mission);
