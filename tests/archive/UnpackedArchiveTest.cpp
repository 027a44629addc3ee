#include <gtest/gtest.h>

#include <sys/wait.h>

#include "tests/archive/ArchiveVenue.h"

namespace {

/// Runs `command` in `folder` and returns its exit status.
int RunIn(const std::string& folder, const std::string& command) {
  const int status = std::system(("cd '" + folder + "' && " + command).c_str());
  return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

TEST(UnpackedArchive, HoldsPlainGameFiles) {
  ArchiveVenue venue;
  const std::int64_t game = venue.Archive->Keep(venue.State());
  const std::string first = WriteGameFile(venue.Game, venue.State().Mission);
  FillRandomly(venue.Game, 40, 11);
  venue.Archive->KeepAgain(game, venue.State(), FormerState::KeptToo);
  const std::string last = WriteGameFile(venue.Game, venue.State().Mission);
  venue.Game.Players(ArchiveVenue::Red0).BonusPoints += 3;
  venue.Archive->Keep(venue.State("2026-12-01 09:05:00"));

  const TemporaryFolder folder;
  ASSERT_EQ(RunIn(folder.Path(), "sqlite3 '" + venue.ArchivePath() + "' -A -x"), 0);
  EXPECT_EQ(ReadFile(folder / "2026-11-21/2015-000001-1.game.xml"), first);
  EXPECT_EQ(ReadFile(folder / "2026-11-21/2015-000001.game.xml"), last);
  EXPECT_EQ(ReadFile(folder / "2026-12-01/0905-000002.game.xml"),
            WriteGameFile(venue.Game, venue.State().Mission));
  Game loaded(venue.Strings);
  std::string mission;
  EXPECT_TRUE(ReadGameFile(ReadFile(folder / "2026-11-21/2015-000001.game.xml"), loaded,
                           [&mission](const std::string& name) { mission = name; }));
  EXPECT_EQ(mission, "Capture <the> Flag");
}

TEST(UnpackedArchive, TakesFilesThatTheToolPackedAnew) {
  ArchiveVenue venue;
  const std::int64_t game = venue.Archive->Keep(venue.State());
  const std::string bytes = WriteGameFile(venue.Game, venue.State().Mission);
  const TemporaryFolder folder;
  const std::string tool = "sqlite3 '" + venue.ArchivePath() + "' -A ";
  ASSERT_EQ(RunIn(folder.Path(), tool + "-x"), 0);
  ASSERT_EQ(RunIn(folder.Path(), tool + "-u 2026-11-21/2015-000001.game.xml"), 0);
  EXPECT_EQ(venue.Archive->FileOf(game), bytes);
}

}  // namespace
