#pragma once

#include <cstdint>
#include <string>
#include <vector>

/// Kinds of system calls on files. Flush is of a file, FlushFolder of a folder; Create is an open that makes
/// the file; Status tells whether a file exists, and its size.
enum class FileCall : std::uint32_t {
  Open = 1U << 0U,
  Create = 1U << 1U,
  Status = 1U << 2U,
  Read = 1U << 3U,
  Write = 1U << 4U,
  Flush = 1U << 5U,
  FlushFolder = 1U << 6U,
  Truncate = 1U << 7U,
  Rename = 1U << 8U,
  Link = 1U << 9U,
  Delete = 1U << 10U,
  MakeFolder = 1U << 11U,
  Lock = 1U << 12U,
};

/// A way in which system calls fail.
struct FileFault {
  enum class Effect {
    Nothing,  ///< the call fails and has no effect
    Half,     ///< a read or write of half the bytes, without an error
    Whole,    ///< the call takes effect and then fails
  };

  std::string Name;
  std::uint32_t Calls;  ///< the kinds that can fail so, joined by |
  int Error;            ///< errno
  Effect What = Effect::Nothing;
};

constexpr std::uint32_t Only(FileCall call) {
  return static_cast<std::uint32_t>(call);
}
constexpr std::uint32_t operator|(FileCall left, FileCall right) {
  return static_cast<std::uint32_t>(left) | static_cast<std::uint32_t>(right);
}
constexpr std::uint32_t operator|(std::uint32_t left, FileCall right) {
  return left | static_cast<std::uint32_t>(right);
}

/// While it lives, the system calls of this process on files in a folder, and below it, are counted, and one
/// of them fails, or all from that one on. Nothing there is really flushed, for speed.
///
/// It stands between the program and the system: a program that links this library has its own `open`,
/// `write`, `fsync` and so on, which the database library and the C++ library call too. What C library
/// functions call within themselves (fopen, mkstemp) is not seen. One at a time, in one thread.
class SystemFaults {
 public:
  enum class Lasting { Once, FromThenOn };

  /// Only counts the calls that `fault` can meet.
  SystemFaults(std::string folder, const FileFault& fault);
  /// The call of number `first`, counted from 1 among those that `fault` can meet, fails.
  SystemFaults(std::string folder, const FileFault& fault, int first, Lasting lasting);
  ~SystemFaults();
  SystemFaults(const SystemFaults&) = delete;
  SystemFaults& operator=(const SystemFaults&) = delete;

  /// How many calls the fault could have met so far.
  int Calls() const { return calls_; }
  /// True once a call has failed.
  bool Failed() const { return first_ > 0 && calls_ >= first_; }
  /// The first call that failed: "Write members.mdb"; empty for none.
  const std::string& FailedCall() const { return failedCall_; }

  /// Used by the calls themselves.
  static SystemFaults* OnPath(const char* path);
  static SystemFaults* OnFile(int descriptor);
  bool Fails(FileCall call, const std::string& path);
  const FileFault& Fault() const { return fault_; }

 private:
  std::string folder_;
  FileFault fault_;
  int first_ = 0;
  Lasting lasting_ = Lasting::Once;
  int calls_ = 0;
  std::string failedCall_;
};

/// All faults that a disk, a full one, and another program can bring about.
const std::vector<FileFault>& AllFileFaults();
