#include "demo/DemoMission.h"

const MissionRecord& DemoMission() {
  static const MissionRecord mission = {
      .Name = "Harbour Lights",
      .Description =
          "Three crews, three beacons and one fog horn.\r\n"
          "Each crew lights the beacon on its pier and keeps it burning. The fog horn in the middle of the "
          "harbour belongs to whoever sounds it last. The harbour master walks the piers and notes who "
          "holds what.",
      .RespawnPenalty = "5",
      .HealPenalty = "2.5",
      .GameDuration = "25 minutes",
      .TeamRatio = "three equal crews",
      .Objectives = {
          {{"Keep the beacon on the north pier burning.", "Sound the fog horn last.", "400", "150"},
           {"Keep the beacon on the south pier burning.", "Sound the fog horn last.", "400", "150"},
           {"Keep the beacon on the old mole burning.",
            "Bring the spare lamp to another crew's pier.\r\nIt must burn there at the final horn.", "400",
            "200"}}}};
  return mission;
}

void AddMission(Database& dbScenarios) {
  const auto rows = dbScenarios.OpenRecordset("Table1");
  rows->AddNew();
  WriteMission(*rows, DemoMission());
  rows->Update();
}
