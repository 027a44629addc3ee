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

}  // namespace

std::string InstanceFolder(const std::string& runtimeFolder, const std::string& dataFolder) {
  if (IsOwnFolder(runtimeFolder)) {
    return runtimeFolder;
  }
  std::error_code none;  // where it cannot be made, the program says so when it needs it
  std::filesystem::create_directories(dataFolder, none);
  return dataFolder;
}

Instance::Instance(InstancePlace place) : place_(std::move(place)) {}

// The lock goes last, so that nothing of the next start is taken away.
Instance::~Instance() {
  if (listener_.Number() >= 0) {
    unlink(SocketPath().c_str());
  }
  if (lock_.Number() >= 0 && IsAtPath(lock_.Number(), LockPath())) {
    unlink(LockPath().c_str());
  }
}

InstanceOutcome Instance::Start(const InstanceRequest& request, std::chrono::milliseconds patience) {
  constexpr int betweenTries = 20;  // milliseconds
  const Deadline deadline(patience);
  const std::optional<std::string> line = InstanceLine(request);
  while (true) {
    if (const Lock lock = TakeLock(); lock != Lock::Busy) {
      if (lock == Lock::Taken) {
        Listen();
      }
      return InstanceOutcome::First;
    }
    // The other one may be about to listen, or about to end.
    if (line && TellRunning(SocketPath(), *line, deadline)) {
      return InstanceOutcome::Told;
    }
    if (deadline.MillisecondsLeft() == 0) {
      return InstanceOutcome::NoAnswer;
    }
    poll(nullptr, 0, std::min(betweenTries, deadline.MillisecondsLeft()));
  }
}

Instance::Lock Instance::TakeLock() {
  while (true) {
    Descriptor file(
        open(LockPath().c_str(), O_RDWR | O_CREAT | O_NOFOLLOW | O_CLOEXEC | O_NONBLOCK, OwnerOnly));
    struct stat opened {};
    if (file.Number() < 0 || fstat(file.Number(), &opened) != 0 || !S_ISREG(opened.st_mode)) {
      return Lock::Impossible;
    }
    if (flock(file.Number(), LOCK_EX | LOCK_NB) != 0) {
      return errno == EWOULDBLOCK ? Lock::Busy : Lock::Impossible;
    }
    // The one before may just have taken the file away: a lock on it would be found by no other start.
    if (IsAtPath(file.Number(), LockPath())) {
      lock_ = std::move(file);
      return Lock::Taken;
    }
  }
}

void Instance::Listen() {
  constexpr int waitingCalls = 64;
  const InstanceAddress address(SocketPath());
  Descriptor socketEnd(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
  unlink(SocketPath().c_str());  // of a program that crashed
  if (address.Valid() && socketEnd.Number() >= 0 && fchmod(socketEnd.Number(), OwnerOnly) == 0 &&
      bind(socketEnd.Number(), address.Get(), InstanceAddress::Size) == 0 &&
      chmod(SocketPath().c_str(), OwnerOnly) == 0 && listen(socketEnd.Number(), waitingCalls) == 0) {
    listener_ = std::move(socketEnd);
  }
}
