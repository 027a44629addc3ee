#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <csignal>
#include <random>
#include <thread>

#include "tests/archive/copies/CopySite.h"

namespace {

constexpr std::array<const char*, 2> Names = {"'Eve', 'Fay'", "'Gus', 'Hal', 'Ida'"};

/// Restores one copy after the other until it is killed.
[[noreturn]] void RestoreForEver(CopySite& site, const std::array<BackupCopy, 2>& copies) {
  for (std::size_t turn = 0;; turn = 1 - turn) {
    site.Open();
    if (site.Restore(copies[turn]).What != Restored::Done) {
      _exit(1);
    }
  }
}

TEST(RestoreKilled, LeavesTheWholeOldOrTheWholeNewFile) {
  constexpr int kills = 40;
  constexpr int longestMicroseconds = 60'000;
  const unsigned seed = std::random_device()();
  SCOPED_TRACE("seed " + std::to_string(seed));
  std::mt19937 random(seed);
  CopySite site;
  const std::array<BackupCopy, 2> copies = {
      site.PutCopy("members-2013-05-01-200000.mdb", CopySite::WithMembers(Names[0])),
      site.PutCopy("members-2013-05-02-200000.mdb", CopySite::WithMembers(Names[1]))};
  const std::string first = site.Names();
  int exchanged = 0;
  for (int kill = 0; kill < kills; ++kill) {
    site.InUse.reset();
    const pid_t child = fork();
    if (child == 0) {
      RestoreForEver(site, copies);
    }
    std::this_thread::sleep_for(
        std::chrono::microseconds(std::uniform_int_distribution<int>(0, longestMicroseconds)(random)));
    ::kill(child, SIGKILL);
    int status = 0;
    waitpid(child, &status, 0);
    ASSERT_TRUE(WIFSIGNALED(status)) << "ended by itself";
    for (const char* left : {"-journal", "-wal", "-shm"}) {
      EXPECT_FALSE(std::filesystem::exists(site.MembersFile() + left)) << left;
    }
    const std::string names = site.Names();
    EXPECT_TRUE(names == first || names == "Eve Fay" || names == "Gus Hal Ida") << names;
    EXPECT_EQ(OtherConnection(site.MembersFile()).Query("PRAGMA integrity_check"), "ok");
    exchanged += names != first ? 1 : 0;
    for (const BackupCopy& copy : CopiesIn(site.Disk, site.CopyFolder())) {
      EXPECT_EQ(OtherConnection(site.Work.PathOf(copy)).Query("PRAGMA integrity_check"), "ok") << copy.File;
    }
    ASSERT_FALSE(HasFailure());
  }
  EXPECT_GT(exchanged, 0);
  site.Open();
  EXPECT_EQ(site.Restore(copies[0]).What, Restored::Done);
}

}  // namespace
