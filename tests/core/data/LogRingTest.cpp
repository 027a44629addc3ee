#include "core/data/LogRing.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeFiles.h"

namespace {

using testing::IsEmpty;

constexpr const char* Newer = "/data/logs/line.log";
constexpr const char* Older = "/data/logs/line.1.log";

class Ring : public testing::Test {
 protected:
  Ring() { files.AddFolder("/data"); }

  std::string TextOf(const char* path) const { return files.FileExists(path) ? files.Read(path) : ""; }

  FakeFiles files;
  LogRing ring{files, "/data/logs", "line", 10};
};

TEST_F(Ring, MakesItsFolderWhenThereIsSomethingToWrite) {
  ring.Append("");
  EXPECT_FALSE(files.FolderExists("/data/logs"));
  ring.Append("one\n");
  EXPECT_EQ(TextOf(Newer), "one\n");
}

TEST_F(Ring, AddsToWhatAnEarlierRunWrote) {
  files.Put(Newer, "old\n");
  ring.Append("one\n");
  EXPECT_EQ(TextOf(Newer), "old\none\n");
}

TEST_F(Ring, BeginsAnotherFileWhenTheFirstIsFull) {
  ring.Append("one\n");
  ring.Append("two\n");
  ring.Append("three\n");
  EXPECT_EQ(TextOf(Older), "one\ntwo\n");
  EXPECT_EQ(TextOf(Newer), "three\n");
}

TEST_F(Ring, FillsAFileToTheLastByte) {
  ring.Append("123456789\n");
  EXPECT_EQ(TextOf(Newer), "123456789\n");
  EXPECT_FALSE(files.FileExists(Older));
}

TEST_F(Ring, CountsWhatAnEarlierRunWrote) {
  files.Put(Newer, "12345678\n");
  ring.Append("one\n");
  EXPECT_EQ(TextOf(Older), "12345678\n");
  EXPECT_EQ(TextOf(Newer), "one\n");
}

TEST_F(Ring, KeepsTheLatestRowsOfMany) {
  for (int row = 0; row < 1000; ++row) {
    ring.Append(std::to_string(1000 + row) + "\n");
  }
  EXPECT_EQ(TextOf(Older) + TextOf(Newer), "1996\n1997\n1998\n1999\n");
}

TEST_F(Ring, WritesRowsThatAreTooLongForAFileWhole) {
  ring.Append("one\n");
  ring.Append("a row of its own\n");
  EXPECT_EQ(TextOf(Older), "one\n");
  EXPECT_EQ(TextOf(Newer), "a row of its own\n");
}

TEST_F(Ring, LeavesThirtyTwoMegabytesOfTheDisk) {
  files.FreeBytes = LogRing::FreeBytesKept + 3;
  ring.Append("one\n");
  EXPECT_FALSE(files.FileExists(Newer));
  files.FreeBytes = LogRing::FreeBytesKept + 4;
  ring.Append("two\n");
  EXPECT_EQ(TextOf(Newer), "two\n");
}

TEST_F(Ring, DropsRowsThatCannotBeWritten) {
  LogRing nowhere(files, "/none/logs", "line", 10);
  EXPECT_NO_THROW(nowhere.Append("one\n"));
  EXPECT_THAT(files.Contents(), IsEmpty());

  files.FailReplace(Newer, RuntimeError(61));
  EXPECT_NO_THROW(ring.Append("one\n"));
  EXPECT_EQ(TextOf(Newer), "");
}

TEST_F(Ring, DropsRowsWhenTheOldFileCannotBePutAway) {
  files.FailReplace(Older, RuntimeError(70));
  ring.Append("12345678\n");
  EXPECT_NO_THROW(ring.Append("one\n"));
  EXPECT_EQ(TextOf(Newer), "12345678\n");
}

TEST_F(Ring, GoesOnWhenSomeoneTookTheFileAway) {
  ring.Append("12345678\n");
  files.Remove(Newer);
  ring.Append("one\n");  // finds no file to rename
  ring.Append("two\n");
  EXPECT_EQ(TextOf(Newer), "two\n");
}

}  // namespace
