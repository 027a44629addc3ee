#pragma once

#include <chrono>
#include <cstddef>
#include <string>
#include <vector>

#include "platform/linux/Descriptor.h"
#include "platform/linux/InstanceLine.h"

/// Where the programs on one data folder meet.
struct InstancePlace {
  /// Absolute paths. The lock is held in each of them where that is possible, so that programs meet which
  /// have only one of them in common. The socket lies in the first where one can be made.
  std::vector<std::string> Folders;
  std::string Name;  ///< of the files there, without their endings; another one for each data folder
};

/// The folders for the meeting place: `runtimeFolder` where it is an absolute path of a folder that belongs
/// to this user alone, and always `dataFolder`, which is created if it is missing.
std::vector<std::string> InstanceFolders(const std::string& runtimeFolder, const std::string& dataFolder);

enum class InstanceOutcome {
  First,     ///< no other program of this place runs, and none will start while this object lives
  Told,      ///< another one runs and has taken the request
  NoAnswer,  ///< another one runs, but has not taken it
  Barred     ///< the lock is another user's, so that one's program may run: see Instance::BarredBy
};

/// This start of the program among those of one place: either the one that runs, or one that tells that one
/// what it was started for. What a crashed program leaves does not matter: the system drops its lock.
class Instance {
 public:
  explicit Instance(InstancePlace place);
  /// The next start can be the first again.
  ~Instance();
  Instance(const Instance&) = delete;
  Instance& operator=(const Instance&) = delete;

  /// Becomes the first, or has the first one take `request`. Asks no longer than `patience`. Where the system
  /// allows no lock at all, a start is the first unless another one answers.
  InstanceOutcome Start(const InstanceRequest& request, std::chrono::milliseconds patience);

  /// The first one's socket, at which calls arrive: see InstanceCall. Negative if there is none.
  int Listener() const { return listener_.Number(); }

  /// Path of a lock that belongs to another user and that this one may not open; empty if there is none.
  const std::string& BarredBy() const { return barredBy_; }

  static std::string LockPath(const InstancePlace& place, std::size_t folder) {
    return place.Folders[folder] + "/" + place.Name + ".lock";
  }
  static std::string SocketPath(const InstancePlace& place, std::size_t folder) {
    return place.Folders[folder] + "/" + place.Name + ".socket";
  }

 private:
  enum class Lock { Taken, Busy, Impossible, Barred };
  struct HeldLock {
    std::string Path;
    Descriptor File;
  };

  /// Takes all locks that can be taken, or none.
  Lock TakeLocks();
  Lock TakeLock(const std::string& path);
  void DropLocks();
  void Listen();
  bool ListenAt(const std::string& path);

  const InstancePlace place_;
  std::vector<HeldLock> locks_;
  std::string barredBy_;
  std::string socketPath_;  ///< of the listener
  Descriptor listener_;
};
