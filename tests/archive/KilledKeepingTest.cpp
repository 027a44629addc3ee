#include <gtest/gtest.h>

#include <sys/wait.h>
#include <unistd.h>
#include <csignal>
#include <ctime>
#include <random>

#include "tests/archive/ArchiveVenue.h"

namespace {

/// Another process that keeps games, and tells each game's number once it is kept, until it is killed.
class KeepingProcess {
 public:
  explicit KeepingProcess(ArchiveVenue& venue) {
    int ends[2] = {};
    if (pipe(ends) != 0) {
      throw std::runtime_error("no pipe");
    }
    process_ = fork();
    if (process_ == 0) {
      close(ends[0]);
      KeepForEver(venue, ends[1]);
    }
    close(ends[1]);
    told_ = ends[0];
  }
  ~KeepingProcess() { close(told_); }
  KeepingProcess(const KeepingProcess&) = delete;
  KeepingProcess& operator=(const KeepingProcess&) = delete;

  /// Waits for the first number, then some microseconds; returns all numbers that were told before the end.
  std::vector<std::int64_t> KillAfter(long microseconds) {
    std::vector<std::int64_t> numbers;
    std::int64_t number = 0;
    if (read(told_, &number, sizeof number) == sizeof number) {
      numbers.push_back(number);
    }
    const timespec pause{.tv_sec = 0, .tv_nsec = microseconds * 1000};
    nanosleep(&pause, nullptr);
    kill(process_, SIGKILL);
    waitpid(process_, nullptr, 0);
    while (read(told_, &number, sizeof number) == sizeof number) {
      numbers.push_back(number);
    }
    return numbers;
  }

 private:
  [[noreturn]] static void KeepForEver(ArchiveVenue& venue, int told) {
    std::int64_t number = 0;
    do {
      venue.Open();
      ++venue.Game.Players(ArchiveVenue::Red0).BonusPoints;
      number = venue.Archive->Keep(venue.State());
      for (const FormerState former : {FormerState::KeptToo, FormerState::Replaced}) {
        ++venue.Game.Players(ArchiveVenue::Red0).BonusPoints;
        venue.Archive->KeepAgain(number, venue.State(), former);
      }
    } while (write(told, &number, sizeof number) == sizeof number);
    _exit(0);
  }

  pid_t process_ = -1;
  int told_ = -1;
};

/// Fails unless each game of the archive is whole, those of which nobody was told too.
void ExpectWholeGames(ArchiveVenue& venue) {
  EXPECT_EQ(venue.Query("PRAGMA integrity_check"), "ok");
  EXPECT_EQ(venue.Query("SELECT count(*) FROM Games g WHERE Players <> "
                        "(SELECT count(*) FROM GamePlayers p WHERE p.GameID = g.GameID)"),
            "0");
  EXPECT_EQ(venue.Query("SELECT count(*) FROM Games LEFT JOIN GameFiles USING (GameID, InputsHash) "
                        "WHERE State IS NOT 0"),
            "0");
  EXPECT_EQ(venue.Query("SELECT count(*) FROM GameFiles LEFT JOIN sqlar USING (Name) WHERE sz IS NULL"), "0");
  EXPECT_EQ(venue.Query("SELECT count(*) FROM sqlar"), venue.Query("SELECT count(*) FROM GameFiles"));
}

TEST(KilledKeeping, LeavesEveryGameThatWasToldKeptAndNoneHalf) {
  ArchiveVenue venue;
  FillRandomly(venue.Game, 40, 5);
  std::mt19937 random(20261121);
  std::vector<std::int64_t> told;
  for (int round = 0; round < 25; ++round) {
    venue.Archive.reset();
    venue.ArchiveDatabase.reset();
    venue.MembersDatabase.reset();
    const std::vector<std::int64_t> numbers =
        KeepingProcess(venue).KillAfter(static_cast<long>(random() % 20'000));
    told.insert(told.end(), numbers.begin(), numbers.end());
    venue.Open();
    ExpectWholeGames(venue);
  }
  ASSERT_GE(told.size(), 25U);
  for (const std::int64_t number : told) {
    EXPECT_EQ(venue.Archive->EarlierStates(number), 1) << number;
    EXPECT_NO_THROW(venue.Read(venue.Archive->FileOf(number))) << number;
    EXPECT_NO_THROW(venue.Read(venue.Archive->FileOf(number, 1))) << number;
  }
}

}  // namespace
