#include "archive/ArchiveFile.h"

#include <gtest/gtest.h>

#include "platform/Sql.h"
#include "platform/linux/LinuxFiles.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/OrdinaryUser.h"
#include "tests/support/Thrown.h"

namespace {

class OpeningTheArchive : public testing::Test {
 protected:
  OpeningTheArchive() {
    std::filesystem::create_directory(data);
    WriteFile(defaultPath, MadeDatabase("games"));
  }

  ArchiveFile Open() { return OpenArchive(engine, disk, data, defaultPath); }
  std::int64_t GamesIn(const ArchiveFile& file) {
    return WholeNumber(file.Open->Statements(), "SELECT count(*) FROM Games");
  }
  std::vector<std::string> FileNames() const { return disk.FileNames(data); }

  TemporaryFolder folder;
  const std::string data = folder / "data";
  const std::string defaultPath = folder / "games_default.mdb";
  const std::string usual = data + "/games.mdb";
  const std::string fresh = data + "/games-new.mdb";
  LinuxFiles disk;
  SqliteEngine engine{std::chrono::milliseconds(30)};
};

TEST_F(OpeningTheArchive, MakesItWhenItIsFirstNeeded) {
  const ArchiveFile file = Open();
  EXPECT_EQ(file.Path, usual);
  EXPECT_EQ(file.Unusable, "");
  EXPECT_EQ(GamesIn(file), 0);
  EXPECT_EQ(FileNames(), std::vector<std::string>{"games.mdb"});
}

TEST_F(OpeningTheArchive, TakesTheOneThatIsThere) {
  Open();
  OtherConnection(usual).Execute("INSERT INTO ArchiveKey VALUES (1, 'mine')");
  const std::string before = ReadFile(usual);
  const ArchiveFile file = Open();
  EXPECT_EQ(WholeNumber(file.Open->Statements(), "SELECT count(*) FROM ArchiveKey"), 1);
  EXPECT_EQ(ReadFile(usual), before);
}

TEST_F(OpeningTheArchive, PlaysNoForeignJournalIntoANewFile) {
  WriteFile(usual + "-journal", "left over");
  EXPECT_EQ(GamesIn(Open()), 0);
  EXPECT_EQ(FileNames(), std::vector<std::string>{"games.mdb"});
}

TEST_F(OpeningTheArchive, LeavesADamagedFileAloneAndBeginsOneBesideIt) {
  const std::string sound = MadeDatabase("games");
  for (const std::string& damaged : {std::string("no database"), std::string(), std::string(20000, 'x'),
                                     sound.substr(0, sound.size() - 100)}) {
    WriteFile(usual, damaged);
    {
      const ArchiveFile file = Open();
      EXPECT_EQ(file.Path, fresh);
      EXPECT_EQ(file.Unusable, usual);
      EXPECT_EQ(GamesIn(file), 0);
    }
    EXPECT_EQ(ReadFile(usual), damaged);
    std::filesystem::remove(fresh);
  }
}

TEST_F(OpeningTheArchive, UsesTheOneBesideItAgain) {
  WriteFile(usual, "no database");
  Open().Open->Statements().Change("INSERT INTO ArchiveKey VALUES (1, 'mine')", {});
  const ArchiveFile file = Open();
  EXPECT_EQ(file.Path, fresh);
  EXPECT_EQ(WholeNumber(file.Open->Statements(), "SELECT count(*) FROM ArchiveKey"), 1);
}

TEST_F(OpeningTheArchive, TakesNoOtherDatabaseForAnArchive) {
  WriteFile(usual, MadeDatabase("members"));
  EXPECT_EQ(Open().Path, fresh);
  EXPECT_EQ(ReadFile(usual), MadeDatabase("members"));
}

TEST_F(OpeningTheArchive, FailsWhenBothAreDamaged) {
  WriteFile(usual, "no database");
  WriteFile(fresh, "no database");
  const Thrown failure = ThrownBy([this] { Open(); });
  EXPECT_EQ(failure.Number, 3343);
  EXPECT_NE(failure.Text.find(fresh), std::string::npos);
}

TEST_F(OpeningTheArchive, FailsWhenItIsLockedAndMakesNoOther) {
  Open();
  OtherConnection other(usual);
  other.Execute("BEGIN EXCLUSIVE");
  EXPECT_EQ(NumberThrownBy([this] { Open(); }), 3050);
  other.Execute("COMMIT");
  EXPECT_EQ(FileNames(), std::vector<std::string>{"games.mdb"});
}

TEST_F(OpeningTheArchive, FailsInAFolderThatCannotBeWritten) {
  std::filesystem::permissions(data, std::filesystem::perms(0555));
  const OrdinaryUser user;
  const int number = NumberThrownBy([this] { Open(); });
  EXPECT_TRUE(number == 70 || number == 75) << number;
}

TEST_F(OpeningTheArchive, OfAReadOnlyFileLetsItBeReadOnly) {
  Open();
  std::filesystem::permissions(usual, std::filesystem::perms(0444));
  const OrdinaryUser user;
  const ArchiveFile file = Open();
  EXPECT_EQ(GamesIn(file), 0);
  EXPECT_EQ(NumberThrownBy(
                [&] { file.Open->Statements().Change("INSERT INTO ArchiveKey VALUES (1, 'mine')", {}); }),
            3027);
}

TEST_F(OpeningTheArchive, LeavesOneAsideThatIsChangedWhileItIsHeldAside) {
  Open();
  ASSERT_TRUE(SetArchiveAside(disk, usual));
  EXPECT_TRUE(IsArchiveSetAside(disk, usual));
  HoldArchiveAside(disk, usual);
  OtherConnection(usual).Execute("INSERT INTO ArchiveKey VALUES (1, 'mine')");
  EXPECT_EQ(Open().Path, fresh);
  SetArchiveAside(disk, usual);
  EXPECT_EQ(Open().Path, fresh);
  OtherConnection(usual).Execute("DELETE FROM ArchiveKey");
  EXPECT_FALSE(IsArchiveSetAside(disk, usual));
}

}  // namespace
