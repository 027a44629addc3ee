#include "missions/MissionRecord.h"

#include <gmock/gmock.h>

#include <fstream>
#include <iterator>

#include "core/text/TextEncoding.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

std::string Repeated(const std::string& text, int times) {
  std::string repeated;
  for (int i = 0; i < times; ++i) {
    repeated += text;
  }
  return repeated;
}

/// A text of `length` characters that show their position: 1, 2, ... 9, 0, 1, ...
std::string Numbered(int length) {
  std::string text;
  for (int place = 1; place <= length; ++place) {
    text += static_cast<char>('0' + place % 10);
  }
  return text;
}

MissionRecord MissionWith(const std::string& description) {
  MissionRecord mission;
  mission.Name = "Test";
  mission.Description = description;
  return mission;
}

class MissionRow : public testing::Test {
 protected:
  MissionRow() {
    OtherConnection connection(folder_ / "scenarios.mdb");
    std::ifstream script(TESSARINE_RESOURCES "/scenarios_default.sql");
    connection.Execute(std::string(std::istreambuf_iterator<char>(script), {}));
    database_ = engine_.OpenDatabase(folder_ / "scenarios.mdb");
    rows = database_->OpenRecordset("Table1");
  }

  void Add(const MissionRecord& mission) {
    rows->AddNew();
    WriteMission(*rows, mission);
    rows->Update();
    rows->MoveLast();
  }

  void Change(const MissionRecord& mission) {
    rows->Edit();
    WriteMission(*rows, mission);
    rows->Update();
  }

  /// A column of the current row as stored in the file.
  std::string Stored(const std::string& column) {
    return OtherConnection(folder_ / "scenarios.mdb")
        .Query("SELECT " + column + " FROM Table1 ORDER BY ID DESC LIMIT 1");
  }

  std::unique_ptr<Recordset> rows;

 private:
  TemporaryFolder folder_;
  SqliteEngine engine_;
  std::unique_ptr<Database> database_;
};

TEST(Mission, MustHaveADescriptionOfAtMost1000Characters) {
  EXPECT_EQ(FaultOf(MissionWith("")), 177);
  EXPECT_EQ(FaultOf(MissionWith("x")), 0);
  EXPECT_EQ(FaultOf(MissionWith(Numbered(1000))), 0);
  EXPECT_EQ(FaultOf(MissionWith(Numbered(1001))), 175);
}

TEST(Mission, CountsCharactersAndNotBytes) {
  EXPECT_EQ(FaultOf(MissionWith(Repeated("战", 1000))), 0);
  EXPECT_EQ(FaultOf(MissionWith(Repeated("战", 1001))), 175);
  MissionRecord mission = MissionWith("x");
  mission.Objectives[2].SecondaryDescription = Repeated("战", 255);
  EXPECT_EQ(FaultOf(mission), 0);
}

TEST(Mission, MustHaveObjectivesOfAtMost255Characters) {
  for (int set = 0; set < TeamCount; ++set) {
    for (std::string MissionObjectives::*text :
         {&MissionObjectives::PrimaryDescription, &MissionObjectives::SecondaryDescription}) {
      MissionRecord mission = MissionWith("x");
      mission.Objectives[set].*text = Numbered(255);
      EXPECT_EQ(FaultOf(mission), 0);
      mission.Objectives[set].*text = Numbered(256);
      EXPECT_EQ(FaultOf(mission), 178);
    }
  }
}

TEST(Mission, TellsTheFaultOfItsDescriptionFirst) {
  MissionRecord mission = MissionWith("");
  mission.Objectives[0].PrimaryDescription = Numbered(256);
  EXPECT_EQ(FaultOf(mission), 177);
}

TEST_F(MissionRow, HoldsADescriptionOf254CharactersInOneColumn) {
  Add(MissionWith(Numbered(254)));
  EXPECT_EQ(Stored("MissionDescription"), Numbered(254));
  EXPECT_EQ(Stored("MissionDescription2"), "NULL");
}

TEST_F(MissionRow, PutsTheCharacterBehindThatIntoTheSecondColumn) {
  Add(MissionWith(Numbered(254) + "X"));
  EXPECT_EQ(Stored("MissionDescription"), Numbered(254));
  EXPECT_EQ(Stored("MissionDescription2"), "X");
  EXPECT_EQ(Stored("MissionDescription3"), "NULL");
}

TEST_F(MissionRow, FillsEachColumnFromItsPlace) {
  const std::string text = Numbered(1000);
  Add(MissionWith(text));
  EXPECT_EQ(Stored("MissionDescription"), text.substr(0, 254));
  EXPECT_EQ(Stored("MissionDescription2"), text.substr(254, 255));
  EXPECT_EQ(Stored("MissionDescription3"), text.substr(510, 255));
  EXPECT_EQ(Stored("MissionDescription4"), text.substr(766));
}

TEST_F(MissionRow, DoesNotWriteAColumnThatTheDescriptionDoesNotReachBeyond) {
  for (const auto& [length, column] : {std::pair{510, "MissionDescription3"}, {766, "MissionDescription4"}}) {
    Add(MissionWith(Numbered(length)));
    EXPECT_EQ(Stored(column), "NULL") << length;
    Add(MissionWith(Numbered(length) + "X"));
    EXPECT_EQ(Stored(column), "X") << length;
  }
}

TEST_F(MissionRow, LosesTheCharactersBetweenTheColumns) {
  const std::string text = Numbered(800);
  Add(MissionWith(text));
  EXPECT_EQ(ReadMission(*rows).Description, text.substr(0, 509) + text.substr(510, 255) + text.substr(766));
}

TEST_F(MissionRow, BringsTheOldTailBackWhenADescriptionIsShortened) {
  const std::string before = Numbered(600);
  Add(MissionWith(before));
  Change(MissionWith(std::string(100, 'x')));
  EXPECT_EQ(ReadMission(*rows).Description,
            std::string(100, 'x') + before.substr(254, 255) + before.substr(510, 90));
}

TEST_F(MissionRow, CutsChineseBetweenCharacters) {
  Add(MissionWith(Repeated("战", 300)));
  EXPECT_EQ(Stored("MissionDescription"), Repeated("战", 254));
  EXPECT_EQ(Stored("MissionDescription2"), Repeated("战", 46));
}

TEST_F(MissionRow, KeepsEveryField) {
  MissionRecord mission = MissionWith("What to do.\r\nAnd how.");
  mission.RespawnPenalty = "2.5";
  mission.HealPenalty = "-3";
  mission.GameDuration = "60 minutes";
  mission.TeamRatio = "5 attackers per defender";
  for (int set = 0; set < TeamCount; ++set) {
    const std::string letter(1, static_cast<char>('A' + set));
    mission.Objectives[set] = {"Primary " + letter, "Secondary " + letter, std::to_string(10 + set),
                               std::to_string(20 + set)};
  }
  Add(mission);
  const MissionRecord read = ReadMission(*rows);
  EXPECT_EQ(read.Name, "Test");
  EXPECT_EQ(read.Description, mission.Description);
  EXPECT_EQ(read.RespawnPenalty, "2.5");
  EXPECT_EQ(read.HealPenalty, "-3");
  EXPECT_EQ(read.GameDuration, "60 minutes");
  EXPECT_EQ(read.TeamRatio, "5 attackers per defender");
  for (int set = 0; set < TeamCount; ++set) {
    EXPECT_EQ(read.Objectives[set].PrimaryDescription, mission.Objectives[set].PrimaryDescription);
    EXPECT_EQ(read.Objectives[set].SecondaryDescription, mission.Objectives[set].SecondaryDescription);
    EXPECT_EQ(read.Objectives[set].PrimaryPoints, mission.Objectives[set].PrimaryPoints);
    EXPECT_EQ(read.Objectives[set].SecondaryPoints, mission.Objectives[set].SecondaryPoints);
  }
  EXPECT_EQ(Stored("SecondaryObjectivePointsC"), "22");
  EXPECT_EQ(Stored("PrimaryObjectiveDescriptionB"), "Primary B");
}

TEST_F(MissionRow, TakesTheLeadingNumberOfAPenalty) {
  MissionRecord mission = MissionWith("x");
  mission.RespawnPenalty = "12abc";
  mission.HealPenalty = "";
  Add(mission);
  EXPECT_EQ(Stored("RespawnPenalty"), "12.0");
  EXPECT_EQ(Stored("HealPenalty"), "0.0");
}

TEST_F(MissionRow, RefusesPointsThatAreNoNumber) {
  for (const char* points : {"abc", "12abc", "1,5", "--1", "+-5", "-+5", "++5", "1e999"}) {
    MissionRecord mission = MissionWith("x");
    mission.Objectives[1].SecondaryPoints = points;
    EXPECT_NE(NumberThrownBy([&] { Add(mission); }), 0) << points;
  }
}

TEST_F(MissionRow, TakesPointsThatAreANumberInAnyForm) {
  for (const auto& [points, shown] :
       {std::pair{"12", "12"}, {" 7 ", "7"}, {"-2.5", "-2.5"}, {"+3", "3"}, {"1E2", "100"}}) {
    MissionRecord mission = MissionWith("x");
    mission.Objectives[0].PrimaryPoints = points;
    Add(mission);
    EXPECT_EQ(ReadMission(*rows).Objectives[0].PrimaryPoints, shown);
  }
}

TEST(Characters, AreCutFromUtf8ByTheirPlace) {
  EXPECT_EQ(CharacterCount("a战é😀"), 4U);
  EXPECT_EQ(Characters("a战é😀", 1, 2), "战é");
  EXPECT_EQ(Characters("a战é😀", 3, 5), "😀");
  EXPECT_EQ(Characters("abc", 3, 5), "");
  EXPECT_EQ(CharacterCount(""), 0U);
}

}  // namespace
