#include "archive/CopiedArchive.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/Thrown.h"

namespace {

class CopiedArchiveInFolder : public testing::Test {
 protected:
  CopiedArchiveInFolder() { WriteFile(folder / "games_default.mdb", MadeDatabase("games")); }

  TemporaryFolder folder;
  LinuxFiles disk;
  SqliteEngine engine{std::chrono::milliseconds(0)};
  CopiedArchive archive{{engine, disk, folder.Path(), folder.Path()}};
};

TEST_F(CopiedArchiveInFolder, IsNotThereWithoutFileAndCopies) {
  EXPECT_FALSE(archive.IsThere());
  EXPECT_FALSE(std::filesystem::exists(folder / "games.mdb"));
}

TEST_F(CopiedArchiveInFolder, IsThereWithACopyAlone) {
  std::filesystem::create_directory(folder / "backups");
  WriteFile(folder / "backups/games-2013-05-21-143005-kept.mdb", MadeDatabase("games"));
  EXPECT_TRUE(archive.IsThere());
}

TEST_F(CopiedArchiveInFolder, IsThereThoughItCannotBeOpened) {
  WriteFile(folder / "games.mdb", MadeDatabase("games"));
  {
    OtherConnection other(folder / "games.mdb");
    other.Execute("BEGIN EXCLUSIVE");
    EXPECT_TRUE(archive.IsThere());
    EXPECT_EQ(NumberThrownBy([this] { archive.Entry().InUse(); }), 3050);
  }
  EXPECT_EQ(archive.Entry().InUse().Path(), folder / "games.mdb");
}

}  // namespace
