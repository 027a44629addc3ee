#include "platform/linux/LinuxFiles.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstddef>
#include <filesystem>
#include <string>

#include "tests/support/FileSizeLimit.h"
#include "tests/support/OrdinaryUser.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Thrown.h"

namespace {

using testing::HasSubstr;

std::size_t EntriesOf(const std::string& folder) {
  return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(folder), {}));
}

mode_t ModeOf(const std::string& path) {
  struct stat info {};
  stat(path.c_str(), &info);
  return info.st_mode & 07777;
}

TEST(LinuxFilesReplace, WritesANewFileAndLeavesNothingElse) {
  const TemporaryFolder folder;
  LinuxFiles files;
  files.Replace(folder / "new", std::string("a\0b", 3));
  EXPECT_EQ(ReadFile(folder / "new"), std::string("a\0b", 3));
  EXPECT_EQ(EntriesOf(folder.Path()), 1u);
}

TEST(LinuxFilesReplace, ReplacesAllOfALongerFile) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", std::string(100'000, 'x'));
  LinuxFiles files;
  files.Replace(folder / "file", "short");
  EXPECT_EQ(ReadFile(folder / "file"), "short");
  EXPECT_EQ(EntriesOf(folder.Path()), 1u);
}

TEST(LinuxFilesReplace, ReaderOfTheOldFileKeepsIt) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "old");
  std::ifstream reader(folder / "file");
  LinuxFiles files;
  files.Replace(folder / "file", "new");
  std::string seen;
  reader >> seen;
  EXPECT_EQ(seen, "old");
}

TEST(LinuxFilesReplace, NewFileGets0644LessTheMask) {
  const TemporaryFolder folder;
  LinuxFiles files;
  const mode_t old = umask(0027);
  files.Replace(folder / "private", "x");
  umask(0);
  files.Replace(folder / "open", "x");
  umask(old);
  EXPECT_EQ(ModeOf(folder / "private"), 0640u);
  EXPECT_EQ(ModeOf(folder / "open"), 0644u);
}

TEST(LinuxFilesReplace, KeepsTheOldFilesMode) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "old");
  std::filesystem::permissions(folder / "file", std::filesystem::perms(0666));
  LinuxFiles files;
  const mode_t old = umask(0077);
  files.Replace(folder / "file", "new");
  umask(old);
  EXPECT_EQ(ModeOf(folder / "file"), 0666u);
}

TEST(LinuxFilesReplace, LetsThisUserAloneReadPersonalData) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "old");
  std::filesystem::permissions(folder / "file", std::filesystem::perms(0644));
  LinuxFiles files;
  const mode_t old = umask(0);
  files.ReplacePrivately(folder / "file", "new");
  files.ReplacePrivately(folder / "fresh", "x");
  umask(old);
  EXPECT_EQ(ModeOf(folder / "file"), 0600u);
  EXPECT_EQ(ModeOf(folder / "fresh"), 0600u);
  EXPECT_EQ(ReadFile(folder / "file"), "new");
  EXPECT_EQ(EntriesOf(folder.Path()), 2u);
}

TEST(LinuxFilesReplace, ReplacesTheTargetOfALinkAndKeepsTheLink) {
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder / "real");
  WriteFile(folder / "real/file", "old");
  std::filesystem::create_symlink("real/file", folder / "second");
  std::filesystem::create_symlink(folder / "second", folder / "first");
  LinuxFiles files;
  files.Replace(folder / "first", "new");
  EXPECT_TRUE(std::filesystem::is_symlink(folder / "first"));
  EXPECT_TRUE(std::filesystem::is_symlink(folder / "second"));
  EXPECT_EQ(ReadFile(folder / "real/file"), "new");
}

TEST(LinuxFilesReplace, MakesTheMissingTargetOfALink) {
  const TemporaryFolder folder;
  std::filesystem::create_symlink("target", folder / "link");
  LinuxFiles files;
  files.Replace(folder / "link", "new");
  EXPECT_TRUE(std::filesystem::is_symlink(folder / "link"));
  EXPECT_EQ(ReadFile(folder / "target"), "new");
}

TEST(LinuxFilesReplace, LinkToItselfIs75) {
  const TemporaryFolder folder;
  std::filesystem::create_symlink("ring", folder / "ring");
  LinuxFiles files;
  EXPECT_EQ(NumberThrownBy([&] { files.Replace(folder / "ring", "x"); }), 75);
}

TEST(LinuxFilesReplace, MissingFolderIs76AndNamesTheFile) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "x");
  LinuxFiles files;
  const Thrown thrown = ThrownBy([&] { files.Replace(folder / "no/file", "x"); });
  EXPECT_EQ(thrown.Number, 76);
  EXPECT_EQ(thrown.Text, "Path not found: " + folder / "no/file");
  EXPECT_EQ(NumberThrownBy([&] { files.Replace(folder / "file/below", "x"); }), 76);
}

TEST(LinuxFilesReplace, FolderIs75AndStays) {
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder / "sub");
  LinuxFiles files;
  EXPECT_EQ(NumberThrownBy([&] { files.Replace(folder / "sub", "x"); }), 75);
  EXPECT_TRUE(std::filesystem::is_directory(folder / "sub"));
  EXPECT_EQ(EntriesOf(folder.Path()), 1u);
}

TEST(LinuxFilesReplace, DeviceIs75) {
  LinuxFiles files;
  EXPECT_EQ(NumberThrownBy([&] { files.Replace("/dev/null", "x"); }), 75);
}

TEST(LinuxFilesReplace, FileWithoutWritePermissionIs70AndStays) {
  const TemporaryFolder folder;
  std::filesystem::permissions(folder.Path(), std::filesystem::perms(0777));
  WriteFile(folder / "file", "old");
  std::filesystem::permissions(folder / "file", std::filesystem::perms(0444));
  LinuxFiles files;
  const OrdinaryUser user;
  const Thrown thrown = ThrownBy([&] { files.Replace(folder / "file", "new"); });
  EXPECT_EQ(thrown.Number, 70);
  EXPECT_EQ(thrown.Text, "Permission denied: " + folder / "file");
  EXPECT_EQ(ReadFile(folder / "file"), "old");
  EXPECT_EQ(EntriesOf(folder.Path()), 1u);
}

TEST(LinuxFilesReplace, FolderWithoutWritePermissionIs70AndTheOldFileStays) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "old");
  std::filesystem::permissions(folder / "file", std::filesystem::perms(0666));
  std::filesystem::permissions(folder.Path(), std::filesystem::perms(0555));
  LinuxFiles files;
  const OrdinaryUser user;
  EXPECT_EQ(NumberThrownBy([&] { files.Replace(folder / "file", "new"); }), 70);
  EXPECT_EQ(ReadFile(folder / "file"), "old");
}

TEST(LinuxFilesReplace, OrdinaryUserMayReplaceAFileOfAnother) {
  const TemporaryFolder folder;
  std::filesystem::permissions(folder.Path(), std::filesystem::perms(0777));
  WriteFile(folder / "file", "old");
  std::filesystem::permissions(folder / "file", std::filesystem::perms(0666));
  LinuxFiles files;
  const OrdinaryUser user;
  files.Replace(folder / "file", "new");
  EXPECT_EQ(ReadFile(folder / "file"), "new");
  EXPECT_EQ(ModeOf(folder / "file"), 0666u);
}

TEST(LinuxFilesReplace, WriteThatFailsHalfWayLeavesTheOldFileAndNothingElse) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "old");
  LinuxFiles files;
  Thrown thrown;
  {
    const FileSizeLimit limit(4096);
    thrown = ThrownBy([&] { files.Replace(folder / "file", std::string(10'000, 'x')); });
  }
  EXPECT_EQ(thrown.Number, 75);
  EXPECT_THAT(thrown.Text, HasSubstr(folder / "file"));
  EXPECT_EQ(ReadFile(folder / "file"), "old");
  EXPECT_EQ(EntriesOf(folder.Path()), 1u);
}

TEST(LinuxFilesReplace, RenameThatFailsLeavesNothingBehind) {
  const TemporaryFolder folder;
  LinuxFiles files;
  EXPECT_EQ(NumberThrownBy([&] { files.Replace(folder / std::string(256, 'n'), "x"); }), 75);
  EXPECT_EQ(EntriesOf(folder.Path()), 0u);
}

TEST(LinuxFilesReplace, TakesAPathRelativeToTheWorkingFolder) {
  const TemporaryFolder folder;
  const std::filesystem::path old = std::filesystem::current_path();
  std::filesystem::current_path(folder.Path());
  LinuxFiles files;
  files.Replace("here", "x");
  std::filesystem::current_path(old);
  EXPECT_EQ(ReadFile(folder / "here"), "x");
}

TEST(TakePlace, PutsAFileInTheOthersPlaceWithItsPermissions) {
  const TemporaryFolder folder;
  WriteFile(folder / "old", "old");
  WriteFile(folder / "new", "new");
  chmod((folder / "old").c_str(), 0640);
  LinuxFiles().TakePlace(folder / "new", folder / "old");
  EXPECT_EQ(ReadFile(folder / "old"), "new");
  EXPECT_EQ(ModeOf(folder / "old"), 0640U);
  EXPECT_EQ(EntriesOf(folder.Path()), 1U);
}

TEST(TakePlace, NeedsBothFiles) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "there");
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().TakePlace(folder / "gone", folder / "file"); }), 53);
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().TakePlace(folder / "file", folder / "gone"); }), 53);
  EXPECT_EQ(ReadFile(folder / "file"), "there");
}

TEST(TakePlace, LeavesAWriteProtectedFileWhereItIs) {
  const TemporaryFolder folder;
  WriteFile(folder / "old", "old");
  WriteFile(folder / "new", "new");
  chmod((folder / "old").c_str(), 0444);
  const OrdinaryUser user;
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().TakePlace(folder / "new", folder / "old"); }), 70);
  EXPECT_EQ(ReadFile(folder / "old"), "old");
  EXPECT_EQ(ReadFile(folder / "new"), "new");
}

TEST(NewFile, TakesItsPlaceOnlyWhenItIsFinished) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "old");
  chmod((folder / "file").c_str(), 0640);
  LinuxFiles files;
  {
    const auto file = files.BeginReplace(folder / "file", FileReaders::AsBefore);
    file->Write("one ");
    file->Write(std::string("two\0", 4));
    EXPECT_EQ(ReadFile(folder / "file"), "old");
    file->Finish();
  }
  EXPECT_EQ(ReadFile(folder / "file"), std::string("one two\0", 8));
  EXPECT_EQ(ModeOf(folder / "file"), 0640U);
  EXPECT_EQ(EntriesOf(folder.Path()), 1U);
}

TEST(NewFile, LeavesNothingWhenItIsNotFinished) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "old");
  LinuxFiles().BeginReplace(folder / "file", FileReaders::AsBefore)->Write("new");
  LinuxFiles().BeginReplace(folder / "other", FileReaders::AsBefore)->Write("new");
  EXPECT_EQ(ReadFile(folder / "file"), "old");
  EXPECT_EQ(EntriesOf(folder.Path()), 1U);
}

TEST(NewFile, IsForThisUserAloneWhereThatIsWanted) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "old");
  chmod((folder / "file").c_str(), 0644);
  const auto file = LinuxFiles().BeginReplace(folder / "file", FileReaders::ThisUser);
  file->Finish();
  EXPECT_EQ(ModeOf(folder / "file"), 0600U);
}

TEST(NewFile, FailsAsAReplacementDoes) {
  const TemporaryFolder folder;
  LinuxFiles files;
  EXPECT_EQ(NumberThrownBy([&] { files.BeginReplace(folder / "none/file", FileReaders::AsBefore); }), 76);
  EXPECT_EQ(NumberThrownBy([&] { files.BeginReplace(folder.Path(), FileReaders::AsBefore); }), 75);
  WriteFile(folder / "file", "old");
  const FileSizeLimit limit(10'000);
  const auto file = files.BeginReplace(folder / "file", FileReaders::AsBefore);
  EXPECT_EQ(NumberThrownBy([&] { file->Write(std::string(20'000, 'x')); }), 75);
  EXPECT_EQ(ReadFile(folder / "file"), "old");
}

}  // namespace
