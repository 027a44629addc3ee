#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <new>
#include <string>

#include "platform/RuntimeError.h"
#include "tests/support/SystemFaults.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Thrown.h"

/// One thing that an operator does, on files of its own. Making it prepares everything up to the moment when
/// the operator presses the button.
class FaultyOperation {
 public:
  FaultyOperation() = default;
  virtual ~FaultyOperation() = default;
  FaultyOperation(const FaultyOperation&) = delete;
  FaultyOperation& operator=(const FaultyOperation&) = delete;

  const std::string& Folder() const { return folder_.Path(); }
  std::string operator/(const std::string& name) const { return folder_ / name; }

  /// Does it, or does it again after a failure. Throws RuntimeError for what the operator is told.
  virtual void Act() = 0;

  /// What the disk holds.
  virtual std::string State() const = 0;

  /// True if `told` is what the operator should read about this fault in `call` ("Write members.mdb").
  /// Its number is never 0.
  virtual bool Fits(const FileFault& fault, const std::string& call, const Thrown& told) const = 0;

  /// Further conditions that hold whatever happened.
  virtual void Check() const {}

  /// True if the operator may be told of a failure although the new state is there: it is a whole file then,
  /// which trying again replaces by itself.
  virtual bool CanFailWhenDone() const { return false; }

  /// True if what cannot be written is given up without a word.
  virtual bool IsSilent() const { return false; }

 private:
  TemporaryFolder folder_;
};

inline std::string Shortened(const std::string& state) {
  constexpr std::size_t most = 1500;
  return state.size() > most ? state.substr(0, most) + "..." : state;
}

/// The states of an operation's files, and how often its faults met a call.
struct FaultRun {
  std::string Before;
  std::string After;
  int Failures = 0;
};

/// Has the call of number `first` fail, and looks at what the operator is told and what the disk holds, then,
/// and after another try on a sound disk. Returns false if the operation ended before that call.
template <typename Operation>
bool FailAtCall(const FileFault& fault, int first, SystemFaults::Lasting lasting, FaultRun& run) {
  Operation operation;
  Thrown told;
  std::string call;
  {
    const SystemFaults faults(operation.Folder(), fault, first, lasting);
    told = ThrownBy([&] { operation.Act(); });
    if (!faults.Failed()) {
      return false;
    }
    call = faults.FailedCall();
  }
  ++run.Failures;
  SCOPED_TRACE(fault.Name + (lasting == SystemFaults::Lasting::Once ? ", once: " : ", from then on: ") +
               call + " (call " + std::to_string(first) + "), told: " + std::to_string(told.Number) + " " +
               told.Text);
  const std::string state = operation.State();
  if (told.Number != 0) {
    EXPECT_TRUE(state == run.Before || (operation.CanFailWhenDone() && state == run.After))
        << "told as failed, but it holds:\n"
        << Shortened(state);
    EXPECT_TRUE(operation.Fits(fault, call, told));
  } else {
    EXPECT_TRUE(state == run.After || (operation.IsSilent() && state == run.Before))
        << "told as done, but it holds:\n"
        << Shortened(state);
  }
  operation.Check();
  if (state != run.After) {
    const SystemFaults none(operation.Folder(), fault);  // only for its speed
    EXPECT_NO_THROW(operation.Act()) << "the next try";
    EXPECT_EQ(operation.State(), run.After) << "after the next try";
    operation.Check();
  }
  return !testing::Test::HasFailure();
}

/// Lets each fault meet each call of the operation, once and from then on: the files then hold what they held
/// before or what they should, the operator is told the truth, and the next try works.
template <typename Operation>
FaultRun FailAtEveryCall() {
  FaultRun run;
  {
    Operation operation;
    run.Before = operation.State();
    operation.Act();
    run.After = operation.State();
  }
  for (const FileFault& fault : AllFileFaults()) {
    for (const auto lasting : {SystemFaults::Lasting::Once, SystemFaults::Lasting::FromThenOn}) {
      for (int first = 1; FailAtCall<Operation>(fault, first, lasting, run); ++first) {
      }
    }
  }
  return run;
}

/// The numbers and texts of the database layer for a fault on the file at `path`.
inline bool DatabaseFaultFits(const FileFault& fault, const std::string& call, const Thrown& told,
                              const std::string& path) {
  const Thrown locked{Fault::DatabaseLocked, "Could not lock file '" + path + "'."};
  const Thrown full{Fault::DatabaseDiskFull, "Not enough space on disk: " + path};
  const Thrown disk{Fault::DatabaseDiskError, "Disk error: " + path};
  const Thrown closed{Fault::DatabaseCannotOpen,
                      "Cannot open the file '" + path + "'. You may lack the permission for it."};
  const Thrown readOnly{Fault::DatabaseReadOnly, "Cannot update. Database or object is read-only: " + path};
  const auto is = [&told](const Thrown& one) { return told.Number == one.Number && told.Text == one.Text; };
  switch (fault.Error) {
    case EAGAIN:
      return is(locked);
    case ENOSPC:
    case EDQUOT:
      return is(full) || is(closed);  // the database library does not tell why it could not make a journal
    case EACCES:
      return is(closed) || is(readOnly) || is(disk);
    case EIO:
      // The database library looks whether its file is still in its place before it writes, and takes a
      // failure for "no".
      return is(disk) || is(closed) || (call.starts_with("Status") && is(readOnly));
    default:
      return false;  // harmless: not to be told at all
  }
}
