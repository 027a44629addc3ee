#include "demo/DemoMission.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "core/text/NumberForms.h"
#include "core/text/TextEncoding.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/support/TemporaryFolder.h"

namespace {

class DemoMissionTest : public testing::Test {
 protected:
  DemoMissionTest() {
    std::filesystem::copy_file(TESSARINE_PROGRAM_FOLDER "/scenarios_default.mdb", folder / "scenarios.mdb");
    database = SqliteEngine().OpenDatabase(folder / "scenarios.mdb");
  }

  TemporaryFolder folder;
  std::unique_ptr<Database> database;
};

TEST_F(DemoMissionTest, IsAddedBehindTheOthersAsItIs) {
  const int before = database->OpenRecordset("Table1")->RecordCount();
  AddMission(*database);
  const auto rows = database->OpenRecordset("Table1");
  EXPECT_EQ(rows->RecordCount(), before + 1);
  rows->MoveLast();
  const MissionRecord read = ReadMission(*rows);
  EXPECT_EQ(read.Name, "Harbour Lights");
  EXPECT_EQ(read.Description, DemoMission().Description);
  EXPECT_EQ(read.RespawnPenalty, DemoMission().RespawnPenalty);
  for (std::size_t set = 0; set < TeamCount; ++set) {
    const MissionObjectives& objectives = DemoMission().Objectives[set];
    EXPECT_EQ(read.Objectives[set].PrimaryDescription, objectives.PrimaryDescription);
    EXPECT_EQ(read.Objectives[set].SecondaryPoints, objectives.SecondaryPoints);
  }
}

TEST_F(DemoMissionTest, CouldHaveBeenMadeInTheEditor) {
  constexpr std::size_t charactersKept = 509;
  EXPECT_EQ(FaultOf(DemoMission()), 0);
  EXPECT_LE(CharacterCount(DemoMission().Description), charactersKept);
}

TEST_F(DemoMissionTest, HasTwoObjectivesWithPointsForEachTeam) {
  for (const MissionObjectives& objectives : DemoMission().Objectives) {
    EXPECT_FALSE(objectives.PrimaryDescription.empty());
    EXPECT_FALSE(objectives.SecondaryDescription.empty());
    EXPECT_GT(Val(objectives.PrimaryPoints), 0);
    EXPECT_GT(Val(objectives.SecondaryPoints), 0);
  }
}

}  // namespace
