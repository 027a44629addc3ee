#include <gtest/gtest.h>

#include <filesystem>

#include "tests/archive/copies/CopySite.h"
#include "tests/faults/FaultLoop.h"
#include "tests/support/DatabaseContents.h"

namespace {

/// The operator restores a copy.
class CopyRestored : public FaultyOperation {
 public:
  CopyRestored() {
    std::filesystem::create_directories(*this / "backups");
    WriteFile(*this / "members.mdb", CopySite::WithMembers("'Ann', 'Bob'"));
    WriteFile(*this / "backups/members-2013-05-01-200000.mdb", CopySite::WithMembers("'Old'"));
    inUse_ = engine_.OpenDatabase(*this / "members.mdb");
  }

  void Act() override {
    if (tried_) {
      inUse_ = engine_.OpenDatabase(*this / "members.mdb");
    }
    tried_ = true;
    const Restored restored = work_.Restore(*BackupCopyOf("members-2013-05-01-200000.mdb"), members_,
                                            [](CopyStep) { return true; });
    if (restored.What != Restored::Done) {
      isUncertain_ = restored.What == Restored::Uncertain;
      throw RuntimeError(Fault::InternalError, restored.Reason);
    }
  }

  std::string State() const override { return WholeContents(*this / "members.mdb"); }

  /// Nothing but an uncertain end may leave the copy in its place.
  bool CanFailWhenDone() const override { return isUncertain_; }

  bool Fits(const FileFault& fault, const std::string& /*call*/, const Thrown& told) const override {
    const auto has = [&told](const char* words) { return told.Text.find(words) != std::string::npos; };
    const bool general = has("Path/File access error") || has("Cannot open the file") || has("Disk error");
    switch (fault.Error) {
      case ENOSPC:
      case EDQUOT:
        return general || has("Disk full") || has("Not enough space");
      case EACCES:
        return general || has("Permission denied") || has("read-only");
      case EAGAIN:
        return has("Could not lock file") || has("Disk error");
      case EIO:
        // A page that cannot be read makes a copy as unusable as one that is damaged.
        return general || has("read-only") || has("Unrecognized database format");
      default:
        return false;  // harmless: not to be told at all
    }
  }

  /// Nothing is left beside the file that could be taken for its journal, and no copy is half there.
  void Check() const override {
    for (const char* left : {"-journal", "-wal", "-shm"}) {
      EXPECT_FALSE(std::filesystem::exists(*this / "members.mdb" + left)) << left;
    }
    for (const BackupCopy& copy : CopiesIn(disk_, *this / "backups")) {
      EXPECT_EQ(WholeContents(work_.PathOf(copy)).substr(0, 3), "ok|") << copy.File;
    }
  }

 private:
  struct Program {
    Program() { WriteFile(Default(), MadeDatabase("members")); }
    std::string Default() const { return Folder / "members_default.mdb"; }
    TemporaryFolder Folder;
  };
  /// What comes with the program does not fail.
  static const Program& Installed() {
    static const Program program;
    return program;
  }

  LinuxFiles disk_;
  FakeClock time_;
  StringTable strings_{Language::English};
  SqliteEngine engine_{std::chrono::milliseconds(0)};
  std::unique_ptr<Database> inUse_;
  CopiedDatabase members_{.Name = "members",
                          .Table = "Members",
                          .DefaultPath = Installed().Default(),
                          .Title = OwnText::CopiedMembers,
                          .InUse = [this]() -> Database& { return *inUse_; }};
  CopyWork work_{
      {.Engine = engine_, .Disk = disk_, .Time = time_, .Strings = strings_, .Folder = *this / "backups"}};
  bool tried_ = false;
  bool isUncertain_ = false;
};

TEST(RestoreFaults, LeaveTheOldFileOrTheNewOneAndTell) {
  EXPECT_GE(FailAtEveryCall<CopyRestored>().Failures, 200);
}

}  // namespace
