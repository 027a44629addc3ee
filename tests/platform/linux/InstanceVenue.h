#pragma once

#include "platform/linux/Instance.h"

#include <gtest/gtest.h>
#include <poll.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/wait.h>

#include <algorithm>
#include <csignal>
#include <filesystem>
#include <functional>
#include <memory>

#include "platform/linux/ChildProcess.h"
#include "platform/linux/InstanceCall.h"
#include "platform/linux/InstanceSocket.h"
#include "tests/support/OrdinaryUser.h"
#include "tests/support/TemporaryFolder.h"

/// Programs that start on one place: some in processes of their own, their calls taken by the test.
inline constexpr int Limit = 30'000;  ///< milliseconds that a test waits for what must come

/// A process of its own that runs `body` and exits with its result.
class Forked {
 public:
  explicit Forked(const std::function<int()>& body) : id_(fork()) {
    if (id_ == 0) {
      _exit(body());
    }
  }
  ~Forked() {
    if (id_ > 0) {
      kill(id_, SIGKILL);
      waitpid(id_, nullptr, 0);
    }
  }
  Forked(const Forked&) = delete;
  Forked& operator=(const Forked&) = delete;

  void Signal(int number) const { kill(id_, number); }

  /// Waits for its end; its exit code, or -1.
  int ExitCode() {
    int status = 0;
    waitpid(id_, &status, 0);
    id_ = 0;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
  }

 private:
  pid_t id_;
};

inline bool Readable(int descriptor, int milliseconds = Limit) {
  pollfd watched{descriptor, POLLIN, 0};
  return poll(&watched, 1, milliseconds) == 1;
}

class InstanceOfAProgram : public testing::Test {
 protected:
  InstancePlace Place(const std::string& name = "program") const { return {{folder.Path()}, name}; }

  std::string LockPath() const { return Instance::LockPath(Place(), 0); }
  std::string SocketPath() const { return Instance::SocketPath(Place(), 0); }

  /// Starts in a process of its own; its outcome is the exit code.
  Forked StartElsewhere(InstanceRequest request,
                        std::chrono::milliseconds patience = std::chrono::seconds(30),
                        const std::string& name = "program") const {
    return StartAt(Place(name), std::move(request), patience);
  }
  static Forked StartAt(InstancePlace place, InstanceRequest request = {},
                        std::chrono::milliseconds patience = std::chrono::milliseconds(0)) {
    return Forked([place = std::move(place), request = std::move(request), patience] {
      return static_cast<int>(Instance(place).Start(request, patience));
    });
  }

  /// A first one in a process of its own, which holds the place until that is killed.
  std::unique_ptr<Forked> HoldElsewhere() const {
    Pipe ready;
    auto holder = std::make_unique<Forked>([this, &ready] {
      Instance instance(Place());
      const bool isFirst = instance.Start({}, std::chrono::milliseconds(0)) == InstanceOutcome::First;
      if (isFirst && write(ready.WriteEnd.Number(), "1", 1) == 1) {
        pause();
      }
      return 0;
    });
    EXPECT_TRUE(Readable(ready.ReadEnd.Number()));
    return holder;
  }

  /// A call from this process at the listener of `first`.
  InstanceCall CallWith(const Instance& first, const std::string& bytes) {
    caller = Descriptor(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
    const InstanceAddress address(SocketPath());
    EXPECT_EQ(connect(caller.Number(), address.Get(), InstanceAddress::Size), 0);
    Send(bytes);
    bool failed = false;
    std::optional<InstanceCall> call = InstanceCall::Accept(first.Listener(), failed);
    EXPECT_FALSE(failed);
    return std::move(call.value());
  }
  void Send(const std::string& bytes) {
    EXPECT_EQ(send(caller.Number(), bytes.data(), bytes.size(), MSG_NOSIGNAL),
              static_cast<ssize_t>(bytes.size()));
  }

  TemporaryFolder folder;
  Descriptor caller;
};

inline constexpr int First = static_cast<int>(InstanceOutcome::First);
inline constexpr int Told = static_cast<int>(InstanceOutcome::Told);
inline constexpr int NoAnswer = static_cast<int>(InstanceOutcome::NoAnswer);

/// Takes the next call as the running program does.
inline InstanceRequest TakeCall(const Instance& first) {
  bool failed = false;
  EXPECT_TRUE(Readable(first.Listener()));
  std::optional<InstanceCall> call = InstanceCall::Accept(first.Listener(), failed);
  EXPECT_TRUE(call);
  InstanceCall::State state = InstanceCall::State::Pending;
  while (state == InstanceCall::State::Pending && Readable(call->Number())) {
    state = call->Read();
  }
  EXPECT_EQ(state, InstanceCall::State::Complete);
  EXPECT_TRUE(call->Answer());
  return call->Request();
}
