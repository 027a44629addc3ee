#include "platform/linux/Instance.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/file.h>
#include <sys/stat.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <filesystem>
#include <utility>

#include "platform/linux/InstanceSocket.h"

namespace {

constexpr mode_t OwnerOnly = 0600;

class Deadline {
 public:
  explicit Deadline(std::chrono::milliseconds patience) : end_(std::chrono::steady_clock::now() + patience) {}

  /// At least 0.
  int MillisecondsLeft() const {
    const auto left =
        std::chrono::ceil<std::chrono::milliseconds>(end_ - std::chrono::steady_clock::now()).count();
    return left > 0 ? static_cast<int>(left) : 0;
  }

 private:
  std::chrono::steady_clock::time_point end_;
};

/// Waits until `socket` is ready for `events`. False when the time is over.
bool IsReady(int socket, short events, const Deadline& deadline) {
  pollfd watched{socket, events, 0};
  int ready = -1;
  do {
    ready = poll(&watched, 1, deadline.MillisecondsLeft());
  } while (ready < 0 && errno == EINTR && deadline.MillisecondsLeft() > 0);
  return ready > 0;
}

bool SendLine(int socket, std::string_view line, const Deadline& deadline) {
  while (!line.empty()) {
    const ssize_t sent = send(socket, line.data(), line.size(), MSG_NOSIGNAL);
    if (sent >= 0) {
      line.remove_prefix(static_cast<std::size_t>(sent));
    } else if (errno != EINTR && (errno != EAGAIN || !IsReady(socket, POLLOUT, deadline))) {
      return false;
    }
  }
  return true;
}

bool IsTaken(int socket, const Deadline& deadline) {
  const std::string_view due = InstanceAnswer;
  std::string answer;
  while (answer.size() < due.size() && IsReady(socket, POLLIN, deadline)) {
    std::array<char, 16> buffer;
    const ssize_t got = recv(socket, buffer.data(), buffer.size(), 0);
    if (got == 0 || (got < 0 && errno != EAGAIN && errno != EINTR)) {
      return false;
    }
    answer.append(buffer.data(), got < 0 ? 0 : static_cast<std::size_t>(got));
  }
  return answer == due;
}

/// Has the program that listens at `path` take the line. False if there is none, or it did not.
bool TellRunning(const std::string& path, const std::string& line, const Deadline& deadline) {
  const InstanceAddress address(path);
  const Descriptor socketEnd(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
  return address.Valid() && socketEnd.Number() >= 0 &&
         connect(socketEnd.Number(), address.Get(), InstanceAddress::Size) == 0 &&
         IsOfThisUser(socketEnd.Number()) && SendLine(socketEnd.Number(), line, deadline) &&
         IsTaken(socketEnd.Number(), deadline);
}

/// True if the file that is open is the one at `path`.
bool IsAtPath(int file, const std::string& path) {
  struct stat opened {};
  struct stat there {};
  return fstat(file, &opened) == 0 && stat(path.c_str(), &there) == 0 && opened.st_ino == there.st_ino &&
         opened.st_dev == there.st_dev;
}

bool IsOwnFolder(const std::string& path) {
  struct stat info {};
  return !path.empty() && path.front() == '/' && stat(path.c_str(), &info) == 0 && S_ISDIR(info.st_mode) &&
         info.st_uid == geteuid() && (info.st_mode & (S_IWGRP | S_IWOTH)) == 0 &&
         access(path.c_str(), W_OK | X_OK) == 0;
}

/// Opens the lock's file, which is made if it is missing. A negative number, with errno, if that fails.
Descriptor OpenLock(const std::string& path) {
  constexpr int flags = O_NOFOLLOW | O_CLOEXEC | O_NONBLOCK;
  Descriptor file(open(path.c_str(), O_RDWR | O_CREAT | flags, OwnerOnly));
  if (file.Number() < 0 && (errno == EACCES || errno == EROFS)) {
    const int error = errno;
    file = Descriptor(open(path.c_str(), O_RDONLY | flags));
    errno = error;
  }
  return file;
}

/// The administrator's program on the folder of a user holds a lock that this user can take afterwards.
/// False if it stays the administrator's.
bool GiveToOwnerOfFolder(int file, const std::string& path) {
  struct stat own {};
  struct stat folder {};
  return geteuid() == 0 && fstat(file, &own) == 0 && own.st_nlink == 1 &&
         stat(std::filesystem::path(path).parent_path().c_str(), &folder) == 0 &&
         (own.st_uid == folder.st_uid || fchown(file, folder.st_uid, folder.st_gid) == 0);
}

/// True if there is a file of another user that this one may not open.
bool IsForeign(const std::string& path) {
  struct stat info {};
  return lstat(path.c_str(), &info) == 0 && S_ISREG(info.st_mode) && info.st_uid != geteuid();
}

}  // namespace

std::vector<std::string> InstanceFolders(const std::string& runtimeFolder, const std::string& dataFolder) {
  std::error_code none;  // where it cannot be made, the program says so when it needs it
  std::filesystem::create_directories(dataFolder, none);
  std::vector<std::string> folders;
  if (IsOwnFolder(runtimeFolder)) {
    folders.push_back(runtimeFolder);
  }
  folders.push_back(dataFolder);
  return folders;
}

Instance::Instance(InstancePlace place) : place_(std::move(place)) {}

// The locks go last, so that nothing of the next start is taken away.
Instance::~Instance() {
  if (listener_.Number() >= 0) {
    unlink(socketPath_.c_str());
  }
  DropLocks();
}

InstanceOutcome Instance::Start(const InstanceRequest& request, std::chrono::milliseconds patience) {
  constexpr int betweenTries = 20;  // milliseconds
  const Deadline deadline(patience);
  const std::optional<std::string> line = InstanceLine(request);
  const auto tellRunning = [&] {
    for (std::size_t folder = 0; line && folder < place_.Folders.size(); ++folder) {
      if (TellRunning(SocketPath(place_, folder), *line, deadline)) {
        return true;
      }
    }
    return false;
  };
  while (true) {
    const Lock lock = TakeLocks();
    if (lock == Lock::Barred) {
      return InstanceOutcome::Barred;
    }
    // The other one may be about to listen, or about to end.
    if (lock != Lock::Taken && tellRunning()) {
      return InstanceOutcome::Told;
    }
    if (lock != Lock::Busy) {
      Listen();
      return InstanceOutcome::First;
    }
    if (deadline.MillisecondsLeft() == 0) {
      return InstanceOutcome::NoAnswer;
    }
    poll(nullptr, 0, std::min(betweenTries, deadline.MillisecondsLeft()));
  }
}

Instance::Lock Instance::TakeLocks() {
  // All take the data folder's lock first: it is the one that each of them has in common.
  for (std::size_t folder = place_.Folders.size(); folder > 0; --folder) {
    const Lock lock = TakeLock(LockPath(place_, folder - 1));
    if (lock == Lock::Busy || lock == Lock::Barred) {
      DropLocks();
      return lock;
    }
  }
  return locks_.empty() ? Lock::Impossible : Lock::Taken;
}

Instance::Lock Instance::TakeLock(const std::string& path) {
  while (true) {
    Descriptor file = OpenLock(path);
    if (file.Number() < 0 && errno == EACCES && IsForeign(path)) {
      barredBy_ = path;
      return Lock::Barred;
    }
    struct stat opened {};
    if (file.Number() < 0 || fstat(file.Number(), &opened) != 0 || !S_ISREG(opened.st_mode)) {
      return Lock::Impossible;
    }
    if (flock(file.Number(), LOCK_EX | LOCK_NB) != 0) {
      return errno == EWOULDBLOCK ? Lock::Busy : Lock::Impossible;
    }
    // The one before may just have taken the file away: a lock on it would be found by no other start.
    if (IsAtPath(file.Number(), path)) {
      GiveToOwnerOfFolder(file.Number(), path);
      locks_.push_back({path, std::move(file)});
      return Lock::Taken;
    }
  }
}

void Instance::DropLocks() {
  for (; !locks_.empty(); locks_.pop_back()) {
    const HeldLock& lock = locks_.back();
    if (IsAtPath(lock.File.Number(), lock.Path)) {
      unlink(lock.Path.c_str());
    }
  }
}

void Instance::Listen() {
  for (std::size_t folder = 0; folder < place_.Folders.size() && listener_.Number() < 0; ++folder) {
    if (ListenAt(SocketPath(place_, folder))) {
      socketPath_ = SocketPath(place_, folder);
    }
  }
}

bool Instance::ListenAt(const std::string& path) {
  constexpr int waitingCalls = 64;
  const InstanceAddress address(path);
  Descriptor socketEnd(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
  unlink(path.c_str());  // of a program that crashed
  const bool isListening =
      address.Valid() && socketEnd.Number() >= 0 && fchmod(socketEnd.Number(), OwnerOnly) == 0 &&
      bind(socketEnd.Number(), address.Get(), InstanceAddress::Size) == 0 &&
      chmod(path.c_str(), OwnerOnly) == 0 && listen(socketEnd.Number(), waitingCalls) == 0;
  if (isListening) {
    listener_ = std::move(socketEnd);
  }
  return isListening;
}
