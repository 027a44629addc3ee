#include "platform/jet/ChildProgram.h"

#include <fcntl.h>
#include <poll.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>
#include <array>
#include <cerrno>
#include <csignal>

#include "platform/RuntimeError.h"

namespace {

constexpr std::size_t MostOfError = 4096;

class Pipe {
 public:
  Pipe() {
    if (pipe2(ends_.data(), O_CLOEXEC) != 0) {
      throw RuntimeError(75, "No pipe can be made.");
    }
  }
  ~Pipe() {
    CloseWriteEnd();
    close(ends_[0]);
  }
  Pipe(const Pipe&) = delete;
  Pipe& operator=(const Pipe&) = delete;

  int ReadEnd() const { return ends_[0]; }
  int WriteEnd() const { return ends_[1]; }
  void CloseWriteEnd() {
    if (ends_[1] >= 0) {
      close(ends_[1]);
      ends_[1] = -1;
    }
  }

 private:
  std::array<int, 2> ends_{};
};

/// A running program; the destructor kills it.
class Child {
 public:
  Child(const std::string& program, const std::vector<std::string>& arguments, const Pipe& output,
        const Pipe& errors) {
    std::vector<char*> texts = {const_cast<char*>(program.c_str())};
    for (const std::string& argument : arguments) {
      texts.push_back(const_cast<char*>(argument.c_str()));
    }
    texts.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, output.WriteEnd(), STDOUT_FILENO);
    posix_spawn_file_actions_adddup2(&actions, errors.WriteEnd(), STDERR_FILENO);
    const int result = posix_spawn(&id_, program.c_str(), &actions, nullptr, texts.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    if (result != 0) {
      throw RuntimeError(53, "File not found: " + program);
    }
  }
  ~Child() {
    if (id_ > 0) {
      kill(id_, SIGKILL);
      Wait();
    }
  }
  Child(const Child&) = delete;
  Child& operator=(const Child&) = delete;

  void Kill() const { kill(id_, SIGKILL); }

  /// True if it exited with status 0.
  bool Wait() {
    int status = 0;
    while (waitpid(id_, &status, 0) < 0 && errno == EINTR) {
    }
    id_ = 0;
    return WIFEXITED(status) && WEXITSTATUS(status) == 0;
  }

 private:
  pid_t id_ = 0;
};

}  // namespace

ChildEnd RunChild(const std::string& program, const std::vector<std::string>& arguments,
                  std::chrono::milliseconds silence, const std::function<void(std::string_view)>& onOutput) {
  Pipe output;
  Pipe errors;
  Child child(program, arguments, output, errors);
  output.CloseWriteEnd();
  errors.CloseWriteEnd();
  ChildEnd end;
  using Clock = std::chrono::steady_clock;
  Clock::time_point limit = Clock::now() + silence;
  std::array<pollfd, 2> sources = {{{output.ReadEnd(), POLLIN, 0}, {errors.ReadEnd(), POLLIN, 0}}};
  std::vector<char> buffer(std::size_t{1} << 18U);
  while (sources[0].fd >= 0 || sources[1].fd >= 0) {
    const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(limit - Clock::now()).count();
    if (left <= 0) {
      end.TimedOut = true;
      child.Kill();
      break;
    }
    const int ready = poll(sources.data(), sources.size(), static_cast<int>(left));
    for (pollfd& source : sources) {
      if (ready <= 0 || source.fd < 0 || source.revents == 0) {
        continue;
      }
      const ssize_t count = read(source.fd, buffer.data(), buffer.size());
      if (count <= 0) {
        source.fd = -1;  // closed: no longer polled
      } else if (&source == sources.data()) {
        onOutput({buffer.data(), static_cast<std::size_t>(count)});
        limit = Clock::now() + silence;
      } else if (end.Error.size() < MostOfError) {
        end.Error.append(buffer.data(), static_cast<std::size_t>(count));
      }
    }
  }
  end.Error = end.Error.substr(0, end.Error.find('\n'));
  end.Succeeded = child.Wait() && !end.TimedOut;
  return end;
}
