#pragma once

#include <gtest/gtest.h>

#include <QApplication>
#include <functional>
#include <string>
#include <vector>

#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/SystemFaults.h"

/// What an operator saves in a window, each time something else.
struct SavedInWindow {
  std::string Folder;  ///< the calls on its files fail
  FakeMessageBoxes& Boxes;

  /// Does all by keys and buttons, from the state in which the last try has left the window.
  std::function<void()> Save;
  /// What another program reads.
  std::function<std::string()> Stored;
  /// What it reads once Save has succeeded.
  std::function<std::string()> Wanted;
  /// True for a box by which the operator learns that it was not saved.
  std::function<bool(const FakeMessageBoxes::Box&)> Tells;
  /// True if something told as failed may be there.
  bool CanFailWhenDone = false;
  /// True if what cannot be written is given up without a word.
  bool IsSilent = false;
};

/// The kinds of faults that windows meet. Which error it is matters to the operations beneath, and is tried
/// there.
inline std::vector<FileFault> FaultsForWindows() {
  std::vector<FileFault> faults;
  for (const FileFault& fault : AllFileFaults()) {
    if (fault.Name == "EIO" || fault.Name == "ENOSPC" || fault.Name == "locked by another program") {
      faults.push_back(fault);
    }
  }
  return faults;
}

/// No command is left over: another can be given at once.
inline void ExpectIdle() {
  EXPECT_EQ(QApplication::overrideCursor(), nullptr);
  EXPECT_EQ(QApplication::activePopupWidget(), nullptr);
}

/// Has a call of the saving fail, and looks at what the operator is told and what is stored, then, and after
/// another try on a sound disk. `prepare` begins each try with something else to save. Returns false if the
/// saving ended before that call.
inline bool FailInWindow(const SavedInWindow& saved, const std::function<void()>& prepare,
                         const FileFault& fault, int first, SystemFaults::Lasting lasting) {
  prepare();
  saved.Boxes.Boxes.clear();
  const std::string before = saved.Stored();
  std::string call;
  {
    const SystemFaults faults(saved.Folder, fault, first, lasting);
    saved.Save();
    call = faults.FailedCall();
  }
  std::string told;
  bool isTold = false;
  for (const FakeMessageBoxes::Box& box : saved.Boxes.Boxes) {
    told += box.Text + "; ";
    isTold = isTold || saved.Tells(box);
  }
  SCOPED_TRACE(fault.Name + ": " + call + " (call " + std::to_string(first) + "), told: " + told);
  const std::string state = saved.Stored();
  const bool isSaved = state == saved.Wanted();
  EXPECT_TRUE(isSaved || state == before) << state;
  EXPECT_TRUE(isTold ? !isSaved || saved.CanFailWhenDone : isSaved || saved.IsSilent);
  ExpectIdle();
  if (!isSaved || isTold) {
    saved.Boxes.Boxes.clear();
    saved.Save();
    for (const FakeMessageBoxes::Box& box : saved.Boxes.Boxes) {
      EXPECT_FALSE(saved.Tells(box)) << "the next try: " << box.Text;
    }
    EXPECT_EQ(saved.Stored(), saved.Wanted()) << "after the next try";
    ExpectIdle();
  }
  return !call.empty() && !testing::Test::HasFailure();
}

/// Lets each fault meet each call of the saving, once and from then on. Returns how many there were.
inline int FailAtEveryCallInWindow(const SavedInWindow& saved, const std::function<void()>& prepare) {
  int failures = 0;
  for (const FileFault& fault : FaultsForWindows()) {
    for (const auto lasting : {SystemFaults::Lasting::Once, SystemFaults::Lasting::FromThenOn}) {
      for (int first = 1; FailInWindow(saved, prepare, fault, first, lasting); ++first) {
        ++failures;
      }
    }
  }
  return failures;
}
