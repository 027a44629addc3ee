#pragma once

#include "missions/MissionRecord.h"
#include "platform/Database.h"

/// The mission that the demo plays, with objectives for three teams.
const MissionRecord& DemoMission();

/// Adds it to the missions. Throws RuntimeError if the database refuses the row.
void AddMission(Database& dbScenarios);
