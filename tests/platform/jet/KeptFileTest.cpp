#include "platform/jet/KeptFile.h"

#include <gmock/gmock.h>

#include <filesystem>

#include "platform/linux/LinuxFiles.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// Keeps the paths of the durable writes.
class WatchedFiles : public LinuxFiles {
 public:
  std::vector<std::string> Replaced;
  bool Fails = false;

  void Replace(const std::string& path, const std::string& bytes) override {
    Replaced.push_back(path);
    if (Fails) {
      throw RuntimeError(Fault::DiskFull);
    }
    LinuxFiles::Replace(path, bytes);
  }
};

bool NoLinks(const std::string& /*path*/, const std::string& /*newPath*/) {
  return false;
}

class Keeping : public testing::Test {
 protected:
  Keeping() { WriteFile(path, "old"); }

  TemporaryFolder folder;
  const std::string path = folder / "members.mdb";
  WatchedFiles disk;
};

TEST_F(Keeping, GivesTheFileASecondName) {
  KeptFile kept(disk, path);
  EXPECT_EQ(kept.Path(), path + ".jet");
  EXPECT_TRUE(std::filesystem::equivalent(path, path + ".jet"));
  EXPECT_THAT(disk.Replaced, IsEmpty());
}

TEST_F(Keeping, MakesADurableCopyWhereThereAreNoLinks) {
  KeptFile(disk, path, NoLinks).Keep();
  EXPECT_THAT(disk.Replaced, ElementsAre(path + ".jet"));
  EXPECT_EQ(ReadFile(path + ".jet"), "old");
  EXPECT_FALSE(std::filesystem::equivalent(path, path + ".jet"));
}

TEST_F(Keeping, LeavesNothingOfACopyThatFails) {
  disk.Fails = true;
  EXPECT_EQ(NumberThrownBy([&] { KeptFile(disk, path, NoLinks); }), 61);
  EXPECT_THAT(disk.FileNames(folder.Path()), ElementsAre("members.mdb"));
}

TEST_F(Keeping, IsTakenBackUnlessItIsToStay) {
  { const KeptFile kept(disk, path); }
  EXPECT_FALSE(disk.FileExists(path + ".jet"));
  KeptFile(disk, path).Keep();
  EXPECT_TRUE(disk.FileExists(path + ".jet"));
}

TEST_F(Keeping, UsesTheNameOfAnInterruptedConversionAgain) {
  WriteFile(path + ".jet", "another");
  HardLink(path, path + ".jet2");
  { EXPECT_EQ(KeptFile(disk, path).Path(), path + ".jet2"); }
  EXPECT_TRUE(disk.FileExists(path + ".jet2"));
  EXPECT_EQ(ReadFile(path + ".jet"), "another");
}

}  // namespace
