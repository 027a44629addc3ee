#include "platform/linux/PortLocks.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdint>
#include <filesystem>
#include <string_view>

#include "tests/support/TemporaryFolder.h"

namespace {

/// A folder of locks and one of processes, in which number 4711 runs.
class LockedLine : public testing::Test {
 protected:
  LockedLine() {
    WriteFile(folder / "ttyUSB0", "");
    std::filesystem::create_directories(folder / "proc/4711");
    WriteFile(folder / "proc/4711/comm", "modemd\n");
  }

  std::optional<std::string> Holder() const { return HolderOf(folder / "ttyUSB0"); }
  std::optional<std::string> HolderOf(const std::string& device) const {
    return LockHolder(device, folder.Path(), folder / "proc");
  }
  void PutLock(std::string_view bytes) const { WriteFile(folder / "LCK..ttyUSB0", std::string(bytes)); }
  /// The process began that many seconds after 1970.
  void BeginAt(std::int64_t seconds) const {
    constexpr std::int64_t boot = 1'000'000'000;
    const std::int64_t ticks = (seconds - boot) * sysconf(_SC_CLK_TCK);
    WriteFile(folder / "proc/stat", "cpu  1 2 3\nbtime " + std::to_string(boot) + "\nprocesses 9\n");
    std::string fields = "4711 (a) b 7) S";
    for (int field = 4; field < 22; ++field) {
      fields.append(" ").append(std::to_string(field));
    }
    WriteFile(folder / "proc/4711/stat", fields + " " + std::to_string(ticks) + " 23 24\n");
  }

  TemporaryFolder folder;
};

TEST_F(LockedLine, IsFreeWithoutALock) {
  EXPECT_EQ(Holder(), std::nullopt);
  EXPECT_EQ(HolderOf(folder / "missing"), std::nullopt);
}

TEST_F(LockedLine, NamesTheProgramWhoseNumberTheLockTells) {
  PutLock("      4711\n");
  EXPECT_EQ(Holder(), "modemd");
  PutLock("4711\nmodemd\nthis-computer\n");
  EXPECT_EQ(Holder(), "modemd");
}

TEST_F(LockedLine, ReadsALockOfFourBytesToo) {
  const std::int32_t number = 4711;
  PutLock(std::string_view(reinterpret_cast<const char*>(&number), sizeof number));
  EXPECT_EQ(Holder(), "modemd");
}

TEST_F(LockedLine, IsKnownByItsOtherNames) {
  PutLock("4711");
  std::filesystem::create_symlink(folder / "ttyUSB0", folder / "by-id");
  EXPECT_EQ(HolderOf(folder / "by-id"), "modemd");
}

TEST_F(LockedLine, IsFreeWhenTheLockIsLeftOverOrNonsense) {
  for (const std::string_view bytes : {"4712\n", "", "nobody\n", "-4711\n", "0\n", "99999999999999\n"}) {
    PutLock(bytes);
    EXPECT_EQ(Holder(), std::nullopt) << bytes;
  }
}

TEST_F(LockedLine, IsFreeWhenTheLockIsThisProgramsOwn) {
  std::filesystem::create_directories(folder / ("proc/" + std::to_string(getpid())));
  PutLock(std::to_string(getpid()));
  EXPECT_EQ(Holder(), std::nullopt);
}

TEST_F(LockedLine, IsFreeWhenTheNumberIsAnotherProgramsByNow) {
  PutLock("4711\n");
  struct stat info {};
  ASSERT_EQ(stat((folder / "LCK..ttyUSB0").c_str(), &info), 0);
  BeginAt(info.st_mtime - 60);
  EXPECT_EQ(Holder(), "modemd");
  BeginAt(info.st_mtime + 60);
  EXPECT_EQ(Holder(), std::nullopt);
}

TEST_F(LockedLine, IsToldByItsNumberWhereThatHasNoName) {
  PutLock("4711\n");
  std::filesystem::remove(folder / "proc/4711/comm");
  EXPECT_EQ(Holder(), "4711");
}

TEST_F(LockedLine, IsFreeWhereTheLockIsNoPlainFile) {
  std::filesystem::create_directory(folder / "LCK..ttyUSB0");
  EXPECT_EQ(Holder(), std::nullopt);
}

}  // namespace
