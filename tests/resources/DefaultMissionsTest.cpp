#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

#include "tests/resources/DefaultDatabase.h"

namespace {

const std::vector<std::string> Columns = {"ID",
                                          "MissionName",
                                          "MissionDescription",
                                          "MissionDescription2",
                                          "MissionDescription3",
                                          "MissionDescription4",
                                          "RespawnPenalty",
                                          "HealPenalty",
                                          "GameDuration",
                                          "PrimaryObjectiveDescriptionA",
                                          "SecondaryObjectiveDescriptionA",
                                          "PrimaryObjectivePointsA",
                                          "SecondaryObjectivePointsA",
                                          "PrimaryObjectiveDescriptionB",
                                          "SecondaryObjectiveDescriptionB",
                                          "PrimaryObjectivePointsB",
                                          "SecondaryObjectivePointsB",
                                          "PrimaryObjectiveDescriptionC",
                                          "SecondaryObjectiveDescriptionC",
                                          "PrimaryObjectivePointsC",
                                          "SecondaryObjectivePointsC",
                                          "TeamRatio"};

const std::vector<std::string> PointsColumns = {"PrimaryObjectivePointsA", "SecondaryObjectivePointsA",
                                                "PrimaryObjectivePointsB", "SecondaryObjectivePointsB",
                                                "PrimaryObjectivePointsC", "SecondaryObjectivePointsC"};

const std::set<std::string> MayBeNull = {"MissionDescription2", "MissionDescription3", "MissionDescription4"};

class DefaultMissions : public testing::Test {
 protected:
  /// True if the first mission accepts `value`, an SQL expression, in `column`.
  bool Accepts(const std::string& column, const std::string& value) {
    return database.Run("UPDATE Table1 SET " + column + " = " + value + " WHERE ID = 1");
  }

  DefaultDatabase database{"scenarios_default.mdb"};
};

TEST_F(DefaultMissions, HaveTheColumnsOfTheMissionTable) {
  EXPECT_EQ(database.Column("SELECT name FROM pragma_table_info('Table1')"), Columns);
  EXPECT_EQ(database.Single("PRAGMA user_version"), "1");
}

TEST_F(DefaultMissions, AreAtLeastEightWithDistinctNames) {
  const std::vector<std::string> names = database.Column("SELECT MissionName FROM Table1");
  EXPECT_GE(names.size(), 8U);
  EXPECT_EQ(std::set<std::string>(names.begin(), names.end()).size(), names.size());
  EXPECT_THAT(names, testing::Not(testing::Contains("")));
  EXPECT_EQ(database.Single("SELECT count(*) FROM Table1 WHERE MissionDescription = ''"), "0");
}

TEST_F(DefaultMissions, DifferInPenaltiesDurationsAndRatios) {
  for (const char* column : {"RespawnPenalty", "HealPenalty", "GameDuration", "TeamRatio"}) {
    EXPECT_GE(std::stoi(database.Single(std::string("SELECT count(DISTINCT ") + column + ") FROM Table1")), 4)
        << column;
  }
}

TEST_F(DefaultMissions, HoldNoNullOutsideTheLaterDescriptionColumns) {
  for (const std::string& column : Columns) {
    if (MayBeNull.contains(column)) {
      EXPECT_TRUE(Accepts(column, "NULL")) << column;
      continue;
    }
    EXPECT_EQ(database.Single("SELECT count(*) FROM Table1 WHERE " + column + " IS NULL"), "0") << column;
    EXPECT_FALSE(Accepts(column, "NULL")) << column;
  }
}

TEST_F(DefaultMissions, FillAnAddedRowWithEmptyTextsAndZeros) {
  ASSERT_TRUE(database.Run("INSERT INTO Table1 (MissionName) VALUES ('New Mission')"));
  for (const std::string& column : PointsColumns) {
    EXPECT_EQ(database.Single("SELECT " + column + " FROM Table1 WHERE MissionName = 'New Mission'"), "0")
        << column;
  }
  EXPECT_EQ(database.Single("SELECT RespawnPenalty FROM Table1 WHERE MissionName = 'New Mission'"), "0.0");
  EXPECT_EQ(database.Single("SELECT TeamRatio FROM Table1 WHERE MissionName = 'New Mission'"), "");
  EXPECT_EQ(database.Single("SELECT MissionDescription2 FROM Table1 WHERE MissionName = 'New Mission'"),
            "NULL");
}

TEST_F(DefaultMissions, NeverGiveANumberTwice) {
  const int last = std::stoi(database.Single("SELECT max(ID) FROM Table1"));
  ASSERT_TRUE(database.Run("DELETE FROM Table1 WHERE ID = " + std::to_string(last)));
  ASSERT_TRUE(database.Run("INSERT INTO Table1 (MissionName) VALUES ('New Mission')"));
  EXPECT_EQ(database.Single("SELECT ID FROM Table1 WHERE MissionName = 'New Mission'"),
            std::to_string(last + 1));
}

TEST_F(DefaultMissions, CutLongDescriptionsBehind254Characters) {
  EXPECT_GE(std::stoi(database.Single("SELECT count(*) FROM Table1 WHERE MissionDescription2 IS NOT NULL")),
            1);
  EXPECT_EQ(database.Single("SELECT count(*) FROM Table1 WHERE MissionDescription2 IS NOT NULL "
                            "AND length(MissionDescription) <> 254"),
            "0");
  EXPECT_EQ(database.Single("SELECT count(*) FROM Table1 WHERE length(MissionDescription) > 254 "
                            "OR MissionDescription2 = ''"),
            "0");
  // Character 510 would be lost on saving, so no default description is that long.
  EXPECT_EQ(database.Single("SELECT count(*) FROM Table1 WHERE MissionDescription3 IS NOT NULL "
                            "OR MissionDescription4 IS NOT NULL"),
            "0");
}

TEST_F(DefaultMissions, BeginWithALineThatServesAsToolTip) {
  for (const std::string& text : database.Column("SELECT MissionDescription FROM Table1")) {
    const std::size_t end = text.find("\r\n");
    ASSERT_NE(end, std::string::npos) << text;
    EXPECT_LE(end, 80U) << text;
  }
}

TEST_F(DefaultMissions, EndEveryLineInCrLf) {
  for (const std::string& column : Columns) {
    EXPECT_EQ(database.Single("SELECT count(*) FROM Table1 WHERE replace(" + column +
                              ", char(13, 10), '') GLOB '*[' || char(13, 10) || ']*'"),
              "0")
        << column;
  }
}

TEST_F(DefaultMissions, GiveNoPointsForAnObjectiveWithoutWords) {
  for (const std::string& points : PointsColumns) {
    std::string words = points;
    words.replace(words.find("Points"), 6, "Description");
    std::string query = "SELECT count(*) FROM Table1 WHERE (";
    query.append(words).append(" = '') <> (").append(points).append(" = 0)");
    EXPECT_EQ(database.Single(query), "0") << points;
  }
}

TEST_F(DefaultMissions, PointsAreNumbers) {
  for (const std::string& column : PointsColumns) {
    EXPECT_EQ(database.Single("SELECT count(*) FROM Table1 WHERE typeof(" + column + ") <> 'integer'"), "0")
        << column;
  }
}

TEST_F(DefaultMissions, PointsTakeATypedNumberAsThatNumber) {
  for (const std::string& column : PointsColumns) {
    for (const char* number : {"25", "-5", "12.5", "0"}) {
      ASSERT_TRUE(Accepts(column, "'" + std::string(number) + "'")) << column << " " << number;
      EXPECT_EQ(database.Single("SELECT " + column + " FROM Table1 WHERE ID = 1"), number) << column;
      EXPECT_NE(database.Single("SELECT typeof(" + column + ") FROM Table1 WHERE ID = 1"), "text") << column;
    }
  }
}

TEST_F(DefaultMissions, PointsRefuseATextThatIsNoNumber) {
  for (const std::string& column : PointsColumns) {
    const std::string before = database.Single("SELECT " + column + " FROM Table1 WHERE ID = 1");
    for (const char* text : {"'abc'", "''", "'12abc'", "'1e999'", "x'3235'"}) {
      EXPECT_FALSE(Accepts(column, text)) << column << " " << text;
    }
    EXPECT_EQ(database.Single("SELECT " + column + " FROM Table1 WHERE ID = 1"), before) << column;
  }
}

TEST_F(DefaultMissions, PenaltiesRefuseATextThatIsNoNumber) {
  for (const char* column : {"RespawnPenalty", "HealPenalty"}) {
    EXPECT_FALSE(Accepts(column, "'abc'")) << column;
    EXPECT_TRUE(Accepts(column, "2.5")) << column;
    EXPECT_TRUE(Accepts(column, "3")) << column;
  }
}

TEST_F(DefaultMissions, ShortTextsHold255CharactersAndNoMore) {
  for (const std::string& column : Columns) {
    if (column.starts_with("MissionDescription")) {
      continue;  // memo columns in old files may be longer
    }
    if (database.Single("SELECT type FROM pragma_table_info('Table1') WHERE name = '" + column + "'") !=
        "TEXT") {
      continue;
    }
    const std::string text255 = "replace(printf('%255s', ''), ' ', '任')";
    EXPECT_TRUE(Accepts(column, text255)) << column;
    EXPECT_FALSE(Accepts(column, text255 + " || 'x'")) << column;
  }
}

}  // namespace
