#include <gmock/gmock.h>
#include <sys/socket.h>
#include <sys/stat.h>

#include <filesystem>
#include <memory>

#include "tests/platform/linux/InstanceVenue.h"

namespace {

using namespace std::chrono_literals;

/// Programs with one data folder, which may have different runtime folders.
class InstanceInTwoFolders : public InstanceOfAProgram {
 protected:
  InstanceInTwoFolders() {
    for (const std::string& each : {Runtime, Other, Data}) {
      EXPECT_EQ(mkdir(each.c_str(), 0755), 0);
    }
  }

  const std::string Runtime = folder / "runtime";
  const std::string Other = folder / "other";
  const std::string Data = folder / "data";
  const InstancePlace Both{{Runtime, Data}, "program"};
  const InstancePlace DataAlone{{Data}, "program"};
};

TEST_F(InstanceInTwoFolders, IsNoSecondFirstWithoutTheRuntimeFolderOfTheFirst) {
  Instance first(Both);
  ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First);
  EXPECT_EQ(StartAt(DataAlone).ExitCode(), NoAnswer);
  EXPECT_EQ(StartAt({{Other, Data}, "program"}).ExitCode(), NoAnswer);
}

TEST_F(InstanceInTwoFolders, IsNoSecondFirstWithARuntimeFolderThatTheFirstDidNotHave) {
  Instance first(DataAlone);
  ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First);
  Forked second = StartAt(Both, {"/a", ""}, 30s);
  EXPECT_EQ(TakeCall(first).Path, "/a");
  EXPECT_EQ(second.ExitCode(), Told);
}

TEST_F(InstanceInTwoFolders, LocksInOneWhereTheOtherCannotTakeAFile) {
  for (const std::string& refuses : {Runtime, Data}) {
    ASSERT_EQ(rmdir(refuses.c_str()), 0);  // as a disk without room does
    Instance first(Both);
    ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First) << refuses;
    Forked second = StartAt(Both, {"/a", ""}, 30s);
    EXPECT_EQ(TakeCall(first).Path, "/a") << refuses;
    EXPECT_EQ(second.ExitCode(), Told);
    EXPECT_EQ(StartAt(Both).ExitCode(), NoAnswer) << refuses;
    ASSERT_EQ(mkdir(refuses.c_str(), 0755), 0);
  }
}

TEST_F(InstanceInTwoFolders, DropsOneLockWhenTheOtherIsHeld) {
  const InstancePlace runtimeAlone{{Runtime}, "program"};
  auto first = std::make_unique<Instance>(runtimeAlone);
  ASSERT_EQ(first->Start({}, 0ms), InstanceOutcome::First);
  Instance second(Both);
  EXPECT_EQ(second.Start({}, 0ms), InstanceOutcome::NoAnswer);
  EXPECT_TRUE(std::filesystem::is_empty(Data));
  first.reset();
  EXPECT_EQ(second.Start({}, 0ms), InstanceOutcome::First);
  EXPECT_EQ(StartAt(DataAlone).ExitCode(), NoAnswer);
}

TEST_F(InstanceInTwoFolders, TakesItsFilesAwayFromBoth) {
  {
    Instance first(Both);
    ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First);
    EXPECT_EQ(access(Instance::LockPath(Both, 0).c_str(), F_OK), 0);
    EXPECT_EQ(access(Instance::LockPath(Both, 1).c_str(), F_OK), 0);
    EXPECT_EQ(access(Instance::SocketPath(Both, 1).c_str(), F_OK), -1) << "one is enough";
  }
  EXPECT_TRUE(std::filesystem::is_empty(Runtime));
  EXPECT_TRUE(std::filesystem::is_empty(Data));
}

TEST_F(InstanceInTwoFolders, IsBarredByALockOfAnotherUser) {
  if (geteuid() != 0) {  // nobody else can make a file of another user: what it is for an own file
    WriteFile(Instance::LockPath(Both, 1), "");
    EXPECT_EQ(StartAt(Both).ExitCode(), First);
    return;
  }
  WriteFile(Instance::LockPath(Both, 1), "");
  ASSERT_EQ(chmod(Instance::LockPath(Both, 1).c_str(), 0600), 0);
  for (const std::string& each : {folder.Path(), Runtime, Data}) {
    ASSERT_EQ(chmod(each.c_str(), 0777), 0);
  }
  const OrdinaryUser user;
  Instance barred(Both);
  EXPECT_EQ(barred.Start({}, 0ms), InstanceOutcome::Barred);
  EXPECT_EQ(barred.BarredBy(), Instance::LockPath(Both, 1));
}

TEST_F(InstanceInTwoFolders, LeavesTheLockOfTheAdministratorToTheOwnerOfTheData) {
  if (geteuid() == 0) {
    ASSERT_EQ(chmod(folder.Path().c_str(), 0777), 0);
    ASSERT_EQ(chown(Data.c_str(), 65534, 65534), 0);
  }
  auto first = std::make_unique<Instance>(DataAlone);
  ASSERT_EQ(first->Start({}, 0ms), InstanceOutcome::First);
  const OrdinaryUser user;
  EXPECT_EQ(Instance(DataAlone).Start({}, 0ms), InstanceOutcome::NoAnswer) << "it is held";
}

}  // namespace
