#include "platform/linux/ChildProcess.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>

#include <array>
#include <cerrno>
#include <csignal>

#include "platform/RuntimeError.h"

namespace {

/// What posix_spawn does in the new process before the program starts.
class SpawnSteps {
 public:
  SpawnSteps(const StandardStreams& streams, ProcessKind kind) {
    posix_spawn_file_actions_init(&files_);
    posix_spawn_file_actions_adddup2(&files_, streams.Input, STDIN_FILENO);
    posix_spawn_file_actions_adddup2(&files_, streams.Output, STDOUT_FILENO);
    posix_spawn_file_actions_adddup2(&files_, streams.Error, STDERR_FILENO);
    posix_spawn_file_actions_addclosefrom_np(&files_, STDERR_FILENO + 1);
    posix_spawnattr_init(&attributes_);
    if (kind == ProcessKind::Detached) {
      sigset_t defaults;
      sigemptyset(&defaults);
      sigaddset(&defaults, SIGPIPE);  // which this program may ignore
      posix_spawnattr_setsigdefault(&attributes_, &defaults);
      posix_spawnattr_setflags(&attributes_, POSIX_SPAWN_SETSID | POSIX_SPAWN_SETSIGDEF);
    }
  }
  ~SpawnSteps() {
    posix_spawnattr_destroy(&attributes_);
    posix_spawn_file_actions_destroy(&files_);
  }
  SpawnSteps(const SpawnSteps&) = delete;
  SpawnSteps& operator=(const SpawnSteps&) = delete;

  const posix_spawn_file_actions_t* Files() const { return &files_; }
  const posix_spawnattr_t* Attributes() const { return &attributes_; }

 private:
  posix_spawn_file_actions_t files_{};
  posix_spawnattr_t attributes_{};
};

}  // namespace

Pipe::Pipe() {
  std::array<int, 2> ends{};
  if (pipe2(ends.data(), O_CLOEXEC) != 0) {
    throw RuntimeError(Fault::PathAccess, "No pipe can be made.");
  }
  ReadEnd = Descriptor(ends[0]);
  WriteEnd = Descriptor(ends[1]);
}

pid_t StartProcess(const std::vector<std::string>& words, const StandardStreams& streams, ProcessKind kind) {
  std::vector<char*> texts;
  texts.reserve(words.size() + 1);
  for (const std::string& word : words) {
    texts.push_back(const_cast<char*>(word.c_str()));
  }
  texts.push_back(nullptr);
  const SpawnSteps steps(streams, kind);
  pid_t id = 0;
  if (posix_spawnp(&id, texts[0], steps.Files(), steps.Attributes(), texts.data(), environ) != 0) {
    throw RuntimeError(Fault::FileNotFound, "File not found: " + words[0]);
  }
  return id;
}

ChildProcess::~ChildProcess() {
  if (id_ > 0) {
    Kill();
    Wait();
  }
}

bool ChildProcess::Running() {
  if (id_ > 0 && waitpid(id_, &status_, WNOHANG) != 0) {
    id_ = 0;
  }
  return id_ > 0;
}

void ChildProcess::Kill() const {
  if (id_ > 0) {
    kill(id_, SIGKILL);
  }
}

bool ChildProcess::Wait() {
  while (id_ > 0 && waitpid(id_, &status_, 0) < 0 && errno == EINTR) {
  }
  id_ = 0;
  return WIFEXITED(status_) && WEXITSTATUS(status_) == 0;
}
