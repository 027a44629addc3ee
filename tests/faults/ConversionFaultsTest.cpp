#include <gtest/gtest.h>

#include <cerrno>
#include <chrono>
#include <filesystem>
#include <string>

#include "platform/jet/JetConverter.h"
#include "platform/linux/LinuxFiles.h"
#include "tests/faults/FaultLoop.h"
#include "tests/support/ConversionAnswers.h"
#include "tests/support/DatabaseContents.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/ReaderWords.h"
#include "tests/support/TestDatabase.h"

namespace {

/// What does not change while files fail: the reader and what it writes.
class Sound {
 public:
  Sound() {
    WriteFile(folder_ / "written", MembersAsRead({{7, "Ada"}, {8, "Sean"}}));
    WriteFile(Reader(), "#!/bin/sh\nexec cat '" + (folder_ / "written") + "'\n");
    std::filesystem::permissions(Reader(), std::filesystem::perms(0755));
  }

  std::string Reader() const { return folder_ / "reader"; }

  static const Sound& Files() {
    static const Sound files;
    return files;
  }

 private:
  TemporaryFolder folder_;
};

/// An old file becomes a new one.
class OldFileConverted : public FaultyOperation {
 public:
  OldFileConverted() {
    WriteFile(*this / "members.mdb", OldBytes());
    WriteFile(*this / "members_default.mdb", MadeDatabase("members"));
    converter_.SetLockWait(std::chrono::milliseconds(0));  // nobody gives a lock back here
  }

  void Act() override {
    converter_.Convert(
        {*this / "members.mdb", "Members", *this / "members_default.mdb", *this / "members-new.mdb"},
        answers_);
  }

  std::string State() const override {
    const std::string bytes = ReadFile(*this / "members.mdb");
    return bytes == OldBytes() ? "old" : WholeContents(*this / "members.mdb");
  }

  bool Fits(const FileFault& fault, const std::string& /*call*/, const Thrown& told) const override {
    const auto has = [&told](const char* words) { return told.Text.find(words) != std::string::npos; };
    const bool general = has("Path/File access error") || has("Cannot open the file") ||
                         has("Could not find file") || has("could not be added");
    const bool byErrno = fault.Error == ENOSPC || fault.Error == EDQUOT
                             ? has("Disk full") || has("Not enough space")
                         : fault.Error == EACCES ? has("Permission denied") || has("read-only")
                         : fault.Error == EAGAIN ? has("Could not lock")
                                                 : has("Disk error") || has("read-only");
    return told.Number == Fault::UnrecognizedDatabase && (general || byErrno || has("Disk error"));
  }

  /// When the folder can no longer be asked which of the two stands there.
  bool CanFailWhenDone() const override { return true; }

  /// The old file is there as long as it has not become the new one, and beside it from then on.
  void Check() const override {
    if (ReadFile(*this / "members.mdb") != OldBytes()) {
      EXPECT_TRUE(ReadFile(*this / "members.mdb.jet") == OldBytes() ||
                  ReadFile(*this / "members.mdb.jet2") == OldBytes());
    }
  }

 private:
  static std::string OldBytes() {
    return std::string("\0\1\0\0", 4) + "Standard Jet DB" + std::string(4096 - 19, '\0');
  }

  LinuxFiles disk_;
  ConversionAnswers answers_;
  JetConverter converter_{disk_, Sound::Files().Reader()};
};

/// And takes the rows of the interim file.
class OldFileJoined : public OldFileConverted {
 public:
  OldFileJoined() {
    WriteFile(*this / "members-new.mdb",
              MadeDatabase("members", "INSERT INTO Members (ContactID, FirstName) VALUES (8, 'Zoe')"));
  }

  void Check() const override {
    OldFileConverted::Check();
    for (const char* name : {"members-new.mdb", "members-new.mdb.joined"}) {
      if (std::filesystem::exists(*this / name)) {
        EXPECT_EQ(OtherConnection(*this / name).Query("SELECT FirstName FROM Members"), "Zoe");
      }
    }
  }
};

TEST(ConversionFaults, OldFileIsOneOfTheTwo) {
  EXPECT_GE(FailAtEveryCall<OldFileConverted>().Failures, 100);
}

TEST(ConversionFaults, InterimRowsAreInOneOfTheTwo) {
  EXPECT_GE(FailAtEveryCall<OldFileJoined>().Failures, 100);
}

}  // namespace
