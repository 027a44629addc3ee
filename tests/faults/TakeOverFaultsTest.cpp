#include <gtest/gtest.h>

#include "tests/faults/FaultLoop.h"
#include "tests/takeover/TakeOverSite.h"

namespace {

/// The operator has looked at an old installation and takes it over.
class OldInstallationTaken : public FaultyOperation {
 public:
  OldInstallationTaken() {
    site_.PutInstallation("old", "Zachary");
    site_.Look(work_, "old");
  }

  void Act() override {
    if (tried_) {
      site_.Open();
      site_.Look(work_, "old");
    }
    tried_ = true;
    // One file that is open and one that is not: each further one would meet the same calls again.
    const TakenOver taken = work_.Take({OldItem::Members, OldItem::Settings}, [](TakeStep) { return true; });
    if (taken.What != TakenOver::Done) {
      isPending_ = taken.What == TakenOver::Pending;
      throw RuntimeError(Fault::InternalError, taken.Reason);
    }
  }

  /// As the next start finds it.
  std::string State() const override {
    FinishTakeOver(site_.Disk, site_.Data());
    return site_.Labels();
  }

  /// Only what is still to be finished may be there although a failure was told.
  bool CanFailWhenDone() const override { return isPending_; }

  bool Fits(const FileFault& fault, const std::string& /*call*/, const Thrown& told) const override {
    const auto has = [&told](const char* words) { return told.Text.find(words) != std::string::npos; };
    const bool general = has("Path/File access error") || has("Cannot open the file") || has("Disk error");
    switch (fault.Error) {
      case ENOSPC:
      case EDQUOT:
        return general || has("Disk full") || has("Not enough space");
      case EACCES:
        return general || has("Permission denied") || has("read-only") || has("File not found");
      case EAGAIN:
        return has("Could not lock file") || has("Disk error");
      case EIO:
        return general || has("read-only") || has("Unrecognized database format") || has("File not found");
      default:
        return false;  // harmless: not to be told at all
    }
  }

  void Check() const override {
    for (const char* file : {"/members.mdb", "/scenarios.mdb"}) {
      for (const char* left : {"-journal", "-wal", "-shm"}) {
        EXPECT_FALSE(std::filesystem::exists(site_.Data() + file + left)) << file << left;
      }
    }
  }

 private:
  TakeOverSite site_{Folder()};
  TakeOverWork work_{site_.Parts()};
  bool tried_ = false;
  bool isPending_ = false;
};

TEST(TakeOverFaults, LeaveAllFilesOldOrAllNewAndTell) {
  EXPECT_GE(FailAtEveryCall<OldInstallationTaken>().Failures, 200);
}

}  // namespace
