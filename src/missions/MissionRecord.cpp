#include "missions/MissionRecord.h"

#include <cstddef>

#include "core/data/FieldValue.h"
#include "core/text/NumberForms.h"
#include "core/text/TextEncoding.h"
#include "missions/MissionNotes.h"

namespace {

constexpr std::size_t MostOfObjective = 255;

struct DescriptionColumn {
  const char* Name;
  std::size_t First;     ///< first character of the description in this column, counted from 0
  std::size_t Count;     ///< number of characters in this column
  std::size_t IfLonger;  ///< the column is written if the description is longer than this
};

constexpr DescriptionColumn DescriptionTail[] = {
    {"MissionDescription2", 254, 255, 254},
    {"MissionDescription3", 510, 255, 510},
    {"MissionDescription4", 766, 255, 766},
};

std::string Column(const char* name, int set) {
  return std::string(name) + static_cast<char>('A' + set);
}

}  // namespace

int FaultOf(const MissionRecord& mission) {
  if (CharacterCount(mission.Description) > MostOfDescription) {
    return 175;
  }
  if (mission.Description.empty()) {
    return 177;
  }
  for (const MissionObjectives& objectives : mission.Objectives) {
    if (CharacterCount(objectives.PrimaryDescription) > MostOfObjective ||
        CharacterCount(objectives.SecondaryDescription) > MostOfObjective) {
      return 178;
    }
  }
  return 0;
}

MissionRecord ReadMission(Recordset& row) {
  const auto text = [&row](const std::string& column) { return TextOf(row.Fields(column)); };
  MissionRecord mission;
  mission.Name = text("MissionName");
  mission.Description = text("MissionDescription");
  for (const DescriptionColumn& column : DescriptionTail) {
    mission.Description += text(column.Name);
  }
  mission.RespawnPenalty = text("RespawnPenalty");
  mission.HealPenalty = text("HealPenalty");
  mission.GameDuration = text("GameDuration");
  for (int set = 0; set < TeamCount; ++set) {
    mission.Objectives[set] = {
        text(Column("PrimaryObjectiveDescription", set)), text(Column("SecondaryObjectiveDescription", set)),
        text(Column("PrimaryObjectivePoints", set)), text(Column("SecondaryObjectivePoints", set))};
  }
  mission.TeamRatio = text("TeamRatio");
  return mission;
}

void WriteMission(Recordset& row, const MissionRecord& mission) {
  row.SetField("MissionName", mission.Name);
  row.SetField("MissionDescription", Characters(mission.Description, 0, 254));
  const std::size_t length = CharacterCount(mission.Description);
  for (const DescriptionColumn& column : DescriptionTail) {
    if (length > column.IfLonger) {
      row.SetField(column.Name, Characters(mission.Description, column.First, column.Count));
    }
  }
  row.SetField("RespawnPenalty", Val(mission.RespawnPenalty));
  row.SetField("HealPenalty", Val(mission.HealPenalty));
  row.SetField("GameDuration", mission.GameDuration);
  for (int set = 0; set < TeamCount; ++set) {
    const MissionObjectives& objectives = mission.Objectives[set];
    row.SetField(Column("PrimaryObjectiveDescription", set), objectives.PrimaryDescription);
    row.SetField(Column("SecondaryObjectiveDescription", set), objectives.SecondaryDescription);
    row.SetField(Column("PrimaryObjectivePoints", set), objectives.PrimaryPoints);
    row.SetField(Column("SecondaryObjectivePoints", set), objectives.SecondaryPoints);
  }
  row.SetField("TeamRatio", mission.TeamRatio);
}
