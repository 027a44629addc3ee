#include "platform/linux/LinuxComputer.h"

#include <fcntl.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <pty.h>
#include <sys/stat.h>
#include <sys/wait.h>

#include <csignal>
#include <filesystem>

#include "platform/linux/ChildProcess.h"
#include "tests/support/OrdinaryUser.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Thrown.h"

namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;

bool Always() {
  return true;
}

/// A line that a program of another process has open.
class HeldLine : public testing::Test {
 protected:
  HeldLine() {
    int own = -1;
    int far = -1;
    char name[64] = {};
    EXPECT_EQ(openpty(&own, &far, static_cast<char*>(name), nullptr, nullptr), 0);
    ownEnd = Descriptor(own);
    line = static_cast<char*>(name);
    holder = std::make_unique<ChildProcess>(std::vector<std::string>{"/bin/sleep", "1000"},
                                            StandardStreams{.Input = far});
    close(far);
  }

  Descriptor ownEnd;
  std::string line;
  std::unique_ptr<ChildProcess> holder;
  LinuxComputer computer;
};

TEST_F(HeldLine, IsFoundWithTheNameOfItsProgram) {
  EXPECT_THAT(computer.UsersOf({"/dev/null", line}, Always), Contains(DeviceUser{line, "sleep"}));
}

TEST_F(HeldLine, IsFoundUnderAnotherNameToo) {
  const TemporaryFolder folder;
  const std::string link = folder / "by-id";
  ASSERT_EQ(symlink(line.c_str(), link.c_str()), 0);
  EXPECT_THAT(computer.UsersOf({link}, Always), ElementsAre(DeviceUser{link, "sleep"}));
}

TEST_F(HeldLine, IsFoundByItsLockToo) {
  const TemporaryFolder folder;
  std::filesystem::create_directories(folder / "proc/4711");
  WriteFile(folder / "proc/4711/comm", "modemd\n");
  WriteFile(folder / ("LCK.." + line.substr(line.rfind('/') + 1)), "      4711\n");
  const LinuxComputer locked(folder / "proc", {}, folder.Path());
  EXPECT_THAT(locked.UsersOf({line}, Always), ElementsAre(DeviceUser{line, "modemd"}));
}

TEST_F(HeldLine, IsFreeOnceTheProgramHasEnded) {
  holder.reset();
  EXPECT_THAT(computer.UsersOf({line}, Always), IsEmpty());
}

TEST_F(HeldLine, OfThisProgramItselfDoesNotCount) {
  holder.reset();
  const Descriptor mine(open(line.c_str(), O_RDWR | O_NOCTTY | O_CLOEXEC));
  ASSERT_GE(mine.Number(), 0);
  EXPECT_THAT(computer.UsersOf({line}, Always), IsEmpty());
}

TEST_F(HeldLine, IsNotLookedForAnyFurtherWhenThatIsNotWanted) {
  int asked = 0;
  computer.UsersOf({line}, [&asked] { return ++asked < 3; });
  EXPECT_EQ(asked, 3);
}

TEST(ThisComputer, KnowsWhatItsUserMayUse) {
  const TemporaryFolder folder;
  WriteFile(folder / "port", "");
  ASSERT_EQ(chmod((folder / "port").c_str(), 0600), 0);
  EXPECT_TRUE(LinuxComputer().MayUse(folder / "port"));
  EXPECT_FALSE(LinuxComputer().MayUse(folder / "missing"));
  ASSERT_EQ(chmod((folder / "port").c_str(), 0400), 0);
  const OrdinaryUser user;
  EXPECT_FALSE(LinuxComputer().MayUse(folder / "port"));
}

TEST(ThisComputer, KnowsItsUser) {
  EXPECT_THAT(LinuxComputer().HomeFolder(), Not(IsEmpty()));
  EXPECT_THAT(LinuxComputer().UserName(), Not(IsEmpty()));
}

LinuxComputer WithPrinters(const std::string& script) {
  return LinuxComputer("/proc", {"/bin/sh", "-c", script});
}

TEST(Printers, AreThoseThatTheSystemLists) {
  EXPECT_THAT(WithPrinters("printf 'Office\nBack_Room\nscheduler is running\n'").Printers(Always),
              ElementsAre("Office", "Back_Room"));
  EXPECT_THAT(WithPrinters("echo scheduler is running").Printers(Always), IsEmpty());
}

TEST(Printers, InTheNetworkNeedNoPrintingSystemOfTheirOwn) {
  EXPECT_THAT(WithPrinters("printf 'Hall\nscheduler is not running\n'").Printers(Always),
              ElementsAre("Hall"));
}

TEST(Printers, AreNoneWhereNothingListsThem) {
  EXPECT_THAT(LinuxComputer("/proc", {"/missing/lpstat"}).Printers(Always), IsEmpty());
  EXPECT_THAT(LinuxComputer("/proc", {"env", "LC_ALL=C", "/missing/lpstat"}).Printers(Always), IsEmpty());
}

TEST(Printers, AreNotNoneWhereThePrintingSystemIsDown) {
  const auto failureOf = [](const LinuxComputer& computer) -> std::string {
    try {
      computer.Printers(Always);
    } catch (const RuntimeError& error) {
      return std::to_string(error.Number()) + ' ' + error.what();
    }
    return "none";
  };
  EXPECT_EQ(failureOf(WithPrinters("echo scheduler is not running")), "68 scheduler is not running");
  EXPECT_EQ(failureOf(WithPrinters("echo lpstat: Forbidden >&2; exit 1")), "68 lpstat: Forbidden");
}

TEST(Printers, AreNotWaitedForWhenThatIsNotWanted) {
  EXPECT_THAT(LinuxComputer("/proc", {"/bin/sleep", "1000"}).Printers([] { return false; }), IsEmpty());
}

TEST(ThisComputer, TellsAboutItsClock) {
  EXPECT_TRUE(LinuxComputer().ClockIsSynchronised().has_value());
}

}  // namespace
