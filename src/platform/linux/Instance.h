#pragma once

#include <chrono>
#include <string>

#include "platform/linux/Descriptor.h"
#include "platform/linux/InstanceLine.h"

/// Where the programs on one data folder meet.
struct InstancePlace {
  std::string Folder;  ///< absolute, and this user's
  std::string Name;    ///< of the files there, without their endings; another one for each data folder
};

/// The folder for the meeting place: `runtimeFolder` where it is an absolute path of a folder that belongs to
/// this user alone, else `dataFolder`, which is created if it is missing.
std::string InstanceFolder(const std::string& runtimeFolder, const std::string& dataFolder);

enum class InstanceOutcome {
  First,    ///< no other program of this place runs, and none will start while this object lives
  Told,     ///< another one runs and has taken the request
  NoAnswer  ///< another one runs, but has not taken it
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
  /// allows no lock at all, each start is the first.
  InstanceOutcome Start(const InstanceRequest& request, std::chrono::milliseconds patience);

  /// The first one's socket, at which calls arrive: see InstanceCall. Negative if there is none.
  int Listener() const { return listener_.Number(); }

  std::string LockPath() const { return place_.Folder + "/" + place_.Name + ".lock"; }
  std::string SocketPath() const { return place_.Folder + "/" + place_.Name + ".socket"; }

 private:
  enum class Lock { Taken, Busy, Impossible };
  Lock TakeLock();
  void Listen();

  const InstancePlace place_;
  Descriptor lock_;
  Descriptor listener_;
};
