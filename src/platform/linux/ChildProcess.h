#pragma once

#include <sys/types.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "platform/linux/Descriptor.h"

/// Two ends of which other programs inherit none. Throws RuntimeError 75 when the system grants no pipe.
struct Pipe {
  Pipe();

  Descriptor ReadEnd;
  Descriptor WriteEnd;
};

/// Descriptors of this process that become the standard streams of a new one.
struct StandardStreams {
  int Input = STDIN_FILENO;
  int Output = STDOUT_FILENO;
  int Error = STDERR_FILENO;
};

enum class ProcessKind {
  Child,    ///< of this program's session: keys of its terminal (Ctrl+C) are for both
  Detached  ///< a session of its own, with the signals as a new login has them
};

/// Starts the program `words[0]`, which is looked for on the search path when it has no slash, with the other
/// words as arguments; returns its process id. Of our descriptors it gets `streams` and no others. Throws
/// RuntimeError 53 when it cannot be started.
pid_t StartProcess(const std::vector<std::string>& words, const StandardStreams& streams, ProcessKind kind);

/// A program that does not outlive this.
class ChildProcess {
 public:
  /// Throws as StartProcess does.
  ChildProcess(const std::vector<std::string>& words, const StandardStreams& streams)
      : id_(StartProcess(words, streams, ProcessKind::Child)) {}

  /// Kills it when it still runs.
  ~ChildProcess();
  ChildProcess(const ChildProcess&) = delete;
  ChildProcess& operator=(const ChildProcess&) = delete;

  /// False once it has ended.
  bool Running();

  void Kill() const;

  /// Waits for its end, as long as it takes. True when it ended by itself with 0.
  bool Wait();

 private:
  pid_t id_;  ///< 0 when it has ended
  int status_ = 0;
};
