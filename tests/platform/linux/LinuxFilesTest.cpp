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

#include "platform/linux/FileError.h"
#include "tests/support/OrdinaryUser.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;

std::size_t EntriesOf(const std::string& folder) {
  return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(folder), {}));
}

TEST(LinuxFilesRead, GivesEveryByte) {
  const TemporaryFolder folder;
  std::string bytes(200'000, '\0');
  for (std::size_t i = 0; i < bytes.size(); ++i) {
    bytes[i] = static_cast<char>(i * 7);
  }
  WriteFile(folder / "all", bytes);
  EXPECT_EQ(LinuxFiles().Read(folder / "all"), bytes);
}

TEST(LinuxFilesRead, GivesAnEmptyFile) {
  const TemporaryFolder folder;
  WriteFile(folder / "empty", "");
  EXPECT_EQ(LinuxFiles().Read(folder / "empty"), "");
}

TEST(LinuxFilesRead, GivesAPartAsFarAsTheFileGoes) {
  const TemporaryFolder folder;
  const std::string bytes = std::string(100'000, 'a') + "0123456789";
  WriteFile(folder / "parts", bytes);
  const LinuxFiles files;
  EXPECT_EQ(files.ReadPart(folder / "parts", 0, 3), "aaa");
  EXPECT_EQ(files.ReadPart(folder / "parts", 99'999, 4), "a012");
  EXPECT_EQ(files.ReadPart(folder / "parts", 100'007, 50), "789");
  EXPECT_EQ(files.ReadPart(folder / "parts", 0, std::size_t{1} << 40U), bytes);
  EXPECT_EQ(files.ReadPart(folder / "parts", 100'010, 5), "");
  EXPECT_EQ(files.ReadPart(folder / "parts", std::uint64_t{1} << 62U, 5), "");
  EXPECT_EQ(NumberThrownBy([&] { files.ReadPart(folder / "none", 0, 1); }), 53);
  EXPECT_EQ(NumberThrownBy([&] { files.ReadPart(folder.Path(), 0, 1); }), 75);
}

TEST(LinuxFilesRead, MissingFileIs53AndNamesIt) {
  const TemporaryFolder folder;
  const Thrown thrown = ThrownBy([&] { LinuxFiles().Read(folder / "none"); });
  EXPECT_EQ(thrown.Number, 53);
  EXPECT_EQ(thrown.Text, "File not found: " + folder / "none");
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().Read(folder / "none/below"); }), 53);
}

TEST(LinuxFilesRead, FolderIs75) {
  const TemporaryFolder folder;
  const Thrown thrown = ThrownBy([&] { LinuxFiles().Read(folder.Path()); });
  EXPECT_EQ(thrown.Number, 75);
  EXPECT_EQ(thrown.Text, "Path/File access error: " + folder.Path());
}

TEST(LinuxFilesRead, PipeIs75AndDoesNotWait) {
  const TemporaryFolder folder;
  ASSERT_EQ(mkfifo((folder / "pipe").c_str(), 0600), 0);
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().Read(folder / "pipe"); }), 75);
}

TEST(LinuxFilesRead, FileWithoutReadPermissionIs75) {
  const TemporaryFolder folder;
  WriteFile(folder / "secret", "x");
  std::filesystem::permissions(folder / "secret", std::filesystem::perms::none);
  const OrdinaryUser user;
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().Read(folder / "secret"); }), 75);
}

TEST(LinuxFilesExists, TellsFilesFromFolders) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "x");
  const LinuxFiles files;
  EXPECT_TRUE(files.FileExists(folder / "file"));
  EXPECT_FALSE(files.FolderExists(folder / "file"));
  EXPECT_FALSE(files.FileExists(folder.Path()));
  EXPECT_TRUE(files.FolderExists(folder.Path()));
  EXPECT_FALSE(files.FileExists(folder / "none"));
  EXPECT_FALSE(files.FolderExists(folder / "none"));
  EXPECT_FALSE(files.FileExists(""));
}

TEST(LinuxFilesExists, LinkToNothingIsNoFile) {
  const TemporaryFolder folder;
  std::filesystem::create_symlink("none", folder / "link");
  EXPECT_FALSE(LinuxFiles().FileExists(folder / "link"));
}

TEST(LinuxFilesCreateFolder, MakesOneFolder) {
  const TemporaryFolder folder;
  LinuxFiles files;
  files.CreateFolder(folder / "new");
  EXPECT_TRUE(std::filesystem::is_directory(folder / "new"));
}

TEST(LinuxFilesCreateFolder, MissingParentIs76AndPresentFolderIs75) {
  const TemporaryFolder folder;
  LinuxFiles files;
  const Thrown missing = ThrownBy([&] { files.CreateFolder(folder / "no/new"); });
  EXPECT_EQ(missing.Number, 76);
  EXPECT_EQ(missing.Text, "Path not found: " + folder / "no/new");
  EXPECT_EQ(NumberThrownBy([&] { files.CreateFolder(folder.Path()); }), 75);
  EXPECT_FALSE(std::filesystem::exists(folder / "no"));
}

TEST(LinuxFilesPrivateFolder, IsForThisUserAloneAlsoIfItWasForAll) {
  const TemporaryFolder folder;
  LinuxFiles files;
  for (int time = 0; time < 2; ++time) {
    files.MakePrivateFolder(folder / "own");
    EXPECT_EQ(std::filesystem::status(folder / "own").permissions(), std::filesystem::perms::owner_all);
    std::filesystem::permissions(folder / "own", std::filesystem::perms::all);
  }
  EXPECT_EQ(NumberThrownBy([&] { files.MakePrivateFolder(folder / "no/own"); }), 76);
}

TEST(LinuxFilesUnfinished, AreDeletedAndNothingElse) {
  const TemporaryFolder folder;
  LinuxFiles files;
  for (const char* name : {".new-0123456789abcdef", ".new-0123456789abcdeg", ".new-0123456789abcde",
                           ".new-0123456789abcdef0", "a.new-0123456789abcdef", "members.mdb"}) {
    files.Write(folder / name, "bytes");
  }
  std::filesystem::create_directory(folder / ".new-0123456789abcdee");
  files.DeleteUnfinished(folder.Path());
  EXPECT_THAT(files.FileNames(folder.Path()),
              ElementsAre(".new-0123456789abcde", ".new-0123456789abcdef0", ".new-0123456789abcdeg",
                          "a.new-0123456789abcdef", "members.mdb"));
  EXPECT_TRUE(files.FolderExists(folder / ".new-0123456789abcdee"));
  files.DeleteUnfinished(folder / "no");
}

TEST(LinuxFilesUnfinished, HaveTheNamesThatAReplacementGivesThem) {
  const TemporaryFolder folder;
  LinuxFiles files;
  const std::unique_ptr<NewFile> file = files.BeginReplace(folder / "a", FileReaders::AsBefore);
  EXPECT_EQ(files.FileNames(folder.Path()).size(), 1U);
  files.DeleteUnfinished(folder.Path());
  EXPECT_EQ(files.FileNames(folder.Path()).size(), 0U);
}

TEST(LinuxFilesTemporary, MakesANewEmptyFileEachTime) {
  LinuxFiles files;
  const std::string first = files.MakeTempFileName();
  const std::string second = files.MakeTempFileName();
  EXPECT_NE(first, second);
  for (const std::string& path : {first, second}) {
    EXPECT_EQ(std::filesystem::path(path).parent_path(), std::filesystem::temp_directory_path());
    EXPECT_EQ(std::filesystem::path(path).filename().string().substr(0, 3), "per");
    EXPECT_EQ(std::filesystem::file_size(path), 0u);
    files.Delete(path);
    EXPECT_FALSE(files.FileExists(path));
  }
}

TEST(LinuxFilesNewFile, HasAHiddenNameThatNoOtherFileHas) {
  const TemporaryFolder folder;
  LinuxFiles files;
  const std::string first = files.MakeFileIn(folder.Path());
  const std::string second = files.MakeFileIn(folder.Path());
  EXPECT_NE(first, second);
  for (const std::string& path : {first, second}) {
    EXPECT_EQ(std::filesystem::path(path).parent_path(), folder.Path());
    EXPECT_EQ(std::filesystem::path(path).filename().string().front(), '.');
    EXPECT_EQ(std::filesystem::file_size(path), 0U);
  }
  const Thrown thrown = ThrownBy([&] { files.MakeFileIn(folder / "nowhere"); });
  EXPECT_EQ(thrown.Number, 76);
  EXPECT_EQ(thrown.Text, "Path not found: " + folder / "nowhere");
}

TEST(LinuxFilesIsSame, SeesThroughLinksOfAllKinds) {
  const TemporaryFolder folder;
  LinuxFiles files;
  files.CreateFolder(folder / "data");
  WriteFile(folder / "data/file", "x");
  WriteFile(folder / "data/other", "x");
  std::filesystem::create_directory_symlink(folder / "data", folder / "link");
  std::filesystem::create_symlink(folder / "data/file", folder / "soft");
  std::filesystem::create_hard_link(folder / "data/file", folder / "hard");
  for (const char* path : {"data/file", "data/../data/file", "link/file", "soft", "hard"}) {
    EXPECT_TRUE(files.IsSame(folder / path, folder / "data/file")) << path;
  }
  EXPECT_TRUE(files.IsSame(folder / "link", folder / "data"));
  EXPECT_FALSE(files.IsSame(folder / "data/other", folder / "data/file"));
  EXPECT_FALSE(files.IsSame(folder / "data/new", folder / "data/new"));
}

TEST(LinuxFilesWrite, ReplacesTheContentsInPlace) {
  const TemporaryFolder folder;
  LinuxFiles files;
  files.Write(folder / "file", "a longer text");
  files.Write(folder / "file", "short");
  EXPECT_EQ(ReadFile(folder / "file"), "short");
  EXPECT_EQ(NumberThrownBy([&] { files.Write(folder / "nowhere/file", "x"); }), 76);
  EXPECT_EQ(NumberThrownBy([&] { files.Write("/dev/full", "x"); }), 61);
}

TEST(LinuxFilesAppend, AddsAtTheEndOfAFileAndMakesAMissingOne) {
  const TemporaryFolder folder;
  LinuxFiles files;
  files.Append(folder / "log", "one\n");
  files.Append(folder / "log", "");
  files.Append(folder / "log", std::string("t\0o\n", 4));
  EXPECT_EQ(files.Read(folder / "log"), std::string("one\nt\0o\n", 8));
  EXPECT_EQ(EntriesOf(folder.Path()), 1U);
}

TEST(LinuxFilesAppend, AddsToTheTargetOfALink) {
  const TemporaryFolder folder;
  WriteFile(folder / "target", "one ");
  std::filesystem::create_symlink("target", folder / "link");
  LinuxFiles().Append(folder / "link", "two");
  EXPECT_EQ(LinuxFiles().Read(folder / "target"), "one two");
}

TEST(LinuxFilesAppend, OfWhatIsNoFileOrNowhereFails) {
  const TemporaryFolder folder;
  ASSERT_EQ(mkfifo((folder / "pipe").c_str(), 0644), 0);
  LinuxFiles files;
  const Thrown thrown = ThrownBy([&] { files.Append(folder / "none/log", "one"); });
  EXPECT_EQ(thrown.Number, 76);
  EXPECT_THAT(thrown.Text, HasSubstr(folder / "none/log"));
  EXPECT_EQ(NumberThrownBy([&] { files.Append(folder.Path(), "one"); }), 75);
  EXPECT_EQ(NumberThrownBy([&] { files.Append(folder / "pipe", "one"); }), 75);
  EXPECT_EQ(NumberThrownBy([&] { files.Append("/dev/null", "one"); }), 75);
}

TEST(LinuxFilesAppend, ToAFileWithoutWritePermissionIs70AndLeavesIt) {
  const TemporaryFolder folder;
  std::filesystem::permissions(folder.Path(), std::filesystem::perms(0777));
  WriteFile(folder / "log", "one");
  std::filesystem::permissions(folder / "log", std::filesystem::perms(0444));
  const OrdinaryUser user;
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().Append(folder / "log", "two"); }), 70);
  EXPECT_EQ(ReadFile(folder / "log"), "one");
}

TEST(FreeSpace, IsThatOfTheDiskAPathLiesOn) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "one");
  const LinuxFiles files;
  EXPECT_GT(files.FreeSpace(folder.Path()), 0U);
  EXPECT_GT(files.FreeSpace(folder / "file"), 0U);
  EXPECT_EQ(files.FreeSpace("/proc"), 0U) << "a disk that holds no files has no room";
  EXPECT_EQ(NumberThrownBy([&] { (void)files.FreeSpace(folder / "none"); }), 76);
}

TEST(LinuxFilesDelete, ReportsAFileThatIsNotThere) {
  const TemporaryFolder folder;
  LinuxFiles files;
  EXPECT_EQ(NumberThrownBy([&] { files.Delete(folder / "file"); }), 53);
  EXPECT_EQ(NumberThrownBy([&] { files.Delete(folder.Path()); }), 75);
}

TEST(FileError, GivesEachSystemErrorItsNumberAndText) {
  const struct {
    int SystemError;
    int Number;
    std::string Text;
  } cases[] = {
      {ENOSPC, 61, "Disk full: /a/b"},
      {EDQUOT, 61, "Disk full: /a/b"},
      {EACCES, 70, "Permission denied: /a/b"},
      {EPERM, 70, "Permission denied: /a/b"},
      {EROFS, 70, "Permission denied: /a/b"},
      {ENOENT, 76, "Path not found: /a/b"},
      {ENOTDIR, 76, "Path not found: /a/b"},
      {EIO, 75, "Path/File access error: /a/b"},
      {EFBIG, 75, "Path/File access error: /a/b"},
  };
  for (const auto& expected : cases) {
    const RuntimeError error = FileError(expected.SystemError, "/a/b");
    EXPECT_EQ(error.Number(), expected.Number) << expected.SystemError;
    EXPECT_EQ(error.what(), expected.Text);
  }
}

TEST(FileLen, CountsTheBytesOfAFile) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", std::string(100001, 'x'));
  WriteFile(folder / "empty", "");
  EXPECT_EQ(LinuxFiles().FileLen(folder / "file"), 100001U);
  EXPECT_EQ(LinuxFiles().FileLen(folder / "empty"), 0U);
}

TEST(FileLen, FailsForWhatCannotBeRead) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "x");
  std::filesystem::permissions(folder / "file", std::filesystem::perms(0));
  const OrdinaryUser user;
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().FileLen(folder / "file"); }), 75);
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().FileLen(folder.Path()); }), 75);
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().FileLen(folder / "gone"); }), 53);
}

TEST(FileNames, AreThoseOfTheFilesInAFolderInOrder) {
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder / "folder");
  WriteFile(folder / "b", "");
  WriteFile(folder / "a", "");
  WriteFile(folder / "folder/c", "");
  EXPECT_EQ(LinuxFiles().FileNames(folder.Path()), (std::vector<std::string>{"a", "b"}));
  EXPECT_TRUE(LinuxFiles().FileNames(folder / "gone").empty());
  EXPECT_TRUE(LinuxFiles().FileNames(folder / "a").empty());
}

TEST(Rename, PutsAFileInPlaceOfAnother) {
  const TemporaryFolder folder;
  WriteFile(folder / "new", "new");
  WriteFile(folder / "old", "old");
  LinuxFiles().Rename(folder / "new", folder / "old");
  EXPECT_EQ(ReadFile(folder / "old"), "new");
  EXPECT_FALSE(LinuxFiles().FileExists(folder / "new"));
}

TEST(Rename, FailsForAMissingFileOrAnImpossibleTarget) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "x");
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().Rename(folder / "gone", folder / "other"); }), 53);
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().Rename(folder / "file", folder / "gone/other"); }), 76);
  const OrdinaryUser user;
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().Rename(folder / "file", folder / "other"); }), 70);
  EXPECT_EQ(ReadFile(folder / "file"), "x");
}

TEST(FolderNames, AreThoseOfTheFoldersInAFolderInOrder) {
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder / "b");
  std::filesystem::create_directory(folder / "a");
  std::filesystem::create_directory_symlink(folder.Path(), folder / "link");
  WriteFile(folder / "file", "");
  EXPECT_EQ(LinuxFiles().FolderNames(folder.Path()), (std::vector<std::string>{"a", "b"}));
  EXPECT_TRUE(LinuxFiles().FolderNames(folder / "a").empty());
}

TEST(FolderNames, AreNotKnownOfAFolderThatCannotBeRead) {
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder / "closed");
  std::filesystem::permissions(folder / "closed", std::filesystem::perms::none);
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().FolderNames(folder / "gone"); }), 76);
  const OrdinaryUser user;
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().FolderNames(folder / "closed"); }), 70);
}

TEST(TimeOfChange, IsLocal) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "");
  const timespec times[] = {{1'700'000'000, 0}, {1'700'000'000, 0}};
  ASSERT_EQ(utimensat(AT_FDCWD, (folder / "file").c_str(), times, 0), 0);
  const std::string before = getenv("TZ") != nullptr ? getenv("TZ") : "";
  setenv("TZ", "IST-5:30", 1);
  tzset();
  EXPECT_EQ(LinuxFiles().TimeOfChange(folder / "file"), "2023-11-15 03:43:20");
  before.empty() ? unsetenv("TZ") : setenv("TZ", before.c_str(), 1);
  tzset();
  EXPECT_EQ(NumberThrownBy([&] { LinuxFiles().TimeOfChange(folder / "gone"); }), 53);
}

}  // namespace
