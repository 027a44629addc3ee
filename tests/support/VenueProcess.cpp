#include "tests/support/VenueProcess.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <poll.h>
#include <signal.h>
#include <spawn.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <system_error>

#include "tests/support/RawHost.h"

namespace sim {
namespace {

struct Pipe {
  Pipe() {
    std::array<int, 2> ends{};
    if (::pipe2(ends.data(), O_CLOEXEC) != 0) {
      throw std::system_error(errno, std::generic_category(), "pipe");
    }
    Reader = FileDescriptor(ends[0]);
    Writer = FileDescriptor(ends[1]);
  }
  FileDescriptor Reader;
  FileDescriptor Writer;
};

bool WaitReadable(const FileDescriptor& descriptor) {
  pollfd watched{descriptor.Get(), POLLIN, 0};
  return ::poll(&watched, 1, static_cast<int>(std::chrono::milliseconds(Limit).count())) > 0;
}

std::string ReadTo(const FileDescriptor& descriptor, char last) {
  std::string text;
  char next = 0;
  while (WaitReadable(descriptor) && ::read(descriptor.Get(), &next, 1) == 1) {
    text += next;
    if (next == last) {
      break;
    }
  }
  return text;
}

}  // namespace

VenueProcess::VenueProcess(const std::vector<std::string>& arguments) {
  Pipe input;
  Pipe output;
  Pipe errors;
  posix_spawn_file_actions_t actions{};
  ::posix_spawn_file_actions_init(&actions);
  ::posix_spawn_file_actions_adddup2(&actions, input.Reader.Get(), STDIN_FILENO);
  ::posix_spawn_file_actions_adddup2(&actions, output.Writer.Get(), STDOUT_FILENO);
  ::posix_spawn_file_actions_adddup2(&actions, errors.Writer.Get(), STDERR_FILENO);
  std::vector<std::string> words{TESSARINE_VENUE_PROGRAM};
  words.insert(words.end(), arguments.begin(), arguments.end());
  std::vector<char*> argv;
  argv.reserve(words.size() + 1);
  for (std::string& word : words) {
    argv.push_back(word.data());
  }
  argv.push_back(nullptr);
  EXPECT_EQ(::posix_spawn(&process_, TESSARINE_VENUE_PROGRAM, &actions, nullptr, argv.data(), environ), 0);
  ::posix_spawn_file_actions_destroy(&actions);
  // The C++ linkage of the library's own pidfd_open is wrong in glibc 2.36.
  handle_ = FileDescriptor(static_cast<int>(::syscall(SYS_pidfd_open, process_, 0)));
  input_ = std::move(input.Writer);
  output_ = std::move(output.Reader);
  errors_ = std::move(errors.Reader);
}

VenueProcess::~VenueProcess() {
  if (process_ > 0) {
    ::kill(process_, SIGKILL);
    ::waitpid(process_, nullptr, 0);
  }
}

std::string VenueProcess::ReadDevice(const std::string& title) {
  const std::string begin = title + ": ";
  const std::string line = ReadLine();
  EXPECT_EQ(line.substr(0, begin.size()), begin) << (line.empty() ? RestOfErrors() : "");
  return line.size() < begin.size() ? "" : line.substr(begin.size());
}

std::string VenueProcess::ReadLine() {
  std::string line = ReadTo(output_, '\n');
  if (!line.empty()) {
    line.pop_back();
  }
  return line;
}

void VenueProcess::WriteInput(const std::string& text) {
  EXPECT_EQ(::write(input_.Get(), text.data(), text.size()), static_cast<ssize_t>(text.size()));
}

void VenueProcess::Signal(int signal) {
  EXPECT_EQ(::kill(process_, signal), 0);
}

bool VenueProcess::IsRunning() {
  return process_ > 0 && ::waitpid(process_, nullptr, WNOHANG) == 0;
}

int VenueProcess::WaitForExit() {
  int status = 0;
  if (!WaitReadable(handle_) || ::waitpid(process_, &status, 0) != process_) {
    return -1;
  }
  process_ = -1;
  return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

std::string VenueProcess::RestOfOutput() {
  return ReadTo(output_, '\0');
}

std::string VenueProcess::RestOfErrors() {
  return ReadTo(errors_, '\0');
}

}  // namespace sim
