#include <gmock/gmock.h>
#include <sys/stat.h>

#include <filesystem>

#include "archive/history/ForgetMember.h"
#include "platform/linux/LinuxFiles.h"
#include "tests/archive/history/HistoryVenue.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;

/// A member to be forgotten; one of the copies cannot be read.
class ForgettingWithAnUnreadableCopy : public testing::Test, protected HistoryVenue {
 protected:
  ForgettingWithAnUnreadableCopy() {
    Keep("2026-10-01 20:00:00", 100);
    std::filesystem::create_directory(Folder / "backups");
    std::filesystem::copy_file(ArchivePath(), SoundCopy());
  }

  std::string SoundCopy() const { return Folder / "backups/games-2026-10-05-200000.mdb"; }
  std::string UnreadableCopy() const { return Folder / "backups/games-2026-10-05-200000-kept.mdb"; }

  Forgotten Forget() {
    SqliteEngine engine;
    LinuxFiles disk;
    ForgetMember forgetting({.Engine = engine,
                             .Disk = disk,
                             .DbMembers = *MembersDatabase,
                             .Strings = Strings,
                             .UserDataFolder = Folder.Path()},
                            5);
    forgetting.CountGames([](const ForgetMember::State&) { return true; });
    return forgetting.Forget([this](const ForgetMember::State& state) {
      isFar = isFar && state.Done >= 0 && state.Done <= 1;
      return true;
    });
  }

  void ExpectForgottenButThere() {
    const Forgotten forgotten = Forget();
    EXPECT_THAT(forgotten.Failures,
                ElementsAre(HasSubstr("games-2026-10-05-200000-kept.mdb still names the member: ")));
    EXPECT_FALSE(forgotten.Stopped);
    EXPECT_EQ(forgotten.Games, 1);
    EXPECT_TRUE(isFar);
    for (const std::string& path : {ArchivePath(), SoundCopy()}) {
      EXPECT_EQ(ReadFile(path).find(BosButton), std::string::npos) << path;
    }
  }

  bool isFar = true;
};

TEST_F(ForgettingWithAnUnreadableCopy, GoesOnWhenItIsALinkToNothing) {
  std::filesystem::create_symlink(Folder / "nowhere/games.mdb", UnreadableCopy());
  ExpectForgottenButThere();
}

TEST_F(ForgettingWithAnUnreadableCopy, GoesOnWhenItIsAPipe) {
  ASSERT_EQ(mkfifo(UnreadableCopy().c_str(), 0600), 0);
  ExpectForgottenButThere();
}

}  // namespace
