#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/resources/DefaultDatabase.h"

namespace {

using testing::ElementsAre;

class DefaultGames : public testing::Test {
 protected:
  DefaultDatabase database{"games_default.mdb"};
};

TEST_F(DefaultGames, AreNone) {
  EXPECT_EQ(database.Single("SELECT count(*) FROM Games"), "0");
  EXPECT_EQ(database.Single("SELECT count(*) FROM ArchiveKey"), "0");
  EXPECT_EQ(database.Single("PRAGMA user_version"), "1");
}

TEST_F(DefaultGames, HaveTheTableInWhichTheSqlite3ToolKeepsFiles) {
  EXPECT_THAT(database.Column("SELECT name || ' ' || type || ' ' || pk FROM pragma_table_info('sqlar')"),
              ElementsAre("name TEXT 1", "mode INT 0", "mtime INT 0", "sz INT 0", "data BLOB 0"));
}

}  // namespace
